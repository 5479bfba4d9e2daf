// The save-as dialog: folder and name taken apart, the extension lists of documents and
// mail items, confirming and cancelling.
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include "dialogs/frm_save_as.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/state.h"
#include "watchdog.h"

using namespace zv;

namespace {

QStringList Items(const QComboBox& box) {
    QStringList out;
    for (int i = 0; i < box.count(); ++i) {
        out << box.itemText(i);
    }
    return out;
}

FrmSaveAs& AsSaveAs(QWidget& w) {
    return static_cast<FrmSaveAs&>(w);
}

}  // namespace

class TestFrmSaveAs : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void splitsFileName_data();
    void splitsFileName();
    void extensionLists_data();
    void extensionLists();
    void confirmsWithoutEditing_data();
    void confirmsWithoutEditing();
    void cancels_data();
    void cancels();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestFrmSaveAs::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
}

void TestFrmSaveAs::cleanup() {
    QVERIFY((*ui_)->Messages().empty());
    QCOMPARE((*ui_)->UnexpectedModals(), 0);
    ui_.reset();
    env_.reset();
}

void TestFrmSaveAs::splitsFileName_data() {
    QTest::addColumn<QString>("fileName");
    QTest::addColumn<QString>("dir");
    QTest::addColumn<QString>("name");
    QTest::newRow("dots in the name")
        << QStringLiteral("C:\\A\\B\\report.final.docx") << QStringLiteral("C:\\A\\B\\")
        << QStringLiteral("report.final");
    QTest::newRow("hebrew, forward separators")
        << QStringLiteral("/srv/zorvane/DOCS/100/מכתב ללקוח.msg")
        << QStringLiteral("/srv/zorvane/DOCS/100/") << QStringLiteral("מכתב ללקוח");
    QTest::newRow("dot in a folder only")
        << QStringLiteral("C:\\v1.2\\readme.txt") << QStringLiteral("C:\\v1.2\\")
        << QStringLiteral("readme");
}

void TestFrmSaveAs::splitsFileName() {
    QFETCH(QString, fileName);
    QFETCH(QString, dir);
    QFETCH(QString, name);
    test::Watchdog watchdog;
    FrmSaveAs frm;
    frm.SetFileName(fileName);
    (*ui_)->QueueModal([](QWidget& w) { AsSaveAs(w).CmdSave().click(); });
    ShowModal(frm);
    QCOMPARE(frm.LDir().text(), dir);
    QCOMPARE(frm.TxtName().text(), name);
}

void TestFrmSaveAs::extensionLists_data() {
    QTest::addColumn<int>("sug");
    QTest::addColumn<QString>("sourceExt");
    QTest::addColumn<QStringList>("items");
    const QStringList word = {QStringLiteral("Doc"), QStringLiteral("Docx")};
    const QStringList mail = {QStringLiteral("msg"), QStringLiteral("eml"), QStringLiteral("htm")};
    QTest::newRow("document from docx") << 2 << QStringLiteral("docx") << word;
    QTest::newRow("document from DOC") << 2 << QStringLiteral("DOC") << word;
    QTest::newRow("document without extension") << 2 << QString() << word;
    // A PDF keeps its own type first instead of being renamed to .Doc.
    QTest::newRow("document from pdf")
        << 2 << QStringLiteral("pdf") << (QStringList{QStringLiteral("pdf")} + word);
    QTest::newRow("document from XLSX")
        << 2 << QStringLiteral("XLSX") << (QStringList{QStringLiteral("XLSX")} + word);
    QTest::newRow("mail item") << 0 << QStringLiteral("msg") << mail;
    QTest::newRow("mail item from eml") << 1 << QStringLiteral("eml") << mail;
    QTest::newRow("mail kind ignores a pdf source") << 0 << QStringLiteral("pdf") << mail;
}

void TestFrmSaveAs::extensionLists() {
    QFETCH(int, sug);
    QFETCH(QString, sourceExt);
    QFETCH(QStringList, items);
    test::Watchdog watchdog;
    SetSourceExt(sourceExt);
    FrmSaveAs frm;
    frm.SetFileName(QStringLiteral("C:\\DOCS\\a.") +
                    (sourceExt.isEmpty() ? QStringLiteral("doc") : sourceExt));
    frm.SetSug(static_cast<int16_t>(sug));
    QStringList shown;
    QString current;
    (*ui_)->QueueModal([&](QWidget& w) {
        shown = Items(AsSaveAs(w).CboEndName());
        current = AsSaveAs(w).CboEndName().currentText();
        AsSaveAs(w).CmdSave().click();
    });
    ShowModal(frm);
    QCOMPARE(shown, items);
    QCOMPARE(current, items.first());
}

void TestFrmSaveAs::confirmsWithoutEditing_data() {
    QTest::addColumn<bool>("byEnter");
    QTest::newRow("save button") << false;
    QTest::newRow("Enter in the name") << true;
}

void TestFrmSaveAs::confirmsWithoutEditing() {
    QFETCH(bool, byEnter);
    test::Watchdog watchdog;
    SetSourceExt(QStringLiteral("docx"));
    FrmSaveAs frm;
    frm.SetFileName(QStringLiteral("C:\\DOCS\\100\\חוזה שכירות.docx"));
    frm.SetSug(2);
    (*ui_)->QueueModal([&](QWidget& w) {
        if (byEnter) {
            QTest::keyClick(&AsSaveAs(w).TxtName(), Qt::Key_Return);
        } else {
            QTest::mouseClick(&AsSaveAs(w).CmdSave(), Qt::LeftButton);
        }
    });
    ShowModal(frm);
    QVERIFY(!frm.IsCancel());
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.TxtName().text(), QStringLiteral("חוזה שכירות"));
    // The first of the list, not the extension the proposed name had.
    QCOMPARE(frm.CboEndName().currentText(), QStringLiteral("Doc"));
}

void TestFrmSaveAs::cancels_data() {
    QTest::addColumn<int>("how");
    QTest::newRow("cancel button") << 0;
    QTest::newRow("close box") << 1;
    QTest::newRow("Escape") << 2;
}

void TestFrmSaveAs::cancels() {
    QFETCH(int, how);
    test::Watchdog watchdog;
    FrmSaveAs frm;
    frm.SetFileName(QStringLiteral("C:\\DOCS\\a.msg"));
    (*ui_)->QueueModal([how](QWidget& w) {
        FrmSaveAs& f = AsSaveAs(w);
        if (how == 0) {
            QTest::mouseClick(&f.CmdCancel(), Qt::LeftButton);
        } else if (how == 1) {
            f.close();
        } else {
            QTest::keyClick(&f.TxtName(), Qt::Key_Escape);
        }
    });
    ShowModal(frm);
    QVERIFY(frm.IsCancel());
    QVERIFY(!frm.isVisible());
}

QTEST_MAIN(TestFrmSaveAs)
#include "test_frm_save_as.moc"

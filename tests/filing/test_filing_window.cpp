// A filing request end to end in process: the command line through Main, the filing dialog
// and the save-as dialog filled by the test, the file copied, the rows read back.
#include <QComboBox>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QtTest>

#include "dialog_script.h"
#include "dialogs/frm_save_as.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "filing_fixture.h"
#include "util/ui.h"

using namespace zv;
using namespace zv::test;

namespace {

const QString kSaved = QStringLiteral("הקובץ נשמר לכתובת המבוקשת");

QStringList Items(const QComboBox& box) {
    QStringList items;
    for (int i = 0; i < box.count(); ++i) {
        items << box.itemText(i);
    }
    return items;
}

// The FULLNAME the suite stores for a path below DOCS ("DOC1001/W/2/x.pdf").
QString FullName(const QString& relPath) {
    return QStringLiteral("\\DOCS\\") +
           QString(relPath).replace(QLatin1Char('/'), QLatin1Char('\\'));
}

}  // namespace

class TestFilingWindow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void documentFiled_data();
    void documentFiled();
    void cancelled_data();
    void cancelled();
    void clash_data();
    void clash();
    void sourceWithoutExtension();
    void mail_data();
    void mail();
    void otherModeFilesNothing();
    void rowNotSavedKeepsSource();
    void sourceThatCannotBeDeleted();
    void copyCannotBeWritten_data();
    void copyCannotBeWritten();
};

void TestFilingWindow::documentFiled_data() {
    QTest::addColumn<QString>("tik");
    QTest::addColumn<QString>("folder");
    QTest::addColumn<QString>("sug");
    QTest::addColumn<QString>("code");
    QTest::newRow("client") << ""
                            << "DOC1001"
                            << "F"
                            << "";
    QTest::newRow("case") << "2"
                          << "DOC1001/W/2"
                          << "W"
                          << "1001-2";
}

void TestFilingWindow::documentFiled() {
    QFETCH(QString, tik);
    QFETCH(QString, folder);
    QFETCH(QString, sug);
    QFETCH(QString, code);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("letter.docx"), "body");
    DialogInput in;
    in.client = QStringLiteral("1001");
    in.tik = tik;
    in.description = QStringLiteral("חוזה");
    in.remark = QStringLiteral("נשלח בדואר");
    in.reminder = true;
    in.reminderTime = QStringLiteral("09:15");
    in.popup = true;
    QueueFilingDialog(f.Ui(), in, [](FrmGetDocDet& d) {
        QCOMPARE(d.PartOf(), int16_t(2));
        QVERIFY(d.IsCaptureDoc());
        QVERIFY(!d.IsCaptureMail());
        QCOMPARE(d.DefultName(), QStringLiteral("מכתב ללקוח"));
    });

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("מכתב: <ללקוח>"));

    const QString rel = folder + QStringLiteral("/מכתב ללקוח.docx");
    QCOMPARE(archived, f.Docs() + QLatin1Char('/') + rel);
    QCOMPARE(Content(archived), QByteArray("body"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.first();
    QCOMPARE(row["FULLNAME"].toString(), FullName(rel));
    QCOMPARE(row["CLIENT_NUM"].toString(), QStringLiteral("1001"));
    QCOMPARE(row["SUG"].toString(), sug);
    QCOMPARE(row["TIK"].toString(), tik);
    QCOMPARE(row["NUM"].toString(), code);
    QCOMPARE(row["TEUR"].toString(), QStringLiteral("חוזה"));
    QVERIFY(row["BODY"].toString().endsWith(QStringLiteral(" -- נשלח בדואר")));
    QCOMPARE(row["PARTOF"].toInt(), 2);
    QCOMPARE(row["STATUS"].toInt(), 2);
    QCOMPARE(row["ISMEMO"].toBool(), false);
    QCOMPARE(row["MEMOHOUR"].toString(), QStringLiteral("09:15"));
    const auto memos =
        f.Rows(QStringLiteral("BM"),
               QStringLiteral("SELECT * FROM UMEMO WHERE ID=") + row["ID"].toString());
    QCOMPARE(memos.size(), 2);  // the pop-up and the regular reminder of the one handler
    for (const QVariantMap& memo : memos) {
        QCOMPARE(memo["MEMOTIME"].toDateTime(),
                 QDateTime(FilingFixture::Moment().date(), QTime(9, 15)));
    }
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
    QCOMPARE(f.Ui().Messages().front().style, vbOKOnly | vbInformation);
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::cancelled_data() {
    QTest::addColumn<bool>("atSaveAs");
    QTest::newRow("filing dialog closed") << false;
    QTest::newRow("save-as cancelled") << true;
}

void TestFilingWindow::cancelled() {
    QFETCH(bool, atSaveAs);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("scan.pdf"), "new");
    const QString existing = f.ArchiveFile(QStringLiteral("DOC1001/מכתב.pdf"), "old");
    DialogInput in;
    in.confirm = atSaveAs;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);
    if (atSaveAs) {
        QueueSaveAs(f.Ui(), {}, std::nullopt, true);
    }

    QCOMPARE(f.RunWithDialog(1, source, QStringLiteral("מכתב")), QString());

    QCOMPARE(Content(source), QByteArray("new"));
    QCOMPARE(Content(existing), QByteArray("old"));
    QCOMPARE(FolderEntries(f.Docs() + QStringLiteral("/DOC1001")), QStringList{"מכתב.pdf"});
    QVERIFY(f.DocsRows().isEmpty());
    QVERIFY(f.Ui().Texts().isEmpty());
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::clash_data() {
    QTest::addColumn<QStringList>("renames");  // one entry per save-as shown
    QTest::addColumn<QString>("expected");     // empty: nothing filed
    QTest::newRow("replaced") << QStringList{""} << "מכתב.pdf";
    QTest::newRow("renamed") << QStringList{"מכתב: שני"} << "מכתב שני.pdf";
    // A new name that clashes too is asked about again, not silently replaced.
    QTest::newRow("renamed onto another file, then renamed")
        << QStringList{"אחר", "שלישי"} << "שלישי.pdf";
}

void TestFilingWindow::clash() {
    QFETCH(QStringList, renames);
    QFETCH(QString, expected);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("scan.pdf"), "new");
    const QString existing = f.ArchiveFile(QStringLiteral("DOC1001/מכתב.pdf"), "old");
    const QString other = f.ArchiveFile(QStringLiteral("DOC1001/אחר.pdf"), "other");
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);
    QString shown = QStringLiteral("מכתב");
    for (const QString& rename : renames) {
        QueueSaveAs(
            f.Ui(),
            [&f, shown](FrmSaveAs& s) {
                QCOMPARE(s.LDir().text(), f.Docs() + QStringLiteral("/DOC1001/"));
                QCOMPARE(s.TxtName().text(), shown);
                // A PDF is offered as a PDF first, then the word-processor types.
                QCOMPARE(Items(s.CboEndName()), (QStringList{"pdf", "Doc", "Docx"}));
                QCOMPARE(s.CboEndName().currentText(), QStringLiteral("pdf"));
            },
            rename.isEmpty() ? std::nullopt : std::optional<QString>(rename));
        shown = rename;
    }

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("מכתב"));

    QCOMPARE(f.Ui().ModalCount(), 2 + static_cast<int>(renames.size()));
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/") + expected);
    QCOMPARE(Content(archived), QByteArray("new"));
    QVERIFY(!QFile::exists(source));
    if (expected != QStringLiteral("מכתב.pdf")) {
        QCOMPARE(Content(existing), QByteArray("old"));
    }
    QCOMPARE(Content(other), QByteArray("other"));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QCOMPARE(rows.first()["FULLNAME"].toString(), FullName(QStringLiteral("DOC1001/") + expected));
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
}

void TestFilingWindow::sourceWithoutExtension() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("README"), "plain");
    DialogInput in;
    in.client = QStringLiteral("1002");
    QueueFilingDialog(f.Ui(), in);

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("קרא אותי"));

    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1002/קרא אותי"));
    QCOMPARE(Content(archived), QByteArray("plain"));
    QCOMPARE(f.DocsRows().first()["SHORTNAME"].toString(), QStringLiteral("קרא אותי"));
}

void TestFilingWindow::mail_data() {
    QTest::addColumn<QString>("sourceName");
    QTest::addColumn<QString>("suggested");
    QTest::addColumn<QString>("typed");     // null: the proposal stays in the name box
    QTest::addColumn<QString>("existing");  // a mail already in the folder
    QTest::addColumn<QString>("renameTo");  // the save-as dialog's new name; empty: not shown
    QTest::addColumn<QString>("expected");
    const QString subject = QStringLiteral("נושא: פגישה");
    QTest::newRow("empty name") << "m.msg" << subject << ""
                                << ""
                                << ""
                                << "נושא פגישה.msg";
    QTest::newRow("name differing in case only") << "m.msg"
                                                 << "Meeting notes"
                                                 << "MEETING NOTES"
                                                 << ""
                                                 << ""
                                                 << "Meeting notes.msg";
    QTest::newRow("name of its own") << "m.msg" << subject << "סיכום"
                                     << ""
                                     << ""
                                     << "סיכום.msg";
    QTest::newRow("upper-case .MSG source") << "m.MSG" << subject << QString() << ""
                                            << ""
                                            << "נושא פגישה.msg";
    QTest::newRow(".eml source") << "m.eml" << subject << QString() << ""
                                 << ""
                                 << "נושא פגישה.msg.eml";
    // The earlier mail of the same subject is found under its final name and kept.
    QTest::newRow(".eml clash") << "m.eml" << subject << QString() << "נושא פגישה.msg.eml"
                                << "נושא פגישה 2"
                                << "נושא פגישה 2.msg.eml";
}

void TestFilingWindow::mail() {
    QFETCH(QString, sourceName);
    QFETCH(QString, suggested);
    QFETCH(QString, typed);
    QFETCH(QString, existing);
    QFETCH(QString, renameTo);
    QFETCH(QString, expected);
    FilingFixture f;
    const QString source = f.Source(sourceName, "mail");
    const QString earlier = existing.isEmpty()
                                ? QString()
                                : f.ArchiveFile(QStringLiteral("DOC1001/") + existing, "earlier");
    DialogInput in;
    in.client = QStringLiteral("1001");
    if (!typed.isNull()) {
        in.name = typed;
    }
    QueueFilingDialog(f.Ui(), in, [](FrmGetDocDet& d) {
        QCOMPARE(d.PartOf(), int16_t(1));
        QVERIFY(!d.IsCaptureDoc());
        QVERIFY(d.IsCaptureMail());
    });
    if (!renameTo.isEmpty()) {
        QueueSaveAs(
            f.Ui(),
            [](FrmSaveAs& s) {
                QCOMPARE(s.TxtName().text(), QStringLiteral("נושא פגישה"));
                QCOMPARE(Items(s.CboEndName()), (QStringList{"msg", "eml", "htm"}));
            },
            renameTo);
    }

    const QString archived = f.RunWithDialog(2, source, suggested);

    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/") + expected);
    QCOMPARE(Content(archived), QByteArray("mail"));
    QVERIFY(!QFile::exists(source));
    if (!earlier.isEmpty()) {
        QCOMPARE(Content(earlier), QByteArray("earlier"));
    }
    QCOMPARE(f.DocsRows().size(), 1);
    QCOMPARE(f.DocsRows().first()["PARTOF"].toInt(), 1);
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::otherModeFilesNothing() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.doc"), "x");
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);

    QCOMPARE(f.RunWithDialog(3, source, QStringLiteral("שלוש")), QString());

    QCOMPARE(f.Ui().ModalCount(), 2);
    QCOMPARE(Content(source), QByteArray("x"));
    QCOMPARE(FolderEntries(f.Docs() + QStringLiteral("/DOC1001")), QStringList());
    QVERIFY(f.DocsRows().isEmpty());
    QVERIFY(f.Ui().Texts().isEmpty());
}

void TestFilingWindow::rowNotSavedKeepsSource() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "x");
    f.ExecFile(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE DOCS RENAME TO DOCS_AWAY"));
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);

    QCOMPARE(f.RunWithDialog(1, source, QStringLiteral("מסמך")), QString());

    QCOMPARE(Content(source), QByteArray("x"));
    // Nothing is left in the archive without its row.
    QCOMPARE(FolderEntries(f.Docs() + QStringLiteral("/DOC1001")), QStringList());
    const QStringList texts = f.Ui().Texts();
    // One message, the reason below what became of the document.
    QCOMPARE(texts.size(), 1);
    QVERIFY(texts.front().startsWith(
        QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :\r\n") + source +
        QStringLiteral("\r\n\r\n")));
    QVERIFY(!texts.contains(kSaved));
}

void TestFilingWindow::sourceThatCannotBeDeleted() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "x");
    Unwritable keep(source);
    if (!keep.Holds()) {
        QSKIP("this file system cannot keep a file from being deleted");
    }
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("מסמך"));

    // The filing stands; the user is told the source is still there.
    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/מסמך.pdf"));
    QCOMPARE(f.DocsRows().size(), 1);
    QVERIFY(QFile::exists(source));
    const QStringList texts = f.Ui().Texts();
    QCOMPARE(texts.size(), 2);
    QCOMPARE(texts.at(0), kSaved);
    QVERIFY2(texts.at(1).startsWith(
                 QStringLiteral("לא ניתן היה למחוק את קובץ המקור, והוא נשאר במקומו :\r\n") +
                 source + QStringLiteral("\r\n")),
             qPrintable(texts.at(1)));
}

void TestFilingWindow::copyCannotBeWritten_data() {
    QTest::addColumn<bool>("readOnlyFolder");
    QTest::addColumn<QString>("errorStart");
    QTest::newRow("target taken by a folder") << false << "75-0-WorkWithStr-";
    QTest::newRow("read-only folder") << true << "70-0-WorkWithStr-";
}

void TestFilingWindow::copyCannotBeWritten() {
    QFETCH(bool, readOnlyFolder);
    QFETCH(QString, errorStart);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "x");
    const QString folder = f.Docs() + QStringLiteral("/DOC1001");
    QVERIFY(QDir().mkpath(readOnlyFolder ? folder : folder + QStringLiteral("/מסמך.pdf")));
    const QStringList before = FolderEntries(folder);
    std::optional<Unwritable> keep;
    if (readOnlyFolder) {
        keep.emplace(folder);
        if (!keep->Holds()) {
            QSKIP("this file system cannot keep a folder from receiving files");
        }
    }
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);

    QCOMPARE(f.RunWithDialog(1, source, QStringLiteral("מסמך")), QString());

    QCOMPARE(Content(source), QByteArray("x"));
    QCOMPARE(FolderEntries(folder), before);
    QVERIFY(f.DocsRows().isEmpty());
    const QStringList texts = f.Ui().Texts();
    QCOMPARE(texts.size(), 1);
    QVERIFY2(texts.first().startsWith(errorStart), qPrintable(texts.first()));
    QVERIFY2(
        texts.first().endsWith(QStringLiteral("\r\n1\r\n") + source + QStringLiteral("\r\nמסמך")),
        qPrintable(texts.first()));
}

QTEST_MAIN(TestFilingWindow)
#include "test_filing_window.moc"

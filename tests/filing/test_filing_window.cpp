// A filing request end to end in process: the command line through Main, the filing dialog
// and the save-as dialog filled by the test, the file copied, the rows read back; on the
// file databases or, in the server build of this program, on PostgreSQL.
#include <QFile>
#include <QFileInfo>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include "dialogs/frm_save_as.h"
#include "filing_fixture.h"
#include "sample_install/test_server.h"

using namespace zv;
using namespace zv::test;
using namespace Qt::Literals::StringLiterals;

namespace {

constexpr bool kServer = ZV_FILING_ON_SERVER;
const QString kSaved = u"הקובץ נשמר לכתובת המבוקשת"_s;
const QString kCancel = u"<cancel>"_s;

// One request on the client 1001: mode, source, suggested name, the name typed (none: the
// proposal stays), files already in the client's folder, the name given in each save-as
// shown (empty: keep it; kCancel: cancel), the file archived (empty: nothing is filed), and
// whether the filing dialog is confirmed.
struct Case {
    int mode;
    QString source, suggested;
    std::optional<QString> typed;
    QStringList existing, renames;
    QString expected;
    bool confirm = true;
};

}  // namespace

Q_DECLARE_METATYPE(Case)

class TestFilingWindow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void documentFiled();
    void filed_data();
    void filed();
    void sourceThatCannotBeDeleted();
};

void TestFilingWindow::initTestCase() {
    if (kServer) {
        const SampleOptions options = TestServerOptions();
        ZV_REQUIRE_TEST_SERVER(options);
    }
}

// A case chosen in the dialog: the file goes to its folder, and what the user filled in
// reaches the row and its reminders.
void TestFilingWindow::documentFiled() {
    FilingFixture f(kServer);
    const QString source = f.Source(u"letter.docx"_s, "body");
    QueueFilingDialog(f.Ui(), {.tik = u"2"_s,
                               .description = u"חוזה"_s,
                               .remark = u"נשלח בדואר"_s,
                               .reminderTime = u"09:15"_s,
                               .popup = true});

    const QString archived = f.RunWithDialog(1, source, u"מכתב: <ללקוח>"_s);

    QCOMPARE(archived, f.Docs() + u"/DOC1001/W/2/מכתב ללקוח.docx"_s);
    QCOMPARE(Content(archived), QByteArray("body"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.first();
    QCOMPARE(QStringList({row["FULLNAME"].toString(), row["CLIENT_NUM"].toString(),
                          row["SUG"].toString(), row["TIK"].toString(), row["NUM"].toString(),
                          row["TEUR"].toString(), row["MEMOHOUR"].toString()}),
             QStringList({FullName(u"DOC1001/W/2/מכתב ללקוח.docx"_s), "1001", "W", "2", "1001-2",
                          "חוזה", "09:15"}));
    QVERIFY(row["BODY"].toString().endsWith(u" -- נשלח בדואר"_s));
    const auto memos = Rows(u"BM"_s, "SELECT * FROM UMEMO WHERE ID=" + row["ID"].toString());
    QCOMPARE(memos.size(), 2);  // the pop-up and the regular reminder of the one handler
    for (const QVariantMap& memo : memos) {
        QCOMPARE(memo["MEMOTIME"].toDateTime(),
                 QDateTime(FilingFixture::Moment().date(), QTime(9, 15)));
    }
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::filed_data() {
    QTest::addColumn<Case>("c");
    const QString scan = u"scan.pdf"_s, letter = u"מכתב"_s, subject = u"נושא: פגישה"_s;
    const QStringList old{u"מכתב.pdf"_s};
    QTest::newRow("filing dialog closed") << Case{1, scan, letter, {}, old, {}, {}, false};
    QTest::newRow("save-as cancelled") << Case{1, scan, letter, {}, old, {kCancel}, {}};
    QTest::newRow("mode 3 files nothing") << Case{3, scan, letter, {}, old, {}, {}};
    QTest::newRow("clash replaced") << Case{1, scan, letter, {}, old, {""}, "מכתב.pdf"};
    QTest::newRow("clash renamed") << Case{1, scan, letter, {}, old, {"מכתב: שני"}, "מכתב שני.pdf"};
    // A new name that clashes too is asked about again, not silently replaced.
    QTest::newRow("renamed onto another file, then renamed")
        << Case{1, scan, letter, {}, {"מכתב.pdf", "אחר.pdf"}, {"אחר", "שלישי"}, "שלישי.pdf"};
    QTest::newRow("source without extension")
        << Case{1, "README", "קרא אותי", {}, {}, {}, "קרא אותי"};
    QTest::newRow("mail, empty name") << Case{2, "m.msg", subject, "", {}, {}, "נושא פגישה.msg"};
    QTest::newRow("mail, name differing in case only")
        << Case{2, "m.msg", "Meeting notes", "MEETING NOTES", {}, {}, "Meeting notes.msg"};
    QTest::newRow("mail, name of its own")
        << Case{2, "m.msg", subject, "סיכום", {}, {}, "סיכום.msg"};
    QTest::newRow("mail, upper-case .MSG source")
        << Case{2, "m.MSG", subject, {}, {}, {}, "נושא פגישה.msg"};
    QTest::newRow("mail, .eml source")
        << Case{2, "m.eml", subject, {}, {}, {}, "נושא פגישה.msg.eml"};
    // The earlier mail of the same subject is found under its final name and kept.
    QTest::newRow("mail, .eml clash") << Case{
        2, "m.eml", subject, {}, {"נושא פגישה.msg.eml"}, {"נושא פגישה 2"}, "נושא פגישה 2.msg.eml"};
}

void TestFilingWindow::filed() {
    QFETCH(Case, c);
    FilingFixture f(kServer);
    const QString source = f.Source(c.source, "new");
    for (const QString& name : c.existing) {
        f.ArchiveFile(u"DOC1001/"_s + name, "old, longer");
    }
    QueueFilingDialog(f.Ui(), {.confirm = c.confirm, .name = c.typed});
    // The save-as dialog proposes the clashing name, then each name typed before.
    QString shown = c.existing.isEmpty() ? QString() : QFileInfo(c.existing.first()).baseName();
    for (const QString& rename : c.renames) {
        f.Ui().QueueModal([shown, rename](QWidget& window) {
            auto& s = dynamic_cast<FrmSaveAs&>(window);
            QCOMPARE(s.TxtName().text(), shown);
            if (!rename.isEmpty() && rename != kCancel) {
                s.TxtName().setText(rename);
            }
            (rename == kCancel ? s.CmdCancel() : s.CmdSave()).click();
        });
        shown = rename;
    }

    const QString archived = f.RunWithDialog(c.mode, source, c.suggested);

    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    QCOMPARE(f.Ui().ModalCount(), (c.confirm ? 2 : 1) + static_cast<int>(c.renames.size()));
    const QString folder = f.Docs() + u"/DOC1001/"_s;
    const bool filed = !c.expected.isEmpty();
    QStringList entries = c.existing;
    for (const QString& name : c.existing) {
        QVERIFY(name == c.expected || Content(folder + name) == "old, longer");
    }
    if (filed && !entries.contains(c.expected)) {
        entries << c.expected;
    }
    entries.sort();
    QCOMPARE(FolderEntries(folder), entries);  // and no copy left half way
    QCOMPARE(archived, filed ? folder + c.expected : QString());
    QCOMPARE(Content(filed ? archived : source), QByteArray("new"));
    QCOMPARE(QFile::exists(source), !filed);
    QCOMPARE(f.Ui().Texts(), filed ? QStringList{kSaved} : QStringList());
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), filed ? 1 : 0);
    if (filed) {
        QCOMPARE(rows.first()["FULLNAME"].toString(), FullName(u"DOC1001/"_s + c.expected));
        QCOMPARE(rows.first()["SUG"].toString(), u"F"_s);
        QCOMPARE(rows.first()["PARTOF"].toInt(), c.mode == 1 ? 2 : 1);
    }
}

void TestFilingWindow::sourceThatCannotBeDeleted() {
    FilingFixture f(kServer);
    const QString source = f.Source(u"x.pdf"_s, "x");
    Unwritable keep(source);
    if (!keep.Holds()) {
        QSKIP("this file system cannot keep a file from being deleted");
    }
    QueueFilingDialog(f.Ui(), {});

    const QString archived = f.RunWithDialog(1, source, u"מסמך"_s);

    // The filing stands; the user is told the source is still there.
    QCOMPARE(archived, f.Docs() + u"/DOC1001/מסמך.pdf"_s);
    QCOMPARE(f.DocsRows().size(), 1);
    QVERIFY(QFile::exists(source));
    const QStringList texts = f.Ui().Texts();
    QCOMPARE(texts.size(), 2);
    QCOMPARE(texts.at(0), kSaved);
    QVERIFY2(texts.at(1).startsWith(u"לא ניתן היה למחוק את קובץ המקור, והוא נשאר במקומו :\r\n"_s +
                                    source + u"\r\n"_s),
             qPrintable(texts.at(1)));
}

QTEST_MAIN(TestFilingWindow)
#include "test_filing_window.moc"

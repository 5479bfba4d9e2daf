// A filing request end to end in process: the command line through Main, the filing dialog
// and the save-as dialog filled by the test, the file copied, the rows read back; on the
// file databases or, in the server build of this program, on PostgreSQL.
#include <QFile>
#include <QFileInfo>
#include <QLineEdit>
#include <QtTest>

#include "dialog_script.h"
#include "dialogs/frm_save_as.h"
#include "filing_fixture.h"
#include "sample_install/test_server.h"

using namespace zv;
using namespace zv::test;

namespace {

constexpr bool kServer = ZV_FILING_ON_SERVER;
const QString kSaved = QStringLiteral("הקובץ נשמר לכתובת המבוקשת");

}  // namespace

class TestFilingWindow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void documentFiled_data();
    void documentFiled();
    void cancelled_data();
    void cancelled();
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

void TestFilingWindow::documentFiled_data() {
    QTest::addColumn<QString>("tik");
    QTest::addColumn<QStringList>("expected");  // folder, SUG, NUM
    QTest::newRow("client") << QString() << QStringList{"DOC1001", "F", ""};
    QTest::newRow("case") << "2" << QStringList{"DOC1001/W/2", "W", "1001-2"};
}

void TestFilingWindow::documentFiled() {
    QFETCH(QString, tik);
    QFETCH(QStringList, expected);
    FilingFixture f(kServer);
    const QString source = f.Source(QStringLiteral("letter.docx"), "body");
    QueueFilingDialog(f.Ui(), {.client = QStringLiteral("1001"),
                               .tik = tik,
                               .description = QStringLiteral("חוזה"),
                               .remark = QStringLiteral("נשלח בדואר"),
                               .reminder = true,
                               .reminderTime = QStringLiteral("09:15"),
                               .popup = true});

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("מכתב: <ללקוח>"));

    const QString rel = expected[0] + QStringLiteral("/מכתב ללקוח.docx");
    QCOMPARE(archived, f.Docs() + QLatin1Char('/') + rel);
    QCOMPARE(Content(archived), QByteArray("body"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.first();
    const QMap<QString, QString> columns{
        {"FULLNAME", FullName(rel)}, {"CLIENT_NUM", "1001"}, {"SUG", expected[1]}, {"TIK", tik},
        {"NUM", expected[2]},        {"TEUR", "חוזה"},       {"PARTOF", "2"},      {"STATUS", "2"},
        {"MEMOHOUR", "09:15"}};
    for (auto it = columns.cbegin(); it != columns.cend(); ++it) {
        QCOMPARE(row[it.key()].toString(), it.value());
    }
    QVERIFY(!row["ISMEMO"].toBool());
    QVERIFY(row["BODY"].toString().endsWith(QStringLiteral(" -- נשלח בדואר")));
    const auto memos = Rows(QStringLiteral("BM"),
                            QStringLiteral("SELECT * FROM UMEMO WHERE ID=") + row["ID"].toString());
    QCOMPARE(memos.size(), 2);  // the pop-up and the regular reminder of the one handler
    for (const QVariantMap& memo : memos) {
        QCOMPARE(memo["MEMOTIME"].toDateTime(),
                 QDateTime(FilingFixture::Moment().date(), QTime(9, 15)));
    }
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::cancelled_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<bool>("confirm");
    QTest::addColumn<bool>("atSaveAs");
    QTest::newRow("filing dialog closed") << 1 << false << false;
    QTest::newRow("save-as cancelled") << 1 << true << true;
    QTest::newRow("mode 3 files nothing") << 3 << true << false;
}

void TestFilingWindow::cancelled() {
    QFETCH(int, mode);
    QFETCH(bool, confirm);
    QFETCH(bool, atSaveAs);
    FilingFixture f(kServer);
    const QString source = f.Source(QStringLiteral("scan.pdf"), "new");
    const QString existing = f.ArchiveFile(QStringLiteral("DOC1001/מכתב.pdf"), "old");
    DialogInput in{.client = QStringLiteral("1001")};
    in.confirm = confirm;
    QueueFilingDialog(f.Ui(), in);
    if (atSaveAs) {
        QueueSaveAs(f.Ui(), {}, std::nullopt, true);
    }

    QCOMPARE(f.RunWithDialog(mode, source, QStringLiteral("מכתב")), QString());

    QCOMPARE(Content(source), QByteArray("new"));
    QCOMPARE(Content(existing), QByteArray("old"));
    QCOMPARE(FolderEntries(f.Docs() + QStringLiteral("/DOC1001")), QStringList{"מכתב.pdf"});
    QVERIFY(f.DocsRows().isEmpty());
    QVERIFY(f.Ui().Texts().isEmpty());
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingWindow::filed_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("sourceName");
    QTest::addColumn<QString>("suggested");
    QTest::addColumn<QString>("typed");         // null: the proposal stays in the name box
    QTest::addColumn<QStringList>("existing");  // files already in the client's folder
    QTest::addColumn<QStringList>("renames");   // one per save-as shown; empty: keep the name
    QTest::addColumn<QString>("expected");
    const QString subject = QStringLiteral("נושא: פגישה");
    const QString none;
    QTest::newRow("clash replaced")
        << 1 << "scan.pdf"
        << "מכתב" << none << QStringList{"מכתב.pdf"} << QStringList{""} << "מכתב.pdf";
    QTest::newRow("clash renamed")
        << 1 << "scan.pdf"
        << "מכתב" << none << QStringList{"מכתב.pdf"} << QStringList{"מכתב: שני"} << "מכתב שני.pdf";
    // A new name that clashes too is asked about again, not silently replaced.
    QTest::newRow("renamed onto another file, then renamed")
        << 1 << "scan.pdf"
        << "מכתב" << none << QStringList{"מכתב.pdf", "אחר.pdf"} << QStringList{"אחר", "שלישי"}
        << "שלישי.pdf";
    QTest::newRow("source without extension")
        << 1 << "README"
        << "קרא אותי" << none << QStringList() << QStringList() << "קרא אותי";
    QTest::newRow("mail, empty name")
        << 2 << "m.msg" << subject << "" << QStringList() << QStringList() << "נושא פגישה.msg";
    QTest::newRow("mail, name differing in case only")
        << 2 << "m.msg"
        << "Meeting notes"
        << "MEETING NOTES" << QStringList() << QStringList() << "Meeting notes.msg";
    QTest::newRow("mail, name of its own")
        << 2 << "m.msg" << subject << "סיכום" << QStringList() << QStringList() << "סיכום.msg";
    QTest::newRow("mail, upper-case .MSG source")
        << 2 << "m.MSG" << subject << none << QStringList() << QStringList() << "נושא פגישה.msg";
    QTest::newRow("mail, .eml source") << 2 << "m.eml" << subject << none << QStringList()
                                       << QStringList() << "נושא פגישה.msg.eml";
    QTest::newRow("mail, name with an apostrophe")
        << 2 << "m.msg" << subject << "O'Neil" << QStringList() << QStringList() << "O'Neil.msg";
    // The earlier mail of the same subject is found under its final name and kept.
    QTest::newRow("mail, .eml clash")
        << 2 << "m.eml" << subject << none << QStringList{"נושא פגישה.msg.eml"}
        << QStringList{"נושא פגישה 2"} << "נושא פגישה 2.msg.eml";
}

void TestFilingWindow::filed() {
    QFETCH(int, mode);
    QFETCH(QString, sourceName);
    QFETCH(QString, suggested);
    QFETCH(QString, typed);
    QFETCH(QStringList, existing);
    QFETCH(QStringList, renames);
    QFETCH(QString, expected);
    FilingFixture f(kServer);
    const QString source = f.Source(sourceName, "new");
    for (const QString& name : existing) {
        f.ArchiveFile(QStringLiteral("DOC1001/") + name, "old, longer");
    }
    DialogInput in{.client = QStringLiteral("1001")};
    if (!typed.isNull()) {
        in.name = typed;
    }
    QueueFilingDialog(f.Ui(), in);
    // The save-as dialog proposes the clashing name, then each name typed before.
    QString shown = existing.isEmpty() ? QString() : QFileInfo(existing.first()).baseName();
    for (const QString& rename : renames) {
        QueueSaveAs(
            f.Ui(), [shown](FrmSaveAs& s) { QCOMPARE(s.TxtName().text(), shown); },
            rename.isEmpty() ? std::nullopt : std::optional<QString>(rename));
        shown = rename;
    }

    const QString archived = f.RunWithDialog(mode, source, suggested);

    QCOMPARE(f.Ui().ModalCount(), 2 + static_cast<int>(renames.size()));
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    const QString folder = f.Docs() + QStringLiteral("/DOC1001/");
    for (const QString& name : existing) {
        if (name != expected) {
            QCOMPARE(Content(folder + name), QByteArray("old, longer"));
        }
    }
    QCOMPARE(archived, folder + expected);
    QCOMPARE(Content(archived), QByteArray("new"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QCOMPARE(rows.first()["FULLNAME"].toString(), FullName(QStringLiteral("DOC1001/") + expected));
    QCOMPARE(rows.first()["PARTOF"].toInt(), mode == 1 ? 2 : 1);
    QCOMPARE(f.Ui().Texts(), QStringList{kSaved});
}

void TestFilingWindow::sourceThatCannotBeDeleted() {
    FilingFixture f(kServer);
    const QString source = f.Source(QStringLiteral("x.pdf"), "x");
    Unwritable keep(source);
    if (!keep.Holds()) {
        QSKIP("this file system cannot keep a file from being deleted");
    }
    QueueFilingDialog(f.Ui(), {.client = QStringLiteral("1001")});

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

QTEST_MAIN(TestFilingWindow)
#include "test_filing_window.moc"

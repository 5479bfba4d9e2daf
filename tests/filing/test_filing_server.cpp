// A filing request on an installation whose databases are on the server: once with the
// dialog in process and once through --batch.
#include <QFile>
#include <QtTest>

#include "dialog_script.h"
#include "filing_fixture.h"
#include "sample_install/test_server.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;

class TestFilingServer : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void withDialog();
    void withoutWindow();
};

void TestFilingServer::init() {
    auto options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
}

void TestFilingServer::withDialog() {
    FilingFixture f(true);
    QVERIFY(IsDocs() && IsBM() && IsOffice() && IsZorva());
    const QString source = f.Source(QStringLiteral("m.eml"), "mail");
    DialogInput in;
    in.client = QStringLiteral("1004");
    in.tik = QStringLiteral("1");
    in.name = QStringLiteral("O'Neil meeting");
    in.reminder = true;
    in.reminderTime = QStringLiteral("11:00");
    QueueFilingDialog(f.Ui(), in);

    const QString archived = f.RunWithDialog(2, source, QStringLiteral("פגישה"));

    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1004/W/1/O'Neil meeting.msg.eml"));
    QVERIFY(!QFile::exists(source));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QCOMPARE(rows.first()["FULLNAME"].toString(),
             QStringLiteral("\\DOCS\\DOC1004\\W\\1\\O'Neil meeting.msg.eml"));
    QCOMPARE(rows.first()["TIK"].toString(), QStringLiteral("1"));
    const auto memos =
        f.Rows(QStringLiteral("BM"),
               QStringLiteral("SELECT * FROM UMEMO WHERE ID=") + rows.first()["ID"].toString());
    QCOMPARE(memos.size(), 1);
    QCOMPARE(f.Ui().Texts(), QStringList{QStringLiteral("הקובץ נשמר לכתובת המבוקשת")});
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
}

void TestFilingServer::withoutWindow() {
    FilingFixture f(true);
    const QString source = f.Source(QStringLiteral("a.pdf"), "new");
    const ProcessResult r =
        f.RunProgram({"--batch", "--client", "1001", "--case", "2", "--status", "3", "--remark",
                      "נסרק", f.Request(1, source, QStringLiteral("סריקה"))});
    QCOMPARE(r.status, 0);
    const QString archived = f.Docs() + QStringLiteral("/DOC1001/W/2/סריקה.pdf");
    QCOMPARE(r.out, archived + QLatin1Char('\n'));
    QCOMPARE(Content(archived), QByteArray("new"));
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QCOMPARE(rows.first()["STATUS"].toInt(), 3);
    QCOMPARE(rows.first()["SUG"].toString(), QStringLiteral("W"));
    QVERIFY(rows.first()["BODY"].toString().endsWith(QStringLiteral(" -- נסרק")));

    // An unknown client on the server files nothing either.
    const QString second = f.Source(QStringLiteral("b.pdf"), "b");
    const ProcessResult refused =
        f.RunProgram({"--batch", "--client", "4242", f.Request(1, second, QStringLiteral("x"))});
    QCOMPARE(refused.status, 1);
    QVERIFY(QFile::exists(second));
    QCOMPARE(f.DocsRows().size(), 1);
}

QTEST_MAIN(TestFilingServer)
#include "test_filing_server.moc"

// Back-end selection on a sample installation with server databases: the flags of its MSql
// row choose, per database, the PostgreSQL test cluster or the file.

#include <QTest>

#include "data/database.h"
#include "data/recordset.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "scripted_ui.h"
#include "startup/backend_selection.h"
#include "test_env.h"
#include "util/state.h"

using namespace zv;

class TestBackendServer : public QObject {
    Q_OBJECT

  private slots:
    void flagsChooseTheServer();
};

void TestBackendServer::flagsChooseTheServer() {
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    SampleOptions options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
    options.onServerDocs = false;
    options.writeSettings = false;
    CreateSampleInstallation(env.DataDir(), options);
    SetMainPath(env.DataDir());
    SetMyUser(options.myUser);
    SetVolnaGlobNum(options.volnaGlobNum);

    GetMSSQLParam();
    QCOMPARE(Provider(), QStringLiteral("PostgreSQL"));
    QCOMPARE(DataSource(), options.serverDataSource);
    QCOMPARE(UserID(), options.serverUser);
    QVERIFY(IsOffice() && IsBM() && IsZorva());
    QVERIFY(!IsDocs());

    // Clients come from the server, the document statuses from the file.
    auto office = Database::Open(QStringLiteral("OFFICE"), IsOffice());
    QVERIFY(office->IsServer());
    auto client = office->OpenRecordset(QStringLiteral("SELECT * FROM [CLIENT] WHERE [NUM]='1003'"),
                                        dbOpenSnapshot);
    QCOMPARE(client->RecordCount(), 1);
    QCOMPARE(client->Value(QStringLiteral("L_NAME")).toString(), QStringLiteral("ג'בארה"));
    GClose(client);
    GClose(office);

    auto docs = Database::Open(QStringLiteral("MDOCS"), IsDocs());
    QVERIFY(!docs->IsServer());
    auto statuses = docs->OpenRecordset(QStringLiteral("SELECT * FROM [DOCSTATUS] ORDER BY ORD"),
                                        dbOpenSnapshot);
    QCOMPARE(statuses->RecordCount(), 4);
    GClose(statuses);
    GClose(docs);
    QCOMPARE(ui->Texts(), QStringList());
}

QTEST_MAIN(TestBackendServer)
#include "test_backend_server.moc"

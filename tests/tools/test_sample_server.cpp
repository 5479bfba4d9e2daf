// The sample installation with server databases on the PostgreSQL test cluster: the same
// rows as the files, server-made document keys. (Its settings file and MSql flags are read
// back by the filing dialog's server test.)

#include <QDir>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QTest>

#include "sample_install/sample_data.h"
#include "sample_install/sample_install.h"
#include "sample_install/sample_server.h"
#include "sample_install/test_server.h"
#include "test_env.h"

using namespace zv;

namespace {

// Every row of a table as text lines, in a fixed order, from any connection.
QStringList Rows(const QSqlDatabase& db, const SampleTable& t) {
    QSqlQuery q(db);
    if (!q.exec(QStringLiteral("SELECT %1 FROM %2").arg(t.columns.join(','), t.table)))
        return {QStringLiteral("<query failed>")};
    QStringList rows;
    while (q.next()) {
        QStringList values;
        for (int i = 0; i < t.columns.size(); ++i)
            values.append(q.value(i).isNull() ? QStringLiteral("<null>") : q.value(i).toString());
        rows.append(values.join(QLatin1Char('|')));
    }
    rows.sort();
    return rows;
}

}  // namespace

class TestSampleServer : public QObject {
    Q_OBJECT

  private slots:
    void serverHoldsTheFileRowsAndAssignsKeys();
};

// The connections stay until the program ends, which is right after this test.
void TestSampleServer::serverHoldsTheFileRowsAndAssignsKeys() {
    test::TestEnv env;
    SampleOptions options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
    options.clients = 300;
    options.lookfor = 1500;
    CreateSampleInstallation(env.DataDir(), options);
    QSqlDatabase file =
        QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), QStringLiteral("file"));
    for (const SampleTable& t : SampleData::Tables()) {
        if (!ServerDatabaseNames().contains(t.database))
            continue;
        file.close();
        file.setDatabaseName(QDir(env.DataDir()).filePath(t.database + QStringLiteral(".MDB")));
        QVERIFY(file.open());
        const QStringList fileRows = Rows(file, t);
        QVERIFY2(fileRows.size() > 1, qPrintable(t.table));
        QCOMPARE(Rows(ConnectSampleServer(options, t.database + options.volnaGlobNum,
                                          t.database + t.table),
                      t),
                 fileRows);
    }

    // Document keys are taken by the server, and a repeated path is allowed.
    QSqlQuery q(ConnectSampleServer(options, QStringLiteral("MDOCS") + options.volnaGlobNum,
                                    QStringLiteral("keys")));
    for (int expected : {1, 2}) {
        QVERIFY(
            q.exec(QStringLiteral("INSERT INTO DOCS (FULLNAME) VALUES ('\\a.doc') RETURNING ID")));
        QVERIFY(q.next());
        QCOMPARE(q.value(0).toInt(), expected);
    }
}

QTEST_MAIN(TestSampleServer)
#include "test_sample_server.moc"

// The sample installation with server databases on the PostgreSQL test cluster: the same
// rows as the files, the settings file and the MSql flags, server-made document keys.

#include <QDir>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QSqlRecord>
#include <QTest>
#include <QUuid>

#include "sample_install/sample_data.h"
#include "sample_install/sample_install.h"
#include "sample_install/sample_server.h"
#include "sample_install/test_server.h"
#include "test_env.h"
#include "util/ini_reader.h"

using namespace zv;

namespace {

// Every row of a table as text lines, in a fixed order, from any connection.
QStringList Rows(QSqlDatabase db, const SampleTable& t) {
    QSqlQuery q(db);
    const QString columns = t.columns.join(',');
    if (!q.exec(QStringLiteral("SELECT %1 FROM %2").arg(columns, t.table)))
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

class Connection {
  public:
    explicit Connection(const SampleOptions& o, const QString& database)
        : name_(QUuid::createUuid().toString()), db_(ConnectSampleServer(o, database, name_)) {}
    Connection(const QString& file) : name_(QUuid::createUuid().toString()) {
        db_ = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name_);
        db_.setDatabaseName(file);
        db_.open();
    }
    ~Connection() {
        db_.close();
        db_ = QSqlDatabase();
        QSqlDatabase::removeDatabase(name_);
    }
    QSqlDatabase db() const { return db_; }

  private:
    QString name_;
    QSqlDatabase db_;
};

}  // namespace

class TestSampleServer : public QObject {
    Q_OBJECT

  private slots:
    void serverHoldsTheFileRows();
    void settingsFileAndFlags_data();
    void settingsFileAndFlags();
    void serverAssignsDocumentKeys();
};

void TestSampleServer::serverHoldsTheFileRows() {
    test::TestEnv env;
    SampleOptions options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
    options.clients = 300;
    options.lookfor = 1500;
    CreateSampleInstallation(env.DataDir(), options);
    int compared = 0;
    for (const SampleTable& t : SampleData::Tables()) {
        if (!ServerDatabaseNames().contains(t.database))
            continue;
        Connection file(QDir(env.DataDir()).filePath(t.database + QStringLiteral(".MDB")));
        Connection server(options, t.database + options.volnaGlobNum);
        const QStringList fileRows = Rows(file.db(), t);
        QVERIFY2(fileRows.size() > 1, qPrintable(t.table));
        QCOMPARE(Rows(server.db(), t), fileRows);
        ++compared;
    }
    QCOMPARE(compared, 5);
}

void TestSampleServer::settingsFileAndFlags_data() {
    QTest::addColumn<bool>("office");
    QTest::addColumn<bool>("docs");
    QTest::addColumn<QString>("flags");
    QTest::newRow("all on the server") << true << true << "1|1|1|1";
    QTest::newRow("clients on the server, documents in the file") << true << false << "0|1|1|1";
}

void TestSampleServer::settingsFileAndFlags() {
    QFETCH(bool, office);
    QFETCH(bool, docs);
    QFETCH(QString, flags);
    test::TestEnv env;
    SampleOptions options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
    options.onServerOffice = office;
    options.onServerDocs = docs;
    CreateSampleInstallation(env.DataDir(), options);

    const QString ini = QDir(env.DataDir()).filePath(QStringLiteral("Def/MSSQLSetting.INI"));
    QCOMPARE(ReadINI(QStringLiteral("MSSQL"), QStringLiteral("Provider"), ini),
             QStringLiteral("PostgreSQL"));
    QCOMPARE(ReadINI(QStringLiteral("MSSQL"), QStringLiteral("DataSource"), ini),
             options.serverDataSource);
    QCOMPARE(ReadINI(QStringLiteral("000"), QStringLiteral("UserID"), ini), options.serverUser);

    Connection main(QDir(env.DataDir()).filePath(QStringLiteral("MAIN.MDB")));
    QSqlQuery q(main.db());
    q.prepare(QStringLiteral("SELECT IsDocs, IsBM, IsOffice, IsZorva FROM MSql WHERE ClientID=?"));
    q.addBindValue(options.volnaGlobNum);
    QVERIFY(q.exec() && q.next());
    QStringList read;
    for (int i = 0; i < 4; ++i)
        read.append(q.value(i).toString());
    QCOMPARE(read.join(QLatin1Char('|')), flags);
}

void TestSampleServer::serverAssignsDocumentKeys() {
    test::TestEnv env;
    SampleOptions options = TestServerOptions();
    ZV_REQUIRE_TEST_SERVER(options);
    CreateSampleInstallation(env.DataDir(), options);
    Connection docs(options, QStringLiteral("MDOCS") + options.volnaGlobNum);
    QSqlQuery q(docs.db());
    for (int expected : {1, 2}) {
        QVERIFY(
            q.exec(QStringLiteral("INSERT INTO DOCS (FULLNAME) VALUES ('\\a.doc') RETURNING ID")));
        QVERIFY(q.next());
        QCOMPARE(q.value(0).toInt(), expected);
    }
    // Keys are taken by the server, and a repeated path is allowed.
    QVERIFY(q.exec(QStringLiteral("SELECT count(DISTINCT ID) FROM DOCS WHERE FULLNAME='\\a.doc'")));
    QVERIFY(q.next());
    QCOMPARE(q.value(0).toInt(), 2);
}

QTEST_MAIN(TestSampleServer)
#include "test_sample_server.moc"

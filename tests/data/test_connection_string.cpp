// The server connection string, its mapping onto Qt drivers, and the PostgreSQL rewrites
// of the suite's T-SQL texts.
#include <QtTest>

#include "data/connection_string.h"
#include "data/pg_dialect.h"
#include "test_env.h"
#include "util/errors.h"
#include "util/state.h"

using namespace zv;

class TestConnectionString : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void build_data();
    void build();
    void parseSqlServer_data();
    void parseSqlServer();
    void odbcDriverFromEnvironment();
    void parsePostgres_data();
    void parsePostgres();
    void roundTripOfQuotedValues_data();
    void roundTripOfQuotedValues();
    void unknownProvider();
    void adapter_data();
    void adapter();
};

void TestConnectionString::build_data() {
    QTest::addColumn<QString>("provider");
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("expected");
    QTest::newRow("with password")
        << "SQLOLEDB"
        << "srv\\SQL2019"
        << "sa"
        << "secret"
        << "Provider=SQLOLEDB;Data Source=srv\\SQL2019;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=sa;Password=secret;";
    QTest::newRow("empty password: no Password pair")
        << "SQLNCLI11"
        << "srv"
        << "sa"
        << ""
        << "Provider=SQLNCLI11;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;User ID=sa;";
    QTest::newRow("password with ; is quoted")
        << "SQLOLEDB"
        << "srv"
        << "sa"
        << "a;b"
        << "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=sa;Password=\"a;b\";";
    QTest::newRow("leading blank is quoted")
        << "SQLOLEDB"
        << "srv"
        << " sa"
        << "x"
        << "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=\" sa\";Password=x;";
    QTest::newRow("leading double quote in single quotes")
        << "SQLOLEDB"
        << "srv"
        << "sa"
        << "\"pw"
        << "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=sa;Password='\"pw';";
    QTest::newRow("both quotes: doubled double quotes")
        << "SQLOLEDB"
        << "srv"
        << "sa"
        << "'a\";"
        << "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=sa;Password=\"'a\"\";\";";
    QTest::newRow("other specials stay as stored")
        << "SQLOLEDB"
        << "srv"
        << "sa"
        << "p=w'x\"y"
        << "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
           "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;"
           "User ID=sa;Password=p=w'x\"y;";
}

void TestConnectionString::build() {
    QFETCH(QString, provider);
    QFETCH(QString, dataSource);
    QFETCH(QString, user);
    QFETCH(QString, password);
    QFETCH(QString, expected);
    test::TestEnv env;
    SetProvider(provider);
    SetDataSource(dataSource);
    SetUserID(user);
    SetPassWord(password);
    SetVolnaGlobNum(QStringLiteral("23"));
    QCOMPARE(GetConnectionByDbName(QStringLiteral("MDOCS")), expected);
}

void TestConnectionString::parseSqlServer_data() {
    QTest::addColumn<QString>("provider");
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("odbc");
    QTest::newRow("SQLOLEDB host") << "SQLOLEDB"
                                   << "db1"
                                   << "DRIVER={FreeTDS};SERVER=db1;DATABASE=OFFICE7;UID=sa;"
                                      "PWD={a;b};";
    QTest::newRow("SQLNCLI11 host,port")
        << "SQLNCLI11"
        << "db1,1444"
        << "DRIVER={FreeTDS};SERVER=db1;PORT=1444;DATABASE=OFFICE7;UID=sa;PWD={a;b};";
    QTest::newRow("MSOLEDBSQL19 named instance")
        << "MSOLEDBSQL19"
        << "db1\\SQLEXPRESS"
        << "DRIVER={FreeTDS};SERVER=db1\\SQLEXPRESS;DATABASE=OFFICE7;UID=sa;PWD={a;b};";
    QTest::newRow("SQLOLEDB.1") << "SQLOLEDB.1"
                                << "db1"
                                << "DRIVER={FreeTDS};SERVER=db1;DATABASE=OFFICE7;UID=sa;"
                                   "PWD={a;b};";
}

void TestConnectionString::parseSqlServer() {
    QFETCH(QString, provider);
    QFETCH(QString, dataSource);
    QFETCH(QString, odbc);
    test::TestEnv env;
    qunsetenv("ZORVANE_ODBC_DRIVER");
    SetProvider(provider);
    SetDataSource(dataSource);
    SetUserID(QStringLiteral("sa"));
    SetPassWord(QStringLiteral("a;b"));
    SetVolnaGlobNum(QStringLiteral("7"));
    const ServerConnectionParams p =
        ParseConnectionString(GetConnectionByDbName(QStringLiteral("OFFICE")));
    QCOMPARE(p.driver, QStringLiteral("QODBC"));
    QCOMPARE(p.database, QStringLiteral("OFFICE7"));
    QCOMPARE(p.password, QStringLiteral("a;b"));
    QCOMPARE(p.connectTimeout, 30);
    QCOMPARE(p.odbcConnectionString, odbc);
}

void TestConnectionString::odbcDriverFromEnvironment() {
    test::TestEnv env;
    qputenv("ZORVANE_ODBC_DRIVER", "ODBC Driver 18 for SQL Server");
    const ServerConnectionParams p = ParseConnectionString(QStringLiteral(
        "Provider=SQLOLEDB;Data Source=db1,1444;Initial Catalog=BM5;MARS Connection=True;"
        "Connect Timeout=30;User ID=u;"));
    qunsetenv("ZORVANE_ODBC_DRIVER");
    QCOMPARE(p.odbcConnectionString,
             QStringLiteral("DRIVER={ODBC Driver 18 for SQL Server};SERVER=db1,1444;"
                            "MARS_Connection=yes;DATABASE=BM5;UID=u;PWD=;"));
}

void TestConnectionString::parsePostgres_data() {
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("host");
    QTest::addColumn<int>("port");
    QTest::newRow("host") << "pg.local"
                          << "pg.local" << -1;
    QTest::newRow("host,port") << "pg.local,5433"
                               << "pg.local" << 5433;
    QTest::newRow("socket folder") << "/run/postgresql"
                                   << "/run/postgresql" << -1;
    QTest::newRow("socket folder,port") << "/tmp/pg x,55432"
                                        << "/tmp/pg x" << 55432;
}

void TestConnectionString::parsePostgres() {
    QFETCH(QString, dataSource);
    QFETCH(QString, host);
    QFETCH(int, port);
    test::TestEnv env;
    SetProvider(QStringLiteral("PostgreSQL"));
    SetDataSource(dataSource);
    SetUserID(QStringLiteral("postgres"));
    SetVolnaGlobNum(QStringLiteral("23"));
    const ServerConnectionParams p =
        ParseConnectionString(GetConnectionByDbName(QStringLiteral("ZORVA")));
    QCOMPARE(p.driver, QStringLiteral("QPSQL"));
    QCOMPARE(p.host, host);
    QCOMPARE(p.port, port);
    QCOMPARE(p.database, QStringLiteral("ZORVA23"));
    QCOMPARE(p.user, QStringLiteral("postgres"));
    QCOMPARE(p.password, QString());
    QCOMPARE(p.connectTimeout, 30);
}

void TestConnectionString::roundTripOfQuotedValues_data() {
    QTest::addColumn<QString>("password");
    QTest::newRow("semicolon") << "a;b";
    QTest::newRow("leading blank") << " pw";
    QTest::newRow("trailing blank") << "pw ";
    QTest::newRow("leading tab") << "\tpw";
    QTest::newRow("leading double quote") << "\"pw;";
    QTest::newRow("leading apostrophe") << "'pw";
    QTest::newRow("both quotes") << "'x\";y\"";
    QTest::newRow("plain with equals") << "a=b";
}

void TestConnectionString::roundTripOfQuotedValues() {
    QFETCH(QString, password);
    test::TestEnv env;
    SetProvider(QStringLiteral("PostgreSQL"));
    SetDataSource(QStringLiteral("h"));
    SetUserID(QStringLiteral("u"));
    SetPassWord(password);
    const ServerConnectionParams p =
        ParseConnectionString(GetConnectionByDbName(QStringLiteral("BM")));
    QCOMPARE(p.password, password);
    QCOMPARE(p.user, QStringLiteral("u"));
}

void TestConnectionString::unknownProvider() {
    try {
        ParseConnectionString(QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=x;"));
        QFAIL("accepted");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), 3706L);
    }
}

void TestConnectionString::adapter_data() {
    QTest::addColumn<QString>("tsql");
    QTest::addColumn<QString>("expected");
    QTest::newRow("USE") << "USE MDOCS23"
                         << "DO $zv$BEGIN IF current_database() <> 'MDOCS23' THEN RAISE "
                            "EXCEPTION '%', 'Database ''MDOCS23'' is not the database of this "
                            "connection.'; END IF; END$zv$";
    QTest::newRow("DOCS by path") << "SELECT * FROM DOCS WHERE [FullName]='\\DOCS\\[1]\\a''b.doc'"
                                  << "SELECT * FROM DOCS WHERE FullName='\\DOCS\\[1]\\a''b.doc'";
    QTest::newRow("UMEMO delete")
        << "DELETE FROM UMEMO WHERE ([MTYPE]=31 OR [MTYPE]=32) AND [ID]=1234"
        << "DELETE FROM UMEMO WHERE (MTYPE=31 OR MTYPE=32) AND ID=1234";
    QTest::newRow("UMEMO empty") << "SELECT * FROM UMEMO WHERE 1=0"
                                 << "SELECT * FROM UMEMO WHERE 1=0";
    QTest::newRow("MTIK") << "SELECT * FROM [MTIK] WHERE [SHOW]=1 ORDER BY [ID]"
                          << "SELECT * FROM MTIK WHERE SHOW=1 ORDER BY ID";
    QTest::newRow("OFF_CODE") << "SELECT * FROM [OFF_CODE] WHERE [CODE]=20 ORDER BY [NUM]"
                              << "SELECT * FROM OFF_CODE WHERE CODE=20 ORDER BY NUM";
    QTest::newRow("DOCSTATUS") << "SELECT * FROM [DOCSTATUS] ORDER BY ORD"
                               << "SELECT * FROM DOCSTATUS ORDER BY ORD";
    QTest::newRow("CLIENT by number") << "SELECT * FROM [CLIENT] WHERE [NUM]='O''Neil'"
                                      << "SELECT * FROM CLIENT WHERE NUM='O''Neil'";
    QTest::newRow("CLIENT list") << "SELECT * FROM [CLIENT] ORDER BY NUM"
                                 << "SELECT * FROM CLIENT ORDER BY NUM";
    QTest::newRow("CLIENT search")
        << "SELECT * FROM [CLIENT] WHERE [NUM] LIKE '%a[b]%' OR [F_NAME] LIKE '%a[b]%' OR "
           "[L_NAME] LIKE '%a[b]%' OR [TELEFON] LIKE '%a[b]%' ORDER BY NUM"
        << "SELECT * FROM CLIENT WHERE NUM::text ILIKE '%a[b]%' OR F_NAME::text ILIKE "
           "'%a[b]%' OR L_NAME::text ILIKE '%a[b]%' OR TELEFON::text ILIKE '%a[b]%' ORDER BY "
           "NUM";
    QTest::newRow("LOOKFOR empty") << "SELECT * FROM [LOOKFOR] WHERE 1=0"
                                   << "SELECT * FROM LOOKFOR WHERE 1=0";
    QTest::newRow("LOOKFOR client search")
        << "SELECT * FROM [LOOKFOR] WHERE [LakNum]='12' AND [OptKey] IN (1,2,3,4,5,6,10,11) AND "
           "([F_NAME] LIKE '%x%' OR [L_NAME] LIKE '%x%' OR [TELEFON] LIKE '%x%' OR [TIK] LIKE "
           "'%x%') ORDER BY OptKey, Tik"
        << "SELECT * FROM LOOKFOR WHERE LakNum='12' AND OptKey IN (1,2,3,4,5,6,10,11) AND "
           "(F_NAME::text ILIKE '%x%' OR L_NAME::text ILIKE '%x%' OR TELEFON::text ILIKE '%x%' "
           "OR TIK::text ILIKE '%x%') ORDER BY OptKey, Tik";
    QTest::newRow("LOOKFOR all search")
        << "SELECT * FROM [LOOKFOR] WHERE [OptKey] IN (0,1,2,3,4,5,6,10,11) AND [F_NAME] LIKE "
           "'%x%' OR [L_NAME] LIKE '%x%' ORDER BY OptKey, Tik"
        << "SELECT * FROM LOOKFOR WHERE OptKey IN (0,1,2,3,4,5,6,10,11) AND F_NAME::text "
           "ILIKE '%x%' OR L_NAME::text ILIKE '%x%' ORDER BY OptKey, Tik";
    QTest::newRow("LOOKFOR client")
        << "SELECT * FROM [LOOKFOR] WHERE [LakNum]='12' AND [OptKey] IN (1,2,3,4,5,6,10,11) "
           "ORDER BY OptKey, Tik"
        << "SELECT * FROM LOOKFOR WHERE LakNum='12' AND OptKey IN (1,2,3,4,5,6,10,11) ORDER BY "
           "OptKey, Tik";
    QTest::newRow("LOOKFOR all")
        << "SELECT * FROM [LOOKFOR] WHERE [OptKey] IN (0,1,2,3,4,5,6,10,11) ORDER BY OptKey, "
           "LakNum"
        << "SELECT * FROM LOOKFOR WHERE OptKey IN (0,1,2,3,4,5,6,10,11) ORDER BY OptKey, LakNum";
    QTest::newRow("reposition with doubled blanks")
        << "SELECT TOP 1 *  FROM [DOCS]  ORDER BY ID DESC"
        << "SELECT *  FROM DOCS  ORDER BY ID DESC LIMIT 1";
    QTest::newRow("NOT LIKE, literal LIKE untouched")
        << "SELECT * FROM T WHERE [A] NOT LIKE 'LIKE [x]'"
        << "SELECT * FROM T WHERE A::text NOT ILIKE 'LIKE [x]'";
    QTest::newRow("word containing LIKE") << "SELECT LIKES FROM T"
                                          << "SELECT LIKES FROM T";
    QTest::newRow("odd identifier") << "SELECT [My Col] FROM T"
                                    << "SELECT \"my col\" FROM T";
}

void TestConnectionString::adapter() {
    QFETCH(QString, tsql);
    QFETCH(QString, expected);
    QCOMPARE(AdaptForPostgres(tsql), expected);
}

QTEST_MAIN(TestConnectionString)
#include "test_connection_string.moc"

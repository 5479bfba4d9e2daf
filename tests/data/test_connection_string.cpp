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
    void unknownProvider();
    void adapter_data();
    void adapter();
};

// After "Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;" and the fixed pairs.
void TestConnectionString::build_data() {
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* user, const char* password,
                        const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(user) << QString::fromLatin1(password)
                            << QString::fromLatin1(expected);
    };
    row("with password", "sa", "secret", "User ID=sa;Password=secret;");
    row("empty password: no Password pair", "sa", "", "User ID=sa;");
    row("password with ; is quoted", "sa", "a;b", "User ID=sa;Password=\"a;b\";");
    row("leading blank is quoted", " sa", "x", "User ID=\" sa\";Password=x;");
    row("leading double quote in single quotes", "sa", "\"pw", "User ID=sa;Password='\"pw';");
    row("both quotes: doubled double quotes", "sa", "'a\";", "User ID=sa;Password=\"'a\"\";\";");
    row("other specials stay as stored", "sa", "p=w'x\"y", "User ID=sa;Password=p=w'x\"y;");
}

void TestConnectionString::build() {
    QFETCH(QString, user);
    QFETCH(QString, password);
    QFETCH(QString, expected);
    test::TestEnv env;
    SetProvider(QStringLiteral("SQLOLEDB"));
    SetDataSource(QStringLiteral("srv"));
    SetUserID(user);
    SetPassWord(password);
    SetVolnaGlobNum(QStringLiteral("23"));
    QCOMPARE(GetConnectionByDbName(QStringLiteral("MDOCS")),
             QStringLiteral("Provider=SQLOLEDB;Data Source=srv;Initial Catalog=MDOCS23;"
                            "MARS Connection=True;Connect Timeout=30;DataTypeCompatibility=80;") +
                 expected);
}

// Each provider of SQL Server maps onto ODBC the same way; the password survives quoting.
void TestConnectionString::parseSqlServer_data() {
    QTest::addColumn<QString>("provider");
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("server");
    const auto row = [](const char* provider, const char* dataSource, const char* server) {
        QTest::newRow(provider) << QString::fromLatin1(provider) << QString::fromLatin1(dataSource)
                                << QString::fromLatin1(server);
    };
    row("SQLOLEDB", "db1", "SERVER=db1");
    row("SQLNCLI11", "db1,1444", "SERVER=db1;PORT=1444");
    row("MSOLEDBSQL19", "db1\\SQLEXPRESS", "SERVER=db1\\SQLEXPRESS");
    row("SQLOLEDB.1", "db1", "SERVER=db1");
}

void TestConnectionString::parseSqlServer() {
    QFETCH(QString, provider);
    QFETCH(QString, dataSource);
    QFETCH(QString, server);
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
    QCOMPARE(p.connectTimeout, 30);
    QCOMPARE(p.odbcConnectionString, QStringLiteral("DRIVER={FreeTDS};") + server +
                                         QStringLiteral(";DATABASE=OFFICE7;UID=sa;PWD={a;b};"));
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

// The host, port and password the PostgreSQL driver is given.
void TestConnectionString::parsePostgres_data() {
    QTest::addColumn<QString>("dataSource");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* dataSource, const char* password,
                        const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(dataSource) << QString::fromLatin1(password)
                            << QString::fromLatin1(expected);
    };
    row("host", "pg.local", "", "pg.local|-1|");
    row("host,port", "pg.local,5433", "a;b", "pg.local|5433|a;b");
    row("socket folder", "/run/postgresql", " pw", "/run/postgresql|-1| pw");
    row("socket folder,port", "/tmp/pg x,55432", "pw ", "/tmp/pg x|55432|pw ");
    row("leading tab", "h", "\tpw", "h|-1|\tpw");
    row("leading double quote", "h", "\"pw;", "h|-1|\"pw;");
    row("leading apostrophe", "h", "'pw", "h|-1|'pw");
    row("both quotes", "h", "'x\";y\"", "h|-1|'x\";y\"");
}

void TestConnectionString::parsePostgres() {
    QFETCH(QString, dataSource);
    QFETCH(QString, password);
    QFETCH(QString, expected);
    test::TestEnv env;
    SetProvider(QStringLiteral("PostgreSQL"));
    SetDataSource(dataSource);
    SetUserID(QStringLiteral("postgres"));
    SetPassWord(password);
    SetVolnaGlobNum(QStringLiteral("23"));
    const ServerConnectionParams p =
        ParseConnectionString(GetConnectionByDbName(QStringLiteral("ZORVA")));
    QCOMPARE(p.driver, QStringLiteral("QPSQL"));
    QCOMPARE(QStringLiteral("%1|%2|%3").arg(p.host).arg(p.port).arg(p.password), expected);
    QCOMPARE(p.database, QStringLiteral("ZORVA23"));
    QCOMPARE(p.user, QStringLiteral("postgres"));
}

void TestConnectionString::unknownProvider() {
    try {
        ParseConnectionString(QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=x;"));
        QFAIL("accepted");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), 3706L);
    }
}

// The server test runs every text of the suite through the rewrite on a real server; these
// are the rewrites whose exact form matters.
void TestConnectionString::adapter_data() {
    QTest::addColumn<QString>("tsql");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* tsql, const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(tsql) << QString::fromLatin1(expected);
    };
    row("USE", "USE MDOCS23",
        "DO $zv$BEGIN IF current_database() <> 'MDOCS23' THEN RAISE "
        "EXCEPTION '%', 'Database ''MDOCS23'' is not the database of this "
        "connection.'; END IF; END$zv$");
    row("DOCS by path", "SELECT * FROM DOCS WHERE [FullName]='\\DOCS\\[1]\\a''b.doc'",
        "SELECT * FROM DOCS WHERE FullName='\\DOCS\\[1]\\a''b.doc'");
    row("CLIENT search",
        "SELECT * FROM [CLIENT] WHERE [NUM] LIKE '%a[b]%' OR [F_NAME] LIKE '%a[b]%' OR "
        "[L_NAME] LIKE '%a[b]%' OR [TELEFON] LIKE '%a[b]%' ORDER BY NUM",
        "SELECT * FROM CLIENT WHERE NUM::text ILIKE '%a[b]%' OR F_NAME::text ILIKE "
        "'%a[b]%' OR L_NAME::text ILIKE '%a[b]%' OR TELEFON::text ILIKE '%a[b]%' ORDER BY "
        "NUM");
    row("reposition with doubled blanks", "SELECT TOP 1 *  FROM [DOCS]  ORDER BY ID DESC",
        "SELECT *  FROM DOCS  ORDER BY ID DESC LIMIT 1");
    row("NOT LIKE, literal LIKE untouched", "SELECT * FROM T WHERE [A] NOT LIKE 'LIKE [x]'",
        "SELECT * FROM T WHERE A::text NOT ILIKE 'LIKE [x]'");
    row("word containing LIKE", "SELECT LIKES FROM T", "SELECT LIKES FROM T");
    row("odd identifier", "SELECT [My Col] FROM T", "SELECT \"my col\" FROM T");
}

void TestConnectionString::adapter() {
    QFETCH(QString, tsql);
    QFETCH(QString, expected);
    QCOMPARE(AdaptForPostgres(tsql), expected);
}

QTEST_MAIN(TestConnectionString)
#include "test_connection_string.moc"

// The server connection string, its mapping onto Qt drivers, and the PostgreSQL rewrites
// of the suite's T-SQL texts.
#include <QtTest>

#include "data/connection_string.h"
#include "data/pg_dialect.h"
#include "error_of.h"
#include "util/state.h"

using namespace zv;

namespace {

QString ConnectionOf(const char* provider, const char* dataSource, const char* user,
                     const char* password) {
    SetProvider(QString::fromLatin1(provider));
    SetDataSource(QString::fromLatin1(dataSource));
    SetUserID(QString::fromLatin1(user));
    SetPassWord(QString::fromLatin1(password));
    SetVolnaGlobNum(QStringLiteral("23"));
    return GetConnectionByDbName(QStringLiteral("ZORVA"));
}

}  // namespace

class TestConnectionString : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    // Written from the settings and read back: a value is quoted when it holds ";", begins
    // with a quote or has blanks around it, in the quotes it does not hold (double ones
    // doubled when it holds both); no Password pair when there is none. The PostgreSQL
    // driver gets the host and port of the data source and the login as it was.
    void postgres() {
        const struct {
            const char* dataSource;
            const char* user;
            const char* password;
            const char* login;  // the pairs after the fixed ones
            const char* hostPort;
        } cases[] = {
            {"pg.local,5433", "sa", "", "User ID=sa;", "pg.local|5433"},
            {"/run/postgresql", "sa", "a;b", "User ID=sa;Password=\"a;b\";", "/run/postgresql|-1"},
            {"/tmp/pg x,55432", " sa", "pw ", "User ID=\" sa\";Password=\"pw \";",
             "/tmp/pg x|55432"},
            {"h", "sa", "\"pw;", "User ID=sa;Password='\"pw;';", "h|-1"},
            {"h", "sa", "'a\";", "User ID=sa;Password=\"'a\"\";\";", "h|-1"},
            {"h", "sa", "p=w'x\"y", "User ID=sa;Password=p=w'x\"y;", "h|-1"},
        };
        for (const auto& c : cases) {
            const QString text = ConnectionOf("PostgreSQL", c.dataSource, c.user, c.password);
            QCOMPARE(text, QStringLiteral("Provider=PostgreSQL;Data Source=%1;Initial "
                                          "Catalog=ZORVA23;MARS Connection=True;Connect "
                                          "Timeout=30;DataTypeCompatibility=80;%2")
                               .arg(QLatin1String(c.dataSource), QLatin1String(c.login)));
            const ServerConnectionParams p = ParseConnectionString(text);
            QCOMPARE(QStringList({p.driver, p.host, QString::number(p.port), p.database, p.user,
                                  p.password})
                         .join(QLatin1Char('|')),
                     QStringLiteral("QPSQL|%1|ZORVA23|%2|%3")
                         .arg(QLatin1String(c.hostPort), QLatin1String(c.user),
                              QLatin1String(c.password)));
        }
    }

    // Each provider of SQL Server maps onto ODBC: FreeTDS takes the port as a key of its own,
    // a driver named in ZORVANE_ODBC_DRIVER takes "host,port" and MARS. Any other provider
    // is refused.
    void sqlServer() {
        const struct {
            const char* provider;
            const char* dataSource;
            const char* driver;
            const char* server;
        } cases[] = {
            {"SQLOLEDB", "db1", "", "DRIVER={FreeTDS};SERVER=db1;"},
            {"SQLNCLI11", "db1,1444", "", "DRIVER={FreeTDS};SERVER=db1;PORT=1444;"},
            {"MSOLEDBSQL19", "db1\\SQLEXPRESS", "", "DRIVER={FreeTDS};SERVER=db1\\SQLEXPRESS;"},
            {"SQLOLEDB.1", "db1", "", "DRIVER={FreeTDS};SERVER=db1;"},
            {"SQLOLEDB", "db1,1444", "ODBC Driver 18 for SQL Server",
             "DRIVER={ODBC Driver 18 for SQL Server};SERVER=db1,1444;MARS_Connection=yes;"},
        };
        for (const auto& c : cases) {
            qputenv("ZORVANE_ODBC_DRIVER", c.driver);
            const ServerConnectionParams p =
                ParseConnectionString(ConnectionOf(c.provider, c.dataSource, "sa", "a;b"));
            qunsetenv("ZORVANE_ODBC_DRIVER");
            QCOMPARE(p.driver, QStringLiteral("QODBC"));
            QCOMPARE(p.connectTimeout, 30);
            QCOMPARE(
                p.odbcConnectionString,
                QLatin1String(c.server) + QStringLiteral("DATABASE=ZORVA23;UID=sa;PWD={a;b};"));
        }
        QCOMPARE(test::ErrorOf([] {
                     ParseConnectionString(QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;"));
                 }),
                 3706L);
    }

    // The server tests run the suite's texts on a real server; these are the rewrites whose
    // exact form matters.
    void adapter() {
        const struct {
            const char* tsql;
            const char* expected;
        } cases[] = {
            {"USE MDOCS23",
             "DO $zv$BEGIN IF current_database() <> 'MDOCS23' THEN RAISE EXCEPTION '%', "
             "'Database ''MDOCS23'' is not the database of this connection.'; END IF; END$zv$"},
            {"SELECT * FROM DOCS WHERE [FullName]='\\DOCS\\[1]\\a''b.doc'",
             "SELECT * FROM DOCS WHERE FullName='\\DOCS\\[1]\\a''b.doc'"},
            {"SELECT * FROM [CLIENT] WHERE [NUM] LIKE '%a[b]%' OR [F_NAME] LIKE '%a[b]%'",
             "SELECT * FROM CLIENT WHERE NUM::text ILIKE '%a[b]%' OR F_NAME::text ILIKE '%a[b]%'"},
            {"SELECT TOP 1 *  FROM [DOCS]  ORDER BY ID DESC",
             "SELECT *  FROM DOCS  ORDER BY ID DESC LIMIT 1"},
            {"SELECT * FROM T WHERE [A] NOT LIKE 'LIKE [x]'",
             "SELECT * FROM T WHERE A::text NOT ILIKE 'LIKE [x]'"},
            {"SELECT LIKES FROM T", "SELECT LIKES FROM T"},
            {"SELECT [My Col] FROM T", "SELECT \"my col\" FROM T"},
        };
        for (const auto& c : cases) {
            QCOMPARE(AdaptForPostgres(QString::fromLatin1(c.tsql)),
                     QString::fromLatin1(c.expected));
        }
    }
};

QTEST_MAIN(TestConnectionString)
#include "test_connection_string.moc"

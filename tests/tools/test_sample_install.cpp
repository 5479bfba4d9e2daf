// The sample installation on file databases, checked with the sqlite3 shell, and the
// schema files of the three engines kept in step.

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QRegularExpression>
#include <QTest>

#include "sample_install/sample_install.h"
#include "sample_install/schema_script.h"
#include "test_env.h"
#include "util/settings_store.h"

using namespace zv;

namespace {

// Runs the sqlite3 shell on a database file; returns its standard output, trimmed.
QString Sqlite3(const QString& file, const QString& command) {
    QProcess p;
    p.start(QStringLiteral("sqlite3"), {QStringLiteral("-bail"), file, command});
    if (!p.waitForFinished(30000) || p.exitStatus() != QProcess::NormalExit || p.exitCode() != 0)
        return QStringLiteral("<error> ") + QString::fromUtf8(p.readAllStandardError()).trimmed();
    return QString::fromUtf8(p.readAllStandardOutput()).trimmed();
}

// Runs the installation tool on a folder; returns its exit code and standard error.
QPair<int, QByteArray> RunInstaller(const QString& dir, const QStringList& arguments) {
    QProcess p;
    p.start(QStringLiteral(ZV_SAMPLE_INSTALL_PROGRAM), QStringList{dir} + arguments);
    if (!p.waitForFinished(60000))
        return {-1, "did not finish"};
    return {p.exitCode(), p.readAllStandardError()};
}

QString Db(const QString& dir, const QString& name) {
    return QDir(dir).filePath(name + QStringLiteral(".MDB"));
}

// Table name -> column names (lower case), from the CREATE TABLE statements of a section.
QMap<QString, QStringList> TablesOf(const QStringList& statements) {
    static const QRegularExpression create(QStringLiteral(R"(^CREATE TABLE (\w+) \((.*)\)$)"),
                                           QRegularExpression::DotMatchesEverythingOption);
    QMap<QString, QStringList> tables;
    for (const QString& s : statements) {
        const auto m = create.match(s);
        if (!m.hasMatch())
            continue;
        QStringList columns;
        for (const QString& line : m.captured(2).split(QLatin1Char('\n'))) {
            const QString first = line.trimmed().section(QLatin1Char(' '), 0, 0);
            if (!first.isEmpty() && first != QLatin1String("PRIMARY"))
                columns.append(first.toLower());
        }
        tables.insert(m.captured(1).toUpper(), columns);
    }
    return tables;
}

QList<SchemaSection> SchemaFile(const QString& engine) {
    QFile f(QStringLiteral(ZV_SCHEMA_DIR "/%1.sql").arg(engine));
    if (!f.open(QIODevice::ReadOnly))
        return {};
    return ParseSchema(QString::fromUtf8(f.readAll()));
}

}  // namespace

class TestSampleInstall : public QObject {
    Q_OBJECT

  private slots:
    void serverSchemasMatchFileSchema();
    void sevenFilesOpenInTheShell();
    void sampleRowsCoverTheCases_data();
    void sampleRowsCoverTheCases();
    void unreachableServer();
};

// The server databases hold the same tables and columns as their files, so that one
// query text finds the same columns on either back-end.
void TestSampleInstall::serverSchemasMatchFileSchema() {
    const auto file = SchemaFile(QStringLiteral("sqlite"));
    for (const QString& engine : {QStringLiteral("postgres"), QStringLiteral("mssql")}) {
        QStringList databases;
        const auto server = SchemaFile(engine);
        for (const SchemaSection& s : server)
            databases.append(s.database);
        QCOMPARE(databases, (QStringList{"OFFICE", "MDOCS", "BM", "ZORVA"}));
        for (const QString& db : databases) {
            const auto expected = TablesOf(SchemaStatements(file, db));
            QVERIFY2(!expected.isEmpty(), qPrintable(db));
            QCOMPARE(TablesOf(SchemaStatements(server, db)), expected);
        }
    }
}

// Generated sizes; a second run replaces the databases instead of adding to them.
void TestSampleInstall::sevenFilesOpenInTheShell() {
    test::TestEnv env;
    const QStringList sizes{"--clients", "500", "--lookfor", "2000"};
    QCOMPARE(RunInstaller(env.DataDir(), sizes).first, 0);
    QCOMPARE(RunInstaller(env.DataDir(), sizes).first, 0);
    for (const QString& line :
         QStringLiteral("OFFICE: CLIENT MTIK OFF_CODE|MDOCS: DOCS DOCSTATUS|BM: UMEMO|"
                        "ZORVA: LOOKFOR|MADAD: TRANS_CODE|MAIN: MSql|PUB: USERS")
             .split(QLatin1Char('|'))) {
        const QString file = Db(env.DataDir(), line.section(QLatin1Char(':'), 0, 0));
        QCOMPARE(Sqlite3(file, QStringLiteral(".tables")).simplified(),
                 line.section(QStringLiteral(": "), 1));
        QCOMPARE(Sqlite3(file, QStringLiteral("PRAGMA integrity_check")), QStringLiteral("ok"));
    }
    const QString office = Db(env.DataDir(), QStringLiteral("OFFICE"));
    QCOMPARE(Sqlite3(office, QStringLiteral("SELECT count(*), count(DISTINCT NUM) FROM CLIENT")),
             QStringLiteral("500|500"));
    // Every case points at an existing client.
    QCOMPARE(Sqlite3(Db(env.DataDir(), QStringLiteral("ZORVA")),
                     QStringLiteral("ATTACH '%1' AS o; SELECT count(*), sum(LakNum NOT IN "
                                    "(SELECT NUM FROM o.CLIENT)) FROM LOOKFOR")
                         .arg(office)),
             QStringLiteral("2000|0"));
    QVERIFY(!QFile::exists(env.DataDir() + QStringLiteral("/Def/MSSQLSetting.INI")));
    QCOMPARE(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                        QStringLiteral("MainPath")),
             QDir::toNativeSeparators(env.DataDir()));
}

// Statements that should be refused give "<error> ...".
void TestSampleInstall::sampleRowsCoverTheCases_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("query");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* db, const char* query, const char* result) {
        QTest::newRow(name) << QString::fromLatin1(db) << QString::fromUtf8(query)
                            << QString::fromUtf8(result);
    };
    row("every case kind 1 to 18", "ZORVA",
        "SELECT count(DISTINCT OptKey) FROM LOOKFOR WHERE OptKey BETWEEN 1 AND 18", "18");
    row("apostrophe, found without regard to case", "OFFICE",
        "SELECT NUM FROM CLIENT WHERE L_NAME='o''neil'", "1004");
    row("DOCS.ID may repeat a path", "MDOCS",
        "INSERT INTO DOCS (ID, FULLNAME) VALUES (1, 'a'), (2, 'a'); SELECT count(*) FROM DOCS",
        "2");
    row("DOCS.ID unique", "MDOCS", "INSERT INTO DOCS (ID) VALUES (1), (1)", "<error>");
    row("reminders: handlers and kinds differ", "BM",
        "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A'), "
        "(5, 32, '1', 'A'), (5, 31, '1', ''); SELECT count(*) FROM UMEMO",
        "3");
    row("one reminder per document, kind and handler", "BM",
        "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A'), (5, 31, '1', "
        "'A')",
        "<error>");
}

void TestSampleInstall::sampleRowsCoverTheCases() {
    QFETCH(QString, database);
    QFETCH(QString, query);
    QFETCH(QString, expected);
    test::TestEnv env;
    CreateSampleInstallation(env.DataDir());
    const QString out = Sqlite3(Db(env.DataDir(), database), query);
    if (expected == QLatin1String("<error>")) {
        QVERIFY2(out.startsWith(expected) && out.contains(QLatin1String("UNIQUE")),
                 qPrintable(out));
    } else {
        QCOMPARE(out, expected);
    }
}

// A failed run says so and leaves no settings that would point the add-in at it.
void TestSampleInstall::unreachableServer() {
    test::TestEnv env;
    const auto [code, err] =
        RunInstaller(env.DataDir(), {QStringLiteral("--server"), QStringLiteral("/nonexistent,1")});
    QCOMPARE(code, 1);
    QVERIFY2(err.contains("cannot connect"), err.constData());
    QCOMPARE(GetSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                        QStringLiteral("MainPath")),
             QString());
}

QTEST_MAIN(TestSampleInstall)
#include "test_sample_install.moc"

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

// Runs a program; its exit code (-1 when it did not finish), standard output and error.
struct Ran {
    int code;
    QString out, err;
};
Ran Run(const QString& program, const QStringList& arguments) {
    QProcess p;
    p.start(program, arguments);
    if (!p.waitForFinished(60000) || p.exitStatus() != QProcess::NormalExit)
        return {-1, {}, QStringLiteral("did not finish")};
    return {p.exitCode(), QString::fromUtf8(p.readAllStandardOutput()).trimmed(),
            QString::fromUtf8(p.readAllStandardError()).trimmed()};
}

// The sqlite3 shell's output on a database file of the installation, or "<error> " and its
// message.
QString Sqlite3(const QString& dir, const QString& database, const QString& command) {
    const Ran r = Run(QStringLiteral("sqlite3"),
                      {QStringLiteral("-bail"), dir + "/" + database + ".MDB", command});
    return r.code == 0 ? r.out : QStringLiteral("<error> ") + r.err;
}

// Table name -> column names (lower case), from the CREATE TABLE statements of a section.
QMap<QString, QStringList> TablesOf(const QStringList& statements) {
    static const QRegularExpression create(QStringLiteral(R"(^CREATE TABLE (\w+) \((.*)\)$)"),
                                           QRegularExpression::DotMatchesEverythingOption);
    QMap<QString, QStringList> tables;
    for (const QString& s : statements) {
        const auto m = create.match(s);
        for (const QString& line : m.captured(2).split(QLatin1Char('\n'), Qt::SkipEmptyParts)) {
            const QString first = line.trimmed().section(QLatin1Char(' '), 0, 0);
            if (!first.isEmpty() && first != QLatin1String("PRIMARY"))
                tables[m.captured(1).toUpper()].append(first.toLower());
        }
    }
    return tables;
}

QList<SchemaSection> SchemaFile(const QString& engine) {
    QFile f(QStringLiteral(ZV_SCHEMA_DIR "/%1.sql").arg(engine));
    return f.open(QIODevice::ReadOnly) ? ParseSchema(QString::fromUtf8(f.readAll()))
                                       : QList<SchemaSection>();
}

}  // namespace

class TestSampleInstall : public QObject {
    Q_OBJECT

  private slots:
    void serverSchemasMatchFileSchema();
    void sevenFilesOpenInTheShell();
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
    const QString dir = env.DataDir();
    const QStringList sizes{dir, "--clients", "500", "--lookfor", "2000"};
    QCOMPARE(Run(QStringLiteral(ZV_SAMPLE_INSTALL_PROGRAM), sizes).code, 0);
    QCOMPARE(Run(QStringLiteral(ZV_SAMPLE_INSTALL_PROGRAM), sizes).code, 0);
    for (const QString& line :
         QStringLiteral("OFFICE: CLIENT MTIK OFF_CODE|MDOCS: DOCS DOCSTATUS|BM: UMEMO|"
                        "ZORVA: LOOKFOR|MADAD: TRANS_CODE|MAIN: MSql|PUB: USERS")
             .split(QLatin1Char('|'))) {
        const QString db = line.section(QLatin1Char(':'), 0, 0);
        QCOMPARE(Sqlite3(dir, db, QStringLiteral(".tables")).simplified(),
                 line.section(QStringLiteral(": "), 1));
        QCOMPARE(Sqlite3(dir, db, QStringLiteral("PRAGMA integrity_check")), QStringLiteral("ok"));
    }
    QCOMPARE(
        Sqlite3(dir, "OFFICE", QStringLiteral("SELECT count(*), count(DISTINCT NUM) FROM CLIENT")),
        QStringLiteral("500|500"));
    // Every case points at an existing client.
    QCOMPARE(Sqlite3(dir, "ZORVA",
                     QStringLiteral("ATTACH '%1/OFFICE.MDB' AS o; SELECT count(*), sum(LakNum NOT "
                                    "IN (SELECT NUM FROM o.CLIENT)) FROM LOOKFOR")
                         .arg(dir)),
             QStringLiteral("2000|0"));
    QVERIFY(!QFile::exists(dir + QStringLiteral("/Def/MSSQLSetting.INI")));
    QCOMPARE(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                        QStringLiteral("MainPath")),
             QDir::toNativeSeparators(dir));
}

// The rows cover the cases the other tests need, and the keys refuse what the suite's keys
// refuse ("<error>": refused as a duplicate).
void TestSampleInstall::sampleRowsCoverTheCases() {
    test::TestEnv env;
    CreateSampleInstallation(env.DataDir());
    const char* cases[][3] = {
        // Every case kind from 1 to 18.
        {"ZORVA", "SELECT count(DISTINCT OptKey) FROM LOOKFOR WHERE OptKey BETWEEN 1 AND 18", "18"},
        // An apostrophe, found without regard to case.
        {"OFFICE", "SELECT NUM FROM CLIENT WHERE L_NAME='o''neil'", "1004"},
        // DOCS.ID is unique; a path may repeat.
        {"MDOCS",
         "INSERT INTO DOCS (ID, FULLNAME) VALUES (1, 'a'), (2, 'a'); SELECT count(*) FROM DOCS",
         "2"},
        {"MDOCS", "INSERT INTO DOCS (ID) VALUES (3), (3)", "<error>"},
        // One reminder per document, kind and handler.
        {"BM",
         "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A'), "
         "(5, 32, '1', 'A'), (5, 31, '1', ''); SELECT count(*) FROM UMEMO",
         "3"},
        {"BM",
         "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (6, 31, '1', 'A'), (6, 31, '1', "
         "'A')",
         "<error>"},
    };
    for (const auto& [database, query, expected] : cases) {
        const QString out =
            Sqlite3(env.DataDir(), QString::fromLatin1(database), QString::fromUtf8(query));
        QVERIFY2(qstrcmp(expected, "<error>") == 0 ? out.startsWith(QLatin1String("<error>")) &&
                                                         out.contains(QLatin1String("UNIQUE"))
                                                   : out == QString::fromUtf8(expected),
                 qPrintable(QString::fromUtf8(query) + QStringLiteral(" -> ") + out));
    }
}

// A failed run says so and leaves no settings that would point the add-in at it.
void TestSampleInstall::unreachableServer() {
    test::TestEnv env;
    const Ran r =
        Run(QStringLiteral(ZV_SAMPLE_INSTALL_PROGRAM),
            {env.DataDir(), QStringLiteral("--server"), QStringLiteral("/nonexistent,1")});
    QCOMPARE(r.code, 1);
    QVERIFY2(r.err.contains(QLatin1String("cannot connect")), qPrintable(r.err));
    QCOMPARE(GetSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                        QStringLiteral("MainPath")),
             QString());
}

QTEST_MAIN(TestSampleInstall)
#include "test_sample_install.moc"

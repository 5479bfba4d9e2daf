// The sample installation on file databases, checked with the sqlite3 shell, and the
// schema files of the three engines kept in step.

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QRegularExpression>
#include <QTest>

#include "sample_install/sample_data.h"
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
    if (!p.waitForFinished(30000) || p.exitStatus() != QProcess::NormalExit)
        return QStringLiteral("<sqlite3 did not finish>");
    if (p.exitCode() != 0)
        return QStringLiteral("<error> ") + QString::fromUtf8(p.readAllStandardError()).trimmed();
    return QString::fromUtf8(p.readAllStandardOutput()).trimmed();
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
    void parsesSectionsAndStatements();
    void serverSchemasMatchFileSchema_data();
    void serverSchemasMatchFileSchema();
    void sevenFilesOpenInTheShell_data();
    void sevenFilesOpenInTheShell();
    void sampleRowsCoverTheCases_data();
    void sampleRowsCoverTheCases();
    void indexesRefuseDuplicates_data();
    void indexesRefuseDuplicates();
    void foldersAndSettings();
    void generatedSizesAndReplacement();
    void program_data();
    void program();
};

void TestSampleInstall::parsesSectionsAndStatements() {
    const auto sections =
        ParseSchema(QStringLiteral("-- comment before any section\nCREATE TABLE IGNORED (A int);\n"
                                   "-- database: ONE\nCREATE TABLE A (\n  X int -- a note\n);\n\n"
                                   "CREATE INDEX A_X ON A (X);\n"
                                   "--   database:  TWO  \nCREATE TABLE B (Y int);\n"));
    QCOMPARE(sections.size(), 2);
    QCOMPARE(sections[0].database, QStringLiteral("ONE"));
    QCOMPARE(sections[0].statements.size(), 2);
    QVERIFY(!IsIndexStatement(sections[0].statements[0]));
    QVERIFY(IsIndexStatement(sections[0].statements[1]));
    QVERIFY(IsIndexStatement(QStringLiteral("create unique index U on T (A)")));
    QCOMPARE(SchemaStatements(sections, QStringLiteral("two")),
             QStringList{QStringLiteral("CREATE TABLE B (Y int)")});
    QVERIFY(SchemaStatements(sections, QStringLiteral("THREE")).isEmpty());
}

void TestSampleInstall::serverSchemasMatchFileSchema_data() {
    QTest::addColumn<QString>("engine");
    QTest::newRow("postgres") << QStringLiteral("postgres");
    QTest::newRow("mssql") << QStringLiteral("mssql");
}

// The server databases hold the same tables and columns as their files, so that one
// query text finds the same columns on either back-end.
void TestSampleInstall::serverSchemasMatchFileSchema() {
    QFETCH(QString, engine);
    const auto file = SchemaFile(QStringLiteral("sqlite"));
    const auto server = SchemaFile(engine);
    QVERIFY(!server.isEmpty());
    QStringList databases;
    for (const SchemaSection& s : server)
        databases.append(s.database);
    QCOMPARE(databases, (QStringList{"OFFICE", "MDOCS", "BM", "ZORVA"}));
    for (const QString& db : databases) {
        const auto expected = TablesOf(SchemaStatements(file, db));
        QVERIFY2(!expected.isEmpty(), qPrintable(db));
        QCOMPARE(TablesOf(SchemaStatements(server, db)), expected);
    }
}

void TestSampleInstall::sevenFilesOpenInTheShell_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("tables");
    QTest::newRow("OFFICE") << "OFFICE"
                            << "CLIENT MTIK OFF_CODE";
    QTest::newRow("MDOCS") << "MDOCS"
                           << "DOCS DOCSTATUS";
    QTest::newRow("BM") << "BM"
                        << "UMEMO";
    QTest::newRow("ZORVA") << "ZORVA"
                           << "LOOKFOR";
    QTest::newRow("MADAD") << "MADAD"
                           << "TRANS_CODE";
    QTest::newRow("MAIN") << "MAIN"
                          << "MSql";
    QTest::newRow("PUB") << "PUB"
                         << "USERS";
}

void TestSampleInstall::sevenFilesOpenInTheShell() {
    QFETCH(QString, database);
    QFETCH(QString, tables);
    test::TestEnv env;
    CreateSampleInstallation(env.DataDir());
    const QString listed = Sqlite3(Db(env.DataDir(), database), QStringLiteral(".tables"));
    QCOMPARE(listed.split(QRegularExpression(QStringLiteral("\\s+"))).join(' '), tables);
    QCOMPARE(Sqlite3(Db(env.DataDir(), database), QStringLiteral("PRAGMA integrity_check")),
             QStringLiteral("ok"));
}

void TestSampleInstall::sampleRowsCoverTheCases_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("query");
    QTest::addColumn<QString>("expected");
    QTest::newRow("every case kind 1 to 18")
        << "ZORVA"
        << "SELECT count(DISTINCT OptKey) FROM LOOKFOR WHERE OptKey BETWEEN 1 AND 18"
        << "18";
    QTest::newRow("client's own kinds of client 1001")
        << "ZORVA"
        << "SELECT group_concat(OptKey) FROM (SELECT DISTINCT OptKey FROM LOOKFOR "
           "WHERE LakNum='1001' AND OptKey IN (1,2,3,4,5,6,10,11) ORDER BY OptKey)"
        << "1,2,3,4,5,6,10,11";
    QTest::newRow("every names row's client exists")
        << "ZORVA"
        << "ATTACH '%1/OFFICE.MDB' AS o; SELECT count(*) FROM LOOKFOR "
           "WHERE LakNum NOT IN (SELECT NUM FROM o.CLIENT)"
        << "0";
    QTest::newRow("general cases name user kinds")
        << "ZORVA"
        << "SELECT count(*) FROM LOOKFOR WHERE OptKey=11 AND Sug='T' AND TIK_ID>='26'"
        << "6";
    QTest::newRow("kind 17 with an unknown letter")
        << "ZORVA"
        << "SELECT count(*) FROM LOOKFOR WHERE OptKey=17 AND Sug NOT IN "
           "('F','N','W','G','H','T','L')"
        << "1";
    QTest::newRow("clients without a first name")
        << "OFFICE"
        << "SELECT count(*) FROM CLIENT WHERE F_NAME IS NULL"
        << "3";
    QTest::newRow("apostrophe, found without regard to case")
        << "OFFICE"
        << "SELECT NUM FROM CLIENT WHERE L_NAME='o''neil'"
        << "1004";
    QTest::newRow("user kinds from 26, one hidden")
        << "OFFICE"
        << "SELECT group_concat(ID || ':' || SHOW) FROM (SELECT * FROM MTIK ORDER BY ID)"
        << "26:1,27:1,28:1,29:0";
    QTest::newRow("descriptions 20 and 21")
        << "OFFICE"
        << "SELECT group_concat(CODE || ':' || n) FROM (SELECT CODE, count(*) n FROM OFF_CODE "
           "WHERE CODE IN (20,21) GROUP BY CODE)"
        << "20:6,21:5";
    QTest::newRow("origins 1080 as text, 10 of them")
        << "MADAD"
        << "SELECT count(*) FROM TRANS_CODE WHERE TABLE_NUM='1080' AND KOD_NUM_1 BETWEEN '1' AND "
           "'9'"
        << "10";
    QTest::newRow("statuses by ORD")
        << "MDOCS"
        << "SELECT group_concat(ID) FROM (SELECT ID FROM DOCSTATUS ORDER BY ORD)"
        << "1,2,4,3";
    QTest::newRow("file databases only")
        << "MAIN"
        << "SELECT IsDocs+IsBM+IsOffice+IsZorva FROM MSql WHERE ClientID='23'"
        << "0";
    QTest::newRow("this office's users") << "PUB"
                                         << "SELECT count(*) FROM USERS WHERE USERCODE='100'"
                                         << "4";
    QTest::newRow("no documents, no reminders")
        << "MDOCS"
        << "ATTACH '%1/BM.MDB' AS b; SELECT (SELECT count(*) FROM DOCS) + "
           "(SELECT count(*) FROM b.UMEMO)"
        << "0";
}

void TestSampleInstall::sampleRowsCoverTheCases() {
    QFETCH(QString, database);
    QFETCH(QString, query);
    QFETCH(QString, expected);
    test::TestEnv env;
    CreateSampleInstallation(env.DataDir());
    QCOMPARE(Sqlite3(Db(env.DataDir(), database), query.arg(env.DataDir())), expected);
}

void TestSampleInstall::indexesRefuseDuplicates_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("statements");
    QTest::addColumn<bool>("refused");
    QTest::newRow("DOCS.ID unique") << "MDOCS"
                                    << "INSERT INTO DOCS (ID) VALUES (1);"
                                       "INSERT INTO DOCS (ID) VALUES (1)"
                                    << true;
    QTest::newRow("DOCS.ID may repeat a path") << "MDOCS"
                                               << "INSERT INTO DOCS (ID, FULLNAME) VALUES (1, 'a');"
                                                  "INSERT INTO DOCS (ID, FULLNAME) VALUES (2, 'a')"
                                               << false;
    QTest::newRow("one reminder per document, kind and handler")
        << "BM"
        << "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A');"
           "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A')"
        << true;
    QTest::newRow("handlers and kinds differ")
        << "BM"
        << "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', 'A');"
           "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 32, '1', 'A');"
           "INSERT INTO UMEMO (ID, MTYPE, USER97, METAPEL) VALUES (5, 31, '1', '')"
        << false;
}

void TestSampleInstall::indexesRefuseDuplicates() {
    QFETCH(QString, database);
    QFETCH(QString, statements);
    QFETCH(bool, refused);
    test::TestEnv env;
    CreateSampleInstallation(env.DataDir());
    const QString out = Sqlite3(Db(env.DataDir(), database), statements);
    QCOMPARE(out.startsWith(QLatin1String("<error>")), refused);
    if (refused)
        QVERIFY2(out.contains(QLatin1String("UNIQUE")), qPrintable(out));
}

void TestSampleInstall::foldersAndSettings() {
    test::TestEnv env;
    SampleOptions options;
    options.volnaGlobNum = QStringLiteral("81005");
    CreateSampleInstallation(env.DataDir(), options);
    const QDir root(env.DataDir());
    QVERIFY(QFile::exists(root.filePath(QStringLiteral("Zorvane.Exe"))));
    QVERIFY(root.exists(QStringLiteral("Def")));
    QVERIFY(root.exists(QStringLiteral("DOCS/MAILIN")));
    QDir docBasic(root.filePath(QStringLiteral("DOCS/DOCBASIC")));
    QStringList inner = docBasic.entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    QStringList expected = SampleDocBasicFolders();
    inner.sort();
    expected.sort();
    QCOMPARE(inner, expected);
    QVERIFY(!QFile::exists(root.filePath(QStringLiteral("Def/MSSQLSetting.INI"))));

    // The store the add-in reads; application names compare without case.
    auto setting = [](const char* key) {
        return GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                          QString::fromLatin1(key));
    };
    QCOMPARE(setting("MainPath"), QDir::toNativeSeparators(env.DataDir()));
    QCOMPARE(setting("MyUserName"), QStringLiteral("דנה כהן"));
    QCOMPARE(setting("MyUser"), QStringLiteral("1"));
    QCOMPARE(setting("VolnaGlobNum"), QStringLiteral("81005"));
    QCOMPARE(setting("LNUM"), QStringLiteral("100"));
    QCOMPARE(Sqlite3(Db(env.DataDir(), QStringLiteral("MAIN")),
                     QStringLiteral("SELECT count(*) FROM MSql WHERE ClientID='81005'")),
             QStringLiteral("1"));
}

void TestSampleInstall::generatedSizesAndReplacement() {
    test::TestEnv env;
    SampleOptions options;
    options.clients = 500;
    options.lookfor = 2000;
    CreateSampleInstallation(env.DataDir(), options);
    // A second run replaces the databases instead of adding to them.
    CreateSampleInstallation(env.DataDir(), options);
    const QString office = Db(env.DataDir(), QStringLiteral("OFFICE"));
    const QString zorva = Db(env.DataDir(), QStringLiteral("ZORVA"));
    QCOMPARE(Sqlite3(office, QStringLiteral("SELECT count(*), count(DISTINCT NUM) FROM CLIENT")),
             QStringLiteral("500|500"));
    QCOMPARE(Sqlite3(zorva, QStringLiteral("SELECT count(*) FROM LOOKFOR")),
             QStringLiteral("2000"));
    // Every generated client has its client row, and its cases point at it.
    QCOMPARE(Sqlite3(zorva, QStringLiteral("ATTACH '%1' AS o; SELECT count(*) FROM o.CLIENT "
                                           "WHERE NUM NOT IN (SELECT LakNum FROM LOOKFOR "
                                           "WHERE OptKey=0)")
                                .arg(office)),
             QStringLiteral("0"));
    QCOMPARE(Sqlite3(zorva, QStringLiteral("ATTACH '%1' AS o; SELECT count(*) FROM LOOKFOR "
                                           "WHERE LakNum NOT IN (SELECT NUM FROM o.CLIENT)")
                                .arg(office)),
             QStringLiteral("0"));
    // Sizes below the built-in set keep the built-in set.
    options.clients = 3;
    options.lookfor = 3;
    CreateSampleInstallation(env.DataDir(), options);
    QCOMPARE(Sqlite3(office, QStringLiteral("SELECT count(*) FROM CLIENT")),
             QString::number(SampleData::BaseClientCount()));
    QCOMPARE(Sqlite3(zorva, QStringLiteral("SELECT count(*) FROM LOOKFOR")),
             QString::number(SampleData::BaseLookForCount()));
}

void TestSampleInstall::program_data() {
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("clients");
    QTest::newRow("default") << QStringList{} << 0 << "12";
    QTest::newRow("sizes") << QStringList{"--clients", "40", "--lookfor", "100"} << 0 << "40";
    QTest::newRow("bad size") << QStringList{"--clients", "many"} << 2 << "";
    QTest::newRow("unreachable server")
        << QStringList{"--server", "/nonexistent-socket-folder,1"} << 1 << "12";
}

void TestSampleInstall::program() {
    QFETCH(QStringList, arguments);
    QFETCH(int, exitCode);
    QFETCH(QString, clients);
    test::TestEnv env;
    QProcess p;
    p.start(QStringLiteral(ZV_SAMPLE_INSTALL_PROGRAM), QStringList{env.DataDir()} + arguments);
    QVERIFY(p.waitForFinished(60000));
    QCOMPARE(p.exitCode(), exitCode);
    if (exitCode == 2) {
        QVERIFY(!QFile::exists(Db(env.DataDir(), QStringLiteral("OFFICE"))));
        return;
    }
    QCOMPARE(Sqlite3(Db(env.DataDir(), QStringLiteral("OFFICE")),
                     QStringLiteral("SELECT count(*) FROM CLIENT")),
             clients);
    if (exitCode == 0) {
        QCOMPARE(GetSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                            QStringLiteral("MainPath")),
                 QDir::toNativeSeparators(env.DataDir()));
    } else {
        QVERIFY(p.readAllStandardError().contains("cannot connect"));
    }
}

QTEST_MAIN(TestSampleInstall)
#include "test_sample_install.moc"

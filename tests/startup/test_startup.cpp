// Start-up in process: the command line, Main's request grammar and its refusals in their
// order, the settings' read order and work folders, and the back end chosen from
// MSSQLSetting.INI and the MSql row of MAIN.MDB on a sample installation.
#include <QtTest>

#include "installation.h"
#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "startup/backend_selection.h"
#include "startup/command_line.h"
#include "startup/main_entry.h"
#include "startup/request_text.h"
#include "startup/settings.h"
#include "table_rows.h"
#include "util/settings_store.h"
#include "util/state.h"
#include "util/ui.h"

using namespace zv;

namespace {

const QString Y{QChar(kRequestSeparator)};
const QString kNotIdentified = QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה");
const QString kBadCall = QStringLiteral("קריאה לא תקינה של שרות זה");
enum Setup { kNoVolna, kNoExe, kInstalled };

// Runs Main; the handler's mode, path and name, or "-" when it was not called.
int Run(const QString& text, QString& handled) {
    handled = QStringLiteral("-");
    return Main(text, [&](int& mode, QString& path, QString& name) {
        handled = QStringLiteral("%1|%2|%3").arg(mode).arg(path, name);
    });
}

QStringList Tree(const QString& root) {
    QStringList out;
    QDirIterator it(root, QDir::AllEntries | QDir::NoDotAndDotDot, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        out << it.next().mid(root.size());
    }
    out.sort();
    return out;
}

// The installation's client number, quoted in the query that looks up its MSql row.
const QString kOwn = QStringLiteral("2'3");
const QString kLogin = QStringLiteral(
    "[MSSQL]\nProvider=SQLOLEDB\nDataSource=srv\\office\n[1]\nUserID=dana\nPassWord=p;w\n");

QString Flags() {
    return QStringLiteral("%1%2%3%4")
        .arg(IsDocs() ? "D" : "-", IsBM() ? "B" : "-", IsOffice() ? "O" : "-",
             IsZorva() ? "Z" : "-");
}

}  // namespace

class TestStartup : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void options_data();
    void options();
    void request_data();
    void request();
    void developmentRun();
    void location();
    void noFallbackBeforeMainPath();
    void basicParamsAndIdempotentWorkFolders();
    void missingMainPathFolderIsReported();
    void backEnd_data();
    void backEnd();
    void flagStaysSet();
    void rowWithoutAFlagColumn();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    test::ScriptedUi& Ui() { return **ui_; }
    QString GlobalFile() const {
        return env_->LocalAppData() + QStringLiteral("/Zorvane/Kavex32R.txt");
    }
    // A sample installation with this login file, the state pointing at it.
    void Sample(const QString& ini) {
        SampleOptions options;
        options.writeSettings = false;
        CreateSampleInstallation(env_->DataDir(), options);
        SetMainPath(env_->DataDir());
        SetMyUser(QStringLiteral("1"));
        SetVolnaGlobNum(kOwn);
        QVERIFY(test::WriteFile(env_->DataDir() + QStringLiteral("/Def/MSSQLSetting.INI"),
                                ini.toUtf8()));
    }
    // The MSql row of a client number; values: IsDocs, IsBM, IsOffice, IsZorva.
    static void SetRow(const QString& client, const QString& values) {
        const QString num = QString(client).replace(QLatin1Char('\''), QStringLiteral("''"));
        test::Execute(QStringLiteral("MAIN"), "DELETE FROM MSql WHERE ClientID='" + num + "'");
        test::Execute(QStringLiteral("MAIN"),
                      "INSERT INTO MSql (ClientID, IsDocs, IsBM, IsOffice, IsZorva) VALUES ('" +
                          num + "', " + values + ")");
    }
};

void TestStartup::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
}

void TestStartup::cleanup() {
    ui_.reset();
    env_.reset();
}

// Expected: "help", or the request bytes after "batch " when --batch was given; "error" would be
// a usage error (an unknown option is tried on the built program).
void TestStartup::options_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<QByteArray>("expected");
    using L = QList<QByteArray>;
    QTest::newRow("request only") << L{"1\xA5/t/a.doc\xA5x"} << QByteArray("1\xA5/t/a.doc\xA5x");
    QTest::newRow("split request joined")
        << L{"--batch", "--client", "1001", "1\xA5/t/my", "file.doc\xA5x"}
        << QByteArray("batch 1\xA5/t/my file.doc\xA5x");
    QTest::newRow("options end at the request")
        << L{"1\xA5p\xA5n", "--batch"} << QByteArray("1\xA5p\xA5n --batch");
    QTest::newRow("double dash") << L{"--batch", "--client", "1001", "--", "-1\xA5p\xA5n"}
                                 << QByteArray("batch -1\xA5p\xA5n");
    QTest::newRow("help") << L{"--help"} << QByteArray("help");
}

void TestStartup::options() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(QByteArray, expected);
    const CommandLine cl = ParseCommandLine(args);
    const QByteArray found = !cl.error.isEmpty() ? QByteArray("error")
                             : cl.help           ? QByteArray("help")
                                                 : (cl.batch ? "batch " : "") + cl.request;
    QCOMPARE(found, expected);
}

// "%D" stands for the document's path, "%M" for MainPath. A refusal is critical and ends the
// run with 1; a report about the mode field is shown and the request handled all the same.
// The broken installations miss one thing more than the checks after theirs look at, so the
// refusal shown is the one of the first failing check.
void TestStartup::request_data() {
    QTest::addColumn<int>("setup");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QString>("handled");
    const auto row = [](const char* name, const QString& text, const QString& message,
                        const QString& handled, int setup = kInstalled) {
        QTest::newRow(name) << setup << text << message << handled;
    };
    row("three fields", "1" + Y + "%D" + Y + "Letter", {}, "1|%D|Letter");
    row("fourth ignored", "2" + Y + "%D" + Y + "נושא" + Y + "x", {}, "2|%D|נושא");
    row("outer spaces trimmed", "  1" + Y + "%D" + Y + "Letter  ", {}, "1|%D|Letter");
    row("empty name", "1" + Y + "%D" + Y, {}, "1|%D|");
    row("mode half to even up", "1.5" + Y + "%D" + Y + "n", {}, "2|%D|n");
    row("mode not a number", "abc" + Y + "%D" + Y + "n", "13-Main-Type mismatch", "0|%D|n");
    row("mode out of range", "40000" + Y + "%D" + Y + "n", "6-Main-Overflow", "0|%D|n");
    row("two fields", "1" + Y + "%D", QStringLiteral("הפעלה לא חוקית של שרות זה"), "-");
    row("space before path", "1" + Y + " %D" + Y + "Letter", kBadCall + "\r\n %D", "-");
    row("pattern is no file", "1" + Y + "%D*" + Y + "Letter", kBadCall + "\r\n%D*", "-");
    row("no suite executable", "1", QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף\r\n%M"),
        "-", kNoExe);
    row("MainPath without VolnaGlobNum", "1", kNotIdentified, "-", kNoVolna);
}

void TestStartup::request() {
    QFETCH(int, setup);
    QFETCH(QString, text);
    QFETCH(QString, message);
    QFETCH(QString, handled);
    test::MakeInstallation(*env_, setup != kNoExe, setup == kNoVolna ? "" : "23");
    for (QString* s : {&text, &message, &handled}) {
        s->replace(QStringLiteral("%D"), env_->Root() + QStringLiteral("/in/letter.docx"))
            .replace(QStringLiteral("%M"), env_->DataDir());
    }
    QString found;
    const int status = Run(text, found);
    QCOMPARE(found, handled);
    QCOMPARE(Ui().Texts(), message.isEmpty() ? QStringList() : QStringList{message});
    QCOMPARE(status, handled == QLatin1String("-") ? 1 : 0);
    if (handled == QLatin1String("-")) {
        QCOMPARE(Ui().Messages().front().style, vbOKOnly | vbCritical);
    }
}

// A development run takes a fixed request, whatever the command line holds (its file exists
// only on a developer's machine), and reads the per-user file alone, not the store.
void TestStartup::developmentRun() {
    const QString document = test::MakeInstallation(*env_);
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUser"),
                QStringLiteral("3"));
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUserName"),
                QStringLiteral("store"));
    qputenv("ZORVANE_DEVELOPMENT_RUN", "1");
    QString handled;
    QCOMPARE(Run(QStringLiteral("1") + Y + document + Y + QStringLiteral("n"), handled), 1);
    QVERIFY(IsDevelopmentRun());
    QCOMPARE(Ui().Texts(), QStringList{kBadCall + "\r\nF:\\Ornit32\\DOCS\\TEMPLATES\\profil.doc"});
    QCOMPARE(handled, QStringLiteral("-"));
    QCOMPARE(MyUser(), QStringLiteral("7"));
    QCOMPARE(MyUserName(), QString());
}

// A LOCALAPPDATA folder not yet there is made and holds the file itself; without LOCALAPPDATA
// the file lies below XDG_DATA_HOME.
void TestStartup::location() {
    const QString local = env_->Root() + QStringLiteral("/new/local");
    qputenv("LOCALAPPDATA", local.toUtf8());
    QCOMPARE(GetGlobalKeysFile(), local + QStringLiteral("/Kavex32R.txt"));
    QVERIFY(QFileInfo::exists(local));
    SetGlobalKeysFileCache({});
    qunsetenv("LOCALAPPDATA");
    const QByteArray oldDataHome = qgetenv("XDG_DATA_HOME");
    qputenv("XDG_DATA_HOME", env_->Root().toUtf8());
    const QString file = GetGlobalKeysFile();
    qputenv("XDG_DATA_HOME", oldDataHome);
    QCOMPARE(file, env_->Root() + QStringLiteral("/Zorvane/Kavex32R.txt"));
    QVERIFY(QFileInfo::exists(env_->Root() + QStringLiteral("/Zorvane")));
}

void TestStartup::noFallbackBeforeMainPath() {
    // A path inside a regular file: no folder can ever be made there.
    QVERIFY(test::WriteFile(env_->Root() + QStringLiteral("/plainfile"), "x"));
    qputenv("LOCALAPPDATA", (env_->Root() + QStringLiteral("/plainfile/sub")).toUtf8());
    const bool atRootBefore = QFileInfo::exists(QStringLiteral("/Def/UMR"));
    QCOMPARE(GetGlobalKeysFile(), QString());
    QCOMPARE(GlobalKeysFileCache(), QString());
    QCOMPARE(QFileInfo::exists(QStringLiteral("/Def/UMR")), atRootBefore);
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MainPath")), QString());
    // Once MainPath is known the fallback folder is made and used; the failed attempts at the
    // unusable folder were reported.
    SetMainPath(env_->DataDir());
    QVERIFY(QDir().mkpath(env_->DataDir()));
    QCOMPARE(GetGlobalKeysFile(), env_->DataDir() + QStringLiteral("/Def/UMR/Kavex32R.txt"));
    QVERIFY(!Ui().Texts().isEmpty());
    QVERIFY(test::WriteFile(GetGlobalKeysFile(), "[General]\nMyUser=3\n"));
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MyUser")),
             QStringLiteral("3"));
}

// Each value from the store first, from the per-user file when the store lacks it.
void TestStartup::basicParamsAndIdempotentWorkFolders() {
    QVERIFY(QDir().mkpath(env_->DataDir()));
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MainPath"),
                env_->DataDir());
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUser"),
                QStringLiteral("7"));
    QVERIFY(test::WriteFile(GlobalFile(),
                            "[General]\nMyUserName=\"דנה כהן\"\nVolnaGlobNum=23\nMyUser=9\n"));
    SetBasicParam();
    QCOMPARE(MainPath(), env_->DataDir());
    QCOMPARE(MyUser(), QStringLiteral("7"));
    QCOMPARE(MyUserName(), QStringLiteral("דנה כהן"));
    QCOMPARE(VolnaGlobNum(), QStringLiteral("23"));
    const QStringList folders{"/Dat1",     "/Dat1/BakMDB",  "/Dat1/DTDef",
                              "/Dat1/Def", "/Dat1/GDetDef", "/Dat1/Temp"};
    QCOMPARE(Ui().Texts(), QStringList());
    // Preparing again keeps what the folders hold.
    QVERIFY(test::WriteFile(env_->DataDir() + QStringLiteral("/Dat1/Temp/keep.txt"), "keep"));
    PrepareWorkDir(env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(GetWorkDir(), env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(Tree(env_->DataDir()), folders + QStringList{"/Dat1/Temp/keep.txt"});
}

void TestStartup::missingMainPathFolderIsReported() {
    QVERIFY(test::WriteFile(GlobalFile(), "[General]\nMainPath=" + env_->DataDir().toUtf8() +
                                              "\nVolnaGlobNum=23\nMyUser=4\n"));
    SetBasicParam();
    QCOMPARE(Ui().Texts(), QStringList{QStringLiteral("76-0--SetBasicParam-Path not found")});
    QCOMPARE(VolnaGlobNum(), QStringLiteral("23"));
    QVERIFY(!QFileInfo::exists(env_->DataDir()));
}

// Expected: provider|data source|user|password|flags, the flags as D, B, O, Z or -.
void TestStartup::backEnd_data() {
    QTest::addColumn<QString>("ini");
    QTest::addColumn<QString>("rowOf");
    QTest::addColumn<QString>("row");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const QString& ini, const char* flags,
                        const char* expected, const QString& rowOf = kOwn) {
        QTest::newRow(name) << ini << rowOf << flags << QString::fromUtf8(expected);
    };
    const char* all = "1, 1, 1, 1";
    row("complete, own login", kLogin, all, "SQLOLEDB|srv\\office|dana|p;w|DBOZ");
    row("shared login 000, own password ignored",
        "[MSSQL]\nProvider=P\nDataSource=S\n[1]\nPassWord=own\n[000]\nUserID=office\n"
        "PassWord=shared\n",
        all, "P|S|office|shared|DBOZ");
    row("no provider", "[MSSQL]\nDataSource=S\n[1]\nUserID=dana\nPassWord=p\n", all,
        "|S|dana|p|----");
    row("no login in either section",
        "[MSSQL]\nProvider=P\nDataSource=S\n[2]\nUserID=other\n[000]\nPassWord=y\n", all,
        "P|S||y|----");
    row("true written as -1", kLogin, "-1, 0, 0, -1", "SQLOLEDB|srv\\office|dana|p;w|D--Z");
    row("null reads as false", kLogin, "NULL, 1, NULL, NULL", "SQLOLEDB|srv\\office|dana|p;w|-B--");
    row("no row for this installation", kLogin, all, "SQLOLEDB|srv\\office|dana|p;w|----",
        QStringLiteral("23"));
}

void TestStartup::backEnd() {
    QFETCH(QString, ini);
    QFETCH(QString, rowOf);
    QFETCH(QString, row);
    QFETCH(QString, expected);
    Sample(ini);
    SetRow(rowOf, row);
    GetMSSQLParam();
    QCOMPARE(QStringList({Provider(), DataSource(), UserID(), PassWord(), Flags()})
                 .join(QLatin1Char('|')),
             expected);
    QCOMPARE(Ui().Texts(), QStringList());
}

// The dialog reads the settings again when it loads; a flag once set is not taken back.
void TestStartup::flagStaysSet() {
    Sample(kLogin);
    SetRow(kOwn, QStringLiteral("0, 1, 1, 0"));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("-BO-"));
    SetRow(kOwn, QStringLiteral("1, 0, 0, 0"));
    GetMSSQLParam();
    QCOMPARE(Flags(), QStringLiteral("DBO-"));
}

// Every column is read before a flag is set: a row that cannot be read sets none, and the
// login read before stays.
void TestStartup::rowWithoutAFlagColumn() {
    Sample(kLogin);
    SetRow(kOwn, QStringLiteral("1, 1, 1, 1"));
    test::Execute(QStringLiteral("MAIN"), QStringLiteral("ALTER TABLE MSql DROP COLUMN IsZorva"));
    GetMSSQLParam();
    QCOMPARE(Ui().Messages().size(), std::size_t{1});
    const test::ShownMessage& m = Ui().Messages().front();
    QVERIFY2(m.text.startsWith(QStringLiteral("3265-0-GetMSSQLParam-")), qPrintable(m.text));
    QCOMPARE(m.style, int{vbOKOnly});
    QCOMPARE(Flags(), QStringLiteral("----"));
    QCOMPARE(UserID(), QStringLiteral("dana"));
    QCOMPARE(DataSource(), QStringLiteral("srv\\office"));
}

QTEST_MAIN(TestStartup)
#include "test_startup.moc"

// Installation settings: the read order of store and file, where the per-user settings
// file lives, and the work folder.
#include <QtTest>

#include "scripted_ui.h"
#include "startup/settings.h"
#include "test_env.h"
#include "test_files.h"
#include "util/settings_store.h"
#include "util/state.h"

using namespace zv;

namespace {

QStringList Tree(const QString& root) {
    QStringList out;
    QDirIterator it(root, QDir::AllEntries | QDir::NoDotAndDotDot, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        out << it.next().mid(root.size());
    }
    out.sort();
    return out;
}

const QStringList kWorkFolders{QStringLiteral("/Dat1"),         QStringLiteral("/Dat1/BakMDB"),
                               QStringLiteral("/Dat1/DTDef"),   QStringLiteral("/Dat1/Def"),
                               QStringLiteral("/Dat1/GDetDef"), QStringLiteral("/Dat1/Temp")};

}  // namespace

class TestSettings : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void readOrder_data();
    void readOrder();
    void location_data();
    void location();
    void noFallbackBeforeMainPath();
    void basicParamsAndIdempotentWorkFolders();
    void missingMainPathFolderIsReported();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    QString GlobalFile() const {
        return env_->LocalAppData() + QStringLiteral("/Zorvane/Kavex32R.txt");
    }
    // A path inside a regular file: no folder can ever be made there.
    QString Unusable() const {
        test::WriteFile(env_->Root() + QStringLiteral("/plainfile"), "x");
        return env_->Root() + QStringLiteral("/plainfile/sub");
    }
};

void TestSettings::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
}

void TestSettings::cleanup() {
    ui_.reset();
    env_.reset();
}

void TestSettings::readOrder_data() {
    QTest::addColumn<QString>("store");
    QTest::addColumn<QString>("file");
    QTest::addColumn<bool>("development");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* store, const char* file, bool development,
                        const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(store) << QString::fromLatin1(file)
                            << development << QString::fromLatin1(expected);
    };
    row("store wins", "store", "file", false, "store");
    row("file when store lacks it", "", "file", false, "file");
    row("neither", "", "", false, "");
    row("development: file alone", "store", "file", true, "file");
    row("development: store only reads empty", "store", "", true, "");
}

void TestSettings::readOrder() {
    QFETCH(QString, store);
    QFETCH(QString, file);
    QFETCH(bool, development);
    QFETCH(QString, expected);
    if (!store.isEmpty()) {
        SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("LNUM"),
                    store);
    }
    QVERIFY(test::WriteFile(GlobalFile(), "[General]\r\nLNUM=" + file.toUtf8() + "\r\n"));
    SetIsDevelopmentRun(development);
    QCOMPARE(ReadSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                         QStringLiteral("LNUM"), {}),
             expected);
}

// "%R" stands for the test's folder, "%L" for its LOCALAPPDATA; "-" unsets LOCALAPPDATA and
// points XDG_DATA_HOME at "%R".
void TestSettings::location_data() {
    QTest::addColumn<QString>("localAppData");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* localAppData, const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(localAppData) << QString::fromLatin1(expected);
    };
    row("LOCALAPPDATA present", "%L", "%L/Zorvane/Kavex32R.txt");
    row("LOCALAPPDATA not yet there", "%R/new/local", "%R/new/local/Kavex32R.txt");
    row("LOCALAPPDATA absent", "-", "%R/Zorvane/Kavex32R.txt");
}

void TestSettings::location() {
    QFETCH(QString, localAppData);
    QFETCH(QString, expected);
    for (QString* s : {&localAppData, &expected}) {
        s->replace(QStringLiteral("%R"), env_->Root())
            .replace(QStringLiteral("%L"), env_->LocalAppData());
    }
    const QByteArray oldDataHome = qgetenv("XDG_DATA_HOME");
    if (localAppData == QLatin1String("-")) {
        qunsetenv("LOCALAPPDATA");
        qputenv("XDG_DATA_HOME", env_->Root().toUtf8());
    } else {
        qputenv("LOCALAPPDATA", localAppData.toUtf8());
    }
    const QString file = GetGlobalKeysFile();
    qputenv("XDG_DATA_HOME", oldDataHome);
    QCOMPARE(file, expected);
    QVERIFY(QFileInfo(file).dir().exists());
}

void TestSettings::noFallbackBeforeMainPath() {
    qputenv("LOCALAPPDATA", Unusable().toUtf8());
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
    QVERIFY(!(*ui_)->Texts().isEmpty());
    QVERIFY(test::WriteFile(GetGlobalKeysFile(), "[General]\nMyUser=3\n"));
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MyUser")),
             QStringLiteral("3"));
}

void TestSettings::basicParamsAndIdempotentWorkFolders() {
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
    QCOMPARE(Tree(env_->DataDir()), kWorkFolders);
    QCOMPARE((*ui_)->Texts(), QStringList());
    // Preparing again keeps what the folders hold.
    QVERIFY(test::WriteFile(env_->DataDir() + QStringLiteral("/Dat1/Temp/keep.txt"), "keep"));
    PrepareWorkDir(env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(GetWorkDir(), env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(Tree(env_->DataDir()),
             kWorkFolders + QStringList{QStringLiteral("/Dat1/Temp/keep.txt")});
}

void TestSettings::missingMainPathFolderIsReported() {
    QVERIFY(test::WriteFile(GlobalFile(), "[General]\nMainPath=" + env_->DataDir().toUtf8() +
                                              "\nVolnaGlobNum=23\nMyUser=4\n"));
    SetBasicParam();
    QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("76-0--SetBasicParam-Path not found")});
    QCOMPARE(VolnaGlobNum(), QStringLiteral("23"));
    QVERIFY(!QFileInfo::exists(env_->DataDir()));
}

QTEST_MAIN(TestSettings)
#include "test_settings.moc"

// Installation settings: the read order of store and file, where the per-user settings
// file lives, and the work folder.
#include <QtTest>

#include "scripted_ui.h"
#include "startup/settings.h"
#include "test_env.h"
#include "util/settings_store.h"
#include "util/state.h"

using namespace zv;

namespace {

void WriteFile(const QString& path, const QByteArray& content) {
    QVERIFY(QDir().mkpath(QFileInfo(path).path()));
    QFile f(path);
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write(content);
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
    void fileUnderExistingLocalAppData();
    void localAppDataNotYetThere();
    void xdgDataHomeWithoutLocalAppData();
    void fallbackInsideInstallation();
    void noFallbackBeforeMainPath();
    void pathIsCached();
    void basicParamsAndWorkFolders();
    void workFoldersIdempotent();
    void missingMainPathFolderIsReported();
    void noWorkFolderWithoutMainPath();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    QString GlobalFile() const {
        return env_->LocalAppData() + QStringLiteral("/Zorvane/Kavex32R.txt");
    }
    // A path inside a regular file: no folder can ever be made there.
    QString Unusable() const {
        WriteFile(env_->Root() + QStringLiteral("/plainfile"), "x");
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
    QTest::newRow("store wins") << "store"
                                << "file" << false << "store";
    QTest::newRow("file when store lacks it") << ""
                                              << "file" << false << "file";
    QTest::newRow("neither") << ""
                             << "" << false << "";
    QTest::newRow("development: file alone") << "store"
                                             << "file" << true << "file";
    QTest::newRow("development: store only reads empty") << "store"
                                                         << "" << true << "";
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
    WriteFile(GlobalFile(), "[General]\r\nLNUM=" + file.toUtf8() + "\r\n");
    SetIsDevelopmentRun(development);
    QCOMPARE(ReadSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                         QStringLiteral("LNUM"), {}),
             expected);
}

void TestSettings::fileUnderExistingLocalAppData() {
    QCOMPARE(GetGlobalKeysFile(), GlobalFile());
    QVERIFY(QFileInfo(env_->LocalAppData() + QStringLiteral("/Zorvane")).isDir());
    WriteFile(GlobalFile(), "[General]\nMyUser=12\n");
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MyUser")),
             QStringLiteral("12"));
}

void TestSettings::localAppDataNotYetThere() {
    const QString fresh = env_->Root() + QStringLiteral("/new/local");
    qputenv("LOCALAPPDATA", fresh.toUtf8());
    QCOMPARE(GetGlobalKeysFile(), fresh + QStringLiteral("/Kavex32R.txt"));
    QVERIFY(QFileInfo(fresh).isDir());
    QVERIFY(!QFileInfo::exists(fresh + QStringLiteral("/Zorvane")));
}

void TestSettings::xdgDataHomeWithoutLocalAppData() {
    qunsetenv("LOCALAPPDATA");
    const QByteArray old = qgetenv("XDG_DATA_HOME");
    qputenv("XDG_DATA_HOME", env_->Root().toUtf8());
    const QString file = GetGlobalKeysFile();
    qputenv("XDG_DATA_HOME", old);
    QCOMPARE(file, env_->Root() + QStringLiteral("/Zorvane/Kavex32R.txt"));
}

void TestSettings::fallbackInsideInstallation() {
    qputenv("LOCALAPPDATA", Unusable().toUtf8());
    SetMainPath(env_->DataDir());
    QVERIFY(QDir().mkpath(env_->DataDir()));
    QCOMPARE(GetGlobalKeysFile(), env_->DataDir() + QStringLiteral("/Def/UMR/Kavex32R.txt"));
    QVERIFY(QFileInfo(env_->DataDir() + QStringLiteral("/Def/UMR")).isDir());
    // The failed attempts at the unusable folder were reported.
    QVERIFY(!(*ui_)->Texts().isEmpty());
}

void TestSettings::noFallbackBeforeMainPath() {
    qputenv("LOCALAPPDATA", Unusable().toUtf8());
    const bool atRootBefore = QFileInfo::exists(QStringLiteral("/Def/UMR"));
    QCOMPARE(GetGlobalKeysFile(), QString());
    QCOMPARE(GlobalKeysFileCache(), QString());
    QCOMPARE(QFileInfo::exists(QStringLiteral("/Def/UMR")), atRootBefore);
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MainPath")), QString());
    // Once MainPath is known the fallback folder is used.
    SetMainPath(env_->DataDir());
    QVERIFY(QDir().mkpath(env_->DataDir()));
    WriteFile(env_->DataDir() + QStringLiteral("/Def/UMR/Kavex32R.txt"), "[General]\nMyUser=3\n");
    QCOMPARE(ReadGlobalKeys(QStringLiteral("General"), QStringLiteral("MyUser")),
             QStringLiteral("3"));
}

void TestSettings::pathIsCached() {
    const QString first = GetGlobalKeysFile();
    qputenv("LOCALAPPDATA", (env_->Root() + QStringLiteral("/elsewhere")).toUtf8());
    QCOMPARE(GetGlobalKeysFile(), first);
    QVERIFY(!QFileInfo::exists(env_->Root() + QStringLiteral("/elsewhere")));
}

void TestSettings::basicParamsAndWorkFolders() {
    QVERIFY(QDir().mkpath(env_->DataDir()));
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MainPath"),
                env_->DataDir());
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUser"),
                QStringLiteral("7"));
    WriteFile(GlobalFile(), "[General]\nMyUserName=\"דנה כהן\"\nVolnaGlobNum=23\nMyUser=9\n");
    SetBasicParam();
    QCOMPARE(MainPath(), env_->DataDir());
    QCOMPARE(MyUser(), QStringLiteral("7"));
    QCOMPARE(MyUserName(), QStringLiteral("דנה כהן"));
    QCOMPARE(VolnaGlobNum(), QStringLiteral("23"));
    QCOMPARE(GetWorkDir(), env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(Tree(env_->DataDir()), kWorkFolders);
    QCOMPARE((*ui_)->Texts(), QStringList());
}

void TestSettings::workFoldersIdempotent() {
    QVERIFY(QDir().mkpath(env_->DataDir() + QStringLiteral("/Dat1/Temp")));
    WriteFile(env_->DataDir() + QStringLiteral("/Dat1/Temp/keep.txt"), "keep");
    PrepareWorkDir(env_->DataDir() + QStringLiteral("/Dat1"));
    QCOMPARE(GetWorkDir(), env_->DataDir() + QStringLiteral("/Dat1/"));
    const QStringList once = Tree(env_->DataDir());
    PrepareWorkDir(env_->DataDir() + QStringLiteral("/Dat1/"));
    QCOMPARE(Tree(env_->DataDir()), once);
    QCOMPARE(once, kWorkFolders + QStringList{QStringLiteral("/Dat1/Temp/keep.txt")});
}

void TestSettings::missingMainPathFolderIsReported() {
    WriteFile(GlobalFile(),
              "[General]\nMainPath=" + env_->DataDir().toUtf8() + "\nVolnaGlobNum=23\nMyUser=4\n");
    SetBasicParam();
    QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("76-0--SetBasicParam-Path not found")});
    QCOMPARE(VolnaGlobNum(), QStringLiteral("23"));
    QVERIFY(!QFileInfo::exists(env_->DataDir()));
}

void TestSettings::noWorkFolderWithoutMainPath() {
    SetBasicParam();
    QCOMPARE(MainPath(), QString());
    QCOMPARE(GetWorkDir(), QString());
    QCOMPARE((*ui_)->Texts(), QStringList());
}

QTEST_MAIN(TestSettings)
#include "test_settings.moc"

// The per-user settings store: names without case, the suite's section General kept as a
// plain [General] section of a readable file.
#include <QtTest>

#include "test_env.h"
#include "util/settings_store.h"

using namespace zv;

class TestSettingsStore : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void fileFollowsConfigHome();
    void roundTrip_data();
    void roundTrip();
    void generalIsAPlainSection();
    void handWrittenGeneralIsRead();
    void missingKeyGivesDefault();
};

void TestSettingsStore::fileFollowsConfigHome() {
    test::TestEnv env;
    QCOMPARE(SettingsStoreFile(QStringLiteral("KAVEX32")),
             env.ConfigHome() + QStringLiteral("/zorvane/kavex32.ini"));
    qunsetenv("XDG_CONFIG_HOME");
    QCOMPARE(SettingsStoreFile(QStringLiteral("Kavex32")),
             QDir::homePath() + QStringLiteral("/.config/zorvane/kavex32.ini"));
}

void TestSettingsStore::roundTrip_data() {
    QTest::addColumn<QString>("saveApp");
    QTest::addColumn<QString>("saveSection");
    QTest::addColumn<QString>("saveKey");
    QTest::addColumn<QString>("readApp");
    QTest::addColumn<QString>("readSection");
    QTest::addColumn<QString>("readKey");
    QTest::addColumn<QString>("value");
    QTest::newRow("same names") << "Kavex32"
                                << "General"
                                << "MainPath"
                                << "Kavex32"
                                << "General"
                                << "MainPath"
                                << "D:\\Data";
    QTest::newRow("application case") << "Kavex32"
                                      << "General"
                                      << "VolnaGlobNum"
                                      << "KAVEX32"
                                      << "General"
                                      << "VolnaGlobNum"
                                      << "23";
    QTest::newRow("section and key case") << "Kavex32"
                                          << "GENERAL"
                                          << "myuser"
                                          << "kavex32"
                                          << "General"
                                          << "MyUser"
                                          << "7";
    QTest::newRow("other section") << "Kavex32"
                                   << "Grid"
                                   << "Width"
                                   << "KAVEX32"
                                   << "grid"
                                   << "WIDTH"
                                   << "1200";
    QTest::newRow("Hebrew and commas") << "Kavex32"
                                       << "General"
                                       << "MyUserName"
                                       << "Kavex32"
                                       << "General"
                                       << "MyUserName"
                                       << "כהן, דנה";
}

void TestSettingsStore::roundTrip() {
    QFETCH(QString, saveApp);
    QFETCH(QString, saveSection);
    QFETCH(QString, saveKey);
    QFETCH(QString, readApp);
    QFETCH(QString, readSection);
    QFETCH(QString, readKey);
    QFETCH(QString, value);
    test::TestEnv env;
    SaveSetting(saveApp, saveSection, saveKey, value);
    QCOMPARE(GetSetting(readApp, readSection, readKey, QStringLiteral("none")), value);
    // Saving under another spelling replaces the value rather than adding a second key.
    SaveSetting(readApp, readSection, readKey, QStringLiteral("second"));
    QCOMPARE(GetSetting(saveApp, saveSection, saveKey, {}), QStringLiteral("second"));
}

void TestSettingsStore::generalIsAPlainSection() {
    test::TestEnv env;
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MainPath"),
                QStringLiteral("/srv/zorvane"));
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUserName"),
                QStringLiteral("דנה"));
    QFile f(SettingsStoreFile(QStringLiteral("Kavex32")));
    QVERIFY(f.open(QIODevice::ReadOnly));
    const QString text = QString::fromUtf8(f.readAll());
    QVERIFY2(text.startsWith(QStringLiteral("[General]\n")), qPrintable(text));
    QVERIFY(text.contains(QStringLiteral("MainPath=/srv/zorvane\n")));
    QVERIFY(!text.contains(QStringLiteral("%General")));
}

void TestSettingsStore::handWrittenGeneralIsRead() {
    test::TestEnv env;
    const QString file = SettingsStoreFile(QStringLiteral("Kavex32"));
    QVERIFY(QDir().mkpath(QFileInfo(file).path()));
    QFile f(file);
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write("[General]\nMainPath=/srv/z\nVolnaGlobNum=23\n");
    f.close();
    QCOMPARE(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                        QStringLiteral("VolnaGlobNum"), {}),
             QStringLiteral("23"));
}

void TestSettingsStore::missingKeyGivesDefault() {
    test::TestEnv env;
    QCOMPARE(GetSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                        QStringLiteral("MainPath"), QStringLiteral("dflt")),
             QStringLiteral("dflt"));
    QVERIFY(!QFileInfo::exists(SettingsStoreFile(QStringLiteral("Kavex32"))));
}

QTEST_MAIN(TestSettingsStore)
#include "test_settings_store.moc"

// The per-user settings store: names without case, the suite's section General kept as a
// plain [General] section of a readable file.
#include <QtTest>

#include "test_env.h"
#include "test_files.h"
#include "util/settings_store.h"

using namespace zv;

class TestSettingsStore : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void fileFollowsConfigHome();
    void roundTrip();
    void generalIsAPlainSection();
};

void TestSettingsStore::fileFollowsConfigHome() {
    test::TestEnv env;
    QCOMPARE(SettingsStoreFile(QStringLiteral("KAVEX32")),
             env.ConfigHome() + QStringLiteral("/zorvane/kavex32.ini"));
    qunsetenv("XDG_CONFIG_HOME");
    QCOMPARE(SettingsStoreFile(QStringLiteral("Kavex32")),
             QDir::homePath() + QStringLiteral("/.config/zorvane/kavex32.ini"));
}

// Names are without case: saved under one spelling, read and replaced under another.
void TestSettingsStore::roundTrip() {
    test::TestEnv env;
    const QStringList rows{QStringLiteral("Kavex32/GENERAL/myuser|kavex32/General/MyUser"),
                           QStringLiteral("Kavex32/Grid/Width|KAVEX32/grid/WIDTH"),
                           QStringLiteral("Kavex32/General/MyUserName|KAVEX32/general/myusername")};
    for (const QString& row : rows) {
        const QStringList saveAs = row.section(QLatin1Char('|'), 0, 0).split(QLatin1Char('/'));
        const QStringList readAs = row.section(QLatin1Char('|'), 1).split(QLatin1Char('/'));
        const QString value = QStringLiteral("כהן, דנה ") + row;
        QCOMPARE(GetSetting(readAs[0], readAs[1], readAs[2], QStringLiteral("none")),
                 QStringLiteral("none"));
        SaveSetting(saveAs[0], saveAs[1], saveAs[2], value);
        QCOMPARE(GetSetting(readAs[0], readAs[1], readAs[2], {}), value);
        SaveSetting(readAs[0], readAs[1], readAs[2], QStringLiteral("second"));
        QCOMPARE(GetSetting(saveAs[0], saveAs[1], saveAs[2], {}), QStringLiteral("second"));
    }
}

void TestSettingsStore::generalIsAPlainSection() {
    test::TestEnv env;
    const QString file = SettingsStoreFile(QStringLiteral("Kavex32"));
    QVERIFY(test::WriteFile(file, "[General]\nMainPath=/srv/z\nVolnaGlobNum=23\n"));
    QCOMPARE(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                        QStringLiteral("VolnaGlobNum"), {}),
             QStringLiteral("23"));
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), QStringLiteral("MyUserName"),
                QStringLiteral("דנה"));
    const QString text = QString::fromUtf8(test::ReadFile(file).toLatin1());
    QVERIFY2(text.startsWith(QStringLiteral("[General]\n")), qPrintable(text));
    QVERIFY(text.contains(QStringLiteral("MainPath=/srv/z\n")));
    QVERIFY(!text.contains(QStringLiteral("%General")));
}

QTEST_MAIN(TestSettingsStore)
#include "test_settings_store.moc"

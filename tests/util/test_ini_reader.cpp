// The INI reader against files as the suite and its users write them.
#include <QStringEncoder>
#include <QtTest>

#include "test_files.h"
#include "util/ini_reader.h"

using namespace zv;

class TestIniReader : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void windowsSemantics_data();
    void windowsSemantics();
};

void TestIniReader::windowsSemantics_data() {
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("section");
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const QByteArray& content, const char* section,
                        const char* key, const QString& expected) {
        QTest::newRow(name) << content << QString::fromUtf8(section) << QString::fromUtf8(key)
                            << expected;
    };
    const QByteArray basic =
        "[General]\r\nMainPath=D:\\Data\r\nMyUser=7\r\n[Other]\r\nMyUser=9\r\n";
    row("missing file", QByteArray(), "General", "MainPath", "");
    row("plain", basic, "General", "MainPath", "D:\\Data");
    row("names without case", basic, "GENERAL", "mainpath", "D:\\Data");
    row("section chosen", basic, "other", "MyUser", "9");
    row("missing key", basic, "General", "VolnaGlobNum", "");
    row("first key wins", "[G]\nk=1\nK=2\n", "G", "k", "1");
    row("first section wins", "[G]\na=1\n[g]\nb=2\n", "G", "b", "");
    row("blanks trimmed", "  [ G ]  \n  key   =   a b  \t\n", "G", "key", "a b");
    row("double quotes", "[G]\nk=\" x \"\n", "G", "k", " x ");
    row("unmatched quotes kept", "[G]\nk=\"y'\n", "G", "k", "\"y'");
    row("no unescaping", "[G]\nk=a\\tb, c;d\n", "G", "k", "a\\tb, c;d");
    row("empty value", "[G]\nk=\nk=2\n", "G", "k", "");
    row("line without equals", "[G]\nk\nk=3\n", "G", "k", "3");
    row("keys outside sections", "k=0\n[G]\nk=4\n", "G", "k", "4");
    row("cut at 511", "[G]\nk=" + QByteArray(600, 'x'), "G", "k", QString(511, 'x'));
    const QString hebrew(600, QChar(0x05D0));
    row("cut in characters", "[G]\nk=" + hebrew.toUtf8(), "G", "k", hebrew.left(511));
    const QString text = QStringLiteral("[General]\r\nMyUserName=דנה כהן\r\n");
    const QString name = QStringLiteral("דנה כהן");
    row("UTF-8 with BOM", "\xEF\xBB\xBF" + text.toUtf8(), "General", "MyUserName", name);
    QStringEncoder cp1255("windows-1255");
    row("Windows-1255", cp1255.encode(text), "General", "MyUserName", name);
}

void TestIniReader::windowsSemantics() {
    QFETCH(QByteArray, content);
    QFETCH(QString, section);
    QFETCH(QString, key);
    QFETCH(QString, expected);
    QTemporaryDir dir;
    const QString file = dir.filePath(QStringLiteral("Kavex32R.txt"));
    if (!content.isNull()) {
        QVERIFY(test::WriteFile(file, content));
    }
    QCOMPARE(ReadINI(section, key, file), expected);
}

QTEST_MAIN(TestIniReader)
#include "test_ini_reader.moc"

// The INI reader against files as the suite and its users write them.
#include <QStringEncoder>
#include <QtTest>

#include "scripted_ui.h"
#include "test_env.h"
#include "util/ini_reader.h"

using namespace zv;

class TestIniReader : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void windowsSemantics_data();
    void windowsSemantics();
    void valuesAreCutAt511();
    void encodings_data();
    void encodings();
    void missingFileIsEmpty();
};

void TestIniReader::windowsSemantics_data() {
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("section");
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("expected");
    const QByteArray basic =
        "[General]\r\nMainPath=D:\\Data\r\nMyUser=7\r\n[Other]\r\nMyUser=9\r\n";
    QTest::newRow("plain") << basic << "General"
                           << "MainPath"
                           << "D:\\Data";
    QTest::newRow("names without case") << basic << "GENERAL"
                                        << "mainpath"
                                        << "D:\\Data";
    QTest::newRow("section chosen") << basic << "other"
                                    << "MyUser"
                                    << "9";
    QTest::newRow("missing key") << basic << "General"
                                 << "VolnaGlobNum"
                                 << "";
    QTest::newRow("missing section") << basic << "Nothing"
                                     << "MyUser"
                                     << "";
    QTest::newRow("first key wins") << QByteArray("[G]\nk=1\nK=2\n") << "G"
                                    << "k"
                                    << "1";
    QTest::newRow("first section wins") << QByteArray("[G]\na=1\n[g]\nb=2\n") << "G"
                                        << "b"
                                        << "";
    QTest::newRow("blanks trimmed") << QByteArray("  [ G ]  \n  key   =   a b  \t\n") << "G"
                                    << "key"
                                    << "a b";
    QTest::newRow("double quotes") << QByteArray("[G]\nk=\" x \"\n") << "G"
                                   << "k"
                                   << " x ";
    QTest::newRow("single quotes") << QByteArray("[G]\nk='y'\n") << "G"
                                   << "k"
                                   << "y";
    QTest::newRow("unmatched quotes kept") << QByteArray("[G]\nk=\"y'\n") << "G"
                                           << "k"
                                           << "\"y'";
    QTest::newRow("no unescaping") << QByteArray("[G]\nk=a\\tb, c;d\n") << "G"
                                   << "k"
                                   << "a\\tb, c;d";
    QTest::newRow("empty value") << QByteArray("[G]\nk=\nk=2\n") << "G"
                                 << "k"
                                 << "";
    QTest::newRow("equals in value") << QByteArray("[G]\nk=a=b\n") << "G"
                                     << "k"
                                     << "a=b";
    QTest::newRow("line without equals") << QByteArray("[G]\nk\nk=3\n") << "G"
                                         << "k"
                                         << "3";
    QTest::newRow("keys outside sections") << QByteArray("k=0\n[G]\nk=4\n") << "G"
                                           << "k"
                                           << "4";
}

void TestIniReader::windowsSemantics() {
    QFETCH(QByteArray, content);
    QFETCH(QString, section);
    QFETCH(QString, key);
    QFETCH(QString, expected);
    QTemporaryDir dir;
    const QString file = dir.filePath(QStringLiteral("s.ini"));
    QFile f(file);
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write(content);
    f.close();
    QCOMPARE(ReadINI(section, key, file), expected);
}

void TestIniReader::valuesAreCutAt511() {
    QTemporaryDir dir;
    const QString file = dir.filePath(QStringLiteral("long.ini"));
    QFile f(file);
    QVERIFY(f.open(QIODevice::WriteOnly));
    const QString hebrew = QString(600, QChar(0x05D0));
    f.write("[G]\nlong=" + QByteArray(600, 'x') + "\nhebrew=" + hebrew.toUtf8() +
            "\nexact=" + QByteArray(511, 'y') + "\n");
    f.close();
    QCOMPARE(ReadINI(QStringLiteral("G"), QStringLiteral("long"), file), QString(511, 'x'));
    QCOMPARE(ReadINI(QStringLiteral("G"), QStringLiteral("hebrew"), file), hebrew.left(511));
    QCOMPARE(ReadINI(QStringLiteral("G"), QStringLiteral("exact"), file), QString(511, 'y'));
}

void TestIniReader::encodings_data() {
    QTest::addColumn<QByteArray>("content");
    const QString text = QStringLiteral("[General]\r\nMyUserName=דנה כהן\r\n");
    QStringEncoder cp1255("windows-1255");
    QTest::newRow("UTF-8") << text.toUtf8();
    QTest::newRow("UTF-8 with BOM") << QByteArray("\xEF\xBB\xBF") + text.toUtf8();
    QTest::newRow("Windows-1255") << QByteArray(cp1255.encode(text));
}

void TestIniReader::encodings() {
    QFETCH(QByteArray, content);
    QTemporaryDir dir;
    const QString file = dir.filePath(QStringLiteral("Kavex32R.txt"));
    QFile f(file);
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write(content);
    f.close();
    QCOMPARE(ReadINI(QStringLiteral("General"), QStringLiteral("MyUserName"), file),
             QStringLiteral("דנה כהן"));
}

void TestIniReader::missingFileIsEmpty() {
    test::ScopedScriptedUi ui;
    QTemporaryDir dir;
    QCOMPARE(ReadINI(QStringLiteral("G"), QStringLiteral("k"), dir.filePath(QStringLiteral("no"))),
             QString());
    QCOMPARE(ReadINI(QStringLiteral("G"), QStringLiteral("k"), QString()), QString());
    QCOMPARE(ui->Texts(), QStringList());
}

QTEST_MAIN(TestIniReader)
#include "test_ini_reader.moc"

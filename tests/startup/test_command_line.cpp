// The command line: options, the request bytes after them and their decoding.
#include <QStringEncoder>
#include <QtTest>

#include "startup/command_line.h"
#include "startup/request_text.h"

using namespace zv;

class TestCommandLine : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void options_data();
    void options();
    void decoding_data();
    void decoding();
};

void TestCommandLine::options_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<bool>("batch");
    QTest::addColumn<bool>("help");
    QTest::addColumn<bool>("error");
    QTest::addColumn<QByteArray>("request");
    using L = QList<QByteArray>;
    QTest::newRow("request only") << L{"1\xC2\xA5/t/a.doc\xC2\xA5x"} << false << false << false
                                  << QByteArray("1\xC2\xA5/t/a.doc\xC2\xA5x");
    QTest::newRow("batch") << L{"--batch", "--client", "1001", ""} << true << false << false
                           << QByteArray();
    QTest::newRow("nothing") << L{} << false << false << false << QByteArray();
    QTest::newRow("split request joined")
        << L{"--batch", "--client", "1001", "1\xA5/t/my", "file.doc\xA5x"} << true << false << false
        << QByteArray("1\xA5/t/my file.doc\xA5x");
    QTest::newRow("options end at the request") << L{"1\xA5p\xA5n", "--batch"} << false << false
                                                << false << QByteArray("1\xA5p\xA5n --batch");
    QTest::newRow("double dash") << L{"--batch", "--client", "1001", "--", "-1\xA5p\xA5n"} << true
                                 << false << false << QByteArray("-1\xA5p\xA5n");
    QTest::newRow("help") << L{"--help"} << false << true << false << QByteArray();
    QTest::newRow("unknown option") << L{"--bogus", "x"} << false << false << true << QByteArray();
    QTest::newRow("single-dash unknown") << L{"-x"} << false << false << true << QByteArray();
}

void TestCommandLine::options() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(bool, batch);
    QFETCH(bool, help);
    QFETCH(bool, error);
    QFETCH(QByteArray, request);
    const CommandLine cl = ParseCommandLine(args);
    QCOMPARE(cl.batch, batch);
    QCOMPARE(cl.help, help);
    QCOMPARE(!cl.error.isEmpty(), error);
    if (!error) {
        QCOMPARE(cl.request, request);
    }
}

void TestCommandLine::decoding_data() {
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QStringList>("fields");
    QStringEncoder cp1255("windows-1255");
    const QString hebrew = QStringLiteral("2¥/tmp/דואר.msg¥נושא המכתב");
    QTest::newRow("UTF-8") << hebrew.toUtf8() << QStringList{"2", "/tmp/דואר.msg", "נושא המכתב"};
    QTest::newRow("Windows-1255") << QByteArray(cp1255.encode(hebrew))
                                  << QStringList{"2", "/tmp/דואר.msg", "נושא המכתב"};
    QTest::newRow("byte A5 in ASCII text") << QByteArray(
                                                  "1\xA5"
                                                  "C:\\Temp\\x.docx\xA5Letter")
                                           << QStringList{"1", "C:\\Temp\\x.docx", "Letter"};
}

void TestCommandLine::decoding() {
    QFETCH(QByteArray, bytes);
    QFETCH(QStringList, fields);
    QCOMPARE(SplitRequest(DecodeArgumentText(bytes)), fields);
}

QTEST_MAIN(TestCommandLine)
#include "test_command_line.moc"

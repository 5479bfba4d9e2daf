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

// Expected: "error", "help", or the request bytes after "batch " when --batch was given.
void TestCommandLine::options_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<QByteArray>("expected");
    using L = QList<QByteArray>;
    QTest::newRow("request only") << L{"1\xA5/t/a.doc\xA5x"} << QByteArray("1\xA5/t/a.doc\xA5x");
    QTest::newRow("batch") << L{"--batch", "--client", "1001", ""} << QByteArray("batch ");
    QTest::newRow("split request joined")
        << L{"--batch", "--client", "1001", "1\xA5/t/my", "file.doc\xA5x"}
        << QByteArray("batch 1\xA5/t/my file.doc\xA5x");
    QTest::newRow("options end at the request")
        << L{"1\xA5p\xA5n", "--batch"} << QByteArray("1\xA5p\xA5n --batch");
    QTest::newRow("double dash") << L{"--batch", "--client", "1001", "--", "-1\xA5p\xA5n"}
                                 << QByteArray("batch -1\xA5p\xA5n");
    QTest::newRow("help") << L{"--help"} << QByteArray("help");
    QTest::newRow("unknown option") << L{"--bogus", "x"} << QByteArray("error");
    QTest::newRow("single-dash unknown") << L{"-x"} << QByteArray("error");
}

void TestCommandLine::options() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(QByteArray, expected);
    const CommandLine cl = ParseCommandLine(args);
    const QByteArray found = !cl.error.isEmpty() ? QByteArray("error")
                             : cl.help           ? QByteArray("help")
                                                 : (cl.batch ? "batch " : "") + cl.request;
    QCOMPARE(found, expected);
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

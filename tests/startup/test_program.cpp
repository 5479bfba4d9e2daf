// The built program as the suite starts it: exit status, messages on standard error in
// --batch, and the work folders it leaves.
#include <QStringEncoder>
#include <QtTest>

#include "installation.h"
#include "test_env.h"

using namespace zv;

namespace {

struct Result {
    int status = -1;
    QString err;
    QString out;
};

// Arguments are raw bytes, as the suite passes them; QProcess would re-encode text, so a
// shell hands each argument over from a file.
Result RunProgram(const QList<QByteArray>& args, const test::TestEnv& env) {
    QTemporaryDir argDir;
    QString script = QStringLiteral("exec \"$0\"");
    QStringList list{
        QStringLiteral("-c"), QString(),
        qEnvironmentVariable("ZV_TEST_BUILD_DIR") + QStringLiteral("/src/app/zorvane-filer")};
    for (qsizetype i = 0; i < args.size(); ++i) {
        const QString file = argDir.filePath(QString::number(i));
        test::WriteBytes(file, args.at(i));
        script += QStringLiteral(" \"$(cat \"$%1\")\"").arg(i + 1);
        list << file;
    }
    list[1] = script;
    QProcess p;
    QProcessEnvironment pe = QProcessEnvironment::systemEnvironment();
    pe.insert(QStringLiteral("XDG_CONFIG_HOME"), env.ConfigHome());
    pe.insert(QStringLiteral("LOCALAPPDATA"), env.LocalAppData());
    pe.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    pe.remove(QStringLiteral("ZORVANE_DEVELOPMENT_RUN"));
    p.setProcessEnvironment(pe);
    p.start(QStringLiteral("/bin/sh"), list);
    if (!p.waitForFinished(30000)) {
        p.kill();
        return {};
    }
    Result r;
    r.status = p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -2;
    r.err = QString::fromUtf8(p.readAllStandardError());
    r.out = QString::fromUtf8(p.readAllStandardOutput());
    return r;
}

}  // namespace

class TestProgram : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void refusals_data();
    void refusals();
    void handledRequestPreparesWorkFolders();
    void windows1255Request();
    void options_data();
    void options();
};

void TestProgram::initTestCase() {
    QVERIFY(!qEnvironmentVariable("ZV_TEST_BUILD_DIR").isEmpty());
}

void TestProgram::refusals_data() {
    QTest::addColumn<int>("setup");  // 0 nothing, 1 no executable, 2 complete
    QTest::addColumn<QByteArray>("request");
    QTest::addColumn<QString>("expected");
    QTest::newRow("not identified")
        << 0 << QByteArray() << QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה\n");
    QTest::newRow("no executable")
        << 1 << QByteArray() << QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף\n%M\n");
    QTest::newRow("malformed") << 2 << QByteArray("1\xC2\xA5only-path")
                               << QStringLiteral("הפעלה לא חוקית של שרות זה\n");
    QTest::newRow("missing file") << 2 << QByteArray("1\xC2\xA5/no/such.doc\xC2\xA5n")
                                  << QStringLiteral("קריאה לא תקינה של שרות זה\n/no/such.doc\n");
}

void TestProgram::refusals() {
    QFETCH(int, setup);
    QFETCH(QByteArray, request);
    QFETCH(QString, expected);
    test::TestEnv env;
    if (setup > 0) {
        test::MakeInstallation(env, setup == 2);
    }
    expected.replace(QStringLiteral("%M"), env.DataDir());
    const Result r = RunProgram({"--batch", request}, env);
    QCOMPARE(r.status, 1);
    QVERIFY2(r.err.endsWith(expected), qPrintable(r.err));
}

void TestProgram::handledRequestPreparesWorkFolders() {
    test::TestEnv env;
    const test::Installation inst = test::MakeInstallation(env);
    const Result r = RunProgram({"--batch", "--client", "1001",
                                 "1\xC2\xA5" + inst.document.toUtf8() +
                                     "\xC2\xA5"
                                     "Letter"},
                                env);
    // Handled, not filed: this installation has no client databases.
    QCOMPARE(r.status, 1);
    QVERIFY2(!r.err.contains(QStringLiteral("שרות")), qPrintable(r.err));
    QStringList folders =
        QDir(inst.mainPath + QStringLiteral("/Dat1")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    folders.sort();
    QCOMPARE(folders, (QStringList{"BakMDB", "DTDef", "Def", "GDetDef", "Temp"}));
}

void TestProgram::windows1255Request() {
    test::TestEnv env;
    const test::Installation inst = test::MakeInstallation(env);
    const QString hebrewDoc = env.Root() + QStringLiteral("/in/מכתב.doc");
    QVERIFY(test::WriteBytes(hebrewDoc, "x"));
    QStringEncoder cp1255("windows-1255");
    // The suite passes the request in its ANSI code page: "¥" is the single byte A5.
    const QByteArray request = cp1255.encode(QStringLiteral("2¥") + hebrewDoc + "¥נושא");
    QVERIFY(request.contains('\xA5'));
    // The file's name on disk is UTF-8, so a path decoded from Windows-1255 must match it.
    const Result r = RunProgram({"--batch", "--client", "1001", request}, env);
    QCOMPARE(r.status, 1);
    QVERIFY2(!r.err.contains(QStringLiteral("שרות")), qPrintable(r.err));
}

void TestProgram::options_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<int>("status");
    QTest::addColumn<QString>("outStart");
    QTest::newRow("version") << QList<QByteArray>{"--version"} << 0
                             << QStringLiteral("zorvane-filer ");
    QTest::newRow("help") << QList<QByteArray>{"--help"} << 0 << QStringLiteral("Usage: ");
    QTest::newRow("unknown option") << QList<QByteArray>{"--bogus"} << 2 << QString();
}

void TestProgram::options() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(int, status);
    QFETCH(QString, outStart);
    test::TestEnv env;
    const Result r = RunProgram(args, env);
    QCOMPARE(r.status, status);
    if (outStart.isEmpty()) {
        QVERIFY(r.err.contains(QStringLiteral("unknown option: --bogus")));
    } else {
        QVERIFY2(r.out.startsWith(outStart), qPrintable(r.out));
    }
}

QTEST_MAIN(TestProgram)
#include "test_program.moc"

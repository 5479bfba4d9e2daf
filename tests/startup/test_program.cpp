// The built program as the suite starts it: the request's bytes, exit status and messages on
// standard error in --batch, and the window libraries it loads.
#include <QStringEncoder>
#include <QtTest>

#include "installation.h"
#include "test_env.h"

using namespace zv;

namespace {

struct Result {
    int status = -1;
    QString err;
};

QString BuiltProgram() {
    return qEnvironmentVariable("ZV_TEST_BUILD_DIR") + QStringLiteral("/src/app/zorvane-filer");
}

// Arguments are raw bytes, as the suite passes them; QProcess would re-encode text, so the
// shell makes each one with printf.
Result RunProgram(const QList<QByteArray>& args, const QProcessEnvironment& env,
                  const QString& program = BuiltProgram()) {
    QString script = QStringLiteral("exec \"$0\"");
    for (const QByteArray& arg : args) {
        script += QStringLiteral(" \"$(printf '");
        for (const char c : arg)
            script += QStringLiteral("\\%1").arg(uchar(c), 3, 8, QLatin1Char('0'));
        script += QStringLiteral("')\"");
    }
    QProcess p;
    p.setProcessEnvironment(env);
    p.start(QStringLiteral("/bin/sh"), {QStringLiteral("-c"), script, program});
    if (!p.waitForFinished(30000)) {
        p.kill();
        return {};
    }
    return {p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -2,
            QString::fromUtf8(p.readAllStandardError())};
}

}  // namespace

class TestProgram : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void windows1255Request();
    void windowLibrariesOnlyWhereAWindowMayShow();
};

// The suite passes the request in its ANSI code page: "¥" is the single byte A5. The file's
// name on disk is UTF-8, so a path decoded from Windows-1255 must match it.
void TestProgram::windows1255Request() {
    test::TestEnv env;
    test::MakeInstallation(env);
    const QString hebrewDoc = env.Root() + QStringLiteral("/in/מכתב.doc");
    QVERIFY(test::WriteFile(hebrewDoc, "x"));
    QStringEncoder cp1255("windows-1255");
    const QByteArray request = cp1255.encode(QStringLiteral("2¥") + hebrewDoc + "¥נושא");
    const Result r = RunProgram({"--batch", "--client", "1001", request}, env.ProgramEnvironment());
    // Taken, and not filed for want of client databases; the report names the path and name.
    QCOMPARE(r.status, 1);
    QVERIFY2(!r.err.contains(QStringLiteral("שרות")) &&
                 r.err.contains(hebrewDoc + QStringLiteral("\nנושא\n")),
             qPrintable(r.err));
}

// A batch run loads no window library; every other run loads the windows module beside the
// program, and says so when it is missing.
void TestProgram::windowLibrariesOnlyWhereAWindowMayShow() {
    test::TestEnv env;
    QProcessEnvironment pe = env.ProgramEnvironment();
    // The dynamic loader lists every library it loads, one file per process.
    const QString loads = env.Root() + QStringLiteral("/loads");
    QVERIFY(QDir().mkpath(loads));
    pe.insert(QStringLiteral("LD_DEBUG"), QStringLiteral("files"));
    pe.insert(QStringLiteral("LD_DEBUG_OUTPUT"), loads + QStringLiteral("/run"));
    const auto loadedWidgets = [&] {
        QString listed;
        for (const QFileInfo& f : QDir(loads).entryInfoList(QDir::Files)) {
            listed += test::ReadFile(f.filePath());
            QFile::remove(f.filePath());
        }
        return listed.contains(QLatin1String("libQt6Widgets"));
    };
    const auto notInstalled = [](const Result& r) {
        return r.status == 1 &&
               r.err.endsWith(QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה\n"));
    };

    Result r = RunProgram({"--batch", ""}, pe);
    QVERIFY2(notInstalled(r), qPrintable(r.err));
    QVERIFY2(!loadedWidgets(), "a batch run loaded the window libraries");

    // Qt's own options need QApplication, so this batch run goes through the module.
    r = RunProgram({"-platform", "offscreen", "--batch", ""}, pe);
    QVERIFY2(notInstalled(r), qPrintable(r.err));
    QVERIFY(loadedWidgets());

    r = RunProgram({"--no-such-option"}, pe);
    QCOMPARE(r.status, 2);
    QVERIFY2(r.err.contains(QStringLiteral("zorvane-filer: unknown option: --no-such-option\n")),
             qPrintable(r.err));

    const QString alone = env.Root() + QStringLiteral("/alone/zorvane-filer");
    QVERIFY(QDir().mkpath(QFileInfo(alone).path()));
    QVERIFY(QFile::copy(BuiltProgram(), alone));
    r = RunProgram({"--no-such-option"}, env.ProgramEnvironment(), alone);
    QCOMPARE(r.status, 1);
    QVERIFY2(r.err.startsWith(QStringLiteral("zorvane-filer: cannot load its windows: ")),
             qPrintable(r.err));
    r = RunProgram({"--batch", ""}, env.ProgramEnvironment(), alone);
    QVERIFY2(notInstalled(r), qPrintable(r.err));
}

QTEST_MAIN(TestProgram)
#include "test_program.moc"

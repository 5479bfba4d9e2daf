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
    void refusals();
    void windows1255RequestPreparesWorkFolders();
    void windowLibrariesOnlyWhereAWindowMayShow();
};

// In --batch the refusals go to standard error, the value after the line break on a line of
// its own ("%M" stands for MainPath).
void TestProgram::refusals() {
    for (const bool installed : {false, true}) {
        test::TestEnv env;
        if (installed) {
            test::MakeInstallation(env, false);
        }
        const Result r = RunProgram({"--batch", ""}, env.ProgramEnvironment());
        QCOMPARE(r.status, 1);
        const QString expected =
            installed ? QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף\n") + env.DataDir()
                      : QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה");
        QVERIFY2(r.err.endsWith(expected + QLatin1Char('\n')), qPrintable(r.err));
    }
}

void TestProgram::windows1255RequestPreparesWorkFolders() {
    test::TestEnv env;
    const test::Installation inst = test::MakeInstallation(env);
    const QString hebrewDoc = env.Root() + QStringLiteral("/in/מכתב.doc");
    QVERIFY(test::WriteFile(hebrewDoc, "x"));
    // The suite passes the request in its ANSI code page: "¥" is the single byte A5. The
    // file's name on disk is UTF-8, so a path decoded from Windows-1255 must match it.
    QStringEncoder cp1255("windows-1255");
    const QByteArray request = cp1255.encode(QStringLiteral("2¥") + hebrewDoc + "¥נושא");
    const Result r = RunProgram({"--batch", "--client", "1001", request}, env.ProgramEnvironment());
    // Handled, not filed: this installation has no client databases.
    QCOMPARE(r.status, 1);
    QVERIFY2(!r.err.contains(QStringLiteral("שרות")), qPrintable(r.err));
    QStringList folders =
        QDir(inst.mainPath + QStringLiteral("/Dat1")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    folders.sort();
    QCOMPARE(folders, (QStringList{"BakMDB", "DTDef", "Def", "GDetDef", "Temp"}));
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
        QByteArray listed;
        for (const QFileInfo& f : QDir(loads).entryInfoList(QDir::Files)) {
            QFile file(f.filePath());
            if (file.open(QIODevice::ReadOnly)) {
                listed += file.readAll();
            }
            QFile::remove(f.filePath());
        }
        return listed.contains("libQt6Widgets");
    };
    const QString noInstallation = QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה\n");

    Result r = RunProgram({"--batch", ""}, pe);
    QCOMPARE(r.status, 1);
    QVERIFY2(r.err.endsWith(noInstallation), qPrintable(r.err));
    QVERIFY2(!loadedWidgets(), "a batch run loaded the window libraries");

    // Qt's own options need QApplication, so this batch run goes through the module.
    r = RunProgram({"-platform", "offscreen", "--batch", ""}, pe);
    QCOMPARE(r.status, 1);
    QVERIFY2(r.err.endsWith(noInstallation), qPrintable(r.err));
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
    QCOMPARE(r.status, 1);
    QVERIFY2(r.err.endsWith(noInstallation), qPrintable(r.err));
}

QTEST_MAIN(TestProgram)
#include "test_program.moc"

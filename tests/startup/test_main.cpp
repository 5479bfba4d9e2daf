// Main in process: the request grammar and its mode, the refusals in their order, the
// development run.
#include <QtTest>

#include "installation.h"
#include "scripted_ui.h"
#include "startup/main_entry.h"
#include "startup/request_text.h"
#include "test_env.h"
#include "util/state.h"
#include "util/ui.h"

using namespace zv;

namespace {

const QString Y{QChar(kRequestSeparator)};
const QString kNotIdentified = QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה");
const QString kBadLaunch = QStringLiteral("הפעלה לא חוקית של שרות זה");
const QString kBadCall = QStringLiteral("קריאה לא תקינה של שרות זה");

enum Setup { kNothing, kNoVolna, kNoExe, kComplete };

// Runs Main; the handler's mode, path and name, or "-" when it was not called.
int Run(const QString& text, QString& handled) {
    handled = QStringLiteral("-");
    return Main(text, [&](int& mode, QString& path, QString& name) {
        handled = QStringLiteral("%1|%2|%3").arg(mode).arg(path, name);
    });
}

}  // namespace

class TestMain : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void request_data();
    void request();
    void developmentRun();
};

// "%D" stands for the document's path, "%M" for MainPath. A refusal is critical and ends the
// run with 1; a report about the mode field is shown and the request handled all the same.
// The broken installations miss one thing more than the checks after theirs look at, so the
// refusal shown is the one of the first failing check.
void TestMain::request_data() {
    QTest::addColumn<int>("setup");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QString>("handled");
    const auto row = [](const char* name, const QString& text, const QString& message,
                        const QString& handled, int setup = kComplete) {
        QTest::newRow(name) << setup << text << message << handled;
    };
    row("three fields", "1" + Y + "%D" + Y + "Letter", {}, "1|%D|Letter");
    row("fourth ignored", "2" + Y + "%D" + Y + "Subject" + Y + "x", {}, "2|%D|Subject");
    row("outer spaces trimmed", "  1" + Y + "%D" + Y + "Letter  ", {}, "1|%D|Letter");
    row("empty name", "1" + Y + "%D" + Y, {}, "1|%D|");
    row("Hebrew name", "1" + Y + "%D" + Y + "מכתב ללקוח", {}, "1|%D|מכתב ללקוח");
    row("mode half to even up", "1.5" + Y + "%D" + Y + "n", {}, "2|%D|n");
    row("mode not a number", "abc" + Y + "%D" + Y + "n", "13-Main-Type mismatch", "0|%D|n");
    row("mode empty", Y + "%D" + Y + "n", "13-Main-Type mismatch", "0|%D|n");
    row("mode out of range", "40000" + Y + "%D" + Y + "n", "6-Main-Overflow", "0|%D|n");
    row("only spaces", "   ", kBadLaunch, "-");
    row("two fields", "1" + Y + "%D", kBadLaunch, "-");
    row("other separator", "1|%D|Letter", kBadLaunch, "-");
    row("space before path", "1" + Y + " %D" + Y + "Letter", kBadCall + "\r\n %D", "-");
    row("pattern is no file", "1" + Y + "%D*" + Y + "Letter", kBadCall + "\r\n%D*", "-");
    row("missing document", "1" + Y + "%M/none.doc" + Y + "x", kBadCall + "\r\n%M/none.doc", "-");
    row("no suite executable", "1", QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף\r\n%M"),
        "-", kNoExe);
    row("MainPath without VolnaGlobNum", "1", kNotIdentified, "-", kNoVolna);
    row("no settings at all", "1", kNotIdentified, "-", kNothing);
}

void TestMain::request() {
    QFETCH(int, setup);
    QFETCH(QString, text);
    QFETCH(QString, message);
    QFETCH(QString, handled);
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    if (setup != kNothing) {
        test::MakeInstallation(env, setup == kComplete, setup == kNoVolna ? "" : "23");
    }
    for (QString* s : {&text, &message, &handled}) {
        s->replace(QStringLiteral("%D"), env.Root() + QStringLiteral("/in/letter.docx"))
            .replace(QStringLiteral("%M"), env.DataDir());
    }
    QString found;
    const int status = Run(text, found);
    QCOMPARE(found, handled);
    QCOMPARE(ui->Texts(), message.isEmpty() ? QStringList() : QStringList{message});
    QCOMPARE(status, handled == QLatin1String("-") ? 1 : 0);
    if (handled == QLatin1String("-")) {
        QCOMPARE(ui->Messages().front().style, vbOKOnly | vbCritical);
    }
}

void TestMain::developmentRun() {
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    const test::Installation inst = test::MakeInstallation(env);
    qputenv("ZORVANE_DEVELOPMENT_RUN", "1");
    // Whatever the command line holds, the fixed request is used; its file exists only on
    // a developer's machine.
    QString handled;
    QCOMPARE(Run(QStringLiteral("1") + Y + inst.document + Y + QStringLiteral("n"), handled), 1);
    QVERIFY(IsDevelopmentRun());
    QCOMPARE(
        ui->Texts(),
        QStringList{kBadCall + QStringLiteral("\r\nF:\\Ornit32\\DOCS\\TEMPLATES\\profil.doc")});
    QCOMPARE(handled, QStringLiteral("-"));
}

QTEST_MAIN(TestMain)
#include "test_main.moc"

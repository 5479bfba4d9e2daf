// Main in process: the request grammar, the refusals in their order, the development run.
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
const QString kBadFolder = QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף");
const QString kBadLaunch = QStringLiteral("הפעלה לא חוקית של שרות זה");
const QString kBadCall = QStringLiteral("קריאה לא תקינה של שרות זה");

struct Handled {
    int calls = 0;
    int mode = -1;
    QString path, name;
};

}  // namespace

class TestMain : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void grammar_data();
    void grammar();
    void refusals_data();
    void refusals();
    void modeConversion_data();
    void modeConversion();
    void developmentRun();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    Handled handled_;
    int Run(const QString& text) {
        return Main(text, [this](int& mode, QString& path, QString& name) {
            ++handled_.calls;
            handled_.mode = mode;
            handled_.path = path;
            handled_.name = name;
        });
    }
};

void TestMain::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    handled_ = {};
}

void TestMain::cleanup() {
    ui_.reset();
    env_.reset();
}

// "%D" stands for the document's path.
void TestMain::grammar_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("refusal");
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("name");
    QTest::newRow("three fields") << "1" + Y + "%D" + Y + "Letter"
                                  << "" << 1 << "Letter";
    QTest::newRow("fourth ignored") << "2" + Y + "%D" + Y + "Subject" + Y + "x"
                                    << "" << 2 << "Subject";
    QTest::newRow("outer spaces trimmed") << "  1" + Y + "%D" + Y + "Letter  "
                                          << "" << 1 << "Letter";
    QTest::newRow("inner spaces kept") << "1" + Y + "%D" + Y + " Letter ."
                                       << "" << 1 << " Letter .";
    QTest::newRow("empty name") << "1" + Y + "%D" + Y << "" << 1 << "";
    QTest::newRow("Hebrew name") << "1" + Y + "%D" + Y + "מכתב ללקוח"
                                 << "" << 1 << "מכתב ללקוח";
    QTest::newRow("empty text") << "" << kBadLaunch << 0 << "";
    QTest::newRow("only spaces") << "   " << kBadLaunch << 0 << "";
    QTest::newRow("two fields") << "1" + Y + "%D" << kBadLaunch << 0 << "";
    QTest::newRow("other separator") << "1|%D|Letter" << kBadLaunch << 0 << "";
    QTest::newRow("space before path")
        << "1" + Y + " %D" + Y + "Letter" << kBadCall + "\r\n %D" << 0 << "";
    QTest::newRow("missing file") << "1" + Y + "%D.old" + Y + "Letter" << kBadCall + "\r\n%D.old"
                                  << 0 << "";
    QTest::newRow("pattern is no file")
        << "1" + Y + "%D*" + Y + "Letter" << kBadCall + "\r\n%D*" << 0 << "";
}

void TestMain::grammar() {
    QFETCH(QString, text);
    QFETCH(QString, refusal);
    QFETCH(int, mode);
    QFETCH(QString, name);
    const test::Installation inst = test::MakeInstallation(*env_);
    text.replace(QStringLiteral("%D"), inst.document);
    refusal.replace(QStringLiteral("%D"), inst.document);
    const int status = Run(text);
    if (refusal.isEmpty()) {
        QCOMPARE((*ui_)->Texts(), QStringList());
        QCOMPARE(status, 0);
        QCOMPARE(handled_.calls, 1);
        QCOMPARE(handled_.mode, mode);
        QCOMPARE(handled_.path, inst.document);
        QCOMPARE(handled_.name, name);
    } else {
        QCOMPARE((*ui_)->Texts(), QStringList{refusal});
        QCOMPARE((*ui_)->Messages().front().style, vbOKOnly | vbCritical);
        QCOMPARE((*ui_)->Messages().front().title, AppTitle());
        QCOMPARE(status, 1);
        QCOMPARE(handled_.calls, 0);
    }
}

// Each case breaks the installation in one more way than the checks after it look at, so
// the refusal shown is the one of the first failing check.
void TestMain::refusals_data() {
    QTest::addColumn<bool>("withSettings");
    QTest::addColumn<bool>("withExe");
    QTest::addColumn<QByteArray>("volna");
    QTest::addColumn<QString>("request");
    QTest::addColumn<QString>("expected");
    const QString bad = QStringLiteral("1");
    QTest::newRow("no settings at all") << false << false << QByteArray() << bad << kNotIdentified;
    QTest::newRow("MainPath without VolnaGlobNum")
        << true << false << QByteArray() << bad << kNotIdentified;
    QTest::newRow("no suite executable")
        << true << false << QByteArray("23") << bad << kBadFolder + "\r\n%M";
    QTest::newRow("malformed request") << true << true << QByteArray("23") << bad << kBadLaunch;
    QTest::newRow("missing document")
        << true << true << QByteArray("23") << "1" + Y + "%M/none.doc" + Y + "x"
        << kBadCall + "\r\n%M/none.doc";
}

void TestMain::refusals() {
    QFETCH(bool, withSettings);
    QFETCH(bool, withExe);
    QFETCH(QByteArray, volna);
    QFETCH(QString, request);
    QFETCH(QString, expected);
    if (withSettings) {
        test::MakeInstallation(*env_, withExe, volna);
    }
    request.replace(QStringLiteral("%M"), env_->DataDir());
    expected.replace(QStringLiteral("%M"), env_->DataDir());
    QCOMPARE(Run(request), 1);
    QCOMPARE((*ui_)->Texts(), QStringList{expected});
    QCOMPARE((*ui_)->Messages().front().style, vbOKOnly | vbCritical);
    QCOMPARE(handled_.calls, 0);
}

void TestMain::modeConversion_data() {
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("report");
    QTest::addColumn<int>("mode");
    QTest::newRow("document") << "1"
                              << "" << 1;
    QTest::newRow("mail") << " 2 "
                          << "" << 2;
    QTest::newRow("other number") << "7"
                                  << "" << 7;
    QTest::newRow("negative") << "-3"
                              << "" << -3;
    QTest::newRow("half to even down") << "2.5"
                                       << "" << 2;
    QTest::newRow("half to even up") << "1.5"
                                     << "" << 2;
    QTest::newRow("not a number") << "abc"
                                  << "13-Main-Type mismatch" << 0;
    QTest::newRow("empty") << ""
                           << "13-Main-Type mismatch" << 0;
    QTest::newRow("out of range") << "40000"
                                  << "6-Main-Overflow" << 0;
}

void TestMain::modeConversion() {
    QFETCH(QString, field);
    QFETCH(QString, report);
    QFETCH(int, mode);
    const test::Installation inst = test::MakeInstallation(*env_);
    QCOMPARE(Run(field + Y + inst.document + Y + QStringLiteral("n")), 0);
    QCOMPARE((*ui_)->Texts(), report.isEmpty() ? QStringList() : QStringList{report});
    if (!report.isEmpty()) {
        QCOMPARE((*ui_)->Messages().front().style, int(vbOKOnly));
    }
    QCOMPARE(handled_.calls, 1);
    QCOMPARE(handled_.mode, mode);
}

void TestMain::developmentRun() {
    const test::Installation inst = test::MakeInstallation(*env_);
    qputenv("ZORVANE_DEVELOPMENT_RUN", "1");
    // Whatever the command line holds, the fixed request is used; its file exists only on
    // a developer's machine.
    QCOMPARE(Run(QStringLiteral("1") + Y + inst.document + Y + QStringLiteral("n")), 1);
    QVERIFY(IsDevelopmentRun());
    QCOMPARE(
        (*ui_)->Texts(),
        QStringList{kBadCall + QStringLiteral("\r\nF:\\Ornit32\\DOCS\\TEMPLATES\\profil.doc")});
    (*ui_)->Clear();
    QCOMPARE(Run(QString()), 1);
    QCOMPARE((*ui_)->Texts().size(), 1);
    QVERIFY((*ui_)->Texts().front().startsWith(kBadCall));
}

QTEST_MAIN(TestMain)
#include "test_main.moc"

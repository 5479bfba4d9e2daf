// Failure reports and the Ui port's default answers.
#include <QtTest>

#include "scripted_ui.h"
#include "util/errors.h"

using namespace zv;

class TestErrors : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void formats();
    void stepReportsAndGoesOn();
    void defaultAnswers();
};

void TestErrors::formats() {
    const VbError e = MakeError(err::TypeMismatch);
    QCOMPARE(FormatPlain(QStringLiteral("Main"), e), QStringLiteral("13-Main-Type mismatch"));
    QCOMPARE(FormatWithLine(QStringLiteral("Main"), e), QStringLiteral("13-0-Main-Type mismatch"));
}

void TestErrors::stepReportsAndGoesOn() {
    test::ScopedScriptedUi ui;
    int after = 0;
    const auto format = [](const VbError& e) { return FormatPlain(QStringLiteral("X"), e); };
    QVERIFY(!Step(format, [] { throw MakeError(err::FileNotFound); }));
    QVERIFY(Step(format, [&] { ++after; }));
    QCOMPARE(after, 1);
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("53-X-File not found")});
    QCOMPARE(ui->Messages().front().style, int(vbOKOnly));
}

void TestErrors::defaultAnswers() {
    QCOMPARE(DefaultAnswer(vbOKOnly | vbCritical), int(vbOK));
    QCOMPARE(DefaultAnswer(vbYesNo | vbQuestion | vbDefaultButton2), int(vbNo));
}

QTEST_MAIN(TestErrors)
#include "test_errors.moc"

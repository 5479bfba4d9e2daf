// Failure reports and the Ui port's default answers.
#include <QtTest>

#include "scripted_ui.h"
#include "util/errors.h"

using namespace zv;

class TestErrors : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void formats_data();
    void formats();
    void stepReportsAndGoesOn();
    void defaultAnswers_data();
    void defaultAnswers();
};

void TestErrors::formats_data() {
    QTest::addColumn<bool>("withLine");
    QTest::addColumn<QString>("expected");
    QTest::newRow("plain") << false << QStringLiteral("13-Main-Type mismatch");
    QTest::newRow("with line") << true << QStringLiteral("13-0-Main-Type mismatch");
}

void TestErrors::formats() {
    QFETCH(bool, withLine);
    QFETCH(QString, expected);
    const VbError e = MakeError(err::TypeMismatch);
    QCOMPARE(withLine ? FormatWithLine(QStringLiteral("Main"), e)
                      : FormatPlain(QStringLiteral("Main"), e),
             expected);
}

void TestErrors::stepReportsAndGoesOn() {
    test::ScopedScriptedUi ui;
    int after = 0;
    const bool failed = Step([](const VbError& e) { return FormatPlain(QStringLiteral("X"), e); },
                             [] { throw MakeError(err::FileNotFound); });
    const bool ok = Step([](const VbError& e) { return FormatPlain(QStringLiteral("X"), e); },
                         [&] { ++after; });
    QVERIFY(!failed);
    QVERIFY(ok);
    QCOMPARE(after, 1);
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("53-X-File not found")});
    QCOMPARE(ui->Messages().front().style, int(vbOKOnly));
    QCOMPARE(ui->Messages().front().title, AppTitle());
}

void TestErrors::defaultAnswers_data() {
    QTest::addColumn<int>("style");
    QTest::addColumn<int>("answer");
    QTest::newRow("ok") << int(vbOKOnly | vbCritical) << int(vbOK);
    QTest::newRow("yes") << int(vbYesNo | vbQuestion) << int(vbYes);
    QTest::newRow("no by default") << int(vbYesNo | vbQuestion | vbDefaultButton2) << int(vbNo);
    QTest::newRow("cancel by default") << int(vbOKCancel | vbDefaultButton2) << int(vbCancel);
}

void TestErrors::defaultAnswers() {
    QFETCH(int, style);
    QFETCH(int, answer);
    QCOMPARE(DefaultAnswer(style), answer);
}

QTEST_MAIN(TestErrors)
#include "test_errors.moc"

// The reminder moment and the remark history.
#include <QtTest>

#include "archive/date_values.h"
#include "archive/memo_date.h"
#include "archive/remark.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/clock.h"
#include "util/state.h"

using namespace zv;

namespace {

const QString kFormatMessage = QStringLiteral("בעיה במבנה של התאריך או השעות/דקות");

QDateTime At(int y, int m, int d, int h = 0, int min = 0) {
    return QDateTime(QDate(y, m, d), QTime(h, min));
}

}  // namespace

class TestMemoDate : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void moment_data();
    void moment();
    void messageOnlyWhenAskedAndFailed_data();
    void messageOnlyWhenAskedAndFailed();
    void unreadableDateIsReported();
    void remarkStamp();
    void remarkHistory_data();
    void remarkHistory();
};

void TestMemoDate::moment_data() {
    QTest::addColumn<QVariant>("date");
    QTest::addColumn<QVariant>("hour");
    QTest::addColumn<bool>("formed");
    QTest::addColumn<QDateTime>("expected");

    const QVariant day = At(2026, 12, 10);
    QTest::newRow("08:00") << day << QVariant(QStringLiteral("08:00")) << true
                           << At(2026, 12, 10, 8, 0);
    QTest::newRow("stored as iso text")
        << QVariant(QStringLiteral("2026-12-10 00:00:00")) << QVariant(QStringLiteral("17:45"))
        << true << At(2026, 12, 10, 17, 45);
    QTest::newRow("stored as a date")
        << QVariant(QDate(2026, 12, 10)) << QVariant(QStringLiteral("09:05")) << true
        << At(2026, 12, 10, 9, 5);
    QTest::newRow("24:30 is the next day")
        << day << QVariant(QStringLiteral("24:30")) << true << At(2026, 12, 11, 0, 30);
    QTest::newRow("minutes carry too")
        << day << QVariant(QStringLiteral("99:99")) << true << At(2026, 12, 14, 4, 39);
    QTest::newRow("year end") << QVariant(At(2026, 12, 31)) << QVariant(QStringLiteral("23:60"))
                              << true << At(2027, 1, 1, 0, 0);
    QTest::newRow("separator is not checked")
        << day << QVariant(QStringLiteral("08.15")) << true << At(2026, 12, 10, 8, 15);
    QTest::newRow("four characters")
        << day << QVariant(QStringLiteral("8:00")) << false << QDateTime();
    QTest::newRow("empty mask") << day << QVariant(QStringLiteral("__:__")) << false << QDateTime();
    QTest::newRow("half typed") << day << QVariant(QStringLiteral("08:_5")) << false << QDateTime();
    QTest::newRow("letters") << day << QVariant(QStringLiteral("ab:cd")) << false << QDateTime();
    QTest::newRow("empty time") << day << QVariant(QString()) << false << QDateTime();
    QTest::newRow("null time") << day << QVariant(QMetaType(QMetaType::QString)) << false
                               << QDateTime();
    QTest::newRow("null date") << QVariant(QMetaType(QMetaType::QDateTime))
                               << QVariant(QStringLiteral("08:00")) << false << QDateTime();
    QTest::newRow("zero date") << QVariant(ZeroDate()) << QVariant(QStringLiteral("08:00")) << false
                               << QDateTime();
}

void TestMemoDate::moment() {
    QFETCH(QVariant, date);
    QFETCH(QVariant, hour);
    QFETCH(bool, formed);
    QFETCH(QDateTime, expected);
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    QDateTime result;
    QCOMPARE(GetmDate(date, hour, result, false), formed);
    if (formed) {
        QCOMPARE(result, expected);
    }
    QVERIFY(ui->Texts().isEmpty());
}

void TestMemoDate::messageOnlyWhenAskedAndFailed_data() {
    QTest::addColumn<QString>("hour");
    QTest::addColumn<bool>("show");
    QTest::addColumn<bool>("message");
    QTest::newRow("failed, asked") << QStringLiteral("8:00") << true << true;
    QTest::newRow("failed, not asked") << QStringLiteral("8:00") << false << false;
    QTest::newRow("formed, asked") << QStringLiteral("08:00") << true << false;
}

void TestMemoDate::messageOnlyWhenAskedAndFailed() {
    QFETCH(QString, hour);
    QFETCH(bool, show);
    QFETCH(bool, message);
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    QDateTime result;
    GetmDate(At(2026, 12, 10), hour, result, show);
    if (message) {
        QCOMPARE(ui->Texts(), QStringList{kFormatMessage});
        QCOMPARE(ui->Messages().front().style, int(vbExclamation | vbOKOnly));
    } else {
        QVERIFY(ui->Texts().isEmpty());
    }
}

void TestMemoDate::unreadableDateIsReported() {
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    QDateTime result;
    QVERIFY(!GetmDate(QStringLiteral("soon"), QStringLiteral("08:00"), result, true));
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("13-GetmDate-Type mismatch")});
    QCOMPARE(ui->Messages().front().style, int(vbOKOnly));
}

// The test runs in the en_US locale (set by CMake): short date M/d/yy, long time
// h:mm:ss AP, and no time zone in the stamp.
void TestMemoDate::remarkStamp() {
    QCOMPARE(RemarkStamp(QDateTime(QDate(2026, 12, 6), QTime(20, 17, 5)), QStringLiteral("דנה")),
             QStringLiteral("12/6/26 8:17:05 PM (דנה)"));
}

void TestMemoDate::remarkHistory_data() {
    QTest::addColumn<QVariant>("old");
    QTest::addColumn<QString>("expected");
    const QString entry = QStringLiteral("3/1/26 9:30:00 AM (דנה כהן) -- נשלח ללקוח");
    QTest::newRow("null body") << QVariant(QMetaType(QMetaType::QString)) << entry;
    QTest::newRow("empty body") << QVariant(QString()) << entry;
    QTest::newRow("earlier entry") << QVariant(QStringLiteral("first"))
                                   << QStringLiteral("first\r\n") + QString(60, QLatin1Char('-')) +
                                          QStringLiteral("\r\n") + entry;
}

void TestMemoDate::remarkHistory() {
    QFETCH(QVariant, old);
    QFETCH(QString, expected);
    test::TestEnv env;
    SetMyUserName(QStringLiteral("דנה כהן"));
    SetClock([] { return QDateTime(QDate(2026, 3, 1), QTime(9, 30)); });
    QCOMPARE(AppendRemark(old, QStringLiteral("נשלח ללקוח")), expected);
}

QTEST_MAIN(TestMemoDate)
#include "test_memo_date.moc"

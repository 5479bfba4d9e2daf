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
    void remarkHistory();
};

void TestMemoDate::moment_data() {
    QTest::addColumn<QVariant>("date");
    QTest::addColumn<QVariant>("hour");
    QTest::addColumn<bool>("show");           // the format message asked for
    QTest::addColumn<QDateTime>("expected");  // null: not formed
    QTest::addColumn<QString>("message");

    const QVariant day = At(2026, 12, 10);
    const QVariant eight = QStringLiteral("08:00");
    QTest::newRow("stored as iso text")
        << QVariant(QStringLiteral("2026-12-10 00:00:00")) << QVariant(QStringLiteral("17:45"))
        << true << At(2026, 12, 10, 17, 45) << QString();
    QTest::newRow("minutes carry too")
        << day << QVariant(QStringLiteral("99:99")) << true << At(2026, 12, 14, 4, 39) << QString();
    QTest::newRow("year end") << QVariant(At(2026, 12, 31)) << QVariant(QStringLiteral("23:60"))
                              << true << At(2027, 1, 1, 0, 0) << QString();
    QTest::newRow("four characters")
        << day << QVariant(QStringLiteral("8:00")) << true << QDateTime() << kFormatMessage;
    QTest::newRow("four characters, not asked")
        << day << QVariant(QStringLiteral("8:00")) << false << QDateTime() << QString();
    QTest::newRow("empty mask") << day << QVariant(QStringLiteral("__:__")) << true << QDateTime()
                                << kFormatMessage;
    QTest::newRow("zero date") << QVariant(ZeroDate()) << eight << true << QDateTime()
                               << kFormatMessage;
    // An error is reported whether the format message was asked for or not.
    QTest::newRow("unreadable date") << QVariant(QStringLiteral("soon")) << eight << false
                                     << QDateTime() << QStringLiteral("13-GetmDate-Type mismatch");
}

void TestMemoDate::moment() {
    QFETCH(QVariant, date);
    QFETCH(QVariant, hour);
    QFETCH(bool, show);
    QFETCH(QDateTime, expected);
    QFETCH(QString, message);
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    QDateTime result;
    QCOMPARE(GetmDate(date, hour, result, show), expected.isValid());
    if (expected.isValid()) {
        QCOMPARE(result, expected);
    }
    QCOMPARE(ui->Texts(), message.isEmpty() ? QStringList() : QStringList{message});
}

// The test runs in the en_US locale (set by CMake): short date M/d/yy, long time
// h:mm:ss AP, and no time zone in the stamp.
void TestMemoDate::remarkHistory() {
    test::TestEnv env;
    SetMyUserName(QStringLiteral("דנה כהן"));
    SetClock([] { return QDateTime(QDate(2026, 3, 1), QTime(21, 30)); });
    QCOMPARE(AppendRemark(QStringLiteral("first"), QStringLiteral("נשלח ללקוח")),
             QStringLiteral("first\r\n") + QString(60, QLatin1Char('-')) +
                 QStringLiteral("\r\n3/1/26 9:30:00 PM (דנה כהן) -- נשלח ללקוח"));
}

QTEST_MAIN(TestMemoDate)
#include "test_memo_date.moc"

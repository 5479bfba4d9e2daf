// Value helpers and the splitting of SELECT statements.
#include <QtTest>

#include "data/sql_parts.h"
#include "data/values.h"
#include "recordset_checks.h"
#include "util/errors.h"

using namespace zv;

class TestValues : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void numbers_data();
    void numbers();
    void fixQuoteAndNulls();
    void maxVal();
    void sqlParts_data();
    void sqlParts();
};

// The 16-bit conversion gives 0 on overflow, the 32-bit one and the Double raise error 6
// (shown as -6); both round half to even.
void TestValues::numbers_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<qint64>("asInt");
    QTest::addColumn<qint64>("asLng");
    QTest::addColumn<double>("asDbl");
    const auto row = [](const char* name, const QVariant& v, qint64 i, qint64 l, double d) {
        QTest::newRow(name) << v << i << l << d;
    };
    row("blanks around", QStringLiteral("  42 "), 42, 42, 42);
    row("12.5 to even", QStringLiteral("12.5"), 12, 12, 12.5);
    row("13.5 to even", QStringLiteral("13.5"), 14, 14, 13.5);
    row("-2.5 to even", QStringLiteral("-2.5"), -2, -2, -2.5);
    row("12.51 up", QStringLiteral("12.51"), 13, 13, 12.51);
    row("double 1.5", 1.5, 2, 2, 1.5);
    row("16-bit min", QStringLiteral("-32768"), -32768, -32768, -32768);
    row("above 16 bits", QStringLiteral("32768"), 0, 32768, 32768);
    row("rounds over 16 bits", QStringLiteral("32767.5"), 0, 32768, 32767.5);
    row("32-bit max", QStringLiteral("2147483647"), 0, 2147483647, 2147483647);
    row("above 32 bits", QStringLiteral("2147483648"), 0, -6, 2147483648.0);
    row("rounds over 32 bits", QStringLiteral("2147483647.5"), 0, -6, 2147483647.5);
    row("below 32 bits", QStringLiteral("-2147483649"), 0, -6, -2147483649.0);
    row("huge", QStringLiteral("1e400"), 0, -6, -6);
    row("text", QStringLiteral("abc"), 0, 0, 0);
    row("inf", QStringLiteral("inf"), 0, 0, 0);
    row("grouped", QStringLiteral("1,234"), 1234, 1234, 1234);
    row("digits then text", QStringLiteral("12abc"), 0, 0, 0);
    row("Null", Null(), 0, 0, 0);
    row("True", true, -1, -1, -1);
    row("exponent", QStringLiteral("1.5e2"), 150, 150, 150);
}

void TestValues::numbers() {
    QFETCH(QVariant, value);
    QFETCH(qint64, asInt);
    QFETCH(qint64, asLng);
    QFETCH(double, asDbl);
    QCOMPARE(qint64(GetIntFromStr(value)), asInt);
    const long lng = test::ErrorOf([&] { QCOMPARE(qint64(GetLngFromStr(value)), asLng); });
    QCOMPARE(lng, asLng == -6 ? long(err::Overflow) : 0L);
    const long dbl = test::ErrorOf([&] { QCOMPARE(GetDblFromStr(value), asDbl); });
    QCOMPARE(dbl, asDbl == -6 ? long(err::Overflow) : 0L);
}

void TestValues::fixQuoteAndNulls() {
    QCOMPARE(FixQuote(QStringLiteral("O'Brien")), QStringLiteral("O''Brien"));
    QCOMPARE(FixQuote(QStringLiteral("a''b")), QStringLiteral("a''''b"));
    QCOMPARE(FixQuote(QStringLiteral("צ'ק")), QStringLiteral("צ''ק"));
    QCOMPARE(FixQuote(Null()), QString());
    QCOMPARE(FixQuote(23), QStringLiteral("23"));
    QVERIFY(IsNullVal(QVariant(QMetaType(QMetaType::Int))));
    QVERIFY(!IsNullVal(Empty()));
    QVERIFY(!IsNullVal(QVariant(QString())));
    QVERIFY(IsEmptyVal(Empty()) && !IsEmptyVal(Null()));
}

void TestValues::maxVal() {
    QCOMPARE(GetMaxVal(2, 3.5), QVariant(3.5));
    QCOMPARE(GetMaxVal(10, 9), QVariant(10));
    QCOMPARE(GetMaxVal(QStringLiteral("10"), QStringLiteral("9")), QVariant(QStringLiteral("9")));
    QCOMPARE(GetMaxVal(10, QStringLiteral("9")), QVariant(10));
    QCOMPARE(GetMaxVal(QStringLiteral("abc"), 100), QVariant(QStringLiteral("abc")));
    QCOMPARE(GetMaxVal(Null(), 1), QVariant(1));
}

// Expected: the SELECT, WHERE and ORDER parts, joined by "|".
void TestValues::sqlParts_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<bool>("keepCase");
    QTest::addColumn<QString>("parts");
    const auto row = [](const char* name, const char* sql, bool keepCase, const char* parts) {
        QTest::newRow(name) << QString::fromLatin1(sql) << keepCase << QString::fromLatin1(parts);
    };
    row("all three", "select * from docs where id>5 order by id", false,
        "SELECT * FROM [DOCS] |WHERE ID>5 |ORDER BY ID");
    row("bracketed stays single", "SELECT * FROM [UMEMO] WHERE 1=0", false,
        "SELECT * FROM [UMEMO] |WHERE 1=0|");
    row("where untrimmed to the end", "SELECT * FROM DOCS WHERE [FullName]='a'  ", false,
        "SELECT * FROM [DOCS] |WHERE [FULLNAME]='A'  |");
    row("order only", "SELECT * FROM [CLIENT] ORDER BY NUM", false,
        "SELECT * FROM [CLIENT] ||ORDER BY NUM");
    row("repeated blanks", "SELECT  *   FROM   docs   WHERE  x=1   ORDER BY x", false,
        "SELECT * FROM [DOCS] |WHERE  X=1 |ORDER BY X");
    row("keep case, lower where", "SELECT * FROM Docs where ID=1", true,
        "SELECT * FROM [Docs] where ID=1 ||");
    row("keep case WHERE", "SELECT * FROM Docs WHERE ID=1", true,
        "SELECT * FROM [Docs] |WHERE ID=1|");
    row("from lower kept case", "select a from t", true, "select a from [t] ||");
}

void TestValues::sqlParts() {
    QFETCH(QString, sql);
    QFETCH(bool, keepCase);
    QFETCH(QString, parts);
    const auto found = GetSqlParts(sql, keepCase);
    QCOMPARE(QStringList({found[0], found[1], found[2]}).join(QLatin1Char('|')), parts);
}

QTEST_MAIN(TestValues)
#include "test_values.moc"

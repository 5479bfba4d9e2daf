// Value helpers and the splitting of SELECT statements.
#include <QtTest>

#include "data/sql_parts.h"
#include "data/values.h"
#include "util/errors.h"

using namespace zv;

class TestValues : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void intFromStr_data();
    void intFromStr();
    void lngFromStr_data();
    void lngFromStr();
    void lngOverflowRaises_data();
    void lngOverflowRaises();
    void dblFromStr();
    void fixQuote_data();
    void fixQuote();
    void nullAndEmpty();
    void maxVal_data();
    void maxVal();
    void sqlParts_data();
    void sqlParts();
};

void TestValues::intFromStr_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<int>("expected");
    QTest::newRow("whole") << QVariant(QStringLiteral("123")) << 123;
    QTest::newRow("blanks around") << QVariant(QStringLiteral("  42 ")) << 42;
    QTest::newRow("negative") << QVariant(QStringLiteral("-7")) << -7;
    QTest::newRow("12.5 to even") << QVariant(QStringLiteral("12.5")) << 12;
    QTest::newRow("13.5 to even") << QVariant(QStringLiteral("13.5")) << 14;
    QTest::newRow("-2.5 to even") << QVariant(QStringLiteral("-2.5")) << -2;
    QTest::newRow("12.51 up") << QVariant(QStringLiteral("12.51")) << 13;
    QTest::newRow("double 0.5") << QVariant(0.5) << 0;
    QTest::newRow("double 1.5") << QVariant(1.5) << 2;
    QTest::newRow("max") << QVariant(QStringLiteral("32767")) << 32767;
    QTest::newRow("min") << QVariant(QStringLiteral("-32768")) << -32768;
    QTest::newRow("above max") << QVariant(QStringLiteral("32768")) << 0;
    QTest::newRow("rounds over max") << QVariant(QStringLiteral("32767.5")) << 0;
    QTest::newRow("below min") << QVariant(QStringLiteral("-32769")) << 0;
    QTest::newRow("huge") << QVariant(QStringLiteral("1e400")) << 0;
    QTest::newRow("abc") << QVariant(QStringLiteral("abc")) << 0;
    QTest::newRow("inf") << QVariant(QStringLiteral("inf")) << 0;
    QTest::newRow("nan") << QVariant(QStringLiteral("nan")) << 0;
    QTest::newRow("grouped") << QVariant(QStringLiteral("1,234")) << 1234;
    QTest::newRow("digits then text") << QVariant(QStringLiteral("12abc")) << 0;
    QTest::newRow("blank") << QVariant(QStringLiteral("   ")) << 0;
    QTest::newRow("empty text") << QVariant(QString()) << 0;
    QTest::newRow("Null") << Null() << 0;
    QTest::newRow("Empty") << Empty() << 0;
    QTest::newRow("int") << QVariant(99) << 99;
    QTest::newRow("True") << QVariant(true) << -1;
    QTest::newRow("exponent") << QVariant(QStringLiteral("1.5e2")) << 150;
}

void TestValues::intFromStr() {
    QFETCH(QVariant, value);
    QFETCH(int, expected);
    QCOMPARE(int(GetIntFromStr(value)), expected);
}

void TestValues::lngFromStr_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<qint64>("expected");
    QTest::newRow("above 16 bits") << QVariant(QStringLiteral("100000")) << qint64(100000);
    QTest::newRow("max") << QVariant(QStringLiteral("2147483647")) << qint64(2147483647);
    QTest::newRow("2.5 to even") << QVariant(QStringLiteral("2.5")) << qint64(2);
    QTest::newRow("3.5 to even") << QVariant(QStringLiteral("3.5")) << qint64(4);
    QTest::newRow("text") << QVariant(QStringLiteral("x1")) << qint64(0);
    QTest::newRow("Null") << Null() << qint64(0);
    QTest::newRow("longlong from engine") << QVariant(qlonglong(1234)) << qint64(1234);
}

void TestValues::lngFromStr() {
    QFETCH(QVariant, value);
    QFETCH(qint64, expected);
    QCOMPARE(qint64(GetLngFromStr(value)), expected);
}

void TestValues::lngOverflowRaises_data() {
    QTest::addColumn<QString>("text");
    QTest::newRow("above") << QStringLiteral("2147483648");
    QTest::newRow("below") << QStringLiteral("-2147483649");
    QTest::newRow("rounds over") << QStringLiteral("2147483647.5");
}

void TestValues::lngOverflowRaises() {
    QFETCH(QString, text);
    try {
        GetLngFromStr(text);
        QFAIL("no overflow");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), err::Overflow);
    }
}

void TestValues::dblFromStr() {
    QCOMPARE(GetDblFromStr(QStringLiteral(" 12.25 ")), 12.25);
    QCOMPARE(GetDblFromStr(QStringLiteral("abc")), 0.0);
    QCOMPARE(GetDblFromStr(Null()), 0.0);
    try {
        GetDblFromStr(QStringLiteral("1e400"));
        QFAIL("no overflow");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), err::Overflow);
    }
}

void TestValues::fixQuote_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("O'Brien") << QVariant(QStringLiteral("O'Brien")) << QStringLiteral("O''Brien");
    QTest::newRow("one apostrophe") << QVariant(QStringLiteral("'")) << QStringLiteral("''");
    QTest::newRow("two in a row") << QVariant(QStringLiteral("a''b")) << QStringLiteral("a''''b");
    QTest::newRow("Hebrew geresh") << QVariant(QStringLiteral("צ'ק")) << QStringLiteral("צ''ק");
    QTest::newRow("empty") << QVariant(QString()) << QString();
    QTest::newRow("Empty") << Empty() << QString();
    QTest::newRow("Null") << Null() << QString();
    QTest::newRow("number") << QVariant(23) << QStringLiteral("23");
}

void TestValues::fixQuote() {
    QFETCH(QVariant, value);
    QFETCH(QString, expected);
    QCOMPARE(FixQuote(value), expected);
}

void TestValues::nullAndEmpty() {
    QVERIFY(IsNullVal(Null()));
    QVERIFY(IsNullVal(QVariant(QMetaType(QMetaType::Int))));
    QVERIFY(!IsNullVal(Empty()));
    QVERIFY(!IsNullVal(QVariant(QString())));
    QVERIFY(!IsNullVal(QVariant(0)));
    QVERIFY(IsEmptyVal(Empty()));
    QVERIFY(!IsEmptyVal(Null()));
}

void TestValues::maxVal_data() {
    QTest::addColumn<QVariant>("a");
    QTest::addColumn<QVariant>("b");
    QTest::addColumn<QVariant>("expected");
    QTest::newRow("numbers") << QVariant(5) << QVariant(3) << QVariant(5);
    QTest::newRow("numbers b") << QVariant(2) << QVariant(3.5) << QVariant(3.5);
    QTest::newRow("numeric not text order") << QVariant(10) << QVariant(9) << QVariant(10);
    QTest::newRow("texts compare as text")
        << QVariant(QStringLiteral("10")) << QVariant(QStringLiteral("9"))
        << QVariant(QStringLiteral("9"));
    QTest::newRow("number and numeric text")
        << QVariant(10) << QVariant(QStringLiteral("9")) << QVariant(10);
    QTest::newRow("text above number")
        << QVariant(QStringLiteral("abc")) << QVariant(100) << QVariant(QStringLiteral("abc"));
    QTest::newRow("Null gives b") << Null() << QVariant(1) << QVariant(1);
}

void TestValues::maxVal() {
    QFETCH(QVariant, a);
    QFETCH(QVariant, b);
    QFETCH(QVariant, expected);
    QCOMPARE(GetMaxVal(a, b), expected);
}

void TestValues::sqlParts_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<bool>("keepCase");
    QTest::addColumn<QString>("select");
    QTest::addColumn<QString>("where");
    QTest::addColumn<QString>("order");
    QTest::newRow("all three") << QStringLiteral("select * from docs where id>5 order by id")
                               << false << QStringLiteral("SELECT * FROM [DOCS] ")
                               << QStringLiteral("WHERE ID>5 ") << QStringLiteral("ORDER BY ID");
    QTest::newRow("bracketed stays single")
        << QStringLiteral("SELECT * FROM [UMEMO] WHERE 1=0") << false
        << QStringLiteral("SELECT * FROM [UMEMO] ") << QStringLiteral("WHERE 1=0") << QString();
    QTest::newRow("where untrimmed to the end")
        << QStringLiteral("SELECT * FROM DOCS WHERE [FullName]='a'  ") << false
        << QStringLiteral("SELECT * FROM [DOCS] ") << QStringLiteral("WHERE [FULLNAME]='A'  ")
        << QString();
    QTest::newRow("neither") << QStringLiteral("SELECT * FROM CLIENT") << false
                             << QStringLiteral("SELECT * FROM [CLIENT] ") << QString() << QString();
    QTest::newRow("order only") << QStringLiteral("SELECT * FROM [CLIENT] ORDER BY NUM") << false
                                << QStringLiteral("SELECT * FROM [CLIENT] ") << QString()
                                << QStringLiteral("ORDER BY NUM");
    QTest::newRow("repeated blanks")
        << QStringLiteral("SELECT  *   FROM   docs   WHERE  x=1   ORDER BY x") << false
        << QStringLiteral("SELECT * FROM [DOCS] ") << QStringLiteral("WHERE  X=1 ")
        << QStringLiteral("ORDER BY X");
    QTest::newRow("keep case") << QStringLiteral("SELECT * FROM Docs where ID=1") << true
                               << QStringLiteral("SELECT * FROM [Docs] where ID=1 ") << QString()
                               << QString();
    QTest::newRow("keep case WHERE")
        << QStringLiteral("SELECT * FROM Docs WHERE ID=1") << true
        << QStringLiteral("SELECT * FROM [Docs] ") << QStringLiteral("WHERE ID=1") << QString();
    QTest::newRow("from lower kept case")
        << QStringLiteral("select a from t") << true << QStringLiteral("select a from [t] ")
        << QString() << QString();
}

void TestValues::sqlParts() {
    QFETCH(QString, sql);
    QFETCH(bool, keepCase);
    QFETCH(QString, select);
    QFETCH(QString, where);
    QFETCH(QString, order);
    const auto parts = GetSqlParts(sql, keepCase);
    QCOMPARE(parts[0], select);
    QCOMPARE(parts[1], where);
    QCOMPARE(parts[2], order);
}

QTEST_MAIN(TestValues)
#include "test_values.moc"

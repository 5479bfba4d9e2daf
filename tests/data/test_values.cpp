// Value helpers and the splitting of SELECT statements.
#include <QtTest>

#include "data/sql_parts.h"
#include "data/values.h"
#include "error_of.h"
#include "util/errors.h"

using namespace zv;

class TestValues : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    // The 16-bit conversion gives 0 on overflow, the 32-bit one and the Double raise error 6
    // (shown as -6); both round half to even.
    void numbers_data() {
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<qint64>("asInt");
        QTest::addColumn<qint64>("asLng");
        QTest::addColumn<double>("asDbl");
        const auto row = [](const char* name, const QVariant& v, qint64 i, qint64 l, double d) {
            QTest::newRow(name) << v << i << l << d;
        };
        row("blanks around", QStringLiteral("  42 "), 42, 42, 42);
        row("12.5 down to even", QStringLiteral("12.5"), 12, 12, 12.5);
        row("-2.5 to even", QStringLiteral("-2.5"), -2, -2, -2.5);
        row("double 1.5 up to even", 1.5, 2, 2, 1.5);
        row("16-bit min", QStringLiteral("-32768"), -32768, -32768, -32768);
        row("rounds over 16 bits", QStringLiteral("32767.5"), 0, 32768, 32767.5);
        row("32-bit max", QStringLiteral("2147483647"), 0, 2147483647, 2147483647);
        row("rounds over 32 bits", QStringLiteral("2147483647.5"), 0, -6, 2147483647.5);
        row("below 32 bits", QStringLiteral("-2147483649"), 0, -6, -2147483649.0);
        row("beyond a double", QStringLiteral("1e400"), 0, -6, -6);
        row("text", QStringLiteral("12abc"), 0, 0, 0);
        row("inf is a word", QStringLiteral("inf"), 0, 0, 0);
        row("grouped", QStringLiteral("1,234"), 1234, 1234, 1234);
        row("Null", Null(), 0, 0, 0);
        row("True", true, -1, -1, -1);
    }

    void numbers() {
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

    void quotesNullsAndMax() {
        QCOMPARE(FixQuote(QStringLiteral("צ'ק O''Brien")), QStringLiteral("צ''ק O''''Brien"));
        QCOMPARE(FixQuote(Null()), QString());
        // A null QString is text, not Null.
        QVERIFY(IsNullVal(Null()) && !IsNullVal(Empty()) && !IsNullVal(QVariant(QString())));
        // Numbers compare as numbers, texts as texts, a number against text as numbers only when
        // the text reads as one; a comparison with Null is never true.
        QCOMPARE(GetMaxVal(2, 3.5), QVariant(3.5));
        QCOMPARE(GetMaxVal(QStringLiteral("10"), QStringLiteral("9")),
                 QVariant(QStringLiteral("9")));
        QCOMPARE(GetMaxVal(10, QStringLiteral("9")), QVariant(10));
        QCOMPARE(GetMaxVal(QStringLiteral("abc"), 100), QVariant(QStringLiteral("abc")));
        QCOMPARE(GetMaxVal(Null(), 1), QVariant(1));
    }

    // The SELECT, WHERE and ORDER parts, joined by "|": the table bracketed once, the WHERE
    // part to the end or to ORDER; WHERE and ORDER in any case, in upper case only when the
    // case is kept.
    void sqlParts() {
        const struct {
            const char* sql;
            bool keepCase;
            const char* parts;
        } cases[] = {
            {"select * from docs where id>5 order by id", false,
             "SELECT * FROM [DOCS] |WHERE ID>5 |ORDER BY ID"},
            {"SELECT * FROM [UMEMO] WHERE 1=0", false, "SELECT * FROM [UMEMO] |WHERE 1=0|"},
            {"SELECT * FROM DOCS WHERE [FullName]='a'  ", false,
             "SELECT * FROM [DOCS] |WHERE [FULLNAME]='A'  |"},
            {"SELECT * FROM [CLIENT] ORDER BY NUM", false, "SELECT * FROM [CLIENT] ||ORDER BY NUM"},
            {"SELECT  *   FROM   docs   WHERE  x=1   ORDER BY x", false,
             "SELECT * FROM [DOCS] |WHERE  X=1 |ORDER BY X"},
            {"SELECT * FROM Docs where ID=1", true, "SELECT * FROM [Docs] where ID=1 ||"},
            {"select a from t", true, "select a from [t] ||"},
        };
        for (const auto& c : cases) {
            const auto found = GetSqlParts(QString::fromLatin1(c.sql), c.keepCase);
            QCOMPARE(QStringList({found[0], found[1], found[2]}).join(QLatin1Char('|')),
                     QString::fromLatin1(c.parts));
        }
    }
};

QTEST_MAIN(TestValues)
#include "test_values.moc"

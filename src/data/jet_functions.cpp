#include "data/jet_functions.h"

#include <sqlite3.h>

#include <QVector>
#include <cmath>

namespace zv {
namespace {

bool IsBlank(QChar c) {
    return c == QLatin1Char(' ') || c == QLatin1Char('\t') || c == QLatin1Char('\n') ||
           c == QLatin1Char('\r');
}

double RadixVal(const QString& digits, int radix) {
    double v = 0;
    for (QChar c : digits) {
        const int d = c.isDigit() ? c.digitValue() : (c.toUpper().unicode() - 'A' + 10);
        if (d < 0 || d >= radix) {
            break;
        }
        v = v * radix + d;
    }
    return v;
}

// One element of a pattern: a literal, any run, any one, a digit, or a class.
struct PatternItem {
    enum Kind { Literal, AnyRun, AnyOne, Digit, Class } kind;
    QChar ch;
    bool negated = false;
    QVector<QPair<QChar, QChar>> ranges;
};

QVector<PatternItem> Compile(const QString& pattern, QChar escape) {
    QVector<PatternItem> items;
    for (qsizetype i = 0; i < pattern.size(); ++i) {
        const QChar c = pattern.at(i);
        if (!escape.isNull() && c == escape && i + 1 < pattern.size()) {
            items.push_back({PatternItem::Literal, pattern.at(++i).toCaseFolded(), false, {}});
        } else if (c == QLatin1Char('*')) {
            items.push_back({PatternItem::AnyRun, {}, false, {}});
        } else if (c == QLatin1Char('?')) {
            items.push_back({PatternItem::AnyOne, {}, false, {}});
        } else if (c == QLatin1Char('#')) {
            items.push_back({PatternItem::Digit, {}, false, {}});
        } else if (c == QLatin1Char('[') && pattern.indexOf(QLatin1Char(']'), i + 1) > i) {
            const qsizetype close = pattern.indexOf(QLatin1Char(']'), i + 1);
            QString body = pattern.mid(i + 1, close - i - 1);
            PatternItem item{PatternItem::Class, {}, false, {}};
            if (body.startsWith(QLatin1Char('!'))) {
                item.negated = true;
                body.remove(0, 1);
            }
            for (qsizetype k = 0; k < body.size(); ++k) {
                const QChar from = body.at(k).toCaseFolded();
                if (k + 2 < body.size() && body.at(k + 1) == QLatin1Char('-')) {
                    item.ranges.push_back({from, body.at(k + 2).toCaseFolded()});
                    k += 2;
                } else {
                    item.ranges.push_back({from, from});
                }
            }
            items.push_back(item);
            i = close;
        } else {
            items.push_back({PatternItem::Literal, c.toCaseFolded(), false, {}});
        }
    }
    return items;
}

bool MatchOne(const PatternItem& item, QChar c) {
    switch (item.kind) {
        case PatternItem::Literal:
            return item.ch == c;
        case PatternItem::AnyOne:
            return true;
        case PatternItem::Digit:
            return c >= QLatin1Char('0') && c <= QLatin1Char('9');
        case PatternItem::Class: {
            bool in = false;
            for (const auto& r : item.ranges) {
                if (c >= r.first && c <= r.second) {
                    in = true;
                    break;
                }
            }
            return in != item.negated;
        }
        case PatternItem::AnyRun:
            break;
    }
    return false;
}

QString ValueText(sqlite3_value* v) {
    const void* t = sqlite3_value_text16(v);
    const int bytes = sqlite3_value_bytes16(v);
    return QString(static_cast<const QChar*>(t), bytes / 2);
}

void ValFunction(sqlite3_context* ctx, int, sqlite3_value** argv) {
    switch (sqlite3_value_type(argv[0])) {
        case SQLITE_NULL:
            sqlite3_result_null(ctx);
            return;
        case SQLITE_INTEGER:
            sqlite3_result_int64(ctx, sqlite3_value_int64(argv[0]));
            return;
        case SQLITE_FLOAT:
            sqlite3_result_double(ctx, sqlite3_value_double(argv[0]));
            return;
        default:
            break;
    }
    const double d = JetVal(ValueText(argv[0]));
    if (d == std::trunc(d) && std::fabs(d) < 9.0e15) {
        sqlite3_result_int64(ctx, static_cast<sqlite3_int64>(d));
    } else {
        sqlite3_result_double(ctx, d);
    }
}

// SQLite calls like(pattern, text[, escape]) for "text LIKE pattern [ESCAPE e]".
void LikeFunction(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    if (sqlite3_value_type(argv[0]) == SQLITE_NULL || sqlite3_value_type(argv[1]) == SQLITE_NULL) {
        sqlite3_result_null(ctx);
        return;
    }
    QChar escape;
    if (argc == 3 && sqlite3_value_type(argv[2]) != SQLITE_NULL) {
        const QString e = ValueText(argv[2]);
        if (e.size() != 1) {
            sqlite3_result_error(ctx, "ESCAPE expression must be a single character", -1);
            return;
        }
        escape = e.at(0);
    }
    sqlite3_result_int(ctx, JetLike(ValueText(argv[0]), ValueText(argv[1]), escape) ? 1 : 0);
}

}  // namespace

double JetVal(const QString& text) {
    QString s;
    for (QChar c : text) {
        if (!IsBlank(c)) {
            s += c;
        }
    }
    if (s.startsWith(QLatin1String("&H"), Qt::CaseInsensitive)) {
        return RadixVal(s.mid(2), 16);
    }
    if (s.startsWith(QLatin1String("&O"), Qt::CaseInsensitive)) {
        return RadixVal(s.mid(2), 8);
    }
    // Longest prefix of the form [sign] digits [. digits] [E|D [sign] digits].
    qsizetype i = 0;
    const qsizetype n = s.size();
    auto digits = [&] {
        const qsizetype start = i;
        while (i < n && s.at(i) >= QLatin1Char('0') && s.at(i) <= QLatin1Char('9')) {
            ++i;
        }
        return i > start;
    };
    if (i < n && (s.at(i) == QLatin1Char('+') || s.at(i) == QLatin1Char('-'))) {
        ++i;
    }
    bool any = digits();
    if (i < n && s.at(i) == QLatin1Char('.')) {
        ++i;
        any = digits() || any;
    }
    if (!any) {
        return 0;
    }
    qsizetype end = i;
    if (i < n && (s.at(i).toUpper() == QLatin1Char('E') || s.at(i).toUpper() == QLatin1Char('D'))) {
        ++i;
        if (i < n && (s.at(i) == QLatin1Char('+') || s.at(i) == QLatin1Char('-'))) {
            ++i;
        }
        if (digits()) {
            end = i;
        }
    }
    QString number = s.left(end);
    number.replace(QLatin1Char('d'), QLatin1Char('e')).replace(QLatin1Char('D'), QLatin1Char('e'));
    return number.toDouble();
}

bool JetLike(const QString& pattern, const QString& text, QChar escape) {
    const QVector<PatternItem> items = Compile(pattern, escape);
    const QString t = text.toCaseFolded();
    // Greedy match with one backtrack point for the last "*", linear in practice.
    qsizetype p = 0, s = 0, starP = -1, starS = -1;
    while (s < t.size()) {
        if (p < items.size() && items[p].kind == PatternItem::AnyRun) {
            starP = p++;
            starS = s;
        } else if (p < items.size() && MatchOne(items[p], t.at(s))) {
            ++p;
            ++s;
        } else if (starP >= 0) {
            p = starP + 1;
            s = ++starS;
        } else {
            return false;
        }
    }
    while (p < items.size() && items[p].kind == PatternItem::AnyRun) {
        ++p;
    }
    return p == items.size();
}

int RegisterJetFunctions(sqlite3* db) {
    const int flags = SQLITE_UTF8 | SQLITE_DETERMINISTIC;
    int rc = sqlite3_create_function(db, "Val", 1, flags, nullptr, ValFunction, nullptr, nullptr);
    if (rc == SQLITE_OK) {
        rc = sqlite3_create_function(db, "like", 2, flags, nullptr, LikeFunction, nullptr, nullptr);
    }
    if (rc == SQLITE_OK) {
        rc = sqlite3_create_function(db, "like", 3, flags, nullptr, LikeFunction, nullptr, nullptr);
    }
    return rc;
}

}  // namespace zv

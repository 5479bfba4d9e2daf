#include "data/jet_functions.h"

#include <sqlite3.h>

#include <QStringView>
#include <algorithm>
#include <array>
#include <cmath>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

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

// Case folding of one UTF-16 code unit, as QChar::toCaseFolded does it, without the table
// look-up for the letters names are mostly made of. A surrogate folds to itself.
inline char16_t Fold(char16_t c) {
    if (c < 0x80) {
        return c >= u'A' && c <= u'Z' ? static_cast<char16_t>(c + 0x20) : c;
    }
    if (c >= 0x0590 && c <= 0x05FF) {  // Hebrew has no case
        return c;
    }
    return static_cast<char16_t>(QChar::toCaseFolded(char32_t{c}));
}

// One element of a pattern: a literal, any run, any one, a digit, or a class. Characters
// are folded.
struct PatternItem {
    enum Kind { Literal, AnyRun, AnyOne, Digit, Class } kind;
    char16_t ch = 0;
    bool negated = false;
    std::vector<std::pair<char16_t, char16_t>> ranges;
};

bool MatchOne(const PatternItem& item, char16_t c) {
    switch (item.kind) {
        case PatternItem::Literal:
            return item.ch == c;
        case PatternItem::AnyOne:
            return true;
        case PatternItem::Digit:
            return c >= u'0' && c <= u'9';
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

// A pattern compiled once and matched against many texts without copying them. Pattern
// and text are folded one code unit at a time, so that a letter outside the basic plane
// folds the same way on both sides.
class LikePattern {
  public:
    LikePattern(QStringView pattern, char16_t escape);
    char16_t Escape() const { return escape_; }
    bool Matches(QStringView text) const;

  private:
    // The shapes a search box makes ("text", "text*", "*text", "*text*", "*"), matched
    // against literal_ without the general loop.
    enum class Shape { General, Exact, Prefix, Suffix, Contains, Anything };

    bool SameFolded(const char16_t* t) const;
    bool MatchGeneral(const char16_t* t, qsizetype n) const;

    char16_t escape_;
    std::vector<PatternItem> items_;
    Shape shape_ = Shape::General;
    std::u16string literal_;
};

LikePattern::LikePattern(QStringView pattern, char16_t escape) : escape_(escape) {
    for (qsizetype i = 0; i < pattern.size(); ++i) {
        const char16_t c = pattern.at(i).unicode();
        if (escape != 0 && c == escape && i + 1 < pattern.size()) {
            items_.push_back({PatternItem::Literal, Fold(pattern.at(++i).unicode()), false, {}});
        } else if (c == u'*') {
            // A run of stars means what one does.
            if (items_.empty() || items_.back().kind != PatternItem::AnyRun) {
                items_.push_back({PatternItem::AnyRun, 0, false, {}});
            }
        } else if (c == u'?') {
            items_.push_back({PatternItem::AnyOne, 0, false, {}});
        } else if (c == u'#') {
            items_.push_back({PatternItem::Digit, 0, false, {}});
        } else if (c == u'[' && pattern.indexOf(QLatin1Char(']'), i + 1) > i) {
            const qsizetype close = pattern.indexOf(QLatin1Char(']'), i + 1);
            QStringView body = pattern.mid(i + 1, close - i - 1);
            PatternItem item{PatternItem::Class, 0, false, {}};
            if (body.startsWith(QLatin1Char('!'))) {
                item.negated = true;
                body = body.mid(1);
            }
            for (qsizetype k = 0; k < body.size(); ++k) {
                const char16_t from = Fold(body.at(k).unicode());
                if (k + 2 < body.size() && body.at(k + 1) == QLatin1Char('-')) {
                    item.ranges.push_back({from, Fold(body.at(k + 2).unicode())});
                    k += 2;
                } else {
                    item.ranges.push_back({from, from});
                }
            }
            items_.push_back(std::move(item));
            i = close;
        } else {
            items_.push_back({PatternItem::Literal, Fold(c), false, {}});
        }
    }
    const auto literal = [](const PatternItem& item) { return item.kind == PatternItem::Literal; };
    const bool starFirst = !items_.empty() && items_.front().kind == PatternItem::AnyRun;
    const bool starLast = !items_.empty() && items_.back().kind == PatternItem::AnyRun;
    const auto first = items_.begin() + (starFirst ? 1 : 0);
    const auto last = items_.end() - (starLast && items_.size() > 1 ? 1 : 0);
    if (first > last || !std::all_of(first, last, literal)) {
        return;
    }
    for (auto it = first; it != last; ++it) {
        literal_.push_back(it->ch);
    }
    if (starFirst && literal_.empty()) {
        shape_ = Shape::Anything;
    } else if (starFirst) {
        shape_ = starLast ? Shape::Contains : Shape::Suffix;
    } else {
        shape_ = starLast ? Shape::Prefix : Shape::Exact;
    }
}

bool LikePattern::Matches(QStringView text) const {
    const char16_t* t = text.utf16();
    const qsizetype n = text.size();
    const qsizetype m = static_cast<qsizetype>(literal_.size());
    switch (shape_) {
        case Shape::Anything:
            return true;
        case Shape::Exact:
            return n == m && SameFolded(t);
        case Shape::Prefix:
            return n >= m && SameFolded(t);
        case Shape::Suffix:
            return n >= m && SameFolded(t + n - m);
        case Shape::Contains:
            for (qsizetype i = 0; i + m <= n; ++i) {
                if (SameFolded(t + i)) {
                    return true;
                }
            }
            return false;
        case Shape::General:
            break;
    }
    return MatchGeneral(t, n);
}

bool LikePattern::SameFolded(const char16_t* t) const {
    for (const char16_t c : literal_) {
        if (Fold(*t++) != c) {
            return false;
        }
    }
    return true;
}

bool LikePattern::MatchGeneral(const char16_t* t, qsizetype n) const {
    // Greedy match with one backtrack point for the last "*", linear in practice.
    const qsizetype size = static_cast<qsizetype>(items_.size());
    qsizetype p = 0, s = 0, starP = -1, starS = -1;
    while (s < n) {
        if (p < size && items_[p].kind == PatternItem::AnyRun) {
            starP = p++;
            starS = s;
        } else if (p < size && MatchOne(items_[p], Fold(t[s]))) {
            ++p;
            ++s;
        } else if (starP >= 0) {
            p = starP + 1;
            s = ++starS;
        } else {
            return false;
        }
    }
    while (p < size && items_[p].kind == PatternItem::AnyRun) {
        ++p;
    }
    return p == size;
}

// The UTF-16 text of a value as SQLite holds it, valid until the value changes. Null when
// SQLite ran out of memory converting it.
const char16_t* Text16(sqlite3_value* v, qsizetype* size) {
    const auto* t = static_cast<const char16_t*>(sqlite3_value_text16(v));
    *size = sqlite3_value_bytes16(v) / 2;
    return t;
}

// A value's UTF-8 text as UTF-16 in units, when it is short, well-formed and within the
// basic plane; its length, or -1 for anything else, which is left to SQLite's own
// conversion (a malformed byte would otherwise be read differently).
qsizetype Utf8ToUtf16(const unsigned char* p, qsizetype n, std::array<char16_t, 256>& units) {
    if (n > static_cast<qsizetype>(units.size())) {
        return -1;
    }
    const unsigned char* end = p + n;
    qsizetype size = 0;
    while (p < end) {
        const unsigned c = *p;
        if (c < 0x80) {
            units[size++] = static_cast<char16_t>(c);
            ++p;
        } else if (c >= 0xC2 && c <= 0xDF && end - p >= 2 && (p[1] & 0xC0) == 0x80) {
            units[size++] = static_cast<char16_t>(((c & 0x1F) << 6) | (p[1] & 0x3F));
            p += 2;
        } else if (c >= 0xE0 && c <= 0xEF && end - p >= 3 && (p[1] & 0xC0) == 0x80 &&
                   (p[2] & 0xC0) == 0x80) {
            const unsigned u = ((c & 0x0F) << 12) | ((p[1] & 0x3F) << 6) | (p[2] & 0x3F);
            // Overlong forms, surrogates and the two non-characters SQLite replaces.
            if (u < 0x800 || (u >= 0xD800 && u <= 0xDFFF) || u >= 0xFFFE) {
                return -1;
            }
            units[size++] = static_cast<char16_t>(u);
            p += 3;
        } else {
            return -1;
        }
    }
    return size;
}

// Matches a value's text, read as stored when that spares SQLite the conversion to
// UTF-16. Empty when SQLite ran out of memory.
std::optional<bool> MatchValue(const LikePattern& pattern, sqlite3_value* v) {
    const unsigned char* bytes = sqlite3_value_text(v);
    if (bytes == nullptr) {
        return std::nullopt;
    }
    std::array<char16_t, 256> units;
    const qsizetype converted = Utf8ToUtf16(bytes, sqlite3_value_bytes(v), units);
    if (converted >= 0) {
        return pattern.Matches(QStringView(units.data(), converted));
    }
    qsizetype size = 0;
    const char16_t* text = Text16(v, &size);
    if (text == nullptr) {
        return std::nullopt;
    }
    return pattern.Matches(QStringView(text, size));
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

// SQLite calls like(pattern, text[, escape]) for "text LIKE pattern [ESCAPE e]". The
// compiled pattern is kept with the statement while the pattern stays the same.
void LikeFunction(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    if (sqlite3_value_type(argv[0]) == SQLITE_NULL || sqlite3_value_type(argv[1]) == SQLITE_NULL) {
        sqlite3_result_null(ctx);
        return;
    }
    char16_t escape = 0;
    if (argc == 3 && sqlite3_value_type(argv[2]) != SQLITE_NULL) {
        qsizetype size = 0;
        const char16_t* e = Text16(argv[2], &size);
        if (e == nullptr) {
            sqlite3_result_error_nomem(ctx);
            return;
        }
        if (size != 1) {
            sqlite3_result_error(ctx, "ESCAPE expression must be a single character", -1);
            return;
        }
        escape = e[0];
    }
    const auto* kept = static_cast<const LikePattern*>(sqlite3_get_auxdata(ctx, 0));
    std::unique_ptr<LikePattern> compiled;
    if (kept == nullptr || kept->Escape() != escape) {
        qsizetype size = 0;
        const char16_t* pattern = Text16(argv[0], &size);
        if (pattern == nullptr) {
            sqlite3_result_error_nomem(ctx);
            return;
        }
        compiled = std::make_unique<LikePattern>(QStringView(pattern, size), escape);
        kept = compiled.get();
    }
    const std::optional<bool> match = MatchValue(*kept, argv[1]);
    if (!match) {
        sqlite3_result_error_nomem(ctx);
        return;
    }
    sqlite3_result_int(ctx, *match ? 1 : 0);
    if (compiled) {
        // SQLite may delete it at once (a pattern that changes from row to row), so it is
        // handed over last.
        sqlite3_set_auxdata(ctx, 0, compiled.release(),
                            [](void* p) { delete static_cast<LikePattern*>(p); });
    }
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
    return LikePattern(pattern, escape.unicode()).Matches(text);
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

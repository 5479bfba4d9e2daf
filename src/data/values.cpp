#include "data/values.h"

#include <QDateTime>
#include <QLocale>
#include <cmath>
#include <limits>

#include "util/errors.h"

namespace zv {
namespace {

// The platform's numeric test: numbers and Booleans are numeric, text is numeric when it
// reads as a decimal number (signs, decimal point, grouping and exponent allowed).
// Returns false for anything else; an out-of-range number sets overflow.
bool NumericValue(const QVariant& value, double& out, bool& overflow) {
    overflow = false;
    switch (value.typeId()) {
        case QMetaType::Bool:
            out = value.toBool() ? -1.0 : 0.0;
            return true;
        case QMetaType::Int:
        case QMetaType::UInt:
        case QMetaType::LongLong:
        case QMetaType::ULongLong:
        case QMetaType::Short:
        case QMetaType::UShort:
        case QMetaType::Long:
        case QMetaType::ULong:
        case QMetaType::Double:
        case QMetaType::Float:
            out = value.toDouble();
            return true;
        case QMetaType::QString:
        case QMetaType::QByteArray:
            break;
        default:
            return false;
    }
    const QString text = value.toString().trimmed();
    bool ok = false;
    out = QLocale::c().toDouble(text, &ok);
    if (ok) {
        return std::isfinite(out);  // "inf" and "nan" are words, not numbers
    }
    // A well-formed number beyond the range of a double is numeric and overflows.
    const QByteArray latin = text.toLatin1();
    char* end = nullptr;
    const double d = std::strtod(latin.constData(), &end);
    if (!latin.isEmpty() && end == latin.constData() + latin.size() && std::isinf(d) &&
        !text.contains(QLatin1String("inf"), Qt::CaseInsensitive)) {
        overflow = true;
        return true;
    }
    return false;
}

// Null, blank and non-numeric give 0; otherwise the number, or overflow.
double NumberOrZero(const QVariant& value, bool& overflow) {
    overflow = false;
    if (IsNullVal(value) || !value.isValid() || value.toString().trimmed().isEmpty()) {
        return 0;
    }
    double d = 0;
    if (!NumericValue(value, d, overflow)) {
        return 0;
    }
    return d;
}

// Whole-number conversion rounds halves to the even neighbour.
double RoundHalfEven(double d) {
    const double r = std::round(d);
    if (std::fabs(d - std::trunc(d)) == 0.5) {
        return 2.0 * std::round(d / 2.0);
    }
    return r;
}

bool IsNumber(const QVariant& v) {
    double d = 0;
    bool overflow = false;
    return v.typeId() != QMetaType::QString && NumericValue(v, d, overflow);
}

double AsComparableNumber(const QVariant& v) {
    if (v.typeId() == QMetaType::QDateTime || v.typeId() == QMetaType::QDate) {
        // Dates compare as their day numbers.
        const QDateTime zero(QDate(1899, 12, 30), QTime(0, 0));
        return zero.msecsTo(v.toDateTime()) / 86400000.0;
    }
    double d = 0;
    bool overflow = false;
    NumericValue(v, d, overflow);
    return d;
}

bool IsDateValue(const QVariant& v) {
    return v.typeId() == QMetaType::QDateTime || v.typeId() == QMetaType::QDate;
}

}  // namespace

bool IsNullVal(const QVariant& value) {
    return value.isValid() && value.isNull();
}

QString FixQuote(const QVariant& value) {
    if (!value.isValid() || IsNullVal(value)) {
        return {};
    }
    QString text = value.toString();
    return text.replace(QLatin1Char('\''), QStringLiteral("''"));
}

QVariant GetMaxVal(const QVariant& a, const QVariant& b) {
    // A comparison with Null is never true.
    if (IsNullVal(a) || IsNullVal(b)) {
        return b;
    }
    const bool aNum = IsNumber(a) || IsDateValue(a) || !a.isValid();
    const bool bNum = IsNumber(b) || IsDateValue(b) || !b.isValid();
    bool greater = false;
    if (aNum && bNum) {
        greater = AsComparableNumber(a) > AsComparableNumber(b);
    } else if (!aNum && !bNum) {
        greater = a.toString().compare(b.toString(), Qt::CaseSensitive) > 0;
    } else {
        // A number against text: numeric when the text reads as a number, otherwise the
        // number is the smaller.
        const QVariant& text = aNum ? b : a;
        double d = 0;
        bool overflow = false;
        if (NumericValue(text, d, overflow) && !overflow) {
            greater = AsComparableNumber(a) > AsComparableNumber(b);
        } else {
            greater = !aNum;
        }
    }
    return greater ? a : b;
}

double GetDblFromStr(const QVariant& value) {
    bool overflow = false;
    const double d = NumberOrZero(value, overflow);
    if (overflow) {
        throw MakeError(err::Overflow);
    }
    return d;
}

int16_t GetIntFromStr(const QVariant& value) {
    bool overflow = false;
    const double d = RoundHalfEven(NumberOrZero(value, overflow));
    if (overflow || d < std::numeric_limits<int16_t>::min() ||
        d > std::numeric_limits<int16_t>::max()) {
        return 0;
    }
    return static_cast<int16_t>(d);
}

int32_t GetLngFromStr(const QVariant& value) {
    bool overflow = false;
    const double d = RoundHalfEven(NumberOrZero(value, overflow));
    if (overflow || d < std::numeric_limits<int32_t>::min() ||
        d > std::numeric_limits<int32_t>::max()) {
        throw MakeError(err::Overflow);
    }
    return static_cast<int32_t>(d);
}

}  // namespace zv

#pragma once
// Value helpers around SQL text. Empty is an invalid QVariant (a value never set); Null is
// a null QVariant of a valid type, as Qt SQL returns a SQL NULL.

#include <QVariant>
#include <cstdint>

namespace zv {

inline QVariant Empty() {
    return QVariant();
}
inline QVariant Null() {
    return QVariant(QMetaType(QMetaType::QString));
}

// Apostrophes doubled, for a value placed between apostrophes in SQL.
QString FixQuote(const QVariant& value);
QVariant GetMaxVal(const QVariant& a, const QVariant& b);
double GetDblFromStr(const QVariant& value);   // throws VbError 6 on overflow
int16_t GetIntFromStr(const QVariant& value);  // overflow gives 0
int32_t GetLngFromStr(const QVariant& value);  // throws VbError 6 on overflow
bool IsNullVal(const QVariant& value);

}  // namespace zv

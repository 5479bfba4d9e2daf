#pragma once
// Date values as the suite stores them: an empty date box reads 0, which is the zero date
// 1899-12-30 00:00.

#include <QDate>
#include <QDateTime>
#include <QVariant>

namespace zv {

QDateTime ZeroDate();
// The value a date box writes: its day at midnight, or the zero date when empty.
QDateTime DateBoxValue(const QDate& day);
// A stored date or date-time (a date-time, a date or its ISO text) as a date-time; an
// invalid result when the value is none of them.
QDateTime StoredDateTime(const QVariant& value);

}  // namespace zv

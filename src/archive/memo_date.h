#pragma once
// The moment of a document's reminder, from its stored date and "HH:MM" time.

#include <QDateTime>
#include <QVariant>

namespace zv {

// Forms the reminder moment: the date plus the hours and minutes of the time text. Hours
// and minutes are not range-checked, so "24:30" is 00:30 of the next day. A missing or zero
// date, or a time that is not two digits, a separator and two digits, forms nothing; with
// showMessage the user is told. Returns whether result was set.
bool GetmDate(const QVariant& dateValue, const QVariant& hourValue, QDateTime& result,
              bool showMessage);

}  // namespace zv

#pragma once
// The filing request on the command line: mode, path and name joined by "¥".

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <cstdint>

namespace zv {

// The request separator, code 165 of the Windows ANSI code pages.
inline constexpr char16_t kRequestSeparator = u'\u00A5';

// Command-line bytes as text: UTF-8, or Windows-1255 when they are not valid UTF-8.
QString DecodeArgumentText(const QByteArray& bytes);
// The argument text without leading and trailing spaces, split on "¥". The fields
// themselves keep their spaces.
QStringList SplitRequest(const QString& argumentText);
// The fixed request of a development run.
QString DevelopmentRequest();
// The mode field as a 16-bit integer, rounding halves to even; throws VbError 13 for a
// text that is not a number and 6 for one out of range.
int16_t RequestMode(const QString& field);

}  // namespace zv

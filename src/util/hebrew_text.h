#pragma once
// Text from the suite's Windows side: UTF-8 when it is valid UTF-8, otherwise the Hebrew
// ANSI code page (Windows-1255), in which the byte A5 is "¥".

#include <QByteArray>
#include <QString>

namespace zv {

QString DecodeUtf8OrWindows1255(const QByteArray& bytes);

}  // namespace zv

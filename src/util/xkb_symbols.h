#pragma once
// Windows keyboard-layout identifiers in terms of XKB: the keyboard's symbols name (for
// example "pc+us+il:2+inet(evdev)") lists each group's layout, "il:2" being the second.

#include <QString>

namespace zv {

// The XKB layout of a Windows layout identifier (hexadecimal digits in any case), or an
// empty string for a layout without one.
QString XkbLayoutOfId(const QString& layoutId);
// The Windows identifier, in upper case, of an XKB layout; empty when it has none.
QString IdOfXkbLayout(const QString& layout);
// The zero-based group holding a layout, or -1.
int XkbGroupOfLayout(const QString& symbols, const QString& layout);
// The layout of a zero-based group when it has a Windows identifier, else an empty string.
QString XkbLayoutOfGroup(const QString& symbols, int group);

}  // namespace zv

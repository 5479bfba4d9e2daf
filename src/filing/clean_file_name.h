#pragma once
// The characters a file name may not hold, and a name without them.

#include <QString>

namespace zv {

// Stores the nine characters refused in file names in BadFileChars, then returns text with
// every one of them removed; everything else, spaces and dots too, stays in its order.
QString CleanFileName(const QString& text);

}  // namespace zv

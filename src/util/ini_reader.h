#pragma once
// Reads one value of an INI file the way Windows reads suite files: section and key names
// without case, the first match wins, blanks around names and values ignored, surrounding
// quotes removed, values cut at 511 characters. Files are UTF-8, or else Windows-1255.

#include <QString>

namespace zv {

// The value, or an empty string when the file, the section or the key is missing.
// Failures are reported with the tag "-ReadINI-".
QString ReadINI(const QString& section, const QString& key, const QString& fileName);

}  // namespace zv

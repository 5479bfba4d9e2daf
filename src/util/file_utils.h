#pragma once
// File and folder helpers shared by the whole add-in. Paths may use "\" or "/" as the
// separator; both reach the same file on disk.

#include <QString>

#include "util/errors.h"

namespace zv {

// The path as the file system of this platform spells it ("\" and "/" both accepted).
QString DiskPath(const QString& path);

// Whether a file (or, for a path with "?" or "*", any file matching the pattern) exists.
// An existing file is deleted first when deleteIfExist (read-only or not); a missing one is
// created holding the line "1" when createIfMissing. The flags are ignored for patterns.
// Failures other than a denied permission are reported in a message box.
bool IsFileExist(const QString& path, bool deleteIfExist = false, bool createIfMissing = false);

// Whether a folder exists; with createIfMissing it is created first with its parents.
bool IsFolderExist(const QString& path, bool createIfMissing = false);

// The runtime's error for a failed file-system call with this errno value (76 path not
// found, 70 permission denied, 58 file already exists, else 75).
VbError FileSystemError(int code);

// Creates one folder whose parent exists (an existing folder is fine); throws the
// runtime's VbError (76 path not found, 70 permission denied, ...) when it cannot.
void MakeFolder(const QString& path);

// Creates a folder with every missing parent, one level at a time. The server part of a
// network path ("\\server\share\...") is never created. Returns whether the folder exists
// at the end; a level that cannot be created is reported and the next one is tried.
bool BuildDirTree(const QString& path);

}  // namespace zv

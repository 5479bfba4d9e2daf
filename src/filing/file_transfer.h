#pragma once
// Moving a document into the archive: copying it over a target and removing the source.

#include <QString>

namespace zv {

// Copies source to target, replacing a file of that name. The copy is written beside the
// target under a temporary name and renamed over it at the end, so a copy that fails half
// way leaves an earlier file at target whole. Throws the runtime's VbError (70 permission
// denied, 76 path not found, ...).
void CopyFileOver(const QString& source, const QString& target);

// Whether both paths name one file on disk (also through other spellings or links).
bool IsSameFile(const QString& a, const QString& b);

// Deletes a file; throws the runtime's VbError when it cannot.
void RemoveFile(const QString& path);

}  // namespace zv

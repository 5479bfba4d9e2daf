#pragma once
// The row of DOCS that describes a filed document.

#include <QString>

#include "archive/doc_details.h"

namespace zv {

// Writes (or updates, for a path that already has one) the DOCS row of the archived file
// fullPath, from the file and from the confirmed dialog (nullptr: no dialog was loaded), then
// rewrites the document's reminders. Returns whether the row was saved; when it was not, the
// caller keeps the source file.
bool AddDocToListByAddIn(const QString& fullPath, const DocDetails* details);

}  // namespace zv

#pragma once
// The reminder rows of a document in UMEMO of the BM database.

#include <QString>

namespace zv {

class Recordset;

// Replaces the reminders of the document row that rs is positioned on: its pop-up (31) and
// regular (32) rows are deleted, then, when the row asks for a reminder, one row per handler
// is written, all pop-up rows first. Other reminder types are never touched.
void CheckMemo(const QString& tableName, Recordset* rs);

}  // namespace zv

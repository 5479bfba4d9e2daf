#pragma once
// The suite's code tables behind the filing dialog's lists, read front to back into plain
// values. Each reader opens and closes its own database and throws VbError on failure.

#include <QString>
#include <QStringList>
#include <vector>

namespace zv {

// One list entry: its text and its item data.
struct CodeEntry {
    QString text;
    int data = 0;
};

// Suggestions of OFF_CODE for one code (20: descriptions, 21: additional descriptions).
QStringList ReadOffCodeTexts(int code);
// Document statuses of DOCSTATUS: "ID - Caption", item data ID.
std::vector<CodeEntry> ReadDocStatuses();
// Document origins of TRANS_CODE table 1080 in numeric order: "KOD_NUM_1 - Teur", item
// data KOD_NUM_1.
std::vector<CodeEntry> ReadDocOrigins();
// Names of the inner folders under DOCS/DOCBASIC (created when missing), as the file system
// lists them.
QStringList ReadInnerFolders();

}  // namespace zv

#pragma once
// Error numbers of the data layer beyond the common ones of util/errors.h, and the
// mapping of engine failures onto the numbers the suite's users know.

#include <QSqlError>

#include "util/errors.h"

namespace zv {
namespace err {
constexpr long AdoInvalidArgument = 3001;        // arguments of the wrong type or out of range
constexpr long JetUpdateWithoutEdit = 3020;      // Update or CancelUpdate without AddNew or Edit
constexpr long JetNoCurrentRecord = 3021;        // no current record
constexpr long JetCannotFindTable = 3078;        // input table or query not found
constexpr long JetNotValidBookmark = 3159;       // not a valid bookmark
constexpr long JetRecordChanged = 3197;          // row changed or deleted by another user
constexpr long JetNullField = 3314;              // a required field holds Null
constexpr long JetUnrecognizedFormat = 3343;     // not a database file
constexpr long AdoObjectClosed = 3704;           // operation not allowed when closed
constexpr long AdoObjectOpen = 3705;             // operation not allowed when open
constexpr long AdoProviderNotFound = 3706;       // provider cannot be found
constexpr long ServerCommand = -2147217900;      // 0x80040E14: the server refused the command
constexpr long ServerRowNotFound = -2147217864;  // 0x80040E38: row to update not found
}  // namespace err

// An error of the data layer with its usual description.
VbError DataError(long number, const QString& source = {});

enum class Engine { Sqlite, Postgres, SqlServer };

// The VB-style error for a failure of the engine; source names the operation.
VbError EngineError(Engine engine, const QSqlError& error, const QString& source = {});

}  // namespace zv

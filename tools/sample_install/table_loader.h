#pragma once
// Creating the tables of one database from its schema section and filling them with the
// sample rows, on any Qt SQL connection (SQLite or PostgreSQL).

#include <QSqlDatabase>
#include <QString>
#include <QStringList>

#include "sample_install/sample_data.h"

namespace zv {

// Runs one statement; a failure throws std::runtime_error naming the statement.
void ExecOrThrow(QSqlDatabase& db, const QString& sql);

// Creates the tables of a database and loads its sample rows, in one transaction with
// multi-row prepared INSERTs. Returns the index statements of the schema, left for the
// caller to run afterwards: building an index on loaded rows is much faster.
QStringList LoadDatabase(QSqlDatabase& db, const QString& database, const QStringList& schema,
                         const SampleData& data);

}  // namespace zv

#pragma once
// The few rewrites PostgreSQL needs to run the suite's T-SQL texts: "[name]" identifiers,
// "SELECT TOP n", LIKE without regard to case (with the text conversion SQL Server makes
// implicitly) and "USE <db>", which becomes a check that the connection is on that
// database. String literals are never touched.

#include <QString>

namespace zv {

QString AdaptForPostgres(const QString& tsql);

}  // namespace zv

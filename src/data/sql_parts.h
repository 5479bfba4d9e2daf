#pragma once
// Splits a SELECT statement into its select, where and order parts.

#include <QString>
#include <array>

namespace zv {

std::array<QString, 3> GetSqlParts(const QString& sql, bool keepCase);

}  // namespace zv

#pragma once
// The rows of a logical database, read and changed where the back-end flags put it.

#include <QList>
#include <QString>
#include <QVariantMap>

namespace zv::test {

// Rows of a query, each a map from the upper-case column name to its value.
QList<QVariantMap> Rows(const QString& database, const QString& sql);
void Execute(const QString& database, const QString& sql);

}  // namespace zv::test

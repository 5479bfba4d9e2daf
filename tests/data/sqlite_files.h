#pragma once
// Small file databases for the data tests, made with the SQLite C API so that nothing of
// the code under test is used to build them.

#include <QString>
#include <QStringList>

namespace zv::test {

// Creates (or extends) the file MainPath/name.MDB and runs the statements in it.
void MakeFileDb(const QString& mainPath, const QString& name, const QStringList& statements);
// One value of a query against a file, read with the C API ("" for NULL).
QString QueryFileDb(const QString& mainPath, const QString& name, const QString& sql);

}  // namespace zv::test

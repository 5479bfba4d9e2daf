#pragma once
// The server connection string of a logical database, and its mapping onto a Qt driver.

#include <QString>

namespace zv {

// "Provider=...;Data Source=...;Initial Catalog=<DbName><VolnaGlobNum>;..." as the suite
// builds it.
QString GetConnectionByDbName(const QString& dbName);

}  // namespace zv

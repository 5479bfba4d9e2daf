#pragma once
// The server connection string of a logical database, and its mapping onto a Qt driver.

#include <QString>

namespace zv {

// "Provider=...;Data Source=...;Initial Catalog=<DbName><VolnaGlobNum>;..." as the suite
// builds it. A value that holds ";", begins with a quote, or begins or ends with a blank is
// quoted the way OLE DB and ODBC connection strings quote values; every other value stands
// as stored.
QString GetConnectionByDbName(const QString& dbName);

// One value of a connection string, quoted only when it must be.
QString QuoteConnectionValue(const QString& value);

// What a Qt connection needs, read from a connection string.
struct ServerConnectionParams {
    QString driver;    // "QODBC" or "QPSQL"
    QString host;      // host name, or the socket folder of a local PostgreSQL
    int port = -1;     // -1: the driver's default
    QString database;  // Initial Catalog
    QString user;
    QString password;
    int connectTimeout = 30;  // seconds
    // QODBC only: the ODBC connection string handed to the driver manager.
    QString odbcConnectionString;
};

// Provider SQLOLEDB, SQLNCLI*, MSOLEDBSQL* map to QODBC with a SQL Server ODBC driver;
// Provider PostgreSQL maps to QPSQL. Keys compare without case. An unknown provider is
// error 3706.
ServerConnectionParams ParseConnectionString(const QString& connectionString);

// The ODBC driver used for SQL Server: the environment variable ZORVANE_ODBC_DRIVER when
// set (so an installation can name its own driver without a rebuild), otherwise FreeTDS
// (on Windows: "SQL Server", which every Windows has).
QString SqlServerOdbcDriver();

}  // namespace zv

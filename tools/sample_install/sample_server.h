#pragma once
// The server side of a sample installation: the databases OFFICE, MDOCS, BM and ZORVA
// followed by the client number on a PostgreSQL server, and the settings file that points
// the add-in at them.

#include <QSqlDatabase>
#include <QString>
#include <QStringList>

#include "sample_install/sample_data.h"
#include "sample_install/sample_options.h"

namespace zv {

// The logical names of the databases that may live on the server.
const QStringList& ServerDatabaseNames();

// Drops and creates the four databases (quoted upper-case names, "OFFICE23") and loads
// them with the same rows as the file databases. Throws std::runtime_error.
void CreateServerDatabases(const SampleOptions& options, const SampleData& data);
void CreateServerDatabases(const SampleOptions& options);

// MainPath/Def/MSSQLSetting.INI: provider PostgreSQL, the data source, and the login in
// the shared section "000".
void WriteServerSettingsFile(const QString& mainPath, const SampleOptions& options);

// An open connection (added under connectionName) to a database of the options' server;
// "postgres" is the maintenance database. Throws std::runtime_error.
QSqlDatabase ConnectSampleServer(const SampleOptions& options, const QString& database,
                                 const QString& connectionName);

}  // namespace zv

#pragma once
// One open database: a file database (SQLite in the role of the suite's Jet files) or a
// server database (SQL Server through ODBC, or PostgreSQL). Opened per operation, closed
// by GClose or the destructor; nothing stays open between operations.
//
// File databases store Booleans as 1/0 and dates as "yyyy-MM-dd HH:mm:ss" text (the zero
// date is "1899-12-30 00:00:00"). Columns declared DATE/DATETIME/TIME read back as
// QDateTime, columns declared BOOLEAN/BIT/YESNO as bool. Values written as bool or
// QDateTime are stored in those forms on every engine.

#include <QSqlDatabase>
#include <QString>
#include <memory>

namespace zv {

class Recordset;
class Connection;

enum class DbKind { File, Server };

constexpr int kFileBusyTimeoutMs = 5000;

// Recordset types of the file kind (DAO values).
enum : int { dbOpenDynaset = 2, dbOpenSnapshot = 4 };

// The Connect argument of the password-protected file databases (MADAD, MAIN). Carried and
// ignored: SQLite files have no password.
QString SuitePasswordConnect();

class Database {
  public:
    ~Database();
    Database(const Database&) = delete;
    Database& operator=(const Database&) = delete;

    // MainPath + file, file as the suite names it with its leading separator ("\MDOCS.MDB").
    // A missing file is error 3024, never a new empty database. Writers wait on each other
    // up to kFileBusyTimeoutMs before a lock is error 3260.
    static std::unique_ptr<Database> OpenFile(const QString& file, const QString& connect = {});
    // Logical database name ("MDOCS"): connects with GetConnectionByDbName(name) and then
    // sends "USE " + name + VolnaGlobNum.
    static std::unique_ptr<Database> OpenServer(const QString& name);
    // A server connection from a connection string alone, without USE (the list windows).
    static std::unique_ptr<Database> OpenConnectionString(const QString& connectionString);
    // The logical database on the back-end its flag chooses: the server when onServer,
    // otherwise the file "\" + name + ".MDB".
    static std::unique_ptr<Database> Open(const QString& name, bool onServer);

    DbKind Kind() const { return kind_; }
    bool IsServer() const { return kind_ == DbKind::Server; }
    bool IsPostgres() const;

    // Runs a statement that returns no rows. Throws VbError.
    void Execute(const QString& sql);
    // Opens a recordset on a query: file kind with DAO behaviour (type dbOpenDynaset or
    // dbOpenSnapshot), server kind with ADO keyset/optimistic behaviour. Throws VbError.
    std::unique_ptr<Recordset> OpenRecordset(const QString& sql, int type = dbOpenDynaset);

    // The text as the engine receives it: the file kind accepts the suite's Jet texts
    // ("DELETE * FROM"), PostgreSQL gets the adapted T-SQL text.
    QString EngineSql(const QString& sql) const;
    // The Qt connection, for lazily fetched models of the list windows.
    QSqlDatabase Handle() const;
    QString ConnectionName() const { return connectionName_; }

    void Close();

  private:
    Database(DbKind kind, std::shared_ptr<Connection> connection);
    DbKind kind_;
    QString connectionName_;
    // Shared with the recordsets opened here; the Qt connection goes with the last holder.
    std::shared_ptr<Connection> connection_;
};

// Closes and releases; never throws, never reports. Leaves the pointer empty.
void GClose(std::unique_ptr<Database>& db);
void GClose(std::unique_ptr<Recordset>& rs);

}  // namespace zv

#include "data/database.h"

#include <sqlite3.h>

#include <QAtomicInteger>
#include <QDir>
#include <QFileInfo>
#include <QSqlDriver>
#include <QUrl>

#include "data/connection.h"
#include "data/connection_string.h"
#include "data/jet_functions.h"
#include "data/recordset.h"
#include "util/state.h"

namespace zv {
namespace {

// Every open gets a connection name of its own.
QString NewConnectionName(const char* kind) {
    static QAtomicInteger<quint64> counter;
    return QStringLiteral("zv-%1-%2").arg(QLatin1String(kind)).arg(++counter);
}

VbError MissingFile(const QString& path) {
    return VbError(err::JetCannotOpen,
                   QStringLiteral("Could not find file '%1'.").arg(QDir::toNativeSeparators(path)));
}

}  // namespace

QString SuitePasswordConnect() {
    return QStringLiteral(";pwd=k5093817;");
}

Database::Database(DbKind kind, std::shared_ptr<Connection> connection)
    : kind_(kind), connectionName_(connection->Name()), connection_(std::move(connection)) {}

Database::~Database() = default;

std::unique_ptr<Database> Database::OpenFile(const QString& file, const QString& connect) {
    Q_UNUSED(connect);  // SQLite files carry no password.
    QString relative = file;
    relative.replace(QLatin1Char('\\'), QLatin1Char('/'));
    const QString path = MainPath() + relative;
    if (!QFileInfo(path).isFile()) {
        throw MissingFile(path);
    }
    const QString name = NewConnectionName("file");
    auto connection = std::make_shared<Connection>(name, Engine::Sqlite);
    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
    // mode=rw: a file removed since the check above is an error, not a new empty database.
    db.setDatabaseName(QUrl::fromLocalFile(path).toString(QUrl::FullyEncoded) +
                       QStringLiteral("?mode=rw"));
    db.setConnectOptions(
        QStringLiteral("QSQLITE_OPEN_URI;QSQLITE_BUSY_TIMEOUT=%1").arg(kFileBusyTimeoutMs));
    if (!db.open()) {
        if (!QFileInfo(path).isFile()) {
            throw MissingFile(path);
        }
        throw EngineError(Engine::Sqlite, db.lastError());
    }
    const QVariant handle = db.driver()->handle();
    if (!handle.isValid() || qstrcmp(handle.typeName(), "sqlite3*") != 0) {
        throw VbError(err::JetGeneric, QStringLiteral("The SQLite driver gave no handle."));
    }
    sqlite3* h = *static_cast<sqlite3* const*>(handle.data());
    if (RegisterJetFunctions(h) != SQLITE_OK) {
        throw VbError(err::JetGeneric, QString::fromUtf8(sqlite3_errmsg(h)));
    }
    return std::unique_ptr<Database>(new Database(DbKind::File, std::move(connection)));
}

std::unique_ptr<Database> Database::OpenConnectionString(const QString& connectionString) {
    const ServerConnectionParams p = ParseConnectionString(connectionString);
    const bool postgres = p.driver == QLatin1String("QPSQL");
    const QString name = NewConnectionName("server");
    auto connection =
        std::make_shared<Connection>(name, postgres ? Engine::Postgres : Engine::SqlServer);
    QSqlDatabase db = QSqlDatabase::addDatabase(p.driver, name);
    if (postgres) {
        db.setHostName(p.host);
        if (p.port > 0) {
            db.setPort(p.port);
        }
        db.setDatabaseName(p.database);
        db.setUserName(p.user);
        db.setPassword(p.password);
        db.setConnectOptions(QStringLiteral("connect_timeout=%1").arg(p.connectTimeout));
    } else {
        db.setDatabaseName(p.odbcConnectionString);
        db.setConnectOptions(QStringLiteral("SQL_ATTR_LOGIN_TIMEOUT=%1").arg(p.connectTimeout));
    }
    if (!db.isValid()) {
        throw VbError(err::AdoProviderNotFound,
                      QStringLiteral("The Qt SQL driver %1 is not installed.").arg(p.driver));
    }
    if (!db.open()) {
        const QSqlError e = db.lastError();
        throw VbError(err::ServerGeneric,
                      e.databaseText().isEmpty() ? e.driverText() : e.databaseText());
    }
    return std::unique_ptr<Database>(new Database(DbKind::Server, std::move(connection)));
}

std::unique_ptr<Database> Database::OpenServer(const QString& name) {
    auto db = OpenConnectionString(GetConnectionByDbName(name));
    db->Execute(QStringLiteral("USE ") + name + VolnaGlobNum());
    return db;
}

std::unique_ptr<Database> Database::Open(const QString& name, bool onServer) {
    if (onServer) {
        return OpenServer(name);
    }
    const bool withPassword = name.compare(QLatin1String("MADAD"), Qt::CaseInsensitive) == 0 ||
                              name.compare(QLatin1String("MAIN"), Qt::CaseInsensitive) == 0;
    return OpenFile(QStringLiteral("\\") + name + QStringLiteral(".MDB"),
                    withPassword ? SuitePasswordConnect() : QString());
}

bool Database::IsPostgres() const {
    return connection_ && connection_->GetEngine() == Engine::Postgres;
}

void Database::Execute(const QString& sql) {
    if (!connection_) {
        throw DataError(err::AdoObjectClosed);
    }
    connection_->Run(connection_->EngineSql(sql));
}

std::unique_ptr<Recordset> Database::OpenRecordset(const QString& sql, int type) {
    if (!connection_) {
        throw DataError(err::AdoObjectClosed);
    }
    return Recordset::OpenOn(connection_, kind_, sql, type);
}

QString Database::EngineSql(const QString& sql) const {
    return connection_ ? connection_->EngineSql(sql) : sql;
}

QSqlDatabase Database::Handle() const {
    return connection_ ? connection_->Db() : QSqlDatabase();
}

void Database::Close() {
    if (!connection_) {
        throw DataError(err::AdoObjectClosed);
    }
    connection_.reset();
}

void GClose(std::unique_ptr<Database>& db) {
    try {
        if (db) {
            db->Close();
        }
    } catch (...) {
        // Closing what is already closed is no failure worth reporting.
    }
    db.reset();
}

void GClose(std::unique_ptr<Recordset>& rs) {
    try {
        if (rs) {
            rs->Close();
        }
    } catch (...) {
        // As above.
    }
    rs.reset();
}

}  // namespace zv

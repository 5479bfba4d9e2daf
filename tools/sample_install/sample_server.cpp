#include "sample_install/sample_server.h"

#include <QDir>
#include <QFile>
#include <QSqlError>
#include <QUuid>
#include <future>
#include <stdexcept>
#include <vector>

#include "sample_install/schema_script.h"
#include "sample_install/table_loader.h"

namespace zv {

namespace {

// The connection of one statement or load; removed from Qt's registry when it ends.
class ScopedConnection {
  public:
    ScopedConnection(const SampleOptions& options, const QString& database)
        : name_(QStringLiteral("zv-sample-") + QUuid::createUuid().toString()),
          db_(ConnectSampleServer(options, database, name_)) {}
    ~ScopedConnection() {
        db_.close();
        db_ = QSqlDatabase();
        QSqlDatabase::removeDatabase(name_);
    }
    ScopedConnection(const ScopedConnection&) = delete;
    ScopedConnection& operator=(const ScopedConnection&) = delete;
    QSqlDatabase& db() { return db_; }

  private:
    QString name_;
    QSqlDatabase db_;
};

// Building the trigram indexes of a large installation takes most of its time; sessions
// of their own build them side by side.
constexpr int kIndexSessions = 2;

void CreateIndexes(const SampleOptions& options, const QString& database,
                   const QStringList& indexes) {
    std::vector<std::future<void>> sessions;
    for (int s = 0; s < kIndexSessions && s < indexes.size(); ++s) {
        QStringList share;
        for (int i = s; i < indexes.size(); i += kIndexSessions)
            share.append(indexes[i]);
        sessions.push_back(std::async(std::launch::async, [&options, database, share] {
            ScopedConnection session(options, database);
            ExecOrThrow(session.db(), QStringLiteral("SET maintenance_work_mem = '256MB'"));
            for (const QString& statement : share)
                ExecOrThrow(session.db(), statement);
        }));
    }
    for (std::future<void>& session : sessions)
        session.get();
}

}  // namespace

const QStringList& ServerDatabaseNames() {
    static const QStringList names{"OFFICE", "MDOCS", "BM", "ZORVA"};
    return names;
}

QSqlDatabase ConnectSampleServer(const SampleOptions& options, const QString& database,
                                 const QString& connectionName) {
    QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), connectionName);
    QString host = options.serverDataSource;
    const int comma = host.lastIndexOf(QLatin1Char(','));
    if (comma >= 0) {
        bool ok = false;
        const int port = host.mid(comma + 1).trimmed().toInt(&ok);
        if (ok) {
            db.setPort(port);
            host = host.left(comma);
        }
    }
    db.setHostName(host.trimmed());
    db.setUserName(options.serverUser);
    db.setPassword(options.serverPassword);
    db.setDatabaseName(database);
    db.setConnectOptions(QStringLiteral("connect_timeout=10"));
    if (!db.open()) {
        const QString message = QStringLiteral("cannot connect to %1 on %2: %3")
                                    .arg(database, options.serverDataSource, db.lastError().text());
        db = QSqlDatabase();
        QSqlDatabase::removeDatabase(connectionName);
        throw std::runtime_error(message.toStdString());
    }
    return db;
}

void CreateServerDatabases(const SampleOptions& options, const SampleData& data) {
    const QList<SchemaSection> schema = LoadSchema(QStringLiteral("postgres"));
    for (const QString& name : ServerDatabaseNames()) {
        const QString database = name + options.volnaGlobNum;
        {
            ScopedConnection admin(options, QStringLiteral("postgres"));
            const QString quoted = QLatin1Char('"') + database + QLatin1Char('"');
            ExecOrThrow(admin.db(), QStringLiteral("SET client_min_messages = warning"));
            ExecOrThrow(admin.db(),
                        QStringLiteral("DROP DATABASE IF EXISTS %1 WITH (FORCE)").arg(quoted));
            ExecOrThrow(admin.db(),
                        QStringLiteral("CREATE DATABASE %1 ENCODING 'UTF8' TEMPLATE template0")
                            .arg(quoted));
        }
        QStringList indexes;
        {
            ScopedConnection target(options, database);
            indexes = LoadDatabase(target.db(), name, SchemaStatements(schema, name), data);
        }
        CreateIndexes(options, database, indexes);
    }
}

void CreateServerDatabases(const SampleOptions& options) {
    CreateServerDatabases(options, SampleData(options));
}

void WriteServerSettingsFile(const QString& mainPath, const SampleOptions& options) {
    const QString path = QDir(mainPath).filePath(QStringLiteral("Def/MSSQLSetting.INI"));
    QFile f(path);
    const QString text =
        QStringLiteral(
            "[MSSQL]\r\nProvider=PostgreSQL\r\nDataSource=%1\r\n\r\n"
            "[000]\r\nUserID=%2\r\nPassWord=%3\r\n")
            .arg(options.serverDataSource, options.serverUser, options.serverPassword);
    if (!f.open(QIODevice::WriteOnly | QIODevice::Truncate) || f.write(text.toUtf8()) < 0)
        throw std::runtime_error("cannot write " + path.toStdString());
}

}  // namespace zv

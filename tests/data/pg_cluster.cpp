#include "pg_cluster.h"

#include <QDir>
#include <QFileInfo>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QUuid>
#include <stdexcept>

namespace zv::test {

PgCluster::PgCluster()
    : host_(qEnvironmentVariable("ZV_PG_HOST")),
      port_(qEnvironmentVariable("ZV_PG_PORT")),
      user_(qEnvironmentVariable("ZV_PG_USER", QStringLiteral("postgres"))) {
    available_ = !host_.isEmpty() && !port_.isEmpty() &&
                 QFileInfo::exists(QDir(host_).filePath(QStringLiteral(".s.PGSQL.") + port_));
}

QString PgCluster::Run(const QString& database, const QStringList& statements) const {
    const QString name = QUuid::createUuid().toString();
    QString result;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), name);
        db.setHostName(host_);
        db.setPort(port_.toInt());
        db.setUserName(user_);
        db.setDatabaseName(database);
        if (!db.open()) {
            throw std::runtime_error(db.lastError().text().toStdString());
        }
        QSqlQuery q(db);
        q.exec(QStringLiteral("SET client_min_messages = warning"));
        for (const QString& s : statements) {
            if (!q.exec(s)) {
                throw std::runtime_error(
                    (q.lastError().text() + QStringLiteral(" in ") + s).toStdString());
            }
        }
        if (q.isSelect() && q.next()) {
            result = q.value(0).toString();
        }
        q.finish();
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
    return result;
}

void PgCluster::CreateDatabase(const QString& name, const QStringList& statements) const {
    DropDatabase(name);
    Run(QStringLiteral("postgres"), {QStringLiteral("CREATE DATABASE \"%1\"").arg(name)});
    Run(name, statements);
}

void PgCluster::DropDatabase(const QString& name) const {
    Run(QStringLiteral("postgres"),
        {QStringLiteral("DROP DATABASE IF EXISTS \"%1\" WITH (FORCE)").arg(name)});
}

bool ClusterRequired() {
    return qEnvironmentVariable("CI") == QLatin1String("true");
}

}  // namespace zv::test

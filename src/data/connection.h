#pragma once
// One Qt SQL connection, shared by a database and the recordsets opened on it, removed
// when the last of them lets go. Internal to the data layer.

#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>
#include <QStringList>
#include <QVariantList>

#include "data/data_errors.h"

namespace zv {

class Connection {
  public:
    Connection(QString name, Engine engine);
    ~Connection();
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    const QString& Name() const { return name_; }
    Engine GetEngine() const { return engine_; }
    QSqlDatabase Db() const;

    // The text as the engine receives it.
    QString EngineSql(const QString& sql) const;
    // Runs a statement (already in the engine's text) with bound values. Throws VbError.
    QSqlQuery Run(const QString& engineSql, const QVariantList& values = {}) const;
    // SQLite: the declared column types of a query's result, upper case ("DATETIME").
    QStringList DeclaredTypes(const QString& engineSql) const;

    // An identifier (table or column) as the engine wants it in generated statements.
    QString QuoteIdentifier(const QString& name) const;
    // A table name as the engine's catalogue knows it (PostgreSQL: folded to lower case).
    QString CatalogueName(const QString& table) const;
    // The columns that identify a row of a table: its primary key, or on a file database
    // without one, its first unique index (the suite's file tables often have only that).
    QStringList KeyColumns(const QString& table) const;

    // How the engine stores a value bound from the program: Booleans as 1/0, dates as
    // "yyyy-MM-dd HH:mm:ss".
    static QVariant ToEngine(const QVariant& value);
    // A value read from a column of a file database, by the column's declared type:
    // DATE/TIME columns give QDateTime, BOOLEAN/BIT/YESNO columns give bool.
    static QVariant FromSqlite(const QVariant& value, const QString& declaredType);

  private:
    QString name_;
    Engine engine_;
};

}  // namespace zv

#pragma once
// The schema files under schema/: one section per logical database, opened by a line
// "-- database: NAME", statements ending with ";" at the end of a line.

#include <QList>
#include <QString>
#include <QStringList>

namespace zv {

struct SchemaSection {
    QString database;  // logical name: OFFICE, MDOCS, ...
    QStringList statements;
};

QList<SchemaSection> ParseSchema(const QString& text);
// The schema of an engine, "sqlite" or "postgres", as built into the program.
QList<SchemaSection> LoadSchema(const QString& engine);
// The statements of one database, or none when the schema has no such section.
QStringList SchemaStatements(const QList<SchemaSection>& schema, const QString& database);
// Index statements are run after the rows are loaded, which is much faster.
bool IsIndexStatement(const QString& statement);

}  // namespace zv

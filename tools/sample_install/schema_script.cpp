#include "sample_install/schema_script.h"

#include <QFile>
#include <QRegularExpression>
#include <stdexcept>

namespace zv {

QList<SchemaSection> ParseSchema(const QString& text) {
    static const QRegularExpression marker(QStringLiteral(R"(^--\s*database:\s*(\w+)\s*$)"));
    QList<SchemaSection> sections;
    QString pending;
    const QStringList lines = text.split(QLatin1Char('\n'));
    for (const QString& raw : lines) {
        const QString line = raw.trimmed();
        const auto m = marker.match(line);
        if (m.hasMatch()) {
            sections.append({m.captured(1), {}});
            pending.clear();
            continue;
        }
        if (line.isEmpty() || line.startsWith(QLatin1String("--")) || sections.isEmpty())
            continue;
        pending += (pending.isEmpty() ? QString() : QStringLiteral("\n")) + line;
        if (line.endsWith(QLatin1Char(';'))) {
            pending.chop(1);
            sections.last().statements.append(pending);
            pending.clear();
        }
    }
    return sections;
}

QList<SchemaSection> LoadSchema(const QString& engine) {
    QFile f(QStringLiteral(":/schema/%1.sql").arg(engine));
    if (!f.open(QIODevice::ReadOnly))
        throw std::runtime_error("no schema for engine " + engine.toStdString());
    return ParseSchema(QString::fromUtf8(f.readAll()));
}

QStringList SchemaStatements(const QList<SchemaSection>& schema, const QString& database) {
    for (const SchemaSection& s : schema) {
        if (s.database.compare(database, Qt::CaseInsensitive) == 0)
            return s.statements;
    }
    return {};
}

bool IsIndexStatement(const QString& statement) {
    static const QRegularExpression index(QStringLiteral(R"(^CREATE\s+(UNIQUE\s+)?INDEX\b)"),
                                          QRegularExpression::CaseInsensitiveOption);
    return index.match(statement).hasMatch();
}

}  // namespace zv

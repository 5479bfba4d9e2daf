#include "data/connection.h"

#include <sqlite3.h>

#include <QDateTime>
#include <QRegularExpression>
#include <QSqlDriver>
#include <QSqlIndex>

#include "data/pg_dialect.h"

namespace zv {

Connection::Connection(QString name, Engine engine) : name_(std::move(name)), engine_(engine) {}

Connection::~Connection() {
    {
        QSqlDatabase db = QSqlDatabase::database(name_, false);
        if (db.isValid()) {
            db.close();
        }
    }
    QSqlDatabase::removeDatabase(name_);
}

QSqlDatabase Connection::Db() const {
    return QSqlDatabase::database(name_, false);
}

QString Connection::EngineSql(const QString& sql) const {
    switch (engine_) {
        case Engine::Sqlite: {
            static const QRegularExpression deleteStar(
                QStringLiteral("^(\\s*DELETE)\\s+\\*\\s+(FROM\\b)"),
                QRegularExpression::CaseInsensitiveOption);
            QString s = sql;
            return s.replace(deleteStar, QStringLiteral("\\1 \\2"));
        }
        case Engine::Postgres:
            return AdaptForPostgres(sql);
        case Engine::SqlServer:
            break;
    }
    return sql;
}

QSqlQuery Connection::Run(const QString& engineSql, const QVariantList& values) const {
    QSqlQuery q(Db());
    q.setForwardOnly(true);
    bool ok = false;
    if (values.isEmpty()) {
        ok = q.exec(engineSql);
    } else {
        ok = q.prepare(engineSql);
        if (ok) {
            for (const QVariant& v : values) {
                q.addBindValue(ToEngine(v));
            }
            ok = q.exec();
        }
    }
    if (!ok) {
        throw EngineError(engine_, q.lastError());
    }
    return q;
}

QStringList Connection::DeclaredTypes(const QString& engineSql) const {
    QStringList types;
    if (engine_ != Engine::Sqlite) {
        return types;
    }
    const QVariant handle = Db().driver()->handle();
    if (!handle.isValid() || qstrcmp(handle.typeName(), "sqlite3*") != 0) {
        return types;
    }
    sqlite3* h = *static_cast<sqlite3* const*>(handle.data());
    sqlite3_stmt* stmt = nullptr;
    const QByteArray text = engineSql.toUtf8();
    if (sqlite3_prepare_v2(h, text.constData(), int(text.size()), &stmt, nullptr) == SQLITE_OK &&
        stmt) {
        for (int i = 0; i < sqlite3_column_count(stmt); ++i) {
            const char* t = sqlite3_column_decltype(stmt, i);
            types << (t ? QString::fromUtf8(t).toUpper() : QString());
        }
    }
    sqlite3_finalize(stmt);
    return types;
}

QString Connection::QuoteIdentifier(const QString& name) const {
    if (engine_ == Engine::SqlServer) {
        QString n = name;
        return QLatin1Char('[') + n.replace(QLatin1Char(']'), QStringLiteral("]]")) +
               QLatin1Char(']');
    }
    QString n = name;
    return QLatin1Char('"') + n.replace(QLatin1Char('"'), QStringLiteral("\"\"")) +
           QLatin1Char('"');
}

QString Connection::CatalogueName(const QString& table) const {
    return engine_ == Engine::Postgres ? table.toLower() : table;
}

QStringList Connection::KeyColumns(const QString& table) const {
    QStringList columns;
    const QSqlIndex pk = Db().driver()->primaryIndex(CatalogueName(table));
    for (int k = 0; k < pk.count(); ++k) {
        columns << pk.fieldName(k);
    }
    if (!columns.isEmpty() || engine_ != Engine::Sqlite) {
        return columns;
    }
    QSqlQuery list(Db());
    list.exec(QStringLiteral("PRAGMA index_list(%1)").arg(QuoteIdentifier(table)));
    QStringList unique;
    while (list.next()) {
        if (list.value(QStringLiteral("unique")).toInt() == 1) {
            unique << list.value(QStringLiteral("name")).toString();
        }
    }
    // index_list gives the newest index first; the oldest is the table's own key.
    for (auto it = unique.crbegin(); it != unique.crend() && columns.isEmpty(); ++it) {
        QSqlQuery info(Db());
        info.exec(QStringLiteral("PRAGMA index_info(%1)").arg(QuoteIdentifier(*it)));
        while (info.next()) {
            columns << info.value(QStringLiteral("name")).toString();
        }
    }
    return columns;
}

QVariant Connection::ToEngine(const QVariant& value) {
    if (!value.isValid() || value.isNull()) {
        return value;
    }
    switch (value.typeId()) {
        case QMetaType::Bool:
            return value.toBool() ? 1 : 0;
        case QMetaType::QDateTime:
            return value.toDateTime().toString(QStringLiteral("yyyy-MM-dd HH:mm:ss"));
        case QMetaType::QDate:
            return value.toDate().toString(QStringLiteral("yyyy-MM-dd")) +
                   QStringLiteral(" 00:00:00");
        default:
            return value;
    }
}

QVariant Connection::FromSqlite(const QVariant& value, const QString& declaredType) {
    if (declaredType.isEmpty()) {
        return value;
    }
    const bool isDate = declaredType.contains(QLatin1String("DATE")) ||
                        declaredType.contains(QLatin1String("TIME"));
    const bool isBool =
        declaredType == QLatin1String("BOOLEAN") || declaredType == QLatin1String("BOOL") ||
        declaredType == QLatin1String("BIT") || declaredType == QLatin1String("YESNO");
    if (isDate) {
        if (value.isNull()) {
            return QVariant(QMetaType(QMetaType::QDateTime));
        }
        if (value.typeId() == QMetaType::QString) {
            const QString text = value.toString().trimmed();
            QDateTime dt = QDateTime::fromString(text, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
            if (!dt.isValid()) {
                dt = QDateTime::fromString(text, Qt::ISODateWithMs);
            }
            if (!dt.isValid()) {
                const QDate d = QDate::fromString(text, Qt::ISODate);
                if (d.isValid()) {
                    dt = QDateTime(d, QTime(0, 0));
                }
            }
            if (dt.isValid()) {
                return dt;
            }
        }
        return value;
    }
    if (isBool) {
        if (value.isNull()) {
            return QVariant(QMetaType(QMetaType::Bool));
        }
        return QVariant(value.toLongLong() != 0);
    }
    return value;
}

}  // namespace zv

#include "selection/lazy_query.h"

#include <QSqlError>
#include <QSqlQuery>
#include <atomic>

#include "data/data_errors.h"
#include "data/database.h"

namespace zv {
namespace {

VbError QueryError(const Database& db, const QSqlQuery& q) {
    const Engine engine = db.IsPostgres() ? Engine::Postgres
                          : db.IsServer() ? Engine::SqlServer
                                          : Engine::Sqlite;
    return EngineError(engine, q.lastError());
}

QString NextCursorName() {
    static std::atomic<int> counter{0};
    return QStringLiteral("zv_list_%1").arg(++counter);
}

}  // namespace

struct LazyQuery::Impl {
    explicit Impl(const QSqlDatabase& handle) : query(handle) {}
    QSqlQuery query;
    QString cursor;  // PostgreSQL only
    bool ownsTransaction = false;
};

LazyQuery::LazyQuery(Database& db, const QString& sql)
    : db_(db), d_(std::make_unique<Impl>(db.Handle())) {
    d_->query.setForwardOnly(true);
    const QString engineSql = db.EngineSql(sql);
    if (!db.IsPostgres()) {
        if (!d_->query.exec(engineSql)) {
            throw QueryError(db, d_->query);
        }
        return;
    }
    // A cursor lives inside a transaction; the list only reads, so it is rolled back.
    auto handle = db.Handle();
    d_->ownsTransaction = handle.transaction();
    d_->cursor = NextCursorName();
    if (!d_->query.exec(QStringLiteral("DECLARE ") + d_->cursor +
                        QStringLiteral(" NO SCROLL CURSOR FOR ") + engineSql)) {
        const auto error = QueryError(db, d_->query);
        if (d_->ownsTransaction) {
            handle.rollback();
        }
        d_->cursor.clear();
        throw error;
    }
}

LazyQuery::~LazyQuery() {
    if (d_->cursor.isEmpty()) {
        return;
    }
    QSqlQuery close(db_.Handle());
    close.exec(QStringLiteral("CLOSE ") + d_->cursor);
    if (d_->ownsTransaction) {
        db_.Handle().rollback();
    }
}

std::vector<QSqlRecord> LazyQuery::Fetch(int count) {
    std::vector<QSqlRecord> rows;
    if (atEnd_ || count <= 0) {
        return rows;
    }
    rows.reserve(static_cast<size_t>(count));
    if (!d_->cursor.isEmpty() &&
        !d_->query.exec(QStringLiteral("FETCH FORWARD %1 FROM %2").arg(count).arg(d_->cursor))) {
        throw QueryError(db_, d_->query);
    }
    while (static_cast<int>(rows.size()) < count && d_->query.next()) {
        rows.push_back(d_->query.record());
    }
    if (static_cast<int>(rows.size()) < count) {
        atEnd_ = true;
        if (d_->query.lastError().isValid()) {
            throw QueryError(db_, d_->query);
        }
    }
    return rows;
}

long long QueryCount(Database& db, const QString& sql) {
    QSqlQuery q(db.Handle());
    q.setForwardOnly(true);
    if (!q.exec(db.EngineSql(sql)) || !q.next()) {
        throw QueryError(db, q);
    }
    return q.value(0).toLongLong();
}

}  // namespace zv

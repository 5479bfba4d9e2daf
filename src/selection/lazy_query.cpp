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
    long long fetched = 0;
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
    // The rows are counted by running through the cursor, so it is planned for reading
    // every row, as the engine would plan the query on its own.
    auto handle = db.Handle();
    d_->ownsTransaction = handle.transaction();
    d_->cursor = NextCursorName();
    if (!d_->query.exec(QStringLiteral("SET LOCAL cursor_tuple_fraction = 1")) ||
        !d_->query.exec(QStringLiteral("DECLARE ") + d_->cursor +
                        QStringLiteral(" SCROLL CURSOR FOR ") + engineSql)) {
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
    d_->fetched += static_cast<long long>(rows.size());
    if (static_cast<int>(rows.size()) < count) {
        atEnd_ = true;
        if (d_->query.lastError().isValid()) {
            throw QueryError(db_, d_->query);
        }
    }
    return rows;
}

long long LazyQuery::TotalRows(const QString& countSql) {
    if (atEnd_) {
        return d_->fetched;
    }
    QSqlQuery q(db_.Handle());
    q.setForwardOnly(true);
    if (!d_->cursor.isEmpty()) {
        // The cursor has computed the rows already; moving over them costs no second query.
        if (!q.exec(QStringLiteral("MOVE FORWARD ALL IN ") + d_->cursor)) {
            throw QueryError(db_, q);
        }
        const long long rest = q.numRowsAffected();
        if (!q.exec(QStringLiteral("MOVE ABSOLUTE %1 IN %2").arg(d_->fetched).arg(d_->cursor))) {
            throw QueryError(db_, q);
        }
        return d_->fetched + rest;
    }
    if (!q.exec(db_.EngineSql(countSql)) || !q.next()) {
        throw QueryError(db_, q);
    }
    return q.value(0).toLongLong();
}

}  // namespace zv

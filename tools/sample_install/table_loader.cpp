#include "sample_install/table_loader.h"

#include <QSqlError>
#include <QSqlQuery>
#include <stdexcept>

#include "sample_install/schema_script.h"

namespace zv {

namespace {

// Rows per INSERT: far below the bound-parameter limits of SQLite and PostgreSQL for the
// widest table, large enough that a million rows load in seconds.
constexpr int kBatchRows = 256;

[[noreturn]] void Fail(const QString& what, const QSqlError& error) {
    throw std::runtime_error((what + QStringLiteral(": ") + error.text()).toStdString());
}

QString InsertText(const SampleTable& t, int rows) {
    const QString one =
        QLatin1Char('(') + QStringList(t.columns.size(), QStringLiteral("?")).join(',') + ')';
    return QStringLiteral("INSERT INTO %1 (%2) VALUES %3")
        .arg(t.table, t.columns.join(','), QStringList(rows, one).join(','));
}

class BatchInserter {
  public:
    BatchInserter(QSqlDatabase& db, const SampleTable& table) : db_(db), table_(table) {
        pending_.reserve(kBatchRows * table.columns.size());
    }

    void Add(const QVariantList& row) {
        pending_.append(row);
        if (pending_.size() == kBatchRows * table_.columns.size())
            Flush();
    }

    void Flush() {
        if (pending_.isEmpty())
            return;
        const int rows = static_cast<int>(pending_.size() / table_.columns.size());
        QSqlQuery& q = rows == kBatchRows ? full_ : rest_;
        if (rows != kBatchRows || !fullPrepared_) {
            q = QSqlQuery(db_);
            if (!q.prepare(InsertText(table_, rows)))
                Fail(QStringLiteral("prepare INSERT INTO ") + table_.table, q.lastError());
            fullPrepared_ = fullPrepared_ || rows == kBatchRows;
        }
        for (int i = 0; i < pending_.size(); ++i)
            q.bindValue(i, pending_[i]);
        if (!q.exec())
            Fail(QStringLiteral("INSERT INTO ") + table_.table, q.lastError());
        pending_.clear();
    }

  private:
    QSqlDatabase& db_;
    const SampleTable& table_;
    QVariantList pending_;
    QSqlQuery full_;
    QSqlQuery rest_;
    bool fullPrepared_ = false;
};

}  // namespace

void ExecOrThrow(QSqlDatabase& db, const QString& sql) {
    QSqlQuery q(db);
    if (!q.exec(sql))
        Fail(sql.left(200), q.lastError());
}

void BuildDatabase(QSqlDatabase& db, const QString& database, const QStringList& schema,
                   const SampleData& data) {
    QStringList indexes;
    for (const QString& statement : schema) {
        if (IsIndexStatement(statement))
            indexes.append(statement);
        else
            ExecOrThrow(db, statement);
    }
    if (!db.transaction())
        Fail(QStringLiteral("BEGIN"), db.lastError());
    for (const SampleTable& t : SampleData::Tables()) {
        if (t.database != database)
            continue;
        BatchInserter inserter(db, t);
        data.Rows(t.table, [&inserter](const QVariantList& row) { inserter.Add(row); });
        inserter.Flush();
    }
    if (!db.commit())
        Fail(QStringLiteral("COMMIT"), db.lastError());
    for (const QString& statement : indexes)
        ExecOrThrow(db, statement);
}

}  // namespace zv

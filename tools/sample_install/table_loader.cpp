#include "sample_install/table_loader.h"

#include <QSqlError>
#include <QSqlQuery>
#include <memory>
#include <stdexcept>

#include "sample_install/schema_script.h"

namespace zv {

namespace {

// Rows per INSERT on SQLite: far below its bound-parameter limit for the widest table,
// large enough that a million rows load in seconds.
constexpr int kBatchRows = 256;
// Rows per INSERT on PostgreSQL, where a batch is one array parameter per column.
constexpr int kArrayRows = 20000;

[[noreturn]] void Fail(const QString& what, const QSqlError& error) {
    throw std::runtime_error((what + QStringLiteral(": ") + error.text()).toStdString());
}

QString InsertText(const SampleTable& t, int rows) {
    const QString one =
        QLatin1Char('(') + QStringList(t.columns.size(), QStringLiteral("?")).join(',') + ')';
    return QStringLiteral("INSERT INTO %1 (%2) VALUES %3")
        .arg(t.table, t.columns.join(','), QStringList(rows, one).join(','));
}

class RowInserter {
  public:
    virtual ~RowInserter() = default;
    virtual void Add(const QVariantList& row) = 0;
    virtual void Flush() = 0;
};

// Multi-row VALUES with one parameter per value.
class ValuesInserter : public RowInserter {
  public:
    ValuesInserter(QSqlDatabase& db, const SampleTable& table) : db_(db), table_(table) {
        pending_.reserve(kBatchRows * table.columns.size());
    }

    void Add(const QVariantList& row) override {
        pending_.append(row);
        if (pending_.size() == kBatchRows * table_.columns.size())
            Flush();
    }

    void Flush() override {
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

// PostgreSQL parses a long VALUES list slowly; one array literal per column, unnested by
// the server, loads a million rows in seconds. The array text is a bound value, so the
// driver quotes it like any other.
class ArrayInserter : public RowInserter {
  public:
    ArrayInserter(QSqlDatabase& db, const SampleTable& table)
        : db_(db), table_(table), elements_(table.columns.size()) {}

    void Add(const QVariantList& row) override {
        if (numeric_.isEmpty()) {
            for (const QVariant& v : row)
                numeric_.append(IsNumber(v));
        }
        for (int i = 0; i < row.size(); ++i)
            elements_[i].append(Element(row[i], numeric_[i]));
        if (++rows_ == kArrayRows)
            Flush();
    }

    void Flush() override {
        if (rows_ == 0)
            return;
        if (!prepared_) {
            QStringList arrays;
            for (bool number : numeric_)
                arrays.append(number ? QStringLiteral("?::bigint[]") : QStringLiteral("?::text[]"));
            query_ = QSqlQuery(db_);
            const QString sql = QStringLiteral("INSERT INTO %1 (%2) SELECT * FROM unnest(%3)")
                                    .arg(table_.table, table_.columns.join(','), arrays.join(','));
            if (!query_.prepare(sql))
                Fail(QStringLiteral("prepare ") + sql, query_.lastError());
            prepared_ = true;
        }
        for (int i = 0; i < elements_.size(); ++i) {
            query_.bindValue(i, QLatin1Char('{') + elements_[i].join(',') + QLatin1Char('}'));
            elements_[i].clear();
        }
        if (!query_.exec())
            Fail(QStringLiteral("INSERT INTO ") + table_.table, query_.lastError());
        rows_ = 0;
    }

  private:
    static bool IsNumber(const QVariant& v) {
        switch (v.typeId()) {
            case QMetaType::Int:
            case QMetaType::LongLong:
            case QMetaType::Short:
                return true;
            default:
                return false;
        }
    }

    // An element of an array literal: NULL, a number, or text in double quotes with
    // backslashes and double quotes escaped.
    static QString Element(const QVariant& v, bool number) {
        if (v.isNull())
            return QStringLiteral("NULL");
        if (number)
            return QString::number(v.toLongLong());
        QString text = v.toString();
        text.replace(QLatin1Char('\\'), QStringLiteral("\\\\"));
        text.replace(QLatin1Char('"'), QStringLiteral("\\\""));
        return QLatin1Char('"') + text + QLatin1Char('"');
    }

    QSqlDatabase& db_;
    const SampleTable& table_;
    QList<QStringList> elements_;
    QList<bool> numeric_;
    int rows_ = 0;
    QSqlQuery query_;
    bool prepared_ = false;
};

}  // namespace

void ExecOrThrow(QSqlDatabase& db, const QString& sql) {
    QSqlQuery q(db);
    if (!q.exec(sql))
        Fail(sql.left(200), q.lastError());
}

QStringList LoadDatabase(QSqlDatabase& db, const QString& database, const QStringList& schema,
                         const SampleData& data) {
    // Tables made in the loading transaction need no write-ahead log where the server
    // runs with wal_level minimal (the test cluster does).
    if (!db.transaction())
        Fail(QStringLiteral("BEGIN"), db.lastError());
    QStringList indexes;
    for (const QString& statement : schema) {
        if (IsIndexStatement(statement))
            indexes.append(statement);
        else
            ExecOrThrow(db, statement);
    }
    for (const SampleTable& t : SampleData::Tables()) {
        if (t.database != database)
            continue;
        std::unique_ptr<RowInserter> inserter;
        if (db.driverName() == QLatin1String("QPSQL"))
            inserter = std::make_unique<ArrayInserter>(db, t);
        else
            inserter = std::make_unique<ValuesInserter>(db, t);
        data.Rows(t.table, [&inserter](const QVariantList& row) { inserter->Add(row); });
        inserter->Flush();
    }
    if (!db.commit())
        Fail(QStringLiteral("COMMIT"), db.lastError());
    return indexes;
}

}  // namespace zv

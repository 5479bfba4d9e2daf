#pragma once
// The rows of a list window: fetched lazily from one query, shown through the grid's
// column map (caption, field, row number), with the total row count taken from the
// database.

#include <QAbstractTableModel>
#include <QSqlRecord>
#include <functional>
#include <memory>
#include <vector>

#include "selection/grid_layout.h"
#include "selection/list_query.h"

namespace zv {

class Database;
class LazyQuery;

class ListModel : public QAbstractTableModel {
    Q_OBJECT
  public:
    // Turns a row's value of a column into the shown text; null: shown unchanged.
    using Formatter = std::function<QString(const QSqlRecord& row, const GridColumn& column)>;

    explicit ListModel(QObject* parent = nullptr);
    ~ListModel() override;

    void SetFormatter(Formatter formatter) { formatter_ = std::move(formatter); }
    const GridColumns& Columns() const { return columns_; }
    void SetColumns(GridColumns columns);

    // Replaces the rows by those of the query; the list is empty when it fails. Throws VbError.
    void SetQuery(Database& db, const ListQuery& query);
    // Drops the rows and the open query (before the database closes).
    void Clear();

    // Rows in the database for the current query (not only those fetched).
    long long TotalCount() const { return total_; }
    const QSqlRecord& Record(int row) const { return rows_.at(static_cast<size_t>(row)); }

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    bool canFetchMore(const QModelIndex& parent) const override;
    void fetchMore(const QModelIndex& parent) override;

    static constexpr int kBatch = 256;

  private:
    GridColumns columns_;
    Formatter formatter_;
    std::unique_ptr<LazyQuery> query_;
    std::vector<QSqlRecord> rows_;
    long long total_ = 0;
};

}  // namespace zv

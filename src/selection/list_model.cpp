#include "selection/list_model.h"

#include "data/database.h"
#include "selection/lazy_query.h"
#include "util/errors.h"
#include "util/ui.h"

namespace zv {

ListModel::ListModel(QObject* parent) : QAbstractTableModel(parent) {}

ListModel::~ListModel() = default;

void ListModel::SetColumns(GridColumns columns) {
    beginResetModel();
    columns_ = std::move(columns);
    endResetModel();
}

void ListModel::Clear() {
    beginResetModel();
    rows_.clear();
    query_.reset();
    total_ = 0;
    endResetModel();
}

void ListModel::SetQuery(Database& db, const ListQuery& query) {
    beginResetModel();
    rows_.clear();
    query_.reset();  // before the new query: a server connection holds one open cursor
    total_ = 0;
    try {
        query_ = std::make_unique<LazyQuery>(db, query.Text());
        rows_ = query_->Fetch(kBatch);
        total_ = query_->TotalRows(query.CountText());
    } catch (...) {
        rows_.clear();
        query_.reset();
        total_ = 0;
        endResetModel();
        throw;
    }
    endResetModel();
}

int ListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(rows_.size());
}

int ListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(columns_.size());
}

QVariant ListModel::data(const QModelIndex& index, int role) const {
    if (role != Qt::DisplayRole || !index.isValid()) {
        return {};
    }
    const auto& column = columns_.at(static_cast<size_t>(index.column()));
    if (column.field.isEmpty()) {
        return index.row() + 1;
    }
    const auto& row = rows_.at(static_cast<size_t>(index.row()));
    if (formatter_) {
        const QString text = formatter_(row, column);
        if (!text.isNull()) {
            return text;
        }
    }
    return row.value(column.field);
}

QVariant ListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (role != Qt::DisplayRole || orientation != Qt::Horizontal || section < 0 ||
        section >= columnCount()) {
        return QAbstractTableModel::headerData(section, orientation, role);
    }
    return columns_.at(static_cast<size_t>(section)).caption;
}

bool ListModel::canFetchMore(const QModelIndex& parent) const {
    return !parent.isValid() && query_ && !query_->AtEnd();
}

void ListModel::fetchMore(const QModelIndex& parent) {
    if (!canFetchMore(parent)) {
        return;
    }
    std::vector<QSqlRecord> more;
    try {
        more = query_->Fetch(kBatch);
    } catch (const VbError& e) {
        // The rows read so far stay; the failure is reported once the view is done laying out.
        query_.reset();
        QMetaObject::invokeMethod(
            this, [text = FormatPlain(QStringLiteral("UnboundColumnFetch"), e)] { MsgBox(text); },
            Qt::QueuedConnection);
    }
    if (more.empty()) {
        return;
    }
    const int first = static_cast<int>(rows_.size());
    beginInsertRows({}, first, first + static_cast<int>(more.size()) - 1);
    rows_.insert(rows_.end(), std::make_move_iterator(more.begin()),
                 std::make_move_iterator(more.end()));
    endInsertRows();
}

}  // namespace zv

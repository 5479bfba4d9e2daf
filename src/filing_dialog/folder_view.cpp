#include "filing_dialog/folder_view.h"

#include <QDir>
#include <QFileInfo>
#include <QFileSystemModel>
#include <QHeaderView>

#include "util/file_utils.h"

namespace zv {
namespace {

QString Clean(const QString& path) {
    return QDir::cleanPath(QFileInfo(DiskPath(path)).absoluteFilePath());
}

}  // namespace

FolderView::FolderView(QWidget* parent) : QTreeView(parent) {
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setEditTriggers(QAbstractItemView::NoEditTriggers);
    setSelectionMode(QAbstractItemView::SingleSelection);
}

void FolderView::SetArchiveRoot(const QString& docsPath) {
    root_ = Clean(docsPath);
    top_ = QFileInfo(root_).path();
    if (model_) {
        ShowRoot();
    } else if (isVisible()) {
        StartModel();
    }
}

void FolderView::showEvent(QShowEvent* event) {
    if (!model_ && !root_.isEmpty()) {
        StartModel();
    }
    QTreeView::showEvent(event);
}

// The file-system model starts a watcher thread and reads the disk; the tree stays hidden
// until a client is chosen, so the model is made when the tree is first shown.
void FolderView::StartModel() {
    model_ = new QFileSystemModel(this);
    model_->setFilter(QDir::Dirs | QDir::NoDotAndDotDot);
    model_->setReadOnly(true);
    connect(model_, &QFileSystemModel::rowsInserted, this, &FolderView::HideOutsideRows);
    setModel(model_);
    for (int col = 1; col < model_->columnCount(); ++col) {
        hideColumn(col);
    }
    ShowRoot();
    connect(selectionModel(), &QItemSelectionModel::currentChanged, this,
            [this](const QModelIndex& current) { OnCurrentChanged(current); });
    if (!selected_.isEmpty()) {
        ShowSelected(selected_);
    }
}

void FolderView::ShowRoot() {
    // The tree starts at the parent of the archive so that the archive folder itself can be
    // chosen; every other entry of that parent is hidden.
    model_->setRootPath(top_);
    setRootIndex(model_->index(top_));
    const QModelIndex topIndex = rootIndex();
    HideOutsideRows(topIndex, 0, model_->rowCount(topIndex) - 1);
}

bool FolderView::IsInArchive(const QString& path) const {
    if (root_.isEmpty() || path.isEmpty()) {
        return false;
    }
    const QString p = Clean(path);
    return p == root_ || p.startsWith(root_ + QLatin1Char('/'));
}

bool FolderView::SelectPath(const QString& path) {
    if (!IsInArchive(path) || !QFileInfo(DiskPath(path)).isDir()) {
        return false;
    }
    if (!model_) {
        Select(DiskPath(Clean(path)));
        return true;
    }
    return ShowSelected(path);
}

bool FolderView::ShowSelected(const QString& path) {
    const QModelIndex index = model_->index(Clean(path));
    if (!index.isValid()) {
        return false;
    }
    for (QModelIndex p = index.parent(); p.isValid() && p != rootIndex(); p = p.parent()) {
        expand(p);
    }
    setCurrentIndex(index);
    scrollTo(index);
    return true;
}

void FolderView::HideOutsideRows(const QModelIndex& parent, int first, int last) {
    if (root_.isEmpty() || model_->filePath(parent) != top_) {
        return;
    }
    for (int row = first; row <= last; ++row) {
        const QModelIndex child = model_->index(row, 0, parent);
        setRowHidden(row, parent, model_->filePath(child) != root_);
    }
}

void FolderView::OnCurrentChanged(const QModelIndex& current) {
    const QString path = model_->filePath(current);
    if (!current.isValid() || !IsInArchive(path)) {
        return;
    }
    Select(DiskPath(path));
}

void FolderView::Select(const QString& path) {
    if (path == selected_) {
        return;
    }
    selected_ = path;
    emit FolderSelected(selected_);
}

}  // namespace zv

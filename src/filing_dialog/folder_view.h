#pragma once
// The folder tree of the filing dialog: folders only, confined to the archive MainPath/DOCS.
// The archive folder itself is the single top entry; nothing outside it is shown or can be
// selected, so every target folder is one the suite can resolve.

#include <QString>
#include <QTreeView>

class QFileSystemModel;

namespace zv {

class FolderView : public QTreeView {
    Q_OBJECT

  public:
    explicit FolderView(QWidget* parent = nullptr);

    // Roots the tree at the archive folder (created elsewhere).
    void SetArchiveRoot(const QString& docsPath);
    const QString& ArchiveRoot() const { return root_; }
    // Selects and shows a folder of the archive at once, also one created a moment ago.
    // A folder outside the archive, or one that does not exist, leaves the selection as it
    // was and gives false.
    bool SelectPath(const QString& path);
    // The selected folder; empty before the first selection.
    const QString& SelectedPath() const { return selected_; }
    // Whether a path is the archive folder or lies below it.
    bool IsInArchive(const QString& path) const;

  signals:
    // A folder was selected, by the user or by SelectPath.
    void FolderSelected(const QString& path);

  protected:
    void showEvent(QShowEvent* event) override;

  private:
    void StartModel();
    void ShowRoot();
    bool ShowSelected(const QString& path);
    void Select(const QString& path);
    void HideOutsideRows(const QModelIndex& parent, int first, int last);
    void OnCurrentChanged(const QModelIndex& current);

    QFileSystemModel* model_ = nullptr;
    QString root_;
    QString top_;
    QString selected_;
};

}  // namespace zv

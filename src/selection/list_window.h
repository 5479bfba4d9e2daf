#pragma once
// The list windows of the client and case choices, one implementation for the four
// windows: FrmLak and FrmLakAdo list the clients (CLIENT of OFFICE), FrmLookFor and
// FrmLookForAdo the names and cases (LOOKFOR of ZORVA); the "Ado" variants read the server
// database, the others the file database. A window is created fresh for one choice, loads
// when first shown, hides itself on a choice and sets IsCancel when closed by its close box.

#include <QSqlRecord>
#include <QString>
#include <QWidget>
#include <memory>

#include "selection/grid_layout.h"

class QCheckBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QTableView;

namespace zv {

class Database;
class ListModel;

enum class ListVariant { FrmLak, FrmLakAdo, FrmLookFor, FrmLookForAdo };

class ListWindow : public QWidget {
    Q_OBJECT
  public:
    explicit ListWindow(ListVariant variant, QWidget* parent = nullptr);
    ~ListWindow() override;

    ListVariant Variant() const { return variant_; }
    // The window's name as the suite knows it ("FrmLak", ...), also its object name.
    static QString FormName(ListVariant variant);

    bool IsCancel() const { return isCancel_; }
    // Name and case list: a client number restricts the list to that client's cases.
    const QString& ClientNum() const { return clientNum_; }
    void SetClientNum(const QString& clientNum) { clientNum_ = clientNum; }
    // The per-user layout file of this window.
    const QString& LayoutFile() const { return layoutFile_; }

    // The current row of the list, as the callers read it after a choice.
    bool HasCurrentRow() const;
    QSqlRecord CurrentRecord() const;
    int AbsolutePosition() const;  // 0-based; -1 without a current row
    long long RecordCount() const;

    // Rebuilds the list from the search text.
    void DoSearch();
    // Sets the grid's columns, caption and styles; isReset forces the built-in columns.
    void SetGridStruct(bool isReset);
    // The grid's columns as shown: display order, widths, visibility.
    GridColumns ShownColumns() const;

    ListModel& Model() { return *model_; }

  protected:
    void showEvent(QShowEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void BuildControls();
    void Load();
    void Choose();
    void SaveCurrentLayout();
    void ResetLayout();
    void ApplyColumns(const GridColumns& columns);
    void ShowFirstRow();
    void UpdateCounter();
    bool IsNames() const;
    bool IsServer() const;

    ListVariant variant_;
    bool loaded_ = false;
    bool isCancel_ = false;
    QString clientNum_;
    QString layoutFile_;
    std::unique_ptr<Database> db_;
    ListModel* model_;

    QLineEdit* txtSearch_;
    QPushButton* cmdSearch_;
    QCheckBox* check1_ = nullptr;
    QLabel* gridCaption_;
    QTableView* grid_;
    QLabel* counter_;
    QPushButton* cmdOK_;
    QPushButton* cmdAct_ = nullptr;
    QPushButton* command1_;
    QPushButton* cmdReset_;
    QLabel* label1_;
};

}  // namespace zv

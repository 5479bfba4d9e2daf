#pragma once
// Picks one or more users of the office (table USERS of PUB.MDB, the users of this
// installation's office code). Names go in and come out separated by ";".

#include <memory>

#include "ui/picker_dialog.h"

class QListWidget;
class QPushButton;

namespace Ui {
class FrmGetUsers;
}

namespace zv {

class FrmGetUsers : public PickerDialog {
    Q_OBJECT

  public:
    explicit FrmGetUsers(QWidget* parent = nullptr);
    ~FrmGetUsers() override;

    // The entry at the top of the list that stands for every user.
    static QString AllUsersText();

    // Names selected when the window opens.
    const QString& StartUsers() const { return startUsers_; }
    void SetStartUsers(const QString& v) { startUsers_ = v; }
    // Names selected when the user confirmed.
    const QString& EndUsers() const { return endUsers_; }
    bool WithAllUsers() const { return withAllUsers_; }
    void SetWithAllUsers(bool v) { withAllUsers_ = v; }

    QListWidget& List1() const;
    QPushButton& Command1() const;

  private:
    void Load() override;
    void initCbo();
    void Confirm();

    std::unique_ptr<::Ui::FrmGetUsers> ui_;
    QString startUsers_;
    QString endUsers_;
    bool withAllUsers_ = false;
};

}  // namespace zv

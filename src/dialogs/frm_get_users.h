#pragma once
// Picks one or more users of the office (table USERS of PUB.MDB, the users of this
// installation's office code). Names go in and come out separated by ";".

#include <QDialog>
#include <memory>

class QListWidget;
class QPushButton;

namespace Ui {
class FrmGetUsers;
}

namespace zv {

class FrmGetUsers : public QDialog {
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
    bool IsCancel() const { return isCancel_; }

    QListWidget& List1() const;
    QPushButton& Command1() const;

  public slots:
    void reject() override;

  protected:
    void showEvent(QShowEvent* e) override;

  private:
    void Load();
    void initCbo();
    void Confirm();

    std::unique_ptr<::Ui::FrmGetUsers> ui_;
    QString startUsers_;
    QString endUsers_;
    bool withAllUsers_ = false;
    bool isCancel_ = false;
    bool loaded_ = false;
};

}  // namespace zv

#pragma once
// Asks for one line of text, usually a password behind a mask character. The window does
// not judge what is typed; the caller reads Text1 when IsCancel is false.

#include <memory>

#include "ui/picker_dialog.h"

class QLabel;
class QLineEdit;
class QPushButton;

namespace Ui {
class FrmGetPassword;
}

namespace zv {

class FrmGetPassword : public PickerDialog {
    Q_OBJECT

  public:
    explicit FrmGetPassword(QWidget* parent = nullptr);
    ~FrmGetPassword() override;

    // The prompt shown above the input.
    const QString& Teur() const { return teur_; }
    void SetTeur(const QString& v) { teur_ = v; }
    // The mask character; empty shows what is typed.
    const QString& PassChar() const { return passChar_; }
    void SetPassChar(const QString& v) { passChar_ = v; }

    QLabel& Label1() const;
    QLineEdit& Text1() const;
    QPushButton& Command1() const;

  private:
    void Load() override;
    void Confirm();

    std::unique_ptr<::Ui::FrmGetPassword> ui_;
    QString teur_;
    QString passChar_;
};

}  // namespace zv

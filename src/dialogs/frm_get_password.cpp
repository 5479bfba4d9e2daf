#include "dialogs/frm_get_password.h"

#include "ui/font_fix.h"
#include "ui_frm_get_password.h"
#include "util/ui.h"

namespace zv {

FrmGetPassword::FrmGetPassword(QWidget* parent)
    : PickerDialog(parent), ui_(std::make_unique<::Ui::FrmGetPassword>()) {
    ui_->setupUi(this);
    connect(ui_->Command1, &QPushButton::clicked, this, &FrmGetPassword::Confirm);
    connect(ui_->Text1, &QLineEdit::returnPressed, this, &FrmGetPassword::Confirm);
}

FrmGetPassword::~FrmGetPassword() = default;

QLabel& FrmGetPassword::Label1() const {
    return *ui_->Label1;
}
QLineEdit& FrmGetPassword::Text1() const {
    return *ui_->Text1;
}
QPushButton& FrmGetPassword::Command1() const {
    return *ui_->Command1;
}

void FrmGetPassword::Load() {
    FixControlsFontOnMe(*this);
    ui_->Label1->setText(teur_);
    if (passChar_.isEmpty()) {
        ui_->Text1->setEchoMode(QLineEdit::Normal);
    } else {
        ui_->Text1->setEchoMode(QLineEdit::Password);
        ui_->Text1->setStyleSheet(QStringLiteral("QLineEdit { lineedit-password-character: %1; }")
                                      .arg(passChar_.at(0).unicode()));
    }
    ui_->Text1->setFocus();
}

void FrmGetPassword::Confirm() {
    HideConfirmed();
    DoEvents();
}

}  // namespace zv

#include "ui/picker_dialog.h"

namespace zv {

void PickerDialog::showEvent(QShowEvent* e) {
    if (!loaded_) {
        loaded_ = true;
        isCancel_ = false;
        Load();
    }
    QDialog::showEvent(e);
}

void PickerDialog::HideConfirmed() {
    isCancel_ = false;
    hide();
}

void PickerDialog::reject() {
    isCancel_ = true;
    QDialog::reject();
}

}  // namespace zv

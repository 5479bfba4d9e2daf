#pragma once
// A window used as a picker: it loads once, when first shown, with IsCancel false;
// confirming hides it and keeps IsCancel false; any other way of closing it (close box,
// Escape, a cancel button) sets IsCancel.

#include <QDialog>

namespace zv {

class PickerDialog : public QDialog {
    Q_OBJECT

  public:
    using QDialog::QDialog;
    // True when the window was closed without confirming.
    bool IsCancel() const { return isCancel_; }

  public Q_SLOTS:
    void reject() override;

  protected:
    void showEvent(QShowEvent* e) override;
    // Fills the window; runs once, before it is first shown.
    virtual void Load() = 0;
    // Ends the pick as confirmed.
    void HideConfirmed();

  private:
    bool isCancel_ = false;
    bool loaded_ = false;
};

}  // namespace zv

#pragma once
// The Ui of the windowed program: Qt message boxes, right to left, and modal windows.

#include "util/ui.h"

namespace zv {

class QtUi : public Ui {
  public:
    int MsgBox(const QString& text, int style, const QString& title) override;
    void ShowModal(QWidget& window) override;
    void DoEvents() override;
};

}  // namespace zv

#pragma once
// The Ui of runs without windows (--batch): each message is one entry on standard error,
// its default button answers, and a modal window counts as closed by the user.

#include "util/ui.h"

namespace zv {

class ConsoleUi : public Ui {
  public:
    int MsgBox(const QString& text, int style, const QString& title) override;
    void ShowModal(QWidget& window) override;
    void DoEvents() override;
};

}  // namespace zv

#pragma once
// The Ui port: every message box, modal show and event pump of the program goes through
// it, so the same code runs with windows, on the console (--batch) and under tests.

#include <QString>
#include <memory>

class QWidget;

namespace zv {

// Message box styles and answers, with the values of the VB constants.
enum : int {
    vbOKOnly = 0,
    vbOKCancel = 1,
    vbYesNo = 4,
    vbCritical = 16,
    vbQuestion = 32,
    vbExclamation = 48,
    vbInformation = 64,
    vbDefaultButton2 = 256,
};
enum : int { vbOK = 1, vbCancel = 2, vbYes = 6, vbNo = 7 };

// The default title of every message box.
QString AppTitle();

class Ui {
  public:
    virtual ~Ui() = default;
    // Shows a message box and returns the answer (vbOK, vbYes, ...).
    virtual int MsgBox(const QString& text, int style, const QString& title) = 0;
    // Shows a window modally and returns when it is hidden or closed.
    virtual void ShowModal(QWidget& window) = 0;
    // Lets pending window events run.
    virtual void DoEvents() = 0;
};

// The answer of the default button of a style (the first button, or the second with
// vbDefaultButton2).
int DefaultAnswer(int style);

// The Ui in use; the program and every test install one first.
Ui& CurrentUi();
// Installs a Ui for the rest of the process (or until the next call); returns the old one.
std::unique_ptr<Ui> SetUi(std::unique_ptr<Ui> ui);

int MsgBox(const QString& text, int style = vbOKOnly, const QString& title = {});
void ShowModal(QWidget& window);
void DoEvents();

}  // namespace zv

#include "util/ui.h"

#include <QtGlobal>

namespace zv {
namespace {

std::unique_ptr<Ui>& Current() {
    static std::unique_ptr<Ui> ui;
    return ui;
}

}  // namespace

QString AppTitle() {
    return QStringLiteral("תוסף תיוק לזורבן");
}

int DefaultAnswer(int style) {
    const bool second = (style & vbDefaultButton2) != 0;
    switch (style & 7) {
        case vbOKCancel:
            return second ? vbCancel : vbOK;
        case vbYesNo:
            return second ? vbNo : vbYes;
        default:
            return vbOK;
    }
}

Ui& CurrentUi() {
    if (!Current()) {
        qFatal("No Ui installed");
    }
    return *Current();
}

std::unique_ptr<Ui> SetUi(std::unique_ptr<Ui> ui) {
    auto old = std::move(Current());
    Current() = std::move(ui);
    return old;
}

int MsgBox(const QString& text, int style, const QString& title) {
    return CurrentUi().MsgBox(text, style, title.isEmpty() ? AppTitle() : title);
}

void ShowModal(QWidget& window) {
    CurrentUi().ShowModal(window);
}

void DoEvents() {
    CurrentUi().DoEvents();
}

}  // namespace zv

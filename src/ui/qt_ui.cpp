#include "ui/qt_ui.h"

#include <QApplication>
#include <QDialog>
#include <QEvent>
#include <QEventLoop>
#include <QMessageBox>
#include <QPointer>

namespace zv {
namespace {

QMessageBox::Icon IconOf(int style) {
    switch (style & 0x70) {
        case vbCritical:
            return QMessageBox::Critical;
        case vbQuestion:
            return QMessageBox::Question;
        case vbExclamation:
            return QMessageBox::Warning;
        case vbInformation:
            return QMessageBox::Information;
        default:
            return QMessageBox::NoIcon;
    }
}

// Ends a nested event loop when the watched window is hidden or closed.
class HideWatcher : public QObject {
  public:
    explicit HideWatcher(QEventLoop& loop) : loop_(loop) {}
    bool eventFilter(QObject*, QEvent* e) override {
        if (e->type() == QEvent::Hide || e->type() == QEvent::Close) {
            loop_.quit();
        }
        return false;
    }

  private:
    QEventLoop& loop_;
};

}  // namespace

int QtUi::MsgBox(const QString& text, int style, const QString& title) {
    QMessageBox box(IconOf(style), title, text, QMessageBox::NoButton,
                    QApplication::activeWindow());
    box.setLayoutDirection(Qt::RightToLeft);
    box.setTextFormat(Qt::PlainText);
    QList<QPair<QMessageBox::StandardButton, int>> buttons;
    switch (style & 7) {
        case vbOKCancel:
            buttons = {{QMessageBox::Ok, vbOK}, {QMessageBox::Cancel, vbCancel}};
            break;
        case vbYesNo:
            buttons = {{QMessageBox::Yes, vbYes}, {QMessageBox::No, vbNo}};
            break;
        default:
            buttons = {{QMessageBox::Ok, vbOK}};
    }
    for (const auto& b : buttons) {
        box.addButton(b.first);
    }
    const int defaultIndex = ((style & vbDefaultButton2) && buttons.size() > 1) ? 1 : 0;
    box.setDefaultButton(buttons[defaultIndex].first);
    box.setEscapeButton(buttons.size() > 1 ? buttons.last().first : buttons.first().first);
    const auto pressed = static_cast<QMessageBox::StandardButton>(box.exec());
    for (const auto& b : buttons) {
        if (b.first == pressed) {
            return b.second;
        }
    }
    return buttons[defaultIndex].second;
}

void QtUi::ShowModal(QWidget& window) {
    if (auto* dialog = qobject_cast<QDialog*>(&window)) {
        dialog->exec();
        return;
    }
    QPointer<QWidget> guard(&window);
    QEventLoop loop;
    HideWatcher watcher(loop);
    window.installEventFilter(&watcher);
    window.setWindowModality(Qt::ApplicationModal);
    window.show();
    loop.exec();
    if (guard) {
        window.removeEventFilter(&watcher);
    }
}

void QtUi::DoEvents() {
    QApplication::processEvents();
}

}  // namespace zv

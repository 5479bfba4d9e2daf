#include "filing_dialog/name_guard.h"

#include <QKeyEvent>
#include <QLineEdit>
#include <algorithm>

#include "filing_dialog/file_naming.h"
#include "util/ui.h"

namespace zv {
namespace {

bool HasForbidden(const QString& text) {
    const QString chars = ForbiddenNameChars();
    return std::any_of(text.begin(), text.end(), [&](QChar c) { return chars.contains(c); });
}

}  // namespace

NameGuard::NameGuard(QLineEdit* edit) : QObject(edit), edit_(edit), accepted_(edit->text()) {
    edit->installEventFilter(this);
    connect(edit, &QLineEdit::textChanged, this, &NameGuard::OnTextChanged);
    connect(edit, &QLineEdit::textEdited, this, &NameGuard::OnTextEdited);
    connect(edit, &QLineEdit::cursorPositionChanged, this, &NameGuard::OnCursorMoved);
}

bool NameGuard::eventFilter(QObject* watched, QEvent* event) {
    if (watched == edit_ && event->type() == QEvent::KeyPress) {
        const QString typed = static_cast<QKeyEvent*>(event)->text();
        if (typed.size() == 1 && ForbiddenNameChars().contains(typed.front())) {
            MsgBox(ForbiddenNameMessage(), vbCritical);
            return true;
        }
    }
    return QObject::eventFilter(watched, event);
}

void NameGuard::OnTextChanged(const QString& text) {
    if (!HasForbidden(text)) {
        accepted_ = text;
        acceptedCursor_ = edit_->cursorPosition();
    }
}

void NameGuard::OnTextEdited(const QString& text) {
    if (!HasForbidden(text)) {
        return;
    }
    // Pasted or dropped text: put back what was there before the edit.
    const int cursor = acceptedCursor_;
    edit_->setText(accepted_);
    edit_->setCursorPosition(cursor);
    MsgBox(ForbiddenNameMessage(), vbCritical);
}

void NameGuard::OnCursorMoved(int, int newPos) {
    if (edit_->text() == accepted_) {
        acceptedCursor_ = newPos;
    }
}

}  // namespace zv

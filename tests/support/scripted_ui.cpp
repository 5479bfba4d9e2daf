#include "scripted_ui.h"

#include <QApplication>
#include <QWidget>

namespace zv::test {

int ScriptedUi::MsgBox(const QString& text, int style, const QString& title) {
    messages_.push_back({text, style, title});
    if (answers_.empty()) {
        return DefaultAnswer(style);
    }
    const int answer = answers_.front();
    answers_.pop_front();
    return answer;
}

void ScriptedUi::ShowModal(QWidget& window) {
    ++modalCount_;
    window.show();
    if (modals_.empty()) {
        ++unexpectedModals_;
        window.close();
        return;
    }
    auto handler = std::move(modals_.front());
    modals_.pop_front();
    handler(window);
}

void ScriptedUi::DoEvents() {
    QApplication::processEvents();
}

QStringList ScriptedUi::Texts() const {
    QStringList out;
    for (const auto& m : messages_) {
        out << m.text;
    }
    return out;
}

void ScriptedUi::Clear() {
    messages_.clear();
    answers_.clear();
    modals_.clear();
    modalCount_ = 0;
    unexpectedModals_ = 0;
}

ScopedScriptedUi::ScopedScriptedUi() {
    auto ui = std::make_unique<ScriptedUi>();
    ui_ = ui.get();
    previous_ = SetUi(std::move(ui));
}

ScopedScriptedUi::~ScopedScriptedUi() {
    SetUi(std::move(previous_));
}

}  // namespace zv::test

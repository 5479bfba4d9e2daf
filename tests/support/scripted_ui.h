#pragma once
// The Ui of the tests: records every message, answers from a queue (the default button
// when the queue is empty) and runs a test-supplied function in place of each modal show.

#include <QString>
#include <QStringList>
#include <deque>
#include <functional>
#include <vector>

#include "util/ui.h"

namespace zv::test {

struct ShownMessage {
    QString text;
    int style;
    QString title;
};

class ScriptedUi : public Ui {
  public:
    using ModalHandler = std::function<void(QWidget&)>;

    int MsgBox(const QString& text, int style, const QString& title) override;
    // Shows the window and runs the next queued handler on it; with no handler queued the
    // window is closed as by the close box and the show is counted as unexpected.
    void ShowModal(QWidget& window) override;
    void DoEvents() override;

    void QueueAnswer(int answer) { answers_.push_back(answer); }
    void QueueModal(ModalHandler handler) { modals_.push_back(std::move(handler)); }

    const std::vector<ShownMessage>& Messages() const { return messages_; }
    QStringList Texts() const;
    int ModalCount() const { return modalCount_; }
    int UnexpectedModals() const { return unexpectedModals_; }
    void Clear();

  private:
    std::vector<ShownMessage> messages_;
    std::deque<int> answers_;
    std::deque<ModalHandler> modals_;
    int modalCount_ = 0;
    int unexpectedModals_ = 0;
};

// Installs a fresh ScriptedUi for the lifetime of this object.
class ScopedScriptedUi {
  public:
    ScopedScriptedUi();
    ~ScopedScriptedUi();
    ScriptedUi& operator*() { return *ui_; }
    ScriptedUi* operator->() { return ui_; }

  private:
    ScriptedUi* ui_;
    std::unique_ptr<Ui> previous_;
};

}  // namespace zv::test

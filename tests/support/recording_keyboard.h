#pragma once
// A keyboard for tests: it starts on the English layout, remembers each layout it is asked to
// load, and stands in for the system's keyboard while it lives.

#include <QStringList>
#include <memory>

#include "util/keyboard_layout.h"

namespace zv::test {

class ScopedRecordingKeyboard {
  public:
    ScopedRecordingKeyboard()
        : previous_(SetKeyboardPlatform(std::make_unique<Recorder>(loaded_))) {}
    ~ScopedRecordingKeyboard() { SetKeyboardPlatform(std::move(previous_)); }
    ScopedRecordingKeyboard(const ScopedRecordingKeyboard&) = delete;
    ScopedRecordingKeyboard& operator=(const ScopedRecordingKeyboard&) = delete;

    const QStringList& Loaded() const { return loaded_; }

  private:
    class Recorder : public KeyboardPlatform {
      public:
        explicit Recorder(QStringList& loaded) : loaded_(loaded) {}
        QString ActiveLayoutName() override {
            return loaded_.isEmpty() ? QStringLiteral("00000409") : loaded_.last();
        }
        void LoadLayout(const QString& layoutId) override { loaded_ << layoutId; }

      private:
        QStringList& loaded_;
    };

    QStringList loaded_;
    std::unique_ptr<KeyboardPlatform> previous_;
};

}  // namespace zv::test

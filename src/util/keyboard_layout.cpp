#include "util/keyboard_layout.h"

#include "util/errors.h"
#include "util/keyboard_platform.h"

namespace zv {
namespace {

// Where nothing can switch layouts: no layout is ever active.
class NoKeyboardPlatform : public KeyboardPlatform {
  public:
    QString ActiveLayoutName() override { return {}; }
    void LoadLayout(const QString&) override {}
};

std::unique_ptr<KeyboardPlatform>& Platform() {
    static std::unique_ptr<KeyboardPlatform> platform;
    return platform;
}

}  // namespace

KeyboardPlatform& CurrentKeyboardPlatform() {
    if (!Platform()) {
        Platform() = SystemKeyboardPlatform();
        if (!Platform()) {
            Platform() = std::make_unique<NoKeyboardPlatform>();
        }
    }
    return *Platform();
}

std::unique_ptr<KeyboardPlatform> SetKeyboardPlatform(std::unique_ptr<KeyboardPlatform> p) {
    auto old = std::move(Platform());
    Platform() = std::move(p);
    return old;
}

bool SetKbLayout(const QString& layoutId) {
    bool active = false;
    Step(
        [](const VbError& e) {
            return FormatPlain(QStringLiteral("SetKbLayout"), e) + QStringLiteral("\r\n");
        },
        [&] {
            KeyboardPlatform& platform = CurrentKeyboardPlatform();
            if (platform.ActiveLayoutName() == layoutId) {
                active = true;
                return;
            }
            platform.LoadLayout(layoutId);
            active = platform.ActiveLayoutName() == layoutId;
        });
    return active;
}

void SetKbHebrew(bool isHebrew) {
    SetKbLayout(isHebrew ? QStringLiteral("0000040D") : QStringLiteral("00000409"));
}

}  // namespace zv

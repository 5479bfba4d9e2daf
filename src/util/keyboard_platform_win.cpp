#include <windows.h>

#include "util/keyboard_platform.h"

namespace zv {
namespace {

// The thread's layout through the Windows keyboard-layout calls.
class WindowsKeyboardPlatform : public KeyboardPlatform {
  public:
    QString ActiveLayoutName() override {
        char name[KL_NAMELENGTH] = {};
        if (!GetKeyboardLayoutNameA(name)) {
            return {};
        }
        return QString::fromLatin1(name);
    }

    void LoadLayout(const QString& layoutId) override {
        LoadKeyboardLayoutA(layoutId.toLatin1().constData(), KLF_ACTIVATE);
    }
};

}  // namespace

std::unique_ptr<KeyboardPlatform> SystemKeyboardPlatform() {
    return std::make_unique<WindowsKeyboardPlatform>();
}

}  // namespace zv

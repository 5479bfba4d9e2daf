#include "util/keyboard_platform.h"

namespace zv {

std::unique_ptr<KeyboardPlatform> SystemKeyboardPlatform() {
    return nullptr;
}

}  // namespace zv

#pragma once
// The keyboard layouts of this operating system; one source file per system defines it.

#include <memory>

#include "util/keyboard_layout.h"

namespace zv {

// The platform of this system, or nothing when it offers no way to switch layouts (no
// display, no keyboard extension).
std::unique_ptr<KeyboardPlatform> SystemKeyboardPlatform();

}  // namespace zv

#pragma once
// Key codes, shift states and mouse buttons as the suite's event handlers know them
// (Windows virtual-key codes; Shift 1, Ctrl 2, Alt 4; left button 1, right 2, middle 4).

#include <Qt>
#include <cstdint>

namespace zv {

// The virtual-key code of a Qt key; 0 for keys without one.
int16_t VbKeyCode(int qtKey);
int16_t VbShift(Qt::KeyboardModifiers modifiers);
int16_t VbButtons(Qt::MouseButtons buttons);

}  // namespace zv

#pragma once
// Switching the keyboard layout of the user-interface thread, for text boxes that expect
// Hebrew. Layouts are named by Windows layout identifiers: "0000040D" Hebrew, "00000409"
// English (United States).

#include <QString>
#include <memory>

namespace zv {

// What a platform offers: the active layout's identifier and loading a layout.
class KeyboardPlatform {
  public:
    virtual ~KeyboardPlatform() = default;
    // The identifier of the active layout, eight upper-case hexadecimal digits.
    virtual QString ActiveLayoutName() = 0;
    // Loads and activates a layout; an unknown one leaves the active layout as it is.
    virtual void LoadLayout(const QString& layoutId) = 0;
};

// The platform of this system, chosen when first needed.
KeyboardPlatform& CurrentKeyboardPlatform();
// Replaces the platform (tests); returns the previous one.
std::unique_ptr<KeyboardPlatform> SetKeyboardPlatform(std::unique_ptr<KeyboardPlatform> p);

// Activates a layout; true when it is the active layout afterwards. The comparison with the
// active layout is exact, so the identifier must be in upper case.
bool SetKbLayout(const QString& layoutId);
// Activates the Hebrew layout, or the English one.
void SetKbHebrew(bool isHebrew);

}  // namespace zv

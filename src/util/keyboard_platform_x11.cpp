#include "util/keyboard_platform.h"
#include "util/xkb_symbols.h"

// After Qt's headers: Xlib defines macros (CursorShape, None, ...) that Qt also uses.
// clang-format off
#include <X11/XKBlib.h>
// clang-format on

namespace zv {
namespace {

// Layouts as the groups of the X keyboard; the Hebrew one is found by the layout name in
// the symbols name, since group display names vary.
class X11KeyboardPlatform : public KeyboardPlatform {
  public:
    explicit X11KeyboardPlatform(Display* display) : display_(display) {}
    ~X11KeyboardPlatform() override { XCloseDisplay(display_); }
    X11KeyboardPlatform(const X11KeyboardPlatform&) = delete;
    X11KeyboardPlatform& operator=(const X11KeyboardPlatform&) = delete;

    QString ActiveLayoutName() override {
        XkbStateRec state{};
        if (XkbGetState(display_, XkbUseCoreKbd, &state) != Success) {
            return {};
        }
        return IdOfXkbLayout(XkbLayoutOfGroup(Symbols(), state.group));
    }

    void LoadLayout(const QString& layoutId) override {
        const int group = XkbGroupOfLayout(Symbols(), XkbLayoutOfId(layoutId));
        if (group >= 0) {
            XkbLockGroup(display_, XkbUseCoreKbd, static_cast<unsigned>(group));
            XSync(display_, False);
        }
    }

  private:
    QString Symbols() {
        QString symbols;
        XkbDescPtr desc = XkbAllocKeyboard();
        if (!desc) {
            return symbols;
        }
        if (XkbGetNames(display_, XkbSymbolsNameMask, desc) == Success && desc->names &&
            desc->names->symbols != None) {
            char* name = XGetAtomName(display_, desc->names->symbols);
            if (name) {
                symbols = QString::fromLatin1(name);
                XFree(name);
            }
        }
        XkbFreeKeyboard(desc, 0, True);
        return symbols;
    }

    Display* display_;
};

}  // namespace

std::unique_ptr<KeyboardPlatform> SystemKeyboardPlatform() {
    int event = 0, error = 0, reason = 0;
    int major = XkbMajorVersion, minor = XkbMinorVersion;
    Display* display = XkbOpenDisplay(nullptr, &event, &error, &major, &minor, &reason);
    if (!display) {
        return nullptr;
    }
    return std::make_unique<X11KeyboardPlatform>(display);
}

}  // namespace zv

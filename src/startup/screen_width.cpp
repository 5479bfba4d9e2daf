#include <QGuiApplication>
#include <QScreen>

#include "startup/settings.h"
#include "util/ui.h"

namespace zv {

int ScreenWidthTwips() {
    DoEvents();
    const QScreen* screen = QGuiApplication::primaryScreen();
    if (!screen) {
        return 0;
    }
    // A twip is 1/1440 inch.
    return qRound(screen->geometry().width() * 1440.0 / screen->logicalDotsPerInchX());
}

}  // namespace zv

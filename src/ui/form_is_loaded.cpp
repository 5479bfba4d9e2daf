#include "ui/form_is_loaded.h"

#include <QApplication>
#include <QWidget>

namespace zv {

bool FormIsLoaded(const QString& name) {
    const auto windows = QApplication::topLevelWidgets();
    for (const QWidget* w : windows) {
        if (w->objectName().compare(name, Qt::CaseInsensitive) == 0) {
            return true;
        }
    }
    return false;
}

}  // namespace zv

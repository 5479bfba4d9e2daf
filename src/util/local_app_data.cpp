#include "util/local_app_data.h"

#include <QDir>

namespace zv {

QString LocalAppDataDir() {
    const QString local = qEnvironmentVariable("LOCALAPPDATA");
    if (!local.isEmpty()) {
        return local;
    }
    const QString xdg = qEnvironmentVariable("XDG_DATA_HOME");
    if (!xdg.isEmpty()) {
        return xdg;
    }
    return QDir::homePath() + QStringLiteral("/.local/share");
}

}  // namespace zv

#pragma once
// The per-user local application-data folder: LOCALAPPDATA when set, otherwise
// $XDG_DATA_HOME, otherwise $HOME/.local/share. The folder may not exist.

#include <QString>

namespace zv {

QString LocalAppDataDir();

}  // namespace zv

#pragma once
// The per-user settings store of the suite, addressed by application, section and key.
// On Windows it is the registry branch the suite itself writes
// (HKEY_CURRENT_USER\Software\VB and VBA Program Settings\<App>\<Section>); elsewhere an
// INI file $XDG_CONFIG_HOME/zorvane/<application in lower case>.ini (~/.config when the
// variable is not set). Application, section and key names compare without case.

#include <QString>

namespace zv {

// Where the store of an application lives (a file path, or the registry key on Windows).
QString SettingsStoreFile(const QString& app);
// The stored value, or def when the key is missing.
QString GetSetting(const QString& app, const QString& section, const QString& key,
                   const QString& def = {});
void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value);

}  // namespace zv

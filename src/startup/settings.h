#pragma once
// Installation settings: read from the suite's per-user store, with the per-user settings
// file Kavex32R.txt as the fallback, and the user's work folder MainPath/Dat1.

#include <QString>

namespace zv {

// A value of the settings store; an empty value, or any value in a development run, is
// replaced by the one of the per-user settings file.
QString ReadSetting(const QString& app, const QString& section, const QString& key,
                    const QString& def);
// A value of the per-user settings file.
QString ReadGlobalKeys(const QString& section, const QString& key);
// The full path of the per-user settings file; empty while it cannot be known yet.
QString GetGlobalKeysFile();

// Loads MainPath, MyUserName, MyUser and VolnaGlobNum and prepares the work folder.
void SetBasicParam();
// Makes path the work folder and ensures it and its sub-folders exist.
void PrepareWorkDir(const QString& path);
// The work folder, with a trailing separator.
QString GetWorkDir();

}  // namespace zv

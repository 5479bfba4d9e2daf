#include <QSettings>

#include "util/settings_store.h"

namespace zv {

// The registry compares names without case, as the suite expects.
QString SettingsStoreFile(const QString& app) {
    return QStringLiteral("HKEY_CURRENT_USER\\Software\\VB and VBA Program Settings\\") + app;
}

QString GetSetting(const QString& app, const QString& section, const QString& key,
                   const QString& def) {
    QSettings store(SettingsStoreFile(app), QSettings::NativeFormat);
    store.beginGroup(section);
    return store.value(key, def).toString();
}

void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value) {
    QSettings store(SettingsStoreFile(app), QSettings::NativeFormat);
    store.beginGroup(section);
    store.setValue(key, value);
}

}  // namespace zv

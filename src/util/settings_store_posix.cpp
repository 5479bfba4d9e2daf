#include <QDir>
#include <QSettings>

#include "util/settings_store.h"

namespace zv {
namespace {

// QSettings files keys without a group under [General] and writes a group named General
// as [%General]; the suite's section General is therefore kept as the top level, so the
// file reads [General] as anyone would write it by hand.
bool IsGeneral(const QString& section) {
    return section.compare(QStringLiteral("General"), Qt::CaseInsensitive) == 0;
}

QString Matching(const QStringList& names, const QString& wanted) {
    for (const QString& name : names) {
        if (name.compare(wanted, Qt::CaseInsensitive) == 0) {
            return name;
        }
    }
    return wanted;
}

// Opens the group of a section under the spelling already in the file, if any.
void EnterSection(QSettings& store, const QString& section) {
    if (!IsGeneral(section)) {
        store.beginGroup(Matching(store.childGroups(), section));
    }
}

}  // namespace

QString SettingsStoreFile(const QString& app) {
    QString config = qEnvironmentVariable("XDG_CONFIG_HOME");
    if (config.isEmpty()) {
        config = QDir::homePath() + QStringLiteral("/.config");
    }
    return config + QStringLiteral("/zorvane/") + app.toLower() + QStringLiteral(".ini");
}

QString GetSetting(const QString& app, const QString& section, const QString& key,
                   const QString& def) {
    QSettings store(SettingsStoreFile(app), QSettings::IniFormat);
    EnterSection(store, section);
    const QVariant value = store.value(Matching(store.childKeys(), key));
    if (!value.isValid()) {
        return def;
    }
    // An unquoted value with commas in a hand-edited file reads as a list.
    if (value.typeId() == QMetaType::QStringList) {
        return value.toStringList().join(QLatin1Char(','));
    }
    return value.toString();
}

void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value) {
    QSettings store(SettingsStoreFile(app), QSettings::IniFormat);
    EnterSection(store, section);
    store.setValue(Matching(store.childKeys(), key), value);
    store.sync();
}

}  // namespace zv

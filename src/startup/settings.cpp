#include "startup/settings.h"

#include <QDir>

#include "util/errors.h"
#include "util/file_utils.h"
#include "util/ini_reader.h"
#include "util/local_app_data.h"
#include "util/settings_store.h"
#include "util/state.h"

namespace zv {
namespace {

const QString kSuiteApp = QStringLiteral("Kavex32");
const QString kSuiteAppUpper = QStringLiteral("KAVEX32");
const QString kGeneral = QStringLiteral("General");
const QString kGlobalKeysName = QStringLiteral("Kavex32R.txt");

QString WithSeparator(const QString& folder) {
    if (folder.endsWith(QLatin1Char('\\')) || folder.endsWith(QLatin1Char('/'))) {
        return folder;
    }
    return folder + QDir::separator();
}

}  // namespace

QString ReadSetting(const QString& app, const QString& section, const QString& key,
                    const QString& def) {
    QString value = GetSetting(app, section, key, def);
    if (value.isEmpty() || IsDevelopmentRun()) {
        value = ReadGlobalKeys(section, key);
    }
    return value;
}

QString ReadGlobalKeys(const QString& section, const QString& key) {
    QString value;
    Step([](const VbError& e) { return FormatPlain(QStringLiteral("ReadGlobalKeys"), e); },
         [&] { value = ReadINI(section, key, GetGlobalKeysFile()); });
    return value;
}

QString GetGlobalKeysFile() {
    if (!GlobalKeysFileCache().isEmpty()) {
        return GlobalKeysFileCache();
    }
    QString folder = LocalAppDataDir();
    if (IsFolderExist(folder)) {
        folder = WithSeparator(folder) + QStringLiteral("Zorvane");
    }
    if (!IsFolderExist(folder)) {
        BuildDirTree(folder);
    }
    if (!IsFolderExist(folder)) {
        // The fallback lies inside the installation, so it waits until MainPath is known;
        // until then there is no settings file rather than one at the root of the disk.
        if (MainPath().isEmpty()) {
            return {};
        }
        folder = MainPath() + QDir::separator() + QStringLiteral("Def") + QDir::separator() +
                 QStringLiteral("UMR");
        if (!IsFolderExist(folder)) {
            BuildDirTree(folder);
        }
    }
    SetGlobalKeysFileCache(WithSeparator(folder) + kGlobalKeysName);
    return GlobalKeysFileCache();
}

void SetBasicParam() {
    const auto format = [](const VbError& e) {
        return FormatWithLine(QStringLiteral("-SetBasicParam"), e);
    };
    Step(format,
         [] { SetMainPath(ReadSetting(kSuiteApp, kGeneral, QStringLiteral("MainPath"), {})); });
    Step(format,
         [] { SetMyUserName(ReadSetting(kSuiteApp, kGeneral, QStringLiteral("MyUserName"), {})); });
    Step(format, [] { SetMyUser(ReadSetting(kSuiteApp, kGeneral, QStringLiteral("MyUser"), {})); });
    Step(format, [] {
        SetVolnaGlobNum(ReadSetting(kSuiteAppUpper, kGeneral, QStringLiteral("VolnaGlobNum"), {}));
    });
    // Without MainPath the work folder would land at the root of the disk; Main refuses
    // such an installation anyway.
    if (MainPath().isEmpty()) {
        return;
    }
    Step(format, [] {
        PrepareWorkDir(MainPath() + QDir::separator() + QStringLiteral("Dat1") + QDir::separator());
    });
}

void PrepareWorkDir(const QString& path) {
    SetWorkDirValue(path);
    const QString dir = GetWorkDir();
    if (!IsFolderExist(dir)) {
        MakeFolder(dir);
    }
    for (const char* name : {"Def", "DTDef", "GDetDef", "BakMDB", "Temp"}) {
        const QString sub = dir + QLatin1String(name);
        if (!IsFolderExist(sub)) {
            MakeFolder(sub);
        }
    }
}

QString GetWorkDir() {
    return WorkDirValue().isEmpty() ? QString() : WithSeparator(WorkDirValue());
}

}  // namespace zv

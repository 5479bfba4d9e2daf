#pragma once
// Process-wide values of the add-in, under their own names. They are filled at start-up
// and when the filing dialog loads, and only read afterwards. Tests reset them.

#include <QMap>
#include <QString>

namespace zv {

// Installation settings
const QString& MainPath();
void SetMainPath(const QString& v);
const QString& MyUserName();
void SetMyUserName(const QString& v);
const QString& MyUser();
void SetMyUser(const QString& v);
const QString& VolnaGlobNum();
void SetVolnaGlobNum(const QString& v);
bool IsDevelopmentRun();
void SetIsDevelopmentRun(bool v);

// Work folder and the cached path of the per-user settings file
const QString& WorkDirValue();
void SetWorkDirValue(const QString& v);
const QString& GlobalKeysFileCache();
void SetGlobalKeysFileCache(const QString& v);

// Server settings and the per-module back-end flags (true: that database is on the server)
const QString& Provider();
void SetProvider(const QString& v);
const QString& DataSource();
void SetDataSource(const QString& v);
const QString& UserID();
void SetUserID(const QString& v);
const QString& PassWord();
void SetPassWord(const QString& v);
bool IsOffice();
void SetIsOffice(bool v);
bool IsDocs();
void SetIsDocs(bool v);
bool IsBM();
void SetIsBM(bool v);
bool IsZorva();
void SetIsZorva(bool v);

// Filing request
const QString& SourceExt();
void SetSourceExt(const QString& v);
const QString& BadFileChars();
void SetBadFileChars(const QString& v);

// Filing dialog
const QString& UserCode();
void SetUserCode(const QString& v);
// Case-kind catalogue: key (OptKey as decimal text, or 1000 + user kind) -> Hebrew name
const QMap<QString, QString>& OptKeyNames();
void SetOptKeyNames(const QMap<QString, QString>& v);

// Font fixer's cache of the special medium font name and size
const QString& MedFontNameSpeCache();
void SetMedFontNameSpeCache(const QString& v);
double MedFontSizeSpeCache();
void SetMedFontSizeSpeCache(double v);

// Back to the values at process start.
void ResetState();

}  // namespace zv

#include "util/state.h"

namespace zv {
namespace {

struct State {
    QString mainPath, myUserName, myUser, volnaGlobNum;
    bool isDevelopmentRun = false;
    QString workDir, globalKeysFile;
    QString provider, dataSource, userId, passWord;
    bool isOffice = false, isDocs = false, isBM = false, isZorva = false;
    QString sourceExt, badFileChars;
    QString userCode;
    QMap<QString, QString> optKeyNames;
    QString medFontNameSpe;
    double medFontSizeSpe = 0;
};

State& S() {
    static State s;
    return s;
}

}  // namespace

#define ZV_STRING_VALUE(Name, member)  \
    const QString& Name() {            \
        return S().member;             \
    }                                  \
    void Set##Name(const QString& v) { \
        S().member = v;                \
    }
#define ZV_BOOL_VALUE(Name, member) \
    bool Name() {                   \
        return S().member;          \
    }                               \
    void Set##Name(bool v) {        \
        S().member = v;             \
    }

ZV_STRING_VALUE(MainPath, mainPath)
ZV_STRING_VALUE(MyUserName, myUserName)
ZV_STRING_VALUE(MyUser, myUser)
ZV_STRING_VALUE(VolnaGlobNum, volnaGlobNum)
ZV_BOOL_VALUE(IsDevelopmentRun, isDevelopmentRun)
ZV_STRING_VALUE(WorkDirValue, workDir)
ZV_STRING_VALUE(GlobalKeysFileCache, globalKeysFile)
ZV_STRING_VALUE(Provider, provider)
ZV_STRING_VALUE(DataSource, dataSource)
ZV_STRING_VALUE(UserID, userId)
ZV_STRING_VALUE(PassWord, passWord)
ZV_BOOL_VALUE(IsOffice, isOffice)
ZV_BOOL_VALUE(IsDocs, isDocs)
ZV_BOOL_VALUE(IsBM, isBM)
ZV_BOOL_VALUE(IsZorva, isZorva)
ZV_STRING_VALUE(SourceExt, sourceExt)
ZV_STRING_VALUE(BadFileChars, badFileChars)
ZV_STRING_VALUE(UserCode, userCode)

#undef ZV_STRING_VALUE
#undef ZV_BOOL_VALUE

const QMap<QString, QString>& OptKeyNames() {
    return S().optKeyNames;
}
void SetOptKeyNames(const QMap<QString, QString>& v) {
    S().optKeyNames = v;
}
const QString& MedFontNameSpeCache() {
    return S().medFontNameSpe;
}
void SetMedFontNameSpeCache(const QString& v) {
    S().medFontNameSpe = v;
}
double MedFontSizeSpeCache() {
    return S().medFontSizeSpe;
}
void SetMedFontSizeSpeCache(double v) {
    S().medFontSizeSpe = v;
}

void ResetState() {
    S() = State{};
}

}  // namespace zv

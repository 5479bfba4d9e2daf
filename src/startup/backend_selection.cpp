#include "startup/backend_selection.h"

#include <QVariant>
#include <array>
#include <functional>
#include <memory>

#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/ini_reader.h"
#include "util/state.h"

namespace zv {

namespace {

// A Boolean column of a file database reads 1 (or the Jet -1) for true; Null is false.
bool IsTrueValue(const QVariant& v) {
    if (IsNullVal(v) || !v.isValid())
        return false;
    if (v.typeId() == QMetaType::Bool)
        return v.toBool();
    const QString text = v.toString().trimmed();
    if (text.compare(QStringLiteral("true"), Qt::CaseInsensitive) == 0)
        return true;
    bool ok = false;
    const double n = text.toDouble(&ok);
    return ok && n != 0;
}

void ReadServerLogin(const QString& f) {
    SetProvider(ReadINI(QStringLiteral("MSSQL"), QStringLiteral("Provider"), f));
    SetDataSource(ReadINI(QStringLiteral("MSSQL"), QStringLiteral("DataSource"), f));
    SetUserID(ReadINI(MyUser(), QStringLiteral("UserID"), f));
    if (UserID().isEmpty()) {
        SetUserID(ReadINI(QStringLiteral("000"), QStringLiteral("UserID"), f));
        SetPassWord(ReadINI(QStringLiteral("000"), QStringLiteral("PassWord"), f));
    } else {
        SetPassWord(ReadINI(MyUser(), QStringLiteral("PassWord"), f));
    }
}

struct ModuleFlag {
    const char* column;
    int16_t moduleNumber;
    void (*set)(bool);
};

constexpr std::array kModuleFlags{
    ModuleFlag{"IsDocs", module::Docs, &SetIsDocs},
    ModuleFlag{"IsBM", module::BM, &SetIsBM},
    ModuleFlag{"IsOffice", module::Office, &SetIsOffice},
    ModuleFlag{"IsZorva", module::Zorva, &SetIsZorva},
};

}  // namespace

bool GetIsWorksMSSQL(int16_t moduleNumber, bool requested) {
    Q_UNUSED(moduleNumber);
    Q_UNUSED(requested);
    return true;
}

void GetMSSQLParam() {
    const QString f = MainPath() + QStringLiteral("\\Def\\") + QStringLiteral("MSSQLSetting.INI");
    if (IsFileExist(f))
        ReadServerLogin(f);
    if (Provider().isEmpty() || DataSource().isEmpty() || UserID().isEmpty())
        return;

    std::unique_ptr<Database> db;
    std::unique_ptr<Recordset> rs;
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("GetMSSQLParam"), e); },
         [&] {
             db = Database::OpenFile(QStringLiteral("\\MAIN.MDB"), SuitePasswordConnect());
             // The client number is quoted, so that one with an apostrophe finds its row.
             rs = db->OpenRecordset(QStringLiteral("SELECT * FROM MSql Where [ClientID]='") +
                                        FixQuote(VolnaGlobNum()) + QStringLiteral("'"),
                                    dbOpenSnapshot);
             if (rs->RecordCount() <= 0)
                 return;
             rs->MoveFirst();
             // Every column is read before any flag is set: a failure sets none.
             std::array<bool, kModuleFlags.size()> on{};
             for (std::size_t i = 0; i < kModuleFlags.size(); ++i)
                 on[i] = IsTrueValue(rs->Value(QString::fromLatin1(kModuleFlags[i].column)));
             for (std::size_t i = 0; i < kModuleFlags.size(); ++i) {
                 if (on[i])
                     kModuleFlags[i].set(GetIsWorksMSSQL(kModuleFlags[i].moduleNumber, true));
             }
         });
    GClose(rs);
    GClose(db);
}

}  // namespace zv

#include "filing_dialog/code_lists.h"

#include <QDir>
#include <cmath>

#include "data/database.h"
#include "data/recordset.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"

namespace zv {
namespace {

// A whole number from a code column that may hold text; anything else is a type mismatch.
int WholeNumber(const QVariant& v) {
    bool ok = false;
    const double d = v.toString().trimmed().toDouble(&ok);
    if (!ok) {
        throw MakeError(err::TypeMismatch);
    }
    return static_cast<int>(std::nearbyint(d));
}

QString Trimmed(const QVariant& v) {
    return v.toString().trimmed();
}

}  // namespace

QStringList ReadOffCodeTexts(int code) {
    auto db = Database::Open(QStringLiteral("OFFICE"), IsOffice());
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [OFF_CODE] WHERE [CODE]=") +
                                    QString::number(code) + QStringLiteral(" ORDER BY [NUM]"),
                                dbOpenSnapshot);
    QStringList out;
    for (; !rs->EOF(); rs->MoveNext()) {
        out << Trimmed(rs->Value(QStringLiteral("Teur")));
    }
    GClose(rs);
    GClose(db);
    return out;
}

std::vector<CodeEntry> ReadDocStatuses() {
    auto db = Database::Open(QStringLiteral("MDOCS"), IsDocs());
    auto rs =
        db->OpenRecordset(QStringLiteral("SELECT * FROM [DOCSTATUS] ORDER BY ORD"), dbOpenSnapshot);
    std::vector<CodeEntry> out;
    for (; !rs->EOF(); rs->MoveNext()) {
        const int id = WholeNumber(rs->Value(QStringLiteral("ID")));
        out.push_back({QString::number(id) + QStringLiteral(" - ") +
                           Trimmed(rs->Value(QStringLiteral("Caption"))),
                       id});
    }
    GClose(rs);
    GClose(db);
    return out;
}

std::vector<CodeEntry> ReadDocOrigins() {
    auto db = Database::OpenFile(QStringLiteral("\\MADAD.MDB"), SuitePasswordConnect());
    auto rs = db->OpenRecordset(
        QStringLiteral(
            "SELECT * FROM [TRANS_CODE] WHERE [TABLE_NUM]=\"1080\" ORDER BY Val([KOD_NUM_1]);"),
        dbOpenSnapshot);
    std::vector<CodeEntry> out;
    for (; !rs->EOF(); rs->MoveNext()) {
        const int code = WholeNumber(rs->Value(QStringLiteral("KOD_NUM_1")));
        out.push_back({QString::number(code) + QStringLiteral(" - ") +
                           Trimmed(rs->Value(QStringLiteral("Teur"))),
                       code});
    }
    GClose(rs);
    GClose(db);
    return out;
}

QStringList ReadInnerFolders() {
    const QString basic = MainPath() + QStringLiteral("/DOCS/DOCBASIC");
    if (!IsFolderExist(basic)) {
        BuildDirTree(basic);
    }
    return QDir(DiskPath(basic)).entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Unsorted);
}

}  // namespace zv

#include "filing_dialog/case_kinds.h"

#include <QMap>
#include <array>

#include "data/database.h"
#include "data/recordset.h"
#include "util/errors.h"
#include "util/state.h"

namespace zv {

void SetOptKeyLakTik() {
    static const std::array<std::pair<int, const char*>, 18> fixed{{
        {0, "לקוחות"},
        {1, "תיקי נזיקין"},
        {2, "תיקי מקרקעין"},
        {3, "תיקי עבודה"},
        {4, "חייבים - המשערכת"},
        {5, "תיקי לשכה - חייב"},
        {7, "תיקי לשכה - זוכה"},
        {8, "תיקי חייבים - זוכה"},
        {9, "ספקים"},
        {12, "תיקי חייבים - חייב"},
        {10, "תיקי לשכה"},
        {11, "תיקים כלליים"},
        {13, "תיקי לשכה - חייב"},
        {14, "תיקי לשכה - זוכה"},
        {15, "ספר טלפונים אישי"},
        {16, "ספר טלפונים כללי"},
        {17, "צדדים"},
        {18, "מומחים"},
    }};
    QMap<QString, QString> names;
    for (const auto& [key, name] : fixed) {
        names.insert(QString::number(key), QString::fromUtf8(name));
    }
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("SetOptKeyLakTik"), e); },
         [&] {
             auto db = Database::Open(QStringLiteral("OFFICE"), IsOffice());
             auto rs =
                 db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE [SHOW]=") +
                                       (IsOffice() ? QStringLiteral("1") : QStringLiteral("True")) +
                                       QStringLiteral(" ORDER BY [ID]"),
                                   dbOpenSnapshot);
             while (!rs->EOF()) {
                 const int id = rs->Value(QStringLiteral("ID")).toInt();
                 names.insert(QString::number(id + 1000),
                              rs->Value(QStringLiteral("TEUR")).toString().trimmed());
                 rs->MoveNext();
             }
             GClose(rs);
             GClose(db);
         });
    SetOptKeyNames(names);
}

}  // namespace zv

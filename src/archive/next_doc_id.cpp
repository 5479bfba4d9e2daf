#include "archive/next_doc_id.h"

#include <limits>

#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {

int32_t GetNextIdDOCS() {
    if (IsDocs()) {
        return 0;
    }
    int32_t next = 0;
    std::unique_ptr<Database> db;
    std::unique_ptr<Recordset> rs;
    try {
        db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        rs = db->OpenRecordset(
            QStringLiteral("SELECT max(") + QStringLiteral("ID") + QStringLiteral(") FROM [DOCS]"),
            dbOpenDynaset);
        if (rs->RecordCount() > 0) {
            const QVariant max = rs->Value(rs->FieldName(0));
            const qint64 value = max.isNull() ? 1 : qint64(GetLngFromStr(max)) + 1;
            if (value > std::numeric_limits<int32_t>::max()) {
                throw MakeError(err::Overflow);
            }
            next = static_cast<int32_t>(value);
        } else {
            next = 1;
        }
    } catch (const std::exception& e) {
        MsgBox(FormatWithLine(QStringLiteral("GetNextIdDOCS"), AsVbError(e)), vbOKOnly);
    }
    GClose(rs);
    GClose(db);
    return next;
}

}  // namespace zv

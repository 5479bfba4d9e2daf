#include "filing/batch_choice.h"

#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "selection/list_query.h"
#include "util/state.h"

namespace zv {
namespace {

QString Text(const QVariant& v) {
    return v.isNull() ? QString() : v.toString();
}

QString FieldText(const Recordset& rs, const char* name) {
    return Text(rs.Value(QLatin1String(name)));
}

}  // namespace

std::optional<ChoiceLabels> ClientChoice(const QString& clientNum) {
    auto db = Database::Open(QStringLiteral("OFFICE"), IsOffice());
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [CLIENT] WHERE [NUM]='") +
                                    FixQuote(clientNum) + QStringLiteral("'"),
                                dbOpenSnapshot);
    std::optional<ChoiceLabels> labels;
    if (rs->RecordCount() > 0) {
        labels.emplace();
        labels->lakNum = FieldText(*rs, "NUM");
        labels->lakName =
            (FieldText(*rs, "F_NAME") + QLatin1Char(' ') + FieldText(*rs, "L_NAME")).trimmed();
        labels->lblSug = QStringLiteral("F");
    }
    GClose(rs);
    GClose(db);
    return labels;
}

bool AddCaseChoice(ChoiceLabels& labels, const QString& caseNumber) {
    auto db = Database::Open(QStringLiteral("ZORVA"), IsZorva());
    auto rs =
        db->OpenRecordset(NamesOpenQuery(db->IsServer(), labels.lakNum).Text(), dbOpenSnapshot);
    bool found = false;
    while (!found && !rs->EOF()) {
        if (FieldText(*rs, "Tik") == caseNumber) {
            labels.lblSug = FieldText(*rs, "Sug");
            labels.lSugTik = FieldText(*rs, "TIK_ID");
            labels.lTik = FieldText(*rs, "Tik");
            labels.lTikNum = FieldText(*rs, "Code");
            labels.lTeurTik =
                (FieldText(*rs, "F_NAME") + QLatin1Char(' ') + FieldText(*rs, "L_NAME")).trimmed();
            found = true;
        } else {
            rs->MoveNext();
        }
    }
    GClose(rs);
    GClose(db);
    return found;
}

}  // namespace zv

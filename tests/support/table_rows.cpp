#include "table_rows.h"

#include <map>

#include "data/database.h"
#include "data/recordset.h"
#include "util/state.h"

namespace zv::test {
namespace {

bool OnServer(const QString& database) {
    static const std::map<QString, bool (*)()> flags{
        {"MDOCS", IsDocs}, {"BM", IsBM}, {"OFFICE", IsOffice}, {"ZORVA", IsZorva}};
    const auto flag = flags.find(database);
    return flag != flags.end() && flag->second();
}

}  // namespace

QList<QVariantMap> Rows(const QString& database, const QString& sql) {
    auto rs = Database::Open(database, OnServer(database))->OpenRecordset(sql, dbOpenSnapshot);
    QList<QVariantMap> rows;
    for (; rs->RecordCount() > 0 && !rs->EOF(); rs->MoveNext()) {
        QVariantMap row;
        for (int i = 0; i < rs->FieldCount(); ++i) {
            row.insert(rs->FieldName(i).toUpper(), rs->Value(rs->FieldName(i)));
        }
        rows << row;
    }
    return rows;
}

void Execute(const QString& database, const QString& sql) {
    Database::Open(database, OnServer(database))->Execute(sql);
}

}  // namespace zv::test

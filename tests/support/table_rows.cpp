#include "table_rows.h"

#include "data/database.h"
#include "data/recordset.h"
#include "util/state.h"

namespace zv::test {
namespace {

bool OnServer(const QString& database) {
    if (database == QLatin1String("MDOCS")) {
        return IsDocs();
    }
    if (database == QLatin1String("BM")) {
        return IsBM();
    }
    if (database == QLatin1String("OFFICE")) {
        return IsOffice();
    }
    return database == QLatin1String("ZORVA") && IsZorva();
}

}  // namespace

QList<QVariantMap> Rows(const QString& database, const QString& sql) {
    auto db = Database::Open(database, OnServer(database));
    auto rs = db->OpenRecordset(sql, dbOpenSnapshot);
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

// GetSqlParts on any statement text, with and without keeping the case.

#include "data/sql_parts.h"
#include "fuzz_support.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString sql = QString::fromUtf8(zv::fuzz::Bytes(data, size));
    for (bool keepCase : {true, false}) {
        const std::array<QString, 3> parts = zv::GetSqlParts(sql, keepCase);
        if (!parts[0].endsWith(QLatin1Char(' '))) {
            zv::fuzz::Fail("the select part ends with one blank", sql);
        }
        if (!parts[1].isEmpty() && !parts[1].startsWith(QLatin1String("WHERE "))) {
            zv::fuzz::Fail("the where part begins with WHERE", sql);
        }
        if (!parts[2].isEmpty() && !parts[2].startsWith(QLatin1String("ORDER "))) {
            zv::fuzz::Fail("the order part begins with ORDER", sql);
        }
    }
    return 0;
}

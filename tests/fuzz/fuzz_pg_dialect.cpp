// The PostgreSQL rewrites on any statement text. Besides not failing, they must leave every
// complete string literal as it stands, in its order.

#include "data/pg_dialect.h"
#include "fuzz_support.h"

namespace {

// The complete '...' literals of a statement, outside [identifiers]. An unclosed bracket or
// literal ends the scan.
QStringList Literals(const QString& sql) {
    QStringList found;
    const qsizetype n = sql.size();
    for (qsizetype i = 0; i < n; ++i) {
        if (sql.at(i) == QLatin1Char('[')) {
            const qsizetype close = sql.indexOf(QLatin1Char(']'), i + 1);
            if (close < 0) {
                break;
            }
            i = close;
        } else if (sql.at(i) == QLatin1Char('\'')) {
            qsizetype j = i + 1;
            while (j < n && !(sql.at(j) == QLatin1Char('\'') &&
                              (j + 1 == n || sql.at(j + 1) != QLatin1Char('\'')))) {
                j += sql.at(j) == QLatin1Char('\'') ? 2 : 1;
            }
            if (j >= n) {
                break;
            }
            found << sql.mid(i, j + 1 - i);
            i = j;
        }
    }
    return found;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString sql = QString::fromUtf8(zv::fuzz::Bytes(data, size));
    const QString out = zv::AdaptForPostgres(sql);
    if (out.startsWith(QLatin1String("DO $zv$"))) {
        return 0;  // a USE statement, replaced as a whole
    }
    qsizetype from = 0;
    for (const QString& literal : Literals(sql)) {
        const qsizetype at = out.indexOf(literal, from);
        if (at < 0) {
            zv::fuzz::Fail("string literals stay as they are", sql + QStringLiteral("\n=> ") + out);
        }
        from = at + literal.size();
    }
    return 0;
}

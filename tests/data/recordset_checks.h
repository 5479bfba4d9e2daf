#pragma once
// Checks shared by the data tests: the error number a call raises, and one column of every
// row of a recordset.

#include <QStringList>
#include <functional>

#include "data/recordset.h"
#include "util/errors.h"

namespace zv::test {

// The VB error number raised by f, 0 when it returns.
inline long ErrorOf(const std::function<void()>& f) {
    try {
        f();
    } catch (const VbError& e) {
        return e.Number();
    }
    return 0;
}

inline QStringList Column(Recordset& rs, const QString& field) {
    QStringList values;
    if (rs.RecordCount() == 0) {
        return values;
    }
    for (rs.MoveFirst(); !rs.EOF(); rs.MoveNext()) {
        values << rs.Value(field).toString();
    }
    return values;
}

}  // namespace zv::test

#include "selection/kind_text.h"

#include "util/errors.h"
#include "util/state.h"

namespace zv {
namespace {

constexpr int kGeneralCase = 11;

// Keys are decimal numbers, so comparing them without regard to case changes nothing.
const QString* Lookup(const QString& key) {
    const auto& names = OptKeyNames();
    const auto it = names.constFind(key);
    return it == names.constEnd() ? nullptr : &it.value();
}

}  // namespace

QString KindText(const QVariant& optKey, const QVariant& tikId, bool byTikId) {
    const QString key = optKey.isNull() ? QString() : optKey.toString().trimmed();
    const QString* name = Lookup(key);
    if (!name) {
        return key;
    }
    bool isNumber = false;
    if (!byTikId || key.toInt(&isNumber) != kGeneralCase || !isNumber) {
        return *name;
    }
    if (tikId.isNull() || !tikId.isValid()) {
        throw VbError(94, QStringLiteral("Invalid use of Null"));
    }
    bool ok = false;
    const double id = tikId.toString().trimmed().toDouble(&ok);
    if (!ok) {
        throw MakeError(err::TypeMismatch);
    }
    const QString* general = Lookup(QString::number(static_cast<long long>(id) + 1000));
    return general ? *general : QStringLiteral("");
}

}  // namespace zv

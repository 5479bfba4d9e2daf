#include "selection/kind_text.h"

#include "util/errors.h"
#include "util/state.h"

namespace zv {
namespace {

constexpr int kGeneralCase = 11;

// The catalogue compares its keys as text without regard to case.
const QString* Lookup(const QString& key) {
    const auto& names = OptKeyNames();
    for (auto it = names.constBegin(); it != names.constEnd(); ++it) {
        if (it.key().compare(key, Qt::CaseInsensitive) == 0) {
            return &it.value();
        }
    }
    return nullptr;
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

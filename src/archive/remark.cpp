#include "archive/remark.h"

#include <QLocale>
#include <QRegularExpression>

#include "util/clock.h"
#include "util/state.h"

namespace zv {

QString RemarkStamp(const QDateTime& moment, const QString& userName) {
    const QLocale locale = QLocale::system();
    static const QRegularExpression zone(QStringLiteral("\\s*\\bt+\\b"));
    const QString longTime = locale.timeFormat(QLocale::LongFormat).remove(zone).trimmed();
    return locale.toString(moment.date(), QLocale::ShortFormat) + QLatin1Char(' ') +
           locale.toString(moment.time(), longTime) + QStringLiteral(" (") + userName +
           QLatin1Char(')');
}

QString AppendRemark(const QVariant& oldBody, const QString& remark) {
    const QString entry = RemarkStamp(Now(), MyUserName()) + QStringLiteral(" -- ") + remark;
    const QString old = oldBody.isNull() ? QString() : oldBody.toString();
    if (old.isEmpty()) {
        return entry;
    }
    return old + QStringLiteral("\r\n") + QString(60, QLatin1Char('-')) + QStringLiteral("\r\n") +
           entry;
}

}  // namespace zv

#include "archive/date_values.h"

namespace zv {

QDateTime ZeroDate() {
    return QDateTime(QDate(1899, 12, 30), QTime(0, 0));
}

QDateTime DateBoxValue(const QDate& day) {
    return day.isValid() ? QDateTime(day, QTime(0, 0)) : ZeroDate();
}

QDateTime StoredDateTime(const QVariant& value) {
    switch (value.typeId()) {
        case QMetaType::QDateTime:
            return value.toDateTime();
        case QMetaType::QDate:
            return value.toDate().startOfDay();
        default: {
            const QString text = value.toString().trimmed();
            const QDateTime dateTime = QDateTime::fromString(text, Qt::ISODate);
            if (dateTime.isValid()) {
                return dateTime;
            }
            return QDate::fromString(text, Qt::ISODate).startOfDay();
        }
    }
}

}  // namespace zv

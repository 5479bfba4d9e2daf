#include "archive/memo_date.h"

#include <optional>

#include "archive/date_values.h"
#include "util/errors.h"
#include "util/ui.h"

namespace zv {
namespace {

// A two-character piece of the time text as a number, when it reads as one.
std::optional<int> TimePiece(const QString& piece) {
    bool ok = false;
    const int value = piece.trimmed().toInt(&ok);
    return ok ? std::optional<int>(value) : std::nullopt;
}

// Calendar arithmetic, as the suite's date values count: a day is always 24 hours, whatever
// the clock change of the time zone.
QDateTime AddClockTime(const QDateTime& start, int hours, int minutes) {
    const qint64 seconds =
        QTime(0, 0).secsTo(start.time()) + qint64(hours) * 3600 + qint64(minutes) * 60;
    const qint64 days = seconds >= 0 ? seconds / 86400 : -((-seconds + 86399) / 86400);
    return QDateTime(start.date().addDays(days),
                     QTime(0, 0).addSecs(static_cast<int>(seconds - days * 86400)));
}

}  // namespace

bool GetmDate(const QVariant& dateValue, const QVariant& hourValue, QDateTime& result,
              bool showMessage) {
    bool formed = false;
    try {
        const QString hour = hourValue.isNull() ? QString() : hourValue.toString();
        if (!dateValue.isNull()) {
            const QDateTime day = StoredDateTime(dateValue);
            if (!day.isValid()) {
                throw MakeError(err::TypeMismatch);
            }
            const bool hasDate = day.date() != ZeroDate().date();
            const bool timeShaped = hour != QStringLiteral("__:__") && hour.size() == 5;
            const auto hours = timeShaped ? TimePiece(hour.mid(0, 2)) : std::nullopt;
            const auto minutes = timeShaped ? TimePiece(hour.mid(3, 2)) : std::nullopt;
            if (hasDate && hours && minutes) {
                result = AddClockTime(day, *hours, *minutes);
                formed = true;
            }
        }
    } catch (const std::exception& e) {
        MsgBox(FormatPlain(QStringLiteral("GetmDate"), AsVbError(e)), vbOKOnly);
        return formed;
    }
    if (showMessage && !formed) {
        MsgBox(QStringLiteral("בעיה במבנה של התאריך או השעות/דקות"), vbExclamation | vbOKOnly);
    }
    return formed;
}

}  // namespace zv

#include "startup/request_text.h"

#include <QLocale>
#include <cmath>

#include "util/errors.h"
#include "util/hebrew_text.h"

namespace zv {

QString DecodeArgumentText(const QByteArray& bytes) {
    return DecodeUtf8OrWindows1255(bytes);
}

QStringList SplitRequest(const QString& argumentText) {
    qsizetype begin = 0;
    qsizetype end = argumentText.size();
    while (begin < end && argumentText.at(begin) == QLatin1Char(' ')) {
        ++begin;
    }
    while (end > begin && argumentText.at(end - 1) == QLatin1Char(' ')) {
        --end;
    }
    return argumentText.mid(begin, end - begin).split(QChar(kRequestSeparator));
}

QString DevelopmentRequest() {
    const QString sep{QChar(kRequestSeparator)};
    return QStringLiteral("2") + sep + QStringLiteral("F:\\Ornit32\\DOCS\\TEMPLATES\\profil.doc") +
           sep + QStringLiteral("Test2");
}

int16_t RequestMode(const QString& field) {
    bool ok = false;
    const double value = QLocale::c().toDouble(field.trimmed(), &ok);
    if (!ok || !std::isfinite(value)) {
        throw MakeError(err::TypeMismatch);
    }
    const double rounded = std::nearbyint(value);
    if (rounded < -32768.0 || rounded > 32767.0) {
        throw MakeError(err::Overflow);
    }
    return static_cast<int16_t>(rounded);
}

}  // namespace zv

#include "util/hebrew_text.h"

#include <QStringDecoder>

namespace zv {

QString DecodeUtf8OrWindows1255(const QByteArray& bytes) {
    QStringDecoder utf8(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
    const QString text = utf8.decode(bytes);
    if (!utf8.hasError()) {
        return text;
    }
    QStringDecoder hebrew("windows-1255");
    return hebrew.decode(bytes);
}

}  // namespace zv

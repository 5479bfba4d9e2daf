#include "filing/clean_file_name.h"

#include "util/state.h"

namespace zv {

QString CleanFileName(const QString& text) {
    SetBadFileChars(QStringLiteral("/\\:*?\"<>|"));
    QString clean;
    clean.reserve(text.size());
    for (const QChar c : text) {
        if (!BadFileChars().contains(c)) {
            clean += c;
        }
    }
    return clean;
}

}  // namespace zv

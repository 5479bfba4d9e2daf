#include "util/ini_reader.h"

#include <QFile>

#include "util/errors.h"
#include "util/file_utils.h"
#include "util/hebrew_text.h"
#include "util/ui.h"

namespace zv {
namespace {

// The longest value the suite's reader returns (a 512-character buffer with its NUL).
constexpr qsizetype kMaxValue = 511;

QString Unquoted(const QString& value) {
    if (value.size() >= 2) {
        const QChar first = value.front();
        if ((first == QLatin1Char('"') || first == QLatin1Char('\'')) && value.back() == first) {
            return value.mid(1, value.size() - 2);
        }
    }
    return value;
}

QString Lookup(const QString& text, const QString& section, const QString& key) {
    bool inSection = false;
    bool sectionSeen = false;
    for (QStringView line : QStringView(text).split(QLatin1Char('\n'))) {
        line = line.trimmed();
        if (line.startsWith(QLatin1Char('['))) {
            if (inSection) {
                return {};  // only the first section of that name counts
            }
            const qsizetype close = line.indexOf(QLatin1Char(']'));
            const QStringView name = line.mid(1, close < 0 ? -1 : close - 1).trimmed();
            inSection = !sectionSeen && name.compare(section, Qt::CaseInsensitive) == 0;
            sectionSeen = sectionSeen || inSection;
            continue;
        }
        if (!inSection) {
            continue;
        }
        const qsizetype eq = line.indexOf(QLatin1Char('='));
        if (eq < 0 || line.left(eq).trimmed().compare(key, Qt::CaseInsensitive) != 0) {
            continue;
        }
        return Unquoted(line.mid(eq + 1).trimmed().toString()).left(kMaxValue);
    }
    return {};
}

}  // namespace

QString ReadINI(const QString& section, const QString& key, const QString& fileName) {
    if (section.isEmpty() || key.isEmpty() || fileName.isEmpty()) {
        return {};
    }
    QString value;
    Step([](const VbError& e) { return FormatPlain(QStringLiteral("ReadINI"), e); },
         [&] {
             QFile file(DiskPath(fileName));
             if (!file.exists()) {
                 return;
             }
             if (!file.open(QIODevice::ReadOnly)) {
                 throw MakeError(err::PermissionDenied);
             }
             QString text = DecodeUtf8OrWindows1255(file.readAll());
             if (text.startsWith(QChar(0xFEFF))) {
                 text.remove(0, 1);
             }
             value = Lookup(text, section, key);
         });
    return value;
}

}  // namespace zv

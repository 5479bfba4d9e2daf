#include "util/xkb_symbols.h"

#include <QStringList>
#include <utility>

namespace zv {
namespace {

struct Mapping {
    unsigned language;
    const char* layout;
};
constexpr Mapping kMappings[] = {{0x040D, "il"}, {0x0409, "us"}};

// The layout and zero-based group of one part of a symbols name ("il(lyx):2" -> il, 1).
std::pair<QString, int> Part(const QString& part) {
    QString name = part;
    int group = 0;
    const qsizetype colon = name.indexOf(QLatin1Char(':'));
    if (colon >= 0) {
        group = name.mid(colon + 1).toInt() - 1;
        name.truncate(colon);
    }
    const qsizetype paren = name.indexOf(QLatin1Char('('));
    if (paren >= 0) {
        name.truncate(paren);
    }
    return {name, group};
}

}  // namespace

QString XkbLayoutOfId(const QString& layoutId) {
    bool ok = false;
    const unsigned id = layoutId.toUInt(&ok, 16);
    if (!ok) {
        return {};
    }
    for (const Mapping& m : kMappings) {
        if (m.language == id) {
            return QLatin1String(m.layout);
        }
    }
    return {};
}

QString IdOfXkbLayout(const QString& layout) {
    for (const Mapping& m : kMappings) {
        if (layout == QLatin1String(m.layout)) {
            return QStringLiteral("%1").arg(m.language, 8, 16, QLatin1Char('0')).toUpper();
        }
    }
    return {};
}

int XkbGroupOfLayout(const QString& symbols, const QString& layout) {
    if (layout.isEmpty()) {
        return -1;
    }
    for (const QString& part : symbols.split(QLatin1Char('+'))) {
        const auto [name, group] = Part(part);
        if (name == layout) {
            return group;
        }
    }
    return -1;
}

QString XkbLayoutOfGroup(const QString& symbols, int group) {
    for (const QString& part : symbols.split(QLatin1Char('+'))) {
        const auto [name, g] = Part(part);
        if (g == group && !IdOfXkbLayout(name).isEmpty()) {
            return name;
        }
    }
    return {};
}

}  // namespace zv

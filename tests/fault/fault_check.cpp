#include "fault_check.h"

#include <QDir>
#include <QDirIterator>
#include <QFileInfo>

namespace zv::test {
namespace {

int RowCount(const FilingFixture& f, const QString& database, const QString& table) {
    try {
        return f.Rows(database, QStringLiteral("SELECT * FROM ") + table).size();
    } catch (const std::exception&) {
        return -1;
    }
}

}  // namespace

InstallationState StateOf(const FilingFixture& f) {
    InstallationState s;
    const QDir root(f.DataDir());
    QDirIterator it(f.DataDir(), QDir::Files | QDir::Hidden | QDir::System,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        // Documents are compared with their size; databases only by name, as reading them
        // may not change them but a failed write may leave them another size.
        const QString rel = root.relativeFilePath(path);
        s.files << (rel.startsWith(QLatin1String("DOCS/"))
                        ? rel + QLatin1Char(' ') + QString::number(QFileInfo(path).size())
                        : rel);
    }
    s.files.sort();
    s.docs = RowCount(f, QStringLiteral("MDOCS"), QStringLiteral("DOCS"));
    s.memos = RowCount(f, QStringLiteral("BM"), QStringLiteral("UMEMO"));
    return s;
}

}  // namespace zv::test

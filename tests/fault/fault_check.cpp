#include "fault_check.h"

#include <QDir>
#include <QDirIterator>
#include <QFileInfo>

namespace zv::test {
namespace {

qsizetype RowCount(const QString& database, const QString& table) {
    try {
        return Rows(database, QStringLiteral("SELECT * FROM ") + table).size();
    } catch (const std::exception&) {
        return -1;
    }
}

}  // namespace

QStringList StateOf(const FilingFixture& f) {
    QStringList files;
    const QDir root(f.DataDir());
    QDirIterator it(f.DataDir(), QDir::Files | QDir::Hidden | QDir::System,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        // Documents are compared with their size; databases only by name, as reading them
        // may not change them but a failed write may leave them another size.
        const QString rel = root.relativeFilePath(path);
        files << (rel.startsWith(QLatin1String("DOCS/"))
                      ? rel + QLatin1Char(' ') + QString::number(QFileInfo(path).size())
                      : rel);
    }
    files.sort();
    return files << QStringLiteral("DOCS rows: %1").arg(RowCount("MDOCS", "DOCS"))
                 << QStringLiteral("UMEMO rows: %1").arg(RowCount("BM", "UMEMO"));
}

}  // namespace zv::test

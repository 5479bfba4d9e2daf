#pragma once
// Writing and reading small files in tests, the folders made on the way.

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QString>

namespace zv::test {

inline bool WriteFile(const QString& path, const QByteArray& content) {
    QDir().mkpath(QFileInfo(path).path());
    QFile f(path);
    return f.open(QIODevice::WriteOnly) && f.write(content) == content.size();
}

// The file's bytes as Latin-1 text, "?" when it cannot be read.
inline QString ReadFile(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? QString::fromLatin1(f.readAll()) : QStringLiteral("?");
}

}  // namespace zv::test

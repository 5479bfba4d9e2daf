#include "util/file_utils.h"

#include <QDir>
#include <QFileInfo>
#include <cerrno>
#include <filesystem>
#include <fstream>
#include <system_error>

#include "util/errors.h"
#include "util/ui.h"

namespace zv {
namespace {

namespace fs = std::filesystem;

const QChar kWinSep = QLatin1Char('\\');
const QString kNoAccess = QStringLiteral("כנראה אין הרשאות גישה למשתמש הנוכחי");

fs::path FsPath(const QString& path) {
    return fs::path(DiskPath(path).toStdU16String());
}

// The runtime's error for a failed file-system call.
VbError FsError(int code) {
    switch (code) {
        case ENOENT:
        case ENOTDIR:
            return MakeError(err::PathNotFound);
        case EACCES:
        case EPERM:
        case EROFS:
        case EBUSY:
            return MakeError(err::PermissionDenied);
        case EEXIST:
            return MakeError(err::FileAlreadyExists);
        default:
            return MakeError(err::PathFileAccess);
    }
}

bool FileExists(const QString& path) {
    const QFileInfo info(DiskPath(path));
    return info.exists() && !info.isDir();
}

bool FolderExists(const QString& path) {
    return QFileInfo(DiskPath(path)).isDir();
}

// A directory search: does any ordinary file match the pattern in the last part of path?
bool PatternMatches(const QString& path) {
    const QString disk = DiskPath(path);
    const qsizetype cut = disk.lastIndexOf(QDir::separator());
    const QString folder = cut < 0 ? QStringLiteral(".") : disk.left(cut + 1);
    const QString pattern = disk.mid(cut + 1);
    return !QDir(folder).entryList({pattern}, QDir::Files).isEmpty();
}

// Writes the line "1" as the suite's marker files hold it.
void WriteMarker(const QString& path) {
    errno = 0;
    std::ofstream out(FsPath(path), std::ios::binary | std::ios::trunc);
    if (!out) {
        throw FsError(errno);
    }
    out << "1\r\n";
    out.close();
    if (!out) {
        throw FsError(errno);
    }
}

void ClearReadOnly(const QString& path) {
    const fs::path p = FsPath(path);
    std::error_code ec;
    const fs::perms perms = fs::status(p, ec).permissions();
    if (!ec && (perms & fs::perms::owner_write) == fs::perms::none) {
        fs::permissions(p, fs::perms::owner_write, fs::perm_options::add, ec);
    }
    if (ec) {
        throw FsError(ec.value());
    }
}

void ForceDelete(const QString& path) {
    std::error_code ec;
    fs::remove(FsPath(path), ec);
    if (ec) {
        throw FsError(ec.value());
    }
}

}  // namespace

VbError FileSystemError(int code) {
    return FsError(code);
}

void MakeFolder(const QString& path) {
    std::error_code ec;
    fs::create_directory(FsPath(path), ec);
    if (ec) {
        throw FsError(ec.value());
    }
}

QString DiskPath(const QString& path) {
    QString disk = path;
    if (QDir::separator() == QLatin1Char('/')) {
        disk.replace(kWinSep, QLatin1Char('/'));
    } else {
        disk.replace(QLatin1Char('/'), kWinSep);
    }
    return disk;
}

bool IsFileExist(const QString& path, bool deleteIfExist, bool createIfMissing) {
    if (path.isEmpty()) {
        return false;
    }
    if (path.contains(QLatin1Char('?')) || path.contains(QLatin1Char('*'))) {
        return PatternMatches(path);
    }
    // Each failure is reported (a denied permission silently) and the next step runs.
    const auto attempt = [&path](const auto& step) {
        try {
            step();
        } catch (const VbError& e) {
            if (e.Number() != err::PermissionDenied) {
                MsgBox(QString::number(e.Number()) + QStringLiteral("-IsFileExist-\r\n") + path +
                       QStringLiteral("\r\n") + e.Description());
            }
        }
    };
    if (!FileExists(path)) {
        if (!createIfMissing) {
            return false;
        }
        attempt([&] { WriteMarker(path); });
        return FileExists(path);
    }
    if (!deleteIfExist) {
        return true;
    }
    attempt([&] { ClearReadOnly(path); });
    attempt([&] { ForceDelete(path); });
    DoEvents();
    return FileExists(path);
}

bool IsFolderExist(const QString& path, bool createIfMissing) {
    if (path.isEmpty()) {
        return false;
    }
    if (createIfMissing && !FolderExists(path)) {
        BuildDirTree(path);
    }
    return FolderExists(path);
}

bool BuildDirTree(const QString& path) {
    if (path.isEmpty()) {
        return false;
    }
    if (FolderExists(path)) {
        return true;
    }
    const auto create = [&path](const QString& folder) {
        try {
            MakeFolder(folder);
        } catch (const VbError& e) {
            MsgBox(QString::number(e.Number()) + QStringLiteral("-BuildDirTree-") +
                   e.Description() + QStringLiteral("\r\n") + path + QStringLiteral("\r\n\r\n") +
                   kNoAccess);
        }
    };
    QString s = path;
    s.replace(QLatin1Char('/'), kWinSep);
    qsizetype from = 0;
    if (s.startsWith(QStringLiteral("\\\\"))) {
        // Skip "\\server\": a server cannot be created.
        from = s.indexOf(kWinSep, 2) + 1;
    } else if (s.startsWith(kWinSep) && QDir::separator() == QLatin1Char('/')) {
        // The root of an absolute path here; a drive letter plays this part on Windows.
        from = 1;
    }
    for (qsizetype p = s.indexOf(kWinSep, from); p >= 1; p = s.indexOf(kWinSep, p + 1)) {
        const QString level = s.left(p + 1);
        if (!IsFolderExist(level)) {
            create(level);
        }
    }
    if (!FolderExists(path)) {
        create(path);
    }
    return FolderExists(path);
}

}  // namespace zv

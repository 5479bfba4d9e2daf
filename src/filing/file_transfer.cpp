#include "filing/file_transfer.h"

#include <QCoreApplication>
#include <atomic>
#include <filesystem>
#include <system_error>

#include "util/errors.h"
#include "util/file_utils.h"

namespace zv {
namespace {

namespace fs = std::filesystem;

fs::path FsPath(const QString& path) {
    return fs::path(DiskPath(path).toStdU16String());
}

// A name beside target that no other copy of this or another process uses.
fs::path PartName(const fs::path& target) {
    static std::atomic<int> counter{0};
    const QString suffix = QStringLiteral(".%1-%2.part")
                               .arg(QCoreApplication::applicationPid())
                               .arg(counter.fetch_add(1));
    fs::path part = target;
    part += suffix.toStdU16String();
    return part;
}

}  // namespace

void CopyFileOver(const QString& source, const QString& target) {
    const fs::path to = FsPath(target);
    const fs::path part = PartName(to);
    std::error_code ec;
    fs::copy_file(FsPath(source), part, fs::copy_options::overwrite_existing, ec);
    if (!ec) {
        fs::rename(part, to, ec);
    }
    if (ec) {
        std::error_code ignored;
        fs::remove(part, ignored);
        // A source that went away is "file not found", as the runtime's FileCopy says; a
        // missing target folder stays "path not found".
        if (ec == std::errc::no_such_file_or_directory && !fs::exists(FsPath(source), ignored)) {
            throw MakeError(err::FileNotFound);
        }
        throw FileSystemError(ec.value());
    }
}

bool IsSameFile(const QString& a, const QString& b) {
    std::error_code ec;
    return fs::equivalent(FsPath(a), FsPath(b), ec);
}

void RemoveFile(const QString& path) {
    std::error_code ec;
    if (!fs::remove(FsPath(path), ec) && !ec) {
        ec = std::make_error_code(std::errc::no_such_file_or_directory);
    }
    if (ec) {
        throw FileSystemError(ec.value());
    }
}

}  // namespace zv

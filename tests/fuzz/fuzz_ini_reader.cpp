// The INI reader on a file of arbitrary bytes. Input: the section on the first line, the
// key on the second, the file's bytes after that.

#include <QFile>
#include <QTemporaryDir>

#include "fuzz_support.h"
#include "util/ini_reader.h"

namespace {

// Removed when the process exits.
QTemporaryDir& Scratch() {
    static QTemporaryDir dir;
    return dir;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return Scratch().isValid() ? 0 : 1;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QByteArray bytes = zv::fuzz::Bytes(data, size);
    const QStringList names = zv::fuzz::Fields(data, size, 3);
    qsizetype body = 0;  // past the second line break, or the end
    for (int line = 0; line < 2 && body < bytes.size(); ++line) {
        const qsizetype nl = bytes.indexOf('\n', body);
        body = nl < 0 ? bytes.size() : nl + 1;
    }

    const QString path = Scratch().filePath(QStringLiteral("MSSQLSetting.INI"));
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate) ||
        file.write(bytes.mid(body)) != bytes.size() - body) {
        zv::fuzz::Fail("the scratch file is written", path);
    }
    file.close();

    const QString value = zv::ReadINI(names.at(0), names.at(1), path);
    if (value.size() > 511) {
        zv::fuzz::Fail("values are cut at 511 characters", value);
    }
    return 0;
}

#include "filing_dialog/file_naming.h"

#include <dirent.h>
#include <sys/stat.h>

#include <QDir>
#include <QFile>
#include <array>
#include <cctype>
#include <cmath>
#include <memory>

#include "data/values.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

bool IsSeparator(QChar c) {
    return c == QLatin1Char('\\') || c == QLatin1Char('/');
}

qsizetype LastSeparator(const QString& path) {
    return std::max(path.lastIndexOf(QLatin1Char('\\')), path.lastIndexOf(QLatin1Char('/')));
}

// The number after the letter in a numbered name ("T12.doc" -> 12): the name up to its last
// dot (the whole name when no dot follows the first character) without its first character,
// rounded to the nearest whole number; anything not numeric counts as 0.
double NumberOf(const QString& name) {
    const qsizetype dot = name.lastIndexOf(QLatin1Char('.'));
    const qsizetype end = dot > 0 ? dot : name.size();
    // The usual name, letter and plain digits, is read here: a folder of numbered files
    // holds many thousands of them.
    if (end > 1 && end <= 16) {
        double n = 0;
        qsizetype i = 1;
        for (; i < end && name[i] >= QLatin1Char('0') && name[i] <= QLatin1Char('9'); ++i) {
            n = n * 10 + (name[i].unicode() - '0');
        }
        if (i == end) {
            return n;
        }
    }
    return std::nearbyint(GetDblFromStr(name.mid(1, end - 1)));
}

bool EndsWithSeparator(const QString& path) {
    return !path.isEmpty() && IsSeparator(path.back());
}

// Whether a listed entry is a file, a link to one included; the listing's own kind is used
// where it has one.
bool IsRegularFile(const QByteArray& dir, const dirent& entry) {
    if (entry.d_type != DT_UNKNOWN && entry.d_type != DT_LNK) {
        return entry.d_type == DT_REG;
    }
    struct stat st {};
    return ::stat((dir + '/' + entry.d_name).constData(), &st) == 0 && S_ISREG(st.st_mode);
}

}  // namespace

QString ForbiddenNameChars() {
    // The request handler fills BadFileChars when it cleans the proposed name; the dialog
    // guards its name box with the same nine characters even before that has happened.
    return BadFileChars().isEmpty() ? QStringLiteral("/\\:*?\"<>|") : BadFileChars();
}

QString ForbiddenNameMessage() {
    return QStringLiteral("אסור לקלוט כחלק משם קובץ את התווים הבאים : ") + ForbiddenNameChars();
}

QString CCpath(const QString& path) {
    if (path.isEmpty()) {
        MsgBox(QStringLiteral("אין הגדרת ספריה לעבודה"), vbCritical);
        return {};
    }
    return EndsWithSeparator(path) ? path : path + QDir::separator();
}

QString TruncateFileName(const QString& path) {
    const qsizetype sep = LastSeparator(path);
    return sep < 0 ? path : path.mid(sep + 1);
}

QString GetNextFileName(const QString& folder, const QString& ext, const QString& letter) {
    if (folder.isEmpty()) {
        return {};
    }
    QString result;
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("GetNextFileName"), e); },
         [&] {
             const QString dir = CCpath(folder);
             BuildDirTree(dir);
             // One pass over the names; the entry kind comes from the directory listing itself,
             // and only names starting with the letter are looked at further.
             const QByteArray diskDir = QFile::encodeName(DiskPath(dir));
             const std::unique_ptr<DIR, int (*)(DIR*)> listing(::opendir(diskDir.constData()),
                                                               &::closedir);
             if (!listing) {
                 if (IsDevelopmentRun()) {
                     MsgBox(QStringLiteral("בעיה בהגדרת אוביקט קריאת נתוני ספריה") +
                                QStringLiteral("\r\n") + dir,
                            vbExclamation);
                 }
                 throw MakeError(err::PathNotFound);
             }
             // A one-character ASCII letter is compared on the raw name, so that only the
             // names that start with it are decoded.
             const char ascii = letter.size() == 1 && letter[0].unicode() < 0x80
                                    ? char(letter[0].toUpper().unicode())
                                    : '\0';
             double max = 0;
             while (const dirent* entry = ::readdir(listing.get())) {
                 if (ascii && std::toupper(static_cast<unsigned char>(entry->d_name[0])) != ascii) {
                     continue;
                 }
                 const QString name = QFile::decodeName(entry->d_name);
                 if (!name.startsWith(letter, Qt::CaseInsensitive)) {
                     continue;
                 }
                 if (!IsRegularFile(diskDir, *entry)) {
                     continue;
                 }
                 max = std::max(max, NumberOf(name));
             }
             result = dir.toUpper() + letter + QString::number(max + 1, 'f', 0);
             if (!ext.isEmpty()) {
                 result += QLatin1Char('.') + ext;
             }
         });
    return result;
}

std::optional<DocType> DocTypeOf(const QString& sourceName) {
    static const std::array<std::pair<const char*, const char*>, 10> table{{{".DOC", "T"},
                                                                            {".XLS", "X"},
                                                                            {".TXT", "N"},
                                                                            {".MSG", "E"},
                                                                            {".HTM", "E"},
                                                                            {".EML", "E"},
                                                                            {".PDF", "S"},
                                                                            {".TIF", "S"},
                                                                            {".PPT", "P"},
                                                                            {".DOCX", "T"}}};
    const QString upper = sourceName.toUpper();
    for (const auto& [dotExt, letter] : table) {
        const QString e = QString::fromLatin1(dotExt);
        if (upper.right(e.size()) == e) {
            return DocType{QString::fromLatin1(letter), e.mid(1)};
        }
    }
    return std::nullopt;
}

std::optional<QString> NumberedName(const QString& defultName, const QString& sourceExt,
                                    const QString& selectedFolder) {
    if (selectedFolder.isEmpty()) {
        return std::nullopt;
    }
    const QString source = defultName + QLatin1Char('.') + sourceExt;
    const QString folder = CCpath(selectedFolder);
    const auto type = DocTypeOf(source);
    const QString proposal =
        type ? GetNextFileName(folder, type->ext, type->letter) : folder + TruncateFileName(source);
    if (proposal.isEmpty()) {
        return std::nullopt;
    }
    const QString name = TruncateFileName(proposal);
    const qsizetype dot = name.lastIndexOf(QLatin1Char('.'));
    return dot < 0 ? name : name.left(dot);
}

}  // namespace zv

#include "filing_dialog/docs_folder.h"

#include <QDir>
#include <QFileInfo>

#include "data/values.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

const QString kTag = QStringLiteral("GetDocsDirByClientTik");

QString DocsRoot() {
    return MainPath() + QStringLiteral("/DOCS");
}

// The folder below DOCS for one choice, or none when the kind fits no rule. The kind is looked
// up inside fixed texts with exact case, so an empty kind fits the first rule.
std::optional<QString> RelativeFolder(const QString& c, const QString& k, int u, const QString& q,
                                      const QString& n) {
    const QString doc = QStringLiteral("DOC") + c;
    if (QStringLiteral("FMR").contains(k)) {
        return doc;
    }
    if (QStringLiteral("S").contains(k)) {
        return QStringLiteral("SPK") + c;
    }
    if (QStringLiteral("L").contains(k)) {
        const QString client = c.isEmpty() ? QString(GetClientNumWidth(), QLatin1Char('0')) : c;
        return QStringLiteral("DOC") + client + QStringLiteral("/L/") +
               QString(n).remove(QLatin1Char('-'));
    }
    if (QStringLiteral("T").contains(k) && u >= 26) {
        return doc + QLatin1Char('/') + QString::number(u) + QLatin1Char('/') + q;
    }
    if (QStringLiteral("NWG").contains(k)) {
        return doc + QLatin1Char('/') + k + QLatin1Char('/') + q;
    }
    if (QStringLiteral("H").contains(k) || QStringLiteral("A").contains(k)) {
        return doc + QLatin1Char('/') + k + QLatin1Char('/') + n;
    }
    return std::nullopt;
}

}  // namespace

int16_t GetClientNumWidth() {
    const bool wide = QFileInfo::exists(DiskPath(MainPath() + QStringLiteral("/LCN7.txt"))) &&
                      VolnaGlobNum() == QStringLiteral("81005");
    return wide ? 7 : 5;
}

QString GetDocsDirByClientTik(const QString& clientNum, const QString& kind, const QString& subKind,
                              const QString& caseNum, const QString& caseCode) {
    QString result;
    Step([](const VbError& e) { return FormatWithLine(kTag, e); },
         [&] {
             if (!QFileInfo(DiskPath(DocsRoot())).isDir()) {
                 BuildDirTree(DocsRoot());
             }
             const auto rel =
                 RelativeFolder(clientNum, kind, GetIntFromStr(subKind), caseNum, caseCode);
             if (!rel) {
                 result = DiskPath(DocsRoot());
                 return;
             }
             const QString folder = DocsRoot() + QLatin1Char('/') + *rel;
             BuildDirTree(folder);
             if (QFileInfo(DiskPath(folder)).isDir()) {
                 result = DiskPath(folder);
             } else if (IsDevelopmentRun()) {
                 MsgBox(QStringLiteral("בעיה בבניית ספריית לקוח/תיק") + QStringLiteral("\r\n") +
                            DiskPath(*rel),
                        vbExclamation);
             }
         });
    return result;
}

}  // namespace zv

#include "startup/main_entry.h"

#include <QDir>

#include "startup/request_text.h"
#include "startup/settings.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

int Refuse(const QString& text) {
    MsgBox(text, vbOKOnly | vbCritical);
    return 1;
}

}  // namespace

int Main(const QString& argumentText, const RequestHandler& handle) {
    const auto format = [](const VbError& e) { return FormatPlain(QStringLiteral("Main"), e); };
    SetIsDevelopmentRun(qgetenv("ZORVANE_DEVELOPMENT_RUN") == "1");
    SetBasicParam();
    if (VolnaGlobNum().isEmpty() || MainPath().isEmpty()) {
        return Refuse(QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה"));
    }
    if (!IsFileExist(MainPath() + QDir::separator() + QStringLiteral("Zorvane.Exe"))) {
        return Refuse(QStringLiteral("ספריית עבודה לא חוקית לעבודה עם התוסף") +
                      QStringLiteral("\r\n") + MainPath());
    }
    const QStringList fields =
        SplitRequest(IsDevelopmentRun() ? DevelopmentRequest() : argumentText);
    if (fields.size() < 3) {
        return Refuse(QStringLiteral("הפעלה לא חוקית של שרות זה"));
    }
    int mode = 0;
    Step(format, [&] { mode = RequestMode(fields.at(0)); });
    QString path = fields.at(1);
    QString name = fields.at(2);
    // A pattern is no file to file: the source would be deleted as a pattern afterwards.
    const bool pattern = path.contains(QLatin1Char('*')) || path.contains(QLatin1Char('?'));
    if (pattern || !IsFileExist(path)) {
        return Refuse(QStringLiteral("קריאה לא תקינה של שרות זה") + QStringLiteral("\r\n") + path);
    }
    Step(format, [&] { handle(mode, path, name); });
    return 0;
}

}  // namespace zv

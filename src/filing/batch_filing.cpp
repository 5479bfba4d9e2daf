#include "filing/batch_filing.h"

#include <QDir>
#include <algorithm>

#include "filing/batch_choice.h"
#include "filing/clean_file_name.h"
#include "filing/filing_request.h"
#include "filing_dialog/code_lists.h"
#include "filing_dialog/docs_folder.h"
#include "filing_dialog/file_naming.h"
#include "startup/backend_selection.h"
#include "util/clock.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

const QString kCrLf = QStringLiteral("\r\n");

void Refuse(const QString& text) {
    MsgBox(text, vbOKOnly | vbCritical);
}

// The code the dialog's list would select: an explicit code must be in the list; the
// default is taken when it is there and otherwise leaves the list without a selection.
bool PickCode(const std::vector<CodeEntry>& list, std::optional<int> given, int fallback,
              std::optional<int>& picked) {
    const int code = given.value_or(fallback);
    const bool listed = std::any_of(list.begin(), list.end(),
                                    [code](const CodeEntry& e) { return e.data == code; });
    picked = listed ? std::optional<int>(code) : std::nullopt;
    return listed || !given;
}

// The document name as the dialog's name box would hold it.
QString DocumentName(const QString& name, const QString& folder, const FilingOptions& o) {
    const QString proposed = CleanFileName(name);
    if (o.number) {
        return NumberedName(proposed, SourceExt(), folder).value_or(proposed);
    }
    return o.name.value_or(proposed);
}

DocDetails Details(const ChoiceLabels& labels, const FilingOptions& o) {
    DocDetails d;
    d.handlers = o.handlers && !o.handlers->isEmpty() ? *o.handlers : MyUserName();
    d.description = o.description;
    d.moreDescription = o.moreDescription;
    d.remark = o.remark;
    d.reminder = o.reminderDate.has_value();
    d.reminderDate = o.reminderDate.value_or(Today());
    d.reminderTime = o.reminderDate ? o.reminderTime : QStringLiteral("08:00");
    d.popup = o.popup;
    d.receivedDate = o.received.value_or(Today());
    d.createdDate = o.created.value_or(Today());
    d.createdUnlocked = o.created.has_value();
    d.clientNumber = labels.lakNum;
    d.kindLetter = labels.lblSug;
    d.subKind = labels.lSugTik;
    d.caseNumber = labels.lTik;
    d.caseCode = labels.lTikNum;
    return d;
}

// The answer the confirmed dialog would give; none, after a message, when the options
// name something that is not there.
std::optional<FilingAnswer> BatchAnswer(int mode, const QString& name, const FilingOptions& o) {
    std::optional<ChoiceLabels> labels = ClientChoice(o.client);
    if (!labels) {
        Refuse(QStringLiteral("לא נמצא לקוח מספר ") + o.client);
        return std::nullopt;
    }
    if (!o.caseNumber.isEmpty() && !AddCaseChoice(*labels, o.caseNumber)) {
        Refuse(QStringLiteral("לא נמצא תיק מספר ") + o.caseNumber +
               QStringLiteral(" בתיקי לקוח מספר ") + o.client);
        return std::nullopt;
    }
    FilingAnswer answer;
    answer.details = Details(*labels, o);
    if (!PickCode(ReadDocOrigins(), o.origin, mode == 1 ? 2 : 1, answer.details.origin)) {
        Refuse(QStringLiteral("לא נמצא מקור מסמך בקוד ") + QString::number(*o.origin));
        return std::nullopt;
    }
    if (!PickCode(ReadDocStatuses(), o.status, 2, answer.details.status)) {
        Refuse(QStringLiteral("לא נמצא סטטוס בקוד ") + QString::number(*o.status));
        return std::nullopt;
    }
    const QString folder = GetDocsDirByClientTik(labels->lakNum, labels->lblSug, labels->lSugTik,
                                                 labels->lTik, labels->lTikNum);
    if (folder.isEmpty()) {
        return std::nullopt;  // GetDocsDirByClientTik has told why
    }
    QString dir = folder;
    if (!o.innerFolder.isEmpty()) {
        if (!ReadInnerFolders().contains(o.innerFolder)) {
            Refuse(QStringLiteral("לא נמצאה ספריה פנימית בשם ") + o.innerFolder);
            return std::nullopt;
        }
        dir += QDir::separator() + o.innerFolder;
    }
    answer.nameText = DocumentName(name, folder, o);
    if (std::any_of(answer.nameText.begin(), answer.nameText.end(),
                    [](QChar c) { return BadFileChars().contains(c); })) {
        Refuse(ForbiddenNameMessage());
        return std::nullopt;
    }
    if (answer.nameText.isEmpty()) {
        Refuse(QStringLiteral("יש לקבוע שם לקובץ הנשמר"));
        return std::nullopt;
    }
    answer.fileNameToSave = CCpath(dir) + answer.nameText;
    return answer;
}

}  // namespace

QString FileWithoutWindow(int mode, const QString& path, const QString& name,
                          const FilingOptions& options) {
    try {
        SetSourceExt(ExtensionOf(path));
        const std::optional<FilingAnswer> answer = BatchAnswer(mode, name, options);
        if (!answer) {
            return {};
        }
        return FileDocument(
            mode, path, name, *answer, [&options](const Clash& clash) -> std::optional<QString> {
                if (options.onClash == OnClash::Overwrite) {
                    return clash.proposed;
                }
                MsgBox(QStringLiteral("קיים קובץ בשם זה, המסמך לא תויק :") + kCrLf + clash.existing,
                       vbOKOnly | vbExclamation);
                return std::nullopt;
            });
    } catch (const std::exception& e) {
        MsgBox(FilingFailureText(AsVbError(e), mode, path, name));
    }
    return {};
}

QString HandleBatchRequest(const CommandLine& cl, int mode, const QString& path,
                           const QString& name) {
    GetMSSQLParam();
    return FileWithoutWindow(mode, path, name, cl.filing);
}

}  // namespace zv

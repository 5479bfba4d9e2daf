#include "filing/work_with_str.h"

#include <QComboBox>
#include <QLineEdit>

#include "dialogs/frm_save_as.h"
#include "filing/clean_file_name.h"
#include "filing/filing_request.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

constexpr int16_t kDocumentSug = 2;

std::optional<QString> AskSaveAs(const Clash& clash) {
    FrmSaveAs saveAs;
    saveAs.SetFileName(clash.proposed);
    if (clash.document) {
        saveAs.SetSug(kDocumentSug);
    }
    ShowModal(saveAs);
    if (saveAs.IsCancel()) {
        return std::nullopt;
    }
    return clash.dir + CleanFileName(saveAs.TxtName().text()).trimmed() + QLatin1Char('.') +
           saveAs.CboEndName().currentText();
}

}  // namespace

QString WorkWithStr(int mode, const QString& path, const QString& name) {
    try {
        SetSourceExt(ExtensionOf(path));
        FrmGetDocDet dialog;
        if (mode == 1) {
            dialog.SetPartOf(2);
            dialog.SetIsCaptureDoc(true);
        } else {
            dialog.SetPartOf(1);
            dialog.SetIsCaptureDoc(false);
            dialog.SetIsCaptureMail(true);
        }
        dialog.SetDefultName(CleanFileName(name));
        ShowModal(dialog);
        if (dialog.IsCancel()) {
            return {};
        }
        FilingAnswer answer;
        answer.fileNameToSave = dialog.FileNameToSave();
        if (answer.fileNameToSave.isEmpty()) {
            return {};
        }
        answer.nameText = dialog.TxtTeurText();
        answer.details = dialog.Details();
        return FileDocument(mode, path, name, answer, AskSaveAs);
    } catch (const std::exception& e) {
        MsgBox(FilingFailureText(AsVbError(e), mode, path, name));
    }
    return {};
}

}  // namespace zv

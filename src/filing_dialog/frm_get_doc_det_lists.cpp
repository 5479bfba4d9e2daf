// The filing dialog's lists, folder view and target name.

#include <QComboBox>
#include <QDir>
#include <QSignalBlocker>

#include "controls/gdate.h"
#include "dialogs/frm_get_users.h"
#include "filing_dialog/code_lists.h"
#include "filing_dialog/docs_folder.h"
#include "filing_dialog/file_naming.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "filing_dialog/name_guard.h"
#include "ui_frm_get_doc_det.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {

void FrmGetDocDet::InitCbo10() {
    // A list that cannot be read is reported once and leaves itself and the lists after it
    // empty.
    for (QComboBox* box :
         {ui_->CboTeur, ui_->CboSecTeur, ui_->CboStatus, ui_->CboPartOf, ui_->CboDocBasic}) {
        box->clear();
    }
    Step([](const VbError& e) { return FormatWithLine(QStringLiteral("InitCbo10"), e); },
         [&] {
             ui_->CboTeur->addItems(ReadOffCodeTexts(20));
             ui_->CboTeur->setCurrentIndex(-1);
             ui_->CboSecTeur->addItems(ReadOffCodeTexts(21));
             ui_->CboSecTeur->setCurrentIndex(-1);
             FillStatuses();
             FillOrigins();
             // Filling the list is no choice of an inner folder.
             const QSignalBlocker quiet(ui_->CboDocBasic);
             ui_->CboDocBasic->addItems(ReadInnerFolders());
             ui_->CboDocBasic->setCurrentIndex(-1);
         });
}

void FrmGetDocDet::FillStatuses() {
    int selected = -1;
    for (const CodeEntry& entry : ReadDocStatuses()) {
        ui_->CboStatus->addItem(entry.text, entry.data);
        if (entry.data == status_) {
            selected = ui_->CboStatus->count() - 1;
        }
    }
    ui_->CboStatus->setCurrentIndex(selected);
}

void FrmGetDocDet::FillOrigins() {
    QComboBox* box = ui_->CboPartOf;
    for (const CodeEntry& entry : ReadDocOrigins()) {
        box->addItem(entry.text, entry.data);
    }
    box->setCurrentIndex(-1);
    if (box->count() == 0) {
        return;
    }
    if (partOf_ < 1) {
        box->setCurrentIndex(0);
        return;
    }
    const int match = box->findData(static_cast<int>(partOf_));
    if (match >= 0) {
        // The origin the caller knows is kept: the list no longer takes the user's choice.
        box->setCurrentIndex(match);
        box->setEnabled(false);
    }
}

void FrmGetDocDet::StartFolderView() {
    ui_->FolderView1->hide();
    const QString mailIn = MainPath() + QStringLiteral("/DOCS/MAILIN");
    if (!IsFolderExist(mailIn)) {
        BuildDirTree(mailIn);
    }
    if (startDir_.isEmpty()) {
        startDir_ = DiskPath(mailIn);
    }
    ui_->FolderView1->SetArchiveRoot(MainPath() + QStringLiteral("/DOCS"));
    ui_->FolderView1->SelectPath(mailIn);
    ui_->FolderView1->SelectPath(startDir_);
}

void FrmGetDocDet::RefreshDocsFolder() {
    const ChoiceLabels l = Labels();
    const QString folder = GetDocsDirByClientTik(l.lakNum, l.lblSug, l.lSugTik, l.lTik, l.lTikNum);
    if (!folder.isEmpty()) {
        ui_->FolderView1->SelectPath(folder);
    }
}

void FrmGetDocDet::SetLDir(const QString& path) {
    if (ui_->LDir->text() == path) {
        return;
    }
    ui_->LDir->setText(path);
    SetFileName();
}

void FrmGetDocDet::SetFileName() {
    if (!isFormReady_) {
        return;
    }
    Step([](const VbError& e) { return FormatPlain(QStringLiteral("SetFileName"), e); },
         [&] {
             const QString name = ui_->TxtTeur->text();
             if (name.isEmpty()) {
                 if (!isFromScan_ && !isCaptureMail_) {
                     MsgBox(QStringLiteral("חובה לקבוע שם למסמך שישמר"), vbOKOnly);
                 }
                 return;
             }
             SetFileNameToSave(DirToSave() + name);
         });
}

void FrmGetDocDet::CmdMPlus_Click() {
    // Numbering counts the folder chosen in the tree, also when an inner folder is chosen.
    const auto name = NumberedName(defultName_, SourceExt(), ui_->FolderView1->SelectedPath());
    if (name) {
        ui_->TxtTeur->setText(*name);
    }
}

void FrmGetDocDet::CboDocBasic_Change() {
    if (ui_->CboDocBasic->currentIndex() >= 0) {
        ui_->Option1_1->setChecked(true);
    }
    SetFileName();
}

void FrmGetDocDet::Option1_Click(int index) {
    QComboBox* box = ui_->CboDocBasic;
    if (index == 1) {
        if (box->currentIndex() < 0 && box->count() > 0) {
            box->setCurrentIndex(0);
        }
    } else {
        box->setCurrentIndex(-1);
    }
}

void FrmGetDocDet::CmdListOpen_Click() {
    FrmGetUsers picker(this);
    picker.SetStartUsers(ui_->LPersonal->text());
    picker.SetWithAllUsers(true);
    ShowModal(picker);
    if (!picker.IsCancel()) {
        ui_->LPersonal->setText(picker.EndUsers());
        if (ui_->LPersonal->text().isEmpty()) {
            ui_->LPersonal->setText(MyUserName());
        }
    }
}

}  // namespace zv

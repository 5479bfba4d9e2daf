#include "filing_dialog/frm_get_doc_det.h"

#include <QDir>
#include <QLineEdit>

#include "controls/gdate.h"
#include "filing_dialog/case_kinds.h"
#include "filing_dialog/file_naming.h"
#include "filing_dialog/name_guard.h"
#include "startup/backend_selection.h"
#include "startup/settings.h"
#include "ui/font_fix.h"
#include "ui_frm_get_doc_det.h"
#include "util/clock.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {

FrmGetDocDet::FrmGetDocDet(QWidget* parent) : QDialog(parent), ui_(new ::Ui::FrmGetDocDet) {
    ui_->setupUi(this);
    setObjectName(QStringLiteral("FrmGetDocDet"));
    ui_->TDate->SetEnabled(false);
    ui_->ChkIsJumpMemo->setEnabled(false);
    ui_->LDir->setTextInteractionFlags(Qt::TextSelectableByMouse);
    new NameGuard(ui_->TxtTeur);
    ConnectEvents();
    // The first step is choosing the client; without this the default button takes the focus.
    ui_->CmdLak->setFocus();
}

FrmGetDocDet::~FrmGetDocDet() = default;

QString FrmGetDocDet::FileNameToSave() {
    const QString value = fileNameToSave_;
    const qsizetype folderLength = value.size() - TruncateFileName(value).size() - 1;
    if (folderLength > 0) {
        BuildDirTree(value.left(folderLength));
    }
    return value;
}

void FrmGetDocDet::SetFileNameToSave(const QString& v) {
    fileNameToSave_ = v;
    ui_->LFileName->setText(v);
}

QString FrmGetDocDet::DirToSave() const {
    QString path = ui_->FolderView1->SelectedPath();
    if (ui_->Option1_1->isChecked() && !ui_->CboDocBasic->currentText().isEmpty()) {
        path += QDir::separator() + ui_->CboDocBasic->currentText();
    }
    return CCpath(path);
}

void FrmGetDocDet::Load() {
    if (loaded_) {
        return;
    }
    loaded_ = true;
    LoadSteps();
}

void FrmGetDocDet::setVisible(bool visible) {
    if (visible && !loaded_) {
        Load();
    }
    QDialog::setVisible(visible);
}

void FrmGetDocDet::reject() {
    isCancel_ = true;
    QDialog::reject();
}

void FrmGetDocDet::LoadSteps() {
    const ErrorFormatter report = [](const VbError& e) {
        return FormatWithLine(QStringLiteral("Load"), e);
    };
    Step(report, [&] { FixControlsFontOnMe(*this); });
    Step(report, [&] {
        SetIsDevelopmentRun(qgetenv("ZORVANE_DEVELOPMENT_RUN") == "1");
        SetBasicParam();
    });
    Step(report, [&] {
        ui_->TDateMemo->SetValue(Today());
        ui_->TDateRecieved->SetValue(Today());
        ui_->TDate->SetValue(Today());
    });
    Step(report, [&] { SetOptKeyLakTik(); });
    if (VolnaGlobNum().isEmpty() || MainPath().isEmpty()) {
        MsgBox(QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה"), vbCritical);
        return;
    }
    Step(report, [&] {
        for (const char* key : {"LNUM", "ANUM", "BNUM", "DNUM", "TNUM"}) {
            if (!UserCode().isEmpty()) {
                break;
            }
            SetUserCode(ReadSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                                    QString::fromLatin1(key), QString()));
        }
    });
    Step(report, [&] { GetMSSQLParam(); });
    Step(report, [&] {
        if (IsFileExist(MainPath() + QStringLiteral("/GDetDef/LB81.") + MyUser())) {
            for (QWidget* w : findChildren<QWidget*>()) {
                SetMedFont(*w);
            }
        }
    });
    Step(report, [&] {
        ui_->LblSug->setVisible(IsDevelopmentRun());
        ui_->LSugTik->setVisible(IsDevelopmentRun());
    });
    Step(report, [&] {
        isCancel_ = false;
        if (status_ == 0) {
            status_ = 2;
        }
    });
    Step(report, [&] { InitCbo10(); });
    Step(report, [&] { StartFolderView(); });
    Step(report, [&] { ui_->TDBTime1->setText(QStringLiteral("08:00")); });
    Step(report, [&] {
        if (!defaultMetapel_.isEmpty()) {
            ui_->LPersonal->setText(defaultMetapel_);
        } else if (ui_->LPersonal->text().isEmpty()) {
            ui_->LPersonal->setText(MyUserName());
        }
    });
    Step(report, [&] {
        // The whole proposed name is selected, so typing replaces it.
        ui_->TxtTeur->setText(defultName_);
        ui_->TxtTeur->selectAll();
    });
    Step(report, [&] {
        isFormReady_ = true;
        SetFileName();
    });
    Step(report, [&] {
        ui_->LGlobalNum->setText(VolnaGlobNum() + QLatin1Char('/') + UserCode() + QLatin1Char('/') +
                                 MyUser());
    });
}

QString FrmGetDocDet::TxtTeurText() const {
    return ui_->TxtTeur->text();
}

DocDetails FrmGetDocDet::Details() const {
    DocDetails d;
    d.handlers = ui_->LPersonal->text();
    d.description = ui_->CboTeur->currentText();
    d.moreDescription = ui_->CboSecTeur->currentText();
    d.remark = ui_->TxtRemark->text();
    d.reminder = ui_->ChkIsMemo->isChecked();
    d.reminderDate = ui_->TDateMemo->date();
    d.reminderTime = ui_->TDBTime1->text();
    d.popup = ui_->ChkIsJumpMemo->isChecked();
    d.receivedDate = ui_->TDateRecieved->date();
    d.createdDate = ui_->TDate->date();
    d.createdUnlocked = ui_->TDate->Enabled();
    if (ui_->CboPartOf->currentIndex() >= 0) {
        d.origin = ui_->CboPartOf->currentData().toInt();
    }
    if (ui_->CboStatus->currentIndex() >= 0) {
        d.status = ui_->CboStatus->currentData().toInt();
    }
    d.clientNumber = ui_->LakNum->text();
    d.kindLetter = ui_->LblSug->text();
    d.subKind = ui_->LSugTik->text();
    d.caseNumber = ui_->LTik->text();
    d.caseCode = ui_->LTikNum->text();
    return d;
}

}  // namespace zv

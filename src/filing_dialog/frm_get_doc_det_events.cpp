// The filing dialog's buttons, field events and input filters.

#include <QKeyEvent>
#include <QLineEdit>

#include "controls/gdate.h"
#include "dialogs/frm_get_password.h"
#include "filing_dialog/file_naming.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "filing_dialog/name_guard.h"
#include "ui_frm_get_doc_det.h"
#include "util/clock.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/keyboard_layout.h"
#include "util/state.h"
#include "util/ui.h"

namespace zv {
namespace {

const QString kDateChars = QStringLiteral("0123456789:/.-");
const QString kTimeChars = QStringLiteral("0123456789:");

// Whether a typed character passes a filter. Enter, Tab and Escape belong to the dialog and
// control characters of shortcuts (Ctrl+C) are no input; Backspace is filtered like any
// character.
bool Passes(QChar c, const QString& allowed) {
    const ushort code = c.unicode();
    if (code < 32 && code != 8) {
        return true;
    }
    return allowed.contains(c);
}

}  // namespace

void FrmGetDocDet::ConnectEvents() {
    connect(ui_->CmdLak, &QPushButton::clicked, this, [this] { Choose(&ChooseClient); });
    connect(ui_->CmdTik, &QPushButton::clicked, this, [this] { Choose(&ChooseClientCase); });
    connect(ui_->CmdGetTikByName, &QPushButton::clicked, this,
            [this] { Choose(&ChooseCaseByName); });
    connect(ui_->CmdMPlus, &QPushButton::clicked, this, [this] { CmdMPlus_Click(); });
    connect(ui_->CmdListOpen, &QPushButton::clicked, this, [this] { CmdListOpen_Click(); });
    connect(ui_->CmdOK, &QPushButton::clicked, this, [this] { CmdOK_Click(); });
    connect(ui_->Command3, &QPushButton::clicked, this, [this] { Command3_Click(); });
    connect(ui_->CmdNow, &QPushButton::clicked, this, [this](bool on) { CmdNow_Click(on); });
    connect(ui_->ChkIsMemo, &QCheckBox::clicked, this, [this] { ChkIsMemo_Click(); });
    connect(ui_->Option1_0, &QRadioButton::clicked, this, [this] { Option1_Click(0); });
    connect(ui_->Option1_1, &QRadioButton::clicked, this, [this] { Option1_Click(1); });
    connect(ui_->CboDocBasic, &QComboBox::currentIndexChanged, this,
            [this] { CboDocBasic_Change(); });
    connect(ui_->CboDocBasic, &QComboBox::activated, this, [this] { CboDocBasic_Change(); });
    connect(ui_->FolderView1, &FolderView::FolderSelected, this,
            [this](const QString& path) { SetLDir(path); });
    connect(ui_->TxtTeur, &QLineEdit::textChanged, this, [this](const QString& text) {
        // A refused paste or drop is put back by the name guard at once.
        if (!std::any_of(text.begin(), text.end(),
                         [](QChar c) { return ForbiddenNameChars().contains(c); })) {
            SetFileName();
        }
    });
    for (GDate* date : {ui_->TDate, ui_->TDateMemo, ui_->TDateRecieved}) {
        connect(date, &GDate::KeyPress, this,
                [this](int16_t& keyAscii) { DateKeyPress(keyAscii); });
    }
    ui_->TDBTime1->installEventFilter(this);
    ui_->TxtTeur->installEventFilter(this);
    ui_->TxtRemark->installEventFilter(this);
}

bool FrmGetDocDet::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::FocusIn &&
        (watched == ui_->TxtTeur || watched == ui_->TxtRemark)) {
        SetKbHebrew(true);
    }
    if (event->type() == QEvent::KeyPress && watched == ui_->TDBTime1) {
        const QString typed = static_cast<QKeyEvent*>(event)->text();
        if (typed.size() == 1 && !Passes(typed.front(), kTimeChars)) {
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

void FrmGetDocDet::DateKeyPress(int16_t& keyAscii) {
    if (keyAscii != 0 && !Passes(QChar(static_cast<ushort>(keyAscii)), kDateChars)) {
        keyAscii = 0;
    }
}

ChoiceLabels FrmGetDocDet::Labels() const {
    return {ui_->LakNum->text(),      ui_->LakName->text(), ui_->LblSug->text(),
            ui_->LSugTik->text(),     ui_->LTik->text(),    ui_->LTikNum->text(),
            ui_->LTeurSugTik->text(), ui_->LTeurTik->text()};
}

void FrmGetDocDet::SetLabels(const ChoiceLabels& l) {
    const bool clientChanged = ui_->LakNum->text() != l.lakNum;
    ui_->LakNum->setText(l.lakNum);
    if (clientChanged) {
        ui_->FolderView1->show();
    }
    ui_->LakName->setText(l.lakName);
    ui_->LblSug->setText(l.lblSug);
    ui_->LSugTik->setText(l.lSugTik);
    ui_->LTik->setText(l.lTik);
    ui_->LTikNum->setText(l.lTikNum);
    ui_->LTeurSugTik->setText(l.lTeurSugTik);
    ui_->LTeurTik->setText(l.lTeurTik);
}

void FrmGetDocDet::Choose(bool (*choose)(ChoiceLabels&)) {
    ChoiceLabels labels = Labels();
    if (choose(labels)) {
        SetLabels(labels);
        RefreshDocsFolder();
    }
}

void FrmGetDocDet::CmdOK_Click() {
    Step(
        [](const VbError& e) {
            return QString::number(e.Number()) + QStringLiteral("--") + e.Description();
        },
        [&] {
            if (ui_->LakNum->text().isEmpty()) {
                MsgBox(QStringLiteral("חובה לבחור לקוח / תיק רלוונטים לתיוק המסמך"), vbCritical);
                return;
            }
            const QString path = FileNameToSave();
            if (path.isEmpty()) {
                MsgBox(QStringLiteral("יש לקבוע שם לקובץ הנשמר"), vbCritical);
                return;
            }
            if (IsFileExist(path)) {
                const int answer = MsgBox(QStringLiteral("קיים קובץ בשם זה האם לשכתבו : ") +
                                              QStringLiteral("\r\n") + path,
                                          vbQuestion | vbYesNo | vbDefaultButton2);
                if (answer == vbNo) {
                    return;
                }
            }
            accept();
        });
}

bool FrmGetDocDet::GetPassword(const QString& prompt, const QString& mask, QString& text) {
    FrmGetPassword prompter(this);
    prompter.SetTeur(prompt);
    prompter.SetPassChar(mask);
    ShowModal(prompter);
    if (prompter.IsCancel()) {
        text.clear();
        return false;
    }
    text = prompter.Text1().text();
    return true;
}

void FrmGetDocDet::Command3_Click() {
    QString code;
    if (!GetPassword(QStringLiteral("קלוט סיסמא לשינוי תאריך היצירה"), QStringLiteral("*"), code)) {
        return;
    }
    if (code.toUpper() == QStringLiteral("5382")) {
        ui_->TDate->SetEnabled(true);
        MsgBox(QStringLiteral("ניתן כעת לערוך את תאריך יצירה ולשמור"), vbExclamation);
    }
}

void FrmGetDocDet::CmdNow_Click(bool checked) {
    if (!checked) {
        return;
    }
    ui_->CmdNow->setChecked(false);
    ui_->TDBTime1->setText(Now().toString(QStringLiteral("HH:mm")));
}

void FrmGetDocDet::ChkIsMemo_Click() {
    ui_->ChkIsJumpMemo->setEnabled(ui_->ChkIsMemo->isChecked());
}

}  // namespace zv

#pragma once
// FrmGetDocDet: the filing dialog. The request handler presets a few properties, shows it
// modally and reads it back: IsCancel, FileNameToSave and, at confirmation, Details().
// Confirming hides the dialog; closing it (close box, Escape) cancels.

#include <QDialog>
#include <QString>
#include <cstdint>
#include <memory>

#include "archive/doc_details.h"
#include "selection/choice.h"

namespace Ui {
class FrmGetDocDet;
}

namespace zv {

class FrmGetDocDet : public QDialog {
    Q_OBJECT

  public:
    explicit FrmGetDocDet(QWidget* parent = nullptr);
    ~FrmGetDocDet() override;

    // Status code (DOCSTATUS ID) to preselect; 0 at load becomes 2.
    int16_t Status() const { return status_; }
    void SetStatus(int16_t v) { status_ = v; }
    // Origin code to preselect; below 1 selects the first origin.
    int16_t PartOf() const { return partOf_; }
    void SetPartOf(int16_t v) { partOf_ = v; }
    bool IsCaptureDoc() const { return isCaptureDoc_; }
    void SetIsCaptureDoc(bool v) { isCaptureDoc_ = v; }
    // Either flag accepts an empty document name without asking for one.
    bool IsCaptureMail() const { return isCaptureMail_; }
    void SetIsCaptureMail(bool v) { isCaptureMail_ = v; }
    bool IsFromScan() const { return isFromScan_; }
    void SetIsFromScan(bool v) { isFromScan_ = v; }
    // Folder the folder view opens on; empty at load becomes MainPath/DOCS/MAILIN.
    const QString& StartDir() const { return startDir_; }
    void SetStartDir(const QString& v) { startDir_ = v; }
    // Proposed document name, without extension, already cleaned.
    const QString& DefultName() const { return defultName_; }
    void SetDefultName(const QString& v) { defultName_ = v; }
    // Handler name(s) shown at load; empty shows the current user's name.
    const QString& DefaultMetapel() const { return defaultMetapel_; }
    void SetDefaultMetapel(const QString& v) { defaultMetapel_ = v; }
    // True once the dialog was closed without confirming.
    bool IsCancel() const { return isCancel_; }

    // Full path of the target file without extension. Reading it creates the folders of the
    // path first, so the caller can copy into it at once.
    QString FileNameToSave();
    void SetFileNameToSave(const QString& v);
    // The target folder, with a trailing separator.
    QString DirToSave() const;
    // Asks for one line of text behind a mask; false (and an empty text) when cancelled.
    bool GetPassword(const QString& prompt, const QString& mask, QString& text);
    // Moves the folder view to the folder of the chosen client or case.
    void RefreshDocsFolder();
    // The confirmed dialog as a value, for the archive.
    DocDetails Details() const;
    // The document name typed in TxtTeur (a mail's file name).
    QString TxtTeurText() const;

    // The load steps; they run once, when the dialog is first shown or on this call.
    void Load();
    void setVisible(bool visible) override;
    // Closing without confirming: close box, Escape.
    void reject() override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    // Load and lists
    void LoadSteps();
    void InitCbo10();
    void FillStatuses();
    void FillOrigins();
    void StartFolderView();
    // Naming
    void SetFileName();
    void SetLDir(const QString& path);
    void CmdMPlus_Click();
    void CboDocBasic_Change();
    void Option1_Click(int index);
    // Selection labels
    ChoiceLabels Labels() const;
    void SetLabels(const ChoiceLabels& labels);
    void Choose(bool (*choose)(ChoiceLabels&));
    // Buttons and fields
    void CmdListOpen_Click();
    void CmdOK_Click();
    void Command3_Click();
    void CmdNow_Click(bool checked);
    void ChkIsMemo_Click();
    void DateKeyPress(int16_t& keyAscii);
    void ConnectEvents();

    std::unique_ptr<::Ui::FrmGetDocDet> ui_;
    int16_t status_ = 0;
    int16_t partOf_ = 0;
    bool isCaptureDoc_ = false;
    bool isCaptureMail_ = false;
    bool isFromScan_ = false;
    QString startDir_;
    QString defultName_;
    QString defaultMetapel_;
    bool isCancel_ = false;
    QString fileNameToSave_;
    bool isFormReady_ = false;
    bool loaded_ = false;
};

}  // namespace zv

#pragma once
// Shown when the file to be written exists already (and to confirm a mail's name): the
// target folder, an editable name and the extension. The caller builds the path from
// TxtName and CboEndName when IsCancel is false, and does the copying.

#include <QStringList>
#include <cstdint>
#include <memory>

#include "ui/picker_dialog.h"

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace Ui {
class FrmSaveAs;
}

namespace zv {

class FrmSaveAs : public PickerDialog {
    Q_OBJECT

  public:
    explicit FrmSaveAs(QWidget* parent = nullptr);
    ~FrmSaveAs() override;

    // The full path proposed by the caller: folder, name and extension.
    const QString& FileName() const { return fileName_; }
    void SetFileName(const QString& v) { fileName_ = v; }
    // 2 for a document, anything else for a mail item.
    int16_t Sug() const { return sug_; }
    void SetSug(int16_t v) { sug_ = v; }

    // The extensions offered for a document whose source has the extension sourceExt.
    static QStringList DocumentExtensions(const QString& sourceExt);

    QLabel& LDir() const;
    QLineEdit& TxtName() const;
    QComboBox& CboEndName() const;
    QPushButton& CmdSave() const;
    QPushButton& CmdCancel() const;

  private:
    void Load() override;
    void Confirm();

    std::unique_ptr<::Ui::FrmSaveAs> ui_;
    QString fileName_;
    int16_t sug_ = 0;
};

}  // namespace zv

#include "dialogs/frm_save_as.h"

#include "ui/font_fix.h"
#include "ui_frm_save_as.h"
#include "util/state.h"

namespace zv {
namespace {

constexpr int16_t kDocument = 2;

// Position of the last folder separator; the caller's paths may use either kind.
qsizetype LastSeparator(const QString& path) {
    return qMax(path.lastIndexOf(u'\\'), path.lastIndexOf(u'/'));
}

}  // namespace

FrmSaveAs::FrmSaveAs(QWidget* parent)
    : PickerDialog(parent), ui_(std::make_unique<::Ui::FrmSaveAs>()) {
    ui_->setupUi(this);
    connect(ui_->CmdSave, &QPushButton::clicked, this, &FrmSaveAs::Confirm);
    connect(ui_->CmdCancel, &QPushButton::clicked, this, &FrmSaveAs::reject);
}

FrmSaveAs::~FrmSaveAs() = default;

QLabel& FrmSaveAs::LDir() const {
    return *ui_->LDir;
}
QLineEdit& FrmSaveAs::TxtName() const {
    return *ui_->TxtName;
}
QComboBox& FrmSaveAs::CboEndName() const {
    return *ui_->CboEndName;
}
QPushButton& FrmSaveAs::CmdSave() const {
    return *ui_->CmdSave;
}
QPushButton& FrmSaveAs::CmdCancel() const {
    return *ui_->CmdCancel;
}

QStringList FrmSaveAs::DocumentExtensions(const QString& sourceExt) {
    QStringList list;
    // A PDF or a spreadsheet keeps its own type unless the user picks another.
    if (!sourceExt.isEmpty() && sourceExt.compare(QLatin1String("doc"), Qt::CaseInsensitive) != 0 &&
        sourceExt.compare(QLatin1String("docx"), Qt::CaseInsensitive) != 0) {
        list << sourceExt;
    }
    list << QStringLiteral("Doc") << QStringLiteral("Docx");
    return list;
}

void FrmSaveAs::Load() {
    FixControlsFontOnMe(*this);
    const qsizetype cut = LastSeparator(fileName_);
    ui_->LDir->setText(fileName_.left(cut + 1));
    QString name = fileName_.mid(cut + 1);
    const qsizetype dot = name.lastIndexOf(u'.');
    if (dot >= 0) {
        name.truncate(dot);
    }
    ui_->TxtName->setText(name);
    if (sug_ == kDocument) {
        ui_->CboEndName->clear();
        ui_->CboEndName->addItems(DocumentExtensions(SourceExt()));
    }
    ui_->CboEndName->setCurrentIndex(0);
    ui_->TxtName->setFocus();
}

void FrmSaveAs::Confirm() {
    HideConfirmed();
}

}  // namespace zv

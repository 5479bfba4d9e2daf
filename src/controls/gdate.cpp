#include "controls/gdate.h"

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QResizeEvent>
#include <cmath>

#include "controls/date_box.h"
#include "controls/gdate_layout.h"
#include "controls/twips.h"
#include "data/jet_functions.h"
#include "ui/font_fix.h"
#include "util/clock.h"
#include "util/errors.h"
#include "util/ui.h"

namespace zv {
namespace {

constexpr long kInvalidPropertyValue = 380;

// Day numbers count from the platform's zero date.
QDate FromDayNumber(double n) {
    return QDate(1899, 12, 30).addDays(static_cast<qint64>(std::floor(n)));
}

bool IsNumber(const QVariant& v) {
    switch (v.typeId()) {
        case QMetaType::Int:
        case QMetaType::UInt:
        case QMetaType::Short:
        case QMetaType::UShort:
        case QMetaType::Long:
        case QMetaType::ULong:
        case QMetaType::LongLong:
        case QMetaType::ULongLong:
        case QMetaType::Double:
        case QMetaType::Float:
            return true;
        default:
            return false;
    }
}

}  // namespace

GDate::GDate(QWidget* parent) : QFrame(parent), box_(new DateBox(this)) {
    auto* now = new QPushButton(this);
    now_ = now;
    box_->setObjectName(QStringLiteral("TDBDate1"));
    now->setObjectName(QStringLiteral("CmdNow"));
    // Pressed, it resets itself and puts today's date: a button that never stays down.
    now->setCheckable(true);
    now->setFocusPolicy(Qt::NoFocus);
    now->setToolTip(QStringLiteral("הצב תאריך היום"));
    now->setText(QStringLiteral("ה"));
    QFont nowFont = now->font();
    nowFont.setFamily(QStringLiteral("Microsoft Sans Serif"));
    now->setFont(nowFont);
    setFocusProxy(box_);
    setFocusPolicy(Qt::StrongFocus);
    setFrameShape(QFrame::NoFrame);
    box_->SetText(QString());

    connect(box_, &DateBox::Invalid, this, &GDate::ReportInvalid);
    connect(box_, &DateBox::InvalidInput, this, &GDate::InvalidInput);
    connect(box_, &DateBox::Change, this, &GDate::Change);
    connect(box_, &DateBox::Click, this, &GDate::Click);
    connect(box_, &DateBox::DblClick, this, &GDate::DblClick);
    connect(box_, &DateBox::KeyDown, this, &GDate::KeyDown);
    connect(box_, &DateBox::KeyPress, this, &GDate::KeyPress);
    connect(box_, &DateBox::KeyUp, this, &GDate::KeyUp);
    connect(box_, &DateBox::MouseDown, this, &GDate::MouseDown);
    connect(box_, &DateBox::MouseMove, this, &GDate::MouseMove);
    connect(box_, &DateBox::MouseUp, this, &GDate::MouseUp);
    connect(now_, &QAbstractButton::clicked, this, &GDate::OnNowClicked);
    LayOut();
}

GDate::~GDate() = default;

QColor GDate::BackColor() const {
    return box_->Edit().palette().color(QPalette::Base);
}

void GDate::SetBackColor(const QColor& c) {
    QPalette p = box_->Edit().palette();
    p.setColor(QPalette::Base, c);
    box_->Edit().setPalette(p);
    emit PropertyChanged(QStringLiteral("BackColor"));
}

QColor GDate::ForeColor() const {
    return box_->Edit().palette().color(QPalette::Text);
}

void GDate::SetForeColor(const QColor& c) {
    QPalette p = box_->Edit().palette();
    p.setColor(QPalette::Text, c);
    box_->Edit().setPalette(p);
    emit PropertyChanged(QStringLiteral("ForeColor"));
}

bool GDate::Enabled() const {
    return box_->isEnabledTo(this);
}

void GDate::SetEnabled(bool on) {
    box_->setEnabled(on);
    now_->setEnabled(on);
    emit PropertyChanged(QStringLiteral("Enabled"));
}

QFont GDate::Font() const {
    return box_->font();
}

void GDate::SetFont(const QFont& f) {
    box_->setFont(f);
    emit PropertyChanged(QStringLiteral("Font"));
}

int GDate::BackStyle() const {
    return backStyle_;
}

void GDate::SetBackStyle(int v) {
    backStyle_ = v;
    setAutoFillBackground(v == 1);
    emit PropertyChanged(QStringLiteral("BackStyle"));
}

int GDate::BorderStyle() const {
    return borderStyle_;
}

void GDate::SetBorderStyle(int v) {
    borderStyle_ = v;
    setFrameShape(v == 0 ? QFrame::NoFrame : QFrame::Box);
    LayOut();
    emit PropertyChanged(QStringLiteral("BorderStyle"));
}

QString GDate::Text() const {
    return box_->Text();
}

void GDate::SetText(const QString& text) {
    box_->SetText(text);
    emit PropertyChanged(QStringLiteral("Text"));
}

QVariant GDate::Value() const {
    const QDate d = box_->CurrentDate();
    return d.isValid() ? QVariant(d) : QVariant(0);
}

void GDate::SetValue(const QVariant& v) {
    if (v.isNull() || JetVal(v.toString()) == 0) {
        box_->SetDate({});
    } else {
        QDate d;
        if (v.typeId() == QMetaType::QDate) {
            d = v.toDate();
        } else if (v.typeId() == QMetaType::QDateTime) {
            d = v.toDateTime().date();
        } else if (IsNumber(v)) {
            d = FromDayNumber(v.toDouble());
        } else {
            const QString text = v.toString().trimmed();
            d = box_->Parse(text);
            if (!d.isValid()) {
                d = QDate::fromString(text.left(10), Qt::ISODate);
            }
        }
        if (!d.isValid() || d < MinDate() || d > MaxDate()) {
            throw VbError(kInvalidPropertyValue, QStringLiteral("Invalid property value"),
                          objectName());
        }
        box_->SetDate(d);
    }
    emit PropertyChanged(QStringLiteral("Value"));
}

QDate GDate::date() const {
    return box_->CurrentDate();
}

QString GDate::Format() const {
    return box_->Format();
}

void GDate::SetFormat(const QString& f) {
    box_->SetFormat(f);
    emit PropertyChanged(QStringLiteral("Format"));
}

bool GDate::Locked() const {
    return box_->ReadOnly();
}

void GDate::SetLocked(bool on) {
    box_->SetReadOnly(on);
    now_->setEnabled(!on);
    emit PropertyChanged(QStringLiteral("Locked"));
}

QString GDate::DataField() const {
    return dataField_;
}

void GDate::SetDataField(const QString& f) {
    dataField_ = f;
    emit PropertyChanged(QStringLiteral("DataField"));
}

bool GDate::DontSelData() const {
    return dontSelData_;
}

void GDate::SetDontSelData(bool on) {
    dontSelData_ = on;
    box_->SetSelectOnEntry(!on);
    emit PropertyChanged(QStringLiteral("DontSelData"));
}

bool GDate::HideNow() const {
    return hideNow_;
}

void GDate::SetHideNow(bool on) {
    hideNow_ = on;
    now_->setVisible(!on);
    LayOut();
    emit PropertyChanged(QStringLiteral("HideNow"));
}

int GDate::Appearance() const {
    return box_->Appearance();
}

void GDate::SetAppearance(int v) {
    box_->SetAppearance(v);
    emit PropertyChanged(QStringLiteral("Appearance"));
}

DateDropDown GDate::DropDown() const {
    return box_->DropDown();
}

void GDate::SetDropDown(const DateDropDown& d) {
    box_->SetDropDown(d);
    emit PropertyChanged(QStringLiteral("DropDown"));
}

DateSpin GDate::Spin() const {
    return box_->Spin();
}

void GDate::SetSpin(const DateSpin& s) {
    box_->SetSpin(s);
    emit PropertyChanged(QStringLiteral("Spin"));
}

int GDate::AlignHorizontal() const {
    return box_->AlignHorizontal();
}

void GDate::SetAlignHorizontal(int v) {
    box_->SetAlignHorizontal(v);
    emit PropertyChanged(QStringLiteral("AlignHorizontal"));
}

QString GDate::Version() const {
    return QStringLiteral(ZV_VERSION);
}

QString GDate::Caption() const {
    return caption_;
}

void GDate::SetCaption(const QString& c) {
    caption_ = c;
    box_->SetCaptionText(c);
    emit PropertyChanged(QStringLiteral("Caption"));
}

int16_t GDate::Ratio() const {
    return ratio_;
}

void GDate::SetRatio(int16_t r) {
    ratio_ = r;
    box_->setGeometry(contentsRect());
    ApplyCaptionWidth();
    emit PropertyChanged(QStringLiteral("Ratio"));
}

void GDate::Refresh() {
    box_->update();
}

QSize GDate::sizeHint() const {
    const QMargins m = contentsMargins();
    return box_->sizeHint().grownBy(m);
}

QSize GDate::minimumSizeHint() const {
    return sizeHint();
}

void GDate::resizeEvent(QResizeEvent* e) {
    QFrame::resizeEvent(e);
    LayOut();
}

// The first show stands for the moment the properties have been read: the fixed settings
// are applied once more and the children get the window font fix.
void GDate::showEvent(QShowEvent* e) {
    QFrame::showEvent(e);
    if (shown_) {
        return;
    }
    shown_ = true;
    now_->setVisible(!hideNow_);
    box_->SetAppearance(1);
    ApplyCaptionWidth();
    box_->SetCaptionText(caption_);
    FixControlCharset(*box_);
    FixControlCharset(*now_);
}

void GDate::LayOut() {
    const QRect inner = contentsRect();
    box_->setGeometry(inner);
    if (!hideNow_) {
        const QRect t = NowButtonTwips(PixelsToTwips(inner.height()));
        now_->setGeometry(inner.x() + TwipsToPixels(t.x()), inner.y() + TwipsToPixels(t.y()),
                          TwipsToPixels(t.width()), TwipsToPixels(t.height()));
        now_->raise();
    }
    box_->SetLeftReserve(hideNow_ ? 0 : now_->geometry().right() - inner.x() + 1);
    box_->SetAppearance(1);
    // Owners size the box by layouts, after its properties are set: the caption keeps its
    // share of the width.
    ApplyCaptionWidth();
}

void GDate::ApplyCaptionWidth() {
    box_->SetCaptionWidth(CaptionWidthPixels(ratio_, PixelsToTwips(contentsRect().width())));
}

void GDate::OnNowClicked(bool checked) {
    if (!checked) {
        return;
    }
    now_->setChecked(false);
    if (!Locked()) {
        box_->SetDate(Today());
    }
}

void GDate::ReportInvalid(bool outOfRange) {
    const QString text = box_->Text();
    bool restore = true;
    if (outOfRange) {
        MsgBox(QStringLiteral("קליטה של ערך לא מחוץ לטווח תאריכים 01-01-1900 >-< 31-12-2099 ") +
                   QStringLiteral("\r\n") + QStringLiteral("נעשה נסיון לקלוט תאריך : ") + text,
               vbExclamation, AppTitle());
        emit InvalidRange(restore);
    } else {
        MsgBox(QStringLiteral("קליטה של ערך לא חוקי לתאריך : ") + text, vbExclamation, AppTitle());
        emit InvalidValue(restore);
    }
    if (restore) {
        box_->Restore();
    }
}

}  // namespace zv

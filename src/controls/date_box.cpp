#include "controls/date_box.h"

#include <QCalendarWidget>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QTimer>
#include <QToolButton>
#include <QVBoxLayout>

#include "controls/twips.h"
#include "controls/vb_keys.h"
#include "util/clock.h"

namespace zv {
namespace {

constexpr int kDropWidth = 16;
constexpr int kSpinWidth = 14;

bool HasDigit(const QString& text) {
    for (const QChar c : text) {
        if (c.isDigit()) {
            return true;
        }
    }
    return false;
}

bool InRange(const QDate& d) {
    return d.isValid() && d >= GDate::MinDate() && d <= GDate::MaxDate();
}

// Input mask of a format: every d, m and y is a required digit, everything else a literal.
QString MaskOf(const QString& vbFormat) {
    static const QString meta = QStringLiteral("AaNnXx90Dd#HhBb><!{}[]\\;");
    QString mask;
    for (const QChar c : vbFormat) {
        const QChar lower = c.toLower();
        if (lower == u'd' || lower == u'm' || lower == u'y') {
            mask += u'9';
        } else {
            if (meta.contains(c)) {
                mask += u'\\';
            }
            mask += c;
        }
    }
    return mask + QStringLiteral(";_");
}

// Qt spells months with capitals; minutes do not occur in a date format.
QString QtFormatOf(const QString& vbFormat) {
    QString f = vbFormat;
    f.replace(QStringLiteral("mm"), QStringLiteral("MM"), Qt::CaseInsensitive);
    f.replace(QStringLiteral("DD"), QStringLiteral("dd"));
    f.replace(QStringLiteral("YYYY"), QStringLiteral("yyyy"));
    return f;
}

}  // namespace

class DateBox::Editor : public QLineEdit {
  public:
    explicit Editor(DateBox* box) : QLineEdit(box), box_(box) {}

  protected:
    void keyPressEvent(QKeyEvent* e) override {
        const int16_t original = VbKeyCode(e->key());
        int16_t code = original;
        int16_t shift = VbShift(e->modifiers());
        emit box_->KeyDown(code, shift);
        if (original != 0 && code == 0) {
            e->accept();
            return;
        }
        switch (e->key()) {
            case Qt::Key_F2:
                if (!isReadOnly()) {
                    box_->SetDate({});
                }
                return;
            case Qt::Key_F3:
                if (!isReadOnly()) {
                    box_->SetDate(Today());
                }
                return;
            case Qt::Key_F4:
                box_->PopUp();
                return;
            case Qt::Key_Return:
            case Qt::Key_Enter:
                // A good date lets Enter go on to the window's default button.
                if (box_->Check()) {
                    e->ignore();
                } else {
                    e->accept();
                }
                return;
            default:
                break;
        }
        const QString text = e->text();
        if (text.isEmpty() || !text.at(0).isPrint()) {
            QLineEdit::keyPressEvent(e);
            return;
        }
        int16_t ascii = static_cast<int16_t>(text.at(0).unicode());
        emit box_->KeyPress(ascii);
        if (ascii == 0) {
            e->accept();
            return;
        }
        const QChar ch(static_cast<char16_t>(ascii));
        if (ch >= u'0' && ch <= u'9') {
            QKeyEvent digit(e->type(), Qt::Key_0 + (ch.unicode() - u'0'), e->modifiers(),
                            QString(ch));
            QLineEdit::keyPressEvent(&digit);
        } else if (ch == u'-' || ch == u'/' || ch == u'.') {
            box_->JumpToNextField();
        } else {
            emit box_->InvalidInput();
        }
        e->accept();
    }

    void keyReleaseEvent(QKeyEvent* e) override {
        const int16_t original = VbKeyCode(e->key());
        int16_t code = original;
        int16_t shift = VbShift(e->modifiers());
        emit box_->KeyUp(code, shift);
        if (original != 0 && code == 0) {
            e->accept();
            return;
        }
        QLineEdit::keyReleaseEvent(e);
    }

    void mousePressEvent(QMouseEvent* e) override {
        Relay(e, &DateBox::MouseDown, VbButtons(e->button()));
        QLineEdit::mousePressEvent(e);
    }
    void mouseMoveEvent(QMouseEvent* e) override {
        Relay(e, &DateBox::MouseMove, VbButtons(e->buttons()));
        QLineEdit::mouseMoveEvent(e);
    }
    void mouseReleaseEvent(QMouseEvent* e) override {
        Relay(e, &DateBox::MouseUp, VbButtons(e->button()));
        QLineEdit::mouseReleaseEvent(e);
        if (e->button() == Qt::LeftButton && rect().contains(e->position().toPoint())) {
            emit box_->Click();
        }
    }
    void mouseDoubleClickEvent(QMouseEvent* e) override {
        QLineEdit::mouseDoubleClickEvent(e);
        emit box_->DblClick();
    }

    void focusInEvent(QFocusEvent* e) override {
        QLineEdit::focusInEvent(e);
        if (box_->selectOnEntry_) {
            // After the mouse press that brought the focus has placed the caret.
            QTimer::singleShot(0, this, [this] {
                if (hasFocus()) {
                    setSelection(0, static_cast<int>(box_->format_.size()));
                }
            });
        }
    }
    void focusOutEvent(QFocusEvent* e) override {
        QLineEdit::focusOutEvent(e);
        // Opening the calendar or another window is not leaving the box.
        if (e->reason() != Qt::PopupFocusReason && e->reason() != Qt::ActiveWindowFocusReason) {
            box_->Check();
        }
    }

  private:
    using MouseSignal = void (DateBox::*)(int16_t&, int16_t&, float&, float&);
    void Relay(QMouseEvent* e, MouseSignal signal, int16_t button) {
        int16_t shift = VbShift(e->modifiers());
        float x = static_cast<float>(e->position().x() * kTwipsPerPixel);
        float y = static_cast<float>(e->position().y() * kTwipsPerPixel);
        emit(box_->*signal)(button, shift, x, y);
    }

    DateBox* box_;
};

DateBox::DateBox(QWidget* parent)
    : QWidget(parent),
      caption_(new QLabel(this)),
      edit_(new Editor(this)),
      drop_(new QToolButton(this)),
      up_(new QToolButton(this)),
      down_(new QToolButton(this)) {
    caption_->setObjectName(QStringLiteral("Caption"));
    caption_->hide();
    edit_->setObjectName(QStringLiteral("Edit"));
    // Dates read left to right also in a right-to-left window.
    edit_->setLayoutDirection(Qt::LeftToRight);
    drop_->setObjectName(QStringLiteral("DropDown"));
    drop_->setArrowType(Qt::DownArrow);
    drop_->setFocusPolicy(Qt::NoFocus);
    up_->setObjectName(QStringLiteral("SpinUp"));
    up_->setArrowType(Qt::UpArrow);
    up_->setFocusPolicy(Qt::NoFocus);
    up_->setAutoRepeat(true);
    down_->setObjectName(QStringLiteral("SpinDown"));
    down_->setArrowType(Qt::DownArrow);
    down_->setFocusPolicy(Qt::NoFocus);
    down_->setAutoRepeat(true);
    setFocusProxy(edit_);
    setFocusPolicy(Qt::StrongFocus);

    SetFormat(QStringLiteral("dd-mm-yyyy"));
    SetAlignHorizontal(align_);
    SetSpin(spin_);

    connect(edit_, &QLineEdit::textChanged, this, &DateBox::Change);
    connect(drop_, &QToolButton::clicked, this, &DateBox::PopUp);
    connect(up_, &QToolButton::clicked, this, [this] { Step(1); });
    connect(down_, &QToolButton::clicked, this, [this] { Step(-1); });
}

DateBox::~DateBox() = default;

QLineEdit& DateBox::Edit() const {
    return *edit_;
}

QString DateBox::Text() const {
    const QString shown = edit_->displayText();
    return HasDigit(shown) ? shown : QString();
}

void DateBox::SetText(const QString& text) {
    if (!HasDigit(text)) {
        SetDate({});
        return;
    }
    edit_->setText(text);
    const QDate d = CurrentDate();
    if (d.isValid()) {
        accepted_ = d;
    }
}

QDate DateBox::Parse(const QString& text) const {
    const QDate d = QDate::fromString(text, qtFormat_);
    return InRange(d) ? d : QDate();
}

QString DateBox::Spell(const QDate& d) const {
    return d.toString(qtFormat_);
}

QDate DateBox::CurrentDate() const {
    return Parse(Text());
}

void DateBox::SetDate(const QDate& d) {
    accepted_ = InRange(d) ? d : QDate();
    edit_->setText(accepted_.isValid() ? Spell(accepted_) : QString());
    // Typing starts over at the first digit.
    edit_->setCursorPosition(0);
}

void DateBox::SetFormat(const QString& vbFormat) {
    const QDate keep = CurrentDate();
    format_ = vbFormat;
    qtFormat_ = QtFormatOf(vbFormat);
    edit_->setInputMask(MaskOf(vbFormat));
    edit_->setText(keep.isValid() ? Spell(keep) : QString());
}

bool DateBox::ReadOnly() const {
    return edit_->isReadOnly();
}

void DateBox::SetReadOnly(bool on) {
    edit_->setReadOnly(on);
    UpdateButtons();
}

void DateBox::SetAppearance(int v) {
    appearance_ = v;
    edit_->setFrame(v != 0);
}

void DateBox::SetAlignHorizontal(int v) {
    align_ = v;
    Qt::Alignment a = Qt::AlignVCenter;
    switch (v) {
        case 0:
            a |= Qt::AlignLeft | Qt::AlignAbsolute;
            break;
        case 2:
            a |= Qt::AlignHCenter;
            break;
        default:
            a |= Qt::AlignRight | Qt::AlignAbsolute;
    }
    edit_->setAlignment(a);
}

void DateBox::SetDropDown(const DateDropDown& d) {
    dropDown_ = d;
    drop_->setVisible(d.Visible);
    if (calendar_) {
        calendar_->setFirstDayOfWeek(d.FirstDayOfWeek);
    }
    LayOut();
}

void DateBox::SetSpin(const DateSpin& s) {
    spin_ = s;
    up_->setVisible(s.Visible);
    down_->setVisible(s.Visible);
    LayOut();
}

void DateBox::SetCaptionText(const QString& text) {
    caption_->setText(text);
    caption_->setVisible(!text.isEmpty() && caption_->width() > 0);
    LayOut();
}

void DateBox::SetCaptionWidth(int pixels) {
    caption_->setFixedWidth(pixels);
    caption_->setVisible(!caption_->text().isEmpty() && pixels > 0);
    LayOut();
}

void DateBox::SetLeftReserve(int pixels) {
    leftReserve_ = pixels;
    LayOut();
}

void DateBox::resizeEvent(QResizeEvent*) {
    LayOut();
}

QSize DateBox::sizeHint() const {
    const QSize edit = edit_->sizeHint();
    return QSize(leftReserve_ + edit.width() + kDropWidth + kSpinWidth, edit.height());
}

// Physical positions: the left reserve stays at the left edge in either direction; the
// caption sits at the reading start, the buttons at the reading end of the editor.
void DateBox::LayOut() {
    const int w = width();
    const int h = height();
    const bool rtl = layoutDirection() == Qt::RightToLeft;
    const int captionWidth = caption_->isVisibleTo(this) ? caption_->width() : 0;
    int left = leftReserve_;
    int right = w;
    if (rtl) {
        caption_->setGeometry(right - captionWidth, 0, captionWidth, h);
        right -= captionWidth;
    } else {
        caption_->setGeometry(left, 0, captionWidth, h);
        left += captionWidth;
    }
    // Takes a strip of the given width off the reading end of the editor's room.
    auto take = [&](int width) {
        if (rtl) {
            left += width;
            return left - width;
        }
        right -= width;
        return right;
    };
    if (dropDown_.Visible) {
        drop_->setGeometry(take(kDropWidth), 0, kDropWidth, h);
    }
    if (spin_.Visible) {
        const int x = take(kSpinWidth);
        up_->setGeometry(x, 0, kSpinWidth, h / 2);
        down_->setGeometry(x, h / 2, kSpinWidth, h - h / 2);
    }
    edit_->setGeometry(left, 0, qMax(0, right - left), h);
}

bool DateBox::Check() {
    if (checking_) {
        return true;
    }
    const QString text = Text();
    if (text.isEmpty()) {
        accepted_ = QDate();
        return true;
    }
    const QDate d = QDate::fromString(text, qtFormat_);
    if (InRange(d)) {
        accepted_ = d;
        return true;
    }
    checking_ = true;
    emit Invalid(d.isValid());
    checking_ = false;
    return false;
}

void DateBox::Restore() {
    SetDate(accepted_);
}

void DateBox::PopUp() {
    if (ReadOnly() || !isEnabled()) {
        return;
    }
    if (!popup_) {
        popup_ = new QFrame(this, Qt::Popup);
        popup_->setObjectName(QStringLiteral("Calendar"));
        auto* layout = new QVBoxLayout(popup_);
        layout->setContentsMargins(0, 0, 0, 0);
        calendar_ = new QCalendarWidget(popup_);
        calendar_->setDateRange(GDate::MinDate(), GDate::MaxDate());
        calendar_->setFirstDayOfWeek(dropDown_.FirstDayOfWeek);
        layout->addWidget(calendar_);
        auto pick = [this](const QDate& d) {
            popup_->hide();
            if (!ReadOnly()) {
                SetDate(d);
            }
            edit_->setFocus(Qt::PopupFocusReason);
        };
        connect(calendar_, &QCalendarWidget::clicked, this, pick);
        connect(calendar_, &QCalendarWidget::activated, this, pick);
    }
    const QDate current = CurrentDate();
    calendar_->setSelectedDate(current.isValid() ? current : Today());
    popup_->adjustSize();
    const QPoint below = mapToGlobal(QPoint(0, height()));
    popup_->move(
        layoutDirection() == Qt::RightToLeft ? below.x() + width() - popup_->width() : below.x(),
        below.y());
    popup_->show();
    calendar_->setFocus(Qt::PopupFocusReason);
}

void DateBox::Step(int days) {
    if (ReadOnly()) {
        return;
    }
    const QDate current = CurrentDate();
    const QDate next = (current.isValid() ? current : Today()).addDays(days);
    SetDate(qBound(GDate::MinDate(), next, GDate::MaxDate()));
}

void DateBox::JumpToNextField() {
    const int from = edit_->cursorPosition();
    auto isLiteral = [this](int i) {
        const QChar lower = format_.at(i).toLower();
        return lower != u'd' && lower != u'm' && lower != u'y';
    };
    // Right after a literal the separator has been passed already.
    if (from > 0 && from <= format_.size() && isLiteral(from - 1)) {
        return;
    }
    for (int i = from; i < format_.size(); ++i) {
        if (isLiteral(i)) {
            edit_->setCursorPosition(i + 1);
            return;
        }
    }
}

void DateBox::UpdateButtons() {
    const bool editable = !ReadOnly();
    drop_->setEnabled(editable);
    up_->setEnabled(editable);
    down_->setEnabled(editable);
}

}  // namespace zv

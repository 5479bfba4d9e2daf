#pragma once
// The editor inside GDate: a built-in caption, a masked line edit, a drop-down calendar
// button and optional spin buttons. It knows the last accepted date and checks typed text
// when the user leaves it or presses Enter; GDate reports what it rejects.
//
// Keys: F2 clears, F3 puts today's date, F4 opens the calendar, Enter checks the text
// (and then reaches the window's default button when the text is good).

#include <QDate>
#include <QWidget>
#include <cstdint>

#include "controls/gdate.h"

class QCalendarWidget;
class QLabel;
class QLineEdit;
class QToolButton;

namespace zv {

class DateBox : public QWidget {
    Q_OBJECT

  public:
    explicit DateBox(QWidget* parent = nullptr);
    ~DateBox() override;

    QLineEdit& Edit() const;
    QLabel& CaptionLabel() const { return *caption_; }

    // Text with literals, "" when nothing is typed.
    QString Text() const;
    void SetText(const QString& text);
    // The date the text spells when it is a date of the accepted range, else a null date.
    QDate CurrentDate() const;
    // The date a text spells in the format, when it is one of the accepted range.
    QDate Parse(const QString& text) const;
    // Puts a date (null clears) and takes it as accepted.
    void SetDate(const QDate& d);

    QString Format() const { return format_; }
    void SetFormat(const QString& vbFormat);
    bool ReadOnly() const;
    void SetReadOnly(bool on);
    int Appearance() const { return appearance_; }
    void SetAppearance(int v);
    int AlignHorizontal() const { return align_; }
    void SetAlignHorizontal(int v);
    DateDropDown DropDown() const { return dropDown_; }
    void SetDropDown(const DateDropDown& d);
    DateSpin Spin() const { return spin_; }
    void SetSpin(const DateSpin& s);
    void SetSelectOnEntry(bool on) { selectOnEntry_ = on; }
    void SetCaptionText(const QString& text);
    void SetCaptionWidth(int pixels);
    // Room kept free at the left edge (for the owner's today button).
    void SetLeftReserve(int pixels);

    // Checks the typed text: an empty box or a date of the accepted range is taken; any
    // other text raises Invalid and is not taken. Returns whether the text was taken.
    bool Check();
    // Back to the last accepted date.
    void Restore();
    // Opens the drop-down calendar.
    void PopUp();

    QSize sizeHint() const override;

  signals:
    void Invalid(bool outOfRange);
    void InvalidInput();
    void Change();
    void Click();
    void DblClick();
    void KeyDown(int16_t& KeyCode, int16_t& Shift);
    void KeyPress(int16_t& KeyAscii);
    void KeyUp(int16_t& KeyCode, int16_t& Shift);
    void MouseDown(int16_t& Button, int16_t& Shift, float& X, float& Y);
    void MouseMove(int16_t& Button, int16_t& Shift, float& X, float& Y);
    void MouseUp(int16_t& Button, int16_t& Shift, float& X, float& Y);

  protected:
    void resizeEvent(QResizeEvent* e) override;

  private:
    void LayOut();
    QString Spell(const QDate& d) const;
    void Step(int days);
    void JumpToNextField();
    void UpdateButtons();

    class Editor;
    QLabel* caption_;
    Editor* edit_;
    QToolButton* drop_;
    QToolButton* up_;
    QToolButton* down_;
    QWidget* popup_ = nullptr;
    QCalendarWidget* calendar_ = nullptr;
    QString format_;
    QString qtFormat_;
    QDate accepted_;
    DateDropDown dropDown_;
    DateSpin spin_;
    int appearance_ = 1;
    int align_ = 1;
    int leftReserve_ = 0;
    bool selectOnEntry_ = true;
    bool checking_ = false;
};

}  // namespace zv

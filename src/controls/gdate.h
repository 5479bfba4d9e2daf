#pragma once
// The date box of the add-in's windows: a masked "dd-mm-yyyy" editor (TDBDate1) with a
// drop-down calendar, an optional built-in caption and a small today button (CmdNow).
// An empty box reads 0. Invalid and out-of-range dates are reported in a message box and
// then offered to the owner through InvalidValue / InvalidRange, whose Restore argument
// decides whether the last accepted date comes back.
//
// The events of the editor are relayed as signals with by-reference arguments; connect
// them directly (the default for objects of one thread) so that a handler's change of
// KeyAscii, KeyCode or Restore reaches the editor. KeyPress comes for printable characters
// only. In a Designer form, set the properties below as dynamic ones (stdset="0") so that
// they go through their setters. Sizes in the layout rules are twips, 15 to a pixel.

#include <QColor>
#include <QDate>
#include <QFont>
#include <QFrame>
#include <QString>
#include <QVariant>
#include <cstdint>

class QAbstractButton;

namespace zv {

class DateBox;

// Settings of the drop-down calendar.
struct DateDropDown {
    bool Visible = true;  // the drop-down button is shown (F4 opens the calendar anyway)
    Qt::DayOfWeek FirstDayOfWeek = Qt::Sunday;
    bool operator==(const DateDropDown&) const = default;
};

// Settings of the spin buttons, which step the date by one day.
struct DateSpin {
    bool Visible = false;
    bool operator==(const DateSpin&) const = default;
};

class GDate : public QFrame {
    Q_OBJECT
    Q_PROPERTY(QColor BackColor READ BackColor WRITE SetBackColor)
    Q_PROPERTY(QColor ForeColor READ ForeColor WRITE SetForeColor)
    Q_PROPERTY(bool Enabled READ Enabled WRITE SetEnabled)
    Q_PROPERTY(QFont Font READ Font WRITE SetFont)
    Q_PROPERTY(int BackStyle READ BackStyle WRITE SetBackStyle)
    Q_PROPERTY(int BorderStyle READ BorderStyle WRITE SetBorderStyle)
    Q_PROPERTY(QString Text READ Text WRITE SetText)
    Q_PROPERTY(QVariant Value READ Value WRITE SetValue)
    Q_PROPERTY(QString Format READ Format WRITE SetFormat)
    Q_PROPERTY(bool Locked READ Locked WRITE SetLocked)
    Q_PROPERTY(QString DataField READ DataField WRITE SetDataField)
    Q_PROPERTY(bool DontSelData READ DontSelData WRITE SetDontSelData)
    Q_PROPERTY(bool HideNow READ HideNow WRITE SetHideNow)
    Q_PROPERTY(int Appearance READ Appearance WRITE SetAppearance)
    Q_PROPERTY(int AlignHorizontal READ AlignHorizontal WRITE SetAlignHorizontal)
    Q_PROPERTY(QString Version READ Version)
    Q_PROPERTY(QString Caption READ Caption WRITE SetCaption)
    Q_PROPERTY(int Ratio READ Ratio WRITE SetRatio)

  public:
    // The accepted range of dates.
    static QDate MinDate() { return QDate(1900, 1, 1); }
    static QDate MaxDate() { return QDate(2099, 12, 31); }

    explicit GDate(QWidget* parent = nullptr);
    ~GDate() override;

    QColor BackColor() const;
    void SetBackColor(const QColor& c);
    QColor ForeColor() const;
    void SetForeColor(const QColor& c);
    // False disables the editor and the today button; True enables both.
    bool Enabled() const;
    void SetEnabled(bool on);
    QFont Font() const;
    void SetFont(const QFont& f);
    // 0 transparent, 1 opaque.
    int BackStyle() const;
    void SetBackStyle(int v);
    // 0 none, 1 fixed single.
    int BorderStyle() const;
    void SetBorderStyle(int v);
    // The text with its literals ("05-12-2026", "05-1_-____"); "" when nothing is typed.
    QString Text() const;
    void SetText(const QString& text);
    // The date as a QDate, or the integer 0 when the box holds no valid date. Setting Null,
    // 0, "" (anything whose text does not start with a non-zero number) clears the box; a
    // QDate, QDateTime, a "dd-mm-yyyy" or ISO text or a day number (days since 30-12-1899)
    // sets it. A value that is no date of the accepted range is error 380.
    QVariant Value() const;
    void SetValue(const QVariant& v);
    // The date, or a null QDate when the box holds none.
    QDate date() const;
    void setDate(const QDate& d) { SetValue(d); }
    // Display and edit format, built from dd, mm and yyyy and single literal characters.
    QString Format() const;
    void SetFormat(const QString& f);
    // Read-only editor; the today button is enabled exactly when not locked.
    bool Locked() const;
    void SetLocked(bool on);
    QString DataField() const;
    void SetDataField(const QString& f);
    // Do not select the whole text when the editor receives the focus.
    bool DontSelData() const;
    void SetDontSelData(bool on);
    // Hide the today button.
    bool HideNow() const;
    void SetHideNow(bool on);
    // 0 flat, 1 3-D.
    int Appearance() const;
    void SetAppearance(int v);
    DateDropDown DropDown() const;
    void SetDropDown(const DateDropDown& d);
    DateSpin Spin() const;
    void SetSpin(const DateSpin& s);
    // 0 left, 1 right, 2 centre.
    int AlignHorizontal() const;
    void SetAlignHorizontal(int v);
    // The add-in's version, major.minor.revision.
    QString Version() const;
    // The built-in caption; empty hides it.
    QString Caption() const;
    void SetCaption(const QString& c);
    // Width of the caption in percent of the control's width.
    int16_t Ratio() const;
    void SetRatio(int16_t r);
    void SetRatio(int r) { SetRatio(static_cast<int16_t>(r)); }

    void Refresh();

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

    // Children, for the owner's keyboard handling and for tests.
    DateBox& TDBDate1() const { return *box_; }
    QAbstractButton& CmdNow() const { return *now_; }

  signals:
    void InvalidInput();
    void InvalidRange(bool& Restore);
    void InvalidValue(bool& Restore);
    void Change();
    void Click();
    void DblClick();
    void KeyDown(int16_t& KeyCode, int16_t& Shift);
    void KeyPress(int16_t& KeyAscii);
    void KeyUp(int16_t& KeyCode, int16_t& Shift);
    void MouseDown(int16_t& Button, int16_t& Shift, float& X, float& Y);
    void MouseMove(int16_t& Button, int16_t& Shift, float& X, float& Y);
    void MouseUp(int16_t& Button, int16_t& Shift, float& X, float& Y);
    // A property was set at run time.
    void PropertyChanged(const QString& name);

  protected:
    void resizeEvent(QResizeEvent* e) override;
    void showEvent(QShowEvent* e) override;

  private:
    void LayOut();
    void ApplyCaptionWidth();
    void OnNowClicked(bool checked);
    void ReportInvalid(bool outOfRange);

    DateBox* box_;
    QAbstractButton* now_;
    int16_t ratio_ = 0;
    QString caption_;
    QString dataField_;
    bool hideNow_ = false;
    bool dontSelData_ = false;
    int backStyle_ = 1;
    int borderStyle_ = 0;
    bool shown_ = false;
};

}  // namespace zv

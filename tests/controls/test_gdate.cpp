// The date box: its value, the messages on bad dates, the today button, the key relay and
// the layout rules.
#include <QCalendarWidget>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QtTest>

#include "controls/date_box.h"
#include "controls/gdate.h"
#include "controls/gdate_layout.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/clock.h"
#include "util/errors.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;

namespace {

const QString kInvalidText = u"קליטה של ערך לא חוקי לתאריך : "_s;
const QString kRangeText = QStringLiteral(
    "קליטה של ערך לא מחוץ לטווח תאריכים 01-01-1900 >-< 31-12-2099 \r\n"
    "נעשה נסיון לקלוט תאריך : ");

QLineEdit& EditOf(GDate& g) {
    return g.TDBDate1().Edit();
}

// Types characters into the editor from its first position, one key event each.
void Type(GDate& g, const QString& text) {
    QLineEdit& edit = EditOf(g);
    edit.setCursorPosition(0);
    for (const QChar ch : text) {
        QTest::sendKeyEvent(QTest::Click, &edit, Qt::Key_unknown, QString(ch), Qt::NoModifier);
    }
}

void PressEnter(GDate& g) {
    QTest::keyClick(&EditOf(g), Qt::Key_Return);
}

}  // namespace

class TestGDate : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();

    void emptyReadsZero_data();
    void emptyReadsZero();
    void valueAssignments_data();
    void valueAssignments();
    void valueOutsideRangeIsRefused_data();
    void valueOutsideRangeIsRefused();
    void typedDates_data();
    void typedDates();
    void restoreDecidesWhatStays_data();
    void restoreDecidesWhatStays();
    void invalidCharacterRaisesInvalidInput();
    void keyPressHandlerCancelsOrChanges();
    void enterWithGoodDateReachesDefaultButton();
    void todayButton();
    void functionKeys();
    void calendarPicksDate();
    void lockedVersusEnabled();
    void nowButtonOnWidget();
    void hideNowKeepsButtonAway();
    void captionWidthRule_data();
    void captionWidthRule();
    void captionFollowsRatio();
    void selectOnEntry_data();
    void selectOnEntry();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestGDate::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    SetClock([] { return QDateTime(QDate(2026, 3, 14), QTime(9, 30)); });
}

void TestGDate::cleanup() {
    // Any message a test did not expect fails it.
    QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
    ui_.reset();
    env_.reset();
}

void TestGDate::emptyReadsZero_data() {
    QTest::addColumn<QVariant>("assigned");
    QTest::newRow("zero") << QVariant(0);
    QTest::newRow("null") << QVariant(QMetaType(QMetaType::QDate));
    QTest::newRow("not a number") << QVariant(u"abc"_s);
}

void TestGDate::emptyReadsZero() {
    QFETCH(QVariant, assigned);
    GDate g;
    g.SetValue(QDate(2020, 5, 1));
    g.SetValue(assigned);
    QCOMPARE(g.Value().typeId(), QMetaType::Int);
    QCOMPARE(g.Value().toInt(), 0);
    QCOMPARE(g.Text(), QString());
    QVERIFY(g.date().isNull());
    QCOMPARE(EditOf(g).displayText(), u"__-__-____"_s);
}

void TestGDate::valueAssignments_data() {
    QTest::addColumn<QVariant>("assigned");
    QTest::addColumn<QDate>("expected");
    QTest::newRow("date") << QVariant(QDate(2026, 12, 5)) << QDate(2026, 12, 5);
    QTest::newRow("text in format") << QVariant(u"05-12-2026"_s) << QDate(2026, 12, 5);
    QTest::newRow("day number") << QVariant(45000) << QDate(2023, 3, 15);
    QTest::newRow("last day") << QVariant(QDate(2099, 12, 31)) << QDate(2099, 12, 31);
}

void TestGDate::valueAssignments() {
    QFETCH(QVariant, assigned);
    QFETCH(QDate, expected);
    GDate g;
    QSignalSpy changed(&g, &GDate::PropertyChanged);
    g.SetValue(assigned);
    QCOMPARE(g.Value(), QVariant(expected));
    QCOMPARE(g.date(), expected);
    QCOMPARE(g.Text(), expected.toString(u"dd-MM-yyyy"_s));
    QCOMPARE(changed.count(), 1);
    QCOMPARE(changed.at(0).at(0).toString(), u"Value"_s);
}

void TestGDate::valueOutsideRangeIsRefused_data() {
    QTest::addColumn<QVariant>("assigned");
    QTest::newRow("before 1900") << QVariant(QDate(1899, 12, 31));
    QTest::newRow("after 2099") << QVariant(QDate(2100, 1, 1));
    QTest::newRow("no date") << QVariant(u"31-02-2020"_s);
}

void TestGDate::valueOutsideRangeIsRefused() {
    QFETCH(QVariant, assigned);
    GDate g;
    g.SetValue(QDate(2020, 1, 2));
    try {
        g.SetValue(assigned);
        QFAIL("no error");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), 380L);
    }
    QCOMPARE(g.date(), QDate(2020, 1, 2));
}

void TestGDate::typedDates_data() {
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QString>("message");  // empty: accepted
    QTest::addColumn<QVariant>("value");
    QTest::newRow("good") << u"15062021"_s << QString() << QVariant(QDate(2021, 6, 15));
    QTest::newRow("separators typed")
        << u"15-06-2021"_s << QString() << QVariant(QDate(2021, 6, 15));
    QTest::newRow("one digit") << u"1"_s << kInvalidText + u"1_-__-____"_s << QVariant(0);
    QTest::newRow("no such day") << u"31022020"_s << kInvalidText + u"31-02-2020"_s << QVariant(0);
    QTest::newRow("incomplete") << u"0101"_s << kInvalidText + u"01-01-____"_s << QVariant(0);
    QTest::newRow("before range") << u"31121899"_s << kRangeText + u"31-12-1899"_s << QVariant(0);
    QTest::newRow("after range") << u"01012100"_s << kRangeText + u"01-01-2100"_s << QVariant(0);
}

void TestGDate::typedDates() {
    QFETCH(QString, typed);
    QFETCH(QString, message);
    QFETCH(QVariant, value);
    GDate g;
    int range = 0;
    int invalid = 0;
    connect(&g, &GDate::InvalidRange, this, [&](bool&) { ++range; });
    connect(&g, &GDate::InvalidValue, this, [&](bool&) { ++invalid; });
    Type(g, typed);
    PressEnter(g);
    const auto messages = (*ui_)->Messages();
    if (message.isEmpty()) {
        QCOMPARE(messages.size(), size_t(0));
        QCOMPARE(g.Value(), value);
        return;
    }
    QCOMPARE(messages.size(), size_t(1));
    QCOMPARE(messages[0].text, message);
    QCOMPARE(messages[0].style, int(vbExclamation));
    QCOMPARE(messages[0].title, AppTitle());
    QCOMPARE(range + invalid, 1);
    QCOMPARE(range, message.startsWith(kRangeText) ? 1 : 0);
    // Restored to the (empty) date the box held before.
    QCOMPARE(g.Value(), value);
    QCOMPARE(g.Text(), QString());
    (*ui_)->Clear();
}

void TestGDate::restoreDecidesWhatStays_data() {
    QTest::addColumn<bool>("restore");
    QTest::addColumn<QString>("typed");
    QTest::newRow("restored after range") << true << u"01011850"_s;
    QTest::newRow("kept after bad date") << false << u"30022024"_s;
}

void TestGDate::restoreDecidesWhatStays() {
    QFETCH(bool, restore);
    QFETCH(QString, typed);
    GDate g;
    g.SetValue(QDate(2024, 1, 10));
    bool seen = false;
    auto handler = [&](bool& r) {
        seen = r;  // offered as true
        r = restore;
    };
    connect(&g, &GDate::InvalidRange, this, handler);
    connect(&g, &GDate::InvalidValue, this, handler);
    Type(g, typed);
    PressEnter(g);
    QVERIFY(seen);
    QCOMPARE((*ui_)->Messages().size(), size_t(1));
    const QString shown = typed.left(2) + u'-' + typed.mid(2, 2) + u'-' + typed.mid(4);
    QCOMPARE(g.Text(), restore ? u"10-01-2024"_s : shown);
    QCOMPARE(g.Value(), restore ? QVariant(QDate(2024, 1, 10)) : QVariant(0));
    (*ui_)->Clear();
}

void TestGDate::invalidCharacterRaisesInvalidInput() {
    GDate g;
    QSignalSpy input(&g, &GDate::InvalidInput);
    Type(g, u"1a"_s);
    QTest::sendKeyEvent(QTest::Click, &EditOf(g), Qt::Key_unknown, u"ש"_s, Qt::NoModifier);
    QCOMPARE(input.count(), 2);
    QCOMPARE(g.Text(), u"1_-__-____"_s);
}

void TestGDate::keyPressHandlerCancelsOrChanges() {
    GDate g;
    QString seen;
    // The filter of the filing dialog: only digits and date separators pass; "7" becomes "8".
    connect(&g, &GDate::KeyPress, this, [&](int16_t& key) {
        seen += QChar(static_cast<char16_t>(key));
        if (key == '7') {
            key = '8';
        } else if (!u"0123456789:/.-"_s.contains(QChar(static_cast<char16_t>(key)))) {
            key = 0;
        }
    });
    QSignalSpy input(&g, &GDate::InvalidInput);
    Type(g, u"0x1y07z2020"_s);
    QCOMPARE(seen, u"0x1y07z2020"_s);
    QCOMPARE(input.count(), 0);
    QCOMPARE(g.Text(), u"01-08-2020"_s);
}

void TestGDate::enterWithGoodDateReachesDefaultButton() {
    QDialog dialog;
    auto* g = new GDate(&dialog);
    auto* ok = new QPushButton(u"OK"_s, &dialog);
    ok->setDefault(true);
    ok->move(0, 40);
    QSignalSpy clicked(ok, &QPushButton::clicked);
    dialog.show();
    Type(*g, u"3105"_s);
    PressEnter(*g);
    QCOMPARE(clicked.count(), 0);
    QCOMPARE((*ui_)->Messages().size(), size_t(1));
    (*ui_)->Clear();
    Type(*g, u"31052025"_s);
    PressEnter(*g);
    QCOMPARE(clicked.count(), 1);
    QCOMPARE(g->date(), QDate(2025, 5, 31));
}

void TestGDate::todayButton() {
    GDate g;
    g.resize(120, 20);
    g.show();
    QSignalSpy change(&g, &GDate::Change);
    QTest::mouseClick(&g.CmdNow(), Qt::LeftButton);
    QCOMPARE(g.Value(), QVariant(QDate(2026, 3, 14)));
    QVERIFY(!g.CmdNow().isChecked());
    QVERIFY(change.count() >= 1);
    // A second press puts it again, not toggling anything off.
    g.SetValue(0);
    QTest::mouseClick(&g.CmdNow(), Qt::LeftButton);
    QCOMPARE(g.date(), QDate(2026, 3, 14));
}

void TestGDate::functionKeys() {
    GDate g;
    g.SetValue(QDate(2020, 1, 1));
    QTest::keyClick(&EditOf(g), Qt::Key_F2);
    QCOMPARE(g.Value(), QVariant(0));
    QTest::keyClick(&EditOf(g), Qt::Key_F3);
    QCOMPARE(g.date(), QDate(2026, 3, 14));
    g.SetLocked(true);
    QTest::keyClick(&EditOf(g), Qt::Key_F2);
    QCOMPARE(g.date(), QDate(2026, 3, 14));
}

void TestGDate::calendarPicksDate() {
    GDate g;
    g.show();
    QTest::keyClick(&EditOf(g), Qt::Key_F4);
    auto* calendar = g.findChild<QCalendarWidget*>();
    QVERIFY(calendar);
    QVERIFY(calendar->isVisible());
    QCOMPARE(calendar->selectedDate(), QDate(2026, 3, 14));
    emit calendar->clicked(QDate(2026, 4, 2));
    QVERIFY(!calendar->isVisible());
    QCOMPARE(g.date(), QDate(2026, 4, 2));
}

void TestGDate::lockedVersusEnabled() {
    GDate g;
    g.SetValue(QDate(2022, 2, 2));
    g.SetLocked(true);
    QVERIFY(g.Locked());
    QVERIFY(!g.CmdNow().isEnabled());
    QVERIFY(g.Enabled());
    Type(g, u"11"_s);
    QCOMPARE(g.date(), QDate(2022, 2, 2));

    g.SetEnabled(false);
    QVERIFY(!g.Enabled());
    QVERIFY(!g.TDBDate1().isEnabled());
    QVERIFY(!g.CmdNow().isEnabled());

    // Enabling again also enables the button, though the box is still locked.
    g.SetEnabled(true);
    QVERIFY(g.CmdNow().isEnabled());
    QVERIFY(g.Locked());

    g.SetLocked(false);
    QVERIFY(g.CmdNow().isEnabled());
    Type(g, u"11"_s);
    QCOMPARE(g.Text(), u"11-02-2022"_s);
}

void TestGDate::nowButtonOnWidget() {
    GDate g;
    g.resize(150, 20);  // 300 twips high
    g.show();
    QCOMPARE(g.CmdNow().geometry(), QRect(2, 1, 19, 18));
    QCOMPARE(g.TDBDate1().geometry(), QRect(0, 0, 150, 20));
    // The editor keeps clear of the button.
    QVERIFY(EditOf(g).geometry().left() >= g.CmdNow().geometry().right());
    g.SetBorderStyle(1);
    QCOMPARE(g.TDBDate1().geometry(), g.contentsRect());
    QCOMPARE(g.CmdNow().geometry().topLeft(), g.contentsRect().topLeft() + QPoint(2, 1));
}

void TestGDate::hideNowKeepsButtonAway() {
    GDate g;
    g.resize(150, 20);
    g.SetHideNow(true);
    g.show();
    QVERIFY(!g.CmdNow().isVisible());
    const QRect before = g.CmdNow().geometry();
    g.resize(300, 40);
    QCOMPARE(g.CmdNow().geometry(), before);
    QCOMPARE(EditOf(g).geometry().left(), 0);
    g.SetHideNow(false);
    QVERIFY(g.CmdNow().isVisible());
    QCOMPARE(g.CmdNow().geometry(), QRect(2, 1, 19, 38));
}

void TestGDate::captionWidthRule_data() {
    QTest::addColumn<int>("ratio");
    QTest::addColumn<int>("widthTwips");
    QTest::addColumn<int>("pixels");
    QTest::newRow("30 of 3000") << 30 << 3000 << 60;
    QTest::newRow("none") << 0 << 3000 << 0;
    QTest::newRow("half rounds to even, down") << 50 << 75 << 2;
    QTest::newRow("half rounds to even, up") << 50 << 45 << 2;
    QTest::newRow("above half") << 51 << 75 << 3;
}

void TestGDate::captionWidthRule() {
    QFETCH(int, ratio);
    QFETCH(int, widthTwips);
    QFETCH(int, pixels);
    QCOMPARE(CaptionWidthPixels(static_cast<int16_t>(ratio), widthTwips), pixels);
}

void TestGDate::captionFollowsRatio() {
    GDate g;
    g.setLayoutDirection(Qt::RightToLeft);
    g.resize(200, 20);  // 3000 twips wide
    // As a Designer form sets them.
    QVERIFY(g.setProperty("Caption", u"תאריך"_s));
    QVERIFY(g.setProperty("Ratio", 30));
    g.show();
    QLabel& caption = g.TDBDate1().CaptionLabel();
    QVERIFY(caption.isVisible());
    QCOMPARE(caption.text(), u"תאריך"_s);
    QCOMPARE(caption.width(), 60);
    // Right to left, the caption sits at the right edge and the editor beside it.
    QCOMPARE(caption.geometry().right(), 199);
    QVERIFY(EditOf(g).geometry().right() < caption.geometry().left());
    g.resize(400, 20);
    QCOMPARE(caption.width(), 120);
    g.SetRatio(0);
    QVERIFY(!caption.isVisible());
}

void TestGDate::selectOnEntry_data() {
    QTest::addColumn<bool>("dontSelData");
    QTest::newRow("selects all") << false;
    QTest::newRow("keeps the caret") << true;
}

void TestGDate::selectOnEntry() {
    QFETCH(bool, dontSelData);
    QWidget window;
    auto* other = new QLineEdit(&window);
    auto* g = new GDate(&window);
    g->move(0, 40);
    g->resize(150, 20);
    g->SetDontSelData(dontSelData);
    g->SetValue(QDate(2023, 7, 8));
    window.show();
    QVERIFY(QTest::qWaitForWindowActive(&window));
    other->setFocus();
    QLineEdit& edit = EditOf(*g);
    QTest::mouseClick(&edit, Qt::LeftButton, {}, QPoint(edit.width() - 4, edit.height() / 2));
    QTRY_VERIFY(edit.hasFocus());
    QTest::qWait(20);
    if (dontSelData) {
        QVERIFY(!edit.hasSelectedText());
    } else {
        QCOMPARE(edit.selectedText(), u"08-07-2023"_s);
    }
}

QTEST_MAIN(TestGDate)
#include "test_gdate.moc"

// The date box: its value, the messages on bad dates and characters, the today button, the
// function keys and calendar, locking, and the layout rules.
#include <QCalendarWidget>
#include <QDialog>
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
const QDate kToday(2026, 3, 14);

QLineEdit& EditOf(GDate& g) {
    return g.TDBDate1().Edit();
}

// Empties the editor as a user does, then types characters into it, one key event each.
void Type(GDate& g, const QString& text) {
    EditOf(g).selectAll();
    QTest::keyClick(&EditOf(g), Qt::Key_Delete);
    QTest::keyClicks(&EditOf(g), text);
}

}  // namespace

class TestGDate : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
        SetClock([] { return QDateTime(kToday, QTime(9, 30)); });
    }
    void cleanup() {
        // Any message a test did not expect fails it.
        QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
        ui_.reset();
        env_.reset();
    }

    void setValue_data() {
        QTest::addColumn<QVariant>("assigned");
        QTest::addColumn<QDate>("expected");  // null: the box is empty
        QTest::addColumn<bool>("refused");
        QTest::newRow("date") << QVariant(QDate(2026, 12, 5)) << QDate(2026, 12, 5) << false;
        QTest::newRow("text in format") << QVariant(u"05-12-2026"_s) << QDate(2026, 12, 5) << false;
        QTest::newRow("day number") << QVariant(45000) << QDate(2023, 3, 15) << false;
        QTest::newRow("last day") << QVariant(QDate(2099, 12, 31)) << QDate(2099, 12, 31) << false;
        QTest::newRow("zero") << QVariant(0) << QDate() << false;
        QTest::newRow("null") << QVariant(QMetaType(QMetaType::QDate)) << QDate() << false;
        QTest::newRow("not a number") << QVariant(u"abc"_s) << QDate() << false;
        QTest::newRow("before 1900") << QVariant(QDate(1899, 12, 31)) << QDate() << true;
        QTest::newRow("after 2099") << QVariant(QDate(2100, 1, 1)) << QDate() << true;
        QTest::newRow("no such day") << QVariant(u"31-02-2020"_s) << QDate() << true;
    }
    void setValue() {
        QFETCH(QVariant, assigned);
        QFETCH(QDate, expected);
        QFETCH(bool, refused);
        GDate g;
        g.SetValue(QDate(2020, 1, 2));
        try {
            g.SetValue(assigned);
            QVERIFY(!refused);
        } catch (const VbError& e) {
            QVERIFY(refused);
            QCOMPARE(e.Number(), 380L);
            QCOMPARE(g.date(), QDate(2020, 1, 2));
            return;
        }
        // An empty box reads the integer 0.
        const QVariant want = expected.isValid() ? QVariant(expected) : QVariant(0);
        QCOMPARE(g.Value(), want);
        QCOMPARE(g.Text(), expected.toString(u"dd-MM-yyyy"_s));
    }

    // Each typed text goes into a box holding 10-01-2024, then Enter. A good date lets Enter go
    // on to the window's default button; a bad date is reported and, unless the owner's
    // handler says otherwise, the date held before comes back.
    void typedDates_data() {
        QTest::addColumn<QString>("typed");
        QTest::addColumn<QString>("message");  // empty: accepted
        QTest::addColumn<bool>("restore");
        QTest::newRow("good") << u"15062021"_s << QString() << true;
        QTest::newRow("separators typed") << u"15-06-2021"_s << QString() << true;
        QTest::newRow("no such day") << u"31022020"_s << kInvalidText + u"31-02-2020"_s << true;
        QTest::newRow("incomplete") << u"0101"_s << kInvalidText + u"01-01-____"_s << true;
        QTest::newRow("before range") << u"31121899"_s << kRangeText + u"31-12-1899"_s << true;
        QTest::newRow("after range") << u"01012100"_s << kRangeText + u"01-01-2100"_s << true;
        QTest::newRow("kept after bad date")
            << u"30022024"_s << kInvalidText + u"30-02-2024"_s << false;
    }
    void typedDates() {
        QFETCH(QString, typed);
        QFETCH(QString, message);
        QFETCH(bool, restore);
        QDialog dialog;
        GDate& g = *new GDate(&dialog);
        auto* ok = new QPushButton(u"OK"_s, &dialog);
        ok->setDefault(true);
        ok->move(0, 40);
        QSignalSpy clicked(ok, &QPushButton::clicked);
        dialog.show();
        g.SetValue(QDate(2024, 1, 10));
        int range = 0;
        int invalid = 0;
        // Restore is offered as true.
        connect(&g, &GDate::InvalidRange, this, [&](bool& r) {
            r = r && restore;
            ++range;
        });
        connect(&g, &GDate::InvalidValue, this, [&](bool& r) {
            r = r && restore;
            ++invalid;
        });
        Type(g, typed);
        QTest::keyClick(&EditOf(g), Qt::Key_Return);
        QCOMPARE((*ui_)->Texts(), message.isEmpty() ? QStringList() : QStringList{message});
        QCOMPARE(clicked.count(), message.isEmpty() ? 1 : 0);
        if (message.isEmpty()) {
            QCOMPARE(g.date(), QDate(2021, 6, 15));
            return;
        }
        QCOMPARE((*ui_)->Messages()[0].style, int(vbExclamation));
        QCOMPARE((*ui_)->Messages()[0].title, AppTitle());
        QCOMPARE(range, message.startsWith(kRangeText) ? 1 : 0);
        QCOMPARE(range + invalid, 1);
        QCOMPARE(g.Text(), restore ? u"10-01-2024"_s : message.right(10));
        QCOMPARE(g.Value(), restore ? QVariant(QDate(2024, 1, 10)) : QVariant(0));
        (*ui_)->Clear();
    }

    void invalidCharacters() {
        GDate g;
        QSignalSpy input(&g, &GDate::InvalidInput);
        Type(g, u"1a"_s);
        QTest::sendKeyEvent(QTest::Click, &EditOf(g), Qt::Key_unknown, u"ש"_s, Qt::NoModifier);
        QCOMPARE(input.count(), 2);
        QCOMPARE(g.Text(), u"1_-__-____"_s);
    }

    void todayKeysCalendarAndLock() {
        GDate g;
        g.resize(120, 20);
        g.show();
        QTest::mouseClick(&g.CmdNow(), Qt::LeftButton);
        QCOMPARE(g.date(), kToday);
        // The button never stays down: a second press puts today again.
        g.SetValue(0);
        QTest::mouseClick(&g.CmdNow(), Qt::LeftButton);
        QCOMPARE(g.date(), kToday);

        QTest::keyClick(&EditOf(g), Qt::Key_F2);
        QCOMPARE(g.Value(), QVariant(0));
        QTest::keyClick(&EditOf(g), Qt::Key_F3);
        QCOMPARE(g.date(), kToday);
        QTest::keyClick(&EditOf(g), Qt::Key_F4);
        auto* calendar = g.findChild<QCalendarWidget*>();
        QVERIFY(calendar && calendar->isVisible());
        QCOMPARE(calendar->selectedDate(), kToday);
        emit calendar->clicked(QDate(2026, 4, 2));
        QVERIFY(!calendar->isVisible());
        QCOMPARE(g.date(), QDate(2026, 4, 2));

        // Locked, neither keys nor typing change the date, and the button is off.
        g.SetLocked(true);
        QTest::keyClick(&EditOf(g), Qt::Key_F2);
        Type(g, u"11"_s);
        QCOMPARE(g.date(), QDate(2026, 4, 2));
        QVERIFY(!g.CmdNow().isEnabled());
        g.SetEnabled(false);
        QVERIFY(!g.TDBDate1().isEnabled());
        // Enabling also enables the button, though the box is still locked.
        g.SetEnabled(true);
        QVERIFY(g.CmdNow().isEnabled() && g.Locked());
        g.SetLocked(false);
        Type(g, u"11"_s);
        QCOMPARE(g.Text(), u"11-__-____"_s);
    }

    void layoutRules() {
        GDate g;
        g.resize(150, 40);  // 600 twips high
        g.show();
        // The today button is as high as the box less two margins of 15 twips, and the
        // editor keeps clear of it.
        QCOMPARE(g.CmdNow().geometry(), QRect(2, 1, 19, 38));
        QVERIFY(EditOf(g).geometry().left() >= g.CmdNow().geometry().right());
        // The caption takes its ratio of the width in twips, in pixels rounded half to even.
        QCOMPARE(CaptionWidthPixels(50, 75), 2);
        QCOMPARE(CaptionWidthPixels(50, 45), 2);
        QCOMPARE(CaptionWidthPixels(51, 75), 3);
    }

    void selectOnEntry() {
        QWidget window;
        auto* other = new QLineEdit(&window);
        auto* g = new GDate(&window);
        g->move(0, 40);
        g->resize(150, 20);
        g->SetValue(QDate(2023, 7, 8));
        window.show();
        QVERIFY(QTest::qWaitForWindowActive(&window));
        other->setFocus();
        QLineEdit& edit = EditOf(*g);
        QTest::mouseClick(&edit, Qt::LeftButton, {}, QPoint(edit.width() - 4, edit.height() / 2));
        QTRY_VERIFY(edit.hasFocus());
        QTest::qWait(20);
        QCOMPARE(edit.selectedText(), u"08-07-2023"_s);
    }

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

QTEST_MAIN(TestGDate)
#include "test_gdate.moc"

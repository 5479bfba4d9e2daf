// The password prompt: confirming by button or Enter, closing, the mask and the stacking
// of a long prompt.
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include "dialogs/frm_get_password.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "watchdog.h"

using namespace zv;

namespace {

void TypeText(QWidget* w, const QString& text) {
    for (const QChar ch : text) {
        QTest::sendKeyEvent(QTest::Click, w, Qt::Key_unknown, QString(ch), Qt::NoModifier);
    }
}

FrmGetPassword& AsPrompt(QWidget& w) {
    return static_cast<FrmGetPassword&>(w);
}

}  // namespace

class TestFrmGetPassword : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void confirms_data();
    void confirms();
    void closes_data();
    void closes();
    void mask_data();
    void mask();
    void longPromptPushesDown();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestFrmGetPassword::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
}

void TestFrmGetPassword::cleanup() {
    QVERIFY((*ui_)->Messages().empty());
    QCOMPARE((*ui_)->UnexpectedModals(), 0);
    ui_.reset();
    env_.reset();
}

void TestFrmGetPassword::confirms_data() {
    QTest::addColumn<int>("how");
    QTest::newRow("Enter in the text box") << 0;
    QTest::newRow("the button") << 1;
    QTest::newRow("Enter on the window") << 2;
}

void TestFrmGetPassword::confirms() {
    QFETCH(int, how);
    test::Watchdog watchdog;
    FrmGetPassword frm;
    frm.SetTeur(QStringLiteral("הקלד קוד הפעלה"));
    frm.SetPassChar(QStringLiteral("*"));
    bool shownWhileOpen = false;
    (*ui_)->QueueModal([&](QWidget& w) {
        FrmGetPassword& f = AsPrompt(w);
        shownWhileOpen = f.isVisible() && !f.IsCancel();
        TypeText(&f.Text1(), QStringLiteral("קוד5382"));
        if (how == 0) {
            QTest::keyClick(&f.Text1(), Qt::Key_Return);
        } else if (how == 1) {
            QTest::mouseClick(&f.Command1(), Qt::LeftButton);
        } else {
            QTest::keyClick(&f, Qt::Key_Enter);
        }
    });
    ShowModal(frm);
    QVERIFY(shownWhileOpen);
    QVERIFY(!frm.IsCancel());
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.Text1().text(), QStringLiteral("קוד5382"));
    QCOMPARE(frm.Label1().text(), QStringLiteral("הקלד קוד הפעלה"));
}

void TestFrmGetPassword::closes_data() {
    QTest::addColumn<bool>("escape");
    QTest::newRow("close box") << false;
    QTest::newRow("Escape") << true;
}

void TestFrmGetPassword::closes() {
    QFETCH(bool, escape);
    test::Watchdog watchdog;
    FrmGetPassword frm;
    (*ui_)->QueueModal([&](QWidget& w) {
        TypeText(&AsPrompt(w).Text1(), QStringLiteral("5382"));
        if (escape) {
            QTest::keyClick(&AsPrompt(w).Text1(), Qt::Key_Escape);
        } else {
            w.close();
        }
    });
    ShowModal(frm);
    QVERIFY(frm.IsCancel());
    QVERIFY(!frm.isVisible());
}

void TestFrmGetPassword::mask_data() {
    QTest::addColumn<QString>("passChar");
    QTest::addColumn<QString>("shown");
    QTest::newRow("masked") << QStringLiteral("*") << QStringLiteral("****");
    QTest::newRow("other mask") << QStringLiteral("#") << QStringLiteral("####");
    QTest::newRow("plain") << QString() << QStringLiteral("ab12");
}

void TestFrmGetPassword::mask() {
    QFETCH(QString, passChar);
    QFETCH(QString, shown);
    test::Watchdog watchdog;
    FrmGetPassword frm;
    frm.SetPassChar(passChar);
    QString displayed;
    (*ui_)->QueueModal([&](QWidget& w) {
        TypeText(&AsPrompt(w).Text1(), QStringLiteral("ab12"));
        displayed = AsPrompt(w).Text1().displayText();
        QTest::mouseClick(&AsPrompt(w).Command1(), Qt::LeftButton);
    });
    ShowModal(frm);
    QCOMPARE(displayed, shown);
    QCOMPARE(frm.Text1().text(), QStringLiteral("ab12"));
}

void TestFrmGetPassword::longPromptPushesDown() {
    test::Watchdog watchdog;
    struct Measure {
        int label, text, button, window;
    };
    auto measure = [this](const QString& teur) {
        FrmGetPassword frm;
        frm.SetTeur(teur);
        Measure m{};
        (*ui_)->QueueModal([&](QWidget& w) {
            FrmGetPassword& f = AsPrompt(w);
            QApplication::processEvents();
            m = {f.Label1().height(), f.Text1().y(), f.Command1().y(), f.height()};
            // Each control starts 8 pixels (120 twips) below the one above it.
            QCOMPARE(f.Text1().y(), f.Label1().geometry().bottom() + 1 + 8);
            QCOMPARE(f.Command1().y(), f.Text1().geometry().bottom() + 1 + 8);
            f.Command1().click();
        });
        ShowModal(frm);
        return m;
    };
    const Measure shortPrompt = measure(QStringLiteral("קוד"));
    const Measure longPrompt = measure(QStringLiteral(
        "הקלד את קוד ההפעלה שקיבלת ממנהל המערכת כדי לאפשר עריכה של תאריך היצירה של המסמך "
        "הזה. הקוד אינו נשמר ואינו מוצג על המסך, ויש להקליד אותו בכל פעם מחדש."));
    const int grown = longPrompt.label - shortPrompt.label;
    QVERIFY(grown > 0);
    QCOMPARE(longPrompt.text - shortPrompt.text, grown);
    QCOMPARE(longPrompt.button - shortPrompt.button, grown);
    QCOMPARE(longPrompt.window - shortPrompt.window, grown);
}

QTEST_MAIN(TestFrmGetPassword)
#include "test_frm_get_password.moc"

// Confirming the filing dialog, the creation-date unlock, the reminder fields, the input
// filters and the keyboard.

#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMimeData>
#include <QPushButton>

#include "controls/date_box.h"
#include "controls/gdate.h"
#include "dialog_fixture.h"
#include "dialogs/frm_get_password.h"
#include "dialogs/frm_get_users.h"
#include "filing_dialog/name_guard.h"
#include "util/keyboard_layout.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

namespace {

void Type(QWidget& w, QChar c) {
    QTest::sendKeyEvent(QTest::Click, &w, Qt::Key_unknown, QString(c), Qt::NoModifier);
}

// A keyboard that remembers the layout it was asked for.
class RecordingKeyboard : public KeyboardPlatform {
  public:
    QString ActiveLayoutName() override { return active_; }
    void LoadLayout(const QString& layoutId) override { active_ = layoutId; }

  private:
    QString active_ = u"00000409"_s;
};

}  // namespace

class TestDialogConfirm : public QObject {
    Q_OBJECT

  private slots:
    void refusals_data() {
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("client");
        QTest::addColumn<QString>("message");
        const QString noClient = u"חובה לבחור לקוח / תיק רלוונטים לתיוק המסמך"_s;
        QTest::newRow("no client, with a name") << u"מכתב"_s << QString() << noClient;
        QTest::newRow("no client, no name") << QString() << QString() << noClient;
        QTest::newRow("no name") << QString() << u"1001"_s << u"יש לקבוע שם לקובץ הנשמר"_s;
    }
    void refusals() {
        QFETCH(QString, name);
        QFETCH(QString, client);
        QFETCH(QString, message);
        DialogFixture f;
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
            d.SetDefultName(name);
            d.SetIsCaptureMail(true);
        });
        f.Child<QLabel>("LakNum").setText(client);
        d.show();
        f.Child<QPushButton>("CmdOK").click();
        QCOMPARE(f.Ui().Texts(), QStringList{message});
        QCOMPARE(f.Ui().Messages().front().style, int(vbCritical));
        QVERIFY(d.isVisible());
    }

    void existingFile_data() {
        QTest::addColumn<QString>("existing");  // name of a file in the target folder
        QTest::addColumn<int>("answer");
        QTest::addColumn<bool>("asked");
        QTest::addColumn<bool>("confirmed");
        QTest::newRow("no") << u"מכתב ללקוח"_s << int(vbNo) << true << false;
        QTest::newRow("yes") << u"מכתב ללקוח"_s << int(vbYes) << true << true;
        QTest::newRow("same name with extension")
            << u"מכתב ללקוח.doc"_s << int(vbNo) << false << true;
        QTest::newRow("no file") << u""_s << int(vbNo) << false << true;
    }
    void existingFile() {
        QFETCH(QString, existing);
        QFETCH(int, answer);
        QFETCH(bool, asked);
        QFETCH(bool, confirmed);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        f.Child<QLabel>("LakNum").setText(u"1001"_s);
        f.Child<QComboBox>("CboTeur").setEditText(u"תיאור חופשי"_s);
        const QString target = d.FileNameToSave();
        if (!existing.isEmpty()) {
            QFile file(f.Docs() + u"/MAILIN/"_s + existing);
            QVERIFY(file.open(QIODevice::WriteOnly));
        }
        d.show();
        f.Ui().QueueAnswer(answer);
        f.Child<QPushButton>("CmdOK").click();
        if (asked) {
            QCOMPARE(f.Ui().Texts(),
                     QStringList{u"קיים קובץ בשם זה האם לשכתבו : "_s + u"\r\n"_s + target});
            QCOMPARE(f.Ui().Messages().front().style, int(vbQuestion | vbYesNo | vbDefaultButton2));
        } else {
            QCOMPARE(f.Ui().Texts(), QStringList());
        }
        QCOMPARE(d.isVisible(), !confirmed);
        QVERIFY(!d.IsCancel());
        QCOMPARE(d.FileNameToSave(), target);
        QCOMPARE(d.Details().description, u"תיאור חופשי"_s);
    }

    void details() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load([](FrmGetDocDet& d) { d.SetPartOf(5); });
        f.Child<QLabel>("LakNum").setText(u"5"_s);
        f.Child<QLabel>("LblSug").setText(u"H"_s);
        f.Child<QLabel>("LSugTik").setText(u"4"_s);
        f.Child<QLabel>("LTik").setText(u"9"_s);
        f.Child<QLabel>("LTikNum").setText(u"9-1"_s);
        f.Child<QComboBox>("CboSecTeur").setCurrentIndex(1);
        f.Child<QLineEdit>("TxtRemark").setText(u"הערה"_s);
        f.Child<QCheckBox>("ChkIsMemo").click();
        f.Child<QCheckBox>("ChkIsJumpMemo").click();
        f.Child<GDate>("TDateMemo").SetValue(QDate(2026, 4, 1));
        d.show();
        f.Child<QPushButton>("CmdOK").click();
        QVERIFY(!d.isVisible());
        const DocDetails v = d.Details();
        QCOMPARE(v.handlers, u"דנה כהן"_s);
        QCOMPARE(v.moreDescription, u"העתק"_s);
        QCOMPARE(v.remark, u"הערה"_s);
        QVERIFY(v.reminder);
        QVERIFY(v.popup);
        QCOMPARE(v.reminderDate, QDate(2026, 4, 1));
        QCOMPARE(v.reminderTime, u"08:00"_s);
        QCOMPARE(v.receivedDate, QDate(2026, 3, 17));
        QCOMPARE(v.createdDate, QDate(2026, 3, 17));
        QVERIFY(!v.createdUnlocked);
        QCOMPARE(v.origin, std::optional<int>(5));
        QCOMPARE(v.status, std::optional<int>(2));
        QCOMPARE(v.clientNumber, u"5"_s);
        QCOMPARE(v.kindLetter, u"H"_s);
        QCOMPARE(v.subKind, u"4"_s);
        QCOMPARE(v.caseNumber, u"9"_s);
        QCOMPARE(v.caseCode, u"9-1"_s);
    }

    void unlockCreationDate_data() {
        QTest::addColumn<QString>("code");  // "-": the prompt is closed
        QTest::addColumn<bool>("unlocked");
        QTest::newRow("right code") << u"5382"_s << true;
        QTest::newRow("wrong code") << u"1234"_s << false;
        QTest::newRow("code with more") << u"53820"_s << false;
        QTest::newRow("cancelled") << u"-"_s << false;
    }
    void unlockCreationDate() {
        QFETCH(QString, code);
        QFETCH(bool, unlocked);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QString prompt;
        f.Ui().QueueModal([&](QWidget& w) {
            auto& p = dynamic_cast<FrmGetPassword&>(w);
            prompt = p.Label1().text();
            QCOMPARE(p.Text1().echoMode(), QLineEdit::Password);
            if (code == QLatin1String("-")) {
                p.Text1().setText(u"5382"_s);
                p.close();
            } else {
                p.Text1().setText(code);
                p.Command1().click();
            }
        });
        f.Child<QPushButton>("Command3").click();
        QCOMPARE(prompt, u"קלוט סיסמא לשינוי תאריך היצירה"_s);
        QCOMPARE(f.Child<GDate>("TDate").Enabled(), unlocked);
        QCOMPARE(d.Details().createdUnlocked, unlocked);
        if (unlocked) {
            QCOMPARE(f.Ui().Texts(), QStringList{u"ניתן כעת לערוך את תאריך יצירה ולשמור"_s});
            QCOMPARE(f.Ui().Messages().front().style, int(vbExclamation));
        } else {
            QCOMPARE(f.Ui().Texts(), QStringList());
        }
        QCOMPARE(f.Ui().UnexpectedModals(), 0);
    }

    void handlerPicker_data() {
        QTest::addColumn<QStringList>("pick");  // "-": the picker is closed
        QTest::addColumn<QString>("shown");
        QTest::newRow("two users") << QStringList{"יוסי לוי", "מיכל ברק"} << u"יוסי לוי;מיכל ברק"_s;
        QTest::newRow("nobody") << QStringList{} << u"דנה כהן"_s;
        QTest::newRow("closed") << QStringList{"-"} << u"משה לוי"_s;
    }
    void handlerPicker() {
        QFETCH(QStringList, pick);
        QFETCH(QString, shown);
        DialogFixture f;
        FrmGetDocDet& d = f.Load([](FrmGetDocDet& d) { d.SetDefaultMetapel("משה לוי"); });
        d.show();
        QString start;
        bool all = false;
        f.Ui().QueueModal([&](QWidget& w) {
            auto& picker = dynamic_cast<FrmGetUsers&>(w);
            start = picker.StartUsers();
            all = picker.WithAllUsers();
            if (pick == QStringList{u"-"_s}) {
                picker.close();
                return;
            }
            picker.List1().clearSelection();
            for (int i = 0; i < picker.List1().count(); ++i) {
                picker.List1().item(i)->setSelected(pick.contains(picker.List1().item(i)->text()));
            }
            picker.Command1().click();
        });
        f.Child<QPushButton>("CmdListOpen").click();
        QCOMPARE(start, u"משה לוי"_s);
        QVERIFY(all);
        QCOMPARE(f.Child<QLabel>("LPersonal").text(), shown);
        QCOMPARE(d.Details().handlers, shown);
    }

    void currentTimeAndReminder() {
        DialogFixture f;
        f.Load();
        auto& now = f.Child<QPushButton>("CmdNow");
        now.click();
        QCOMPARE(f.Child<QLineEdit>("TDBTime1").text(), u"14:05"_s);
        QVERIFY(!now.isChecked());

        auto& memo = f.Child<QCheckBox>("ChkIsMemo");
        auto& popup = f.Child<QCheckBox>("ChkIsJumpMemo");
        QVERIFY(!popup.isEnabled());
        memo.click();
        QVERIFY(popup.isEnabled());
        popup.click();
        memo.click();
        QVERIFY(!popup.isEnabled());
        QVERIFY(popup.isChecked());
    }

    void inputFilters_data() {
        QTest::addColumn<QString>("control");
        QTest::addColumn<QString>("typed");
        QTest::addColumn<bool>("changes");
        QTest::newRow("date: letter") << u"TDate"_s << u"a"_s << false;
        QTest::newRow("date: digit") << u"TDateMemo"_s << u"3"_s << true;
        QTest::newRow("time: letter") << u"TDBTime1"_s << u"a"_s << false;
        QTest::newRow("time: backspace") << u"TDBTime1"_s << u"\b"_s << false;
        QTest::newRow("time: slash") << u"TDBTime1"_s << u"/"_s << false;
        QTest::newRow("time: digit") << u"TDBTime1"_s << u"9"_s << true;
        QTest::newRow("time: colon") << u"TDBTime1"_s << u":"_s << true;
    }
    void inputFilters() {
        QFETCH(QString, control);
        QFETCH(QString, typed);
        QFETCH(bool, changes);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        f.Child<GDate>("TDate").SetEnabled(true);
        QLineEdit* edit = control == QLatin1String("TDBTime1")
                              ? &f.Child<QLineEdit>("TDBTime1")
                              : &f.Child<GDate>(qPrintable(control)).TDBDate1().Edit();
        edit->setFocus();
        edit->setCursorPosition(edit->text().size());
        const QString before = edit->text();
        // A refused character never reaches the date box, so it does not count as invalid
        // input there either.
        int invalid = 0;
        if (control != QLatin1String("TDBTime1")) {
            connect(&f.Child<GDate>(qPrintable(control)), &GDate::InvalidInput, this,
                    [&] { ++invalid; });
        }
        if (typed == QLatin1String("\b")) {
            QTest::sendKeyEvent(QTest::Click, edit, Qt::Key_Backspace, typed, Qt::NoModifier);
        } else {
            edit->selectAll();
            Type(*edit, typed.front());
        }
        QCOMPARE(edit->text() != before, changes);
        QCOMPARE(invalid, 0);
        // Keys without a character pass the filters.
        edit->setCursorPosition(0);
        QTest::keyClick(edit, Qt::Key_Right);
        QCOMPARE(edit->cursorPosition(), 1);
    }

    void forbiddenNameChars_data() {
        QTest::addColumn<QString>("how");
        QTest::addColumn<QString>("input");
        QTest::newRow("typed colon") << u"type"_s << u":"_s;
        QTest::newRow("typed backslash") << u"type"_s << u"\\"_s;
        QTest::newRow("pasted path") << u"paste"_s << u"..\\..\\x"_s;
        QTest::newRow("dropped quote") << u"drop"_s << u"a\"b"_s;
    }
    void forbiddenNameChars() {
        QFETCH(QString, how);
        QFETCH(QString, input);
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        auto& name = f.Child<QLineEdit>("TxtTeur");
        name.setFocus();
        name.setCursorPosition(2);
        const QString before = name.text();
        const QString target = d.FileNameToSave();
        if (how == QLatin1String("type")) {
            Type(name, input.front());
        } else if (how == QLatin1String("paste")) {
            QApplication::clipboard()->setText(input);
            QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
        } else {
            auto* mime = new QMimeData;
            mime->setText(input);
            const QPoint at = name.rect().center();
            QDragEnterEvent enter(at, Qt::CopyAction, mime, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(&name, &enter);
            QDropEvent drop(at, Qt::CopyAction, mime, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(&name, &drop);
            delete mime;
        }
        QCOMPARE(name.text(), before);
        QCOMPARE(f.Ui().Texts(), QStringList{ForbiddenNameMessage()});
        QCOMPARE(ForbiddenNameMessage(),
                 u"אסור לקלוט כחלק משם קובץ את התווים הבאים : /\\:*?\"<>|"_s);
        QCOMPARE(f.Ui().Messages().front().style, int(vbCritical));
        QCOMPARE(d.FileNameToSave(), target);
        // Allowed text still goes in the same way.
        f.Ui().Clear();
        if (how == QLatin1String("paste")) {
            QApplication::clipboard()->setText(u"-2"_s);
            QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
        } else {
            name.end(false);
            Type(name, QLatin1Char('7'));
        }
        QVERIFY(name.text() != before);
        QCOMPARE(f.Ui().Texts(), QStringList());
        QCOMPARE(d.FileNameToSave(), d.DirToSave() + name.text());
    }

    void hebrewKeyboardOnFocus_data() {
        QTest::addColumn<QString>("control");
        QTest::addColumn<QString>("layout");
        QTest::newRow("name") << u"TxtTeur"_s << u"0000040D"_s;
        QTest::newRow("remark") << u"TxtRemark"_s << u"0000040D"_s;
        QTest::newRow("time") << u"TDBTime1"_s << u"00000409"_s;
    }
    void hebrewKeyboardOnFocus() {
        QFETCH(QString, control);
        QFETCH(QString, layout);
        DialogFixture f;
        auto previous = SetKeyboardPlatform(std::make_unique<RecordingKeyboard>());
        FrmGetDocDet& d = f.Load();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        d.activateWindow();
        f.Child<QPushButton>("CmdLak").setFocus();
        f.Child<QLineEdit>(qPrintable(control)).setFocus();
        QTRY_VERIFY(f.Child<QLineEdit>(qPrintable(control)).hasFocus());
        QCOMPARE(CurrentKeyboardPlatform().ActiveLayoutName(), layout);
        SetKeyboardPlatform(std::move(previous));
    }

    void focusAndEnter() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        f.Child<QWidget>("FolderView1").show();
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        // The first step has the focus; Enter in a text box confirms.
        QCOMPARE(QApplication::focusWidget(), &f.Child<QWidget>("CmdLak"));
        f.Child<QLineEdit>("TxtRemark").setFocus();
        QTest::keyClick(&f.Child<QLineEdit>("TxtRemark"), Qt::Key_Return);
        QCOMPARE(f.Ui().Texts(), QStringList{u"חובה לבחור לקוח / תיק רלוונטים לתיוק המסמך"_s});
    }
};

QTEST_MAIN(TestDialogConfirm)
#include "test_dialog_confirm.moc"

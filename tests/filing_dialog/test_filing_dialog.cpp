// The filing dialog on a sample installation: the lists and defaults it opens with, the
// target folder and name, confirming, the creation-date unlock, the filters and the keyboard.

#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <cstdlib>

#include "controls/date_box.h"
#include "controls/gdate.h"
#include "dialog_fixture.h"
#include "dialogs/frm_get_password.h"
#include "dialogs/frm_get_users.h"
#include "filing_dialog/folder_view.h"
#include "recording_keyboard.h"
#include "test_files.h"
#include "util/keyboard_layout.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;
using zv::test::DialogFixture;

namespace {

// The name DialogFixture proposes.
const QString kName = u"מכתב ללקוח"_s;

QStringList Texts(const QComboBox& box) {
    QStringList out;
    for (int i = 0; i < box.count(); ++i) {
        out << box.itemText(i);
    }
    return out;
}

FrmGetDocDet& Shown(DialogFixture& f, const std::function<void(FrmGetDocDet&)>& preset = {}) {
    FrmGetDocDet& d = f.Load(preset);
    d.show();
    if (!QTest::qWaitForWindowExposed(&d)) {
        qFatal("the filing dialog is not shown");
    }
    return d;
}

}  // namespace

class TestFilingDialog : public QObject {
    Q_OBJECT

  private slots:
    void listsAndDefaults() {
        DialogFixture f;
        // Descriptions out of order, a text with blanks around it, codes of other lists; a user
        // case kind without a name.
        f.Exec(u"OFFICE"_s, u"DELETE FROM OFF_CODE WHERE CODE=20"_s);
        f.Exec(u"OFFICE"_s,
               u"INSERT INTO OFF_CODE (CODE, NUM, Teur) VALUES (20, 2, ' חוזה '), "
               "(20, 1, 'מכתב'), (20, 10, 'פסק דין')"_s);
        f.Exec(u"OFFICE"_s, u"INSERT INTO MTIK (ID, TEUR, SHOW) VALUES (3, NULL, 1)"_s);
        FrmGetDocDet& d = f.Load();
        QCOMPARE(f.Ui().Texts(), QStringList());

        QCOMPARE(Texts(f.Child<QComboBox>("CboTeur")), QStringList({"מכתב", "חוזה", "פסק דין"}));
        auto& status = f.Child<QComboBox>("CboStatus");
        QCOMPARE(Texts(status),
                 QStringList({"1 - חדש", "2 - בטיפול", "4 - ממתין לתגובה", "3 - סגור"}));
        QCOMPARE(status.currentText(), u"2 - בטיפול"_s);
        // The origins' codes are text and sort as numbers: "10" last.
        const QStringList origins = Texts(f.Child<QComboBox>("CboPartOf"));
        QCOMPARE(origins.last(), u"10 - אחר"_s);
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").currentIndex(), -1);
        QCOMPARE(f.Child<QLabel>("LGlobalNum").text(), u"23/100/1"_s);
        const DocDetails v = d.Details();
        QCOMPARE(QList<QDate>({v.createdDate, v.receivedDate, v.reminderDate}),
                 QList<QDate>(3, QDate(2026, 3, 17)));
        QVERIFY(!v.createdUnlocked && !v.reminder);
        QCOMPARE(QStringList({v.reminderTime, v.handlers, v.description}),
                 QStringList({"08:00", "דנה כהן", ""}));
        QCOMPARE(v.origin, std::optional<int>(1));

        // The proposed name is selected, so typing replaces it.
        QCOMPARE(f.Child<QLineEdit>("TxtTeur").selectedText(), kName);

        const QString mailIn = f.Docs() + u"/MAILIN"_s;
        QVERIFY(f.Child<FolderView>("FolderView1").isHidden());
        QCOMPARE(f.Child<FolderView>("FolderView1").SelectedPath(), mailIn);
        QCOMPARE(f.Child<QLabel>("LDir").text(), mailIn);
        QCOMPARE(d.FileNameToSave(), mailIn + u'/' + kName);

        // The fixed case kinds and the shown user kinds, named without blanks.
        QCOMPARE(OptKeyNames().size(), 22);
        QCOMPARE(OptKeyNames().value(u"1028"_s), u"תיקי הוצאה לפועל"_s);
        QCOMPARE(OptKeyNames().value(u"1003"_s, u"-"_s), QString());
        QVERIFY(!OptKeyNames().contains(u"1029"_s));
    }

    void presets() {
        // Status and origin preset, the texts selected and whether the origin is locked.
        const struct {
            int status, partOf;
            const char *statusText, *originText;
            bool locked;
        } cases[] = {{3, 5, "3 - סגור", "5 - סריקה", true},
                     {9, 0, "", "1 - דואר", false},
                     {1, 99, "1 - חדש", "", false}};
        for (const auto& c : cases) {
            DialogFixture f;
            FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
                d.SetStatus(int16_t(c.status));
                d.SetPartOf(int16_t(c.partOf));
            });
            const QString name = u"status %1, origin %2"_s.arg(c.status).arg(c.partOf);
            auto& origin = f.Child<QComboBox>("CboPartOf");
            QVERIFY2(
                f.Child<QComboBox>("CboStatus").currentText() == QString::fromUtf8(c.statusText),
                qPrintable(name));
            QVERIFY2(origin.currentText() == QString::fromUtf8(c.originText), qPrintable(name));
            QVERIFY2(origin.isEnabled() != c.locked, qPrintable(name));
            // What is stored: the code, or nothing when none is selected.
            QVERIFY2(d.Details().status.value_or(0) == atoi(c.statusText), qPrintable(name));
            QVERIFY2(d.Details().origin.value_or(0) == atoi(c.originText), qPrintable(name));
            // The list after the origins fills whatever the origin did.
            QCOMPARE(f.Child<QComboBox>("CboDocBasic").count(), SampleDocBasicFolders().size());
            QCOMPARE(f.Ui().Texts(), QStringList());
        }
    }

    void failingReadsAreReported() {
        DialogFixture f;
        f.Exec(u"OFFICE"_s, u"DROP TABLE MTIK"_s);
        f.Exec(u"MDOCS"_s, u"DROP TABLE DOCSTATUS"_s);
        f.Load();
        const QStringList texts = f.Ui().Texts();
        QCOMPARE(texts.size(), 2);
        // The fixed case kinds stay.
        QVERIFY2(texts[0].contains(u"-0-SetOptKeyLakTik-"_s), qPrintable(texts[0]));
        QCOMPARE(OptKeyNames().size(), 18);
        QCOMPARE(OptKeyNames().value(u"18"_s), u"מומחים"_s);
        // A list that cannot be read leaves the lists after it empty; the rest of the load runs.
        QVERIFY2(texts[1].contains(u"-0-InitCbo10-"_s), qPrintable(texts[1]));
        QVERIFY(f.Child<QComboBox>("CboSecTeur").count() > 0);
        QCOMPARE(f.Child<QComboBox>("CboStatus").count(), 0);
        QCOMPARE(f.Child<QComboBox>("CboPartOf").count(), 0);
        QCOMPARE(f.Child<QComboBox>("CboDocBasic").count(), 0);
        QCOMPARE(f.Child<QLineEdit>("TDBTime1").text(), u"08:00"_s);
    }

    void startFolder_data() {
        QTest::addColumn<QString>("start");     // below the data folder; "-" outside it
        QTest::addColumn<QString>("selected");  // below the data folder
        QTest::newRow("empty") << u""_s << u"DOCS/MAILIN"_s;
        QTest::newRow("inside the archive") << u"DOCS/DOC1001"_s << u"DOCS/DOC1001"_s;
        QTest::newRow("the archive itself") << u"DOCS"_s << u"DOCS"_s;
        QTest::newRow("outside the archive") << u"-"_s << u"DOCS/MAILIN"_s;
    }
    void startFolder() {
        QFETCH(QString, start);
        QFETCH(QString, selected);
        DialogFixture f;
        // MAILIN is made again when it is missing.
        QDir(f.Docs() + u"/MAILIN"_s).removeRecursively();
        QVERIFY(QDir().mkpath(f.Docs() + u"/DOC1001"_s));
        const QString startDir = start.isEmpty()   ? QString()
                                 : start == u"-"_s ? f.Root()
                                                   : f.DataDir() + u'/' + start;
        FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) { d.SetStartDir(startDir); });
        QVERIFY(QFileInfo(f.Docs() + u"/MAILIN"_s).isDir());
        const QString want = f.DataDir() + u'/' + selected;
        QCOMPARE(f.Child<FolderView>("FolderView1").SelectedPath(), want);
        QCOMPARE(d.FileNameToSave(), want + u'/' + kName);
    }

    void unidentifiedInstallation() {
        SampleOptions options;
        options.writeSettings = false;
        DialogFixture f(options);
        FrmGetDocDet& d = Shown(f);
        const auto& m = f.Ui().Messages();
        QVERIFY(!m.empty());
        QCOMPARE(m.back().text, u"אין זיהוי של עבודה בזורבן במחשב זה"_s);
        QCOMPARE(m.back().style, int(vbCritical));
        QCOMPARE(f.Child<QComboBox>("CboStatus").count(), 0);
        QCOMPARE(f.Child<QLineEdit>("TxtTeur").text(), QString());
        // It can still be closed, and that cancels.
        QTest::keyClick(&d, Qt::Key_Escape);
        QVERIFY(d.IsCancel());
        QVERIFY(d.isHidden());
    }

    // An emptied name keeps the last target; only a document asks for a name.
    void nameBox() {
        for (const char* kind : {"document", "mail", "scan"}) {
            DialogFixture f;
            FrmGetDocDet& d = f.Load([&](FrmGetDocDet& d) {
                d.SetIsCaptureMail(qstrcmp(kind, "mail") == 0);
                d.SetIsFromScan(qstrcmp(kind, "scan") == 0);
            });
            const QString target = f.Docs() + u"/MAILIN/חוזה שכירות"_s;
            auto& name = f.Child<QLineEdit>("TxtTeur");
            name.setText(u"חוזה שכירות"_s);
            QCOMPARE(d.FileNameToSave(), target);
            name.clear();
            QCOMPARE(d.FileNameToSave(), target);
            QCOMPARE(f.Child<QLabel>("LFileName").text(), target);
            const QStringList asked{u"חובה לקבוע שם למסמך שישמר"_s};
            QVERIFY2(f.Ui().Texts() == (qstrcmp(kind, "document") == 0 ? asked : QStringList()),
                     kind);
        }
    }

    void clientButton() {
        DialogFixture f;
        FrmGetDocDet& d = Shown(f);
        f.Child<QLabel>("LakNum").setText(u"5"_s);
        f.Child<QLabel>("LTik").setText(u"9"_s);
        auto& tree = f.Child<FolderView>("FolderView1");
        // Closing the client list changes nothing.
        f.Ui().QueueModal([](QWidget& list) { list.close(); });
        f.Child<QPushButton>("CmdLak").click();
        QCOMPARE(f.Child<QLabel>("LTik").text(), u"9"_s);
        QVERIFY(!tree.isVisible());
        // A new client shows the tree on the client's folder and clears the case.
        f.Ui().QueueModal([](QWidget& list) { list.findChild<QPushButton*>(u"CmdOK"_s)->click(); });
        f.Child<QPushButton>("CmdLak").click();
        QCOMPARE(f.Child<QLabel>("LakNum").text(), u"1001"_s);
        QCOMPARE(f.Child<QLabel>("LblSug").text(), u"F"_s);
        QCOMPARE(f.Child<QLabel>("LTik").text(), QString());
        QVERIFY(tree.isVisible());
        QCOMPARE(d.FileNameToSave(), f.Docs() + u"/DOC1001/"_s + kName);
    }

    void folderViewStaysInTheArchive() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        auto& tree = f.Child<FolderView>("FolderView1");
        tree.show();
        d.resize(1000, 800);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        // The folder chosen while the tree was hidden is the one it shows.
        QCOMPARE(tree.currentIndex().data().toString(), u"MAILIN"_s);

        // Nothing outside the archive can be selected.
        QVERIFY(!tree.SelectPath(f.DataDir() + u"/Def"_s));
        QVERIFY(!tree.SelectPath(f.Docs() + u"/../Def"_s));
        QCOMPARE(tree.SelectedPath(), f.Docs() + u"/MAILIN"_s);

        // The archive is the only entry at the top of the tree.
        auto* model = tree.model();
        const QModelIndex top = tree.rootIndex();
        QTRY_VERIFY(model->rowCount(top) > 1);
        QStringList shown;
        for (int row = 0; row < model->rowCount(top); ++row) {
            if (!tree.isRowHidden(row, top)) {
                shown << model->index(row, 0, top).data().toString();
            }
        }
        QCOMPARE(shown, QStringList{u"DOCS"_s});

        // A folder made a moment ago is selected and shown at once.
        const QString fresh = f.Docs() + u"/DOC77/N/3"_s;
        QVERIFY(QDir().mkpath(fresh));
        QVERIFY(tree.SelectPath(fresh));
        QCOMPARE(tree.currentIndex().data().toString(), u"3"_s);

        // A click reports the folder into LDir and the target follows.
        const QModelIndex docs = tree.currentIndex().parent().parent().parent();
        tree.scrollTo(docs);
        QTest::mouseClick(tree.viewport(), Qt::LeftButton, {}, tree.visualRect(docs).center());
        QCOMPARE(f.Child<QLabel>("LDir").text(), f.Docs());
        QCOMPARE(d.FileNameToSave(), f.Docs() + u'/' + kName);
    }

    void innerFolderAndNumbering() {
        DialogFixture f;
        FrmGetDocDet& d = f.Load();
        f.Child<QLabel>("LakNum").setText(u"5"_s);
        f.Child<QLabel>("LblSug").setText(u"F"_s);
        d.RefreshDocsFolder();
        const QString folder = f.Docs() + u"/DOC5"_s;
        auto& inner = f.Child<QComboBox>("CboDocBasic");
        auto& nested = f.Child<QRadioButton>("Option1_1");
        nested.click();
        QCOMPARE(inner.currentIndex(), 0);
        const QString first = folder + u'/' + inner.itemText(0);
        QCOMPARE(d.FileNameToSave(), first + u'/' + kName);
        QVERIFY(QFileInfo(first).isDir());
        f.Child<QRadioButton>("Option1_0").click();
        QCOMPARE(inner.currentIndex(), -1);
        QCOMPARE(d.FileNameToSave(), folder + u'/' + kName);
        inner.setCurrentIndex(1);
        QVERIFY(nested.isChecked());
        const QString second = folder + u'/' + inner.itemText(1);
        QCOMPARE(d.FileNameToSave(), second + u'/' + kName);

        // Numbering counts the folder of the tree, not the inner one; a source type without a
        // letter keeps the proposed name.
        for (const char* file : {"T1.doc", "S7.pdf", "t12.docx", "Tax.doc"}) {
            QVERIFY(test::WriteFile(folder + u'/' + QLatin1String(file), {}));
        }
        QVERIFY(test::WriteFile(second + u"/T50.doc"_s, {}));
        const std::pair<QString, QString> cases[] = {{u"doc"_s, u"T13"_s}, {u"xlsx"_s, kName}};
        for (const auto& [ext, name] : cases) {
            SetSourceExt(ext);
            f.Child<QLineEdit>("TxtTeur").setText(u"שם אחר"_s);
            f.Child<QPushButton>("CmdMPlus").click();
            QCOMPARE(f.Child<QLineEdit>("TxtTeur").text(), name);
            QCOMPARE(d.FileNameToSave(), second + u'/' + name);
        }
        QCOMPARE(f.Ui().Texts(), QStringList());
    }

    // The refusals, the name clash and what the confirmed dialog holds.
    void confirming() {
        DialogFixture f;
        FrmGetDocDet& d = Shown(f, [](FrmGetDocDet& d) {
            d.SetDefultName(QString());
            d.SetIsCaptureMail(true);
            d.SetPartOf(5);
        });
        auto& ok = f.Child<QPushButton>("CmdOK");
        // The first step has the focus; Enter in a text box confirms like the button.
        QCOMPARE(QApplication::focusWidget(), &f.Child<QWidget>("CmdLak"));
        auto& remark = f.Child<QLineEdit>("TxtRemark");
        remark.setText(u"הערה"_s);
        remark.setFocus();
        QTest::keyClick(&remark, Qt::Key_Return);
        const QStringList choice{u"5"_s, u"H"_s, u"4"_s, u"9"_s, u"9-1"_s};
        const char* labels[] = {"LakNum", "LblSug", "LSugTik", "LTik", "LTikNum"};
        for (int i = 0; i < 5; ++i) {
            f.Child<QLabel>(labels[i]).setText(choice[i]);
        }
        ok.click();
        QCOMPARE(f.Ui().Texts(), QStringList({"חובה לבחור לקוח / תיק רלוונטים לתיוק המסמך",
                                              "יש לקבוע שם לקובץ הנשמר"}));
        QCOMPARE(f.Ui().Messages().back().style, int(vbCritical));
        QVERIFY(d.isVisible());
        f.Ui().Clear();

        // A file of the same name with an extension is no clash.
        f.Child<QLineEdit>("TxtTeur").setText(kName);
        const QString target = d.FileNameToSave();
        QVERIFY(test::WriteFile(target + u".doc"_s, {}));
        ok.click();
        QVERIFY(!d.isVisible());
        // One without is: No, the default, keeps the dialog open; Yes confirms.
        d.show();
        QVERIFY(test::WriteFile(target, {}));
        f.Ui().QueueAnswer(vbNo);
        ok.click();
        QVERIFY(d.isVisible());

        f.Child<QComboBox>("CboTeur").setEditText(u"תיאור חופשי"_s);
        f.Child<QComboBox>("CboSecTeur").setCurrentIndex(1);
        // The current time, from a button that never stays down.
        auto& now = f.Child<QPushButton>("CmdNow");
        now.click();
        QVERIFY(!now.isChecked());
        // The pop-up box is open only with a reminder, and keeps its tick when closed.
        auto& memo = f.Child<QCheckBox>("ChkIsMemo");
        auto& popup = f.Child<QCheckBox>("ChkIsJumpMemo");
        memo.click();
        popup.click();
        memo.click();
        QVERIFY(!popup.isEnabled());
        memo.click();
        f.Child<GDate>("TDateMemo").SetValue(QDate(2026, 4, 1));
        f.Ui().QueueAnswer(vbYes);
        ok.click();
        QVERIFY(!d.isVisible());
        QCOMPARE(f.Ui().Texts(), QStringList(2, u"קיים קובץ בשם זה האם לשכתבו : \r\n"_s + target));
        QCOMPARE(f.Ui().Messages().front().style, int(vbQuestion | vbYesNo | vbDefaultButton2));

        QVERIFY(!d.IsCancel());
        QCOMPARE(d.FileNameToSave(), target);
        const DocDetails v = d.Details();
        QCOMPARE(QStringList({v.clientNumber, v.kindLetter, v.subKind, v.caseNumber, v.caseCode}),
                 choice);
        QCOMPARE(
            QStringList({v.handlers, v.description, v.moreDescription, v.remark, v.reminderTime}),
            QStringList({"דנה כהן", "תיאור חופשי", "העתק", "הערה", "14:05"}));
        QVERIFY(v.reminder && v.popup && !v.createdUnlocked);
        QCOMPARE(QList<QDate>({v.reminderDate, v.receivedDate, v.createdDate}),
                 QList<QDate>({QDate(2026, 4, 1), QDate(2026, 3, 17), QDate(2026, 3, 17)}));
        QCOMPARE(v.origin, std::optional<int>(5));
        QCOMPARE(v.status, std::optional<int>(2));
    }

    // The buttons that open a picker: the creation-date unlock and the handlers.
    void pickers() {
        DialogFixture f;
        FrmGetDocDet& d = Shown(f, [](FrmGetDocDet& d) { d.SetDefaultMetapel(u"משה לוי"_s); });
        // Escape closes the prompt: the right code typed then does not count.
        auto unlock = [&](const QString& code, Qt::Key key) {
            f.Ui().QueueModal([=](QWidget& w) {
                auto& p = dynamic_cast<FrmGetPassword&>(w);
                QCOMPARE(p.Label1().text(), u"קלוט סיסמא לשינוי תאריך היצירה"_s);
                QCOMPARE(p.Text1().echoMode(), QLineEdit::Password);
                p.Text1().setText(code);
                QTest::keyClick(&p.Text1(), key);
            });
            f.Child<QPushButton>("Command3").click();
            return d.Details().createdUnlocked;
        };
        QVERIFY(!unlock(u"5382"_s, Qt::Key_Escape));
        QVERIFY(!unlock(u"53820"_s, Qt::Key_Return));
        QVERIFY(f.Ui().Messages().empty());
        QVERIFY(unlock(u"5382"_s, Qt::Key_Return));
        QCOMPARE(f.Ui().Texts(), QStringList{u"ניתן כעת לערוך את תאריך יצירה ולשמור"_s});
        QCOMPARE(f.Ui().Messages().front().style, int(vbExclamation));

        // Closing the user picker keeps the handlers; choosing nobody shows the current user.
        auto pick = [&](const std::optional<QStringList>& names) {
            const QString before = d.Details().handlers;
            f.Ui().QueueModal([&](QWidget& w) {
                auto& picker = dynamic_cast<FrmGetUsers&>(w);
                QCOMPARE(picker.StartUsers(), before);
                QVERIFY(picker.WithAllUsers());
                for (int i = 0; names && i < picker.List1().count(); ++i) {
                    QListWidgetItem* item = picker.List1().item(i);
                    item->setSelected(names->contains(item->text()));
                }
                names ? picker.Command1().click() : picker.reject();
            });
            f.Child<QPushButton>("CmdListOpen").click();
            return d.Details().handlers;
        };
        QCOMPARE(pick(std::nullopt), u"משה לוי"_s);
        QCOMPARE(pick(QStringList{u"יוסי לוי"_s, u"מיכל ברק"_s}), u"יוסי לוי;מיכל ברק"_s);
        QCOMPARE(pick(QStringList{}), u"דנה כהן"_s);
        QCOMPARE(f.Ui().UnexpectedModals(), 0);
    }

    // The filters of the time, date and name boxes, and the Hebrew layout on the text boxes.
    void keyboard() {
        DialogFixture f;
        FrmGetDocDet& d = Shown(f);
        QLineEdit& time = f.Child<QLineEdit>("TDBTime1");
        QLineEdit& date = f.Child<GDate>("TDateMemo").TDBDate1().Edit();
        int invalid = 0;
        connect(&f.Child<GDate>("TDateMemo"), &GDate::InvalidInput, this, [&] { ++invalid; });
        // Whether a key typed over the whole text changes it.
        auto changes = [](QLineEdit& edit, Qt::Key key, QChar c) {
            edit.setFocus();
            edit.selectAll();
            const QString before = edit.text();
            QTest::sendKeyEvent(QTest::Click, &edit, key, QString(c), Qt::NoModifier);
            return edit.text() != before;
        };
        // Backspace is filtered like a character; each box refuses what the other takes.
        QVERIFY(!changes(time, Qt::Key_Slash, u'/'));
        QVERIFY(!changes(time, Qt::Key_Backspace, u'\b'));
        QVERIFY(changes(time, Qt::Key_Colon, u':'));
        QVERIFY(!changes(date, Qt::Key_A, u'a'));
        QVERIFY(changes(date, Qt::Key_3, u'3'));
        QTest::keyClick(&date, Qt::Key_F2);  // an unfinished date left behind is reported
        // A refused character never reaches the date box as invalid input.
        QCOMPARE(invalid, 0);
        // Keys without a character pass.
        time.setCursorPosition(0);
        QTest::keyClick(&time, Qt::Key_Right);
        QCOMPARE(time.cursorPosition(), 1);

        // In the name, a forbidden character typed is refused; pasted, the name is put back.
        auto& name = f.Child<QLineEdit>("TxtTeur");
        name.setFocus();
        const QString target = d.FileNameToSave();
        for (const bool paste : {false, true}) {
            name.setCursorPosition(2);
            if (paste) {
                QApplication::clipboard()->setText(u"..\\..\\x"_s);
                QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
            } else {
                QTest::keyClick(&name, ':');
            }
            QCOMPARE(name.text(), kName);
            QCOMPARE(f.Ui().Texts(),
                     QStringList{u"אסור לקלוט כחלק משם קובץ את התווים הבאים : /\\:*?\"<>|"_s});
            QCOMPARE(f.Ui().Messages().front().style, int(vbCritical));
            QCOMPARE(d.FileNameToSave(), target);
            f.Ui().Clear();
        }
        // Allowed text still goes in both ways.
        name.setCursorPosition(2);
        QApplication::clipboard()->setText(u"-2"_s);
        QTest::keyClick(&name, Qt::Key_V, Qt::ControlModifier);
        QTest::keyClick(&name, '7');
        QCOMPARE(name.text(), kName.left(2) + u"-27"_s + kName.mid(2));
        QCOMPARE(f.Ui().Texts(), QStringList());
        QCOMPARE(d.FileNameToSave(), d.DirToSave() + name.text());

        d.activateWindow();
        const std::pair<const char*, QString> layouts[] = {
            {"TDBTime1", u"00000409"_s}, {"TxtTeur", u"0000040D"_s}, {"TxtRemark", u"0000040D"_s}};
        for (const auto& [control, layout] : layouts) {
            // Each starts on the English layout.
            test::ScopedRecordingKeyboard keyboard;
            f.Child<QPushButton>("CmdLak").setFocus();
            f.Child<QLineEdit>(control).setFocus();
            QTRY_VERIFY(f.Child<QLineEdit>(control).hasFocus());
            QVERIFY2(CurrentKeyboardPlatform().ActiveLayoutName() == layout, control);
        }
    }
};

QTEST_MAIN(TestFilingDialog)
#include "test_filing_dialog.moc"

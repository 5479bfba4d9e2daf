// The small modal dialogs: the password prompt, save-as and the user picker over the
// PUB.MDB of a sample installation.
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QtTest>

#include "dialogs/frm_get_password.h"
#include "dialogs/frm_get_users.h"
#include "dialogs/frm_save_as.h"
#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/state.h"
#include "watchdog.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;

namespace {

// The sample installation's user and three of its office's users.
const QString kDana = u"דנה כהן"_s;
const QString kYossi = u"יוסי לוי"_s;
const QString kMichal = u"מיכל ברק"_s;
const QString kRon = u"עו\"ד רון שמיר"_s;

enum How { kButton, kEnter, kCloseBox, kEscape, kCancelButton };

// Ends a dialog the way a user would: a button, Enter or Escape in a field, the close box.
void Answer(QWidget& window, QWidget& field, QAbstractButton& button, How how) {
    if (how == kButton) {
        QTest::mouseClick(&button, Qt::LeftButton);
    } else if (how == kCloseBox) {
        window.close();
    } else {
        QTest::keyClick(&field, how == kEscape ? Qt::Key_Escape : Qt::Key_Return);
    }
}

}  // namespace

class TestDialogs : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init() {
        watchdog_ = std::make_unique<test::Watchdog>();
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
        CreateSampleInstallation(env_->DataDir(), {});
        SetMainPath(env_->DataDir());
        SetUserCode(u"100"_s);
    }
    void cleanup() {
        QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
        QCOMPARE((*ui_)->UnexpectedModals(), 0);
        ui_.reset();
        env_.reset();
        watchdog_.reset();
    }

    // Every way of closing a picker, checked on the password prompt.
    void passwordAnswers_data() {
        QTest::addColumn<int>("how");
        QTest::addColumn<QString>("passChar");  // empty: what is typed shows
        QTest::newRow("button, unmasked") << int(kButton) << QString();
        QTest::newRow("Enter in the text box") << int(kEnter) << u"#"_s;
        QTest::newRow("close box") << int(kCloseBox) << u"*"_s;
        QTest::newRow("Escape") << int(kEscape) << u"*"_s;
    }
    void passwordAnswers() {
        QFETCH(int, how);
        QFETCH(QString, passChar);
        FrmGetPassword frm;
        frm.SetPassChar(passChar);
        QString displayed;
        (*ui_)->QueueModal([&](QWidget&) {
            QTest::keyClicks(&frm.Text1(), u"ab12"_s);
            displayed = frm.Text1().displayText();
            Answer(frm, frm.Text1(), frm.Command1(), How(how));
        });
        ShowModal(frm);
        QCOMPARE(displayed, passChar.isEmpty() ? u"ab12"_s : passChar.repeated(4));
        QCOMPARE(frm.IsCancel(), how == kCloseBox || how == kEscape);
        QVERIFY(!frm.isVisible());
        QCOMPARE(frm.Text1().text(), u"ab12"_s);
    }

    void saveAs() {
        const QStringList word = {u"Doc"_s, u"Docx"_s};
        const struct {
            const char* name;
            QString fileName;
            int16_t sug;
            QString dir, shownName;
            QStringList extensions;
            How how;
        } cases[] = {
            // A Word source is offered the first of the list, not its own extension.
            {"Word document, dots in the name, save button", u"C:\\A\\B\\report.final.docx"_s, 2,
             u"C:\\A\\B\\"_s, u"report.final"_s, word, kButton},
            // Other types keep their own extension first instead of being renamed to .Doc.
            {"PDF document, forward separators, Enter", u"/srv/zorvane/DOCS/100/מכתב ללקוח.PDF"_s,
             2, u"/srv/zorvane/DOCS/100/"_s, u"מכתב ללקוח"_s, QStringList{u"PDF"_s} + word, kEnter},
            {"mail, dot in a folder only, cancel button", u"C:\\v1.2\\readme.pdf"_s, 0,
             u"C:\\v1.2\\"_s, u"readme"_s, QStringList{u"msg"_s, u"eml"_s, u"htm"_s},
             kCancelButton}};
        for (const auto& c : cases) {
            SetSourceExt(QFileInfo(c.fileName).suffix());
            FrmSaveAs frm;
            frm.SetFileName(c.fileName);
            frm.SetSug(c.sug);
            QStringList shown;
            (*ui_)->QueueModal([&](QWidget&) {
                for (int i = 0; i < frm.CboEndName().count(); ++i) {
                    shown << frm.CboEndName().itemText(i);
                }
                const bool cancel = c.how == kCancelButton;
                Answer(frm, frm.TxtName(), cancel ? frm.CmdCancel() : frm.CmdSave(),
                       cancel ? kButton : c.how);
            });
            ShowModal(frm);
            QVERIFY2(frm.IsCancel() == (c.how == kCancelButton) && !frm.isVisible(), c.name);
            QVERIFY2(frm.LDir().text() == c.dir, qPrintable(frm.LDir().text()));
            QVERIFY2(frm.TxtName().text() == c.shownName, qPrintable(frm.TxtName().text()));
            QVERIFY2(shown == c.extensions, qPrintable(shown.join(u' ')));
            QVERIFY2(frm.CboEndName().currentText() == c.extensions.first(), c.name);
        }
    }

    void usersPicker() {
        // More users of the office: a repeated name, blanks around a name, no name, Latin.
        const QString sql = QStringLiteral(
            "INSERT INTO USERS (USERCODE, ST_NUMBER, UserName) VALUES ('100', '5', 'יוסי לוי'), "
            "('100', '7', '  שרה  '), ('100', '8', NULL), ('100', '11', 'Admin')");
        const QString connection = u"test-users"_s;
        {
            QSqlDatabase db = QSqlDatabase::addDatabase(u"QSQLITE"_s, connection);
            db.setDatabaseName(env_->DataDir() + u"/PUB.MDB"_s);
            QSqlQuery q(db);
            QVERIFY2(db.open() && q.exec(sql), qPrintable(q.lastError().text()));
        }
        QSqlDatabase::removeDatabase(connection);
        // In the order of their numbers ("10" after "8"); the other office's user is left out.
        const QStringList users{kDana,    kYossi,    kMichal, kYossi,
                                u"שרה"_s, QString(), kRon,    u"Admin"_s};
        const QString all = FrmGetUsers::AllUsersText();
        const struct {
            const char* name;
            QString startUsers;
            bool withAllUsers;
            QList<int> clicked;  // rows; when any, confirmed with Enter
            QString endUsers;
        } cases[] = {
            {"two users, the first of a repeated name", kRon + u';' + kYossi, false, QList<int>(),
             kYossi + u';' + kRon},
            {"unknown and blank-padded names ignored",
             u"אין כזה; דנה כהן;"_s + kMichal + u';' + kRon + u' ', false, QList<int>(), kMichal},
            {"all users entry", all + u';' + kDana, true, QList<int>(), all + u';' + kDana},
            {"one added by click", kRon, false, QList<int>{1}, kYossi + u';' + kRon},
            {"the only one taken away", kDana, false, QList<int>{0}, QString()}};
        for (const auto& c : cases) {
            FrmGetUsers frm;
            frm.SetStartUsers(c.startUsers);
            frm.SetWithAllUsers(c.withAllUsers);
            QStringList texts;
            (*ui_)->QueueModal([&](QWidget&) {
                QListWidget& list = frm.List1();
                for (int i = 0; i < list.count(); ++i) {
                    texts << list.item(i)->text();
                }
                for (const int row : c.clicked) {
                    const QRect r = list.visualItemRect(list.item(row));
                    QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, r.center());
                }
                Answer(frm, list, frm.Command1(), c.clicked.isEmpty() ? kButton : kEnter);
            });
            ShowModal(frm);
            QVERIFY2(texts == (c.withAllUsers ? QStringList{all} : QStringList()) + users, c.name);
            QVERIFY2(!frm.IsCancel() && frm.EndUsers() == c.endUsers,
                     qPrintable(QString::fromUtf8(c.name) + u": "_s + frm.EndUsers()));
        }
    }

    void missingDatabaseIsReported() {
        QVERIFY(QFile::remove(env_->DataDir() + u"/PUB.MDB"_s));
        FrmGetUsers frm;
        frm.SetWithAllUsers(true);
        frm.SetStartUsers(FrmGetUsers::AllUsersText());
        (*ui_)->QueueModal([&](QWidget&) { frm.Command1().click(); });
        ShowModal(frm);
        QCOMPARE((*ui_)->Messages().size(), size_t(1));
        const auto& m = (*ui_)->Messages().front();
        QVERIFY2(m.text.startsWith(u"3024-0-initCbo-Could not find file"_s), qPrintable(m.text));
        QCOMPARE(m.style, int(vbOKOnly));
        // The list keeps what was added before the failure, and the selection still applies.
        QCOMPARE(frm.List1().count(), 1);
        QCOMPARE(frm.EndUsers(), FrmGetUsers::AllUsersText());
        (*ui_)->Clear();
    }

  private:
    std::unique_ptr<test::Watchdog> watchdog_;
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

QTEST_MAIN(TestDialogs)
#include "test_dialogs.moc"

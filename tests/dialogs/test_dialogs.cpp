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

const QString kOffice = u"100"_s;
const QString kDana = u"דנה כהן"_s;
const QString kYossi = u"יוסי לוי"_s;
const QString kMichal = u"מיכל ברק"_s;
const QString kRon = u"עו\"ד רון שמיר"_s;

enum How { kButton, kEnter, kCloseBox, kEscape, kOther };

// Ends a dialog the way a user would: OK button, Enter or Escape in a field, close box.
void Answer(QWidget& window, QWidget& field, QAbstractButton& button, How how) {
    if (how == kButton) {
        QTest::mouseClick(&button, Qt::LeftButton);
    } else if (how == kCloseBox) {
        window.close();
    } else {
        QTest::keyClick(&field, how == kEscape ? Qt::Key_Escape : Qt::Key_Return);
    }
}

QStringList Texts(const QListWidget& list) {
    QStringList out;
    for (int i = 0; i < list.count(); ++i) {
        out << list.item(i)->text();
    }
    return out;
}

template <class Frm>
Frm& As(QWidget& w) {
    return static_cast<Frm&>(w);
}

}  // namespace

class TestDialogs : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void passwordAnswers_data();
    void passwordAnswers();
    void longPromptPushesDown();
    void saveAsAnswers_data();
    void saveAsAnswers();
    void extensionLists_data();
    void extensionLists();
    void startSelection_data();
    void startSelection();
    void usersAnswers_data();
    void usersAnswers();
    void missingDatabaseIsReported();

  private:
    // Adds users to the office: a repeated name, blanks around a name, no name, Latin.
    void AddUsers();

    std::unique_ptr<test::Watchdog> watchdog_;
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestDialogs::init() {
    watchdog_ = std::make_unique<test::Watchdog>();
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    SampleOptions options;
    options.officeCode = kOffice;
    options.myUserName = kDana;
    CreateSampleInstallation(env_->DataDir(), options);
    SetMainPath(env_->DataDir());
    SetUserCode(kOffice);
}

void TestDialogs::cleanup() {
    QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
    QCOMPARE((*ui_)->UnexpectedModals(), 0);
    ui_.reset();
    env_.reset();
    watchdog_.reset();
}

void TestDialogs::AddUsers() {
    const QString connection = u"test-users"_s;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(u"QSQLITE"_s, connection);
        db.setDatabaseName(env_->DataDir() + u"/PUB.MDB"_s);
        QVERIFY(db.open());
        const QList<std::pair<QString, QVariant>> users = {
            {u"5"_s, kYossi},
            {u"7"_s, u"  שרה  "_s},
            {u"8"_s, QVariant(QMetaType(QMetaType::QString))},
            {u"11"_s, u"Admin"_s}};
        for (const auto& [stNumber, name] : users) {
            QSqlQuery q(db);
            q.prepare(QStringLiteral(
                "INSERT INTO USERS (USERCODE, ST_NUMBER, UserName) VALUES (?, ?, ?)"));
            q.addBindValue(kOffice);
            q.addBindValue(stNumber);
            q.addBindValue(name);
            QVERIFY2(q.exec(), qPrintable(q.lastError().text()));
        }
    }
    QSqlDatabase::removeDatabase(connection);
}

void TestDialogs::passwordAnswers_data() {
    QTest::addColumn<int>("how");
    QTest::addColumn<QString>("passChar");
    QTest::addColumn<QString>("shown");
    QTest::newRow("button, unmasked") << int(kButton) << QString() << u"ab12"_s;
    QTest::newRow("Enter in the text box") << int(kEnter) << u"*"_s << u"****"_s;
    QTest::newRow("Enter on the window") << int(kOther) << u"#"_s << u"####"_s;
    QTest::newRow("close box") << int(kCloseBox) << u"*"_s << u"****"_s;
    QTest::newRow("Escape") << int(kEscape) << u"*"_s << u"****"_s;
}

void TestDialogs::passwordAnswers() {
    QFETCH(int, how);
    QFETCH(QString, passChar);
    QFETCH(QString, shown);
    FrmGetPassword frm;
    frm.SetPassChar(passChar);
    QString displayed;
    (*ui_)->QueueModal([&](QWidget& w) {
        FrmGetPassword& f = As<FrmGetPassword>(w);
        for (const QChar ch : u"ab12"_s) {
            QTest::sendKeyEvent(QTest::Click, &f.Text1(), Qt::Key_unknown, QString(ch),
                                Qt::NoModifier);
        }
        displayed = f.Text1().displayText();
        if (how == kOther) {
            QTest::keyClick(&f, Qt::Key_Enter);
        } else {
            Answer(f, f.Text1(), f.Command1(), How(how));
        }
    });
    ShowModal(frm);
    QCOMPARE(displayed, shown);
    QCOMPARE(frm.IsCancel(), how == kCloseBox || how == kEscape);
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.Text1().text(), u"ab12"_s);
}

void TestDialogs::longPromptPushesDown() {
    FrmGetPassword frm;
    frm.SetTeur(QStringLiteral(
        "הקלד את קוד ההפעלה שקיבלת ממנהל המערכת כדי לאפשר עריכה של תאריך היצירה של המסמך "
        "הזה. הקוד אינו נשמר ואינו מוצג על המסך, ויש להקליד אותו בכל פעם מחדש."));
    (*ui_)->QueueModal([](QWidget& w) {
        FrmGetPassword& f = As<FrmGetPassword>(w);
        QApplication::processEvents();
        // The whole prompt shows, and each control starts 8 pixels (120 twips) below the one
        // above it, inside the window.
        QVERIFY(f.Label1().height() >= f.Label1().heightForWidth(f.Label1().width()));
        QVERIFY(f.Label1().height() > 2 * f.Label1().fontMetrics().height());
        QCOMPARE(f.Text1().y(), f.Label1().geometry().bottom() + 1 + 8);
        QCOMPARE(f.Command1().y(), f.Text1().geometry().bottom() + 1 + 8);
        QVERIFY(f.height() > f.Command1().geometry().bottom());
        f.Command1().click();
    });
    ShowModal(frm);
}

void TestDialogs::saveAsAnswers_data() {
    QTest::addColumn<QString>("fileName");
    QTest::addColumn<QString>("dir");
    QTest::addColumn<QString>("name");
    QTest::addColumn<int>("how");
    QTest::newRow("dots in the name, save button")
        << u"C:\\A\\B\\report.final.docx"_s << u"C:\\A\\B\\"_s << u"report.final"_s << int(kButton);
    QTest::newRow("hebrew, forward separators, Enter")
        << u"/srv/zorvane/DOCS/100/מכתב ללקוח.msg"_s << u"/srv/zorvane/DOCS/100/"_s
        << u"מכתב ללקוח"_s << int(kEnter);
    QTest::newRow("dot in a folder only, cancel button")
        << u"C:\\v1.2\\readme.txt"_s << u"C:\\v1.2\\"_s << u"readme"_s << int(kOther);
    QTest::newRow("close box") << u"C:\\a.msg"_s << u"C:\\"_s << u"a"_s << int(kCloseBox);
    QTest::newRow("Escape") << u"C:\\a.msg"_s << u"C:\\"_s << u"a"_s << int(kEscape);
}

void TestDialogs::saveAsAnswers() {
    QFETCH(QString, fileName);
    QFETCH(QString, dir);
    QFETCH(QString, name);
    QFETCH(int, how);
    FrmSaveAs frm;
    frm.SetFileName(fileName);
    (*ui_)->QueueModal([how](QWidget& w) {
        FrmSaveAs& f = As<FrmSaveAs>(w);
        if (how == kOther) {
            QTest::mouseClick(&f.CmdCancel(), Qt::LeftButton);
        } else {
            Answer(f, f.TxtName(), f.CmdSave(), How(how));
        }
    });
    ShowModal(frm);
    QCOMPARE(frm.IsCancel(), how != kButton && how != kEnter);
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.LDir().text(), dir);
    QCOMPARE(frm.TxtName().text(), name);
}

void TestDialogs::extensionLists_data() {
    QTest::addColumn<int>("sug");
    QTest::addColumn<QString>("sourceExt");
    QTest::addColumn<QStringList>("items");
    const QStringList word = {u"Doc"_s, u"Docx"_s};
    const QStringList mail = {u"msg"_s, u"eml"_s, u"htm"_s};
    // A Word source is offered the first of the list, not its own extension.
    QTest::newRow("document from docx") << 2 << u"docx"_s << word;
    // Other types keep their own extension first instead of being renamed to .Doc.
    QTest::newRow("document from PDF") << 2 << u"PDF"_s << (QStringList{u"PDF"_s} + word);
    QTest::newRow("mail item from eml") << 1 << u"eml"_s << mail;
    QTest::newRow("mail kind ignores a pdf source") << 0 << u"pdf"_s << mail;
}

void TestDialogs::extensionLists() {
    QFETCH(int, sug);
    QFETCH(QString, sourceExt);
    QFETCH(QStringList, items);
    SetSourceExt(sourceExt);
    FrmSaveAs frm;
    frm.SetFileName(u"C:\\DOCS\\a."_s + sourceExt);
    frm.SetSug(static_cast<int16_t>(sug));
    QStringList shown;
    (*ui_)->QueueModal([&](QWidget& w) {
        const QComboBox& box = As<FrmSaveAs>(w).CboEndName();
        for (int i = 0; i < box.count(); ++i) {
            shown << box.itemText(i);
        }
        As<FrmSaveAs>(w).CmdSave().click();
    });
    ShowModal(frm);
    QCOMPARE(shown, items);
    QCOMPARE(frm.CboEndName().currentText(), items.first());
}

void TestDialogs::startSelection_data() {
    QTest::addColumn<QString>("startUsers");
    QTest::addColumn<bool>("withAllUsers");
    QTest::addColumn<QList<int>>("selected");
    QTest::addColumn<QString>("endUsers");
    QTest::newRow("nothing") << QString() << false << QList<int>{} << QString();
    QTest::newRow("two users, the first of a repeated name")
        << kRon + u';' + kYossi << false << QList<int>{1, 6} << kYossi + u';' + kRon;
    QTest::newRow("unknown name ignored")
        << u"אין כזה;"_s + kMichal << false << QList<int>{2} << kMichal;
    QTest::newRow("case matters") << u"admin"_s << false << QList<int>{} << QString();
    QTest::newRow("blanks matter")
        << u" דנה כהן;"_s + kRon + u' ' << false << QList<int>{} << QString();
    QTest::newRow("all users entry")
        << FrmGetUsers::AllUsersText() + u';' + kDana << true << QList<int>{0, 1}
        << FrmGetUsers::AllUsersText() + u';' + kDana;
    QTest::newRow("all users entry absent")
        << FrmGetUsers::AllUsersText() + u';' + kDana << false << QList<int>{0} << kDana;
}

void TestDialogs::startSelection() {
    QFETCH(QString, startUsers);
    QFETCH(bool, withAllUsers);
    QFETCH(QList<int>, selected);
    QFETCH(QString, endUsers);
    AddUsers();
    FrmGetUsers frm;
    frm.SetStartUsers(startUsers);
    frm.SetWithAllUsers(withAllUsers);
    QList<int> shown;
    QList<int> numbers;
    (*ui_)->QueueModal([&](QWidget& w) {
        const QListWidget& list = As<FrmGetUsers>(w).List1();
        for (int i = 0; i < list.count(); ++i) {
            numbers << list.item(i)->data(Qt::UserRole).toInt();
            if (list.item(i)->isSelected()) {
                shown << i;
            }
        }
        As<FrmGetUsers>(w).Command1().click();
    });
    ShowModal(frm);
    // "10" after "8": numeric order, not text order; the other office's user is left out.
    QStringList texts{kDana, kYossi, kMichal, kYossi, u"שרה"_s, QString(), kRon, u"Admin"_s};
    QList<int> expectedNumbers{1, 2, 3, 5, 7, 8, 10, 11};
    if (withAllUsers) {
        texts.prepend(FrmGetUsers::AllUsersText());
        expectedNumbers.prepend(0);
    }
    QCOMPARE(Texts(frm.List1()), texts);
    QCOMPARE(numbers, expectedNumbers);
    QCOMPARE(shown, selected);
    QCOMPARE(frm.EndUsers(), endUsers);
}

void TestDialogs::usersAnswers_data() {
    QTest::addColumn<QString>("startUsers");
    QTest::addColumn<QList<int>>("clicked");
    QTest::addColumn<int>("how");
    QTest::addColumn<QString>("endUsers");
    QTest::newRow("as passed in") << kMichal + u';' + kDana << QList<int>{} << int(kEnter)
                                  << kDana + u';' + kMichal;
    QTest::newRow("one added by click")
        << kRon << QList<int>{1} << int(kEnter) << kYossi + u';' + kRon;
    QTest::newRow("the only one taken away") << kDana << QList<int>{0} << int(kButton) << QString();
    QTest::newRow("close box") << kDana << QList<int>{} << int(kCloseBox) << QString();
    QTest::newRow("Escape") << kDana << QList<int>{} << int(kEscape) << QString();
}

void TestDialogs::usersAnswers() {
    QFETCH(QString, startUsers);
    QFETCH(QList<int>, clicked);
    QFETCH(int, how);
    QFETCH(QString, endUsers);
    FrmGetUsers frm;
    frm.SetStartUsers(startUsers);
    (*ui_)->QueueModal([&](QWidget& w) {
        QListWidget& list = As<FrmGetUsers>(w).List1();
        for (const int row : clicked) {
            const QRect r = list.visualItemRect(list.item(row));
            QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, r.center());
        }
        Answer(w, list, As<FrmGetUsers>(w).Command1(), How(how));
    });
    ShowModal(frm);
    QCOMPARE(frm.IsCancel(), how == kCloseBox || how == kEscape);
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.EndUsers(), endUsers);
}

void TestDialogs::missingDatabaseIsReported() {
    QVERIFY(QFile::remove(env_->DataDir() + u"/PUB.MDB"_s));
    FrmGetUsers frm;
    frm.SetWithAllUsers(true);
    frm.SetStartUsers(FrmGetUsers::AllUsersText());
    (*ui_)->QueueModal([](QWidget& w) { As<FrmGetUsers>(w).Command1().click(); });
    ShowModal(frm);
    QCOMPARE((*ui_)->Messages().size(), size_t(1));
    const auto& m = (*ui_)->Messages().front();
    QVERIFY2(m.text.startsWith(u"3024-0-initCbo-Could not find file"_s), qPrintable(m.text));
    QCOMPARE(m.style, int(vbOKOnly));
    // The list keeps what was added before the failure, and the selection still applies.
    QCOMPARE(Texts(frm.List1()), QStringList{FrmGetUsers::AllUsersText()});
    QCOMPARE(frm.EndUsers(), FrmGetUsers::AllUsersText());
    (*ui_)->Clear();
}

QTEST_MAIN(TestDialogs)
#include "test_dialogs.moc"

// The user picker over the PUB.MDB of a sample installation: the list and its order, the
// selection rules of the names passed in, confirming and cancelling.
#include <QListWidget>
#include <QPushButton>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QtTest>

#include "dialogs/frm_get_users.h"
#include "sample_install/sample_install.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/state.h"
#include "watchdog.h"

using namespace zv;

namespace {

const QString kOffice = QStringLiteral("100");
const QString kDana = QStringLiteral("דנה כהן");
const QString kYossi = QStringLiteral("יוסי לוי");
const QString kMichal = QStringLiteral("מיכל ברק");
const QString kRon = QStringLiteral("עו\"ד רון שמיר");

QStringList Texts(const QListWidget& list) {
    QStringList out;
    for (int i = 0; i < list.count(); ++i) {
        out << list.item(i)->text();
    }
    return out;
}

QList<int> Numbers(const QListWidget& list) {
    QList<int> out;
    for (int i = 0; i < list.count(); ++i) {
        out << list.item(i)->data(Qt::UserRole).toInt();
    }
    return out;
}

QList<int> SelectedRows(const QListWidget& list) {
    QList<int> out;
    for (int i = 0; i < list.count(); ++i) {
        if (list.item(i)->isSelected()) {
            out << i;
        }
    }
    return out;
}

FrmGetUsers& AsPicker(QWidget& w) {
    return static_cast<FrmGetUsers&>(w);
}

}  // namespace

class TestFrmGetUsers : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void listsTheOfficeUsersInNumberOrder_data();
    void listsTheOfficeUsersInNumberOrder();
    void startSelection_data();
    void startSelection();
    void sameDisplayNameSelectsFirstOnly();
    void confirmJoinsInListOrder_data();
    void confirmJoinsInListOrder();
    void closingCancels_data();
    void closingCancels();
    void missingDatabaseIsReported();

  private:
    // Adds a row to USERS of the installation.
    void AddUser(const QString& stNumber, const QVariant& name);

    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestFrmGetUsers::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    SampleOptions options;
    options.officeCode = kOffice;
    options.myUserName = kDana;
    CreateSampleInstallation(env_->DataDir(), options);
    SetMainPath(env_->DataDir());
    SetUserCode(kOffice);
}

void TestFrmGetUsers::cleanup() {
    QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
    QCOMPARE((*ui_)->UnexpectedModals(), 0);
    ui_.reset();
    env_.reset();
}

void TestFrmGetUsers::AddUser(const QString& stNumber, const QVariant& name) {
    const QString connection = QStringLiteral("test-users");
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), connection);
        db.setDatabaseName(env_->DataDir() + QStringLiteral("/PUB.MDB"));
        QVERIFY(db.open());
        QSqlQuery q(db);
        q.prepare(
            QStringLiteral("INSERT INTO USERS (USERCODE, ST_NUMBER, UserName) VALUES (?, ?, ?)"));
        q.addBindValue(kOffice);
        q.addBindValue(stNumber);
        q.addBindValue(name);
        QVERIFY2(q.exec(), qPrintable(q.lastError().text()));
    }
    QSqlDatabase::removeDatabase(connection);
}

void TestFrmGetUsers::listsTheOfficeUsersInNumberOrder_data() {
    QTest::addColumn<bool>("withAllUsers");
    QTest::newRow("users only") << false;
    QTest::newRow("with the all-users entry") << true;
}

void TestFrmGetUsers::listsTheOfficeUsersInNumberOrder() {
    QFETCH(bool, withAllUsers);
    test::Watchdog watchdog;
    AddUser(QStringLiteral("7"), QStringLiteral("  שרה  "));
    AddUser(QStringLiteral("8"), QVariant(QMetaType(QMetaType::QString)));
    FrmGetUsers frm;
    frm.SetWithAllUsers(withAllUsers);
    QStringList texts;
    QList<int> numbers;
    (*ui_)->QueueModal([&](QWidget& w) {
        texts = Texts(AsPicker(w).List1());
        numbers = Numbers(AsPicker(w).List1());
        AsPicker(w).Command1().click();
    });
    ShowModal(frm);
    // "10" after "8": numeric order, not text order; the other office's user is left out.
    QStringList expectedTexts{kDana, kYossi, kMichal, QStringLiteral("שרה"), QString(), kRon};
    QList<int> expectedNumbers{1, 2, 3, 7, 8, 10};
    if (withAllUsers) {
        expectedTexts.prepend(FrmGetUsers::AllUsersText());
        expectedNumbers.prepend(0);
    }
    QCOMPARE(texts, expectedTexts);
    QCOMPARE(numbers, expectedNumbers);
}

void TestFrmGetUsers::startSelection_data() {
    QTest::addColumn<QString>("startUsers");
    QTest::addColumn<bool>("withAllUsers");
    QTest::addColumn<QList<int>>("selected");
    QTest::newRow("nothing") << QString() << false << QList<int>{};
    QTest::newRow("two users") << kRon + u';' + kYossi << false << QList<int>{1, 3};
    QTest::newRow("named twice") << kYossi + u';' + kYossi << false << QList<int>{1};
    QTest::newRow("unknown name ignored")
        << QStringLiteral("אין כזה;") + kMichal << false << QList<int>{2};
    QTest::newRow("case matters") << QStringLiteral("admin") << false << QList<int>{};
    QTest::newRow("exact case") << QStringLiteral("Admin") << false << QList<int>{4};
    QTest::newRow("blanks matter")
        << QStringLiteral(" דנה כהן;") + kRon + u' ' << false << QList<int>{};
    QTest::newRow("all users entry")
        << FrmGetUsers::AllUsersText() + u';' + kDana << true << QList<int>{0, 1};
    QTest::newRow("all users entry absent")
        << FrmGetUsers::AllUsersText() + u';' + kDana << false << QList<int>{0};
}

void TestFrmGetUsers::startSelection() {
    QFETCH(QString, startUsers);
    QFETCH(bool, withAllUsers);
    QFETCH(QList<int>, selected);
    test::Watchdog watchdog;
    AddUser(QStringLiteral("11"), QStringLiteral("Admin"));
    FrmGetUsers frm;
    frm.SetStartUsers(startUsers);
    frm.SetWithAllUsers(withAllUsers);
    QList<int> shown;
    (*ui_)->QueueModal([&](QWidget& w) {
        shown = SelectedRows(AsPicker(w).List1());
        AsPicker(w).Command1().click();
    });
    ShowModal(frm);
    QCOMPARE(shown, selected);
}

void TestFrmGetUsers::sameDisplayNameSelectsFirstOnly() {
    test::Watchdog watchdog;
    AddUser(QStringLiteral("5"), kYossi);
    FrmGetUsers frm;
    frm.SetStartUsers(kYossi);
    (*ui_)->QueueModal([](QWidget& w) { AsPicker(w).Command1().click(); });
    ShowModal(frm);
    QCOMPARE(Texts(frm.List1()).count(kYossi), 2);
    QCOMPARE(SelectedRows(frm.List1()), QList<int>{1});
    QCOMPARE(frm.EndUsers(), kYossi);
}

void TestFrmGetUsers::confirmJoinsInListOrder_data() {
    QTest::addColumn<QString>("startUsers");
    QTest::addColumn<QList<int>>("clicked");
    QTest::addColumn<QString>("endUsers");
    QTest::newRow("as passed in") << kMichal + u';' + kDana << QList<int>{}
                                  << kDana + u';' + kMichal;
    QTest::newRow("one added by click") << kRon << QList<int>{1} << kYossi + u';' + kRon;
    QTest::newRow("the only one taken away") << kDana << QList<int>{0} << QString();
    QTest::newRow("none") << QString() << QList<int>{} << QString();
}

void TestFrmGetUsers::confirmJoinsInListOrder() {
    QFETCH(QString, startUsers);
    QFETCH(QList<int>, clicked);
    QFETCH(QString, endUsers);
    test::Watchdog watchdog;
    FrmGetUsers frm;
    frm.SetStartUsers(startUsers);
    (*ui_)->QueueModal([&](QWidget& w) {
        QListWidget& list = AsPicker(w).List1();
        for (const int row : clicked) {
            const QRect r = list.visualItemRect(list.item(row));
            QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, r.center());
        }
        QTest::keyClick(&list, Qt::Key_Return);
    });
    ShowModal(frm);
    QVERIFY(!frm.IsCancel());
    QVERIFY(!frm.isVisible());
    QCOMPARE(frm.EndUsers(), endUsers);
}

void TestFrmGetUsers::closingCancels_data() {
    QTest::addColumn<bool>("escape");
    QTest::newRow("close box") << false;
    QTest::newRow("Escape") << true;
}

void TestFrmGetUsers::closingCancels() {
    QFETCH(bool, escape);
    test::Watchdog watchdog;
    FrmGetUsers frm;
    frm.SetStartUsers(kDana);
    (*ui_)->QueueModal([escape](QWidget& w) {
        if (escape) {
            QTest::keyClick(&AsPicker(w).List1(), Qt::Key_Escape);
        } else {
            w.close();
        }
    });
    ShowModal(frm);
    QVERIFY(frm.IsCancel());
    QCOMPARE(frm.EndUsers(), QString());
}

void TestFrmGetUsers::missingDatabaseIsReported() {
    test::Watchdog watchdog;
    QVERIFY(QFile::remove(env_->DataDir() + QStringLiteral("/PUB.MDB")));
    FrmGetUsers frm;
    frm.SetWithAllUsers(true);
    frm.SetStartUsers(FrmGetUsers::AllUsersText());
    (*ui_)->QueueModal([](QWidget& w) { AsPicker(w).Command1().click(); });
    ShowModal(frm);
    QCOMPARE((*ui_)->Messages().size(), size_t(1));
    const auto& m = (*ui_)->Messages().front();
    QVERIFY2(m.text.startsWith(QStringLiteral("3024-0-initCbo-Could not find file")),
             qPrintable(m.text));
    QCOMPARE(m.style, int(vbOKOnly));
    // The list keeps what was added before the failure, and the selection still applies.
    QCOMPARE(Texts(frm.List1()), QStringList{FrmGetUsers::AllUsersText()});
    QCOMPARE(frm.EndUsers(), FrmGetUsers::AllUsersText());
    (*ui_)->Clear();
}

QTEST_MAIN(TestFrmGetUsers)
#include "test_frm_get_users.moc"

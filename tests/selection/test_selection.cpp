// The client and case choices and their list windows, on the back-end this program was
// built for: the file databases, or (ZV_SELECTION_SERVER) the PostgreSQL test cluster.

#include <QCheckBox>
#include <QFile>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSqlRecord>
#include <QTableView>
#include <QtTest>
#include <functional>

#include "data/database.h"
#include "data/recordset.h"
#include "recording_keyboard.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "scripted_ui.h"
#include "selection/choice.h"
#include "selection/list_model.h"
#include "selection/list_window.h"
#include "test_env.h"
#include "util/keyboard_layout.h"
#include "util/settings_store.h"
#include "util/state.h"
#include "watchdog.h"

using namespace Qt::Literals::StringLiterals;

#ifndef ZV_SELECTION_SERVER
#define ZV_SELECTION_SERVER 0
#endif

namespace zv {
namespace {

constexpr bool kServer = ZV_SELECTION_SERVER;
constexpr ListVariant kClients = kServer ? ListVariant::FrmLakAdo : ListVariant::FrmLak;
constexpr ListVariant kNames = kServer ? ListVariant::FrmLookForAdo : ListVariant::FrmLookFor;
constexpr int kClientCount = 1500;

// A pattern written with the file database's wildcards, in the back-end's own.
QString Wild(QString pattern) {
    if (kServer) {
        pattern.replace(QLatin1Char('*'), QLatin1Char('%')).replace(QLatin1Char('?'), '_');
    }
    return pattern;
}

QMap<QString, QString> Catalogue() {
    return {{"0", "לקוח"},        {"1", "תיק אזרחי"},      {"2", "תיק עבודה"},
            {"3", "תיק גירושין"}, {"4", "תיק הוצל\"פ"},    {"5", "תיק ליטיגציה"},
            {"6", "תיק חברות"},   {"10", "תיק מקרקעין"},   {"11", "תיק כללי"},
            {"17", "תיק מיוחד"},  {"1002", "תיקי צוואות"}, {"1026", "תיקי ירושה"}};
}

QStringList Fields(const ChoiceLabels& l) {
    return {l.lakNum, l.lakName, l.lblSug, l.lSugTik, l.lTik, l.lTikNum, l.lTeurSugTik, l.lTeurTik};
}

ChoiceLabels EarlierChoice() {
    return {"5555", "לקוח קודם", "N", "9", "12", "5555-12", "סוג קודם", "תיאור קודם"};
}

QTableView* Grid(ListWindow& w) {
    return w.findChild<QTableView*>(u"TDBGrid1"_s);
}

QString Counter(ListWindow& w) {
    const auto name = kServer ? u"AdoData"_s : u"Data1"_s;
    return w.findChild<QLabel*>(name)->text();
}

void Click(ListWindow& w, const char* button) {
    w.findChild<QPushButton*>(QLatin1String(button))->click();
}

void Search(ListWindow& w, const QString& text) {
    auto* box = w.findChild<QLineEdit*>(u"txtSearch"_s);
    box->setText(text);
    QTest::keyClick(box, Qt::Key_Return);
}

// Every row of the current search, fetched to the end.
QList<QSqlRecord> AllRows(ListWindow& w) {
    auto& model = w.Model();
    while (model.canFetchMore({})) {
        model.fetchMore({});
    }
    QList<QSqlRecord> rows;
    for (int i = 0; i < model.rowCount(); ++i) {
        rows << model.Record(i);
    }
    return rows;
}

QStringList Column(ListWindow& w, const QString& field) {
    QStringList values;
    for (const auto& row : AllRows(w)) {
        values << row.value(field).toString();
    }
    return values;
}

int ColumnOf(ListWindow& w, const QString& field) {
    const auto& columns = w.Model().Columns();
    for (int i = 0; i < static_cast<int>(columns.size()); ++i) {
        if (columns[static_cast<size_t>(i)].field.compare(field, Qt::CaseInsensitive) == 0) {
            return i;
        }
    }
    return -1;
}

using RowTest = std::function<bool(const QSqlRecord&)>;

RowTest RowOf(const QString& lakNum, int optKey, const QString& tikId = {}) {
    return [=](const QSqlRecord& r) {
        return r.value(u"LakNum"_s).toString() == lakNum &&
               r.value(u"OptKey"_s).toInt() == optKey &&
               (tikId.isNull() || r.value(u"TIK_ID"_s).toString() == tikId);
    };
}

// Makes the first row that passes the test the current row; -1 when none does.
int SelectRow(ListWindow& w, const RowTest& test) {
    const auto rows = AllRows(w);
    for (int i = 0; i < rows.size(); ++i) {
        if (test(rows[i])) {
            Grid(w)->setCurrentIndex(w.Model().index(i, 0));
            return i;
        }
    }
    return -1;
}

long long CountRows(const QString& database, const QString& sql) {
    auto db = Database::Open(database, kServer);
    auto rs = db->OpenRecordset(sql, dbOpenSnapshot);
    return rs->Value(rs->FieldName(0)).toLongLong();
}

}  // namespace
}  // namespace zv

namespace zv {

class TestSelection : public QObject {
    Q_OBJECT
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    std::unique_ptr<test::Watchdog> watchdog_;
    QMap<QString, QString> state_;

    void Restore();

  private slots:
    void initTestCase();
    void init();
    void cleanup();

    void clientSearch_data();
    void clientSearch();
    void enterSearches();
    void searchBoxSwitchesToHebrew();
    void unreachableDatabaseReported();
    void namesOfOneClient_data();
    void namesOfOneClient();
    void allNames();
    void namesSearch_data();
    void namesSearch();
    void kindColumn_data();
    void kindColumn();
    void layoutSaveReopenReset_data();
    void layoutSaveReopenReset();
    void brokenLayoutFile();
    void check1Persisted();

    void chooseClient_data();
    void chooseClient();
    void closingOrEmptyListKeepsClient_data();
    void closingOrEmptyListKeepsClient();
    void clientTeur_data();
    void clientTeur();
    void clientCaseNeedsClient();
    void chooseClientCase_data();
    void chooseClientCase();
    void chooseCaseByName_data();
    void chooseCaseByName();
    void closingNamesWindowChangesNothing();
};

void TestSelection::initTestCase() {
    env_ = std::make_unique<test::TestEnv>();
    SampleOptions options = kServer ? TestServerOptions() : SampleOptions{};
    if (kServer) {
        ZV_REQUIRE_TEST_SERVER(options);
    }
    options.clients = kClientCount;
    CreateSampleInstallation(env_->DataDir(), options);
    state_ = {{"MyUser", options.myUser},
              {"VolnaGlobNum", options.volnaGlobNum},
              {"DataSource", options.serverDataSource},
              {"UserID", options.serverUser},
              {"PassWord", options.serverPassword}};
    Restore();

    // A client whose number holds an apostrophe, with cases of its own.
    auto office = Database::Open(u"OFFICE"_s, kServer);
    office->Execute(
        QStringLiteral("INSERT INTO CLIENT (NUM, F_NAME, L_NAME, TELEFON) "
                       "VALUES ('77''7', 'אנה', 'טל', '03-7777777')"));
    auto zorva = Database::Open(u"ZORVA"_s, kServer);
    const char* rows[] = {
        "('77''7', 0, 'F', NULL, NULL, NULL)",      "('77''7', 1, 'N', '1', '77''7-1', NULL)",
        "('77''7', 11, 'T', '2', '77''7-2', '2')",  "('77''7', 11, 'T', '3', '77''7-3', '3')",
        "('77''7', 11, 'T', '4', '77''7-4', NULL)",
    };
    for (const char* row : rows) {
        zorva->Execute(QStringLiteral("INSERT INTO LOOKFOR (LakNum, OptKey, Sug, Tik, Code, "
                                      "TIK_ID, F_NAME, L_NAME, TELEFON) VALUES ") +
                       QString::fromUtf8(row).chopped(1) + u", 'אנה', 'טל', '03-7777777')"_s);
    }
}

void TestSelection::Restore() {
    ResetState();
    SetMainPath(env_->DataDir());
    SetMyUser(state_.value("MyUser"));
    SetVolnaGlobNum(state_.value("VolnaGlobNum"));
    if (kServer) {
        SetProvider(u"PostgreSQL"_s);
        SetDataSource(state_.value("DataSource"));
        SetUserID(state_.value("UserID"));
        SetPassWord(state_.value("PassWord"));
        SetIsOffice(true);
        SetIsZorva(true);
    }
    SetOptKeyNames(Catalogue());
}

void TestSelection::init() {
    Restore();
    watchdog_ = std::make_unique<test::Watchdog>(std::chrono::seconds(60));
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    QDir(env_->DataDir() + u"/MGRX"_s).removeRecursively();
    SaveSetting(u"KAVEX32"_s, u"General"_s, u"AddInOnLakTik"_s, {});
}

void TestSelection::cleanup() {
    const auto texts = (*ui_)->Texts();
    const int unexpected = (*ui_)->UnexpectedModals();
    ui_.reset();
    watchdog_.reset();
    // An unexpected message or window fails the test.
    QCOMPARE(texts, QStringList());
    QCOMPARE(unexpected, 0);
}

void TestSelection::clientSearch_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("nums");
    QTest::addColumn<QString>("counter");
    QTest::newRow("apostrophe") << u"O'Neil"_s << QStringList{"1004"} << u"רשומה מס' 1 מתוך  1"_s;
    QTest::newRow("apostrophe in the number")
        << u"77'"_s << QStringList{"77'7"} << u"רשומה מס' 1 מתוך  1"_s;
    QTest::newRow("many characters")
        << Wild("O*il") << QStringList{"1004"} << u"רשומה מס' 1 מתוך  1"_s;
    QTest::newRow("one character")
        << Wild("Sh?un") << QStringList{"1004"} << u"רשומה מס' 1 מתוך  1"_s;
    QTest::newRow("telephone") << u"03-502"_s << QStringList{"1002"} << u"רשומה מס' 1 מתוך  1"_s;
    QTest::newRow("no hits") << u"zzz"_s << QStringList{} << u"רשומה מס' 0 מתוך  0"_s;
}

void TestSelection::clientSearch() {
    QFETCH(QString, text);
    QFETCH(QStringList, nums);
    QFETCH(QString, counter);
    ListWindow w(kClients);
    w.show();
    // Every client, by number, read as far as the grid shows them.
    QCOMPARE(w.RecordCount(), kClientCount + 1);
    QVERIFY(w.Model().rowCount() < kClientCount);
    QCOMPARE(Counter(w), u"רשומה מס' 1 מתוך  1,501"_s);
    QCOMPARE(w.CurrentRecord().value("NUM").toString(), u"10001"_s);
    // Counting leaves the rows that follow the first batch to be read, none lost or repeated.
    const auto all = Column(w, u"NUM"_s);
    QCOMPARE(all.size(), kClientCount + 1);
    QCOMPARE(QSet<QString>(all.begin(), all.end()).size(), kClientCount + 1);
    auto sorted = all;
    sorted.sort();
    QCOMPARE(all, sorted);

    Grid(w)->setCurrentIndex(w.Model().index(40, 0));
    QCOMPARE(Counter(w), u"רשומה מס' 41 מתוך  1,501"_s);
    Search(w, text);
    QCOMPARE(Column(w, u"NUM"_s), nums);
    QCOMPARE(Counter(w), counter);
    QCOMPARE(w.HasCurrentRow(), !nums.isEmpty());
    for (int row = 0; row < w.Model().rowCount(); ++row) {
        QCOMPARE(w.Model().index(row, ColumnOf(w, {})).data().toInt(), row + 1);
    }
}

void TestSelection::enterSearches() {
    ListWindow w(kClients);
    w.show();
    auto* box = w.findChild<QLineEdit*>(u"txtSearch"_s);
    QTest::keyClicks(box, u"O'Neil"_s);
    QCOMPARE(w.RecordCount(), kClientCount + 1);
    QTest::keyClick(box, Qt::Key_Enter);
    QCOMPARE(Column(w, u"NUM"_s), QStringList{"1004"});
    box->clear();
    Click(w, "cmdSearch");
    QCOMPARE(w.RecordCount(), kClientCount + 1);
}

void TestSelection::searchBoxSwitchesToHebrew() {
    test::ScopedRecordingKeyboard keyboard;
    for (const auto variant : {kClients, kNames}) {
        ListWindow w(variant);
        w.show();
        QFocusEvent focus(QEvent::FocusIn);
        QApplication::sendEvent(w.findChild<QLineEdit*>(u"txtSearch"_s), &focus);
    }
    QCOMPARE(keyboard.Loaded(), QStringList{"0000040D"});
}

void TestSelection::unreachableDatabaseReported() {
    if (kServer) {
        SetDataSource(env_->Root() + u"/no-server,1"_s);
    } else {
        SetMainPath(env_->Root() + u"/no-installation"_s);
    }
    ListWindow w(kNames);
    w.show();
    QCOMPARE(w.RecordCount(), 0);
    QCOMPARE(Counter(w), u"רשומה מס' 0 מתוך  0"_s);
    Search(w, u"כהן"_s);
    const auto texts = (*ui_)->Texts();
    QCOMPARE(texts.size(), 2);
    QVERIFY2(texts[0].contains(u"--"_s), qPrintable(texts[0]));
    QCOMPARE(texts[1], u"424-DoSearch-Object required"_s);
    (*ui_)->Clear();
}

void TestSelection::namesOfOneClient_data() {
    QTest::addColumn<QString>("client");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("kinds");
    const QStringList all1001{"1", "2", "3", "4", "5", "6", "10", "11", "11"};
    QTest::newRow("opened for a client") << u"1001"_s << u""_s << all1001;
    QTest::newRow("client number with an apostrophe")
        << u"77'7"_s << u""_s << QStringList{"1", "11", "11", "11"};
    QTest::newRow("searched by case") << u"77'7"_s << u"4"_s << QStringList{"11"};
    QTest::newRow("kinds outside the list")
        << u"1002"_s << u""_s << QStringList{"4", "11", "11", "11"};
}

void TestSelection::namesOfOneClient() {
    QFETCH(QString, client);
    QFETCH(QString, text);
    QFETCH(QStringList, kinds);
    ListWindow w(kNames);
    w.SetClientNum(client);
    w.show();
    if (!text.isEmpty()) {
        Search(w, text);
    }
    QCOMPARE(Column(w, u"OptKey"_s), kinds);
    QCOMPARE(Column(w, u"LakNum"_s), QStringList(kinds.size(), client));
    // Within a kind, by case number.
    const auto tiks = Column(w, u"Tik"_s);
    for (int i = 1; i < tiks.size(); ++i) {
        QVERIFY(kinds[i] != kinds[i - 1] || tiks[i - 1] <= tiks[i]);
    }
}

void TestSelection::allNames() {
    ListWindow w(kNames);
    w.show();
    QCOMPARE(w.Model().rowCount(), 0);
    QCOMPARE(Counter(w), u"רשומה מס' 0 מתוך  0"_s);
    Search(w, {});
    const QSet<int> listed{0, 1, 2, 3, 4, 5, 6, 10, 11};
    QCOMPARE(
        w.RecordCount(),
        CountRows("ZORVA", "SELECT COUNT(*) FROM LOOKFOR WHERE OptKey IN (0,1,2,3,4,5,6,10,11)"));
    QList<QPair<int, QString>> keys;
    for (const auto& row : AllRows(w)) {
        QVERIFY(listed.contains(row.value("OptKey").toInt()));
        keys << qMakePair(row.value("OptKey").toInt(), row.value("LakNum").toString());
    }
    auto sorted = keys;
    std::stable_sort(sorted.begin(), sorted.end());
    QCOMPARE(keys, sorted);
}

void TestSelection::namesSearch_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("rows");  // LakNum:OptKey
    QTest::newRow("last name reaches other kinds") << u"רוזן"_s << QStringList{"1005:15"};
    QTest::newRow("first name does not") << u"יוסי"_s << QStringList{};
    QTest::newRow("apostrophe") << u"ג'ב"_s << QStringList{"1003:0", "1003:1", "1003:9", "1003:11"};
    QTest::newRow("wildcard") << Wild("O*Ne?l") << QStringList{"1004:0", "1004:2", "1004:3"};
    QTest::newRow("no hits") << u"zzz"_s << QStringList{};
}

void TestSelection::namesSearch() {
    QFETCH(QString, text);
    QFETCH(QStringList, rows);
    ListWindow w(kNames);
    w.show();
    Search(w, text);
    QStringList found;
    for (const auto& row : AllRows(w)) {
        found << row.value("LakNum").toString() + ":" + row.value("OptKey").toString();
    }
    QCOMPARE(found, rows);
    QCOMPARE(Counter(w), u"רשומה מס' %1 מתוך  %2"_s.arg(rows.isEmpty() ? 0 : 1).arg(rows.size()));
}

void TestSelection::kindColumn_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("client");
    QTest::addColumn<int>("optKey");
    QTest::addColumn<QString>("tikId");
    QTest::addColumn<QString>("shown");
    QTest::newRow("a case kind") << u"ישראלי"_s << u"1001"_s << 4 << u"2"_s << u"תיק הוצל\"פ"_s;
    QTest::newRow("general case") << u"ישראלי"_s << u"1001"_s << 11 << u"26"_s
                                  << (kServer ? "תיק כללי" : "תיקי ירושה");
    QTest::newRow("general case, unknown kind")
        << u"טל"_s << u"77'7"_s << 11 << u"3"_s << (kServer ? "תיק כללי" : "");
    QTest::newRow("general case without kind")
        << u"טל"_s << u"77'7"_s << 11 << u""_s << u"תיק כללי"_s;
    QTest::newRow("kind not in the catalogue") << u"רוזן"_s << u"1005"_s << 15 << u""_s << u"15"_s;
}

void TestSelection::kindColumn() {
    QFETCH(QString, text);
    QFETCH(QString, client);
    QFETCH(int, optKey);
    QFETCH(QString, tikId);
    QFETCH(QString, shown);
    ListWindow w(kNames);
    w.show();
    Search(w, text);
    const int row = SelectRow(w, [&](const QSqlRecord& r) {
        return RowOf(client, optKey)(r) && r.value("TIK_ID").toString() == tikId;
    });
    QVERIFY(row >= 0);
    const auto cell = w.Model().index(row, ColumnOf(w, u"OptKey"_s));
    if (!kServer && tikId.isEmpty() && optKey == 11) {
        // A general case without its kind cannot be named; its number is shown.
        QCOMPARE(cell.data().toString(), u"11"_s);
    } else {
        QCOMPARE(cell.data().toString(), shown);
    }
}

void TestSelection::layoutSaveReopenReset_data() {
    QTest::addColumn<int>("variant");
    QTest::addColumn<QString>("file");
    QTest::newRow("clients") << static_cast<int>(kClients) << u"AddInLak.grx"_s;
    QTest::newRow("names") << static_cast<int>(kNames) << u"AddInLF.grx"_s;
}

void TestSelection::layoutSaveReopenReset() {
    QFETCH(int, variant);
    QFETCH(QString, file);
    const auto v = static_cast<ListVariant>(variant);
    const QString path = env_->DataDir() + "/MGRX/" + MyUser() + "/" + file;
    GridColumns saved;
    GridColumns builtIn;
    {
        ListWindow w(v);
        w.show();
        QCOMPARE(QDir::cleanPath(w.LayoutFile()), QDir::cleanPath(path));
        builtIn = w.ShownColumns();
        QCOMPARE(builtIn, v == kClients ? ClientColumns() : NamesColumns());
        auto* header = Grid(w)->horizontalHeader();
        header->moveSection(4, 0);
        header->resizeSection(header->logicalIndex(2), 222);
        Grid(w)->setColumnHidden(header->logicalIndex(1), true);
        saved = w.ShownColumns();
        QVERIFY(saved != builtIn);
        Click(w, "Command1");
        QVERIFY(QFile::exists(path));
        w.close();
    }
    ListWindow again(v);
    again.show();
    QCOMPARE(again.ShownColumns(), saved);
    QCOMPARE(Grid(again)->horizontalHeader()->sectionSize(2), 222);
    QVERIFY(Grid(again)->isColumnHidden(1));
    Click(again, "CmdReset");
    QVERIFY(!QFile::exists(path));
    QCOMPARE(again.ShownColumns(), builtIn);
}

void TestSelection::brokenLayoutFile() {
    const QString folder = env_->DataDir() + "/MGRX/" + MyUser();
    QDir().mkpath(folder);
    QFile f(folder + "/AddInLak.grx");
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write("{ not a layout");
    f.close();
    ListWindow w(kClients);
    w.show();
    QCOMPARE(w.ShownColumns(), ClientColumns());
    QCOMPARE((*ui_)->Texts().size(), 1);
    QVERIFY((*ui_)->Texts().first().startsWith(u"5-GetTeurTik-"_s));
    (*ui_)->Clear();
}

void TestSelection::check1Persisted() {
    auto stored = [] { return GetSetting(u"KAVEX32"_s, u"General"_s, u"AddInOnLakTik"_s); };
    for (const bool tick : {true, false}) {
        ListWindow w(kNames);
        w.show();
        auto* box = w.findChild<QCheckBox*>(u"Check1"_s);
        QCOMPARE(box->isChecked(), !tick);
        box->click();
        QCOMPARE(stored(), tick ? u"1"_s : u"0"_s);
        w.close();
        ListWindow again(kNames);
        again.show();
        QCOMPARE(again.findChild<QCheckBox*>(u"Check1"_s)->isChecked(), tick);
    }
}

void TestSelection::chooseClient_data() {
    QTest::addColumn<QString>("num");
    QTest::addColumn<QString>("name");
    QTest::addColumn<bool>("doubleClick");
    QTest::newRow("both names") << u"1004"_s << u"Shaun O'Neil"_s << false;
    QTest::newRow("last name only") << u"1002"_s << u"עיריית חולון"_s << true;
    QTest::newRow("no name") << u"1012"_s << u""_s << false;
    QTest::newRow("apostrophe in the number") << u"77'7"_s << u"אנה טל"_s << true;
}

void TestSelection::chooseClient() {
    QFETCH(QString, num);
    QFETCH(QString, name);
    QFETCH(bool, doubleClick);
    (*ui_)->QueueModal([&](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        QCOMPARE(w.objectName(), kServer ? u"FrmLakAdo"_s : u"FrmLak"_s);
        Search(w, num);
        const int row = SelectRow(w, [&](const QSqlRecord& r) { return r.value("NUM") == num; });
        QVERIFY(row >= 0);
        if (doubleClick) {
            auto* grid = Grid(w);
            const auto rect = grid->visualRect(w.Model().index(row, 1));
            // A double-click follows the press of its first click, as from a real mouse.
            QTest::mouseClick(grid->viewport(), Qt::LeftButton, {}, rect.center());
            QTest::mouseDClick(grid->viewport(), Qt::LeftButton, {}, rect.center());
        } else {
            Click(w, "CmdOK");
        }
        QVERIFY(!w.isVisible());
    });
    auto labels = EarlierChoice();
    QVERIFY(ChooseClient(labels));
    QCOMPARE(Fields(labels), (QStringList{num, name, "F", "", "", "", "", ""}));
    QCOMPARE((*ui_)->ModalCount(), 1);
}

void TestSelection::closingOrEmptyListKeepsClient_data() {
    QTest::addColumn<bool>("close");
    QTest::newRow("closed after moving") << true;
    QTest::newRow("chosen from an empty list") << false;
}

void TestSelection::closingOrEmptyListKeepsClient() {
    QFETCH(bool, close);
    (*ui_)->QueueModal([&](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        if (close) {
            Grid(w)->setCurrentIndex(w.Model().index(3, 0));
            w.close();
            QVERIFY(w.IsCancel());
        } else {
            Search(w, "zzz");
            Click(w, "CmdOK");
            QVERIFY(!w.IsCancel());
        }
    });
    auto labels = EarlierChoice();
    QVERIFY(!ChooseClient(labels));
    QCOMPARE(Fields(labels), Fields(EarlierChoice()));
}

void TestSelection::clientTeur_data() {
    QTest::addColumn<QVariant>("num");
    QTest::addColumn<QString>("name");
    QTest::newRow("both names") << QVariant("1004") << u"Shaun O'Neil"_s;
    QTest::newRow("unknown") << QVariant("99'99") << u"99'99"_s;
    QTest::newRow("number") << QVariant(1005) << u"שרה לוי"_s;
    QTest::newRow("null") << QVariant(QMetaType(QMetaType::QString)) << u""_s;
}

void TestSelection::clientTeur() {
    QFETCH(QVariant, num);
    QFETCH(QString, name);
    QCOMPARE(GetClientTeur(num), name);
}

void TestSelection::clientCaseNeedsClient() {
    ChoiceLabels labels;
    QVERIFY(!ChooseClientCase(labels));
    QCOMPARE((*ui_)->ModalCount(), 0);
    QCOMPARE((*ui_)->Messages().size(), size_t{1});
    QCOMPARE((*ui_)->Messages()[0].text, u"יש להגדיר תחילה לקוח, לפני פתיחת רשימת תיקי לקוח"_s);
    QCOMPARE((*ui_)->Messages()[0].style, int{vbExclamation});
    (*ui_)->Clear();
}

void TestSelection::chooseClientCase_data() {
    QTest::addColumn<QString>("client");
    QTest::addColumn<int>("optKey");
    QTest::addColumn<QString>("tikId");
    QTest::addColumn<QStringList>("labels");
    QTest::newRow("case with a sub-kind")
        << u"1001"_s << 4 << u"2"_s
        << QStringList{"1001", "ישראל ישראלי", "H",           "2",
                       "4",    "1001-4",       "תיק הוצל\"פ", "ישראל ישראלי"};
    QTest::newRow("general case") << u"1001"_s << 11 << u"26"_s
                                  << QStringList{"1001",   "ישראל ישראלי", "T",           "26", "8",
                                                 "1001-8", "תיקי ירושה",   "ישראל ישראלי"};
    QTest::newRow("general case of an unknown kind")
        << u"77'7"_s << 11 << u"3"_s
        << QStringList{"77'7", "אנה טל", "T", "3", "3", "77'7-3", "", "אנה טל"};
}

void TestSelection::chooseClientCase() {
    QFETCH(QString, client);
    QFETCH(int, optKey);
    QFETCH(QString, tikId);
    QFETCH(QStringList, labels);
    (*ui_)->QueueModal([&](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        QCOMPARE(w.ClientNum(), client);
        QVERIFY(SelectRow(w, RowOf(client, optKey, tikId)) >= 0);
        Click(w, "CmdAct");
    });
    ChoiceLabels chosen;
    chosen.lakNum = client;
    chosen.lakName = labels[1];
    QVERIFY(ChooseClientCase(chosen));
    QCOMPARE(Fields(chosen), labels);
}

void TestSelection::chooseCaseByName_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("client");
    QTest::addColumn<int>("optKey");
    QTest::addColumn<QString>("sug");
    QTest::addColumn<bool>("taken");
    QTest::addColumn<QStringList>("labels");
    QTest::newRow("client") << u"O'Neil"_s << u"1004"_s << 0 << u"F"_s << true
                            << QStringList{"1004", "Shaun O'Neil", "F",    "",
                                           "12",   "1004",         "לקוח", "Shaun O'Neil"};
    QTest::newRow("blank sub-kind")
        << u"עיריית"_s << u"1002"_s << 4 << u"H"_s << true
        << QStringList{"1002", "עיריית חולון", "H",           "0",
                       "1",    "1002-1",       "תיק הוצל\"פ", "עיריית חולון"};
    QTest::newRow("general case") << u"ישראלי"_s << u"1001"_s << 11 << u"T"_s << true
                                  << QStringList{"1001", "ישראל ישראלי", "T",           "26", "8",
                                                 "8",    "תיקי ירושה",   "ישראל ישראלי"};
    QTest::newRow("kind 17, known letter")
        << u"שטרן"_s << u"1005"_s << 17 << u"W"_s << true
        << QStringList{"1005", "שרה לוי", "W", "0", "3", "1005-3", "תיק מיוחד", "אורי שטרן"};
    QTest::newRow("kind 17, unknown letter")
        << u"גולן"_s << u"1005"_s << 17 << u"X"_s << false << Fields(EarlierChoice());
    QTest::newRow("kind without a rule")
        << u"רוזן"_s << u"1005"_s << 15 << u"A"_s << false << Fields(EarlierChoice());
}

void TestSelection::chooseCaseByName() {
    QFETCH(QString, text);
    QFETCH(QString, client);
    QFETCH(int, optKey);
    QFETCH(QString, sug);
    QFETCH(bool, taken);
    QFETCH(QStringList, labels);
    (*ui_)->QueueModal([&](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        QCOMPARE(w.objectName(), kServer ? u"FrmLookForAdo"_s : u"FrmLookFor"_s);
        QVERIFY(w.ClientNum().isEmpty());
        Search(w, text);
        QVERIFY(SelectRow(w, [&](const QSqlRecord& r) {
                    return RowOf(client, optKey)(r) && r.value("Sug").toString() == sug;
                }) >= 0);
        Click(w, "CmdOK");
    });
    auto chosen = EarlierChoice();
    QCOMPARE(ChooseCaseByName(chosen), taken);
    QCOMPARE(Fields(chosen), labels);
}

void TestSelection::closingNamesWindowChangesNothing() {
    for (const bool byName : {false, true}) {
        (*ui_)->QueueModal([](QWidget& window) {
            auto& w = dynamic_cast<ListWindow&>(window);
            Search(w, u"ישראלי"_s);
            Grid(w)->setCurrentIndex(w.Model().index(2, 0));
            w.close();
        });
        auto labels = EarlierChoice();
        labels.lakNum = u"1001"_s;
        const auto before = Fields(labels);
        QVERIFY(!(byName ? ChooseCaseByName(labels) : ChooseClientCase(labels)));
        QCOMPARE(Fields(labels), before);
    }
}

}  // namespace zv

QTEST_MAIN(zv::TestSelection)
#include "test_selection.moc"

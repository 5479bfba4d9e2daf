// The client and case choices and their list windows, on the back-end this program was
// built for: the file databases, or (ZV_SELECTION_SERVER) the PostgreSQL test cluster.

#include <QCheckBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSqlRecord>
#include <QTableView>
#include <QtTest>
#include <algorithm>

#include "data/database.h"
#include "recording_keyboard.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "scripted_ui.h"
#include "selection/choice.h"
#include "selection/list_model.h"
#include "selection/list_window.h"
#include "startup/backend_selection.h"
#include "startup/settings.h"
#include "test_env.h"
#include "test_files.h"
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
    return w.findChild<QLabel*>(kServer ? u"AdoData"_s : u"Data1"_s)->text();
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
    const auto named = [&](const GridColumn& c) {
        return c.field.compare(field, Qt::CaseInsensitive) == 0;
    };
    return static_cast<int>(std::find_if(columns.begin(), columns.end(), named) - columns.begin());
}

// Makes the first row whose fields hold these "FIELD=value" pairs the current row; -1 when
// none does.
int SelectRow(ListWindow& w, const QStringList& match) {
    const auto rows = AllRows(w);
    for (int i = 0; i < rows.size(); ++i) {
        if (std::all_of(match.begin(), match.end(), [&](const QString& m) {
                return rows[i].value(m.section('=', 0, 0)).toString() == m.section('=', 1);
            })) {
            Grid(w)->setCurrentIndex(w.Model().index(i, 0));
            return i;
        }
    }
    return -1;
}

}  // namespace

class TestSelection : public QObject {
    Q_OBJECT
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    std::unique_ptr<test::Watchdog> watchdog_;

    test::ScriptedUi& Ui() { return **ui_; }

  private slots:
    void initTestCase();
    void init();
    void cleanup();

    void clientSearch();
    void searchBoxSwitchesToHebrew();
    void unreachableDatabaseReported();
    void namesOfOneClient();
    void allNames();
    void namesSearch();
    void kindColumn();
    void layoutSaveReopenReset();
    void brokenLayoutFile();
    void check1Persisted();

    void chooseClient();
    void clientTeur();
    void clientCaseNeedsClient();
    void chooseCase_data();
    void chooseCase();
    void closingKeepsTheChoice();
};

void TestSelection::initTestCase() {
    env_ = std::make_unique<test::TestEnv>();
    SampleOptions options = kServer ? TestServerOptions() : SampleOptions{};
    if (kServer) {
        ZV_REQUIRE_TEST_SERVER(options);
    }
    options.clients = kClientCount;
    CreateSampleInstallation(env_->DataDir(), options);
    init();  // the state every test starts from, for the rows added here
    // A client whose number holds an apostrophe, with cases of its own.
    Database::Open(u"OFFICE"_s, kServer)
        ->Execute(
            u"INSERT INTO CLIENT (NUM, F_NAME, L_NAME, TELEFON) "
            "VALUES ('77''7', 'אנה', 'טל', '03-7777777')"_s);
    auto zorva = Database::Open(u"ZORVA"_s, kServer);
    for (const char* row : {"0, 'F', NULL, NULL, NULL", "1, 'N', '1', '77''7-1', NULL",
                            "11, 'T', '2', '77''7-2', '2'", "11, 'T', '3', '77''7-3', '3'",
                            "11, 'T', '4', '77''7-4', NULL"}) {
        zorva->Execute(
            u"INSERT INTO LOOKFOR (LakNum, OptKey, Sug, Tik, Code, TIK_ID, F_NAME, "
            "L_NAME, TELEFON) VALUES ('77''7', "_s +
            QString::fromUtf8(row) + u", 'אנה', 'טל', '03-7777777')"_s);
    }
    cleanup();
}

void TestSelection::init() {
    // As at start-up: the installation's settings, and on the server its login and flags.
    ResetState();
    SetBasicParam();
    GetMSSQLParam();
    const QString names =
        u"0 לקוח|1 תיק אזרחי|2 תיק עבודה|3 תיק גירושין|4 תיק הוצל\"פ|"
        "5 תיק ליטיגציה|6 תיק חברות|10 תיק מקרקעין|11 תיק כללי|"
        "17 תיק מיוחד|1002 תיקי צוואות|1026 תיקי ירושה"_s;
    QMap<QString, QString> kinds;
    for (const QString& kind : names.split('|')) {
        kinds.insert(kind.section(' ', 0, 0), kind.section(' ', 1));
    }
    SetOptKeyNames(kinds);
    watchdog_ = std::make_unique<test::Watchdog>(std::chrono::seconds(60));
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    QDir(env_->DataDir() + u"/MGRX"_s).removeRecursively();
    SaveSetting(u"KAVEX32"_s, u"General"_s, u"AddInOnLakTik"_s, {});
}

void TestSelection::cleanup() {
    const auto texts = Ui().Texts();
    const int unexpected = Ui().UnexpectedModals();
    ui_.reset();
    watchdog_.reset();
    // An unexpected message or window fails the test.
    QCOMPARE(texts, QStringList());
    QCOMPARE(unexpected, 0);
}

void TestSelection::clientSearch() {
    ListWindow w(kClients);
    w.show();
    // Every client, by number, read as far as the grid shows them.
    QCOMPARE(w.RecordCount(), kClientCount + 1);
    QVERIFY(w.Model().rowCount() < kClientCount);
    QCOMPARE(Counter(w), u"רשומה מס' 1 מתוך  1,501"_s);
    QCOMPARE(w.CurrentRecord().value("NUM").toString(), u"10001"_s);
    // Counting leaves the rows that follow the first batch to be read, none lost or repeated.
    const auto all = Column(w, u"NUM"_s);
    QCOMPARE(QSet<QString>(all.begin(), all.end()).size(), kClientCount + 1);
    QVERIFY(std::is_sorted(all.begin(), all.end()));
    Grid(w)->setCurrentIndex(w.Model().index(40, 0));
    QCOMPARE(Counter(w), u"רשומה מס' 41 מתוך  1,501"_s);

    // By name with an apostrophe, by telephone, and with no hits.
    for (const auto& [text, nums] : {std::pair{u"O'Neil"_s, QStringList{"1004"}},
                                     {u"03-502"_s, QStringList{"1002"}},
                                     {u"zzz"_s, QStringList{}}}) {
        Search(w, text);
        QCOMPARE(Column(w, u"NUM"_s), nums);
        QCOMPARE(Counter(w), u"רשומה מס' %1 מתוך  %1"_s.arg(nums.size()));
        QCOMPARE(w.HasCurrentRow(), !nums.isEmpty());
        for (int row = 0; row < w.Model().rowCount(); ++row) {
            QCOMPARE(w.Model().index(row, ColumnOf(w, {})).data().toInt(), row + 1);
        }
    }
    // The search button with an empty box lists everyone again.
    w.findChild<QLineEdit*>(u"txtSearch"_s)->clear();
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
    QCOMPARE(Counter(w), u"רשומה מס' 0 מתוך  0"_s);
    Search(w, u"כהן"_s);
    const auto texts = Ui().Texts();
    QCOMPARE(texts.size(), 2);
    QVERIFY2(texts[0].contains(u"--"_s), qPrintable(texts[0]));
    QCOMPARE(texts[1], u"424-DoSearch-Object required"_s);
    Ui().Clear();
}

// A client's list holds the case kinds only, by kind and within a kind by case number.
void TestSelection::namesOfOneClient() {
    for (const auto& [client, text, kinds] :
         {std::tuple{u"1001"_s, QString(),
                     QStringList{"1", "2", "3", "4", "5", "6", "10", "11", "11"}},
          {u"1002"_s, QString(), QStringList{"4", "11", "11", "11"}},
          {u"77'7"_s, QString(), QStringList{"1", "11", "11", "11"}},
          {u"77'7"_s, u"4"_s, QStringList{"11"}}}) {
        ListWindow w(kNames);
        w.SetClientNum(client);
        w.show();
        if (!text.isNull()) {
            Search(w, text);
        }
        QCOMPARE(Column(w, u"OptKey"_s), kinds);
        QCOMPARE(Column(w, u"LakNum"_s), QStringList(kinds.size(), client));
        const auto tiks = Column(w, u"Tik"_s);
        for (int i = 1; i < tiks.size(); ++i) {
            QVERIFY(kinds[i] != kinds[i - 1] || tiks[i - 1] <= tiks[i]);
        }
    }
}

// Opened without a client the list is empty; an empty search lists the names of every kind
// of the list, by kind and client.
void TestSelection::allNames() {
    ListWindow w(kNames);
    w.show();
    QCOMPARE(Counter(w), u"רשומה מס' 0 מתוך  0"_s);
    Search(w, {});
    QList<QPair<int, QString>> keys;
    QSet<int> kinds;
    for (const auto& row : AllRows(w)) {
        keys << qMakePair(row.value("OptKey").toInt(), row.value("LakNum").toString());
        kinds << keys.last().first;
    }
    QCOMPARE(kinds, (QSet<int>{0, 1, 2, 3, 4, 5, 6, 10, 11}));
    QCOMPARE(w.RecordCount(), keys.size());
    QVERIFY(std::is_sorted(keys.begin(), keys.end()));
}

// A last name reaches the names of every kind, a first name only those of the list's kinds.
void TestSelection::namesSearch() {
    ListWindow w(kNames);
    w.show();
    for (const auto& [text, rows] :  // LakNum:OptKey
         {std::pair{u"רוזן"_s, QStringList{"1005:15"}},
          {u"יוסי"_s, QStringList{}},
          {u"ג'ב"_s, QStringList{"1003:0", "1003:1", "1003:9", "1003:11"}},
          {kServer ? u"O%Ne_l"_s : u"O*Ne?l"_s, QStringList{"1004:0", "1004:2", "1004:3"}}}) {
        Search(w, text);
        QStringList found;
        for (const auto& row : AllRows(w)) {
            found << row.value("LakNum").toString() + ":" + row.value("OptKey").toString();
        }
        QCOMPARE(found, rows);
        QCOMPARE(Counter(w),
                 u"רשומה מס' %1 מתוך  %2"_s.arg(rows.isEmpty() ? 0 : 1).arg(rows.size()));
    }
}

// The kind column names a general case by its kind, on the file; without its kind, by the
// number.
void TestSelection::kindColumn() {
    ListWindow w(kNames);
    w.show();
    const QString general = kServer ? u"תיק כללי"_s : QString();
    for (const auto& [text, match, shown] :
         {std::tuple{u"ישראלי"_s, QStringList{"LakNum=1001", "OptKey=4", "TIK_ID=2"},
                     u"תיק הוצל\"פ"_s},
          {u"ישראלי"_s, QStringList{"LakNum=1001", "OptKey=11", "TIK_ID=26"},
           kServer ? general : u"תיקי ירושה"_s},
          {u"טל"_s, QStringList{"LakNum=77'7", "OptKey=11", "TIK_ID=3"}, kServer ? general : u""_s},
          {u"טל"_s, QStringList{"LakNum=77'7", "OptKey=11", "TIK_ID="},
           kServer ? general : u"11"_s},
          {u"רוזן"_s, QStringList{"LakNum=1005", "OptKey=15"}, u"15"_s}}) {
        Search(w, text);
        const int row = SelectRow(w, match);
        QVERIFY2(row >= 0, qPrintable(match.join(' ')));
        QCOMPARE(w.Model().index(row, ColumnOf(w, u"OptKey"_s)).data().toString(), shown);
    }
}

void TestSelection::layoutSaveReopenReset() {
    for (const auto& [v, file] :
         {std::pair{kClients, u"AddInLak.grx"_s}, {kNames, u"AddInLF.grx"_s}}) {
        const QString path = env_->DataDir() + "/MGRX/" + MyUser() + "/" + file;
        const GridColumns builtIn = v == kClients ? ClientColumns() : NamesColumns();
        GridColumns saved;
        {
            ListWindow w(v);
            w.show();
            QCOMPARE(QDir::cleanPath(w.LayoutFile()), QDir::cleanPath(path));
            QCOMPARE(w.ShownColumns(), builtIn);
            auto* header = Grid(w)->horizontalHeader();
            header->moveSection(4, 0);
            header->resizeSection(header->logicalIndex(2), 222);
            Grid(w)->setColumnHidden(header->logicalIndex(1), true);
            saved = w.ShownColumns();
            QVERIFY(saved != builtIn);
            Click(w, "Command1");
            QVERIFY(QFile::exists(path));
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
}

void TestSelection::brokenLayoutFile() {
    QVERIFY(
        test::WriteFile(env_->DataDir() + "/MGRX/" + MyUser() + "/AddInLak.grx", "{ not a layout"));
    ListWindow w(kClients);
    w.show();
    QCOMPARE(w.ShownColumns(), ClientColumns());
    QCOMPARE(Ui().Texts().size(), 1);
    QVERIFY(Ui().Texts().first().startsWith(u"5-GetTeurTik-"_s));
    Ui().Clear();
}

void TestSelection::check1Persisted() {
    for (const bool tick : {true, false}) {
        {
            ListWindow w(kNames);
            w.show();
            auto* box = w.findChild<QCheckBox*>(u"Check1"_s);
            QCOMPARE(box->isChecked(), !tick);
            box->click();
            QCOMPARE(GetSetting(u"KAVEX32"_s, u"General"_s, u"AddInOnLakTik"_s),
                     tick ? u"1"_s : u"0"_s);
        }
        ListWindow again(kNames);
        again.show();
        QCOMPARE(again.findChild<QCheckBox*>(u"Check1"_s)->isChecked(), tick);
    }
}

// The client's number and name; the case labels are cleared.
void TestSelection::chooseClient() {
    for (const auto& [num, name, doubleClick] : {std::tuple{u"1004"_s, u"Shaun O'Neil"_s, false},
                                                 {u"1002"_s, u"עיריית חולון"_s, true},
                                                 {u"77'7"_s, u"אנה טל"_s, false}}) {
        // Copies: clang 14 cannot capture a structured binding in a lambda.
        Ui().QueueModal([&, num = num, doubleClick = doubleClick](QWidget& window) {
            auto& w = dynamic_cast<ListWindow&>(window);
            QCOMPARE(w.objectName(), kServer ? u"FrmLakAdo"_s : u"FrmLak"_s);
            Search(w, num);
            const int row = SelectRow(w, {"NUM=" + num});
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
    }
    QCOMPARE(Ui().ModalCount(), 3);
}

// An unknown number stands for itself; a Null one for nothing.
void TestSelection::clientTeur() {
    QCOMPARE(GetClientTeur(u"1004"_s), u"Shaun O'Neil"_s);
    QCOMPARE(GetClientTeur(u"99'99"_s), u"99'99"_s);
    QCOMPARE(GetClientTeur(QVariant(QMetaType(QMetaType::QString))), QString());
}

void TestSelection::clientCaseNeedsClient() {
    ChoiceLabels labels;
    QVERIFY(!ChooseClientCase(labels));
    QCOMPARE(Ui().ModalCount(), 0);
    QCOMPARE(Ui().Texts(), QStringList{u"יש להגדיר תחילה לקוח, לפני פתיחת רשימת תיקי לקוח"_s});
    QCOMPARE(Ui().Messages()[0].style, int{vbExclamation});
    Ui().Clear();
}

// A case from the list of the chosen client's cases (the client's name stays), or from the
// names of every client, searched; the labels after the choice, or the earlier ones when
// the row cannot be taken.
void TestSelection::chooseCase_data() {
    QTest::addColumn<bool>("byName");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("row");
    QTest::addColumn<QStringList>("labels");
    const auto row = [](const char* name, bool byName, const QString& text,
                        const QStringList& match, const QStringList& labels) {
        QTest::newRow(name) << byName << text << match << labels;
    };
    const QStringList earlier = Fields(EarlierChoice());
    row("from the client's cases", false, {}, {"LakNum=1001", "OptKey=11", "TIK_ID=26"},
        {"1001", "לקוח קודם", "T", "26", "8", "1001-8", "תיקי ירושה", "ישראל ישראלי"});
    row("by name: client", true, u"O'Neil"_s, {"LakNum=1004", "OptKey=0"},
        {"1004", "Shaun O'Neil", "F", "", "12", "1004", "לקוח", "Shaun O'Neil"});
    row("by name: blank sub-kind", true, u"עיריית"_s, {"LakNum=1002", "OptKey=4"},
        {"1002", "עיריית חולון", "H", "0", "1", "1002-1", "תיק הוצל\"פ", "עיריית חולון"});
    row("by name: general case", true, u"ישראלי"_s, {"LakNum=1001", "OptKey=11", "TIK_ID=26"},
        {"1001", "ישראל ישראלי", "T", "26", "8", "8", "תיקי ירושה", "ישראל ישראלי"});
    row("by name: kind 17, known letter", true, u"שטרן"_s, {"LakNum=1005", "OptKey=17", "Sug=W"},
        {"1005", "שרה לוי", "W", "0", "3", "1005-3", "תיק מיוחד", "אורי שטרן"});
    row("by name: kind 17, unknown letter", true, u"גולן"_s, {"LakNum=1005", "OptKey=17", "Sug=X"},
        earlier);
    row("by name: kind without a rule", true, u"רוזן"_s, {"LakNum=1005", "OptKey=15"}, earlier);
}

void TestSelection::chooseCase() {
    QFETCH(bool, byName);
    QFETCH(QString, text);
    QFETCH(QStringList, row);
    QFETCH(QStringList, labels);
    auto chosen = EarlierChoice();
    if (!byName) {
        chosen.lakNum = row[0].section('=', 1);
    }
    Ui().QueueModal([&](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        QCOMPARE(w.objectName(), kServer ? u"FrmLookForAdo"_s : u"FrmLookFor"_s);
        QCOMPARE(w.ClientNum(), byName ? QString() : chosen.lakNum);
        if (byName) {
            Search(w, text);
        }
        QVERIFY(SelectRow(w, row) >= 0);
        Click(w, byName ? "CmdOK" : "CmdAct");
    });
    const QStringList before = Fields(chosen);
    // The client's case list always answers yes; the name list when it takes the row.
    QCOMPARE(byName ? ChooseCaseByName(chosen) : ChooseClientCase(chosen),
             !byName || labels != before);
    QCOMPARE(Fields(chosen), labels);
}

// Closing a list window, or choosing from an empty list, keeps the earlier choice; only the
// client's case list answers yes to a choice from its empty list.
void TestSelection::closingKeepsTheChoice() {
    const std::pair<const char*, bool (*)(ChoiceLabels&)> choices[] = {
        {"client", ChooseClient},
        {"client's case", ChooseClientCase},
        {"by name", ChooseCaseByName}};
    for (const auto& [name, choose] : choices) {
        for (const bool close : {true, false}) {
            Ui().QueueModal([&](QWidget& window) {
                auto& w = dynamic_cast<ListWindow&>(window);
                Search(w, close ? QString() : u"zzz"_s);
                if (close) {
                    Grid(w)->setCurrentIndex(w.Model().index(2, 0));
                    w.close();
                } else {
                    Click(w, "CmdOK");
                }
            });
            auto labels = EarlierChoice();
            labels.lakNum = u"1001"_s;
            const auto before = Fields(labels);
            const bool taken = choose(labels);
            QVERIFY2(taken == (!close && choose == &ChooseClientCase), name);
            QVERIFY2(Fields(labels) == before, name);
        }
    }
}

}  // namespace zv

QTEST_MAIN(zv::TestSelection)
#include "test_selection.moc"

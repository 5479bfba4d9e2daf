// File databases: opening, Jet LIKE and Val on SQLite, stored forms of Booleans and dates,
// recordsets of the file kind, and GAddNew/GEdit/GUpdate on them.
#include <sqlite3.h>

#include <QDateTime>
#include <QSqlDatabase>
#include <QtTest>

#include "data/data_errors.h"
#include "data/database.h"
#include "data/jet_functions.h"
#include "data/record_edit.h"
#include "data/recordset.h"
#include "data/values.h"
#include "error_of.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "util/state.h"

using namespace zv;
using test::ErrorOf;

namespace {

// Runs the statements on a file with the SQLite C API, so that nothing of the code under test
// makes or reads the test's files: the values of every row joined by "," (NULL for NULL), and
// the message of an error.
QString Raw(const QString& file, const QString& sql, bool jetFunctions = false) {
    sqlite3* db = nullptr;
    sqlite3_open(file.toUtf8().constData(), &db);
    if (jetFunctions) {
        RegisterJetFunctions(db);
    }
    QStringList values;
    const QByteArray text = sql.toUtf8();
    bool failed = false;
    for (const char* next = text.constData(); *next != 0 && !failed;) {
        sqlite3_stmt* stmt = nullptr;
        int rc = sqlite3_prepare_v2(db, next, -1, &stmt, &next);
        while (stmt && (rc = sqlite3_step(stmt)) == SQLITE_ROW) {
            for (int i = 0; i < sqlite3_column_count(stmt); ++i) {
                const auto* v = reinterpret_cast<const char*>(sqlite3_column_text(stmt, i));
                values << (v ? QString::fromUtf8(v) : QStringLiteral("NULL"));
            }
        }
        failed = rc != SQLITE_OK && rc != SQLITE_DONE;
        if (failed) {
            values << QString::fromUtf8(sqlite3_errmsg(db));
        }
        sqlite3_finalize(stmt);
    }
    sqlite3_close(db);
    return values.join(QLatin1Char(','));
}

}  // namespace

class TestFileDatabase : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        main_ = env_->DataDir();
        SetMainPath(main_);
        QVERIFY(QDir().mkpath(main_));
        QCOMPARE(File("OFFICE",
                      "PRAGMA synchronous=OFF; CREATE TABLE MTIK (ID INTEGER NOT NULL PRIMARY KEY,"
                      " TEUR TEXT, SHOW BOOLEAN DEFAULT 0);"
                      "INSERT INTO MTIK VALUES (1,'גירושין',1),(2,'ירושה',0),(3,'Lease',1)"),
                 QString());
        // DOCS has no primary key, only a unique index on ID, as in the suite's files.
        QCOMPARE(File("MDOCS",
                      "PRAGMA synchronous=OFF; CREATE TABLE DOCS (ID INTEGER, IsMemo BOOLEAN "
                      "DEFAULT 1, DateCreated DATETIME, FULLNAME TEXT, Teur TEXT NOT NULL DEFAULT "
                      "''); CREATE UNIQUE INDEX DOCS_ID ON DOCS (ID);"
                      "INSERT INTO DOCS (ID, FULLNAME) VALUES (7,'a.doc'),(12,'b.doc')"),
                 QString());
    }
    void cleanup() { env_.reset(); }

    // A missing file is an error and is not created; each open is a connection of its own,
    // released on close, and a recordset keeps its rows after its database closes.
    void opening() {
        QCOMPARE(ErrorOf([] { Database::OpenFile(QStringLiteral("\\PUB.MDB")); }),
                 err::JetCannotOpen);
        QVERIFY(!QFile::exists(main_ + QStringLiteral("/PUB.MDB")));
        const QStringList before = QSqlDatabase::connectionNames();
        auto a = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
        auto b = Database::Open(QStringLiteral("OFFICE"), false);
        QVERIFY(a->ConnectionName() != b->ConnectionName());
        auto rs = a->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE [SHOW]=True"));
        GClose(a);
        QCOMPARE(rs->RecordCount(), 2);
        rs->Close();
        GClose(rs);  // closing what is closed is no failure
        GClose(b);
        QCOMPARE(QSqlDatabase::connectionNames(), before);

        const QString folder = main_ + QStringLiteral("/תיק משותף #1?x=%20");
        QVERIFY(QDir().mkpath(folder));
        QCOMPARE(Raw(folder + QStringLiteral("/PUB.MDB"), QStringLiteral("CREATE TABLE U (A)")),
                 QString());
        SetMainPath(folder);
        auto pub = Database::OpenFile(QStringLiteral("\\PUB.MDB"));
        QCOMPARE(pub->OpenRecordset(QStringLiteral("SELECT * FROM U"))->FieldCount(), 1);
    }

    void jetLike() {
        const struct {
            const char* name;
            const char* pattern;
            const char* text;
            bool match;
        } cases[] = {
            {"percent is literal", "%ab%", "xabx", false},
            {"one char", "a?c", "abc", true},
            {"digit", "#-#", "5-7", true},
            {"class", "[abc]x", "Bx", true},
            {"range", "[a-f]1", "e1", true},
            {"negated class", "[!a-f]1", "g1", true},
            {"bracketed star is literal", "a[*]", "a*", true},
            {"whole text", "abc", "abcd", false},
            {"star, empty text", "*", "", true},
            {"stars in a row", "a**b", "ab", true},
            {"letter outside the basic plane", "\U00010410*", "\U00010410x", true},
            {"whole text, mixed case", "ÀbÇ", "àBç", true},
            {"prefix, mixed case", "o'NE*", "O'Neil", true},
            {"prefix longer than text", "abcd*", "abc", false},
            {"suffix, mixed case", "*NEIL", "O'Neil", true},
            {"suffix longer than text", "*abc", "bc", false},
            {"contains after a false start", "*aab*", "aaab", true},
            {"contains longer than text", "*abc*", "ab", false},
            {"Hebrew final letter is its own", "*כהנ*", "כהן", false},
            {"sign that folds to a Latin letter", "*k*", "5 \u212A", true},
            {"class inside stars", "*[ab]*", "xBx", true},
            {"unclosed bracket is literal", "*[a*", "x[Ab", true},
            {"empty class matches nothing", "*[]*", "ab", false},
        };
        for (const auto& c : cases) {
            QVERIFY2(JetLike(QString::fromUtf8(c.pattern), QString::fromUtf8(c.text)) == c.match,
                     c.name);
        }
    }

    // The quick folding of names agrees with Qt's for every code unit.
    void jetLikeFoldsEveryCodeUnit() {
        for (char32_t c = 0; c <= 0xFFFF; ++c) {
            const QChar original(static_cast<char16_t>(c));
            const QChar folded = original.toCaseFolded();
            QVERIFY2(JetLike(QStringLiteral("!") + original, folded, u'!') &&
                         JetLike(QStringLiteral("!") + folded, original, u'!'),
                     qPrintable(QString::number(c, 16)));
        }
    }

    // The registered function straight on a connection: NULLs, the escape, the text as
    // SQLite stores it, and a pattern kept from row to row only while it stays the same.
    void likeFunction() {
        const QString rows = QStringLiteral(
            "CREATE TABLE r (t, p, e); INSERT INTO r VALUES ('abc', 'a*', '!'), ('a*', '*x*', "
            "'#'), ('ABC', '*b*', '!'), ('a!x', '', '#');");
        const struct {
            const char* sql;
            const char* result;
        } cases[] = {
            {"SELECT 'xabx' LIKE '%ab%'", "0"},  // Jet's LIKE, not SQL's
            {"SELECT 'àBç' LIKE 'ÀbÇ'", "1"},
            {"SELECT NULL LIKE 'a*'", "NULL"},
            {"SELECT 'a*' LIKE 'a!*' ESCAPE '!', 'ab' LIKE 'a!*' ESCAPE '!'", "1,0"},
            {"SELECT 'a!b' LIKE 'a!*' ESCAPE NULL", "1"},
            {"SELECT 'a' LIKE 'a' ESCAPE '!!'", "ESCAPE expression must be a single character"},
            {"SELECT 12345 LIKE '*34*'", "1"},
            {"SELECT 'a\U00010410b' LIKE 'a??b'", "1"},                 // two code units
            {"SELECT CAST(x'61C3A980' AS TEXT) LIKE '*\u00E9*'", "0"},  // malformed UTF-8
            {"SELECT CAST(x'41FF' AS TEXT) LIKE 'a?'", "1"},
            {"SELECT '5 \u212A' LIKE '*k*'", "1"},  // a sign that folds to a Latin letter
            {"SELECT replace(hex(zeroblob(200)), '0', 'a') || 'B' LIKE '*b'", "1"},  // long
            {"SELECT t LIKE '*B*' FROM r", "1,0,1,0"},
            {"SELECT t LIKE p FROM r", "1,0,1,0"},
            {"SELECT t LIKE 'a!*' ESCAPE e FROM r", "0,0,0,1"},
        };
        for (const auto& c : cases) {
            QCOMPARE(Raw(QStringLiteral(":memory:"), rows + QString::fromUtf8(c.sql), true),
                     QString::fromUtf8(c.result));
        }
    }

    void jetVal() {
        QCOMPARE(JetVal(QStringLiteral(" 1 2 3")), 123.0);
        QCOMPARE(JetVal(QStringLiteral("12ab3")), 12.0);
        QCOMPARE(JetVal(QStringLiteral("-3.25x")), -3.25);
        QCOMPARE(JetVal(QStringLiteral("1e3")), 1000.0);
        QCOMPARE(JetVal(QStringLiteral("&H1F")), 31.0);
        QCOMPARE(JetVal(QStringLiteral("&O17")), 15.0);
        QCOMPARE(JetVal(QStringLiteral("abc")), 0.0);
    }

    // Booleans are stored as 0 and 1, dates as text; both read back as their types, a missing
    // date as a null one and an unset Boolean as its column's default.
    void booleansAndDates() {
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FALSE"));
        const QDateTime created(QDate(1899, 12, 30), QTime(9, 30, 5));
        rs->AddNew();
        rs->SetValue(QStringLiteral("ID"), 20);
        rs->SetValue(QStringLiteral("IsMemo"), false);
        rs->SetValue(QStringLiteral("DateCreated"), created);
        rs->Update();
        QCOMPARE(File("MDOCS", "SELECT IsMemo || '|' || DateCreated FROM DOCS WHERE ID=20"),
                 QStringLiteral("0|1899-12-30 09:30:05"));
        rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID>=12 ORDER BY ID"));
        QCOMPARE(rs->Value(QStringLiteral("ismemo")), QVariant(true));
        QVERIFY(rs->Value(QStringLiteral("DateCreated")).isNull());
        rs->MoveNext();
        QCOMPARE(rs->Value(QStringLiteral("DateCreated")).toDateTime(), created);
        QCOMPARE(rs->Value(QStringLiteral("IsMemo")), QVariant(false));
    }

    // Past the last row, and on an empty recordset, there is no current row.
    void noCurrentRow() {
        auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE ID=3"));
        rs->MoveNext();
        QVERIFY(rs->EOF() && !rs->BOF());
        QCOMPARE(ErrorOf([&] { rs->Value(QStringLiteral("ID")); }), err::JetNoCurrentRecord);
        QCOMPARE(ErrorOf([&] { rs->MoveNext(); }), err::JetNoCurrentRecord);
        rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE FALSE"));
        QVERIFY(rs->BOF() && rs->EOF());
        QCOMPARE(ErrorOf([&] { rs->MoveFirst(); }), err::JetNoCurrentRecord);
    }

    // No recordset, no row to edit, no pending change: nothing happens, where Update alone
    // would raise 3020; only a missing row is reported.
    void gNothingToDo() {
        test::ScopedScriptedUi ui;
        GAddNew(nullptr);
        GEdit(nullptr);
        QCOMPARE(GUpdate(0, nullptr), 0L);
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS ORDER BY ID"));
        rs->MoveNext();
        QCOMPARE(GUpdate(0, rs.get()), 0L);
        QCOMPARE(rs->AbsolutePosition(), 1);
        QVERIFY(ui->Messages().empty());
        GEdit(db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID=99")).get());
        QCOMPARE(ui->Texts(), QStringList{QStringLiteral("3021-0-GEdit-No current record.")});
    }

    // A second GAddNew keeps the pending row; a duplicate key leaves it pending, so the caller
    // can take the next number and save again. Only a development run is told of either.
    void gPendingAndDuplicate_data() {
        QTest::addColumn<bool>("development");
        QTest::addColumn<QStringList>("messages");
        QTest::newRow("ordinary run: silent") << false << QStringList{};
        QTest::newRow("development run: told")
            << true
            << QStringList{QStringLiteral("כבר בעריכה"),
                           QStringLiteral("Programr : 3022-0-GUpdate-") +
                               StandardDescription(err::JetDuplicate) +
                               QStringLiteral("\nSELECT * FROM DOCS WHERE FALSE\nmDb=0")};
    }

    void gPendingAndDuplicate() {
        QFETCH(bool, development);
        QFETCH(QStringList, messages);
        test::ScopedScriptedUi ui;
        SetIsDevelopmentRun(development);
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FALSE"));
        GAddNew(rs.get());
        rs->SetValue(QStringLiteral("ID"), 12);
        GAddNew(rs.get());
        QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 12);
        QCOMPARE(GUpdate(0, rs.get()), err::JetDuplicate);
        rs->SetValue(QStringLiteral("ID"), 13);
        QCOMPARE(GUpdate(0, rs.get()), 0L);
        QCOMPARE(File("MDOCS", "SELECT group_concat(ID) FROM DOCS"), QStringLiteral("7,12,13"));
        QCOMPARE(ui->Texts(), messages);
    }

    // An edited row is saved by its unique index and stays current; a second GEdit keeps the
    // change; a saved new row becomes the current one.
    void gEditAndAddNew() {
        test::ScopedScriptedUi ui;
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS ORDER BY ID"));
        QCOMPARE(rs->KeyColumn(), QStringLiteral("ID"));
        rs->MoveNext();
        GEdit(rs.get());
        rs->SetValue(QStringLiteral("Teur"), QStringLiteral("שונה"));
        GEdit(rs.get());
        QCOMPARE(GUpdate(0, rs.get()), 0L);
        QCOMPARE(rs->AbsolutePosition(), 1);
        GAddNew(rs.get());
        rs->SetValue(QStringLiteral("ID"), 20);
        QCOMPARE(GUpdate(0, rs.get()), 0L);
        QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 20);
        QCOMPARE(File("MDOCS", "SELECT group_concat(ID || ':' || Teur) FROM DOCS"),
                 QStringLiteral("7:,12:שונה,20:"));
        QVERIFY(ui->Messages().empty());
    }

    void gOtherFailureIsReported() {
        test::ScopedScriptedUi ui;
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID=7"));
        GEdit(rs.get());
        rs->SetValue(QStringLiteral("Teur"), Null());
        QCOMPARE(GUpdate(3, rs.get()), 3314L);
        QCOMPARE(ui->Texts().size(), 1);
        const QString text = ui->Texts().front();
        QVERIFY2(text.startsWith(QStringLiteral("3314-0-GUpdate-NOT NULL constraint failed")) &&
                     text.endsWith(QStringLiteral("\nSELECT * FROM DOCS WHERE ID=7\nmDb=3")),
                 qPrintable(text));
    }

  private:
    QString File(const QString& name, const QString& sql) const {
        return Raw(main_ + QLatin1Char('/') + name + QStringLiteral(".MDB"), sql);
    }
    std::unique_ptr<test::TestEnv> env_;
    QString main_;
};

QTEST_MAIN(TestFileDatabase)
#include "test_file_database.moc"

// File databases: opening, the suite's Jet texts on SQLite, Jet LIKE and Val, stored
// forms of Booleans and dates, engine errors, and recordsets of the file kind.
#include <sqlite3.h>

#include <QDateTime>
#include <QFile>
#include <QSqlDatabase>
#include <QtTest>
#include <thread>

#include "data/data_errors.h"
#include "data/database.h"
#include "data/jet_functions.h"
#include "data/recordset.h"
#include "recordset_checks.h"
#include "sqlite_files.h"
#include "test_env.h"
#include "util/errors.h"
#include "util/state.h"

using namespace zv;
using test::Column;
using test::ErrorOf;

class TestFileDatabase : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();

    void missingFileIsAnErrorAndNotCreated();
    void eachOpenHasItsOwnConnection();
    void folderWithHebrewAndUriCharacters();
    void jetTexts_data();
    void jetTexts();
    void deleteStar();
    void jetLike_data();
    void jetLike();
    void jetLikeFoldsEveryCodeUnit();
    void likeFunction_data();
    void likeFunction();
    void jetVal();
    void booleansAndDates();
    void writerWaitsForAShortLock();
    void lockedPastTimeoutIs3260();
    void navigation();
    void editingRules();
    void updateByUniqueIndexWithoutPrimaryKey();

  private:
    std::unique_ptr<test::TestEnv> env_;
    QString main_;
};

void TestFileDatabase::init() {
    env_ = std::make_unique<test::TestEnv>();
    main_ = env_->DataDir();
    SetMainPath(main_);
    test::MakeFileDb(
        main_, QStringLiteral("OFFICE"),
        {QStringLiteral("CREATE TABLE MTIK (ID INTEGER NOT NULL PRIMARY KEY, TEUR TEXT COLLATE "
                        "NOCASE, SHOW BOOLEAN DEFAULT 0)"),
         QStringLiteral("INSERT INTO MTIK VALUES (1,'גירושין',1),(2,'ירושה',0),(3,'Lease',1)"),
         QStringLiteral("CREATE TABLE CLIENT (NUM TEXT COLLATE NOCASE NOT NULL PRIMARY KEY, "
                        "F_NAME TEXT COLLATE NOCASE, L_NAME TEXT COLLATE NOCASE, TELEFON TEXT)"),
         QStringLiteral("INSERT INTO CLIENT VALUES ('100','משה','כהן','03-5551234'),"
                        "('101','Anna','SMITH','052'),('102','O''Neil','x',NULL)")});
    test::MakeFileDb(
        main_, QStringLiteral("MADAD"),
        {QStringLiteral("CREATE TABLE TRANS_CODE (TABLE_NUM TEXT, KOD_NUM_1 TEXT, Teur TEXT)"),
         QStringLiteral("INSERT INTO TRANS_CODE VALUES ('1080','10','c'),('1080','9','b'),"
                        "('1080',' 2','a'),('1081','1','other')")});
    test::MakeFileDb(
        main_, QStringLiteral("MDOCS"),
        {QStringLiteral("CREATE TABLE DOCS (ID INTEGER, IsMemo BOOLEAN DEFAULT 1, DateCreated "
                        "DATETIME, FULLNAME TEXT COLLATE NOCASE, Teur TEXT NOT NULL DEFAULT '')"),
         QStringLiteral("CREATE UNIQUE INDEX DOCS_ID ON DOCS (ID)"),
         QStringLiteral("INSERT INTO DOCS (ID, FULLNAME) VALUES (7,'\\DOCS\\a.doc'),"
                        "(12,'\\DOCS\\b.doc')")});
    test::MakeFileDb(
        main_, QStringLiteral("BM"),
        {QStringLiteral("CREATE TABLE UMEMO (MemoNum INTEGER PRIMARY KEY, ID INTEGER, MTYPE "
                        "INTEGER, USER97 TEXT, METAPEL TEXT)"),
         QStringLiteral("INSERT INTO UMEMO (ID, MTYPE) VALUES (5,31),(5,32),(5,33),(6,31)")});
}

void TestFileDatabase::cleanup() {
    env_.reset();
}

void TestFileDatabase::missingFileIsAnErrorAndNotCreated() {
    QFile::remove(main_ + QStringLiteral("/OFFICE.MDB"));
    QCOMPARE(ErrorOf([] { Database::OpenFile(QStringLiteral("\\OFFICE.MDB")); }),
             err::JetCannotOpen);
    QVERIFY(!QFile::exists(main_ + QStringLiteral("/OFFICE.MDB")));
    QCOMPARE(ErrorOf([] { Database::Open(QStringLiteral("ZORVA"), false); }), err::JetCannotOpen);
}

// Each open is a connection of its own; a recordset keeps its rows after its database closes.
void TestFileDatabase::eachOpenHasItsOwnConnection() {
    const QStringList before = QSqlDatabase::connectionNames();
    auto a = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto b = Database::Open(QStringLiteral("OFFICE"), false);
    QVERIFY(a->ConnectionName() != b->ConnectionName());
    auto rs = a->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK]"));
    GClose(a);
    QCOMPARE(rs->RecordCount(), 3);
    GClose(rs);
    GClose(b);
    QCOMPARE(QSqlDatabase::connectionNames(), before);
}

void TestFileDatabase::folderWithHebrewAndUriCharacters() {
    const QString folder = main_ + QStringLiteral("/תיק משותף #1?x=%20");
    test::MakeFileDb(folder, QStringLiteral("PUB"), {QStringLiteral("CREATE TABLE USERS (A)")});
    SetMainPath(folder);
    auto db = Database::OpenFile(QStringLiteral("\\PUB.MDB"));
    QCOMPARE(db->OpenRecordset(QStringLiteral("SELECT * FROM USERS"))->FieldCount(), 1);
}

// Expected: the field's values, joined by ",".
void TestFileDatabase::jetTexts_data() {
    QTest::addColumn<QString>("db");
    QTest::addColumn<QString>("sql");
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("expected");
    const auto row = [](const char* name, const char* db, const char* sql, const char* field,
                        const char* expected) {
        QTest::newRow(name) << QString::fromLatin1(db) << QString::fromUtf8(sql)
                            << QString::fromLatin1(field) << QString::fromUtf8(expected);
    };
    row("WHERE FALSE", "BM", "SELECT * FROM UMEMO WHERE FALSE", "ID", "");
    row("[SHOW]=True", "OFFICE", "SELECT * FROM [MTIK] WHERE [SHOW]=True ORDER BY [ID]", "TEUR",
        "גירושין,Lease");
    row("double-quoted text and Val order", "MADAD",
        "SELECT * FROM [TRANS_CODE] WHERE [TABLE_NUM]=\"1080\" ORDER BY Val([KOD_NUM_1]);", "Teur",
        "a,b,c");
    row("max(ID)", "MDOCS", "SELECT max(ID) FROM [DOCS]", "max(ID)", "12");
    row("client by number", "OFFICE", "SELECT * FROM [CLIENT] WHERE [NUM]='101'", "F_NAME", "Anna");
    row("client search", "OFFICE",
        "SELECT * FROM [CLIENT] WHERE [F_NAME] LIKE '*smi*' OR [L_NAME] LIKE '*smi*' OR "
        "[TELEFON] LIKE '*smi*' OR [NUM] LIKE '*smi*' ORDER BY NUM",
        "NUM", "101");
    row("client search Hebrew", "OFFICE",
        "SELECT * FROM [CLIENT] WHERE [F_NAME] LIKE '*כה*' OR [L_NAME] LIKE '*כה*' ORDER BY NUM",
        "NUM", "100");
    row("DOCS by path, no case", "MDOCS", "SELECT * FROM DOCS WHERE [FullName]='\\docs\\B.DOC'",
        "ID", "12");
}

void TestFileDatabase::jetTexts() {
    QFETCH(QString, db);
    QFETCH(QString, sql);
    QFETCH(QString, field);
    QFETCH(QString, expected);
    auto d = Database::Open(db, false);
    auto rs = d->OpenRecordset(sql, dbOpenSnapshot);
    QVERIFY(rs->HasField(field));
    QCOMPARE(Column(*rs, field).join(QLatin1Char(',')), expected);
}

void TestFileDatabase::deleteStar() {
    auto db = Database::OpenFile(QStringLiteral("\\BM.MDB"));
    db->Execute(QStringLiteral("DELETE * FROM UMEMO WHERE ([MTYPE]=31 OR [MTYPE]=32) AND [ID]=5"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM UMEMO ORDER BY MemoNum"));
    QCOMPARE(Column(*rs, QStringLiteral("MTYPE")), (QStringList{"33", "31"}));
    QCOMPARE(db->EngineSql(QStringLiteral("delete  *  from X")), QStringLiteral("delete from X"));
}

void TestFileDatabase::jetLike_data() {
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("match");
    const auto row = [](const char* name, const char* pattern, const char* text, bool match) {
        QTest::newRow(name) << QString::fromUtf8(pattern) << QString::fromUtf8(text) << match;
    };
    row("any run", "*ab*", "xxABxx", true);
    row("percent is literal", "%ab%", "xabx", false);
    row("percent matches itself", "1%", "1%", true);
    row("one char", "a?c", "abc", true);
    row("digit", "#-#", "5-7", true);
    row("class", "[abc]x", "Bx", true);
    row("range", "[a-f]1", "e1", true);
    row("negated class", "[!a-f]1", "g1", true);
    row("bracketed star is literal", "a[*]", "a*", true);
    row("underscore is literal", "a_c", "abc", false);
    row("whole text", "abc", "abcd", false);
    row("empty pattern", "", "", true);
    row("empty pattern, some text", "", "a", false);
    row("star, empty text", "*", "", true);
    row("stars in a row", "a**b", "ab", true);
    row("letter outside the basic plane", "\U00010410*", "\U00010410x", true);
    row("whole text, mixed case", "ÀbÇ", "àBç", true);
    row("prefix, mixed case", "o'NE*", "O'Neil", true);
    row("prefix longer than text", "abcd*", "abc", false);
    row("suffix, mixed case", "*NEIL", "O'Neil", true);
    row("suffix longer than text", "*abc", "bc", false);
    row("contains after a false start", "*aab*", "aaab", true);
    row("contains longer than text", "*abc*", "ab", false);
    row("Hebrew final letter is its own", "*כהנ*", "כהן", false);
    row("Hebrew and Latin", "*COHEN כהן*", "Cohen כהן 2", true);
    row("sign that folds to a Latin letter", "*k*", "5 \u212A", true);
    row("class inside stars", "*[ab]*", "xBx", true);
    row("unclosed bracket is literal", "*[a*", "x[Ab", true);
    row("empty class matches nothing", "*[]*", "ab", false);
}

void TestFileDatabase::jetLike() {
    QFETCH(QString, pattern);
    QFETCH(QString, text);
    QFETCH(bool, match);
    QCOMPARE(JetLike(pattern, text), match);
    // The same through the engine, as the LIKE operator.
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    QString p = pattern;
    QString t = text;
    auto rs = db->OpenRecordset(QStringLiteral("SELECT ('%1' LIKE '%2') AS m")
                                    .arg(t.replace("'", "''"), p.replace("'", "''")));
    QCOMPARE(rs->Value(QStringLiteral("m")).toInt(), match ? 1 : 0);
}

void TestFileDatabase::jetLikeFoldsEveryCodeUnit() {
    for (char32_t c = 0; c <= 0xFFFF; ++c) {
        const QChar original(static_cast<char16_t>(c));
        const QChar folded = original.toCaseFolded();
        const QString escaped = QStringLiteral("!") + original;
        QVERIFY2(JetLike(escaped, QString(folded), u'!'), qPrintable(QString::number(c, 16)));
        QVERIFY2(JetLike(QStringLiteral("!") + folded, QString(original), u'!'),
                 qPrintable(QString::number(c, 16)));
    }
}

void TestFileDatabase::likeFunction_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<QString>("result");
    const auto row = [](const char* name, const char* sql, const char* result) {
        QTest::newRow(name) << QString::fromUtf8(sql) << QString::fromUtf8(result);
    };
    row("NULL text", "SELECT NULL LIKE 'a*'", "NULL");
    row("NULL pattern", "SELECT 'a' LIKE NULL", "NULL");
    row("escape", "SELECT 'a*' LIKE 'a!*' ESCAPE '!', 'ab' LIKE 'a!*' ESCAPE '!'", "1,0");
    row("NULL escape is none", "SELECT 'a!b' LIKE 'a!*' ESCAPE NULL", "1");
    row("escape of two characters", "SELECT 'a' LIKE 'a' ESCAPE '!!'",
        "ESCAPE expression must be a single character");
    row("number as text", "SELECT 12345 LIKE '*34*'", "1");
    row("letter outside the basic plane is two characters", "SELECT 'a\U00010410b' LIKE 'a??b'",
        "1");
    row("malformed text as SQLite reads it", "SELECT CAST(x'61C3A980' AS TEXT) LIKE '*\u00E9*'",
        "0");
    row("byte that is no UTF-8", "SELECT CAST(x'41FF' AS TEXT) LIKE 'a?'", "1");
    row("text longer than a name", "SELECT replace(hex(zeroblob(200)), '0', 'a') || 'B' LIKE '*b'",
        "1");
    row("same pattern on every row", "SELECT t LIKE '*B*' FROM r", "1,0,1,0");
    row("pattern of each row", "SELECT t LIKE p FROM r", "1,0,1,0");
    row("escape of each row", "SELECT t LIKE 'a!*' ESCAPE e FROM r", "0,0,0,1");
}

// The registered function straight on a connection: NULLs, the escape, and a pattern
// kept from row to row only while it stays the same.
void TestFileDatabase::likeFunction() {
    QFETCH(QString, sql);
    QFETCH(QString, result);
    sqlite3* db = nullptr;
    QCOMPARE(sqlite3_open(":memory:", &db), SQLITE_OK);
    const std::unique_ptr<sqlite3, int (*)(sqlite3*)> closer(db, sqlite3_close);
    QCOMPARE(RegisterJetFunctions(db), SQLITE_OK);
    QCOMPARE(sqlite3_exec(db,
                          "CREATE TABLE r (t, p, e); INSERT INTO r VALUES ('abc', 'a*', '!'), "
                          "('a*', '*x*', '#'), ('ABC', '*b*', '!'), ('a!x', '', '#')",
                          nullptr, nullptr, nullptr),
             SQLITE_OK);
    sqlite3_stmt* stmt = nullptr;
    QCOMPARE(sqlite3_prepare_v2(db, sql.toUtf8().constData(), -1, &stmt, nullptr), SQLITE_OK);
    QStringList values;
    int rc = SQLITE_ROW;
    while ((rc = sqlite3_step(stmt)) == SQLITE_ROW) {
        for (int i = 0; i < sqlite3_column_count(stmt); ++i) {
            values << (sqlite3_column_type(stmt, i) == SQLITE_NULL
                           ? QStringLiteral("NULL")
                           : QString::number(sqlite3_column_int(stmt, i)));
        }
    }
    if (rc != SQLITE_DONE) {
        values << QString::fromUtf8(sqlite3_errmsg(db));
    }
    sqlite3_finalize(stmt);
    QCOMPARE(values.join(QLatin1Char(',')), result);
}

void TestFileDatabase::jetVal() {
    QCOMPARE(JetVal(QStringLiteral(" 1 2 3")), 123.0);
    QCOMPARE(JetVal(QStringLiteral("12ab3")), 12.0);
    QCOMPARE(JetVal(QStringLiteral("-3.25x")), -3.25);
    QCOMPARE(JetVal(QStringLiteral("1e3")), 1000.0);
    QCOMPARE(JetVal(QStringLiteral("&H1F")), 31.0);
    QCOMPARE(JetVal(QStringLiteral("&O17")), 15.0);
    QCOMPARE(JetVal(QString()), 0.0);
    QCOMPARE(JetVal(QStringLiteral("abc")), 0.0);
}

void TestFileDatabase::booleansAndDates() {
    auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FALSE"));
    const QDateTime created(QDate(1899, 12, 30), QTime(9, 30, 5));
    rs->AddNew();
    rs->SetValue(QStringLiteral("ID"), 20);
    rs->SetValue(QStringLiteral("IsMemo"), false);
    rs->SetValue(QStringLiteral("DateCreated"), created);
    rs->Update();
    QCOMPARE(test::QueryFileDb(main_, "MDOCS",
                               "SELECT IsMemo || '|' || DateCreated FROM DOCS WHERE ID=20"),
             QStringLiteral("0|1899-12-30 09:30:05"));
    rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID>=12 ORDER BY ID"));
    QCOMPARE(rs->Value(QStringLiteral("ismemo")), QVariant(true));  // the column default
    QVERIFY(rs->Value(QStringLiteral("DateCreated")).isNull());
    rs->MoveNext();
    QCOMPARE(rs->Value(QStringLiteral("DateCreated")).toDateTime(), created);
    QCOMPARE(rs->Value(QStringLiteral("IsMemo")), QVariant(false));
}

void TestFileDatabase::writerWaitsForAShortLock() {
    sqlite3* other = nullptr;
    QCOMPARE(sqlite3_open((main_ + "/MDOCS.MDB").toUtf8().constData(), &other), SQLITE_OK);
    QCOMPARE(sqlite3_exec(other, "BEGIN EXCLUSIVE", nullptr, nullptr, nullptr), SQLITE_OK);
    // Another writer holds the file for a moment, as another filing process would.
    std::thread holder([other] {
        std::this_thread::sleep_for(std::chrono::milliseconds(400));
        sqlite3_exec(other, "UPDATE DOCS SET Teur='first' WHERE ID=12; COMMIT", nullptr, nullptr,
                     nullptr);
    });
    const long error = ErrorOf([] {
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        db->Execute(QStringLiteral("UPDATE DOCS SET Teur='second' WHERE ID=7"));
    });
    holder.join();
    sqlite3_close(other);
    QCOMPARE(error, 0L);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT group_concat(Teur) FROM DOCS"),
             QStringLiteral("second,first"));
}

void TestFileDatabase::lockedPastTimeoutIs3260() {
    sqlite3* other = nullptr;
    QCOMPARE(sqlite3_open((main_ + "/MDOCS.MDB").toUtf8().constData(), &other), SQLITE_OK);
    QCOMPARE(sqlite3_exec(other, "BEGIN EXCLUSIVE", nullptr, nullptr, nullptr), SQLITE_OK);
    QElapsedTimer timer;
    timer.start();
    const long error = ErrorOf([] {
        auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
        db->Execute(QStringLiteral("UPDATE DOCS SET Teur='x' WHERE ID=7"));
    });
    sqlite3_exec(other, "ROLLBACK", nullptr, nullptr, nullptr);
    sqlite3_close(other);
    QCOMPARE(error, err::JetLocked);
    QVERIFY(timer.elapsed() >= kFileBusyTimeoutMs - 100);
}

void TestFileDatabase::navigation() {
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] ORDER BY ID"));
    const QVariant first = rs->Bookmark();
    rs->MoveLast();
    auto clone = rs->Clone();
    QCOMPARE(clone->AbsolutePosition(), 0);
    rs->MoveNext();
    QVERIFY(rs->EOF());
    QCOMPARE(rs->AbsolutePosition(), -1);
    QCOMPARE(ErrorOf([&] { rs->Value(QStringLiteral("ID")); }), err::JetNoCurrentRecord);
    QCOMPARE(ErrorOf([&] { rs->MoveNext(); }), err::JetNoCurrentRecord);
    rs->SetBookmark(first);
    QCOMPARE(rs->Value(QStringLiteral("id")).toInt(), 1);
    rs->MovePrevious();
    QVERIFY(rs->BOF());
    QCOMPARE(ErrorOf([&] { rs->Value(QStringLiteral("NoSuchField")); }), err::JetNoField);
    auto empty = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE FALSE"));
    QVERIFY(empty->BOF() && empty->EOF());
    QCOMPARE(empty->FieldCount(), 3);
    QCOMPARE(ErrorOf([&] { empty->MoveFirst(); }), err::JetNoCurrentRecord);
}

void TestFileDatabase::editingRules() {
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] ORDER BY ID"));
    QCOMPARE(ErrorOf([&] { rs->Update(); }), err::JetUpdateWithoutEdit);
    rs->MoveNext();
    rs->Edit();
    rs->SetValue(QStringLiteral("teur"), QStringLiteral("צוואה"));
    QCOMPARE(rs->Value(QStringLiteral("TEUR")).toString(), QStringLiteral("צוואה"));
    rs->Update();
    QCOMPARE(rs->LastModified(), rs->Bookmark());
    QCOMPARE(test::QueryFileDb(main_, "OFFICE", "SELECT TEUR FROM MTIK WHERE ID=2"),
             QStringLiteral("צוואה"));
    // CancelUpdate forgets the pending values.
    rs->Edit();
    rs->SetValue(QStringLiteral("TEUR"), QStringLiteral("lost"));
    rs->CancelUpdate();
    QCOMPARE(rs->Value(QStringLiteral("TEUR")).toString(), QStringLiteral("צוואה"));
    // A new row gets its key from the engine; the position stays where it was.
    rs->AddNew();
    rs->SetValue(QStringLiteral("TEUR"), QStringLiteral("new"));
    rs->Update();
    QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 2);
    rs->SetBookmark(rs->LastModified());
    QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 4);
    QCOMPARE(rs->Value(QStringLiteral("SHOW")), QVariant(false));
    QCOMPARE(rs->RecordCount(), 4);
    // Snapshots and aggregates cannot be edited.
    auto snapshot = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK]"), dbOpenSnapshot);
    QCOMPARE(ErrorOf([&] { snapshot->Edit(); }), err::JetReadOnly);
    QCOMPARE(ErrorOf([&] { snapshot->AddNew(); }), err::JetReadOnly);
    auto max = db->OpenRecordset(QStringLiteral("SELECT max(ID) FROM [MTIK]"));
    QCOMPARE(ErrorOf([&] { max->Edit(); }), err::JetReadOnly);
}

void TestFileDatabase::updateByUniqueIndexWithoutPrimaryKey() {
    auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    auto rs =
        db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE [FullName]='\\DOCS\\b.doc'"));
    QCOMPARE(rs->KeyColumn(), QStringLiteral("ID"));
    rs->Edit();
    rs->SetValue(QStringLiteral("Teur"), QStringLiteral("שונה"));
    rs->Update();
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT group_concat(ID || ':' || Teur) FROM DOCS"),
             QStringLiteral("7:,12:שונה"));
}

QTEST_MAIN(TestFileDatabase)
#include "test_file_database.moc"

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
#include "sqlite_files.h"
#include "test_env.h"
#include "util/errors.h"
#include "util/state.h"

using namespace zv;

namespace {

long ErrorOf(const std::function<void()>& f) {
    try {
        f();
    } catch (const VbError& e) {
        return e.Number();
    }
    return 0;
}

QStringList Column(Recordset& rs, const QString& field) {
    QStringList values;
    if (rs.RecordCount() == 0) {
        return values;
    }
    for (rs.MoveFirst(); !rs.EOF(); rs.MoveNext()) {
        values << rs.Value(field).toString();
    }
    return values;
}

}  // namespace

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
    void jetVal_data();
    void jetVal();
    void booleansAndDates();
    void duplicateIs3022();
    void writerWaitsForAShortLock();
    void lockedPastTimeoutIs3260();
    void navigation();
    void editingRules();
    void snapshotIsReadOnly();
    void updateByUniqueIndexWithoutPrimaryKey();
    void cloneHasItsOwnPosition();

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
    test::MakeFileDb(
        main_, QStringLiteral("PUB"),
        {QStringLiteral("CREATE TABLE USERS (USERCODE TEXT, ST_NUMBER TEXT, NAME TEXT)"),
         QStringLiteral("INSERT INTO USERS VALUES ('L1','12','c'),('L1','3','a'),('L1','',"
                        "'z'),('L2','1','x')")});
    test::MakeFileDb(main_, QStringLiteral("MAIN"),
                     {QStringLiteral("CREATE TABLE MSql (ClientID TEXT, IsOffice BOOLEAN)"),
                      QStringLiteral("INSERT INTO MSql VALUES ('23', 1)")});
}

void TestFileDatabase::cleanup() {
    env_.reset();
}

void TestFileDatabase::missingFileIsAnErrorAndNotCreated() {
    QFile::remove(main_ + QStringLiteral("/OFFICE.MDB"));
    try {
        Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
        QFAIL("opened a missing file");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), err::JetCannotOpen);
        QVERIFY2(e.Description().contains(QStringLiteral("OFFICE.MDB")),
                 qPrintable(e.Description()));
    }
    QVERIFY(!QFile::exists(main_ + QStringLiteral("/OFFICE.MDB")));
    QCOMPARE(ErrorOf([] { Database::Open(QStringLiteral("ZORVA"), false); }), err::JetCannotOpen);
}

void TestFileDatabase::eachOpenHasItsOwnConnection() {
    const QStringList before = QSqlDatabase::connectionNames();
    auto a = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto b = Database::Open(QStringLiteral("OFFICE"), false);
    QVERIFY(a->ConnectionName() != b->ConnectionName());
    QCOMPARE(a->Kind(), DbKind::File);
    auto rs = a->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK]"));
    GClose(a);
    // The recordset keeps working after its database is closed; its rows are its own.
    QCOMPARE(rs->RecordCount(), 3);
    QCOMPARE(b->OpenRecordset(QStringLiteral("SELECT * FROM CLIENT"))->RecordCount(), 3);
    GClose(rs);
    GClose(b);
    GClose(b);
    QVERIFY(!b);
    QCOMPARE(QSqlDatabase::connectionNames(), before);
}

void TestFileDatabase::folderWithHebrewAndUriCharacters() {
    const QString folder = main_ + QStringLiteral("/תיק משותף #1?x=%20");
    test::MakeFileDb(folder, QStringLiteral("PUB"), {QStringLiteral("CREATE TABLE USERS (A)")});
    SetMainPath(folder);
    auto db = Database::OpenFile(QStringLiteral("\\PUB.MDB"));
    QCOMPARE(db->OpenRecordset(QStringLiteral("SELECT * FROM USERS"))->FieldCount(), 1);
}

void TestFileDatabase::jetTexts_data() {
    QTest::addColumn<QString>("db");
    QTest::addColumn<QString>("sql");
    QTest::addColumn<QString>("field");
    QTest::addColumn<QStringList>("expected");
    QTest::newRow("WHERE FALSE") << "BM"
                                 << "SELECT * FROM UMEMO WHERE FALSE"
                                 << "ID" << QStringList{};
    QTest::newRow("[SHOW]=True") << "OFFICE"
                                 << "SELECT * FROM [MTIK] WHERE [SHOW]=True ORDER BY [ID]"
                                 << "TEUR" << QStringList{"גירושין", "Lease"};
    QTest::newRow("double-quoted text and Val order")
        << "MADAD"
        << "SELECT * FROM [TRANS_CODE] WHERE [TABLE_NUM]=\"1080\" ORDER BY Val([KOD_NUM_1]);"
        << "Teur" << QStringList{"a", "b", "c"};
    QTest::newRow("max(ID)") << "MDOCS"
                             << "SELECT max(ID) FROM [DOCS]"
                             << "max(ID)" << QStringList{"12"};
    QTest::newRow("client by number") << "OFFICE"
                                      << "SELECT * FROM [CLIENT] WHERE [NUM]='101'"
                                      << "F_NAME" << QStringList{"Anna"};
    QTest::newRow("client search")
        << "OFFICE"
        << "SELECT * FROM [CLIENT] WHERE [F_NAME] LIKE '*smi*' OR [L_NAME] LIKE '*smi*' OR "
           "[TELEFON] LIKE '*smi*' OR [NUM] LIKE '*smi*' ORDER BY NUM"
        << "NUM" << QStringList{"101"};
    QTest::newRow("client search Hebrew")
        << "OFFICE"
        << "SELECT * FROM [CLIENT] WHERE [F_NAME] LIKE '*כה*' OR [L_NAME] LIKE '*כה*' ORDER BY NUM"
        << "NUM" << QStringList{"100"};
    QTest::newRow("users by Val") << "PUB"
                                  << "SELECT * FROM [USERS] WHERE [USERCODE] ='L1' ORDER BY "
                                     "VAL([ST_NUMBER])"
                                  << "NAME" << QStringList{"z", "a", "c"};
    QTest::newRow("MSql row") << "MAIN"
                              << "SELECT * FROM MSql Where [ClientID]='23'"
                              << "ClientID" << QStringList{"23"};
    QTest::newRow("DOCS by path, no case") << "MDOCS"
                                           << "SELECT * FROM DOCS WHERE [FullName]='\\docs\\B.DOC'"
                                           << "ID" << QStringList{"12"};
}

void TestFileDatabase::jetTexts() {
    QFETCH(QString, db);
    QFETCH(QString, sql);
    QFETCH(QString, field);
    QFETCH(QStringList, expected);
    auto d = Database::Open(db, false);
    auto rs = d->OpenRecordset(sql, dbOpenSnapshot);
    QVERIFY(rs->HasField(field));
    QCOMPARE(Column(*rs, field), expected);
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
    QTest::newRow("any run") << "*ab*"
                             << "xxABxx" << true;
    QTest::newRow("any run none") << "*ab*"
                                  << "xxaxbx" << false;
    QTest::newRow("percent is literal") << "%ab%"
                                        << "xabx" << false;
    QTest::newRow("percent matches itself") << "1%"
                                            << "1%" << true;
    QTest::newRow("one char") << "a?c"
                              << "abc" << true;
    QTest::newRow("one char too short") << "a?c"
                                        << "ac" << false;
    QTest::newRow("digit") << "#-#"
                           << "5-7" << true;
    QTest::newRow("digit rejects letter") << "#"
                                          << "x" << false;
    QTest::newRow("class") << "[abc]x"
                           << "Bx" << true;
    QTest::newRow("range") << "[a-f]1"
                           << "e1" << true;
    QTest::newRow("negated class") << "[!a-f]1"
                                   << "g1" << true;
    QTest::newRow("negated class rejects") << "[!a-f]1"
                                           << "c1" << false;
    QTest::newRow("bracketed star is literal") << "a[*]"
                                               << "a*" << true;
    QTest::newRow("bracketed star rejects") << "a[*]"
                                            << "ab" << false;
    QTest::newRow("underscore is literal") << "a_c"
                                           << "abc" << false;
    QTest::newRow("Hebrew") << "*שה*"
                            << "משה" << true;
    QTest::newRow("whole text") << "abc"
                                << "abcd" << false;
    QTest::newRow("stars everywhere") << "*a*b*c*"
                                      << "xaxbxcx" << true;
    QTest::newRow("empty pattern") << ""
                                   << "" << true;
    QTest::newRow("letter outside the basic plane") << "\U00010410*"
                                                    << "\U00010410x" << true;
    QTest::newRow("empty pattern, some text") << ""
                                              << "a" << false;
    QTest::newRow("star, empty text") << "*"
                                      << "" << true;
    QTest::newRow("stars in a row") << "a**b"
                                    << "ab" << true;
    QTest::newRow("whole text, mixed case") << "ÀbÇ"
                                            << "àBç" << true;
    QTest::newRow("prefix, mixed case") << "o'NE*"
                                        << "O'Neil" << true;
    QTest::newRow("prefix longer than text") << "abcd*"
                                             << "abc" << false;
    QTest::newRow("suffix, mixed case") << "*NEIL"
                                        << "O'Neil" << true;
    QTest::newRow("suffix longer than text") << "*abc"
                                             << "bc" << false;
    QTest::newRow("contains at the end") << "*eIL*"
                                         << "O'Neil" << true;
    QTest::newRow("contains after a false start") << "*aab*"
                                                  << "aaab" << true;
    QTest::newRow("contains longer than text") << "*abc*"
                                               << "ab" << false;
    QTest::newRow("Hebrew prefix") << "כה*"
                                   << "כהן" << true;
    QTest::newRow("Hebrew final letter is its own") << "*כהנ*"
                                                    << "כהן" << false;
    QTest::newRow("Hebrew and Latin") << "*COHEN כהן*"
                                      << "Cohen כהן 2" << true;
    QTest::newRow("sign that folds to a Latin letter") << "*k*"
                                                       << "5 \u212A" << true;
    QTest::newRow("class inside stars") << "*[ab]*"
                                        << "xBx" << true;
    QTest::newRow("unclosed bracket is literal") << "*[a*"
                                                 << "x[Ab" << true;
    QTest::newRow("empty class matches nothing") << "*[]*"
                                                 << "ab" << false;
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
    QTest::newRow("NULL text") << "SELECT NULL LIKE 'a*'"
                               << "NULL";
    QTest::newRow("NULL pattern") << "SELECT 'a' LIKE NULL"
                                  << "NULL";
    QTest::newRow("escape") << "SELECT 'a*' LIKE 'a!*' ESCAPE '!', 'ab' LIKE 'a!*' ESCAPE '!'"
                            << "1,0";
    QTest::newRow("NULL escape is none") << "SELECT 'a!b' LIKE 'a!*' ESCAPE NULL"
                                         << "1";
    QTest::newRow("escape of two characters") << "SELECT 'a' LIKE 'a' ESCAPE '!!'"
                                              << "ESCAPE expression must be a single character";
    QTest::newRow("number as text") << "SELECT 12345 LIKE '*34*'"
                                    << "1";
    QTest::newRow("letter outside the basic plane is two characters")
        << "SELECT 'a\U00010410b' LIKE 'a??b'"
        << "1";
    QTest::newRow("malformed text as SQLite reads it")
        << "SELECT CAST(x'61C3A980' AS TEXT) LIKE '*\u00E9*'"
        << "0";
    QTest::newRow("byte that is no UTF-8") << "SELECT CAST(x'41FF' AS TEXT) LIKE 'a?'"
                                           << "1";
    QTest::newRow("text longer than a name")
        << "SELECT replace(hex(zeroblob(200)), '0', 'a') || 'B' LIKE '*b'"
        << "1";
    QTest::newRow("same pattern on every row") << "SELECT t LIKE '*B*' FROM r"
                                               << "1,0,1,0";
    QTest::newRow("pattern of each row") << "SELECT t LIKE p FROM r"
                                         << "1,0,1,0";
    QTest::newRow("escape of each row") << "SELECT t LIKE 'a!*' ESCAPE e FROM r"
                                        << "0,0,0,1";
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

void TestFileDatabase::jetVal_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<double>("value");
    QTest::newRow("digits") << "12" << 12.0;
    QTest::newRow("blanks inside") << " 1 2 3" << 123.0;
    QTest::newRow("stops at letter") << "12ab3" << 12.0;
    QTest::newRow("decimal") << "-3.25x" << -3.25;
    QTest::newRow("exponent") << "1e3" << 1000.0;
    QTest::newRow("hex") << "&H1F" << 31.0;
    QTest::newRow("octal") << "&O17" << 15.0;
    QTest::newRow("empty") << "" << 0.0;
    QTest::newRow("letters") << "abc" << 0.0;
}

void TestFileDatabase::jetVal() {
    QFETCH(QString, text);
    QFETCH(double, value);
    QCOMPARE(JetVal(text), value);
}

void TestFileDatabase::booleansAndDates() {
    auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FALSE"));
    const QDateTime created(QDate(2026, 3, 1), QTime(9, 30, 5));
    rs->AddNew();
    rs->SetValue(QStringLiteral("ID"), 20);
    rs->SetValue(QStringLiteral("IsMemo"), false);
    rs->SetValue(QStringLiteral("DateCreated"), created);
    rs->Update();
    rs->AddNew();
    rs->SetValue(QStringLiteral("ID"), 21);
    rs->SetValue(QStringLiteral("IsMemo"), true);
    rs->SetValue(QStringLiteral("DateCreated"), QDateTime(QDate(1899, 12, 30), QTime(0, 0)));
    rs->Update();
    GClose(rs);
    GClose(db);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS",
                               "SELECT IsMemo || '|' || DateCreated FROM DOCS WHERE ID=20"),
             QStringLiteral("0|2026-03-01 09:30:05"));
    QCOMPARE(test::QueryFileDb(main_, "MDOCS",
                               "SELECT IsMemo || '|' || DateCreated FROM DOCS WHERE ID=21"),
             QStringLiteral("1|1899-12-30 00:00:00"));
    db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID>=20 ORDER BY ID"));
    QCOMPARE(rs->Value(QStringLiteral("DateCreated")).toDateTime(), created);
    QCOMPARE(rs->Value(QStringLiteral("IsMemo")), QVariant(false));
    rs->MoveNext();
    QCOMPARE(rs->Value(QStringLiteral("IsMemo")), QVariant(true));
    rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID=7"));
    QVERIFY(rs->Value(QStringLiteral("DateCreated")).isNull());
    QCOMPARE(rs->Value(QStringLiteral("ismemo")), QVariant(true));  // the column default
}

void TestFileDatabase::duplicateIs3022() {
    auto db = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FALSE"));
    rs->AddNew();
    rs->SetValue(QStringLiteral("ID"), 12);
    QCOMPARE(ErrorOf([&] { rs->Update(); }), err::JetDuplicate);
    // The failed row stays pending, so a caller can change the key and save again.
    QCOMPARE(rs->EditMode(), int(dbEditAdd));
    rs->SetValue(QStringLiteral("ID"), 13);
    rs->Update();
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT count(*) FROM DOCS"), QStringLiteral("3"));
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
    QCOMPARE(rs->RecordCount(), 3);
    QCOMPARE(rs->AbsolutePosition(), 0);
    QVERIFY(!rs->BOF());
    QCOMPARE(rs->Value(QStringLiteral("id")).toInt(), 1);
    const QVariant first = rs->Bookmark();
    rs->MoveLast();
    QCOMPARE(rs->AbsolutePosition(), 2);
    rs->MoveNext();
    QVERIFY(rs->EOF());
    QCOMPARE(rs->AbsolutePosition(), -1);
    QCOMPARE(ErrorOf([&] { rs->Value(QStringLiteral("ID")); }), err::JetNoCurrentRecord);
    QCOMPARE(ErrorOf([&] { rs->MoveNext(); }), err::JetNoCurrentRecord);
    rs->SetBookmark(first);
    QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 1);
    rs->MovePrevious();
    QVERIFY(rs->BOF());
    QCOMPARE(ErrorOf([&] { rs->Value(QStringLiteral("NoSuchField")); }), err::JetNoField);
    QCOMPARE(rs->Name(), QStringLiteral("SELECT * FROM [MTIK] ORDER BY ID"));

    auto empty = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] WHERE FALSE"));
    QVERIFY(empty->BOF() && empty->EOF());
    QCOMPARE(empty->RecordCount(), 0);
    QCOMPARE(empty->FieldCount(), 3);
    QCOMPARE(ErrorOf([&] { empty->MoveFirst(); }), err::JetNoCurrentRecord);
}

void TestFileDatabase::editingRules() {
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] ORDER BY ID"));
    QCOMPARE(ErrorOf([&] { rs->SetValue(QStringLiteral("TEUR"), "x"); }),
             err::JetUpdateWithoutEdit);
    QCOMPARE(ErrorOf([&] { rs->Update(); }), err::JetUpdateWithoutEdit);
    rs->MoveNext();
    rs->Edit();
    QCOMPARE(rs->EditMode(), int(dbEditInProgress));
    rs->SetValue(QStringLiteral("teur"), QStringLiteral("צוואה"));
    QCOMPARE(rs->Value(QStringLiteral("TEUR")).toString(), QStringLiteral("צוואה"));
    rs->Update();
    QCOMPARE(rs->EditMode(), int(dbEditNone));
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
}

void TestFileDatabase::snapshotIsReadOnly() {
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK]"), dbOpenSnapshot);
    QCOMPARE(ErrorOf([&] { rs->Edit(); }), err::JetReadOnly);
    QCOMPARE(ErrorOf([&] { rs->AddNew(); }), err::JetReadOnly);
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

void TestFileDatabase::cloneHasItsOwnPosition() {
    auto db = Database::OpenFile(QStringLiteral("\\OFFICE.MDB"));
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM [MTIK] ORDER BY ID"));
    rs->MoveLast();
    auto clone = rs->Clone();
    QCOMPARE(clone->AbsolutePosition(), 0);
    clone->SetBookmark(rs->Bookmark());
    QCOMPARE(clone->Value(QStringLiteral("ID")).toInt(), 3);
    clone->MoveFirst();
    QCOMPARE(rs->AbsolutePosition(), 2);
}

QTEST_MAIN(TestFileDatabase)
#include "test_file_database.moc"

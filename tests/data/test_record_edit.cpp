// GAddNew, GEdit and GUpdate on recordsets of the file kind.
#include <QtTest>

#include "data/database.h"
#include "data/record_edit.h"
#include "data/recordset.h"
#include "data/values.h"
#include "scripted_ui.h"
#include "sqlite_files.h"
#include "test_env.h"
#include "util/errors.h"
#include "util/state.h"

using namespace zv;

class TestRecordEdit : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();

    void nothingToDo();
    void pendingAndDuplicate_data();
    void pendingAndDuplicate();
    void editThenUpdate();
    void updateLeavesNewRowCurrent();
    void otherFailureIsReported();

  private:
    std::unique_ptr<Recordset> OpenDocs(const QString& where);
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<Database> db_;
    QString main_;
};

void TestRecordEdit::init() {
    env_ = std::make_unique<test::TestEnv>();
    main_ = env_->DataDir();
    SetMainPath(main_);
    test::MakeFileDb(
        main_, QStringLiteral("MDOCS"),
        {QStringLiteral("CREATE TABLE DOCS (ID INTEGER, FULLNAME TEXT COLLATE NOCASE, Teur TEXT "
                        "NOT NULL DEFAULT '')"),
         QStringLiteral("CREATE UNIQUE INDEX DOCS_ID ON DOCS (ID)"),
         QStringLiteral("INSERT INTO DOCS (ID, FULLNAME) VALUES (1,'a'),(2,'b'),(3,'c')")});
    db_ = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
}

void TestRecordEdit::cleanup() {
    GClose(db_);
    env_.reset();
}

std::unique_ptr<Recordset> TestRecordEdit::OpenDocs(const QString& where) {
    return db_->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ") + where, dbOpenDynaset);
}

// No recordset, no row to edit, no pending change: nothing happens. Update without an edit
// would be error 3020; a missing row is the one case reported.
void TestRecordEdit::nothingToDo() {
    test::ScopedScriptedUi ui;
    GAddNew(nullptr);
    GEdit(nullptr);
    QCOMPARE(GUpdate(0, nullptr), 0L);
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    rs->MoveNext();
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->AbsolutePosition(), 1);
    QVERIFY(ui->Messages().empty());
    GEdit(OpenDocs(QStringLiteral("ID=99")).get());
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("3021-0-GEdit-No current record.")});
    QCOMPARE(ui->Messages().front().style, int(vbOKOnly));
}

// A second GAddNew keeps the pending row; a duplicate key leaves it pending, so the caller
// can take the next number and save again. Only a development run is told of either.
void TestRecordEdit::pendingAndDuplicate_data() {
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

void TestRecordEdit::pendingAndDuplicate() {
    QFETCH(bool, development);
    QFETCH(QStringList, messages);
    test::ScopedScriptedUi ui;
    SetIsDevelopmentRun(development);
    auto rs = OpenDocs(QStringLiteral("FALSE"));
    GAddNew(rs.get());
    rs->SetValue(QStringLiteral("ID"), 3);
    GAddNew(rs.get());
    QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 3);
    QCOMPARE(GUpdate(0, rs.get()), err::JetDuplicate);
    rs->SetValue(QStringLiteral("ID"), 10);
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("x"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT group_concat(ID || FULLNAME) FROM DOCS"),
             QStringLiteral("1a,2b,3c,10x"));
    QCOMPARE(ui->Texts(), messages);
}

void TestRecordEdit::editThenUpdate() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    rs->MoveLast();
    GEdit(rs.get());
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("changed"));
    GEdit(rs.get());
    QCOMPARE(rs->Value(QStringLiteral("FULLNAME")).toString(), QStringLiteral("changed"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->AbsolutePosition(), 2);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT group_concat(FULLNAME) FROM DOCS"),
             QStringLiteral("a,b,changed"));
    QVERIFY(ui->Messages().empty());
}

void TestRecordEdit::updateLeavesNewRowCurrent() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    GAddNew(rs.get());
    rs->SetValue(QStringLiteral("ID"), 4);
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("new"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->Value(QStringLiteral("FULLNAME")).toString(), QStringLiteral("new"));
    QCOMPARE(rs->AbsolutePosition(), 3);

    // The same on an empty recordset opened only to add rows.
    auto empty = OpenDocs(QStringLiteral("FALSE"));
    GAddNew(empty.get());
    empty->SetValue(QStringLiteral("ID"), 5);
    QCOMPARE(GUpdate(0, empty.get()), 0L);
    QCOMPARE(empty->Value(QStringLiteral("ID")).toInt(), 5);
    QVERIFY(ui->Messages().empty());
}

void TestRecordEdit::otherFailureIsReported() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID=1"));
    GEdit(rs.get());
    rs->SetValue(QStringLiteral("Teur"), Null());
    QCOMPARE(GUpdate(3, rs.get()), 3314L);
    QCOMPARE(ui->Texts().size(), 1);
    const QString text = ui->Texts().front();
    QVERIFY2(text.startsWith(QStringLiteral("3314-0-GUpdate-NOT NULL constraint failed")),
             qPrintable(text));
    QVERIFY2(text.endsWith(QStringLiteral("\nSELECT * FROM DOCS WHERE ID=1\nmDb=3")),
             qPrintable(text));
}

QTEST_MAIN(TestRecordEdit)
#include "test_record_edit.moc"

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

    void nothingOnNoRecordset();
    void addNewWhilePending_data();
    void addNewWhilePending();
    void editKeepsPendingEdit();
    void editWithoutRowIsReported();
    void updateWithoutPendingDoesNothing();
    void updateLeavesNewRowCurrent();
    void updateOfEditedRow();
    void duplicate_data();
    void duplicate();
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

void TestRecordEdit::nothingOnNoRecordset() {
    test::ScopedScriptedUi ui;
    GAddNew(nullptr);
    GEdit(nullptr);
    QCOMPARE(GUpdate(0, nullptr), 0L);
    QVERIFY(ui->Messages().empty());
}

void TestRecordEdit::addNewWhilePending_data() {
    QTest::addColumn<bool>("development");
    QTest::addColumn<QStringList>("messages");
    QTest::newRow("ordinary run: silent") << false << QStringList{};
    QTest::newRow("development run: told") << true << QStringList{QStringLiteral("כבר בעריכה")};
}

void TestRecordEdit::addNewWhilePending() {
    QFETCH(bool, development);
    QFETCH(QStringList, messages);
    test::ScopedScriptedUi ui;
    SetIsDevelopmentRun(development);
    auto rs = OpenDocs(QStringLiteral("FALSE"));
    GAddNew(rs.get());
    rs->SetValue(QStringLiteral("ID"), 10);
    GAddNew(rs.get());
    // No second row was begun: the value assigned before is still pending.
    QCOMPARE(rs->EditMode(), int(dbEditAdd));
    QCOMPARE(rs->Value(QStringLiteral("ID")).toInt(), 10);
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("x"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT FULLNAME FROM DOCS WHERE ID=10"),
             QStringLiteral("x"));
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT count(*) FROM DOCS"), QStringLiteral("4"));
    QCOMPARE(ui->Texts(), messages);
}

void TestRecordEdit::editKeepsPendingEdit() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID=2"));
    GEdit(rs.get());
    rs->SetValue(QStringLiteral("Teur"), QStringLiteral("first"));
    GEdit(rs.get());
    QCOMPARE(rs->Value(QStringLiteral("Teur")).toString(), QStringLiteral("first"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT Teur FROM DOCS WHERE ID=2"),
             QStringLiteral("first"));
    QVERIFY(ui->Messages().empty());
}

void TestRecordEdit::editWithoutRowIsReported() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID=99"));
    GEdit(rs.get());
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("3021-0-GEdit-No current record.")});
    QCOMPARE(ui->Messages().front().style, int(vbOKOnly));
}

void TestRecordEdit::updateWithoutPendingDoesNothing() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    rs->MoveNext();
    // Without an edit, calling Update would be error 3020; nothing is shown, nothing moves.
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->AbsolutePosition(), 1);
    QVERIFY(ui->Messages().empty());
}

void TestRecordEdit::updateLeavesNewRowCurrent() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    QCOMPARE(rs->AbsolutePosition(), 0);
    GAddNew(rs.get());
    rs->SetValue(QStringLiteral("ID"), 4);
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("new"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->EditMode(), int(dbEditNone));
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

void TestRecordEdit::updateOfEditedRow() {
    auto rs = OpenDocs(QStringLiteral("ID>0 ORDER BY ID"));
    rs->MoveLast();
    GEdit(rs.get());
    rs->SetValue(QStringLiteral("FULLNAME"), QStringLiteral("changed"));
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(rs->AbsolutePosition(), 2);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT group_concat(FULLNAME) FROM DOCS"),
             QStringLiteral("a,b,changed"));
}

void TestRecordEdit::duplicate_data() {
    QTest::addColumn<bool>("development");
    QTest::addColumn<QStringList>("messages");
    const QString sql = QStringLiteral("SELECT * FROM DOCS WHERE FALSE");
    QTest::newRow("ordinary run: silent") << false << QStringList{};
    QTest::newRow("development run: shown")
        << true
        << QStringList{QStringLiteral("Programr : 3022-0-GUpdate-") +
                       StandardDescription(err::JetDuplicate) + QLatin1Char('\n') + sql +
                       QStringLiteral("\nmDb=0")};
}

void TestRecordEdit::duplicate() {
    QFETCH(bool, development);
    QFETCH(QStringList, messages);
    test::ScopedScriptedUi ui;
    SetIsDevelopmentRun(development);
    auto rs = OpenDocs(QStringLiteral("FALSE"));
    GAddNew(rs.get());
    rs->SetValue(QStringLiteral("ID"), 3);
    QCOMPARE(GUpdate(0, rs.get()), err::JetDuplicate);
    QCOMPARE(ui->Texts(), messages);
    // The row is still pending: the caller can take the next number and save again.
    rs->SetValue(QStringLiteral("ID"), 4);
    QCOMPARE(GUpdate(0, rs.get()), 0L);
    QCOMPARE(test::QueryFileDb(main_, "MDOCS", "SELECT count(*) FROM DOCS"), QStringLiteral("4"));
}

void TestRecordEdit::otherFailureIsReported() {
    test::ScopedScriptedUi ui;
    auto rs = OpenDocs(QStringLiteral("ID=1"));
    GEdit(rs.get());
    rs->SetValue(QStringLiteral("Teur"), Null());
    const long number = GUpdate(3, rs.get());
    QCOMPARE(number, 3314L);
    QCOMPARE(ui->Texts().size(), 1);
    const QString text = ui->Texts().front();
    QVERIFY2(text.startsWith(QStringLiteral("3314-0-GUpdate-NOT NULL constraint failed")),
             qPrintable(text));
    QVERIFY2(text.endsWith(QStringLiteral("\nSELECT * FROM DOCS WHERE ID=1\nmDb=3")),
             qPrintable(text));
}

QTEST_MAIN(TestRecordEdit)
#include "test_record_edit.moc"

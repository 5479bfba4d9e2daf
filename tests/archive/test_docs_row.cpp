// The DOCS row of a filed document and its UMEMO reminders, on the file databases or, in
// the server build of this program, on PostgreSQL.
#include <QtTest>

#include "archive/date_values.h"
#include "archive/docs_row.h"
#include "archive/memo.h"
#include "archive/next_doc_id.h"
#include "archive/remark.h"
#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "filing_fixture.h"
#include "sample_install/test_server.h"
#include "util/clock.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;

namespace {

constexpr bool kServer = ZV_ARCHIVE_ON_SERVER;

const QDateTime kNow(QDate(2026, 12, 6), QTime(21, 15, 42));
const QString kLetter = QStringLiteral("DOCBASIC/מכתבים/letter.docx");

DocDetails FullDetails() {
    DocDetails d;
    d.handlers = QStringLiteral("דנה כהן;יוסי לוי");
    d.description = QStringLiteral("מכתב ללקוח");
    d.moreDescription = QStringLiteral("עותק שני");
    d.remark = QStringLiteral("נשלח בדואר");
    d.reminder = true;
    d.reminderDate = QDate(2026, 12, 20);
    d.reminderTime = QStringLiteral("9:30");
    d.popup = true;
    d.receivedDate = QDate(2026, 12, 1);
    d.createdDate = QDate(2026, 11, 30);
    d.createdUnlocked = true;
    d.origin = 3;
    d.status = 4;
    d.clientNumber = QStringLiteral("1001");
    d.kindLetter = QStringLiteral("N");
    d.subKind = QStringLiteral("7");
    d.caseNumber = QStringLiteral("55");
    d.caseCode = QStringLiteral("C-9");
    return d;
}

// One way of writing every value, whatever the engine returned.
QString Text(const QVariant& v) {
    if (v.isNull()) {
        return QStringLiteral("<null>");
    }
    switch (v.typeId()) {
        case QMetaType::QDateTime:
        case QMetaType::QDate:
            return StoredDateTime(v).toString(QStringLiteral("yyyy-MM-dd HH:mm:ss"));
        case QMetaType::Bool:
            return v.toBool() ? QStringLiteral("1") : QStringLiteral("0");
        default:
            return v.toString();
    }
}

QList<QVariantMap> DocRows(const QString& relPath) {
    return Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT * FROM DOCS WHERE FULLNAME='") +
                                             FixQuote(FullName(relPath)) + QLatin1Char('\''));
}

QVariant IdOf(const QString& relPath) {
    return DocRows(relPath).value(0).value(QStringLiteral("ID"));
}

QList<QVariantMap> Memos(const QVariant& id) {
    return Rows(QStringLiteral("BM"), QStringLiteral("SELECT * FROM UMEMO WHERE ID=") +
                                          id.toString() + QStringLiteral(" ORDER BY MemoNum"));
}

// "handler/MTYPE/RTYPE" of each reminder row, in the order written.
QStringList MemoKinds(const QVariant& id) {
    QStringList out;
    for (const auto& m : Memos(id)) {
        out << Text(m[QStringLiteral("METAPEL")]) + QLatin1Char('/') +
                   Text(m[QStringLiteral("MTYPE")]) + QLatin1Char('/') +
                   Text(m[QStringLiteral("RTYPE")]);
    }
    return out;
}

qint64 MaxDocId() {
    const auto rows =
        Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT max(ID) AS M FROM DOCS"));
    return rows.front()[QStringLiteral("M")].toLongLong();
}

}  // namespace

class TestDocsRow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void newRow();
    void refiling_data();
    void refiling();
    void reminders_data();
    void reminders();
    void untickRemovesOnlyOwnReminders();
    void idReadingZeroIsReported();
    void missingColumn_data();
    void missingColumn();
    void identifiers();
    void notSavedEndsSilently();
    void backEndsChosenApart();

  private:
};

void TestDocsRow::initTestCase() {
    if (kServer) {
        const SampleOptions options = TestServerOptions();
        ZV_REQUIRE_TEST_SERVER(options);
    }
}

void TestDocsRow::newRow() {
    FilingFixture f(kServer);
    SetClock([] { return kNow; });
    const qint64 maxBefore = MaxDocId();
    const DocDetails d = FullDetails();

    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const QVariantMap row = DocRows(kLetter).value(0);
    QCOMPARE(row[QStringLiteral("ID")].toLongLong(), maxBefore + 1);
    const QString user = MyUserName();
    const QStringList expected =
        (QStringLiteral("FULLNAME=\\DOCS\\DOCBASIC\\מכתבים\\letter.docx|SHORTNAME=letter.docx|"
                        "DIRPATH=\\DOCS\\DOCBASIC\\מכתבים\\|DIRMONE=0|SOURCE=9|ISMEMO=0|"
                        "DATECREATED=2026-11-30 00:00:00|METAPEL=דנה כהן;יוסי לוי|"
                        "TEUR=מכתב ללקוח|SECTEUR=עותק שני|MEMODATE=2026-12-20 00:00:00|"
                        "MEMOHOUR=09:30|ISJUMPMEMO=1|RECIEVEDATE=2026-12-01 00:00:00|"
                        "LASTMODIFICATIONTIME=2026-12-06 21:15:42|PARTOF=3|STATUS=4|"
                        "CLIENT_NUM=1001|SUG=N|IDTIK=7|TIK=55|NUM=C-9|LASTMODIFICATIONUSER=") +
         user + QStringLiteral("|BODY=") + RemarkStamp(kNow, user) +
         QStringLiteral(" -- נשלח בדואר"))
            .split(QLatin1Char('|'));
    for (const QString& column : expected) {
        const QString name = column.section(QLatin1Char('='), 0, 0);
        QVERIFY2(row.contains(name), qPrintable(name));
        QCOMPARE(name + QLatin1Char('=') + Text(row[name]), column);
    }
}

void TestDocsRow::refiling_data() {
    QTest::addColumn<QString>("relPath");
    QTest::newRow("plain name") << kLetter;
    QTest::newRow("apostrophe") << QStringLiteral("DOCBASIC/חוזים/O'Brien's deal.pdf");
}

// Filing to a path that has a row updates it: one row, its ID kept, the remarks kept in
// order under lines of dashes; a remark of blanks adds nothing.
void TestDocsRow::refiling() {
    QFETCH(QString, relPath);
    FilingFixture f(kServer);
    const QString path = f.ArchiveFile(relPath);
    DocDetails d = FullDetails();
    const QDateTime first(QDate(2026, 12, 6), QTime(9, 0, 1));
    const QDateTime second(QDate(2026, 12, 7), QTime(17, 30, 2));

    SetClock([&] { return first; });
    d.remark = QStringLiteral("ראשון");
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QVariant id = IdOf(relPath);
    SetClock([&] { return second; });
    d.remark = QStringLiteral("שני");
    d.description = QStringLiteral("תיאור חדש");
    QVERIFY(AddDocToListByAddIn(path, &d));
    d.remark = QStringLiteral("   ");
    QVERIFY(AddDocToListByAddIn(path, &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const auto rows = DocRows(relPath);
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.front();
    QCOMPARE(row[QStringLiteral("ID")], id);
    QCOMPARE(row[QStringLiteral("TEUR")].toString(), d.description);
    const QString user = MyUserName();
    QCOMPARE(row[QStringLiteral("BODY")].toString(),
             RemarkStamp(first, user) + QStringLiteral(" -- ראשון\r\n") +
                 QString(60, QLatin1Char('-')) + QStringLiteral("\r\n") +
                 RemarkStamp(second, user) + QStringLiteral(" -- שני"));
}

void TestDocsRow::reminders_data() {
    QTest::addColumn<QString>("handlers");
    QTest::addColumn<bool>("reminder");
    QTest::addColumn<QDate>("date");
    QTest::addColumn<QString>("time");
    QTest::addColumn<bool>("popup");
    QTest::addColumn<QStringList>("columns");  // IsMemo, MemoDate, MemoHour, IsJumpMemo
    QTest::addColumn<QStringList>("memos");    // handler/MTYPE/RTYPE
    QTest::addColumn<QDateTime>("moment");     // of every reminder row

    const QDate day(2026, 12, 20);
    const QString midnight = QStringLiteral("2026-12-20 00:00:00");
    const QDateTime at(day, QTime(10, 0));
    QTest::newRow("off") << "A" << false << day << "10:00" << true
                         << QStringList{"1", "<null>", "<null>", "0"} << QStringList{} << at;
    QTest::newRow("on") << "A" << true << day << "10:00" << false
                        << QStringList{"0", midnight, "10:00", "0"} << QStringList{"A/32/3"} << at;
    QTest::newRow("empty time mask is 08:00")
        << "A" << true << day << "__:__" << false << QStringList{"0", midnight, "08:00", "0"}
        << QStringList{"A/32/3"} << QDateTime(day, QTime(8, 0));
    QTest::newRow("empty date box is the zero date")
        << "A" << true << QDate() << "10:00" << true
        << QStringList{"0", "1899-12-30 00:00:00", "10:00", "1"} << QStringList{} << at;
    QTest::newRow("two handlers, pop-up first")
        << "A;B" << true << day << "10:00" << true << QStringList{"0", midnight, "10:00", "1"}
        << QStringList{"A/31/2", "B/31/2", "A/32/3", "B/32/3"} << at;
    QTest::newRow("trailing separator gives an empty handler")
        << "A;" << true << day << "10:00" << true << QStringList{"0", midnight, "10:00", "1"}
        << QStringList{"A/31/2", "/31/2", "A/32/3", "/32/3"} << at;
    QTest::newRow("24:30 is the next day")
        << "A" << true << day << "24:30" << false << QStringList{"0", midnight, "24:30", "0"}
        << QStringList{"A/32/3"} << QDateTime(QDate(2026, 12, 21), QTime(0, 30));
}

void TestDocsRow::reminders() {
    QFETCH(QString, handlers);
    QFETCH(bool, reminder);
    QFETCH(QDate, date);
    QFETCH(QString, time);
    QFETCH(bool, popup);
    QFETCH(QStringList, columns);
    QFETCH(QStringList, memos);
    QFETCH(QDateTime, moment);
    FilingFixture f(kServer);
    SetClock([] { return kNow; });
    DocDetails d = FullDetails();
    d.handlers = handlers;
    d.reminder = reminder;
    d.reminderDate = date;
    d.reminderTime = time;
    d.popup = popup;

    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const QVariantMap row = DocRows(kLetter).value(0);
    const QStringList got{
        Text(row[QStringLiteral("ISMEMO")]), Text(row[QStringLiteral("MEMODATE")]),
        Text(row[QStringLiteral("MEMOHOUR")]), Text(row[QStringLiteral("ISJUMPMEMO")])};
    QCOMPARE(got, columns);
    QCOMPARE(MemoKinds(row[QStringLiteral("ID")]), memos);
    for (const auto& m : Memos(row[QStringLiteral("ID")])) {
        QCOMPARE(m[QStringLiteral("USER97")].toString(), MyUser());
        QCOMPARE(Text(m[QStringLiteral("MEMOTIME")]), Text(moment));
        QCOMPARE(Text(m[QStringLiteral("DATEUPDATED")]), Text(kNow));
    }
}

// Refiling without a reminder removes the document's pop-up and regular reminders; other
// kinds of reminder and other documents' reminders stay.
void TestDocsRow::untickRemovesOnlyOwnReminders() {
    FilingFixture f(kServer);
    const QString path = f.ArchiveFile(kLetter);
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("A");
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QString id = IdOf(kLetter).toString();
    const QString insert = QStringLiteral(
        "INSERT INTO UMEMO (USER97, METAPEL, MTYPE, RTYPE, ID) VALUES ('1', 'A', %1, 2, %2)");
    Execute(QStringLiteral("BM"), insert.arg(QStringLiteral("7"), id));
    Execute(QStringLiteral("BM"), insert.arg(QStringLiteral("31"), QStringLiteral("99999")));
    QCOMPARE(MemoKinds(id), (QStringList{"A/31/2", "A/32/3", "A/7/2"}));

    d.reminder = false;
    QVERIFY(AddDocToListByAddIn(path, &d));

    QCOMPARE(MemoKinds(id), QStringList{"A/7/2"});
    QCOMPARE(MemoKinds(99999), QStringList{"A/31/2"});
    QCOMPARE(Text(DocRows(kLetter).value(0)[QStringLiteral("ISMEMO")]), QStringLiteral("1"));
    QVERIFY(f.Ui().Texts().isEmpty());
}

void TestDocsRow::idReadingZeroIsReported() {
    FilingFixture f(kServer);
    Execute(QStringLiteral("MDOCS"),
            QStringLiteral("INSERT INTO DOCS (ID, FULLNAME, IsMemo, IsJumpMemo, MemoDate, "
                           "MemoHour, Metapel) VALUES (0, '\\zero.doc', 0, 1, "
                           "'2026-12-20 00:00:00', '09:00', 'A')"));
    auto db = Database::Open(QStringLiteral("MDOCS"), IsDocs());
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FULLNAME='\\zero.doc'"));

    CheckMemo(QStringLiteral("DOCS"), rs.get());

    QCOMPARE(f.Ui().Texts(), QStringList{QStringLiteral("בעיה בקוד זיהוי בטבלה : DOCS")});
    QVERIFY(Memos(0).isEmpty());
}

void TestDocsRow::missingColumn_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("statement");
    QTest::addColumn<QString>("message");  // %1: the file, %2: its ID
    QTest::newRow("DOCS") << "MDOCS"
                          << "ALTER TABLE DOCS DROP COLUMN SecTeur"
                          << "3265-0-AddDocToListByAddIn-Item not found in this collection. "
                             "(SecTeur)\r\n%1";
    QTest::newRow("UMEMO")
        << "BM"
        << "ALTER TABLE UMEMO DROP COLUMN DateUpdated"
        << " 3265-CheckMemo-\r\nDOCS-%2\r\nItem not found in this collection. (DateUpdated)";
}

// A column a table lacks is reported; the rest of the row and the reminders are saved.
void TestDocsRow::missingColumn() {
    QFETCH(QString, database);
    QFETCH(QString, statement);
    QFETCH(QString, message);
    FilingFixture f(kServer);
    Execute(database, statement);
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("A");
    d.popup = false;
    const QString path = f.ArchiveFile(kLetter);

    QVERIFY(AddDocToListByAddIn(path, &d));

    const QVariantMap row = DocRows(kLetter).value(0);
    message.replace(QStringLiteral("%1"), path)
        .replace(QStringLiteral("%2"), row[QStringLiteral("ID")].toString());
    QCOMPARE(f.Ui().Texts(), QStringList{message});
    QCOMPARE(row[QStringLiteral("NUM")].toString(), d.caseCode);
    QCOMPARE(MemoKinds(row[QStringLiteral("ID")]), QStringList{"A/32/3"});
}

// The file databases number documents max + 1 (1 in an empty table); on the server the server
// numbers them and the add-in asks for nothing.
void TestDocsRow::identifiers() {
    FilingFixture f(kServer);
    Execute(QStringLiteral("MDOCS"), QStringLiteral("DELETE FROM DOCS"));
    QCOMPARE(GetNextIdDOCS(), kServer ? 0 : 1);
    const DocDetails d = FullDetails();
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(QStringLiteral("MAILIN/a.pdf")), &d));
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(QStringLiteral("MAILIN/b.pdf")), &d));
    const qint64 a = IdOf(QStringLiteral("MAILIN/a.pdf")).toLongLong();
    QVERIFY(a > 0);
    QCOMPARE(IdOf(QStringLiteral("MAILIN/b.pdf")).toLongLong(), a + 1);
    QVERIFY(kServer || a == 1);
    QVERIFY(f.Ui().Texts().isEmpty());
}

// A filing whose row cannot be saved says so and ends silently: a file that is gone, and a
// duplicate in an index other than ID, which is no identifier race and takes no second one.
void TestDocsRow::notSavedEndsSilently() {
    FilingFixture f(kServer);
    Execute(QStringLiteral("MDOCS"),
            QStringLiteral("CREATE UNIQUE INDEX DOCS_SHORTNAME ON DOCS (ShortName)"));
    const qint64 before = MaxDocId();
    const DocDetails d = FullDetails();
    QVERIFY(!AddDocToListByAddIn(f.Docs() + QStringLiteral("/MAILIN/gone.pdf"), &d));
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(QStringLiteral("MAILIN/same.pdf")), &d));
    QVERIFY(!AddDocToListByAddIn(f.ArchiveFile(QStringLiteral("DOCBASIC/same.pdf")), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const auto added =
        Rows(QStringLiteral("MDOCS"),
             QStringLiteral("SELECT ID FROM DOCS WHERE ID>") + QString::number(before));
    QCOMPARE(added.size(), 1);
    if (!kServer) {
        QCOMPARE(GetNextIdDOCS(), before + 2);
    }
}

// The two flags choose independently; the reminders carry the document's own ID.
void TestDocsRow::backEndsChosenApart() {
    if (!kServer) {
        QSKIP("mixed back-ends need the server; the server build runs them");
    }
    FilingFixture f(true, false);
    const DocDetails d = FullDetails();
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(QStringLiteral("MAILIN/first.pdf")), &d));
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    const QVariant first = IdOf(QStringLiteral("MAILIN/first.pdf"));
    QVERIFY(first != IdOf(kLetter));
    QCOMPARE(Memos(first).size(), 4);
    QCOMPARE(Memos(IdOf(kLetter)).size(), 4);
    QVERIFY(f.Ui().Texts().isEmpty());
}

QTEST_MAIN(TestDocsRow)
#include "test_docs_row.moc"

// The DOCS row of a filed document and its UMEMO reminders, on the file databases or, in
// the server build of this program, on PostgreSQL; and the remark history of its body.
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
using namespace Qt::Literals::StringLiterals;

namespace {

constexpr bool kServer = ZV_ARCHIVE_ON_SERVER;

const QDateTime kNow(QDate(2026, 12, 6), QTime(21, 15, 42));
const QString kLetter = u"DOCBASIC/מכתבים/letter.docx"_s;

DocDetails FullDetails() {
    return {.handlers = u"דנה כהן;יוסי לוי"_s,
            .description = u"מכתב ללקוח"_s,
            .moreDescription = u"עותק שני"_s,
            .remark = u"נשלח בדואר"_s,
            .reminder = true,
            .reminderDate = QDate(2026, 12, 20),
            .reminderTime = u"9:30"_s,
            .popup = true,
            .receivedDate = QDate(2026, 12, 1),
            .createdDate = QDate(2026, 11, 30),
            .createdUnlocked = true,
            .origin = 3,
            .status = 4,
            .clientNumber = u"1001"_s,
            .kindLetter = u"N"_s,
            .subKind = u"7"_s,
            .caseNumber = u"55"_s,
            .caseCode = u"C-9"_s};
}

// One way of writing every value, whatever the engine returned.
QString Text(const QVariant& v) {
    if (v.isNull()) {
        return u"<null>"_s;
    }
    if (v.typeId() == QMetaType::QDateTime || v.typeId() == QMetaType::QDate) {
        return StoredDateTime(v).toString(u"yyyy-MM-dd HH:mm:ss"_s);
    }
    return v.typeId() == QMetaType::Bool ? QString::number(v.toInt()) : v.toString();
}

// The one row of a path below DOCS; empty unless there is exactly one.
QVariantMap DocRow(const QString& relPath) {
    const auto rows =
        Rows(u"MDOCS"_s, "SELECT * FROM DOCS WHERE FULLNAME='" + FixQuote(FullName(relPath)) + "'");
    return rows.size() == 1 ? rows[0] : QVariantMap();
}

// The named columns of a row, joined by "|".
QString Columns(const QVariantMap& row, const QStringList& names) {
    QStringList values;
    for (const QString& name : names) {
        values << Text(row[name]);
    }
    return values.join('|');
}

// "handler/MTYPE/RTYPE" of each reminder row of a document, in the order written.
QStringList Memos(const QVariant& id) {
    QStringList out;
    for (const auto& m :
         Rows(u"BM"_s, "SELECT * FROM UMEMO WHERE ID=" + id.toString() + " ORDER BY MemoNum")) {
        out << Columns(m, {"METAPEL", "MTYPE", "RTYPE"}).replace('|', '/');
    }
    return out;
}

struct Reminder {
    QString handlers;
    bool reminder;
    QDate date;
    QString time;
    bool popup;
    QString columns;    // IsMemo|MemoDate|MemoHour|IsJumpMemo
    QStringList memos;  // handler/MTYPE/RTYPE
    QDateTime moment;   // of every reminder row
};

}  // namespace

Q_DECLARE_METATYPE(Reminder)

class TestDocsRow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void newRow();
    void refiling();
    void reminders_data();
    void reminders();
    void untickRemovesOnlyOwnReminders();
    void idReadingZeroIsReported();
    void missingColumn();
    void notSavedEndsSilently();
    void backEndsChosenApart();
    void remarkHistory();
};

void TestDocsRow::initTestCase() {
    if (kServer) {
        const SampleOptions options = TestServerOptions();
        ZV_REQUIRE_TEST_SERVER(options);
    }
}

// Every column of a new row. The file databases number the first document of an empty table
// 1; on the server the server numbers it and the add-in asks for nothing.
void TestDocsRow::newRow() {
    FilingFixture f(kServer);
    SetClock([] { return kNow; });
    Execute(u"MDOCS"_s, u"DELETE FROM DOCS"_s);
    QCOMPARE(GetNextIdDOCS(), kServer ? 0 : 1);
    const DocDetails d = FullDetails();

    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const QVariantMap row = DocRow(kLetter);
    QVERIFY(kServer ? row["ID"].toLongLong() > 0 : row["ID"].toLongLong() == 1);
    const QString user = MyUserName();
    const QStringList expected =
        ("FULLNAME=\\DOCS\\DOCBASIC\\מכתבים\\letter.docx|SHORTNAME=letter.docx|"
         "DIRPATH=\\DOCS\\DOCBASIC\\מכתבים\\|DIRMONE=0|SOURCE=9|ISMEMO=0|"
         "DATECREATED=2026-11-30 00:00:00|METAPEL=דנה כהן;יוסי לוי|TEUR=מכתב ללקוח|"
         "SECTEUR=עותק שני|MEMODATE=2026-12-20 00:00:00|MEMOHOUR=09:30|ISJUMPMEMO=1|"
         "RECIEVEDATE=2026-12-01 00:00:00|LASTMODIFICATIONTIME=2026-12-06 21:15:42|PARTOF=3|"
         "STATUS=4|CLIENT_NUM=1001|SUG=N|IDTIK=7|TIK=55|NUM=C-9|LASTMODIFICATIONUSER=" +
         user + "|BODY=" + RemarkStamp(kNow, user) + " -- נשלח בדואר")
            .split('|');
    for (const QString& column : expected) {
        const QString name = column.section('=', 0, 0);
        QVERIFY2(row.contains(name), qPrintable(name));
        QCOMPARE(name + '=' + Text(row[name]), column);
    }
}

// Filing to a path that has a row updates it: one row, its ID kept, the remarks kept in
// order under lines of dashes; a remark of blanks adds nothing. The path needs quoting.
void TestDocsRow::refiling() {
    const QString relPath = u"DOCBASIC/חוזים/O'Brien's deal.pdf"_s;
    FilingFixture f(kServer);
    const QString path = f.ArchiveFile(relPath);
    DocDetails d = FullDetails();
    const QDateTime first(QDate(2026, 12, 6), QTime(9, 0, 1));
    const QDateTime second(QDate(2026, 12, 7), QTime(17, 30, 2));

    SetClock([&] { return first; });
    d.remark = u"ראשון"_s;
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QVariant id = DocRow(relPath)["ID"];
    SetClock([&] { return second; });
    d.remark = u"שני"_s;
    d.description = u"תיאור חדש"_s;
    QVERIFY(AddDocToListByAddIn(path, &d));
    d.remark = u"   "_s;
    QVERIFY(AddDocToListByAddIn(path, &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const QVariantMap row = DocRow(relPath);
    QCOMPARE(row["ID"], id);
    QCOMPARE(row["TEUR"].toString(), d.description);
    const QString user = MyUserName();
    QCOMPARE(row["BODY"].toString(), RemarkStamp(first, user) + " -- ראשון\r\n" + QString(60, '-') +
                                         "\r\n" + RemarkStamp(second, user) + " -- שני");
}

void TestDocsRow::reminders_data() {
    QTest::addColumn<Reminder>("r");
    const QDate day(2026, 12, 20);
    const QString on = u"0|2026-12-20 00:00:00|"_s;
    const QDateTime at(day, QTime(10, 0));
    QTest::newRow("off") << Reminder{"A", false, day, "10:00", true, "1|<null>|<null>|0", {}, at};
    QTest::newRow("empty time mask is 08:00")
        << Reminder{"A", true, day, "__:__", false, on + "08:00|0", {"A/32/3"}, {day, QTime(8, 0)}};
    QTest::newRow("empty date box is the zero date")
        << Reminder{"A", true, {}, "10:00", true, "0|1899-12-30 00:00:00|10:00|1", {}, at};
    QTest::newRow("two handlers, pop-up first") << Reminder{
        "A;B", true, day, "10:00", true, on + "10:00|1", {"A/31/2", "B/31/2", "A/32/3", "B/32/3"},
        at};
    QTest::newRow("trailing separator gives an empty handler") << Reminder{
        "A;", true, day, "10:00", true, on + "10:00|1", {"A/31/2", "/31/2", "A/32/3", "/32/3"}, at};
    // A time the box cannot read is kept as typed; hours and minutes past their range carry.
    QTest::newRow("99:99 is four days on") << Reminder{
        "A", true, day, "99:99", false, on + "99:99|0", {"A/32/3"}, {day.addDays(4), QTime(4, 39)}};
    QTest::newRow("no time, no reminder rows")
        << Reminder{"A", true, day, "8:0x", true, on + "8:0x|1", {}, at};
}

void TestDocsRow::reminders() {
    QFETCH(Reminder, r);
    FilingFixture f(kServer);
    SetClock([] { return kNow; });
    DocDetails d = FullDetails();
    d.handlers = r.handlers;
    d.reminder = r.reminder;
    d.reminderDate = r.date;
    d.reminderTime = r.time;
    d.popup = r.popup;

    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    const QVariantMap row = DocRow(kLetter);
    QCOMPARE(Columns(row, {"ISMEMO", "MEMODATE", "MEMOHOUR", "ISJUMPMEMO"}), r.columns);
    QCOMPARE(Memos(row["ID"]), r.memos);
    const QString each = MyUser() + '|' + Text(r.moment) + '|' + Text(kNow);
    for (const auto& m : Rows(u"BM"_s, "SELECT * FROM UMEMO WHERE ID=" + row["ID"].toString())) {
        QCOMPARE(Columns(m, {"USER97", "MEMOTIME", "DATEUPDATED"}), each);
    }
}

// Refiling without a reminder removes the document's pop-up and regular reminders; other
// kinds of reminder and other documents' reminders stay.
void TestDocsRow::untickRemovesOnlyOwnReminders() {
    FilingFixture f(kServer);
    const QString path = f.ArchiveFile(kLetter);
    DocDetails d = FullDetails();
    d.handlers = u"A"_s;
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QString id = DocRow(kLetter)["ID"].toString();
    const QString insert =
        u"INSERT INTO UMEMO (USER97, METAPEL, MTYPE, RTYPE, ID) VALUES ('1', 'A', %1, 2, %2)"_s;
    Execute(u"BM"_s, insert.arg(u"7"_s, id));
    Execute(u"BM"_s, insert.arg(u"31"_s, u"99999"_s));
    QCOMPARE(Memos(id), (QStringList{"A/31/2", "A/32/3", "A/7/2"}));

    d.reminder = false;
    QVERIFY(AddDocToListByAddIn(path, &d));

    QCOMPARE(Memos(id), QStringList{"A/7/2"});
    QCOMPARE(Memos(99999), QStringList{"A/31/2"});
    QCOMPARE(Text(DocRow(kLetter)["ISMEMO"]), u"1"_s);
    QVERIFY(f.Ui().Texts().isEmpty());
}

// A row whose ID reads 0 (a server row refiled keeps its ID) gets no reminders under ID 0.
void TestDocsRow::idReadingZeroIsReported() {
    FilingFixture f(kServer);
    Execute(u"MDOCS"_s,
            u"INSERT INTO DOCS (ID, FULLNAME, IsMemo, IsJumpMemo, MemoDate, MemoHour, Metapel) "
            "VALUES (0, '\\zero.doc', 0, 1, '2026-12-20 00:00:00', '09:00', 'A')"_s);
    auto db = Database::Open(u"MDOCS"_s, IsDocs());
    auto rs = db->OpenRecordset(u"SELECT * FROM DOCS WHERE FULLNAME='\\zero.doc'"_s);

    CheckMemo(u"DOCS"_s, rs.get());

    QCOMPARE(f.Ui().Texts(), QStringList{u"בעיה בקוד זיהוי בטבלה : DOCS"_s});
    QVERIFY(Memos(0).isEmpty());
}

// A column a table lacks is reported; the rest of the row and the reminders are saved.
void TestDocsRow::missingColumn() {
    const struct {
        QString database, statement, message;  // %1: the file, %2: its ID
    } cases[] = {
        {"MDOCS", "ALTER TABLE DOCS DROP COLUMN SecTeur",
         "3265-0-AddDocToListByAddIn-Item not found in this collection. (SecTeur)\r\n%1"},
        {"BM", "ALTER TABLE UMEMO DROP COLUMN DateUpdated",
         " 3265-CheckMemo-\r\nDOCS-%2\r\nItem not found in this collection. (DateUpdated)"}};
    for (const auto& c : cases) {
        FilingFixture f(kServer);
        Execute(c.database, c.statement);
        DocDetails d = FullDetails();
        d.handlers = u"A"_s;
        d.popup = false;
        const QString path = f.ArchiveFile(kLetter);

        QVERIFY(AddDocToListByAddIn(path, &d));

        const QVariantMap row = DocRow(kLetter);
        QCOMPARE(
            f.Ui().Texts(),
            QStringList{
                QString(c.message).replace(u"%1"_s, path).replace(u"%2"_s, row["ID"].toString())});
        QCOMPARE(row["NUM"].toString(), d.caseCode);
        QCOMPARE(Memos(row["ID"]), QStringList{"A/32/3"});
    }
}

// A filing whose row cannot be saved says so and ends silently: a file that is gone, and a
// duplicate in an index other than ID, which is no identifier race and takes no second one.
void TestDocsRow::notSavedEndsSilently() {
    FilingFixture f(kServer);
    Execute(u"MDOCS"_s, u"CREATE UNIQUE INDEX DOCS_SHORTNAME ON DOCS (ShortName)"_s);
    const qint64 before = Rows(u"MDOCS"_s, u"SELECT max(ID) AS M FROM DOCS"_s)[0]["M"].toLongLong();
    const DocDetails d = FullDetails();
    QVERIFY(!AddDocToListByAddIn(f.Docs() + u"/MAILIN/gone.pdf"_s, &d));
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(u"MAILIN/same.pdf"_s), &d));
    QVERIFY(!AddDocToListByAddIn(f.ArchiveFile(u"DOCBASIC/same.pdf"_s), &d));

    QVERIFY(f.Ui().Texts().isEmpty());
    QCOMPARE(Rows(u"MDOCS"_s, "SELECT ID FROM DOCS WHERE ID>" + QString::number(before)).size(), 1);
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
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(u"MAILIN/first.pdf"_s), &d));
    QVERIFY(AddDocToListByAddIn(f.ArchiveFile(kLetter), &d));

    const QVariant first = DocRow(u"MAILIN/first.pdf"_s)["ID"];
    QVERIFY(first != DocRow(kLetter)["ID"]);
    QCOMPARE(Memos(first).size(), 4);
    QCOMPARE(Memos(DocRow(kLetter)["ID"]).size(), 4);
    QVERIFY(f.Ui().Texts().isEmpty());
}

// The test runs in the en_US locale (set by CMake): short date M/d/yy, long time
// h:mm:ss AP, and no time zone in the stamp.
void TestDocsRow::remarkHistory() {
    TestEnv env;
    SetMyUserName(u"דנה כהן"_s);
    SetClock([] { return QDateTime(QDate(2026, 3, 1), QTime(21, 30)); });
    QCOMPARE(AppendRemark(u"first"_s, u"נשלח ללקוח"_s),
             "first\r\n" + QString(60, '-') + "\r\n3/1/26 9:30:00 PM (דנה כהן) -- נשלח ללקוח");
}

QTEST_MAIN(TestDocsRow)
#include "test_docs_row.moc"

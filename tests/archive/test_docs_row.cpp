// The DOCS row of a filed document and its UMEMO reminders, on the file databases or, in
// the server build of this program, on PostgreSQL.
#include <QtTest>

#include "archive/date_values.h"
#include "archive/docs_row.h"
#include "archive/memo.h"
#include "archive/next_doc_id.h"
#include "archive/remark.h"
#include "archive_install.h"
#include "data/database.h"
#include "data/recordset.h"
#include "data/values.h"
#include "sample_install/test_server.h"
#include "scripted_ui.h"
#include "util/clock.h"
#include "util/state.h"

using namespace zv;

namespace {

constexpr bool kServer = ZV_ARCHIVE_ON_SERVER;

const QDateTime kNow(QDate(2026, 12, 6), QTime(21, 15, 42));
const QString kLetter = QStringLiteral("DOCS/DOCBASIC/מכתבים/letter.docx");

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

// "\DOCS\...\name" as the suite stores a path below MainPath.
QString Stored(const QString& relPath) {
    return QLatin1Char('\\') + QString(relPath).replace(QLatin1Char('/'), QLatin1Char('\\'));
}

QList<QVariantMap> DocRows(const test::ArchiveInstall& in, const QString& relPath) {
    return in.Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT * FROM DOCS WHERE FULLNAME='") +
                                                FixQuote(Stored(relPath)) + QLatin1Char('\''));
}

QVariantMap DocRow(const test::ArchiveInstall& in, const QString& relPath) {
    const auto rows = DocRows(in, relPath);
    return rows.size() == 1 ? rows.front() : QVariantMap();
}

QList<QVariantMap> Memos(const test::ArchiveInstall& in, const QVariant& id) {
    return in.Rows(QStringLiteral("BM"), QStringLiteral("SELECT * FROM UMEMO WHERE ID=") +
                                             id.toString() + QStringLiteral(" ORDER BY MemoNum"));
}

// "handler/MTYPE/RTYPE" of each reminder row, in the order written.
QStringList MemoKinds(const QList<QVariantMap>& memos) {
    QStringList out;
    for (const auto& m : memos) {
        out << Text(m[QStringLiteral("METAPEL")]) + QLatin1Char('/') +
                   Text(m[QStringLiteral("MTYPE")]) + QLatin1Char('/') +
                   Text(m[QStringLiteral("RTYPE")]);
    }
    return out;
}

qint64 MaxDocId(const test::ArchiveInstall& in) {
    const auto rows =
        in.Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT max(ID) AS M FROM DOCS"));
    return rows.front()[QStringLiteral("M")].toLongLong();
}

}  // namespace

class TestDocsRow : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void newRow_data();
    void newRow();
    void refiling_data();
    void refiling();
    void reminderColumns_data();
    void reminderColumns();
    void memoRows_data();
    void memoRows();
    void untickRemovesOnlyOwnReminders();
    void idReadingZeroIsReported();
    void onlyDocumentRowsHaveReminders();
    void missingFileWritesNothing();
    void failedColumnIsReportedAndRowSaved();
    void failedReminderColumnIsReported();
    void identifiers();
    void otherDuplicateEndsSilently();
    void backEndsChosenApart_data();
    void backEndsChosenApart();

  private:
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestDocsRow::initTestCase() {
    if (kServer) {
        const SampleOptions options = TestServerOptions();
        ZV_REQUIRE_TEST_SERVER(options);
    }
}

void TestDocsRow::init() {
    ui_ = std::make_unique<test::ScopedScriptedUi>();
}

void TestDocsRow::cleanup() {
    ui_.reset();
    SetClock({});
}

void TestDocsRow::newRow_data() {
    QTest::addColumn<bool>("loaded");
    QTest::newRow("dialog loaded") << true;
    QTest::newRow("no dialog") << false;
}

void TestDocsRow::newRow() {
    QFETCH(bool, loaded);
    test::ArchiveInstall in(kServer, kServer);
    SetClock([] { return kNow; });
    const qint64 maxBefore = MaxDocId(in);
    const QString path = in.MakeFile(kLetter);
    const DocDetails details = FullDetails();

    QVERIFY(AddDocToListByAddIn(path, loaded ? &details : nullptr));

    QVERIFY((*ui_)->Texts().isEmpty());
    const QVariantMap row = DocRow(in, kLetter);
    QVERIFY(!row.isEmpty());
    QCOMPARE(row[QStringLiteral("ID")].toLongLong(), maxBefore + 1);
    const QString user = MyUserName();
    QMap<QString, QString> expected{
        {"FULLNAME", QStringLiteral("\\DOCS\\DOCBASIC\\מכתבים\\letter.docx")},
        {"SHORTNAME", QStringLiteral("letter.docx")},
        {"DIRPATH", QStringLiteral("\\DOCS\\DOCBASIC\\מכתבים\\")},
        {"DIRMONE", "0"},
        {"SOURCE", "9"},
    };
    if (loaded) {
        expected.insert({
            {"ISMEMO", "0"},
            {"DATECREATED", "2026-11-30 00:00:00"},
            {"METAPEL", details.handlers},
            {"TEUR", details.description},
            {"SECTEUR", details.moreDescription},
            {"MEMODATE", "2026-12-20 00:00:00"},
            {"MEMOHOUR", "09:30"},
            {"ISJUMPMEMO", "1"},
            {"RECIEVEDATE", "2026-12-01 00:00:00"},
            {"LASTMODIFICATIONTIME", "2026-12-06 21:15:42"},
            {"LASTMODIFICATIONUSER", user},
            {"BODY", RemarkStamp(kNow, user) + QStringLiteral(" -- ") + details.remark},
            {"PARTOF", "3"},
            {"STATUS", "4"},
            {"CLIENT_NUM", "1001"},
            {"SUG", "N"},
            {"IDTIK", "7"},
            {"TIK", "55"},
            {"NUM", "C-9"},
        });
    } else {
        expected.insert({
            {"ISMEMO", "1"},
            {"METAPEL", user},
            {"TEUR", ""},
            {"SECTEUR", ""},
            {"MEMODATE", "<null>"},
            {"MEMOHOUR", "<null>"},
            {"RECIEVEDATE", "<null>"},
            {"LASTMODIFICATIONTIME", "<null>"},
            {"BODY", "<null>"},
            {"PARTOF", "0"},
            {"STATUS", "2"},
            {"CLIENT_NUM", "<null>"},
            {"SUG", "<null>"},
            {"TIK", "<null>"},
            {"NUM", "<null>"},
        });
        // Without a dialog the creation time is the file's own.
        const QDateTime created = StoredDateTime(row[QStringLiteral("DATECREATED")]);
        QVERIFY2(qAbs(created.secsTo(QDateTime::currentDateTime())) < 120,
                 qPrintable(Text(row[QStringLiteral("DATECREATED")])));
    }
    for (auto it = expected.cbegin(); it != expected.cend(); ++it) {
        QVERIFY2(row.contains(it.key()), qPrintable(it.key()));
        QCOMPARE(Text(row[it.key()]), it.value());
    }
    const auto memos = Memos(in, row[QStringLiteral("ID")]);
    QCOMPARE(memos.size(), loaded ? 4 : 0);
}

void TestDocsRow::refiling_data() {
    QTest::addColumn<QString>("relPath");
    QTest::newRow("plain name") << kLetter;
    QTest::newRow("apostrophe") << QStringLiteral("DOCS/DOCBASIC/חוזים/O'Brien's deal.pdf");
}

// Filing to a path that has a row updates it: one row, its ID kept, the remarks kept in
// order under lines of dashes; a remark of blanks adds nothing.
void TestDocsRow::refiling() {
    QFETCH(QString, relPath);
    test::ArchiveInstall in(kServer, kServer);
    const QString path = in.MakeFile(relPath);
    DocDetails d = FullDetails();
    const QDateTime first(QDate(2026, 12, 6), QTime(9, 0, 1));
    const QDateTime second(QDate(2026, 12, 7), QTime(17, 30, 2));

    SetClock([&] { return first; });
    d.remark = QStringLiteral("ראשון");
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QVariant id = DocRow(in, relPath)[QStringLiteral("ID")];
    SetClock([&] { return second; });
    d.remark = QStringLiteral("שני");
    d.description = QStringLiteral("תיאור חדש");
    QVERIFY(AddDocToListByAddIn(path, &d));
    d.remark = QStringLiteral("   ");
    QVERIFY(AddDocToListByAddIn(path, &d));

    QVERIFY((*ui_)->Texts().isEmpty());
    const auto rows = DocRows(in, relPath);
    QCOMPARE(rows.size(), 1);
    const QVariantMap& row = rows.front();
    QCOMPARE(row[QStringLiteral("ID")], id);
    QCOMPARE(row[QStringLiteral("FULLNAME")].toString(), Stored(relPath));
    QCOMPARE(row[QStringLiteral("TEUR")].toString(), d.description);
    const QString user = MyUserName();
    QCOMPARE(row[QStringLiteral("BODY")].toString(),
             RemarkStamp(first, user) + QStringLiteral(" -- ראשון\r\n") +
                 QString(60, QLatin1Char('-')) + QStringLiteral("\r\n") +
                 RemarkStamp(second, user) + QStringLiteral(" -- שני"));
}

void TestDocsRow::reminderColumns_data() {
    QTest::addColumn<bool>("reminder");
    QTest::addColumn<QDate>("date");
    QTest::addColumn<QString>("time");
    QTest::addColumn<bool>("popup");
    QTest::addColumn<QStringList>("expected");  // IsMemo, MemoDate, MemoHour, IsJumpMemo
    QTest::addColumn<int>("memoRows");

    const QDate day(2026, 12, 20);
    const QString midnight = QStringLiteral("2026-12-20 00:00:00");
    QTest::newRow("off") << false << day << QStringLiteral("10:00") << true
                         << QStringList{"1", "<null>", "<null>", "0"} << 0;
    QTest::newRow("on") << true << day << QStringLiteral("10:00") << false
                        << QStringList{"0", midnight, "10:00", "0"} << 1;
    QTest::newRow("empty time is 08:00")
        << true << day << QString() << false << QStringList{"0", midnight, "08:00", "0"} << 1;
    QTest::newRow("empty time mask is 08:00") << true << day << QStringLiteral("__:__") << true
                                              << QStringList{"0", midnight, "08:00", "1"} << 2;
    QTest::newRow("one-digit hour") << true << day << QStringLiteral("7:05") << false
                                    << QStringList{"0", midnight, "07:05", "0"} << 1;
    QTest::newRow("empty date box is the zero date")
        << true << QDate() << QStringLiteral("10:00") << true
        << QStringList{"0", "1899-12-30 00:00:00", "10:00", "1"} << 0;
}

void TestDocsRow::reminderColumns() {
    QFETCH(bool, reminder);
    QFETCH(QDate, date);
    QFETCH(QString, time);
    QFETCH(bool, popup);
    QFETCH(QStringList, expected);
    QFETCH(int, memoRows);
    test::ArchiveInstall in(kServer, kServer);
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("דנה כהן");
    d.reminder = reminder;
    d.reminderDate = date;
    d.reminderTime = time;
    d.popup = popup;

    QVERIFY(AddDocToListByAddIn(in.MakeFile(kLetter), &d));

    const QVariantMap row = DocRow(in, kLetter);
    const QStringList got{
        Text(row[QStringLiteral("ISMEMO")]), Text(row[QStringLiteral("MEMODATE")]),
        Text(row[QStringLiteral("MEMOHOUR")]), Text(row[QStringLiteral("ISJUMPMEMO")])};
    QCOMPARE(got, expected);
    QCOMPARE(Memos(in, row[QStringLiteral("ID")]).size(), memoRows);
    QVERIFY((*ui_)->Texts().isEmpty());
}

void TestDocsRow::memoRows_data() {
    QTest::addColumn<QString>("handlers");
    QTest::addColumn<bool>("popup");
    QTest::addColumn<QString>("time");
    QTest::addColumn<QStringList>("expected");
    QTest::addColumn<QDateTime>("moment");

    const QDateTime at(QDate(2026, 12, 20), QTime(9, 30));
    QTest::newRow("two handlers, pop-up first")
        << QStringLiteral("A;B") << true << QStringLiteral("09:30")
        << QStringList{"A/31/2", "B/31/2", "A/32/3", "B/32/3"} << at;
    QTest::newRow("regular only") << QStringLiteral("A;B") << false << QStringLiteral("09:30")
                                  << QStringList{"A/32/3", "B/32/3"} << at;
    QTest::newRow("trailing separator gives an empty handler")
        << QStringLiteral("A;") << true << QStringLiteral("09:30")
        << QStringList{"A/31/2", "/31/2", "A/32/3", "/32/3"} << at;
    QTest::newRow("a handler twice is written once")
        << QStringLiteral("A;A;B") << true << QStringLiteral("09:30")
        << QStringList{"A/31/2", "B/31/2", "A/32/3", "B/32/3"} << at;
    QTest::newRow("no handlers, no rows")
        << QString() << true << QStringLiteral("09:30") << QStringList{} << at;
    QTest::newRow("24:30 is the next day")
        << QStringLiteral("A") << false << QStringLiteral("24:30") << QStringList{"A/32/3"}
        << QDateTime(QDate(2026, 12, 21), QTime(0, 30));
}

void TestDocsRow::memoRows() {
    QFETCH(QString, handlers);
    QFETCH(bool, popup);
    QFETCH(QString, time);
    QFETCH(QStringList, expected);
    QFETCH(QDateTime, moment);
    test::ArchiveInstall in(kServer, kServer);
    SetClock([] { return kNow; });
    DocDetails d = FullDetails();
    d.handlers = handlers;
    d.popup = popup;
    d.reminderTime = time;

    QVERIFY(AddDocToListByAddIn(in.MakeFile(kLetter), &d));

    QVERIFY((*ui_)->Texts().isEmpty());
    const QVariant id = DocRow(in, kLetter)[QStringLiteral("ID")];
    QVERIFY(id.toLongLong() > 0);
    const auto memos = Memos(in, id);
    QCOMPARE(MemoKinds(memos), expected);
    for (const auto& m : memos) {
        QCOMPARE(m[QStringLiteral("USER97")].toString(), MyUser());
        QCOMPARE(Text(m[QStringLiteral("MEMOTIME")]), Text(moment));
        QCOMPARE(Text(m[QStringLiteral("DATEUPDATED")]), Text(kNow));
    }
}

// Refiling without a reminder removes the document's pop-up and regular reminders; other
// kinds of reminder and other documents' reminders stay.
void TestDocsRow::untickRemovesOnlyOwnReminders() {
    test::ArchiveInstall in(kServer, kServer);
    const QString path = in.MakeFile(kLetter);
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("A");
    QVERIFY(AddDocToListByAddIn(path, &d));
    const QString id = DocRow(in, kLetter)[QStringLiteral("ID")].toString();
    const QString insert = QStringLiteral(
        "INSERT INTO UMEMO (USER97, METAPEL, MTYPE, RTYPE, ID) VALUES ('1', 'A', %1, 2, %2)");
    in.Execute(QStringLiteral("BM"), insert.arg(QStringLiteral("7"), id));
    in.Execute(QStringLiteral("BM"), insert.arg(QStringLiteral("31"), QStringLiteral("99999")));
    QCOMPARE(MemoKinds(Memos(in, id)), (QStringList{"A/31/2", "A/32/3", "A/7/2"}));

    d.reminder = false;
    QVERIFY(AddDocToListByAddIn(path, &d));

    QCOMPARE(MemoKinds(Memos(in, id)), QStringList{"A/7/2"});
    QCOMPARE(MemoKinds(Memos(in, 99999)), QStringList{"A/31/2"});
    QCOMPARE(Text(DocRow(in, kLetter)[QStringLiteral("ISMEMO")]), QStringLiteral("1"));
    QVERIFY((*ui_)->Texts().isEmpty());
}

void TestDocsRow::idReadingZeroIsReported() {
    test::ArchiveInstall in(kServer, kServer);
    in.Execute(QStringLiteral("MDOCS"),
               QStringLiteral("INSERT INTO DOCS (ID, FULLNAME, IsMemo, IsJumpMemo, MemoDate, "
                              "MemoHour, Metapel) VALUES (0, '\\zero.doc', 0, 1, "
                              "'2026-12-20 00:00:00', '09:00', 'A')"));
    auto db = Database::Open(QStringLiteral("MDOCS"), IsDocs());
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE FULLNAME='\\zero.doc'"));

    CheckMemo(QStringLiteral("DOCS"), rs.get());

    QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("בעיה בקוד זיהוי בטבלה : DOCS")});
    QCOMPARE((*ui_)->Messages().front().style, int(vbExclamation | vbOKOnly));
    QVERIFY(Memos(in, 0).isEmpty());
}

void TestDocsRow::onlyDocumentRowsHaveReminders() {
    test::ArchiveInstall in(kServer, kServer);
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("A");
    d.popup = false;
    QVERIFY(AddDocToListByAddIn(in.MakeFile(kLetter), &d));
    const QString id = DocRow(in, kLetter)[QStringLiteral("ID")].toString();
    auto db = Database::Open(QStringLiteral("MDOCS"), IsDocs());
    auto rs = db->OpenRecordset(QStringLiteral("SELECT * FROM DOCS WHERE ID=") + id);
    in.Execute(QStringLiteral("BM"), QStringLiteral("DELETE FROM UMEMO"));

    CheckMemo(QStringLiteral("Docs2"), rs.get());
    QVERIFY(Memos(in, id).isEmpty());
    CheckMemo(QStringLiteral("docs"), rs.get());
    QCOMPARE(MemoKinds(Memos(in, id)), QStringList{"A/32/3"});
    QVERIFY((*ui_)->Texts().isEmpty());
}

void TestDocsRow::missingFileWritesNothing() {
    test::ArchiveInstall in(kServer, kServer);
    const qint64 before = MaxDocId(in);
    const DocDetails d = FullDetails();
    QVERIFY(!AddDocToListByAddIn(in.MainDir() + QStringLiteral("/DOCS/MAILIN/gone.pdf"), &d));
    QCOMPARE(MaxDocId(in), before);
    QVERIFY((*ui_)->Texts().isEmpty());
}

// A column the table lacks is reported with the path; the rest of the row is saved.
void TestDocsRow::failedColumnIsReportedAndRowSaved() {
    test::ArchiveInstall in(kServer, kServer);
    in.Execute(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE DOCS DROP COLUMN SecTeur"));
    const QString path = in.MakeFile(kLetter);
    const DocDetails d = FullDetails();

    QVERIFY(AddDocToListByAddIn(path, &d));

    QCOMPARE((*ui_)->Texts(),
             QStringList{QStringLiteral("3265-0-AddDocToListByAddIn-Item not found in this "
                                        "collection. (SecTeur)\r\n") +
                         path});
    QCOMPARE((*ui_)->Messages().front().style, int(vbOKOnly));
    const QVariantMap row = DocRow(in, kLetter);
    QCOMPARE(row[QStringLiteral("TEUR")].toString(), d.description);
    QCOMPARE(row[QStringLiteral("NUM")].toString(), d.caseCode);
    QCOMPARE(Memos(in, row[QStringLiteral("ID")]).size(), 4);
}

void TestDocsRow::failedReminderColumnIsReported() {
    test::ArchiveInstall in(kServer, kServer);
    in.Execute(QStringLiteral("BM"), QStringLiteral("ALTER TABLE UMEMO DROP COLUMN DateUpdated"));
    DocDetails d = FullDetails();
    d.handlers = QStringLiteral("A");
    d.popup = false;

    QVERIFY(AddDocToListByAddIn(in.MakeFile(kLetter), &d));

    const QString id = DocRow(in, kLetter)[QStringLiteral("ID")].toString();
    QCOMPARE((*ui_)->Texts(),
             QStringList{QStringLiteral(" 3265-CheckMemo-\r\nDOCS-") + id +
                         QStringLiteral("\r\nItem not found in this collection. (DateUpdated)")});
    QCOMPARE(MemoKinds(Memos(in, id)), QStringList{"A/32/3"});
}

// The file databases number documents max + 1 (1 in an empty table), also for a row whose
// ID was never set; on the server the server numbers them and the add-in asks for nothing.
void TestDocsRow::identifiers() {
    test::ArchiveInstall in(kServer, kServer);
    in.Execute(QStringLiteral("MDOCS"), QStringLiteral("DELETE FROM DOCS"));
    QCOMPARE(GetNextIdDOCS(), kServer ? 0 : 1);
    const DocDetails d = FullDetails();
    QVERIFY(AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/MAILIN/a.pdf")), &d));
    QVERIFY(AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/MAILIN/b.pdf")), &d));
    const qint64 a =
        DocRow(in, QStringLiteral("DOCS/MAILIN/a.pdf"))[QStringLiteral("ID")].toLongLong();
    const qint64 b =
        DocRow(in, QStringLiteral("DOCS/MAILIN/b.pdf"))[QStringLiteral("ID")].toLongLong();
    QVERIFY(a > 0);
    QCOMPARE(b, a + 1);
    if (!kServer) {
        QCOMPARE(a, 1);
        in.Execute(QStringLiteral("MDOCS"),
                   QStringLiteral("INSERT INTO DOCS (FULLNAME) VALUES ('\\DOCS\\MAILIN\\c.pdf')"));
        QVERIFY(AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/MAILIN/c.pdf")), &d));
        QCOMPARE(DocRow(in, QStringLiteral("DOCS/MAILIN/c.pdf"))[QStringLiteral("ID")].toLongLong(),
                 3);
        QCOMPARE(GetNextIdDOCS(), 4);
    }
    QCOMPARE(Memos(in, b).size(), 4);
    QVERIFY((*ui_)->Texts().isEmpty());
}

// A duplicate in an index other than ID is no identifier race: the filing ends silently,
// reports that nothing was saved, and takes no second identifier.
void TestDocsRow::otherDuplicateEndsSilently() {
    test::ArchiveInstall in(kServer, kServer);
    in.Execute(QStringLiteral("MDOCS"),
               QStringLiteral("CREATE UNIQUE INDEX DOCS_SHORTNAME ON DOCS (ShortName)"));
    const qint64 before = MaxDocId(in);
    const DocDetails d = FullDetails();
    QVERIFY(AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/MAILIN/same.pdf")), &d));
    QVERIFY(!AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/DOCBASIC/same.pdf")), &d));

    QVERIFY((*ui_)->Texts().isEmpty());
    QCOMPARE(DocRows(in, QStringLiteral("DOCS/DOCBASIC/same.pdf")).size(), 0);
    const auto all =
        in.Rows(QStringLiteral("MDOCS"),
                QStringLiteral("SELECT ID FROM DOCS WHERE ID>") + QString::number(before));
    QCOMPARE(all.size(), 1);
    if (!kServer) {
        QCOMPARE(GetNextIdDOCS(), before + 2);
    }
}

void TestDocsRow::backEndsChosenApart_data() {
    QTest::addColumn<bool>("docsOnServer");
    QTest::addColumn<bool>("bmOnServer");
    QTest::newRow("documents here, reminders there") << !kServer << kServer;
    QTest::newRow("documents there, reminders here") << kServer << !kServer;
}

// The two flags choose independently; the reminders carry the document's own ID.
void TestDocsRow::backEndsChosenApart() {
    QFETCH(bool, docsOnServer);
    QFETCH(bool, bmOnServer);
    if (!kServer) {
        QSKIP("mixed back-ends need the server; the server build runs them");
    }
    test::ArchiveInstall in(docsOnServer, bmOnServer);
    const DocDetails d = FullDetails();
    QVERIFY(AddDocToListByAddIn(in.MakeFile(QStringLiteral("DOCS/MAILIN/first.pdf")), &d));
    QVERIFY(AddDocToListByAddIn(in.MakeFile(kLetter), &d));

    const QVariant id = DocRow(in, kLetter)[QStringLiteral("ID")];
    QCOMPARE(MemoKinds(Memos(in, id)).size(), 4);
    const QVariant firstId =
        DocRow(in, QStringLiteral("DOCS/MAILIN/first.pdf"))[QStringLiteral("ID")];
    QVERIFY(firstId != id);
    QCOMPARE(MemoKinds(Memos(in, firstId)).size(), 4);
    QVERIFY((*ui_)->Texts().isEmpty());
}

QTEST_MAIN(TestDocsRow)
#include "test_docs_row.moc"

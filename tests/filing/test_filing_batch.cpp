// Filing without a window: the batch options and the pipeline's own rules in process, then the
// built program run with --batch as a script runs it, on a fresh sample installation per case: the
// file, the rows, standard output and exit status.
#include <QFile>
#include <QtTest>

#include "filing/filing_request.h"
#include "filing_fixture.h"
#include "startup/command_line.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;
using namespace Qt::Literals::StringLiterals;

namespace {

const QString kDoc = u"DOC1001/מכתב א"_s;  // the suggested name "מכתב: א", cleaned

// Files source as the confirmed dialog would, to DOC1001/מסמך with typed in the name box.
QString FileInto(
    const FilingFixture& f, int mode, const QString& source, const QString& typed,
    const ClashResolver& resolve = [](const Clash&) { return std::nullopt; }) {
    SetSourceExt(ExtensionOf(source));
    FilingAnswer answer{f.Docs() + u"/DOC1001/מסמך"_s, typed, {}};
    return FileDocument(mode, source, u"מסמך"_s, answer, resolve);
}

// One run of the program: mode, source, options (split at "|"), files in DOCS beforehand,
// exit status, then the path below DOCS and SUG of the filed document, or the message of one
// not filed (%D: DOCS).
struct Run {
    int mode;
    QString source, options;
    QStringList existing;
    int status;
    QString result, sug{};
};

}  // namespace

Q_DECLARE_METATYPE(Run)

class TestFilingBatch : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void extension();
    void options();
    void mailNameStaysInFolder();
    void unsavedRowKeepsReplacedFile();
    void failedCopyKeepsEarlierFile();
    void batch_data();
    void batch();
    void everyDetail();
};

// A dot in a folder name is no extension.
void TestFilingBatch::extension() {
    const std::pair<QString, QString> cases[] = {{u"/in/letter.final.DOCX"_s, u"DOCX"_s},
                                                 {u"/in/v1.2/README"_s, {}},
                                                 {u"C:\\in.x\\mail.eml"_s, u"eml"_s},
                                                 {u"/in/x."_s, {}}};
    for (const auto& [path, ext] : cases) {
        QVERIFY2(ExtensionOf(path) == ext, qPrintable(path));
    }
}

void TestFilingBatch::options() {
    using L = QList<QByteArray>;
    const QByteArray req = "1\xC2\xA5/in/x.doc\xC2\xA5x";
    const CommandLine good = ParseCommandLine({"--batch", "--client=1001", req});
    QCOMPARE(good.error, QString());
    QCOMPARE(good.filing.client, u"1001"_s);
    QCOMPARE(good.request, req);
    QCOMPARE(ParseCommandLine({"--client", "1", req}).error, u"the filing options need --batch"_s);
    QCOMPARE(ParseCommandLine({"--batch", "--client"}).error, u"--client needs a value"_s);
    const std::pair<L, QString> refused[] = {
        {{"--created", "31-02-2026"}, u"not a date DD-MM-YYYY: 31-02-2026"_s},
        {{"--reminder", "01-01-2027"}, u"not a reminder \"DD-MM-YYYY HH:MM\": 01-01-2027"_s},
        {{"--popup"}, u"--popup needs --reminder"_s},
        {{"--name", "a", "--number"}, u"--name and --number exclude each other"_s},
        {{"--origin", "x"}, u"not a number: x"_s},
        {{"--on-clash", "rename"}, u"--on-clash takes skip or overwrite, not: rename"_s}};
    for (const auto& [args, error] : refused) {
        QCOMPARE(ParseCommandLine(L{"--batch", "--client", "1"} + args + L{req}).error, error);
    }
}

// The typed name of a mail becomes its file name, cleaned: it cannot lead out of the folder.
void TestFilingBatch::mailNameStaysInFolder() {
    FilingFixture f;
    const std::pair<QString, QString> cases[] = {
        {u"..\\..\\יציאה"_s, u"....יציאה.msg"_s},
        {u"/a\\b:c*d?e\"f<g>h|i. 2"_s, u"abcdefghi. 2.msg"_s}};
    for (const auto& [typed, fileName] : cases) {
        const QString archived = FileInto(f, 2, f.Source(u"m.msg"_s, "mail"), typed);
        QCOMPARE(archived, f.Docs() + u"/DOC1001/"_s + fileName);
        QCOMPARE(Content(archived), QByteArray("mail"));
    }
    QCOMPARE(f.DocsRows().size(), 2);
}

// A file replaced by the copy is not removed when the row cannot be saved: the earlier row
// of that path may still describe it.
void TestFilingBatch::unsavedRowKeepsReplacedFile() {
    FilingFixture f;
    const QString source = f.Source(u"x.pdf"_s, "new");
    const QString existing = f.ArchiveFile(u"DOC1001/מסמך.pdf"_s, "old");
    Execute(u"MDOCS"_s, u"ALTER TABLE DOCS RENAME TO DOCS_AWAY"_s);
    QCOMPARE(FileInto(f, 1, source, {}, [](const Clash& c) { return c.proposed; }), QString());
    QCOMPARE(Content(existing), QByteArray("new"));
    QCOMPARE(Content(source), QByteArray("new"));
}

// A copy that fails leaves the file it was to replace as it was, and nothing beside it.
void TestFilingBatch::failedCopyKeepsEarlierFile() {
    FilingFixture f;
    const QString existing = f.ArchiveFile(u"DOC1001/מסמך.pdf"_s, "old");
    const QString source = f.Source(u"x.pdf"_s);
    QVERIFY(QFile::remove(source));
    QCOMPARE(FileInto(f, 1, source, {}, [](const Clash& c) { return c.proposed; }), QString());
    QCOMPARE(Content(existing), QByteArray("old"));
    QCOMPARE(FolderEntries(f.Docs() + u"/DOC1001"_s), QStringList{u"מסמך.pdf"_s});
    QVERIFY(f.DocsRows().isEmpty());
}

void TestFilingBatch::batch_data() {
    QTest::addColumn<Run>("r");
    const QString pdf = kDoc + ".pdf";
    QTest::newRow("client") << Run{1, "a.docx", "--client|1001", {}, 0, kDoc + ".docx", "F"};
    QTest::newRow("case") << Run{
        1, "a.pdf", "--client|1001|--case|2", {}, 0, "DOC1001/W/2/מכתב א.pdf", "W"};
    QTest::newRow("inner folder") << Run{
        1, "a.pdf", "--client|1002|--inner-folder|חוזים", {}, 0, "DOC1002/חוזים/מכתב א.pdf", "F"};
    QTest::newRow("numbering") << Run{
        1, "a.doc", "--client|1001|--number", {"DOC1001/T4.pdf"}, 0, "DOC1001/T5.doc", "F"};
    QTest::newRow("own name") << Run{
        1, "a.doc", "--client|1001|--name|דוח שנתי", {}, 0, "DOC1001/דוח שנתי.doc", "F"};
    QTest::newRow("clash overwritten")
        << Run{1, "a.pdf", "--client|1001|--on-clash|overwrite", {pdf}, 0, pdf, "F"};
    QTest::newRow("mail") << Run{2, "m.eml", "--client|1001", {}, 0, kDoc + ".msg.eml", "F"};
    QTest::newRow("unknown client")
        << Run{1, "a.pdf", "--client|9999", {}, 1, "לא נמצא לקוח מספר 9999"};
    QTest::newRow("another client's case") << Run{
        1, "a.pdf", "--client|1006|--case|2", {}, 1, "לא נמצא תיק מספר 2 בתיקי לקוח מספר 1006"};
    QTest::newRow("unknown inner folder") << Run{1,  "a.pdf", "--client|1001|--inner-folder|אין",
                                                 {}, 1,       "לא נמצאה ספריה פנימית בשם אין"};
    QTest::newRow("unknown origin")
        << Run{1, "a.pdf", "--client|1001|--origin|99", {}, 1, "לא נמצא מקור מסמך בקוד 99"};
    QTest::newRow("unknown status")
        << Run{1, "a.pdf", "--client|1001|--status|9", {}, 1, "לא נמצא סטטוס בקוד 9"};
    QTest::newRow("forbidden name")
        << Run{1,  "a.pdf", "--client|1001|--name|../x",
               {}, 1,       "אסור לקלוט כחלק משם קובץ את התווים הבאים : "};
    QTest::newRow("empty name") << Run{2,  "m.msg", "--client|1001|--name|",
                                       {}, 1,       "יש לקבוע שם לקובץ הנשמר"};
    QTest::newRow("clash left alone") << Run{
        1, "a.pdf", "--client|1001", {pdf}, 1, "קיים קובץ בשם זה, המסמך לא תויק :\n%D/" + pdf};
    // Names that differ only in case are one file to the suite's tables.
    QTest::newRow("clash in another case left alone") << Run{
        1, "a.pdf", "--client|1001", {kDoc + ".PDF"}, 1, "המסמך לא תויק :\n%D/" + kDoc + ".PDF"};
    QTest::newRow("clash in another case overwritten") << Run{
        1, "a.pdf", "--client|1001|--on-clash|overwrite", {kDoc + ".PDF"}, 0, kDoc + ".PDF", "F"};
    // The copy is written, then cannot take the name: its partial file goes too.
    QTest::newRow("folder where the file should be")
        << Run{1, "a.pdf", "--client|1001", {pdf + "/"}, 1, "75-0-WorkWithStr-"};
    QTest::newRow("usage error") << Run{1, "a.pdf", "--case|2", {}, 2, "--batch needs --client"};
}

void TestFilingBatch::batch() {
    QFETCH(Run, r);
    FilingFixture f;
    const QString source = f.Source(r.source, "new");
    for (const QString& rel : r.existing) {
        if (rel.endsWith('/')) {
            QVERIFY(QDir().mkpath(f.Docs() + '/' + rel));
        } else {
            f.ArchiveFile(rel, "old, longer");
        }
    }
    const QStringList before = FolderEntries(f.Docs() + u"/DOC1001"_s);

    const ProcessResult p = f.RunBatch(r.options.split('|'), r.mode, source, u"מכתב: א"_s);

    QCOMPARE(p.status, r.status);
    const auto rows = f.DocsRows();
    if (r.status == 0) {
        const QString archived = f.Docs() + '/' + r.result;
        QCOMPARE(p.out, archived + '\n');
        QVERIFY2(p.err.contains(u"הקובץ נשמר לכתובת המבוקשת"_s), qPrintable(p.err));
        QCOMPARE(Content(archived), QByteArray("new"));
        QVERIFY(!QFile::exists(source));
        QCOMPARE(rows.size(), 1);
        QCOMPARE(rows.first()["FULLNAME"].toString(), FullName(r.result));
        QCOMPARE(rows.first()["SUG"].toString(), r.sug);
        QCOMPARE(rows.first()["PARTOF"].toInt(), r.mode == 1 ? 2 : 1);
        return;
    }
    QCOMPARE(p.out, QString());
    // The console writes a message's line breaks as new lines.
    QVERIFY2(p.err.contains(r.result.replace(u"%D"_s, f.Docs())), qPrintable(p.err));
    QVERIFY(!p.err.contains(u"הקובץ נשמר"_s));
    QCOMPARE(Content(source), QByteArray("new"));
    QCOMPARE(FolderEntries(f.Docs() + u"/DOC1001"_s), before);
    for (const QString& rel : r.existing) {
        if (!rel.endsWith('/')) {
            QCOMPARE(Content(f.Docs() + '/' + rel), QByteArray("old, longer"));
        }
    }
    QVERIFY(rows.isEmpty());
}

// Every option reaches the row and the reminders as the dialog's fields would.
void TestFilingBatch::everyDetail() {
    FilingFixture f;
    const QStringList options =
        u"--client|1001|--case|4|--description|חוזה|--more-description|נספח|--remark|נחתם היום|"
        "--origin|3|--status|1|--handlers|יוסי לוי;מיכל ברק|--received|01-02-2026|"
        "--created|15-01-2026|--reminder|20-03-2026 10:30|--popup"_s.split('|');
    QCOMPARE(f.RunBatch(options, 1, f.Source(u"r.pdf"_s), u"דוח"_s).status, 0);
    const auto rows = f.DocsRows();
    QCOMPARE(rows.size(), 1);
    QVariantMap row = rows.first();
    for (const char* date : {"RECIEVEDATE", "DATECREATED", "MEMODATE"}) {
        row[date] = row[date].toDateTime().date().toString(Qt::ISODate);
    }
    const QStringList expected =
        ("FULLNAME=" + FullName(u"DOC1001/H/1001-4/דוח.pdf"_s) +
         "|SUG=H|IDTIK=2|TIK=4|NUM=1001-4|TEUR=חוזה|SECTEUR=נספח|PARTOF=3|STATUS=1|"
         "METAPEL=יוסי לוי;מיכל ברק|MEMOHOUR=10:30|RECIEVEDATE=2026-02-01|"
         "DATECREATED=2026-01-15|MEMODATE=2026-03-20")
            .split('|');
    for (const QString& column : expected) {
        const QString name = column.section('=', 0, 0);
        QCOMPARE(name + '=' + row[name].toString(), column);
    }
    QVERIFY(!row["ISMEMO"].toBool());
    QVERIFY(row["ISJUMPMEMO"].toBool());
    QVERIFY(row["BODY"].toString().endsWith(u" -- נחתם היום"_s));
    QStringList handlers;
    for (const QVariantMap& memo :
         Rows(u"BM"_s, "SELECT * FROM UMEMO WHERE ID=" + row["ID"].toString())) {
        handlers << memo["METAPEL"].toString();
    }
    handlers.sort();
    // A pop-up and a regular reminder for each handler.
    QCOMPARE(handlers, (QStringList{"יוסי לוי", "יוסי לוי", "מיכל ברק", "מיכל ברק"}));
}

QTEST_MAIN(TestFilingBatch)
#include "test_filing_batch.moc"

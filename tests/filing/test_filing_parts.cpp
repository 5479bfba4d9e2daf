// The parts of a filing request that need no window: cleaning names, the batch options, the
// copy into the archive and the pipeline's own rules on a sample installation.
#include <QDir>
#include <QFile>
#include <QtTest>

#include "filing/clean_file_name.h"
#include "filing/file_transfer.h"
#include "filing/filing_request.h"
#include "filing_fixture.h"
#include "startup/command_line.h"
#include "test_files.h"
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

using namespace zv;
using namespace zv::test;

namespace {

// Files source as the confirmed dialog would, to DOC1001/מסמך with typed in the name box.
QString FileInto(const FilingFixture& f, int mode, const QString& source, const QString& typed,
                 const ClashResolver& resolve = {}) {
    SetSourceExt(ExtensionOf(source));
    FilingAnswer answer;
    answer.fileNameToSave = f.Docs() + QStringLiteral("/DOC1001/מסמך");
    answer.nameText = typed;
    answer.details.clientNumber = QStringLiteral("1001");
    return FileDocument(
        mode, source, QStringLiteral("מסמך"), answer,
        resolve ? resolve : [](const Clash&) { return std::nullopt; });
}

}  // namespace

class TestFilingParts : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void cleanFileName_data();
    void cleanFileName();
    void extension_data();
    void extension();
    void options_data();
    void options();
    void failedCopyKeepsEarlierFile();
    void mailNameStaysInFolder_data();
    void mailNameStaysInFolder();
    void developmentRunNamesTarget();
    void unsavedRowKeepsReplacedFile();
};

void TestFilingParts::cleanFileName_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("clean");
    QTest::newRow("nothing to remove") << "מכתב ללקוח. 2"
                                       << "מכתב ללקוח. 2";
    QTest::newRow("each forbidden character") << "a/b\\c:d*e?f\"g<h>i|j"
                                              << "abcdefghij";
    QTest::newRow("path climbing") << "..\\..\\x/../y"
                                   << "....x..y";
}

void TestFilingParts::cleanFileName() {
    QFETCH(QString, text);
    QFETCH(QString, clean);
    ResetState();
    QCOMPARE(CleanFileName(text), clean);
}

void TestFilingParts::extension_data() {
    QTest::addColumn<QString>("path");
    QTest::addColumn<QString>("ext");
    QTest::newRow("document") << "/in/letter.final.DOCX"
                              << "DOCX";
    QTest::newRow("dot in a folder only") << "/in/v1.2/README"
                                          << "";
    QTest::newRow("backslashes") << "C:\\in.x\\mail.eml"
                                 << "eml";
    QTest::newRow("trailing dot") << "/in/x."
                                  << "";
}

void TestFilingParts::extension() {
    QFETCH(QString, path);
    QFETCH(QString, ext);
    QCOMPARE(ExtensionOf(path), ext);
}

void TestFilingParts::options_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<QString>("error");
    using L = QList<QByteArray>;
    const QByteArray req = "1\xC2\xA5/in/x.doc\xC2\xA5x";
    QTest::newRow("value after =") << L{"--batch", "--client=1001", req} << "";
    QTest::newRow("filing option without batch")
        << L{"--client", "1", req} << "the filing options need --batch";
    QTest::newRow("missing value") << L{"--batch", "--client"} << "--client needs a value";
    QTest::newRow("impossible date")
        << L{"--batch", "--client", "1", "--created", "31-02-2026", req}
        << "not a date DD-MM-YYYY: 31-02-2026";
    QTest::newRow("reminder without time")
        << L{"--batch", "--client", "1", "--reminder", "01-01-2027", req}
        << "not a reminder \"DD-MM-YYYY HH:MM\": 01-01-2027";
    QTest::newRow("popup without reminder")
        << L{"--batch", "--client", "1", "--popup", req} << "--popup needs --reminder";
    QTest::newRow("name and number")
        << L{"--batch", "--client", "1", "--name", "a", "--number", req}
        << "--name and --number exclude each other";
    QTest::newRow("origin not a number")
        << L{"--batch", "--client", "1", "--origin", "x", req} << "not a number: x";
    QTest::newRow("unknown clash rule")
        << L{"--batch", "--client", "1", "--on-clash", "rename", req}
        << "--on-clash takes skip or overwrite, not: rename";
}

void TestFilingParts::options() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(QString, error);
    const CommandLine cl = ParseCommandLine(args);
    QCOMPARE(cl.error, error);
    if (error.isEmpty()) {
        QCOMPARE(cl.filing.client, QStringLiteral("1001"));
        QCOMPARE(cl.request, args.last());
    }
}

void TestFilingParts::failedCopyKeepsEarlierFile() {
    QTemporaryDir dir;
    const QString target = dir.filePath(QStringLiteral("x.pdf"));
    QVERIFY(WriteFile(target, "old"));
    try {
        CopyFileOver(dir.filePath(QStringLiteral("missing.pdf")), target);
        QFAIL("a missing source was copied");
    } catch (const VbError& e) {
        QCOMPARE(e.Number(), err::FileNotFound);
    }
    QCOMPARE(Content(target), QByteArray("old"));
    QCOMPARE(FolderEntries(dir.path()), QStringList{"x.pdf"});
}

void TestFilingParts::mailNameStaysInFolder_data() {
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QString>("fileName");
    QTest::newRow("climbing out") << "..\\..\\יציאה"
                                  << "....יציאה.msg";
    QTest::newRow("absolute") << "/etc/passwd"
                              << "etcpasswd.msg";
    QTest::newRow("drive") << "C:\\x"
                           << "Cx.msg";
}

// The typed name of a mail becomes its file name; it cannot lead out of the target folder.
void TestFilingParts::mailNameStaysInFolder() {
    QFETCH(QString, typed);
    QFETCH(QString, fileName);
    FilingFixture f;
    const QString archived = FileInto(f, 2, f.Source(QStringLiteral("m.msg"), "mail"), typed);
    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/") + fileName);
    QCOMPARE(Content(archived), QByteArray("mail"));
    QCOMPARE(f.DocsRows().size(), 1);
}

void TestFilingParts::developmentRunNamesTarget() {
    FilingFixture f;
    SetIsDevelopmentRun(true);
    const QString archived = FileInto(f, 1, f.Source(QStringLiteral("x.pdf")), {});
    QCOMPARE(f.Ui().Texts(), QStringList{QStringLiteral("הקובץ נשמר לכתובת : \r\n") + archived});
}

// A file replaced by the copy is not removed when the row cannot be saved: the earlier row
// of that path may still describe it.
void TestFilingParts::unsavedRowKeepsReplacedFile() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "new");
    const QString existing = f.ArchiveFile(QStringLiteral("DOC1001/מסמך.pdf"), "old");
    f.ExecFile(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE DOCS RENAME TO DOCS_AWAY"));
    QCOMPARE(FileInto(f, 1, source, {}, [](const Clash& c) { return c.proposed; }), QString());
    QVERIFY(QFile::exists(existing));
    QCOMPARE(Content(source), QByteArray("new"));
}

QTEST_MAIN(TestFilingParts)
#include "test_filing_parts.moc"

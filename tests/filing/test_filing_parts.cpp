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
#include "util/errors.h"
#include "util/state.h"
#include "util/ui.h"

using namespace zv;
using namespace zv::test;

class TestFilingParts : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void cleanFileName_data();
    void cleanFileName();
    void extension_data();
    void extension();
    void batchOptions_data();
    void batchOptions();
    void badOptions_data();
    void badOptions();
    void copyReplaces();
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
    QTest::newRow("only forbidden characters") << "/\\:*?\"<>|"
                                               << "";
    QTest::newRow("path climbing") << "..\\..\\x/../y"
                                   << "....x..y";
    QTest::newRow("spaces kept") << "  a  "
                                 << "  a  ";
}

void TestFilingParts::cleanFileName() {
    QFETCH(QString, text);
    QFETCH(QString, clean);
    ResetState();
    QCOMPARE(CleanFileName(text), clean);
    QCOMPARE(BadFileChars(), QStringLiteral("/\\:*?\"<>|"));
}

void TestFilingParts::extension_data() {
    QTest::addColumn<QString>("path");
    QTest::addColumn<QString>("ext");
    QTest::newRow("document") << "/in/letter.final.DOCX"
                              << "DOCX";
    QTest::newRow("none") << "/in/README"
                          << "";
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

void TestFilingParts::batchOptions_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<QString>("check");  // which field the row checks
    QTest::addColumn<QString>("value");
    using L = QList<QByteArray>;
    const QByteArray req = "1\xC2\xA5/in/x.doc\xC2\xA5x";
    QTest::newRow("client") << L{"--batch", "--client", "1001", req} << "client"
                            << "1001";
    QTest::newRow("value after =") << L{"--batch", "--client=1001", req} << "client"
                                   << "1001";
    QTest::newRow("Hebrew name") << L{"--batch", "--client", "1", "--name", "מכתב ראשון", req}
                                 << "name"
                                 << "מכתב ראשון";
    QTest::newRow("received") << L{"--batch", "--client", "1", "--received", "05-02-2026", req}
                              << "received"
                              << "2026-02-05";
    QTest::newRow("reminder") << L{"--batch",         "--client", "1", "--reminder",
                                   "31-12-2026 7:05", "--popup",  req}
                              << "reminder"
                              << "2026-12-31 07:05 popup";
    QTest::newRow("overwrite") << L{"--batch", "--client", "1", "--on-clash", "overwrite", req}
                               << "clash"
                               << "overwrite";
    QTest::newRow("default clash") << L{"--batch", "--client", "1", req} << "clash"
                                   << "skip";
    QTest::newRow("status") << L{"--batch", "--client", "1", "--status", "3", req} << "status"
                            << "3";
}

void TestFilingParts::batchOptions() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(QString, check);
    QFETCH(QString, value);
    const CommandLine cl = ParseCommandLine(args);
    QCOMPARE(cl.error, QString());
    QVERIFY(cl.batch);
    QCOMPARE(cl.request, args.last());
    const FilingOptions& o = cl.filing;
    QString actual;
    if (check == QLatin1String("client")) {
        actual = o.client;
    } else if (check == QLatin1String("name")) {
        actual = o.name.value_or(QString());
    } else if (check == QLatin1String("received")) {
        actual = o.received ? o.received->toString(Qt::ISODate) : QString();
    } else if (check == QLatin1String("reminder")) {
        actual = o.reminderDate->toString(Qt::ISODate) + QLatin1Char(' ') + o.reminderTime +
                 (o.popup ? QStringLiteral(" popup") : QString());
    } else if (check == QLatin1String("clash")) {
        actual =
            o.onClash == OnClash::Overwrite ? QStringLiteral("overwrite") : QStringLiteral("skip");
    } else if (check == QLatin1String("status")) {
        actual = o.status ? QString::number(*o.status) : QString();
    }
    QCOMPARE(actual, value);
}

void TestFilingParts::badOptions_data() {
    QTest::addColumn<QList<QByteArray>>("args");
    QTest::addColumn<QString>("error");
    using L = QList<QByteArray>;
    const QByteArray req = "1\xC2\xA5/in/x.doc\xC2\xA5x";
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

void TestFilingParts::badOptions() {
    QFETCH(QList<QByteArray>, args);
    QFETCH(QString, error);
    QCOMPARE(ParseCommandLine(args).error, error);
}

void TestFilingParts::copyReplaces() {
    QTemporaryDir dir;
    const QString source = dir.filePath(QStringLiteral("a.pdf"));
    const QString target = dir.filePath(QStringLiteral("ב.pdf"));
    QFile s(source);
    QVERIFY(s.open(QIODevice::WriteOnly) && s.write("new") == 3);
    s.close();
    QFile t(target);
    QVERIFY(t.open(QIODevice::WriteOnly) && t.write("old, longer") == 11);
    t.close();
    CopyFileOver(source, target);
    QCOMPARE(Content(target), QByteArray("new"));
    QCOMPARE(Content(source), QByteArray("new"));
    QCOMPARE(FolderEntries(dir.path()), (QStringList{"a.pdf", "ב.pdf"}));
    QVERIFY(IsSameFile(source, dir.path() + QStringLiteral("/./a.pdf")));
    QVERIFY(!IsSameFile(source, target));
}

void TestFilingParts::failedCopyKeepsEarlierFile() {
    QTemporaryDir dir;
    const QString target = dir.filePath(QStringLiteral("x.pdf"));
    QFile t(target);
    QVERIFY(t.open(QIODevice::WriteOnly) && t.write("old") == 3);
    t.close();
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
    const QString source = f.Source(QStringLiteral("m.msg"), "mail");
    SetSourceExt(QStringLiteral("msg"));
    FilingAnswer answer;
    answer.fileNameToSave = f.Docs() + QStringLiteral("/DOC1001/נושא");
    answer.nameText = typed;
    answer.details.clientNumber = QStringLiteral("1001");
    const QString archived = FileDocument(2, source, QStringLiteral("נושא"), answer,
                                          [](const Clash&) { return std::nullopt; });
    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/") + fileName);
    QCOMPARE(Content(archived), QByteArray("mail"));
    QCOMPARE(f.DocsRows().size(), 1);
}

void TestFilingParts::developmentRunNamesTarget() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "x");
    SetIsDevelopmentRun(true);
    SetSourceExt(QStringLiteral("pdf"));
    FilingAnswer answer;
    answer.fileNameToSave = f.Docs() + QStringLiteral("/DOC1001/מסמך");
    const QString archived = FileDocument(1, source, QStringLiteral("מסמך"), answer,
                                          [](const Clash&) { return std::nullopt; });
    QCOMPARE(f.Ui().Texts(), QStringList{QStringLiteral("הקובץ נשמר לכתובת : \r\n") + archived});
    QCOMPARE(f.Ui().Messages().front().style, vbOKOnly | vbInformation);
}

// A file replaced by the copy is not removed when the row cannot be saved: the earlier row
// of that path may still describe it.
void TestFilingParts::unsavedRowKeepsReplacedFile() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("x.pdf"), "new");
    const QString existing = f.ArchiveFile(QStringLiteral("DOC1001/מסמך.pdf"), "old");
    f.ExecFile(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE DOCS RENAME TO DOCS_AWAY"));
    SetSourceExt(QStringLiteral("pdf"));
    FilingAnswer answer;
    answer.fileNameToSave = f.Docs() + QStringLiteral("/DOC1001/מסמך");
    const QString archived = FileDocument(1, source, QStringLiteral("מסמך"), answer,
                                          [](const Clash& c) { return c.proposed; });
    QCOMPARE(archived, QString());
    QVERIFY(QFile::exists(existing));
    QCOMPARE(Content(source), QByteArray("new"));
}

QTEST_MAIN(TestFilingParts)
#include "test_filing_parts.moc"

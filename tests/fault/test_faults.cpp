// Filings that meet a fault: the target folder, the file databases, the source and the
// settings fail in turn. A filing that cannot complete leaves the source in place, nothing
// added to the archive or its tables, and one message to the user; one that can complete
// (a garbage server login file) files the document whole.
#include <QProcess>
#include <QRandomGenerator>
#include <QtTest>
#include <memory>

#include "dialog_script.h"
#include "fault_check.h"
#include "filing_fixture.h"
#include "test_files.h"

using namespace zv;
using namespace zv::test;

namespace {

enum Fault {
    TargetImmutable,
    DocsDbMissing,
    DocsDbImmutable,
    DocsDbLocked,
    SourceDeleted,
    SourceIsFolder,
    DocsColumnMissing,
    FolderIsFile,
    SettingsGarbage,
    ServerIniGarbage,
};

// Bytes no settings reader can make sense of: random binary, NUL included, and broken INI
// lines.
QByteArray Garbage() {
    QByteArray bytes(4096, '\0');
    QRandomGenerator(8).fillRange(reinterpret_cast<quint32*>(bytes.data()), bytes.size() / 4);
    return bytes + QByteArray("\n[General\n=\nMainPath\n\r\n\0\xff[]==\n", 30);
}

}  // namespace

class TestFaults : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void withDialog_data();
    void withDialog();
    void batch_data();
    void batch();
};

void TestFaults::withDialog_data() {
    QTest::addColumn<int>("fault");
    QTest::addColumn<QString>("message");  // the message's beginning; %1 the source
    // What became of the document, then why.
    const QString notRecorded =
        QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :\r\n%1\r\n\r\n");
    // Root writes through permissions; the immutable attribute stops it.
    QTest::newRow("target folder immutable")
        << int(TargetImmutable)
        << QStringLiteral("70-0-WorkWithStr-Permission denied\r\n\r\n1\r\n%1\r\nletter");
    QTest::newRow("MDOCS.MDB missing")
        << int(DocsDbMissing)
        << notRecorded + QStringLiteral("3024-0-AddDocToListByAddIn-Could not find file");
    QTest::newRow("MDOCS.MDB immutable")
        << int(DocsDbImmutable)
        << notRecorded +
               QStringLiteral("3027-0-GUpdate-Cannot update. Database or object is read-only.");
    QTest::newRow("MDOCS.MDB locked past the busy timeout")
        << int(DocsDbLocked)
        << notRecorded +
               QStringLiteral("3260-0-AddDocToListByAddIn-Couldn't update; currently locked.");
    QTest::newRow("source deleted after the dialog")
        << int(SourceDeleted) << QStringLiteral("53-0-WorkWithStr-File not found");
    QTest::newRow("source replaced by a folder after the dialog")
        << int(SourceIsFolder) << QStringLiteral("75-0-WorkWithStr-Path/File access error");
    QTest::newRow("DOCS without the column FULLNAME")
        << int(DocsColumnMissing)
        << notRecorded + QStringLiteral("3146-0-AddDocToListByAddIn-no such column: FullName");
}

void TestFaults::withDialog() {
    QFETCH(int, fault);
    QFETCH(QString, message);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    const QString mdocs = f.DataDir() + QStringLiteral("/MDOCS.MDB");
    const QString aside = f.DataDir() + QStringLiteral("/../MDOCS.aside");
    std::unique_ptr<Unwritable> unwritable;
    if (fault == TargetImmutable) {
        QVERIFY(QDir().mkpath(f.Docs() + QStringLiteral("/DOC1001")));
        unwritable = std::make_unique<Unwritable>(f.Docs() + QStringLiteral("/DOC1001"));
        if (!unwritable->Holds()) {
            QSKIP("this file system has no immutable attribute");
        }
    } else if (fault == DocsColumnMissing) {
        f.ExecFile(QStringLiteral("MDOCS"), QStringLiteral("DROP INDEX DOCS_FULLNAME"));
        f.ExecFile(QStringLiteral("MDOCS"),
                   QStringLiteral("ALTER TABLE DOCS DROP COLUMN FULLNAME"));
    }
    const QStringList before = StateOf(f);

    // The fault strikes while the dialog is open, after it loaded.
    QProcess lock;  // a sqlite3 shell holding an exclusive lock on MDOCS.MDB
    const DialogInput in{.client = QStringLiteral("1001"),
                         .reminder = true,
                         .reminderTime = QStringLiteral("10:00"),
                         .popup = true};
    QueueFilingDialog(f.Ui(), in, [&](FrmGetDocDet&) {
        switch (fault) {
            case DocsDbMissing:
                QVERIFY(QFile::rename(mdocs, aside));
                break;
            case DocsDbImmutable:
                unwritable = std::make_unique<Unwritable>(mdocs);
                break;
            case DocsDbLocked:
                lock.start(QStringLiteral("sqlite3"), {mdocs});
                lock.write("BEGIN EXCLUSIVE;\nSELECT 'locked';\n");
                QVERIFY(lock.waitForReadyRead(10000) && lock.readAll().contains("locked"));
                break;
            case SourceDeleted:
                QVERIFY(QFile::remove(source));
                break;
            case SourceIsFolder:
                QVERIFY(QFile::remove(source));
                QVERIFY(QDir().mkpath(source));
                break;
            default:
                break;
        }
    });

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("letter"));
    if (fault == DocsDbImmutable) {
        QVERIFY(unwritable);
        if (!unwritable->Holds()) {
            QSKIP("this file system has no immutable attribute");
        }
    }
    QCOMPARE(archived, QString());

    if (fault == DocsDbMissing) {
        QVERIFY2(!QFile::exists(mdocs), "a missing database was created empty");
        QVERIFY(QFile::rename(aside, mdocs));
    }
    lock.write("ROLLBACK;\n.quit\n");
    lock.closeWriteChannel();
    lock.waitForFinished(10000);
    unwritable.reset();
    QCOMPARE(StateOf(f), before);
    const bool sourceGone = fault == SourceDeleted || fault == SourceIsFolder;
    QCOMPARE(Content(source), sourceGone ? QByteArray() : QByteArray("document"));
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    const QStringList texts = f.Ui().Texts();
    QCOMPARE(texts.size(), 1);
    QVERIFY2(texts.front().startsWith(QString(message).replace(QStringLiteral("%1"), source)),
             qPrintable(texts.front()));
}

void TestFaults::batch_data() {
    QTest::addColumn<int>("fault");
    QTest::addColumn<QString>("message");  // %1: MainPath
    QTest::newRow("file where the target folder should be")
        << int(FolderIsFile)
        << QStringLiteral(
               "58-BuildDirTree-File already exists\n%1/DOCS/DOC1001\n\n"
               "כנראה אין הרשאות גישה למשתמש הנוכחי\n");
    QTest::newRow("settings full of garbage")
        << int(SettingsGarbage) << QStringLiteral("אין זיהוי של עבודה בזורבן במחשב זה\n");
    // No login can be read from it, so no database is on the server: the document is filed
    // on the file databases, whole.
    QTest::newRow("MSSQLSetting.INI full of garbage")
        << int(ServerIniGarbage) << QStringLiteral("הקובץ נשמר לכתובת המבוקשת\n");
}

void TestFaults::batch() {
    QFETCH(int, fault);
    QFETCH(QString, message);
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    if (fault == FolderIsFile) {
        f.ArchiveFile(QStringLiteral("DOC1001"), "not a folder");
    } else if (fault == ServerIniGarbage) {
        // The installation's modules are on the server, and its login file is garbage.
        f.ExecFile(QStringLiteral("MAIN"),
                   QStringLiteral("INSERT OR REPLACE INTO MSql (ClientID, IsDocs, IsBM, IsOffice, "
                                  "IsZorva) VALUES ('23', 1, 1, 1, 1)"));
        QVERIFY(WriteFile(f.DataDir() + QStringLiteral("/Def/MSSQLSetting.INI"), Garbage()));
    } else {
        QVERIFY(WriteFile(
            qEnvironmentVariable("XDG_CONFIG_HOME") + QStringLiteral("/zorvane/kavex32.ini"),
            Garbage()));
        QVERIFY(WriteFile(
            qEnvironmentVariable("LOCALAPPDATA") + QStringLiteral("/Zorvane/Kavex32R.txt"),
            Garbage()));
    }
    const QStringList before = StateOf(f);

    const ProcessResult r =
        f.RunProgram({QStringLiteral("--batch"), QStringLiteral("--client"), QStringLiteral("1001"),
                      FilingFixture::Request(1, source, QStringLiteral("letter"))});

    QCOMPARE(r.err, QString(message).replace(QStringLiteral("%1"), f.DataDir()));
    if (fault != ServerIniGarbage) {
        QCOMPARE(r.status, 1);
        QCOMPARE(r.out, QString());
        QCOMPARE(StateOf(f), before);
        QCOMPARE(Content(source), QByteArray("document"));
        return;
    }
    QCOMPARE(r.status, 0);
    const QString archived = f.Docs() + QStringLiteral("/DOC1001/letter.pdf");
    QCOMPARE(r.out, archived + QLatin1Char('\n'));
    QCOMPARE(Content(archived), QByteArray("document"));
    QVERIFY(!QFile::exists(source));
    QCOMPARE(
        Rows(QStringLiteral("MDOCS"),
             QStringLiteral("SELECT ID FROM DOCS WHERE FULLNAME='\\DOCS\\DOC1001\\letter.pdf'"))
            .size(),
        1);
}

QTEST_MAIN(TestFaults)
#include "test_faults.moc"

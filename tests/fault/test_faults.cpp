// Filings that meet a fault: the target folder, the file databases, the source and the
// settings fail in turn. A filing that cannot complete leaves the source in place, nothing
// added to the archive or its tables, and one message to the user; one that can complete
// (a garbage server login file) files the document whole.
#include <QProcess>
#include <QRandomGenerator>
#include <QtTest>
#include <memory>

#include "filing_fixture.h"
#include "test_files.h"

using namespace zv;
using namespace zv::test;
using namespace Qt::Literals::StringLiterals;

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
    ServerIniGarbage
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
    const QString notRecorded = u"המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :\r\n%1\r\n\r\n"_s;
    // Root writes through permissions; the immutable attribute stops it.
    QTest::newRow("target folder immutable")
        << int(TargetImmutable) << u"70-0-WorkWithStr-Permission denied\r\n\r\n1\r\n%1\r\nletter"_s;
    QTest::newRow("MDOCS.MDB missing")
        << int(DocsDbMissing) << notRecorded + "3024-0-AddDocToListByAddIn-Could not find file";
    QTest::newRow("MDOCS.MDB immutable")
        << int(DocsDbImmutable)
        << notRecorded + "3027-0-GUpdate-Cannot update. Database or object is read-only.";
    QTest::newRow("MDOCS.MDB locked past the busy timeout")
        << int(DocsDbLocked)
        << notRecorded + "3260-0-AddDocToListByAddIn-Couldn't update; currently locked.";
    QTest::newRow("source deleted after the dialog")
        << int(SourceDeleted) << u"53-0-WorkWithStr-File not found"_s;
    QTest::newRow("source replaced by a folder after the dialog")
        << int(SourceIsFolder) << u"75-0-WorkWithStr-Path/File access error"_s;
    QTest::newRow("DOCS without the column FULLNAME")
        << int(DocsColumnMissing)
        << notRecorded + "3146-0-AddDocToListByAddIn-no such column: FullName";
}

void TestFaults::withDialog() {
    QFETCH(int, fault);
    QFETCH(QString, message);
    FilingFixture f;
    const QString source = f.Source(u"letter.pdf"_s);
    const QString mdocs = f.DataDir() + u"/MDOCS.MDB"_s;
    const QString aside = f.DataDir() + u"/../MDOCS.aside"_s;
    if ((fault == TargetImmutable || fault == DocsDbImmutable) && !Unwritable(mdocs).Holds()) {
        QSKIP("this file system has no immutable attribute");
    }
    std::unique_ptr<Unwritable> unwritable;
    if (fault == TargetImmutable) {
        QVERIFY(QDir().mkpath(f.Docs() + u"/DOC1001"_s));
        unwritable = std::make_unique<Unwritable>(f.Docs() + u"/DOC1001"_s);
    } else if (fault == DocsColumnMissing) {
        Execute(u"MDOCS"_s, u"DROP INDEX DOCS_FULLNAME"_s);
        Execute(u"MDOCS"_s, u"ALTER TABLE DOCS DROP COLUMN FULLNAME"_s);
    }
    const QStringList before = f.State();

    // The fault strikes while the dialog is open, after it loaded.
    QProcess lock;  // a sqlite3 shell holding an exclusive lock on MDOCS.MDB
    QueueFilingDialog(f.Ui(), {.reminderTime = u"10:00"_s, .popup = true}, [&](FrmGetDocDet&) {
        if (fault == DocsDbMissing) {
            QVERIFY(QFile::rename(mdocs, aside));
        } else if (fault == DocsDbImmutable) {
            unwritable = std::make_unique<Unwritable>(mdocs);
        } else if (fault == DocsDbLocked) {
            lock.start(u"sqlite3"_s, {mdocs});
            lock.write("BEGIN EXCLUSIVE;\nSELECT 'locked';\n");
            QVERIFY(lock.waitForReadyRead(10000) && lock.readAll().contains("locked"));
        } else if (fault == SourceDeleted || fault == SourceIsFolder) {
            QVERIFY(QFile::remove(source));
            QVERIFY(fault == SourceDeleted || QDir().mkpath(source));
        }
    });

    QCOMPARE(f.RunWithDialog(1, source, u"letter"_s), QString());

    if (fault == DocsDbMissing) {
        QVERIFY2(!QFile::exists(mdocs), "a missing database was created empty");
        QVERIFY(QFile::rename(aside, mdocs));
    }
    lock.write("ROLLBACK;\n.quit\n");
    lock.closeWriteChannel();
    lock.waitForFinished(10000);
    unwritable.reset();
    QCOMPARE(f.State(), before);
    const bool sourceGone = fault == SourceDeleted || fault == SourceIsFolder;
    QCOMPARE(Content(source), sourceGone ? QByteArray() : QByteArray("document"));
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    const QStringList texts = f.Ui().Texts();
    QCOMPARE(texts.size(), 1);
    QVERIFY2(texts.front().startsWith(message.replace(u"%1"_s, source)), qPrintable(texts.front()));
}

void TestFaults::batch_data() {
    QTest::addColumn<int>("fault");
    QTest::addColumn<QString>("message");  // %1: MainPath
    QTest::newRow("file where the target folder should be")
        << int(FolderIsFile)
        << u"58-BuildDirTree-File already exists\n%1/DOCS/DOC1001\n\n"
           "כנראה אין הרשאות גישה למשתמש הנוכחי\n"_s;
    QTest::newRow("settings full of garbage")
        << int(SettingsGarbage) << u"אין זיהוי של עבודה בזורבן במחשב זה\n"_s;
    // No login can be read from it, so no database is on the server: the document is filed
    // on the file databases, whole.
    QTest::newRow("MSSQLSetting.INI full of garbage")
        << int(ServerIniGarbage) << u"הקובץ נשמר לכתובת המבוקשת\n"_s;
}

void TestFaults::batch() {
    QFETCH(int, fault);
    QFETCH(QString, message);
    FilingFixture f;
    const QString source = f.Source(u"letter.pdf"_s);
    if (fault == FolderIsFile) {
        f.ArchiveFile(u"DOC1001"_s, "not a folder");
    } else if (fault == ServerIniGarbage) {
        // The installation's modules are on the server, and its login file is garbage.
        Execute(u"MAIN"_s,
                u"INSERT OR REPLACE INTO MSql (ClientID, IsDocs, IsBM, IsOffice, "
                "IsZorva) VALUES ('23', 1, 1, 1, 1)"_s);
        QVERIFY(WriteFile(f.DataDir() + u"/Def/MSSQLSetting.INI"_s, Garbage()));
    } else {
        QVERIFY(WriteFile(qEnvironmentVariable("XDG_CONFIG_HOME") + u"/zorvane/kavex32.ini"_s,
                          Garbage()));
        QVERIFY(WriteFile(qEnvironmentVariable("LOCALAPPDATA") + u"/Zorvane/Kavex32R.txt"_s,
                          Garbage()));
    }
    const QStringList before = f.State();

    const ProcessResult r = f.RunBatch({"--client", "1001"}, 1, source, u"letter"_s);

    QCOMPARE(r.err, message.replace(u"%1"_s, f.DataDir()));
    if (fault != ServerIniGarbage) {
        QCOMPARE(r.status, 1);
        QCOMPARE(r.out, QString());
        QCOMPARE(f.State(), before);
        QCOMPARE(Content(source), QByteArray("document"));
        return;
    }
    QCOMPARE(r.status, 0);
    const QString archived = f.Docs() + u"/DOC1001/letter.pdf"_s;
    QCOMPARE(r.out, archived + '\n');
    QCOMPARE(Content(archived), QByteArray("document"));
    QVERIFY(!QFile::exists(source));
    QCOMPARE(f.DocsRows().size(), 1);
    QCOMPARE(f.DocsRows().front()["FULLNAME"].toString(), FullName(u"DOC1001/letter.pdf"_s));
}

QTEST_MAIN(TestFaults)
#include "test_faults.moc"

// Filings that meet a fault: the target folder, the file databases, the source and the
// settings fail in turn. A filing that cannot complete leaves the source in place, nothing
// added to the archive or its tables, and one message to the user; one that can complete
// (a garbage server login file, a DOCS column the row can do without) files the document
// whole.
#include <QProcess>
#include <QRandomGenerator>
#include <QtTest>
#include <memory>

#include "dialog_script.h"
#include "fault_check.h"
#include "filing_fixture.h"

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

// Bytes no settings reader can make sense of: random binary with broken INI lines between.
QByteArray Garbage() {
    QRandomGenerator random(8);
    QByteArray bytes;
    for (int i = 0; i < 64; ++i) {
        for (int j = 0; j < 64; ++j) {
            bytes.append(char(random.bounded(256)));
        }
        if (i % 3 == 0) {
            bytes.append("\n[General\n=\nMainPath\n");
        } else {
            bytes.append("\r\n\0\xff[]==\n", 9);
        }
    }
    return bytes;
}

void WriteGarbage(const QString& path) {
    QDir().mkpath(QFileInfo(path).path());
    QFile f(path);
    QVERIFY(f.open(QIODevice::WriteOnly | QIODevice::Truncate));
    f.write(Garbage());
}

// A sqlite3 shell that holds an exclusive lock on a database file until it is dropped.
class ExclusiveLock {
  public:
    explicit ExclusiveLock(const QString& file) {
        shell_.start(QStringLiteral("sqlite3"), {file});
        shell_.write("BEGIN EXCLUSIVE;\nSELECT 'locked';\n");
        while (!locked_ && shell_.waitForReadyRead(10000)) {
            locked_ = shell_.readAll().contains("locked");
        }
    }
    ~ExclusiveLock() {
        shell_.write("ROLLBACK;\n.quit\n");
        shell_.closeWriteChannel();
        if (!shell_.waitForFinished(10000)) {
            shell_.kill();
            shell_.waitForFinished();
        }
    }
    bool Holds() const { return locked_; }

  private:
    QProcess shell_;
    bool locked_ = false;
};

}  // namespace

class TestFaults : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void withDialog_data();
    void withDialog();
    void batch_data();
    void batch();
    void docsWithoutHandlerColumn();
};

void TestFaults::initTestCase() {
    // The programs started here say nothing about a missing runtime folder.
    static QTemporaryDir runtime;
    QVERIFY(QFile::setPermissions(runtime.path(),
                                  QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner));
    qputenv("XDG_RUNTIME_DIR", runtime.path().toUtf8());
}

void TestFaults::withDialog_data() {
    QTest::addColumn<int>("fault");
    QTest::addColumn<QString>("message");  // the message's beginning; %1 the source
    QTest::addColumn<QByteArray>("sourceLeft");
    // What became of the document, then why.
    const QString notRecorded =
        QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :\r\n%1\r\n\r\n");
    // Root writes through permissions; the immutable attribute stops it.
    QTest::newRow("target folder immutable")
        << int(TargetImmutable) << QStringLiteral("70-0-WorkWithStr-Permission denied")
        << QByteArray("document");
    QTest::newRow("MDOCS.MDB missing")
        << int(DocsDbMissing)
        << notRecorded + QStringLiteral("3024-0-AddDocToListByAddIn-Could not find file")
        << QByteArray("document");
    QTest::newRow("MDOCS.MDB immutable")
        << int(DocsDbImmutable)
        << notRecorded +
               QStringLiteral("3027-0-GUpdate-Cannot update. Database or object is read-only.")
        << QByteArray("document");
    QTest::newRow("MDOCS.MDB locked past the busy timeout")
        << int(DocsDbLocked)
        << notRecorded +
               QStringLiteral("3260-0-AddDocToListByAddIn-Couldn't update; currently locked.")
        << QByteArray("document");
    QTest::newRow("source deleted after the dialog")
        << int(SourceDeleted) << QStringLiteral("53-0-WorkWithStr-File not found") << QByteArray();
    QTest::newRow("source replaced by a folder after the dialog")
        << int(SourceIsFolder) << QStringLiteral("75-0-WorkWithStr-Path/File access error")
        << QByteArray();
    QTest::newRow("DOCS without the column FULLNAME")
        << int(DocsColumnMissing)
        << notRecorded + QStringLiteral("3146-0-AddDocToListByAddIn-no such column: FullName")
        << QByteArray("document");
}

void TestFaults::withDialog() {
    QFETCH(int, fault);
    QFETCH(QString, message);
    QFETCH(QByteArray, sourceLeft);
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
    const InstallationState before = StateOf(f);

    // The fault strikes while the dialog is open, after it loaded.
    std::unique_ptr<ExclusiveLock> lock;
    DialogInput in;
    in.client = QStringLiteral("1001");
    in.reminder = true;
    in.reminderTime = QStringLiteral("10:00");
    in.popup = true;
    QueueFilingDialog(f.Ui(), in, [&](FrmGetDocDet&) {
        switch (fault) {
            case DocsDbMissing:
                QVERIFY(QFile::rename(mdocs, aside));
                break;
            case DocsDbImmutable:
                unwritable = std::make_unique<Unwritable>(mdocs);
                break;
            case DocsDbLocked:
                lock = std::make_unique<ExclusiveLock>(mdocs);
                QVERIFY(lock->Holds());
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
    const QStringList texts = f.Ui().Texts();
    const QByteArray shown = texts.join(QStringLiteral("\n----\n")).toUtf8();
    QVERIFY2(archived.isEmpty(), (archived + QStringLiteral(" filed; shown: ")).toUtf8() + shown);

    if (fault == DocsDbMissing) {
        QVERIFY2(!QFile::exists(mdocs), "a missing database was created empty");
        QVERIFY(QFile::rename(aside, mdocs));
    }
    lock.reset();
    unwritable.reset();
    if (fault == SourceIsFolder) {
        QVERIFY(QFileInfo(source).isDir());
        QVERIFY(QDir().rmdir(source));
    }
    ZV_VERIFY_NOT_FILED(f, before, source, sourceLeft);
    QCOMPARE(f.Ui().UnexpectedModals(), 0);
    QVERIFY2(texts.size() == 1, shown.constData());
    QVERIFY2(texts.front().startsWith(QString(message).replace(QStringLiteral("%1"), source)),
             shown.constData());
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
        WriteGarbage(f.DataDir() + QStringLiteral("/Def/MSSQLSetting.INI"));
    } else {
        WriteGarbage(qEnvironmentVariable("XDG_CONFIG_HOME") +
                     QStringLiteral("/zorvane/kavex32.ini"));
        WriteGarbage(qEnvironmentVariable("LOCALAPPDATA") +
                     QStringLiteral("/Zorvane/Kavex32R.txt"));
    }
    const InstallationState before = StateOf(f);

    const ProcessResult r =
        f.RunProgram({QStringLiteral("--batch"), QStringLiteral("--client"), QStringLiteral("1001"),
                      FilingFixture::Request(1, source, QStringLiteral("letter"))});

    QCOMPARE(r.err, QString(message).replace(QStringLiteral("%1"), f.DataDir()));
    if (fault != ServerIniGarbage) {
        QCOMPARE(r.status, 1);
        QCOMPARE(r.out, QString());
        ZV_VERIFY_NOT_FILED(f, before, source, "document");
        return;
    }
    QCOMPARE(r.status, 0);
    const QString archived = f.Docs() + QStringLiteral("/DOC1001/letter.pdf");
    QCOMPARE(r.out, archived + QLatin1Char('\n'));
    QCOMPARE(Content(archived), QByteArray("document"));
    QVERIFY(!QFile::exists(source));
    const QList<QVariantMap> rows = f.DocsRows();
    QCOMPARE(rows.size(), before.docs + 1);
    QVERIFY(std::any_of(rows.begin(), rows.end(), [](const QVariantMap& row) {
        return row.value(QStringLiteral("FULLNAME")).toString() ==
               QStringLiteral("\\DOCS\\DOC1001\\letter.pdf");
    }));
}

// A column that is not the row's key: the document is filed and its row saved with every
// column the table has, as the suite's own table allows; the user is told what could not
// be written before the confirmation.
void TestFaults::docsWithoutHandlerColumn() {
    FilingFixture f;
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    f.ExecFile(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE DOCS DROP COLUMN Metapel"));
    DialogInput in;
    in.client = QStringLiteral("1001");
    QueueFilingDialog(f.Ui(), in);

    const QString archived = f.RunWithDialog(1, source, QStringLiteral("letter"));

    QCOMPARE(archived, f.Docs() + QStringLiteral("/DOC1001/letter.pdf"));
    QCOMPARE(Content(archived), QByteArray("document"));
    QVERIFY(!QFile::exists(source));
    QCOMPARE(f.DocsRows().size(), 1);
    const QStringList texts = f.Ui().Texts();
    QVERIFY2(texts.size() >= 2, qPrintable(texts.join(QLatin1Char('\n'))));
    QVERIFY2(texts.front().startsWith(QStringLiteral("3265-0-AddDocToListByAddIn-")) &&
                 texts.front().contains(QStringLiteral("Metapel")),
             qPrintable(texts.front()));
    QCOMPARE(texts.back(), QStringLiteral("הקובץ נשמר לכתובת המבוקשת"));
}

QTEST_MAIN(TestFaults)
#include "test_faults.moc"

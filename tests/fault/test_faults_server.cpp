// Filings on the server back-end that cannot complete: the server stops while the filing
// waits for it, and DOCS lacks a column. The cluster is this program's own, so stopping it
// disturbs no other test.
#include <unistd.h>

#include <QProcess>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QUuid>
#include <QtTest>
#include <memory>

#include "dialog_script.h"
#include "fault_check.h"
#include "filing_fixture.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;

namespace {

constexpr int kPort = 55433;

QString ServerBin() {
    QStringList versions =
        QDir(QStringLiteral("/usr/lib/postgresql")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    std::sort(versions.begin(), versions.end(),
              [](const QString& a, const QString& b) { return a.toInt() < b.toInt(); });
    return versions.isEmpty()
               ? QString()
               : QStringLiteral("/usr/lib/postgresql/") + versions.last() + QStringLiteral("/bin");
}

// pg_ctl refuses root; as root the server runs as the postgres user, as scripts/pg-cluster
// runs it.
QString PgCtl() {
    return (::geteuid() == 0 ? QStringLiteral("runuser -u postgres -- '") : QStringLiteral("'")) +
           ServerBin() + QStringLiteral("/pg_ctl'");
}

// Runs a shell command line; true when it exits 0.
bool Shell(const QString& command) {
    QProcess p;
    p.setProcessChannelMode(QProcess::ForwardedChannels);
    p.start(QStringLiteral("/bin/sh"), {QStringLiteral("-c"), command});
    return p.waitForFinished(60000) && p.exitStatus() == QProcess::NormalExit && p.exitCode() == 0;
}

// A session of its own on one database of the cluster.
class Session {
  public:
    Session(const QString& socketDir, const QString& database)
        : name_(QUuid::createUuid().toString()) {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), name_);
        db.setHostName(socketDir);
        db.setPort(kPort);
        db.setUserName(QStringLiteral("postgres"));
        db.setDatabaseName(database);
        db.open();
    }
    ~Session() { QSqlDatabase::removeDatabase(name_); }
    bool Exec(const QString& sql) {
        QSqlQuery q(QSqlDatabase::database(name_, false));
        return q.exec(sql);
    }
    QVariant Value(const QString& sql) {
        QSqlQuery q(QSqlDatabase::database(name_, false));
        return q.exec(sql) && q.next() ? q.value(0) : QVariant();
    }
    void Close() { QSqlDatabase::database(name_, false).close(); }

  private:
    QString name_;
};

}  // namespace

class TestFaultsServer : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void serverStopsMidRequest();
    void docsWithoutKeyColumn();

  private:
    bool StartServer();
    bool StopServer();

    QTemporaryDir clusterDir_;
    QString socketDir_;
    bool started_ = false;
};

void TestFaultsServer::initTestCase() {
    if (ServerBin().isEmpty()) {
        if (qEnvironmentVariable("CI") == QLatin1String("true")) {
            QFAIL("the PostgreSQL server programs are missing");
        }
        QSKIP("the PostgreSQL server programs are missing");
    }
    const QString dir = clusterDir_.filePath(QStringLiteral("pg"));
    QVERIFY(Shell(QStringLiteral(ZV_PG_CLUSTER " start '%1' %2").arg(dir).arg(kPort)));
    started_ = true;
    socketDir_ = QFileInfo(dir).canonicalFilePath();
    // The sample installations of this program use this cluster.
    qputenv("ZV_PG_HOST", socketDir_.toUtf8());
    qputenv("ZV_PG_PORT", QByteArray::number(kPort));
    qputenv("ZV_PG_USER", "postgres");
    // The filing program says nothing about a missing runtime folder.
    const QString runtime = clusterDir_.filePath(QStringLiteral("runtime"));
    QVERIFY(QDir().mkpath(runtime));
    QVERIFY(QFile::setPermissions(runtime, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner));
    qputenv("XDG_RUNTIME_DIR", runtime.toUtf8());
}

void TestFaultsServer::cleanupTestCase() {
    if (started_) {
        Shell(QStringLiteral(ZV_PG_CLUSTER " stop '%1'")
                  .arg(clusterDir_.filePath(QStringLiteral("pg"))));
    }
}

bool TestFaultsServer::StartServer() {
    return Shell(QStringLiteral("%1 -D '%2/data' -w -t 30 -l "
                                "'%2/server.log' -o \"-k '%2' -p %3 -c listen_addresses=''\" "
                                "start >/dev/null")
                     .arg(PgCtl(), socketDir_)
                     .arg(kPort));
}

bool TestFaultsServer::StopServer() {
    return Shell(QStringLiteral("%1 -D '%2/data' -w -m fast stop "
                                ">/dev/null")
                     .arg(PgCtl(), socketDir_));
}

void TestFaultsServer::serverStopsMidRequest() {
    FilingFixture f(true);
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    const InstallationState before = StateOf(f);

    // The filing waits for DOCS, which another session holds, and the server stops then.
    Session holder(socketDir_, QStringLiteral("MDOCS") + VolnaGlobNum());
    QVERIFY(holder.Exec(QStringLiteral("BEGIN")));
    QVERIFY(holder.Exec(QStringLiteral("LOCK TABLE docs IN ACCESS EXCLUSIVE MODE")));
    QProcess filer;
    QProcessEnvironment pe = QProcessEnvironment::systemEnvironment();
    pe.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    filer.setProcessEnvironment(pe);
    filer.start(QStringLiteral(ZV_FILER),
                {QStringLiteral("--batch"), QStringLiteral("--client"), QStringLiteral("1001"),
                 FilingFixture::Request(1, source, QStringLiteral("letter"))});
    QVERIFY(filer.waitForStarted());
    {
        Session watcher(socketDir_, QStringLiteral("postgres"));
        const QString waiting = QStringLiteral(
                                    "SELECT count(*) FROM pg_stat_activity WHERE wait_event_type = "
                                    "'Lock' AND datname = "
                                    "'MDOCS%1'")
                                    .arg(VolnaGlobNum());
        QTRY_VERIFY_WITH_TIMEOUT(watcher.Value(waiting).toInt() == 1, 60000);
    }
    QVERIFY(StopServer());
    holder.Close();
    QVERIFY(filer.waitForFinished(60000));
    const QString err = QString::fromUtf8(filer.readAllStandardError());
    QVERIFY(StartServer());

    QCOMPARE(filer.exitCode(), 1);
    QCOMPARE(filer.readAllStandardOutput(), QByteArray());
    ZV_VERIFY_NOT_FILED(f, before, source, "document");
    QVERIFY2(err.startsWith(QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :")),
             qPrintable(err));
}

void TestFaultsServer::docsWithoutKeyColumn() {
    FilingFixture f(true);
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    {
        Session s(socketDir_, QStringLiteral("MDOCS") + VolnaGlobNum());
        QVERIFY(s.Exec(QStringLiteral("ALTER TABLE docs DROP COLUMN fullname")));
    }
    const InstallationState before = StateOf(f);
    DialogInput in;
    in.client = QStringLiteral("1001");
    in.reminder = true;
    in.reminderTime = QStringLiteral("10:00");
    QueueFilingDialog(f.Ui(), in);

    QCOMPARE(f.RunWithDialog(1, source, QStringLiteral("letter")), QString());

    ZV_VERIFY_NOT_FILED(f, before, source, "document");
    const QStringList texts = f.Ui().Texts();
    QVERIFY2(texts.size() == 1, qPrintable(texts.join(QStringLiteral("\n----\n"))));
    QVERIFY2(
        texts.front().startsWith(QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :")),
        qPrintable(texts.front()));
}

QTEST_MAIN(TestFaultsServer)
#include "test_faults_server.moc"

// Filings on the server back-end that cannot complete: DOCS lacks its key column, and the
// server stops while the filing waits for it. The cluster is this program's own, so stopping
// it disturbs no other test.
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QUuid>
#include <QtTest>
#include <thread>

#include "dialog_script.h"
#include "fault_check.h"
#include "filing_fixture.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;

namespace {

constexpr int kPort = 55433;
const QString kNotRecorded = QStringLiteral("המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :");

// Runs a program; its exit code, -1 when it did not finish.
int Run(const QString& program, const QStringList& args) {
    QProcess p;
    p.setProcessChannelMode(QProcess::ForwardedChannels);
    p.start(program, args);
    return p.waitForFinished(60000) && p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
}

// pg_ctl on this program's cluster, as root as the postgres user, as scripts/pg-cluster runs it.
bool PgCtl(const QString& socketDir, const QString& action) {
    const QString command =
        QStringLiteral(
            "bin=$(ls -d /usr/lib/postgresql/*/bin | sort -V | tail -n1); "
            "$([ $(id -u) -eq 0 ] && echo runuser -u postgres --) \"$bin/pg_ctl\" -D '%1/data' "
            "-w -l '%1/server.log' -o \"-k '%1' -p %2 -c listen_addresses=''\" -m fast %3 "
            ">/dev/null")
            .arg(socketDir)
            .arg(kPort)
            .arg(action);
    return Run(QStringLiteral("/bin/sh"), {QStringLiteral("-c"), command}) == 0;
}

// A session of its own on one database of the cluster.
QSqlDatabase Connect(const QString& socketDir, const QString& database) {
    QSqlDatabase db =
        QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), QUuid::createUuid().toString());
    db.setHostName(socketDir);
    db.setPort(kPort);
    db.setUserName(QStringLiteral("postgres"));
    db.setDatabaseName(database);
    db.open();
    return db;
}

}  // namespace

class TestFaultsServer : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void docsWithoutKeyColumn();
    void serverStopsMidRequest();

  private:
    QTemporaryDir clusterDir_;
    QString socketDir_;
};

void TestFaultsServer::initTestCase() {
    const QString dir = clusterDir_.filePath(QStringLiteral("pg"));
    const int started =
        Run(QStringLiteral(ZV_PG_CLUSTER), {QStringLiteral("start"), dir, QString::number(kPort)});
    if (started == 77) {
        QSKIP("the PostgreSQL server programs are missing");
    }
    QCOMPARE(started, 0);
    socketDir_ = QFileInfo(dir).canonicalFilePath();
    // The sample installations of this program use this cluster.
    qputenv("ZV_PG_HOST", socketDir_.toUtf8());
    qputenv("ZV_PG_PORT", QByteArray::number(kPort));
    qputenv("ZV_PG_USER", "postgres");
}

void TestFaultsServer::cleanupTestCase() {
    Run(QStringLiteral(ZV_PG_CLUSTER),
        {QStringLiteral("stop"), clusterDir_.filePath(QStringLiteral("pg"))});
}

void TestFaultsServer::docsWithoutKeyColumn() {
    FilingFixture f(true);
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    Execute(QStringLiteral("MDOCS"), QStringLiteral("ALTER TABLE docs DROP COLUMN fullname"));
    const QStringList before = StateOf(f);
    QueueFilingDialog(f.Ui(), {.client = QStringLiteral("1001"),
                               .reminder = true,
                               .reminderTime = QStringLiteral("10:00")});

    QCOMPARE(f.RunWithDialog(1, source, QStringLiteral("letter")), QString());

    QCOMPARE(StateOf(f), before);
    QCOMPARE(Content(source), QByteArray("document"));
    const QStringList texts = f.Ui().Texts();
    QVERIFY2(texts.size() == 1 && texts.front().startsWith(kNotRecorded),
             qPrintable(texts.join(QStringLiteral("\n----\n"))));
}

void TestFaultsServer::serverStopsMidRequest() {
    FilingFixture f(true);
    const QString source = f.Source(QStringLiteral("letter.pdf"), "document");
    const QStringList before = StateOf(f);

    // The filing waits for DOCS, which another session holds, and the server stops then.
    QSqlDatabase holder = Connect(socketDir_, QStringLiteral("MDOCS") + VolnaGlobNum());
    QVERIFY(QSqlQuery(holder).exec(QStringLiteral("BEGIN")));
    QVERIFY(QSqlQuery(holder).exec(QStringLiteral("LOCK TABLE docs IN ACCESS EXCLUSIVE MODE")));
    ProcessResult filed;
    std::jthread filer([&] {
        filed = f.RunProgram({QStringLiteral("--batch"), QStringLiteral("--client"),
                              QStringLiteral("1001"),
                              FilingFixture::Request(1, source, QStringLiteral("letter"))});
    });
    QSqlQuery waiting(Connect(socketDir_, QStringLiteral("postgres")));
    const QString sql = QStringLiteral(
                            "SELECT count(*) FROM pg_stat_activity WHERE wait_event_type = 'Lock' "
                            "AND datname = 'MDOCS%1'")
                            .arg(VolnaGlobNum());
    QTRY_VERIFY_WITH_TIMEOUT(waiting.exec(sql) && waiting.next() && waiting.value(0).toInt() == 1,
                             60000);
    QVERIFY(PgCtl(socketDir_, QStringLiteral("stop")));
    holder.close();
    filer.join();
    QVERIFY(PgCtl(socketDir_, QStringLiteral("start")));

    QCOMPARE(filed.status, 1);
    QCOMPARE(filed.out, QString());
    QVERIFY2(filed.err.startsWith(kNotRecorded), qPrintable(filed.err));
    QCOMPARE(StateOf(f), before);
    QCOMPARE(Content(source), QByteArray("document"));
}

QTEST_MAIN(TestFaultsServer)
#include "test_faults_server.moc"

// Filings on the server back-end that cannot complete: DOCS lacks its key column, and the
// server stops while the filing waits for it (the last case). The cluster is this program's
// own, so stopping it disturbs no other test.
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QtTest>
#include <thread>

#include "filing_fixture.h"
#include "util/state.h"

using namespace zv;
using namespace zv::test;
using namespace Qt::Literals::StringLiterals;

namespace {

constexpr int kPort = 55433;
const QString kNotRecorded = u"המסמך לא נרשם במערכת, קובץ המקור נשאר במקומו :"_s;

// Runs a shell command; its exit code, -1 when it did not finish.
int Shell(const QString& command) {
    QProcess p;
    p.setProcessChannelMode(QProcess::ForwardedChannels);
    p.start(u"/bin/sh"_s, {u"-c"_s, command});
    return p.waitForFinished(60000) && p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
}

// A session of its own on one database of the cluster.
QSqlDatabase Connect(const QString& socketDir, const QString& database) {
    QSqlDatabase db = QSqlDatabase::addDatabase(u"QPSQL"_s, database + u"-holder"_s);
    db.setHostName(socketDir);
    db.setPort(kPort);
    db.setUserName(u"postgres"_s);
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
    // The cluster script on this program's cluster.
    int Cluster(const QString& action) const {
        return Shell(u"'%1' %2 '%3' %4"_s.arg(QStringLiteral(ZV_PG_CLUSTER), action,
                                              clusterDir_.filePath(u"pg"_s),
                                              QString::number(kPort)));
    }

    QTemporaryDir clusterDir_;
    QString socketDir_;
};

void TestFaultsServer::initTestCase() {
    const int started = Cluster(u"start"_s);
    if (started == 77) {
        QSKIP("the PostgreSQL server programs are missing");
    }
    QCOMPARE(started, 0);
    socketDir_ = QFileInfo(clusterDir_.filePath(u"pg"_s)).canonicalFilePath();
    // The sample installations of this program use this cluster.
    qputenv("ZV_PG_HOST", socketDir_.toUtf8());
    qputenv("ZV_PG_PORT", QByteArray::number(kPort));
    qputenv("ZV_PG_USER", "postgres");
}

void TestFaultsServer::cleanupTestCase() {
    Cluster(u"stop"_s);
}

void TestFaultsServer::docsWithoutKeyColumn() {
    FilingFixture f(true);
    const QString source = f.Source(u"letter.pdf"_s);
    Execute(u"MDOCS"_s, u"ALTER TABLE docs DROP COLUMN fullname"_s);
    const QStringList before = f.State();
    QueueFilingDialog(f.Ui(), {.reminderTime = u"10:00"_s});

    QCOMPARE(f.RunWithDialog(1, source, u"letter"_s), QString());

    QCOMPARE(f.State(), before);
    QCOMPARE(Content(source), QByteArray("document"));
    const QStringList texts = f.Ui().Texts();
    QVERIFY2(texts.size() == 1 && texts.front().startsWith(kNotRecorded),
             qPrintable(texts.join(u"\n----\n"_s)));
}

void TestFaultsServer::serverStopsMidRequest() {
    FilingFixture f(true);
    const QString source = f.Source(u"letter.pdf"_s);
    const QStringList before = f.State();

    // The filing waits for DOCS, which another session holds, and the server stops then.
    QSqlDatabase holder = Connect(socketDir_, u"MDOCS"_s + VolnaGlobNum());
    QVERIFY(QSqlQuery(holder).exec(u"BEGIN"_s));
    QVERIFY(QSqlQuery(holder).exec(u"LOCK TABLE docs IN ACCESS EXCLUSIVE MODE"_s));
    ProcessResult filed;
    std::jthread filer([&] { filed = f.RunBatch({"--client", "1001"}, 1, source, u"letter"_s); });
    QSqlQuery waiting(Connect(socketDir_, u"postgres"_s));
    const QString sql =
        u"SELECT count(*) FROM pg_stat_activity WHERE wait_event_type = 'Lock' "
        "AND datname = 'MDOCS%1'"_s.arg(VolnaGlobNum());
    QTRY_VERIFY_WITH_TIMEOUT(waiting.exec(sql) && waiting.next() && waiting.value(0).toInt() == 1,
                             60000);
    QCOMPARE(Cluster(u"halt"_s), 0);
    holder.close();
    filer.join();

    QCOMPARE(filed.status, 1);
    QCOMPARE(filed.out, QString());
    QVERIFY2(filed.err.startsWith(kNotRecorded), qPrintable(filed.err));
    // Up again: the files and the rows as they were, no half row.
    QCOMPARE(Cluster(u"resume"_s), 0);
    QCOMPARE(f.State(), before);
    QCOMPARE(Content(source), QByteArray("document"));
}

QTEST_MAIN(TestFaultsServer)
#include "test_faults_server.moc"

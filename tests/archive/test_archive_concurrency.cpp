// Many filing processes at one moment on one MDOCS.MDB: every document gets its row, each
// with an ID of its own, and its reminders under that ID.
#include <QProcess>
#include <QtTest>
#include <memory>
#include <vector>

#include "data/database.h"
#include "filing_fixture.h"

using namespace zv;

constexpr int kProcesses = 12;

class TestArchiveConcurrency : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void everyFilingGetsItsRow();
};

void TestArchiveConcurrency::everyFilingGetsItsRow() {
    test::FilingFixture f;
    const QString helper =
        QCoreApplication::applicationDirPath() + QStringLiteral("/record_one_document");
    QVERIFY(QFileInfo::exists(helper));

    QStringList names;
    std::vector<std::unique_ptr<QProcess>> processes;
    for (int i = 0; i < kProcesses; ++i) {
        names << QStringLiteral("doc-%1.pdf").arg(i);
        const QString path = f.ArchiveFile(QStringLiteral("MAILIN/") + names.back());
        auto p = std::make_unique<QProcess>();
        p->start(helper, {f.DataDir(), path});
        QVERIFY2(p->waitForStarted(10000), qPrintable(p->errorString()));
        processes.push_back(std::move(p));
    }
    for (auto& p : processes) {
        while (!p->canReadLine()) {
            QVERIFY2(p->waitForReadyRead(10000), "a filing process did not get ready");
        }
        QCOMPARE(p->readLine().trimmed(), QByteArray("ready"));
    }

    // Every process reads the same max(ID) while another writer holds the file, so all but
    // one find their identifier taken when they save.
    auto writer = Database::OpenFile(QStringLiteral("\\MDOCS.MDB"));
    writer->Execute(QStringLiteral("BEGIN IMMEDIATE"));
    for (auto& p : processes) {
        p->write("go\n");
        p->waitForBytesWritten(1000);
    }
    QTest::qWait(1500);
    writer->Execute(QStringLiteral("ROLLBACK"));
    writer.reset();
    for (auto& p : processes) {
        QVERIFY(p->waitForFinished(60000));
        const QByteArray why = "filing of " + p->arguments().last().toUtf8() +
                               " not saved: " + p->readAllStandardError();
        QVERIFY2(p->exitStatus() == QProcess::NormalExit && p->exitCode() == 0, why.constData());
    }

    const auto rows = test::Rows(QStringLiteral("MDOCS"),
                                 QStringLiteral("SELECT ID, ShortName FROM DOCS ORDER BY ID"));
    QSet<qint64> ids;
    QStringList filed;
    for (const auto& row : rows) {
        const qint64 id = row[QStringLiteral("ID")].toLongLong();
        QVERIFY(id > 0);
        QVERIFY2(!ids.contains(id), qPrintable(QString::number(id)));
        ids.insert(id);
        filed << row[QStringLiteral("SHORTNAME")].toString();
        // Each document's reminders (pop-up and regular for its one handler) carry its ID.
        const auto memos =
            test::Rows(QStringLiteral("BM"),
                       QStringLiteral("SELECT METAPEL FROM UMEMO WHERE ID=") + QString::number(id));
        QCOMPARE(memos.size(), 2);
        QCOMPARE(memos.front()[QStringLiteral("METAPEL")].toString() + QStringLiteral(".pdf"),
                 filed.back());
    }
    filed.sort();
    names.sort();
    QCOMPARE(filed, names);
}

QTEST_MAIN(TestArchiveConcurrency)
#include "test_archive_concurrency.moc"

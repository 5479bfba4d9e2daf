// Many filing processes at one moment on one installation: every document is archived
// once, has its own DOCS row and ID, and its reminder rows; nothing is left behind. On the
// file databases another writer holds MDOCS.MDB as they start, so that they read the same
// max(ID) and all but one find their identifier taken when they save.
#include <QElapsedTimer>
#include <QProcess>
#include <QtTest>
#include <memory>
#include <vector>

#include "data/database.h"
#include "filing_fixture.h"
#include "test_files.h"

using namespace zv;
using namespace zv::test;
using namespace Qt::Literals::StringLiterals;

class TestFilingLoad : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void everyDocumentFiledOnce();
};

void TestFilingLoad::everyDocumentFiledOnce() {
    FilingFixture f(ZV_LOAD_ON_SERVER);
    // The benchmark's count; it times the filing alone, without the other writer.
    const int bench = qEnvironmentVariableIntValue("ZV_LOAD_PROCESSES");
    const int n = bench > 0 ? bench : 8;
    const QString barrier = f.DataDir() + u"/../go"_s;
    QStringList sources;
    QList<QByteArray> contents;
    std::vector<std::unique_ptr<QProcess>> processes;
    for (int i = 0; i < n; ++i) {
        contents << "document " + QByteArray::number(i) + QByteArray(4096, 'x');
        sources << f.Source(u"load-%1.pdf"_s.arg(i), contents.back());
        // Each process waits for the barrier file, so that all file at the same moment.
        QProcess& p = *processes.emplace_back(std::make_unique<QProcess>());
        p.setProcessEnvironment(f.Environment());
        p.start(u"/bin/sh"_s, {"-c", "while [ ! -e \"$0\" ]; do sleep 0.005; done; exec \"$@\"",
                               barrier, ZV_FILER, "--batch", "--client", "1001", "--handlers",
                               "דנה כהן;Moshe", "--reminder", "20-03-2026 09:30", "--popup",
                               FilingFixture::Request(1, sources.back(), u"load-%1"_s.arg(i))});
        QVERIFY2(p.waitForStarted(10000), qPrintable(p.errorString()));
    }
    std::unique_ptr<Database> writer;
    if (!ZV_LOAD_ON_SERVER && bench == 0) {
        writer = Database::OpenFile(u"\\MDOCS.MDB"_s);
        writer->Execute(u"BEGIN IMMEDIATE"_s);
    }
    QVERIFY(WriteFile(barrier, {}));
    QElapsedTimer timer;
    timer.start();
    if (writer) {
        // Long enough for every process to read the same highest ID even under the
        // sanitizers, well inside the busy timeout of the waiting writers.
        QTest::qWait(3000);
        writer->Execute(u"ROLLBACK"_s);
        writer.reset();
    }

    QStringList archived;
    for (int i = 0; i < n; ++i) {
        QProcess& p = *processes[static_cast<size_t>(i)];
        QVERIFY2(p.waitForFinished(240000), "a filing process did not end");
        const QByteArray why = sources[i].toUtf8() + " not filed: " + p.readAllStandardError();
        QVERIFY2(p.exitStatus() == QProcess::NormalExit && p.exitCode() == 0, why.constData());
        archived << QString::fromUtf8(p.readAllStandardOutput()).trimmed();
    }
    qInfo("%d processes filed in %lld ms", n, static_cast<long long>(timer.elapsed()));

    // Each document once, whole, in the client's folder; its source gone; no copy left
    // half way beside them.
    const QString folder = QFileInfo(archived.front()).path();
    QStringList names, fullNames;
    for (int i = 0; i < n; ++i) {
        QCOMPARE(QFileInfo(archived[i]).path(), folder);
        QCOMPARE(Content(archived[i]), contents[i]);
        QVERIFY2(!QFileInfo::exists(sources[i]), qPrintable(sources[i]));
        names << QFileInfo(archived[i]).fileName();
        fullNames << FullName(QDir(f.Docs()).relativeFilePath(archived[i]));
    }
    names.sort();
    QCOMPARE(FolderEntries(folder), names);

    // One row per document, each with an ID of its own and its four reminders under it.
    QSet<qint64> ids;
    QStringList rowNames;
    for (const QVariantMap& row : f.DocsRows()) {
        const qint64 id = row["ID"].toLongLong();
        QVERIFY2(id > 0 && !ids.contains(id), qPrintable(QString::number(id)));
        ids.insert(id);
        rowNames << row["FULLNAME"].toString();
        QStringList memos;
        for (const QVariantMap& m :
             Rows(u"BM"_s, u"SELECT METAPEL, MTYPE, MEMOTIME FROM UMEMO WHERE ID=%1"_s.arg(id))) {
            QCOMPARE(m["MEMOTIME"].toDateTime(), QDateTime(QDate(2026, 3, 20), QTime(9, 30)));
            memos << m["MTYPE"].toString() + '/' + m["METAPEL"].toString();
        }
        memos.sort();
        QCOMPARE(memos, (QStringList{"31/Moshe", "31/דנה כהן", "32/Moshe", "32/דנה כהן"}));
    }
    rowNames.sort();
    fullNames.sort();
    QCOMPARE(rowNames, fullNames);
}

QTEST_MAIN(TestFilingLoad)
#include "test_filing_load.moc"

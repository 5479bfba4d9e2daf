// Many filing processes at one moment on one installation: every document is archived
// once, has its own DOCS row and ID, and its reminder rows; nothing is left behind.
#include <QElapsedTimer>
#include <QProcess>
#include <QtTest>
#include <memory>
#include <vector>

#include "filing_fixture.h"
#include "util/state.h"

using namespace zv;

namespace {

int ProcessCount() {
    const int n = qEnvironmentVariableIntValue("ZV_LOAD_PROCESSES");
    return n > 0 ? n : 8;
}

const QString kHandlerA = QStringLiteral("דנה כהן");
const QString kHandlerB = QStringLiteral("Moshe");

// FULLNAME of an archived file: its path below MainPath, with "\".
QString RelativeName(const QString& archived) {
    QString rel = archived.mid(MainPath().size());
    rel.replace(QLatin1Char('/'), QLatin1Char('\\'));
    return rel;
}

}  // namespace

class TestFilingLoad : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void everyDocumentFiledOnce();
};

void TestFilingLoad::everyDocumentFiledOnce() {
    std::unique_ptr<test::FilingFixture> fx;
    try {
        fx = std::make_unique<test::FilingFixture>(ZV_LOAD_ON_SERVER);
    } catch (const std::exception& e) {
        QFAIL(e.what());
    }
    const int n = ProcessCount();
    const QString barrier = fx->DataDir() + QStringLiteral("/../go");
    QStringList sources;
    QList<QByteArray> contents;
    std::vector<std::unique_ptr<QProcess>> processes;
    QProcessEnvironment pe = QProcessEnvironment::systemEnvironment();
    // The fixture's settings store and LOCALAPPDATA are in this process's environment.
    pe.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    pe.remove(QStringLiteral("ZORVANE_DEVELOPMENT_RUN"));
    for (int i = 0; i < n; ++i) {
        contents << QByteArray("document ") + QByteArray::number(i) + QByteArray(4096, 'x');
        sources << fx->Source(QStringLiteral("load-%1.pdf").arg(i), contents.back());
        // Each process waits for the barrier file, so that all file at the same moment.
        auto p = std::make_unique<QProcess>();
        p->setProcessEnvironment(pe);
        p->start(
            QStringLiteral("/bin/sh"),
            {QStringLiteral("-c"),
             QStringLiteral("while [ ! -e \"$0\" ]; do sleep 0.005; done; exec \"$@\""), barrier,
             QStringLiteral(ZV_FILER), QStringLiteral("--batch"), QStringLiteral("--client"),
             QStringLiteral("1001"), QStringLiteral("--handlers"),
             kHandlerA + QLatin1Char(';') + kHandlerB, QStringLiteral("--reminder"),
             QStringLiteral("20-03-2026 09:30"), QStringLiteral("--popup"),
             test::FilingFixture::Request(1, sources.back(), QStringLiteral("load-%1").arg(i))});
        QVERIFY2(p->waitForStarted(10000), qPrintable(p->errorString()));
        processes.push_back(std::move(p));
    }
    QFile go(barrier);
    QVERIFY(go.open(QIODevice::WriteOnly));
    go.close();
    QElapsedTimer timer;
    timer.start();

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
    QStringList expected;
    for (int i = 0; i < n; ++i) {
        QCOMPARE(QFileInfo(archived[i]).path(), folder);
        QCOMPARE(test::Content(archived[i]), contents[i]);
        QVERIFY2(!QFileInfo::exists(sources[i]), qPrintable(sources[i]));
        expected << QFileInfo(archived[i]).fileName();
    }
    expected.sort();
    QCOMPARE(test::FolderEntries(folder), expected);

    // One row per document, each with an ID of its own and its four reminders.
    const QList<QVariantMap> rows = fx->DocsRows();
    QCOMPARE(rows.size(), n);
    QSet<qint64> ids;
    QStringList names;
    for (const QVariantMap& row : rows) {
        const qint64 id = row.value(QStringLiteral("ID")).toLongLong();
        QVERIFY(id > 0);
        QVERIFY2(!ids.contains(id), qPrintable(QString::number(id)));
        ids.insert(id);
        names << row.value(QStringLiteral("FULLNAME")).toString();
        const QList<QVariantMap> memos = test::Rows(
            QStringLiteral("BM"),
            QStringLiteral("SELECT METAPEL, MTYPE, MEMOTIME FROM UMEMO WHERE ID=%1").arg(id));
        QStringList got;
        for (const QVariantMap& m : memos) {
            got << m.value(QStringLiteral("MTYPE")).toString() + QLatin1Char('/') +
                       m.value(QStringLiteral("METAPEL")).toString();
            QCOMPARE(m.value(QStringLiteral("MEMOTIME")).toDateTime(),
                     QDateTime(QDate(2026, 3, 20), QTime(9, 30)));
        }
        QStringList want{QStringLiteral("31/") + kHandlerB, QStringLiteral("31/") + kHandlerA,
                         QStringLiteral("32/") + kHandlerB, QStringLiteral("32/") + kHandlerA};
        got.sort();
        want.sort();
        QCOMPARE(got, want);
    }
    QStringList filed;
    for (const QString& a : archived) {
        filed << RelativeName(a);
    }
    filed.sort();
    names.sort();
    QCOMPARE(names, filed);
}

QTEST_MAIN(TestFilingLoad)
#include "test_filing_load.moc"

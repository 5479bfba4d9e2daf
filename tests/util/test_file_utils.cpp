// File and folder helpers on a real temporary folder.
#include <QtTest>

#include "scripted_ui.h"
#include "test_env.h"
#include "util/file_utils.h"

using namespace zv;

namespace {

QString Read(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? QString::fromLatin1(f.readAll()) : QStringLiteral("?");
}

void Touch(const QString& path) {
    QFile f(path);
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write("x");
}

QString WindowsStyle(QString path) {
    return path.replace(QLatin1Char('/'), QLatin1Char('\\'));
}

const QString kNoAccess = QStringLiteral("כנראה אין הרשאות גישה למשתמש הנוכחי");

}  // namespace

class TestFileUtils : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void createsMissingFileWithMarkerLine();
    void deletesReadOnlyFile();
    void plainQueries_data();
    void plainQueries();
    void patternIgnoresFlags_data();
    void patternIgnoresFlags();
    void createInMissingFolderIsReported();
    void folderCreatedWithParents();
    void buildDirTree_data();
    void buildDirTree();
    void networkPathFromTheShareDown();
    void networkServerIsNeverCreated();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    QString root_;
};

void TestFileUtils::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    root_ = env_->Root();
}

void TestFileUtils::cleanup() {
    QVERIFY2((*ui_)->Texts().isEmpty() || QTest::currentTestFailed(),
             qPrintable((*ui_)->Texts().join(QLatin1Char('|'))));
    ui_.reset();
    env_.reset();
}

void TestFileUtils::createsMissingFileWithMarkerLine() {
    const QString path = root_ + QStringLiteral("/LB81.7");
    QVERIFY(IsFileExist(path, false, true));
    QCOMPARE(Read(path), QStringLiteral("1\r\n"));
    // An existing file is neither truncated nor rewritten.
    Touch(path);
    QVERIFY(IsFileExist(path, false, true));
    QCOMPARE(Read(path), QStringLiteral("x"));
}

void TestFileUtils::deletesReadOnlyFile() {
    const QString path = root_ + QStringLiteral("/locked.doc");
    Touch(path);
    QVERIFY(QFile::setPermissions(path, QFile::ReadOwner | QFile::ReadGroup));
    QVERIFY(!IsFileExist(WindowsStyle(path), true, false));
    QVERIFY(!QFileInfo::exists(path));
}

void TestFileUtils::plainQueries_data() {
    QTest::addColumn<QString>("relative");
    QTest::addColumn<bool>("expected");
    QTest::newRow("existing file") << QStringLiteral("/a.doc") << true;
    QTest::newRow("missing file") << QStringLiteral("/b.doc") << false;
    QTest::newRow("a folder is no file") << QStringLiteral("/sub") << false;
    QTest::newRow("backslashes") << QStringLiteral("\\sub\\c.doc") << true;
    QTest::newRow("empty path") << QString() << false;
}

void TestFileUtils::plainQueries() {
    QFETCH(QString, relative);
    QFETCH(bool, expected);
    QVERIFY(QDir(root_).mkdir(QStringLiteral("sub")));
    Touch(root_ + QStringLiteral("/a.doc"));
    Touch(root_ + QStringLiteral("/sub/c.doc"));
    const QString path = relative.isEmpty() ? QString() : root_ + relative;
    QCOMPARE(IsFileExist(path), expected);
}

void TestFileUtils::patternIgnoresFlags_data() {
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<bool>("deleteIfExist");
    QTest::addColumn<bool>("createIfMissing");
    QTest::addColumn<bool>("expected");
    QTest::newRow("match") << QStringLiteral("*.doc") << false << false << true;
    QTest::newRow("match, delete asked") << QStringLiteral("*.doc") << true << false << true;
    QTest::newRow("upper-case pattern") << QStringLiteral("*.DOC") << false << false << true;
    QTest::newRow("question mark") << QStringLiteral("lette?.doc") << false << false << true;
    QTest::newRow("no match, create asked") << QStringLiteral("*.pdf") << false << true << false;
    QTest::newRow("folders do not count") << QStringLiteral("s*") << false << false << false;
}

void TestFileUtils::patternIgnoresFlags() {
    QFETCH(QString, pattern);
    QFETCH(bool, deleteIfExist);
    QFETCH(bool, createIfMissing);
    QFETCH(bool, expected);
    Touch(root_ + QStringLiteral("/letter.doc"));
    QVERIFY(QDir(root_).mkdir(QStringLiteral("sub")));
    QCOMPARE(IsFileExist(WindowsStyle(root_) + QLatin1Char('\\') + pattern, deleteIfExist,
                         createIfMissing),
             expected);
    QVERIFY(QFileInfo::exists(root_ + QStringLiteral("/letter.doc")));
    QCOMPARE(QDir(root_).entryList(QDir::Files).size(), 1);
}

void TestFileUtils::createInMissingFolderIsReported() {
    const QString path = root_ + QStringLiteral("/nowhere/m.txt");
    QVERIFY(!IsFileExist(path, false, true));
    QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("76-IsFileExist-\r\n") + path +
                                          QStringLiteral("\r\nPath not found")});
    QCOMPARE((*ui_)->Messages().front().style, int(vbOKOnly));
    (*ui_)->Clear();
}

void TestFileUtils::folderCreatedWithParents() {
    const QString path = root_ + QStringLiteral("/x/y/z");
    QVERIFY(!IsFolderExist(path));
    QVERIFY(!QFileInfo::exists(root_ + QStringLiteral("/x")));
    QVERIFY(IsFolderExist(path, true));
    QVERIFY(QFileInfo(path).isDir());
    QVERIFY(!IsFolderExist(QString(), true));
}

void TestFileUtils::buildDirTree_data() {
    QTest::addColumn<QString>("relative");
    QTest::addColumn<QString>("expectedDir");
    QTest::newRow("nested") << QStringLiteral("/a/b/c") << QStringLiteral("/a/b/c");
    QTest::newRow("trailing backslash") << QStringLiteral("\\x\\y\\") << QStringLiteral("/x/y");
    QTest::newRow("mixed separators") << QStringLiteral("/m\\n/o") << QStringLiteral("/m/n/o");
    QTest::newRow("Hebrew names") << QStringLiteral("/לקוח/תיק 5") << QStringLiteral("/לקוח/תיק 5");
    QTest::newRow("already there") << QString() << QString();
}

void TestFileUtils::buildDirTree() {
    QFETCH(QString, relative);
    QFETCH(QString, expectedDir);
    QVERIFY(BuildDirTree(root_ + relative));
    QVERIFY(QFileInfo(root_ + expectedDir).isDir());
    QVERIFY(BuildDirTree(root_ + relative));
}

void TestFileUtils::networkPathFromTheShareDown() {
    // "\\host\share\a\b" names /host/share/a/b here: the temporary folder plays
    // host and share.
    QString rest = root_.mid(1);
    const qsizetype cut = rest.indexOf(QLatin1Char('/'));
    QVERIFY(cut > 0);
    const QString network = QStringLiteral("\\\\") + WindowsStyle(rest) + QStringLiteral("\\a\\b");
    QVERIFY(BuildDirTree(network));
    QVERIFY(QFileInfo(root_ + QStringLiteral("/a/b")).isDir());
}

void TestFileUtils::networkServerIsNeverCreated() {
    const QString server = QStringLiteral("zv-no-server-") + QFileInfo(root_).fileName();
    const QString network = QStringLiteral("\\\\") + server + QStringLiteral("\\share\\a");
    QVERIFY(!BuildDirTree(network));
    QVERIFY(!QFileInfo::exists(QLatin1Char('/') + server));
    // Each level below the server is tried and reported; the server itself never is.
    const QString report = QStringLiteral("76-BuildDirTree-Path not found\r\n") + network +
                           QStringLiteral("\r\n\r\n") + kNoAccess;
    QCOMPARE((*ui_)->Texts(), QStringList({report, report}));
    (*ui_)->Clear();
}

QTEST_MAIN(TestFileUtils)
#include "test_file_utils.moc"

// File and folder helpers on a real temporary folder.
#include <QtTest>

#include "scripted_ui.h"
#include "test_env.h"
#include "test_files.h"
#include "util/file_utils.h"

using namespace zv;

class TestFileUtils : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void createDeleteAndReport();
    void queries_data();
    void queries();
    void buildDirTree();
};

void TestFileUtils::createDeleteAndReport() {
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    const QString root = env.Root();
    const QString path = root + QStringLiteral("/LB81.7");
    QVERIFY(IsFileExist(path, false, true));
    QCOMPARE(test::ReadFile(path), QStringLiteral("1\r\n"));
    // An existing file is neither truncated nor rewritten.
    QVERIFY(test::WriteFile(path, "x"));
    QVERIFY(IsFileExist(path, false, true));
    QCOMPARE(test::ReadFile(path), QStringLiteral("x"));
    // Deleting works on a read-only file too.
    QVERIFY(QFile::setPermissions(path, QFile::ReadOwner | QFile::ReadGroup));
    QVERIFY(!IsFileExist(QString(path).replace(QLatin1Char('/'), QLatin1Char('\\')), true, false));
    QVERIFY(!QFileInfo::exists(path));

    const QString missing = root + QStringLiteral("/nowhere/m.txt");
    QVERIFY(!IsFileExist(missing, false, true));
    QCOMPARE(ui->Texts(), QStringList{QStringLiteral("76-IsFileExist-\r\n") + missing +
                                      QStringLiteral("\r\nPath not found")});

    QVERIFY(!IsFolderExist(root + QStringLiteral("/x/y")));
    QVERIFY(IsFolderExist(root + QStringLiteral("/x/y"), true));
    QVERIFY(QFileInfo(root + QStringLiteral("/x/y")).isDir());
}

// A pattern only asks: the delete and create flags are ignored for it.
void TestFileUtils::queries_data() {
    QTest::addColumn<QString>("relative");
    QTest::addColumn<bool>("deleteIfExist");
    QTest::addColumn<bool>("createIfMissing");
    QTest::addColumn<bool>("expected");
    const auto row = [](const char* name, const char* path, bool del, bool create, bool found) {
        QTest::newRow(name) << QString::fromUtf8(path) << del << create << found;
    };
    row("existing file", "/letter.doc", false, false, true);
    row("missing file", "/b.doc", false, false, false);
    row("a folder is no file", "/sub", false, false, false);
    row("backslashes", "\\sub\\c.doc", false, false, true);
    row("empty path", "", false, false, false);
    row("pattern, delete asked", "\\*.doc", true, false, true);
    row("upper-case pattern", "\\*.DOC", false, false, true);
    row("no match, create asked", "\\*.pdf", false, true, false);
    row("folders do not match", "\\s*", false, false, false);
}

void TestFileUtils::queries() {
    QFETCH(QString, relative);
    QFETCH(bool, deleteIfExist);
    QFETCH(bool, createIfMissing);
    QFETCH(bool, expected);
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    const QString root = env.Root();
    QVERIFY(test::WriteFile(root + QStringLiteral("/letter.doc"), "x"));
    QVERIFY(test::WriteFile(root + QStringLiteral("/sub/c.doc"), "x"));
    const QString path = relative.isEmpty() ? QString() : root + relative;
    QCOMPARE(IsFileExist(path, deleteIfExist, createIfMissing), expected);
    QCOMPARE(QDir(root).entryList(QDir::Files), QStringList{QStringLiteral("letter.doc")});
    QCOMPARE(ui->Texts(), QStringList());
}

void TestFileUtils::buildDirTree() {
    test::TestEnv env;
    test::ScopedScriptedUi ui;
    const QString root = env.Root();
    for (QString relative : {QStringLiteral("/a/b/c"), QStringLiteral("\\x\\y\\"),
                             QStringLiteral("/m\\n/o"), QStringLiteral("/לקוח/תיק 5")}) {
        QVERIFY(BuildDirTree(root + relative));
        QVERIFY(BuildDirTree(root + relative));
        QVERIFY(QFileInfo(root + relative.replace(QLatin1Char('\\'), QLatin1Char('/'))).isDir());
    }
    QCOMPARE(ui->Texts(), QStringList());
    // "\\host\share\n\k" names /host/share/n/k here: the temporary folder is host and share.
    QVERIFY(BuildDirTree(QStringLiteral("\\\\") +
                         root.mid(1).replace(QLatin1Char('/'), QLatin1Char('\\')) +
                         QStringLiteral("\\n\\k")));
    QVERIFY(QFileInfo(root + QStringLiteral("/n/k")).isDir());

    const QString server = QStringLiteral("zv-no-server-") + QFileInfo(root).fileName();
    const QString network = QStringLiteral("\\\\") + server + QStringLiteral("\\share\\a");
    QVERIFY(!BuildDirTree(network));
    QVERIFY(!QFileInfo::exists(QLatin1Char('/') + server));
    // Each level below the server is tried and reported; the server itself never is.
    const QString report = QStringLiteral("76-BuildDirTree-Path not found\r\n") + network +
                           QStringLiteral("\r\n\r\nכנראה אין הרשאות גישה למשתמש הנוכחי");
    QCOMPARE(ui->Texts(), QStringList({report, report}));
}

QTEST_MAIN(TestFileUtils)
#include "test_file_utils.moc"

// The utilities: failure reports and the Ui port's default answers, file and folder helpers
// on a real temporary folder, the INI reader against files as the suite and its users write
// them, keyboard switching over a fake platform and the XKB mapping of layout identifiers,
// and the per-user settings store.
#include <QStringEncoder>
#include <QtTest>

#include "scripted_ui.h"
#include "test_env.h"
#include "test_files.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/ini_reader.h"
#include "util/keyboard_layout.h"
#include "util/settings_store.h"
#include "util/xkb_symbols.h"

using namespace zv;

namespace {

// A keyboard with the English and the Hebrew layout; loading reads the identifier without
// case, as Windows does, and the active layout is named in upper case.
class FakeKeyboard : public KeyboardPlatform {
  public:
    QString ActiveLayoutName() override { return failing ? throw MakeError(5) : active; }
    void LoadLayout(const QString& layoutId) override {
        ++loads;
        const QString id = layoutId.toUpper();
        if (id == QLatin1String("00000409") || id == QLatin1String("0000040D")) {
            active = id;
        }
    }
    QString active = QStringLiteral("00000409");
    int loads = 0;
    bool failing = false;
};

FakeKeyboard& InstallFakeKeyboard() {
    auto fake = std::make_unique<FakeKeyboard>();
    FakeKeyboard& installed = *fake;
    SetKeyboardPlatform(std::move(fake));
    return installed;
}

}  // namespace

class TestUtil : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
    }
    void cleanup() {
        ui_.reset();
        env_.reset();
    }

    void failureReports() {
        // A failing step is reported and the next one runs.
        const auto format = [](const VbError& e) { return FormatPlain(QStringLiteral("X"), e); };
        QVERIFY(!Step(format, [] { throw MakeError(err::FileNotFound); }));
        bool ran = false;
        QVERIFY(Step(format, [&] { ran = true; }) && ran);
        QCOMPARE(Texts(), QStringList{QStringLiteral("53-X-File not found")});
        QCOMPARE(DefaultAnswer(vbOKOnly | vbCritical), int(vbOK));
        QCOMPARE(DefaultAnswer(vbYesNo | vbQuestion | vbDefaultButton2), int(vbNo));
    }

    void createDeleteAndReport() {
        const QString path = env_->Root() + QStringLiteral("/LB81.7");
        QVERIFY(IsFileExist(path, false, true));
        QCOMPARE(test::ReadFile(path), QStringLiteral("1\r\n"));
        // An existing file is neither truncated nor rewritten.
        QVERIFY(test::WriteFile(path, "x"));
        QVERIFY(IsFileExist(path, false, true));
        QCOMPARE(test::ReadFile(path), QStringLiteral("x"));
        // Deleting works on a read-only file too.
        QVERIFY(QFile::setPermissions(path, QFile::ReadOwner | QFile::ReadGroup));
        QVERIFY(
            !IsFileExist(QString(path).replace(QLatin1Char('/'), QLatin1Char('\\')), true, false));
        QVERIFY(!QFileInfo::exists(path));

        const QString missing = env_->Root() + QStringLiteral("/nowhere/m.txt");
        QVERIFY(!IsFileExist(missing, false, true));
        QCOMPARE(Texts(), QStringList{QStringLiteral("76-IsFileExist-\r\n") + missing +
                                      QStringLiteral("\r\nPath not found")});

        QVERIFY(!IsFolderExist(env_->Root() + QStringLiteral("/x/y")));
        QVERIFY(IsFolderExist(env_->Root() + QStringLiteral("/x/y"), true));
        QVERIFY(QFileInfo(env_->Root() + QStringLiteral("/x/y")).isDir());
    }

    // A pattern only asks: the delete and create flags are ignored for it.
    void fileQueries() {
        const QString root = env_->Root();
        QVERIFY(test::WriteFile(root + QStringLiteral("/letter.doc"), "x"));
        QVERIFY(test::WriteFile(root + QStringLiteral("/sub/c.doc"), "x"));
        const struct {
            const char* path;
            bool deleteIfExist, createIfMissing, found;
        } cases[] = {
            {"/letter.doc", false, false, true}, {"/b.doc", false, false, false},
            {"/sub", false, false, false},       {"\\sub\\c.doc", false, false, true},
            {"\\*.doc", true, false, true},      {"\\*.DOC", false, false, true},
            {"\\*.pdf", false, true, false},     {"\\s*", false, false, false},
        };
        for (const auto& c : cases) {
            QVERIFY2(IsFileExist(root + QLatin1String(c.path), c.deleteIfExist,
                                 c.createIfMissing) == c.found,
                     c.path);
            QCOMPARE(QDir(root).entryList(QDir::Files), QStringList{QStringLiteral("letter.doc")});
        }
        QVERIFY(!IsFileExist(QString(), false, true));
        QCOMPARE(Texts(), QStringList());
    }

    void buildDirTree() {
        const QString root = env_->Root();
        for (QString relative : {QStringLiteral("\\x\\y\\"), QStringLiteral("/לקוח\\תיק 5")}) {
            QVERIFY(BuildDirTree(root + relative));
            QVERIFY(BuildDirTree(root + relative));
            QVERIFY(
                QFileInfo(root + relative.replace(QLatin1Char('\\'), QLatin1Char('/'))).isDir());
        }
        QCOMPARE(Texts(), QStringList());
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
        QCOMPARE(Texts(), QStringList({report, report}));
    }

    void readIni() {
        const QByteArray basic =
            "[General]\r\nMainPath=D:\\Data\r\nMyUser=7\r\n[Other]\r\nMyUser=9\r\n";
        const QString hebrew(600, QChar(0x05D0));
        const QString text = QStringLiteral("[General]\r\nMyUserName=דנה כהן\r\n");
        const QString name = QStringLiteral("דנה כהן");
        const struct {
            const char* name;
            QByteArray content;
            const char* section;
            const char* key;
            QString expected;
        } cases[] = {
            {"missing file", {}, "General", "MainPath", {}},
            {"names without case", basic, "GENERAL", "mainpath", QStringLiteral("D:\\Data")},
            {"section chosen", basic, "other", "MyUser", QStringLiteral("9")},
            {"first key wins", "[G]\nk=1\nK=2\n", "G", "k", QStringLiteral("1")},
            {"first section wins", "[G]\na=1\n[g]\nb=2\n", "G", "b", {}},
            {"blanks trimmed", "  [ G ]  \n  key   =   a b  \t\n", "G", "key",
             QStringLiteral("a b")},
            {"double quotes", "[G]\nk=\" x \"\n", "G", "k", QStringLiteral(" x ")},
            {"unmatched quotes kept", "[G]\nk=\"y'\n", "G", "k", QStringLiteral("\"y'")},
            {"no unescaping", "[G]\nk=a\\tb, c;d\n", "G", "k", QStringLiteral("a\\tb, c;d")},
            {"empty value", "[G]\nk=\nk=2\n", "G", "k", {}},
            {"line without equals", "[G]\nk\nk=3\n", "G", "k", QStringLiteral("3")},
            {"cut at 511", "[G]\nk=" + QByteArray(600, 'x'), "G", "k", QString(511, 'x')},
            {"cut in characters", "[G]\nk=" + hebrew.toUtf8(), "G", "k", hebrew.left(511)},
            {"UTF-8 with BOM", "\xEF\xBB\xBF" + text.toUtf8(), "General", "MyUserName", name},
            {"Windows-1255", QStringEncoder("windows-1255").encode(text), "General", "MyUserName",
             name},
        };
        for (const auto& c : cases) {
            const QString file = env_->Root() + QLatin1Char('/') + QLatin1String(c.name);
            QVERIFY(c.content.isNull() || test::WriteFile(file, c.content));
            const QString value = ReadINI(QLatin1String(c.section), QLatin1String(c.key), file);
            QVERIFY2(value == c.expected,
                     qPrintable(QStringLiteral("%1: %2").arg(QLatin1String(c.name), value)));
        }
    }

    // The comparison with the active layout is exact, so a lower-case identifier loads the
    // layout but fails; an active layout is not loaded again.
    void keyboardSwitching() {
        const struct {
            const char* requested;
            bool result;
            const char* activeAfter;
            int loads;
        } cases[] = {
            {"00000409", true, "00000409", 0},
            {"00000419", false, "00000409", 1},
            {"0000040d", false, "0000040D", 1},
        };
        for (const auto& c : cases) {
            FakeKeyboard& keyboard = InstallFakeKeyboard();
            QCOMPARE(SetKbLayout(QLatin1String(c.requested)), c.result);
            QCOMPARE(keyboard.active, QLatin1String(c.activeAfter));
            QCOMPARE(keyboard.loads, c.loads);
        }
        FakeKeyboard& keyboard = InstallFakeKeyboard();
        SetKbHebrew(true);
        QCOMPARE(keyboard.active, QStringLiteral("0000040D"));
        SetKbHebrew(false);
        QCOMPARE(keyboard.active, QStringLiteral("00000409"));
        QCOMPARE(Texts(), QStringList());
        keyboard.failing = true;
        QVERIFY(!SetKbLayout(QStringLiteral("0000040D")));
        QCOMPARE(
            Texts(),
            QStringList{QStringLiteral("5-SetKbLayout-Invalid procedure call or argument\r\n")});
    }

    void xkbGroups() {
        const QString symbols = QStringLiteral("pc+us+ru:2+il(phonetic):3+inet(evdev)");
        QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("0000040d"))), 2);
        QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("00000409"))), 0);
        QCOMPARE(XkbLayoutOfGroup(symbols, 1), QString());
        QCOMPARE(XkbGroupOfLayout(QStringLiteral("pc+il+us:2+group(alt_shift_toggle)"), "us"), 1);
        QCOMPARE(XkbGroupOfLayout(QStringLiteral("pc+de+inet(evdev)"), "il"), -1);
        QCOMPARE(IdOfXkbLayout(QStringLiteral("il")), QStringLiteral("0000040D"));
    }

    // Names are without case: saved under one spelling, read and replaced under another.
    void settingsRoundTrip() {
        for (const QString& row : {QStringLiteral("Kavex32/GENERAL/myuser|kavex32/General/MyUser"),
                                   QStringLiteral("Kavex32/Grid/Width|KAVEX32/grid/WIDTH")}) {
            const QStringList saveAs = row.section(QLatin1Char('|'), 0, 0).split(QLatin1Char('/'));
            const QStringList readAs = row.section(QLatin1Char('|'), 1).split(QLatin1Char('/'));
            const QString value = QStringLiteral("כהן, דנה ") + row;
            QCOMPARE(GetSetting(readAs[0], readAs[1], readAs[2], QStringLiteral("none")),
                     QStringLiteral("none"));
            SaveSetting(saveAs[0], saveAs[1], saveAs[2], value);
            QCOMPARE(GetSetting(readAs[0], readAs[1], readAs[2], {}), value);
            SaveSetting(readAs[0], readAs[1], readAs[2], QStringLiteral("second"));
            QCOMPARE(GetSetting(saveAs[0], saveAs[1], saveAs[2], {}), QStringLiteral("second"));
        }
    }

    // The file follows XDG_CONFIG_HOME; the suite's section General stays a plain [General]
    // section of a readable file.
    void settingsFile() {
        const QString file = SettingsStoreFile(QStringLiteral("KAVEX32"));
        QCOMPARE(file, env_->ConfigHome() + QStringLiteral("/zorvane/kavex32.ini"));
        QVERIFY(test::WriteFile(file, "[General]\nMainPath=/srv/z\nVolnaGlobNum=23\n"));
        QCOMPARE(GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"),
                            QStringLiteral("VolnaGlobNum"), {}),
                 QStringLiteral("23"));
        SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"),
                    QStringLiteral("MyUserName"), QStringLiteral("דנה"));
        const QString text = QString::fromUtf8(test::ReadFile(file).toLatin1());
        QVERIFY2(text.startsWith(QStringLiteral("[General]\n")) &&
                     text.contains(QStringLiteral("MainPath=/srv/z\n")) &&
                     !text.contains(QStringLiteral("%General")),
                 qPrintable(text));
        qunsetenv("XDG_CONFIG_HOME");
        QCOMPARE(SettingsStoreFile(QStringLiteral("Kavex32")),
                 QDir::homePath() + QStringLiteral("/.config/zorvane/kavex32.ini"));
    }

  private:
    QStringList Texts() { return (*ui_)->Texts(); }
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

QTEST_MAIN(TestUtil)
#include "test_util.moc"

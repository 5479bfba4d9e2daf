// Keyboard switching over a fake platform, and the XKB mapping of layout identifiers.
#include <QtTest>

#include "scripted_ui.h"
#include "util/errors.h"
#include "util/keyboard_layout.h"
#include "util/xkb_symbols.h"

using namespace zv;

namespace {

// A keyboard with a set of installed layouts; loading parses the identifier as Windows does,
// without case, and reports the active layout in upper case.
class FakeKeyboard : public KeyboardPlatform {
  public:
    FakeKeyboard(QStringList installed, QString active)
        : installed_(std::move(installed)), active_(std::move(active)) {}
    QString ActiveLayoutName() override {
        if (failing_) {
            throw MakeError(5);
        }
        return active_;
    }
    void LoadLayout(const QString& layoutId) override {
        ++loads;
        if (installed_.contains(layoutId.toUpper())) {
            active_ = layoutId.toUpper();
        }
    }
    int loads = 0;
    bool failing_ = false;

  private:
    QStringList installed_;
    QString active_;
};

}  // namespace

class TestKeyboardLayout : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void hebrewLoadedOnce();
    void englishBack();
    void switching_data();
    void switching();
    void failureIsReported();
    void xkbGroups_data();
    void xkbGroups();
    void xkbIdentifiers();

  private:
    FakeKeyboard* fake_ = nullptr;
    std::unique_ptr<KeyboardPlatform> previous_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
    void Install(QStringList installed, QString active) {
        auto fake = std::make_unique<FakeKeyboard>(std::move(installed), std::move(active));
        fake_ = fake.get();
        SetKeyboardPlatform(std::move(fake));
    }
};

void TestKeyboardLayout::init() {
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    previous_ = SetKeyboardPlatform(nullptr);
    Install({QStringLiteral("00000409"), QStringLiteral("0000040D")}, QStringLiteral("00000409"));
}

void TestKeyboardLayout::cleanup() {
    SetKeyboardPlatform(std::move(previous_));
    ui_.reset();
}

void TestKeyboardLayout::hebrewLoadedOnce() {
    SetKbHebrew(true);
    QCOMPARE(fake_->ActiveLayoutName(), QStringLiteral("0000040D"));
    SetKbHebrew(true);
    QCOMPARE(fake_->loads, 1);
    QCOMPARE((*ui_)->Texts(), QStringList());
}

void TestKeyboardLayout::englishBack() {
    SetKbHebrew(true);
    SetKbHebrew(false);
    QCOMPARE(fake_->ActiveLayoutName(), QStringLiteral("00000409"));
    QCOMPARE(fake_->loads, 2);
}

void TestKeyboardLayout::switching_data() {
    QTest::addColumn<QStringList>("installed");
    QTest::addColumn<QString>("requested");
    QTest::addColumn<bool>("result");
    QTest::addColumn<QString>("activeAfter");
    QTest::addColumn<int>("loads");
    const QStringList both{QStringLiteral("00000409"), QStringLiteral("0000040D")};
    QTest::newRow("Hebrew installed") << both << "0000040D" << true << "0000040D" << 1;
    QTest::newRow("already active") << both << "00000409" << true << "00000409" << 0;
    QTest::newRow("Hebrew missing")
        << QStringList{QStringLiteral("00000409")} << "0000040D" << false << "00000409" << 1;
    QTest::newRow("lower case loads but fails") << both << "0000040d" << false << "0000040D" << 1;
    QTest::newRow("empty identifier") << both << "" << false << "00000409" << 1;
}

void TestKeyboardLayout::switching() {
    QFETCH(QStringList, installed);
    QFETCH(QString, requested);
    QFETCH(bool, result);
    QFETCH(QString, activeAfter);
    QFETCH(int, loads);
    Install(installed, QStringLiteral("00000409"));
    QCOMPARE(SetKbLayout(requested), result);
    QCOMPARE(fake_->ActiveLayoutName(), activeAfter);
    QCOMPARE(fake_->loads, loads);
}

void TestKeyboardLayout::failureIsReported() {
    fake_->failing_ = true;
    QVERIFY(!SetKbLayout(QStringLiteral("0000040D")));
    QCOMPARE((*ui_)->Texts(),
             QStringList{QStringLiteral("5-SetKbLayout-Invalid procedure call or argument\r\n")});
}

void TestKeyboardLayout::xkbGroups_data() {
    QTest::addColumn<QString>("symbols");
    QTest::addColumn<int>("hebrewGroup");
    QTest::addColumn<int>("englishGroup");
    QTest::addColumn<QString>("layoutOfGroup0");
    QTest::addColumn<QString>("layoutOfGroup1");
    QTest::newRow("us and il") << "pc+us+il:2+inet(evdev)" << 1 << 0 << "us"
                               << "il";
    QTest::newRow("il first") << "pc+il+us:2+inet(evdev)+group(alt_shift_toggle)" << 0 << 1 << "il"
                              << "us";
    QTest::newRow("variant") << "pc+us+il(phonetic):2" << 1 << 0 << "us"
                             << "il";
    QTest::newRow("third group") << "pc+us+ru:2+il:3" << 2 << 0 << "us"
                                 << "";
    QTest::newRow("no Hebrew") << "pc+us+inet(evdev)" << -1 << 0 << "us"
                               << "";
    QTest::newRow("nothing known") << "pc+de+inet(evdev)" << -1 << -1 << ""
                                   << "";
    QTest::newRow("empty") << "" << -1 << -1 << ""
                           << "";
}

void TestKeyboardLayout::xkbGroups() {
    QFETCH(QString, symbols);
    QFETCH(int, hebrewGroup);
    QFETCH(int, englishGroup);
    QFETCH(QString, layoutOfGroup0);
    QFETCH(QString, layoutOfGroup1);
    QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("0000040D"))), hebrewGroup);
    QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("00000409"))), englishGroup);
    QCOMPARE(XkbLayoutOfGroup(symbols, 0), layoutOfGroup0);
    QCOMPARE(XkbLayoutOfGroup(symbols, 1), layoutOfGroup1);
}

void TestKeyboardLayout::xkbIdentifiers() {
    QCOMPARE(XkbLayoutOfId(QStringLiteral("0000040d")), QStringLiteral("il"));
    QCOMPARE(XkbLayoutOfId(QStringLiteral("00000407")), QString());
    QCOMPARE(XkbLayoutOfId(QStringLiteral("zz")), QString());
    QCOMPARE(IdOfXkbLayout(QStringLiteral("il")), QStringLiteral("0000040D"));
    QCOMPARE(IdOfXkbLayout(QStringLiteral("us")), QStringLiteral("00000409"));
    QCOMPARE(IdOfXkbLayout(QStringLiteral("de")), QString());
}

QTEST_MAIN(TestKeyboardLayout)
#include "test_keyboard_layout.moc"

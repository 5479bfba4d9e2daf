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
    explicit FakeKeyboard(QStringList installed) : installed_(std::move(installed)) {}
    QString ActiveLayoutName() override { return failing_ ? throw MakeError(5) : active_; }
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
    QString active_ = QStringLiteral("00000409");
};

}  // namespace

class TestKeyboardLayout : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void hebrewOnceEnglishBackFailureReported();
    void switching_data();
    void switching();
    void xkbGroups();

  private:
    FakeKeyboard* fake_ = nullptr;
    std::unique_ptr<KeyboardPlatform> previous_;
};

void TestKeyboardLayout::init() {
    previous_ = SetKeyboardPlatform(nullptr);
    auto fake = std::make_unique<FakeKeyboard>(
        QStringList{QStringLiteral("00000409"), QStringLiteral("0000040D")});
    fake_ = fake.get();
    SetKeyboardPlatform(std::move(fake));
}

void TestKeyboardLayout::cleanup() {
    SetKeyboardPlatform(std::move(previous_));
}

void TestKeyboardLayout::hebrewOnceEnglishBackFailureReported() {
    test::ScopedScriptedUi ui;
    SetKbHebrew(true);
    QCOMPARE(fake_->ActiveLayoutName(), QStringLiteral("0000040D"));
    SetKbHebrew(true);
    QCOMPARE(fake_->loads, 1);
    SetKbHebrew(false);
    QCOMPARE(fake_->ActiveLayoutName(), QStringLiteral("00000409"));
    QCOMPARE(fake_->loads, 2);
    QCOMPARE(ui->Texts(), QStringList());
    fake_->failing_ = true;
    QVERIFY(!SetKbLayout(QStringLiteral("0000040D")));
    QCOMPARE(ui->Texts(),
             QStringList{QStringLiteral("5-SetKbLayout-Invalid procedure call or argument\r\n")});
}

void TestKeyboardLayout::switching_data() {
    QTest::addColumn<QString>("requested");
    QTest::addColumn<bool>("result");
    QTest::addColumn<QString>("activeAfter");
    QTest::addColumn<int>("loads");
    const auto row = [](const char* name, const char* requested, bool result, const char* active,
                        int loads) {
        QTest::newRow(name) << QString::fromLatin1(requested) << result
                            << QString::fromLatin1(active) << loads;
    };
    row("Hebrew installed", "0000040D", true, "0000040D", 1);
    row("already active", "00000409", true, "00000409", 0);
    row("layout not installed", "00000419", false, "00000409", 1);
    row("lower case loads but fails", "0000040d", false, "0000040D", 1);
    row("empty identifier", "", false, "00000409", 1);
}

void TestKeyboardLayout::switching() {
    QFETCH(QString, requested);
    QFETCH(bool, result);
    QFETCH(QString, activeAfter);
    QFETCH(int, loads);
    QCOMPARE(SetKbLayout(requested), result);
    QCOMPARE(fake_->ActiveLayoutName(), activeAfter);
    QCOMPARE(fake_->loads, loads);
}

void TestKeyboardLayout::xkbGroups() {
    const QString symbols = QStringLiteral("pc+us+ru:2+il(phonetic):3+inet(evdev)");
    QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("0000040d"))), 2);
    QCOMPARE(XkbGroupOfLayout(symbols, XkbLayoutOfId(QStringLiteral("00000409"))), 0);
    QCOMPARE(XkbLayoutOfGroup(symbols, 1), QString());
    QCOMPARE(XkbGroupOfLayout(QStringLiteral("pc+il+us:2+group(alt_shift_toggle)"), "us"), 1);
    QCOMPARE(XkbGroupOfLayout(QStringLiteral("pc+de+inet(evdev)"), "il"), -1);
    QCOMPARE(IdOfXkbLayout(QStringLiteral("il")), QStringLiteral("0000040D"));
}

QTEST_MAIN(TestKeyboardLayout)
#include "test_keyboard_layout.moc"

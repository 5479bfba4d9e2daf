// The window font fixes: which controls change, the per-user marker that stops them, the
// medium font of the settings and its cache; and finding a loaded window by name.
#include <QCheckBox>
#include <QDir>
#include <QFontInfo>
#include <QFontMetrics>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include "controls/gdate.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "ui/font_fix.h"
#include "ui/form_is_loaded.h"
#include "util/settings_store.h"
#include "util/state.h"

using namespace zv;
using namespace Qt::Literals::StringLiterals;

namespace {

const QString kArial = u"Arial"_s;

// A window with one control of each interesting kind, all in Arial 11.
class Window : public QWidget {
  public:
    Window() {
        setObjectName(u"FrmTest"_s);
        Add<QCheckBox>("ChkMarlett")->setFont(QFont(u"Marlett"_s, 11));
        Add<QCheckBox>("CmdSearch");
        Add<QCheckBox>("chkcolor_2");  // member of an exempt control array, other case
        Add<QPushButton>("CmdSearchTik")->setCheckable(true);
        Add<QCheckBox>("CmdOK");
        Add<QPushButton>("CmdGet");  // an exempt name, but a plain button
        Add<QLabel>("Label1");
        Add<QLineEdit>("TxtTeur");
        auto* date = new GDate(this);
        date->setObjectName(u"TDate"_s);
    }

    QWidget& Control(const char* name) {
        auto* w = findChild<QWidget*>(QLatin1String(name));
        Q_ASSERT(w);
        return *w;
    }

  private:
    template <class T>
    T* Add(const char* name) {
        auto* w = new T(this);
        w->setObjectName(QLatin1String(name));
        w->setFont(QFont(kArial, 11));
        return w;
    }
};

void WriteMarker(const QString& dataDir, const QString& user) {
    QDir().mkpath(dataDir + u"/GDetDef"_s);
    QFile marker(dataDir + u"/GDetDef/StopFixFonts."_s + user);
    QVERIFY(marker.open(QIODevice::WriteOnly));
}

void SaveGeneral(const QString& key, const QString& value) {
    SaveSetting(u"Kavex32"_s, u"General"_s, key, value);
}

}  // namespace

class TestFontFix : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init();
    void cleanup();
    void fixesControls_data();
    void fixesControls();
    void fixedFontHasHebrewGlyphs();
    void markerStopsOnlyItsUser_data();
    void markerStopsOnlyItsUser();
    void mediumFont_data();
    void mediumFont();
    void mediumFontCache_data();
    void mediumFontCache();
    void mediumFontBadSizeIsReported();
    void formIsLoaded();

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

void TestFontFix::init() {
    env_ = std::make_unique<test::TestEnv>();
    ui_ = std::make_unique<test::ScopedScriptedUi>();
    QDir().mkpath(env_->DataDir());
    SetMainPath(env_->DataDir());
    SetMyUser(u"7"_s);
}

void TestFontFix::cleanup() {
    QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
    ui_.reset();
    env_.reset();
}

void TestFontFix::fixesControls_data() {
    QTest::addColumn<QString>("control");
    QTest::addColumn<bool>("fixed");
    QTest::newRow("Marlett check box") << u"ChkMarlett"_s << false;
    QTest::newRow("exempt check box") << u"CmdSearch"_s << false;
    QTest::newRow("exempt control array, other case") << u"chkcolor_2"_s << false;
    QTest::newRow("exempt checkable button") << u"CmdSearchTik"_s << false;
    QTest::newRow("ordinary check box") << u"CmdOK"_s << true;
    QTest::newRow("exempt name on a plain button") << u"CmdGet"_s << true;
    QTest::newRow("label") << u"Label1"_s << true;
    QTest::newRow("date box") << u"TDate"_s << true;
}

void TestFontFix::fixesControls() {
    QFETCH(QString, control);
    QFETCH(bool, fixed);
    Window w;
    const QFont before = w.Control(qPrintable(control)).font();
    FixControlsFontOnMe(w);
    const QFont after = w.Control(qPrintable(control)).font();
    if (fixed) {
        QCOMPARE(after.family(), FixedFontFamily());
        QCOMPARE(after.pointSize(), 8);
    } else {
        QCOMPARE(after.family(), before.family());
        QCOMPARE(after.pointSize(), 11);
    }
}

void TestFontFix::fixedFontHasHebrewGlyphs() {
    QLabel label(u"שלום"_s);
    label.setObjectName(u"Label1"_s);
    FixControlCharset(label);
    const QFontMetrics metrics(label.font());
    for (const QChar ch : u"אבגדהוזחטיכלמנסעפצקרשת"_s) {
        QVERIFY2(metrics.inFont(ch), qPrintable(QFontInfo(label.font()).family()));
    }
}

void TestFontFix::markerStopsOnlyItsUser_data() {
    QTest::addColumn<QString>("markerUser");
    QTest::addColumn<bool>("fixed");
    QTest::newRow("marker of this user") << u"7"_s << false;
    QTest::newRow("marker of another user") << u"8"_s << true;
    QTest::newRow("no marker") << QString() << true;
}

void TestFontFix::markerStopsOnlyItsUser() {
    QFETCH(QString, markerUser);
    QFETCH(bool, fixed);
    if (!markerUser.isEmpty()) {
        WriteMarker(env_->DataDir(), markerUser);
    }
    Window w;
    FixControlsFontOnMe(w);
    for (const char* name : {"CmdOK", "Label1", "TxtTeur"}) {
        QCOMPARE(w.Control(name).font().family(), fixed ? FixedFontFamily() : kArial);
    }
}

void TestFontFix::mediumFont_data() {
    QTest::addColumn<QStringList>("settings");  // key=value pairs
    QTest::addColumn<QString>("family");        // empty: nothing changes
    QTest::addColumn<double>("size");
    QTest::newRow("special pair wins")
        << QStringList{"MedFontNameSpe=Tahoma", "MedFontSizeSpe=10.5", "MedFontName=Courier",
                       "MedFontSize=12"}
        << u"Tahoma"_s << 10.5;
    QTest::newRow("special size not numeric, fallback pair")
        << QStringList{"MedFontNameSpe=Tahoma", "MedFontSizeSpe=abc", "MedFontName=Courier",
                       "MedFontSize=12"}
        << u"Courier"_s << 12.0;
    QTest::newRow("special size empty, no fallback")
        << QStringList{"MedFontNameSpe=Tahoma"} << QString() << 0.0;
    QTest::newRow("nothing set") << QStringList{} << QString() << 0.0;
}

void TestFontFix::mediumFont() {
    QFETCH(QStringList, settings);
    QFETCH(QString, family);
    QFETCH(double, size);
    for (const QString& pair : settings) {
        SaveGeneral(pair.section(u'=', 0, 0), pair.section(u'=', 1));
    }
    Window w;
    const QStringList changing = {"Label1", "CmdOK", "CmdGet"};
    const QStringList keeping = {"TxtTeur", "CmdSearch", "chkcolor_2"};
    for (const QString& name : changing + keeping) {
        SetMedFont(w.Control(qPrintable(name)));
    }
    for (const QString& name : changing + keeping) {
        const QFont f = w.Control(qPrintable(name)).font();
        if (!family.isEmpty() && changing.contains(name)) {
            QCOMPARE(f.family(), family);
            QCOMPARE(f.pointSizeF(), size);
        } else {
            QCOMPARE(f.family(), kArial);
            QCOMPARE(f.pointSizeF(), 11.0);
        }
    }
}

void TestFontFix::mediumFontCache_data() {
    QTest::addColumn<QString>("suffix");
    QTest::addColumn<QString>("family");  // after the settings change
    QTest::newRow("special pair is kept") << u"Spe"_s << u"Tahoma"_s;
    QTest::newRow("fallback pair is read each time") << QString() << u"Courier"_s;
}

void TestFontFix::mediumFontCache() {
    QFETCH(QString, suffix);
    QFETCH(QString, family);
    SaveGeneral(u"MedFontName"_s + suffix, u"Tahoma"_s);
    SaveGeneral(u"MedFontSize"_s + suffix, u"10"_s);
    QLabel first;
    SetMedFont(first);
    QCOMPARE(first.font().family(), u"Tahoma"_s);
    SaveGeneral(u"MedFontName"_s + suffix, u"Courier"_s);
    SaveGeneral(u"MedFontSize"_s + suffix, u"14"_s);
    QLabel second;
    SetMedFont(second);
    QCOMPARE(second.font().family(), family);
    QCOMPARE(second.font().pointSizeF(), family == u"Tahoma"_s ? 10.0 : 14.0);
}

void TestFontFix::mediumFontBadSizeIsReported() {
    SaveGeneral(u"MedFontNameSpe"_s, u"Tahoma"_s);
    SaveGeneral(u"MedFontSizeSpe"_s, u"1e999"_s);
    QLabel label;
    label.setFont(QFont(kArial, 11));
    SetMedFont(label);
    QCOMPARE((*ui_)->Texts(), QStringList{u"6-0--Overflow"_s});
    QCOMPARE(label.font().family(), kArial);
    (*ui_)->Clear();
}

void TestFontFix::formIsLoaded() {
    QVERIFY(!FormIsLoaded(u"FrmGetDocDet"_s));
    auto* dialog = new QWidget;
    dialog->setObjectName(u"FrmGetDocDet"_s);
    auto* child = new QWidget(dialog);
    child->setObjectName(u"CmdOK"_s);
    // Loaded, whether shown or hidden; only windows count.
    QVERIFY(FormIsLoaded(u"frmgetdocdet"_s));
    dialog->show();
    QVERIFY(FormIsLoaded(u"FRMGETDOCDET"_s));
    QVERIFY(!FormIsLoaded(u"CmdOK"_s));
    QVERIFY(!FormIsLoaded(u"FrmGetDoc"_s));
    delete dialog;
    QVERIFY(!FormIsLoaded(u"FrmGetDocDet"_s));
}

QTEST_MAIN(TestFontFix)
#include "test_font_fix.moc"

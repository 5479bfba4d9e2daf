// The window font fixes: which controls change, the per-user marker that stops them, the
// medium font of the settings and its cache; and finding a loaded window by name.
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QFontInfo>
#include <QFontMetrics>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QTableView>
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

const QString kArial = QStringLiteral("Arial");

// A window with one control of each interesting kind, all in Arial 11.
class Window : public QWidget {
  public:
    Window() {
        setObjectName(QStringLiteral("FrmTest"));
        Add<QCheckBox>("ChkMarlett")->setFont(QFont(QStringLiteral("Marlett"), 11));
        Add<QCheckBox>("CmdSearch");
        Add<QCheckBox>("chkcolor_2");  // member of an exempt control array, other case
        Add<QPushButton>("CmdSearchTik")->setCheckable(true);
        Add<QCheckBox>("CmdOK");
        Add<QPushButton>("CmdGet");  // an exempt name, but a plain button
        Add<QLabel>("Label1");
        Add<QLineEdit>("TxtTeur");
        Add<QComboBox>("CboStatus");
        Add<QRadioButton>("Option1_0");
        Add<QListWidget>("List1");
        Add<QGroupBox>("Frame1");
        Add<QTableView>("TDBGrid1");
        auto* date = new GDate(this);
        date->setObjectName(QStringLiteral("TDate"));
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
    QDir().mkpath(dataDir + QStringLiteral("/GDetDef"));
    QFile marker(dataDir + QStringLiteral("/GDetDef/StopFixFonts.") + user);
    QVERIFY(marker.open(QIODevice::WriteOnly));
}

void SaveGeneral(const QString& key, const QString& value) {
    SaveSetting(QStringLiteral("Kavex32"), QStringLiteral("General"), key, value);
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
    void mediumFontSpecialPairIsCached();
    void mediumFontFallbackIsReadEachTime();
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
    SetMyUser(QStringLiteral("7"));
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
    QTest::newRow("text box") << u"TxtTeur"_s << true;
    QTest::newRow("combo box") << u"CboStatus"_s << true;
    QTest::newRow("option button") << u"Option1_0"_s << true;
    QTest::newRow("list") << u"List1"_s << true;
    QTest::newRow("frame") << u"Frame1"_s << true;
    QTest::newRow("grid") << u"TDBGrid1"_s << true;
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
    QLabel label(QStringLiteral("שלום"));
    label.setObjectName(QStringLiteral("Label1"));
    FixControlCharset(label);
    const QFontMetrics metrics(label.font());
    for (const QChar ch : QStringLiteral("אבגדהוזחטיכלמנסעפצקרשת")) {
        QVERIFY2(metrics.inFont(ch), qPrintable(QFontInfo(label.font()).family()));
    }
}

void TestFontFix::markerStopsOnlyItsUser_data() {
    QTest::addColumn<QString>("markerUser");
    QTest::addColumn<bool>("fixed");
    QTest::newRow("marker of this user") << QStringLiteral("7") << false;
    QTest::newRow("marker of another user") << QStringLiteral("8") << true;
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
    QTest::newRow("special pair") << QStringList{"MedFontNameSpe=Tahoma", "MedFontSizeSpe=10"}
                                  << u"Tahoma"_s << 10.0;
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
    QTest::newRow("fallback without size")
        << QStringList{"MedFontName=Courier"} << QString() << 0.0;
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
    const QStringList changing = {"Label1", "CmdOK", "CmdGet", "Option1_0", "List1", "Frame1"};
    const QStringList keeping = {"TxtTeur", "CboStatus", "CmdSearch", "chkcolor_2"};
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

void TestFontFix::mediumFontSpecialPairIsCached() {
    SaveGeneral(QStringLiteral("MedFontNameSpe"), QStringLiteral("Tahoma"));
    SaveGeneral(QStringLiteral("MedFontSizeSpe"), QStringLiteral("10"));
    QLabel first;
    SetMedFont(first);
    SaveGeneral(QStringLiteral("MedFontNameSpe"), QStringLiteral("Courier"));
    SaveGeneral(QStringLiteral("MedFontSizeSpe"), QStringLiteral("14"));
    QLabel second;
    SetMedFont(second);
    QCOMPARE(second.font().family(), QStringLiteral("Tahoma"));
    QCOMPARE(second.font().pointSizeF(), 10.0);
}

void TestFontFix::mediumFontFallbackIsReadEachTime() {
    SaveGeneral(QStringLiteral("MedFontName"), QStringLiteral("Tahoma"));
    SaveGeneral(QStringLiteral("MedFontSize"), QStringLiteral("9"));
    QLabel first;
    SetMedFont(first);
    QCOMPARE(first.font().family(), QStringLiteral("Tahoma"));
    SaveGeneral(QStringLiteral("MedFontName"), QStringLiteral("Courier"));
    SaveGeneral(QStringLiteral("MedFontSize"), QStringLiteral("14"));
    QLabel second;
    SetMedFont(second);
    QCOMPARE(second.font().family(), QStringLiteral("Courier"));
    QCOMPARE(second.font().pointSizeF(), 14.0);
}

void TestFontFix::mediumFontBadSizeIsReported() {
    SaveGeneral(QStringLiteral("MedFontNameSpe"), QStringLiteral("Tahoma"));
    SaveGeneral(QStringLiteral("MedFontSizeSpe"), QStringLiteral("1e999"));
    QLabel label;
    label.setFont(QFont(kArial, 11));
    SetMedFont(label);
    QCOMPARE((*ui_)->Texts(), QStringList{QStringLiteral("6-0--Overflow")});
    QCOMPARE(label.font().family(), kArial);
    (*ui_)->Clear();
}

void TestFontFix::formIsLoaded() {
    QVERIFY(!FormIsLoaded(QStringLiteral("FrmGetDocDet")));
    auto* dialog = new QWidget;
    dialog->setObjectName(QStringLiteral("FrmGetDocDet"));
    auto* child = new QWidget(dialog);
    child->setObjectName(QStringLiteral("CmdOK"));
    // Loaded, whether shown or hidden; only windows count.
    QVERIFY(FormIsLoaded(QStringLiteral("frmgetdocdet")));
    dialog->show();
    QVERIFY(FormIsLoaded(QStringLiteral("FRMGETDOCDET")));
    dialog->hide();
    QVERIFY(FormIsLoaded(QStringLiteral("FrmGetDocDet")));
    QVERIFY(!FormIsLoaded(QStringLiteral("CmdOK")));
    QVERIFY(!FormIsLoaded(QStringLiteral("FrmGetDoc")));
    delete dialog;
    QVERIFY(!FormIsLoaded(QStringLiteral("FrmGetDocDet")));
}

QTEST_MAIN(TestFontFix)
#include "test_font_fix.moc"

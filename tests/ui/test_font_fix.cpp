// The window font fixes: which controls change, the per-user marker that stops them, the
// medium font of the settings and its cache.
#include <QCheckBox>
#include <QFontInfo>
#include <QFontMetrics>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QtTest>

#include "controls/gdate.h"
#include "scripted_ui.h"
#include "test_env.h"
#include "test_files.h"
#include "ui/font_fix.h"
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
        Add<QCheckBox>("ChkMarlett")->setFont(QFont(u"Marlett"_s, 11));
        Add<QCheckBox>("CmdSearch");
        Add<QCheckBox>("chkcolor_2");  // member of an exempt control array, other case
        Add<QPushButton>("CmdSearchTik")->setCheckable(true);
        Add<QCheckBox>("CmdOK");
        Add<QPushButton>("CmdGet");  // an exempt name, but a plain button
        Add<QLabel>("Label1");
        Add<QLineEdit>("TxtTeur");
        Add<GDate>("TDate");
    }
    QFont FontOf(const QString& name) const { return findChild<QWidget*>(name)->font(); }

  private:
    template <class T>
    T* Add(const char* name) {
        auto* w = new T(this);
        w->setObjectName(QLatin1String(name));
        w->setFont(QFont(kArial, 11));
        return w;
    }
};

void SaveGeneral(const QString& key, const QString& value) {
    SaveSetting(u"Kavex32"_s, u"General"_s, key, value);
}

}  // namespace

class TestFontFix : public QObject {
    Q_OBJECT
  private Q_SLOTS:
    void init() {
        env_ = std::make_unique<test::TestEnv>();
        ui_ = std::make_unique<test::ScopedScriptedUi>();
        SetMainPath(env_->DataDir());
        SetMyUser(u"7"_s);
    }
    void cleanup() {
        QVERIFY2((*ui_)->Messages().empty(), qPrintable((*ui_)->Texts().join(u'|')));
        ui_.reset();
        env_.reset();
    }

    void fixesControls() {
        Window w;
        FixControlsFontOnMe(w);
        const QStringList fixed{"CmdOK", "CmdGet", "Label1", "TxtTeur", "TDate"};
        for (const QString& name :
             fixed + QStringList{"ChkMarlett", "CmdSearch", "chkcolor_2", "CmdSearchTik"}) {
            const QFont f = w.FontOf(name);
            QVERIFY2((f.family() == FixedFontFamily()) == fixed.contains(name) &&
                         f.pointSize() == (fixed.contains(name) ? 8 : 11),
                     qPrintable(name));
        }
    }

    void fixedFontHasHebrewGlyphs() {
        QLabel label(u"שלום"_s);
        label.setObjectName(u"Label1"_s);
        FixControlCharset(label);
        const QFontMetrics metrics(label.font());
        for (const QChar ch : u"אבגדהוזחטיכלמנסעפצקרשת"_s) {
            QVERIFY2(metrics.inFont(ch), qPrintable(QFontInfo(label.font()).family()));
        }
    }

    // Another user's marker leaves the fixes on; this user's stops them.
    void markerStopsOnlyItsUser() {
        for (const QString& user : {u"8"_s, u"7"_s}) {
            QVERIFY(test::WriteFile(env_->DataDir() + u"/GDetDef/StopFixFonts."_s + user, {}));
            Window w;
            FixControlsFontOnMe(w);
            QCOMPARE(w.FontOf(u"Label1"_s).family(), user == u"8"_s ? FixedFontFamily() : kArial);
        }
    }

    // The special pair wins while its size is a number; else the other pair, when complete.
    void mediumFont_data() {
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
    }

    // Labels, buttons and check boxes take it; text boxes and symbol buttons do not.
    void mediumFont() {
        QFETCH(QStringList, settings);
        QFETCH(QString, family);
        QFETCH(double, size);
        for (const QString& pair : settings) {
            SaveGeneral(pair.section(u'=', 0, 0), pair.section(u'=', 1));
        }
        Window w;
        const QStringList changing = {"Label1", "CmdOK", "CmdGet"};
        for (const QString& name : changing + QStringList{"TxtTeur", "CmdSearch", "chkcolor_2"}) {
            auto* control = w.findChild<QWidget*>(name);
            SetMedFont(*control);
            const bool changed = !family.isEmpty() && changing.contains(name);
            QCOMPARE(control->font().family(), changed ? family : kArial);
            QCOMPARE(control->font().pointSizeF(), changed ? size : 11.0);
        }
    }

    void mediumFontCache_data() {
        QTest::addColumn<QString>("suffix");
        QTest::addColumn<QString>("family");  // after the settings change
        QTest::newRow("special pair is kept") << u"Spe"_s << u"Tahoma"_s;
        QTest::newRow("fallback pair is read each time") << QString() << u"Courier"_s;
    }

    void mediumFontCache() {
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

    void mediumFontBadSizeIsReported() {
        SaveGeneral(u"MedFontNameSpe"_s, u"Tahoma"_s);
        SaveGeneral(u"MedFontSizeSpe"_s, u"1e999"_s);
        QLabel label;
        label.setFont(QFont(kArial, 11));
        SetMedFont(label);
        QCOMPARE((*ui_)->Texts(), QStringList{u"6-0--Overflow"_s});
        QCOMPARE(label.font().family(), kArial);
        (*ui_)->Clear();
    }

  private:
    std::unique_ptr<test::TestEnv> env_;
    std::unique_ptr<test::ScopedScriptedUi> ui_;
};

QTEST_MAIN(TestFontFix)
#include "test_font_fix.moc"

#include "ui/font_fix.h"

#include <QAbstractButton>
#include <QCheckBox>
#include <QFont>
#include <QFontDatabase>
#include <QGroupBox>
#include <QLabel>
#include <QListView>
#include <QRadioButton>
#include <QRegularExpression>
#include <QWidget>

#include "data/values.h"
#include "util/errors.h"
#include "util/file_utils.h"
#include "util/settings_store.h"
#include "util/state.h"

namespace zv {
namespace {

constexpr int kFixedPointSize = 8;

// Installed families with Hebrew glyphs, best first, for systems without the suite's font.
const QStringList& HebrewFallbacks() {
    static const QStringList families = {QStringLiteral("DejaVu Sans"),
                                         QStringLiteral("Noto Sans Hebrew"),
                                         QStringLiteral("FreeSans")};
    return families;
}

// The name a control has in its window: a member of a control array ("Option1_2") goes by
// the array's name.
QString ControlName(const QWidget& w) {
    static const QRegularExpression index(QStringLiteral("_\\d+$"));
    QString name = w.objectName();
    name.remove(index);
    return name;
}

bool IsSymbolButtonName(const QWidget& w) {
    return SymbolButtonNames().contains(ControlName(w), Qt::CaseInsensitive);
}

// Check boxes, also those drawn as push buttons, which is how the suite makes its symbol
// buttons.
bool IsCheckBox(const QWidget& w) {
    if (qobject_cast<const QCheckBox*>(&w)) {
        return true;
    }
    const auto* button = qobject_cast<const QAbstractButton*>(&w);
    return button && button->isCheckable() && !qobject_cast<const QRadioButton*>(&w);
}

// A control of a window, as opposed to the inner parts of Qt's composite widgets.
bool IsControl(const QWidget& w) {
    const QString name = w.objectName();
    return !name.isEmpty() && !name.startsWith(QLatin1String("qt_"));
}

bool TakesMedFont(const QWidget& w) {
    if (IsCheckBox(w)) {
        return !IsSymbolButtonName(w);
    }
    return qobject_cast<const QAbstractButton*>(&w) || qobject_cast<const QLabel*>(&w) ||
           qobject_cast<const QListView*>(&w) || qobject_cast<const QGroupBox*>(&w);
}

QString ReadGeneral(const QString& key) {
    return GetSetting(QStringLiteral("KAVEX32"), QStringLiteral("General"), key);
}

}  // namespace

QString FixedFontFamily() {
    return QStringLiteral("MS Sans Serif");
}

void SubstituteFixedFont() {
    static const bool done = [] {
        if (!QFontDatabase::hasFamily(FixedFontFamily())) {
            QFont::insertSubstitutions(FixedFontFamily(), HebrewFallbacks());
        }
        return true;
    }();
    Q_UNUSED(done);
}

const QStringList& SymbolButtonNames() {
    static const QStringList names = {
        QStringLiteral("CmdSearch"),       QStringLiteral("CmdSetTikMovil"),
        QStringLiteral("CmdSearchLak"),    QStringLiteral("CmdSearchSapak"),
        QStringLiteral("CmdActIshuv"),     QStringLiteral("CmdActAddress"),
        QStringLiteral("CmdGet"),          QStringLiteral("CmdFastSearch"),
        QStringLiteral("CmdCboSearch"),    QStringLiteral("CmdSearchTeur"),
        QStringLiteral("CmdSearchMemo"),   QStringLiteral("CmdDtSearch"),
        QStringLiteral("CmdSearchAllDay"), QStringLiteral("CmdSearchPersonal"),
        QStringLiteral("CmdtaskAccomp"),   QStringLiteral("CmdSearchPMemo"),
        QStringLiteral("ChkColor"),        QStringLiteral("CmdSearchTik"),
    };
    return names;
}

QString StopFixFontsFile() {
    return MainPath() + QStringLiteral("\\GDetDef\\StopFixFonts.") + MyUser();
}

void FixControlsFontOnMe(QWidget& frm) {
    if (IsFileExist(StopFixFontsFile())) {
        return;
    }
    const auto controls = frm.findChildren<QWidget*>();
    for (QWidget* ctl : controls) {
        if (IsControl(*ctl)) {
            FixControlCharset(*ctl);
        }
    }
}

void FixControlCharset(QWidget& ctl) {
    if (IsCheckBox(ctl) &&
        (ctl.font().family().compare(QLatin1String("Marlett"), Qt::CaseInsensitive) == 0 ||
         IsSymbolButtonName(ctl))) {
        return;
    }
    SubstituteFixedFont();
    // The Hebrew character set of the suite's fonts is implied by Unicode text.
    QFont font = ctl.font();
    font.setFamily(FixedFontFamily());
    font.setPointSize(kFixedPointSize);
    ctl.setFont(font);
}

void SetMedFont(QWidget& ctl) {
    Step([](const VbError& e) { return FormatWithLine(QString(), e); },
         [&] {
             if (MedFontNameSpeCache().isEmpty() || MedFontSizeSpeCache() == 0) {
                 SetMedFontNameSpeCache(ReadGeneral(QStringLiteral("MedFontNameSpe")));
                 SetMedFontSizeSpeCache(
                     GetDblFromStr(ReadGeneral(QStringLiteral("MedFontSizeSpe"))));
             }
             QString name = MedFontNameSpeCache();
             double size = MedFontSizeSpeCache();
             if (name.isEmpty() || size == 0) {
                 name = ReadGeneral(QStringLiteral("MedFontName"));
                 size = GetDblFromStr(ReadGeneral(QStringLiteral("MedFontSize")));
                 if (name.isEmpty() || size == 0) {
                     return;
                 }
             }
             if (!TakesMedFont(ctl)) {
                 return;
             }
             if (size < 0) {
                 throw VbError(380, QStringLiteral("Invalid property value"));
             }
             QFont font = ctl.font();
             font.setFamily(name);
             font.setPointSizeF(size);
             ctl.setFont(font);
         });
}

}  // namespace zv

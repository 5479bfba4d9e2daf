#pragma once
// The font fixes every window applies while it loads: its controls get "MS Sans Serif"
// 8 points (a family with Hebrew glyphs stands in where that one is not installed), except
// the small symbol buttons, which keep their own font. A user switches this off for
// himself with the marker file MainPath\GDetDef\StopFixFonts.<MyUser>.

#include <QString>
#include <QStringList>

class QWidget;

namespace zv {

// The family the fixes give; substituted on systems that lack it.
QString FixedFontFamily();
// Makes families with Hebrew glyphs stand in for it where it is not installed (once).
void SubstituteFixedFont();
// The names of the check boxes that serve as symbol buttons across the suite's windows.
const QStringList& SymbolButtonNames();
// The marker file of the current user.
QString StopFixFontsFile();

// Fixes every control of a window, unless the current user's marker file exists.
void FixControlsFontOnMe(QWidget& frm);
// Fixes one control. Check boxes drawn in Marlett or named as symbol buttons are left alone.
void FixControlCharset(QWidget& ctl);
// Gives a label, button, check or option box, list or frame the medium font of the
// settings (MedFontNameSpe / MedFontSizeSpe, else MedFontName / MedFontSize); text and
// combo boxes keep theirs. Nothing changes while neither pair is set.
void SetMedFont(QWidget& ctl);

}  // namespace zv

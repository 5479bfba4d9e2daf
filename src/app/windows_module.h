#pragma once
// The windows are a module of their own, loaded only by runs that may show one, so that a
// batch run starts without Qt Widgets, Gui and the libraries they bring (X11, fonts, GL).

// The module's entry, found by its name: the whole run, with the program's argc and argv.
extern "C" int zv_run_with_windows(int argc, char** argv);
inline constexpr char kWindowsEntryName[] = "zv_run_with_windows";

namespace zv {

// Loads the module next to the program and runs the whole request in it (QApplication,
// Qt's own options, the dialog). Returns the exit status; 1 with a message on standard
// error when the module cannot be loaded.
int RunWithWindows(int argc, char** argv);

}  // namespace zv

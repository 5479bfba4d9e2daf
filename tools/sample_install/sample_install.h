#pragma once
// A complete sample installation of the suite in a folder: the suite's marker
// Zorvane.Exe, the seven file databases with Hebrew sample rows, the DOCS folder layout,
// Def/, and the installation settings in the per-user settings store; with a server data
// source also the four server databases, Def/MSSQLSetting.INI and the MSql flags.
//
// Tests make a fresh installation in a temporary folder with
//     zv::CreateSampleInstallation(env.DataDir());
// after pointing XDG_CONFIG_HOME at a temporary folder (tests/support TestEnv does).

#include <QString>
#include <QStringList>

#include "sample_install/sample_options.h"

namespace zv {

// The logical names of the seven file databases; the files are NAME + ".MDB".
const QStringList& FileDatabaseNames();
// The inner folders created under DOCS/DOCBASIC.
const QStringList& SampleDocBasicFolders();

// Creates the installation; existing databases in dir are replaced. Throws
// std::runtime_error when a file, a database or the server cannot be written.
void CreateSampleInstallation(const QString& dir, const SampleOptions& options = {});

// The settings MainPath, MyUserName, MyUser, VolnaGlobNum and LNUM (application Kavex32,
// section General), MainPath = dir.
void WriteSampleSettings(const QString& dir, const SampleOptions& options);

}  // namespace zv

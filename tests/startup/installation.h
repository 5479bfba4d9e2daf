#pragma once
// A minimal installation for start-up tests: settings in the per-user settings file, the
// data folder (MainPath) with the suite's executable, and a document to file.

#include <QDir>
#include <QString>

#include "test_env.h"
#include "test_files.h"

namespace zv::test {

// withExe false leaves out Zorvane.Exe; an empty volna leaves out VolnaGlobNum. Returns the
// document's path.
inline QString MakeInstallation(const TestEnv& env, bool withExe = true,
                                const QByteArray& volna = "23") {
    QByteArray ini = "[General]\r\nMainPath=" + env.DataDir().toUtf8() + "\r\nMyUser=7\r\n";
    if (!volna.isEmpty()) {
        ini += "VolnaGlobNum=" + volna + "\r\n";
    }
    WriteFile(env.LocalAppData() + QStringLiteral("/Zorvane/Kavex32R.txt"), ini);
    QDir().mkpath(env.DataDir());
    if (withExe) {
        WriteFile(env.DataDir() + QStringLiteral("/Zorvane.Exe"), "MZ");
    }
    const QString document = env.Root() + QStringLiteral("/in/letter.docx");
    WriteFile(document, "document");
    return document;
}

}  // namespace zv::test

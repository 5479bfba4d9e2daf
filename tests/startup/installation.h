#pragma once
// A minimal installation for start-up tests: settings in the per-user settings file, the
// data folder with the suite's executable, and a document to file.

#include <QDir>
#include <QString>

#include "test_env.h"
#include "test_files.h"

namespace zv::test {

struct Installation {
    QString mainPath;
    QString document;
};

// withExe false leaves out Zorvane.Exe; an empty volna leaves out VolnaGlobNum.
inline Installation MakeInstallation(const TestEnv& env, bool withExe = true,
                                     const QByteArray& volna = "23") {
    Installation inst{env.DataDir(), env.Root() + QStringLiteral("/in/letter.docx")};
    QByteArray ini = "[General]\r\nMainPath=" + inst.mainPath.toUtf8() + "\r\nMyUser=7\r\n";
    if (!volna.isEmpty()) {
        ini += "VolnaGlobNum=" + volna + "\r\n";
    }
    WriteFile(env.LocalAppData() + QStringLiteral("/Zorvane/Kavex32R.txt"), ini);
    QDir().mkpath(inst.mainPath);
    if (withExe) {
        WriteFile(inst.mainPath + QStringLiteral("/Zorvane.Exe"), "MZ");
    }
    WriteFile(inst.document, "document");
    return inst;
}

}  // namespace zv::test

#pragma once
// A temporary environment for one test: the per-user settings store, LOCALAPPDATA and a
// data folder all live in a fresh temporary folder, and process-wide state starts empty.

#include <QProcessEnvironment>
#include <QString>
#include <QTemporaryDir>

namespace zv::test {

class TestEnv {
  public:
    TestEnv();
    ~TestEnv();
    TestEnv(const TestEnv&) = delete;
    TestEnv& operator=(const TestEnv&) = delete;

    // The temporary folder holding everything below.
    QString Root() const { return dir_.path(); }
    // $XDG_CONFIG_HOME of this test (the settings store lives below it).
    QString ConfigHome() const;
    // $LOCALAPPDATA of this test (exists, empty).
    QString LocalAppData() const;
    // A folder for the installation's data (MainPath), not created.
    QString DataDir() const;
    // The environment for a program started by the test: this test's settings, no display,
    // never a development run.
    QProcessEnvironment ProgramEnvironment() const;

  private:
    QTemporaryDir dir_;
    QByteArray oldConfig_, oldLocal_, oldDev_;
};

}  // namespace zv::test

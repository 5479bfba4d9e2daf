#include "test_env.h"

#include <QDir>

#include "util/clock.h"
#include "util/state.h"

namespace zv::test {

TestEnv::TestEnv()
    : oldConfig_(qgetenv("XDG_CONFIG_HOME")),
      oldLocal_(qgetenv("LOCALAPPDATA")),
      oldDev_(qgetenv("ZORVANE_DEVELOPMENT_RUN")) {
    QDir(dir_.path()).mkpath(QStringLiteral("config"));
    QDir(dir_.path()).mkpath(QStringLiteral("localappdata"));
    qputenv("XDG_CONFIG_HOME", ConfigHome().toUtf8());
    qputenv("LOCALAPPDATA", LocalAppData().toUtf8());
    qunsetenv("ZORVANE_DEVELOPMENT_RUN");
    ResetState();
    SetClock({});
}

TestEnv::~TestEnv() {
    auto restore = [](const char* name, const QByteArray& v) {
        if (v.isNull()) {
            qunsetenv(name);
        } else {
            qputenv(name, v);
        }
    };
    restore("XDG_CONFIG_HOME", oldConfig_);
    restore("LOCALAPPDATA", oldLocal_);
    restore("ZORVANE_DEVELOPMENT_RUN", oldDev_);
    ResetState();
    SetClock({});
}

QString TestEnv::ConfigHome() const {
    return dir_.path() + QStringLiteral("/config");
}
QString TestEnv::LocalAppData() const {
    return dir_.path() + QStringLiteral("/localappdata");
}
QString TestEnv::DataDir() const {
    return dir_.path() + QStringLiteral("/data");
}

QProcessEnvironment TestEnv::ProgramEnvironment() const {
    QProcessEnvironment pe = QProcessEnvironment::systemEnvironment();
    pe.insert(QStringLiteral("XDG_CONFIG_HOME"), ConfigHome());
    pe.insert(QStringLiteral("LOCALAPPDATA"), LocalAppData());
    pe.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    pe.remove(QStringLiteral("ZORVANE_DEVELOPMENT_RUN"));
    return pe;
}

}  // namespace zv::test

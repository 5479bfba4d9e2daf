#include "sample_install/test_server.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <atomic>

namespace zv {

SampleOptions TestServerOptions() {
    static std::atomic<int> installations{0};
    SampleOptions options;
    options.volnaGlobNum = QStringLiteral("%1%2")
                               .arg(QCoreApplication::applicationPid())
                               .arg(installations.fetch_add(1) + 1, 2, 10, QLatin1Char('0'));
    const QString host = qEnvironmentVariable("ZV_PG_HOST");
    const QString port = qEnvironmentVariable("ZV_PG_PORT");
    const QString socket = QDir(host).filePath(QStringLiteral(".s.PGSQL.") + port);
    if (host.isEmpty() || port.isEmpty() || !QFileInfo::exists(socket))
        return options;
    options.serverDataSource = host + QLatin1Char(',') + port;
    options.serverUser = qEnvironmentVariable("ZV_PG_USER", QStringLiteral("postgres"));
    return options;
}

bool ServerTestsRequired() {
    return qEnvironmentVariable("CI") == QLatin1String("true");
}

}  // namespace zv

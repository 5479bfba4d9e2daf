// zorvane-sample-install DIR [--server DATASOURCE] [--large] [--clients N] [--lookfor N]
// Creates a complete sample installation of the suite in DIR.

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QElapsedTimer>
#include <cstdio>
#include <cstdlib>
#include <exception>

#include "sample_install/sample_install.h"

namespace {

int ToCount(const QCommandLineParser& parser, const QString& name) {
    bool ok = false;
    const int n = parser.value(name).toInt(&ok);
    if (!ok || n < 0) {
        std::fprintf(stderr, "--%s needs a number, not \"%s\"\n", qPrintable(name),
                     qPrintable(parser.value(name)));
        std::exit(2);
    }
    return n;
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral(
        "Creates a sample installation of the suite: Zorvane.Exe, the seven file databases, "
        "the DOCS folders and the settings (application Kavex32, section General)."));
    parser.addHelpOption();
    parser.addPositionalArgument(QStringLiteral("DIR"), QStringLiteral("installation folder"));
    parser.addOptions({
        {QStringLiteral("server"),
         QStringLiteral("also create the server databases on this PostgreSQL data source "
                        "(host, host,port or socket-folder,port)"),
         QStringLiteral("DATASOURCE")},
        {QStringLiteral("server-user"), QStringLiteral("server login (default postgres)"),
         QStringLiteral("NAME"), QStringLiteral("postgres")},
        {QStringLiteral("server-password"), QStringLiteral("password of the server login"),
         QStringLiteral("PASSWORD")},
        {QStringLiteral("large"), QStringLiteral("100,000 clients and 1,000,000 names and cases")},
        {QStringLiteral("clients"), QStringLiteral("total clients"), QStringLiteral("N")},
        {QStringLiteral("lookfor"), QStringLiteral("total rows of names and cases"),
         QStringLiteral("N")},
        {QStringLiteral("client-number"),
         QStringLiteral("the installation's client number (default 23)"), QStringLiteral("N")},
        {QStringLiteral("no-settings"), QStringLiteral("do not write the settings store")},
    });
    parser.process(app);
    if (parser.positionalArguments().size() != 1)
        parser.showHelp(2);

    zv::SampleOptions options;
    if (parser.isSet(QStringLiteral("large"))) {
        options.clients = zv::kLargeClients;
        options.lookfor = zv::kLargeLookFor;
    }
    if (parser.isSet(QStringLiteral("clients")))
        options.clients = ToCount(parser, QStringLiteral("clients"));
    if (parser.isSet(QStringLiteral("lookfor")))
        options.lookfor = ToCount(parser, QStringLiteral("lookfor"));
    if (parser.isSet(QStringLiteral("client-number")))
        options.volnaGlobNum = parser.value(QStringLiteral("client-number"));
    options.serverDataSource = parser.value(QStringLiteral("server"));
    options.serverUser = parser.value(QStringLiteral("server-user"));
    options.serverPassword = parser.value(QStringLiteral("server-password"));
    options.writeSettings = !parser.isSet(QStringLiteral("no-settings"));

    const QString dir = parser.positionalArguments().first();
    QElapsedTimer timer;
    timer.start();
    try {
        zv::CreateSampleInstallation(dir, options);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "zorvane-sample-install: %s\n", e.what());
        return 1;
    }
    std::printf("sample installation in %s (%.1f s)\n", qPrintable(dir),
                static_cast<double>(timer.elapsed()) / 1000.0);
    return 0;
}

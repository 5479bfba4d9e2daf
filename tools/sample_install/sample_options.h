#pragma once
// What a sample installation holds: who uses it, how big it is, and whether its four
// server databases are created too.

#include <QString>

namespace zv {

struct SampleOptions {
    // Installation settings written to the settings store (application Kavex32).
    QString volnaGlobNum = QStringLiteral("23");
    QString myUser = QStringLiteral("1");
    QString myUserName = QStringLiteral("דנה כהן");
    QString officeCode = QStringLiteral("100");  // LNUM, the USERCODE of this office's users
    bool writeSettings = true;

    // Total rows of CLIENT and LOOKFOR. Below the size of the built-in set, the built-in
    // set alone; above it, generated rows make up the rest.
    int clients = 0;
    int lookfor = 0;

    // Server databases (PostgreSQL): empty data source means file databases only.
    QString serverDataSource;  // "host", "host,port" or "socket-folder,port"
    QString serverUser = QStringLiteral("postgres");
    QString serverPassword;
    // The MSql flags written for this installation when it has server databases.
    bool onServerOffice = true;
    bool onServerDocs = true;
    bool onServerBM = true;
    bool onServerZorva = true;
};

// The size of the large installation.
constexpr int kLargeClients = 100000;
constexpr int kLargeLookFor = 1000000;

}  // namespace zv

#pragma once
// The options of the program; what follows them is the filing request.

#include <QByteArray>
#include <QString>
#include <QStringList>

#include "startup/filing_options.h"

namespace zv {

struct CommandLine {
    bool batch = false;    // --batch: messages on standard error, no windows
    bool help = false;     // --help
    bool version = false;  // --version
    QString error;         // a usage error, for example an unknown option
    FilingOptions filing;  // what --batch files, in place of the dialog
    // The arguments after the options, joined with single spaces, as bytes.
    QByteArray request;
};

// Options come first; "--" ends them, and so does the first argument that does not begin
// with "-".
CommandLine ParseCommandLine(const QList<QByteArray>& args);
// The usage text of --help.
QString UsageText(const QString& program);

}  // namespace zv

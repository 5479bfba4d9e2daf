#include "startup/command_line.h"

namespace zv {

CommandLine ParseCommandLine(const QList<QByteArray>& args) {
    CommandLine cl;
    qsizetype i = 0;
    for (; i < args.size(); ++i) {
        const QByteArray& arg = args.at(i);
        if (arg == "--") {
            ++i;
            break;
        }
        if (!arg.startsWith('-') || arg == "-") {
            break;
        }
        if (arg == "--batch") {
            cl.batch = true;
        } else if (arg == "--help" || arg == "-h") {
            cl.help = true;
        } else if (arg == "--version") {
            cl.version = true;
        } else if (ParseFilingOption(args, i, cl.filing, cl.error)) {
            if (!cl.error.isEmpty()) {
                return cl;
            }
        } else {
            cl.error = QStringLiteral("unknown option: ") + QString::fromLocal8Bit(arg);
            return cl;
        }
    }
    cl.request = args.mid(i).join(' ');
    if (!cl.help && !cl.version) {
        cl.error = CheckFilingOptions(cl.batch, cl.filing);
    }
    return cl;
}

QString UsageText(const QString& program) {
    return QStringLiteral(
               "Usage: %1 [--batch --client NUM [filing options]] [--] MODE¥PATH¥NAME\n"
               "Files one document of the Zorvane suite: MODE 1 a document, 2 a mail message;\n"
               "PATH the file to file (it is moved into the archive); NAME a suggested name.\n"
               "\n"
               "Options:\n"
               "  --batch    no windows: messages go to standard error, defaults answer\n"
               "  --help     show this text\n"
               "  --version  show the version\n"
               "\n"
               "Exit status: 0 request handled (with --batch: filed), 1 request refused or\n"
               "not filed, 2 usage error.\n\n")
               .arg(program) +
           FilingOptionsUsage();
}

}  // namespace zv

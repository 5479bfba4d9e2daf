#include "app/run_request.h"

#include "startup/main_entry.h"
#include "startup/request_text.h"

namespace zv {

QList<QByteArray> ProgramArguments(int argc, char** argv) {
    QList<QByteArray> args;
    for (int i = 1; i < argc; ++i) {
        args.append(QByteArray(argv[i]));
    }
    return args;
}

void Print(std::FILE* stream, const QString& text) {
    const QByteArray bytes = text.toUtf8();
    std::fwrite(bytes.constData(), 1, static_cast<size_t>(bytes.size()), stream);
}

bool AnswerInformation(const CommandLine& cl, const char* program) {
    if (cl.help) {
        Print(stdout, UsageText(QString::fromLocal8Bit(program)));
        return true;
    }
    if (cl.version) {
        Print(stdout, QStringLiteral("zorvane-filer " ZV_VERSION "\n"));
        return true;
    }
    return false;
}

int RunRequest(const CommandLine& cl, const char* program, FilingHandler file) {
    QString archived;
    bool usageError = false;
    const int status =
        Main(DecodeArgumentText(cl.request), [&](int& mode, QString& path, QString& name) {
            // Checked only for a request that passed Main's checks, so that a missing
            // installation is reported as such also in batch runs.
            if (cl.batch && cl.filing.client.isEmpty()) {
                Print(stderr, QStringLiteral("zorvane-filer: --batch needs --client\n") +
                                  UsageText(QString::fromLocal8Bit(program)));
                usageError = true;
                return;
            }
            archived = file(cl, mode, path, name);
        });
    if (usageError) {
        return 2;
    }
    if (!cl.batch || status != 0) {
        return status;
    }
    if (archived.isEmpty()) {
        return 1;
    }
    Print(stdout, archived + QStringLiteral("\n"));
    return 0;
}

}  // namespace zv

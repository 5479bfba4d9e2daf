// zorvane-filer: files one document of the Zorvane suite per run.

#include <QApplication>
#include <QFont>
#include <QFontDatabase>
#include <QLibraryInfo>
#include <QTranslator>
#include <cstdio>
#include <memory>

#include "filing/filing_request_handler.h"
#include "startup/command_line.h"
#include "startup/main_entry.h"
#include "startup/request_text.h"
#include "ui/console_ui.h"
#include "ui/qt_ui.h"
#include "util/ui.h"

namespace {

QList<QByteArray> Arguments(int argc, char** argv) {
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

// Answers --help and --version; returns whether the run ends here.
bool AnswerInformation(const zv::CommandLine& cl, const char* program) {
    if (cl.help) {
        Print(stdout, zv::UsageText(QString::fromLocal8Bit(program)));
        return true;
    }
    if (cl.version) {
        Print(stdout, QStringLiteral("zorvane-filer " ZV_VERSION "\n"));
        return true;
    }
    return false;
}

// Hebrew button texts in Qt's own dialogs, right to left, and a Hebrew-capable family where
// the suite's "MS Sans Serif" is not installed.
void PrepareHebrewUi(QApplication& app) {
    QApplication::setLayoutDirection(Qt::RightToLeft);
    auto* translator = new QTranslator(&app);
    if (translator->load(QStringLiteral("qtbase_he"),
                         QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
        QApplication::installTranslator(translator);
    }
    const QString suiteFamily = QStringLiteral("MS Sans Serif");
    if (!QFontDatabase::families().contains(suiteFamily)) {
        QFont::insertSubstitution(suiteFamily, QStringLiteral("DejaVu Sans"));
    }
}

}  // namespace

int main(int argc, char** argv) {
    // Before Qt starts, so that --help needs no display, and --batch and a usage error
    // (unless it is one of Qt's own options) run without one.
    const zv::CommandLine early = zv::ParseCommandLine(Arguments(argc, argv));
    if (early.error.isEmpty() && AnswerInformation(early, argv[0])) {
        return 0;
    }
    if ((early.batch || !early.error.isEmpty()) && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM") &&
        qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY")) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }

    // --batch shows no window: a core application starts without a platform plugin and the
    // font configuration, which took half of its start-up. Otherwise QApplication, which
    // takes its own options (-platform ...) out of argv.
    std::unique_ptr<QCoreApplication> app;
    if (early.batch && early.error.isEmpty()) {
        app = std::make_unique<QCoreApplication>(argc, argv);
    } else {
        app = std::make_unique<QApplication>(argc, argv);
    }
    const zv::CommandLine cl = zv::ParseCommandLine(Arguments(argc, argv));
    if (!cl.error.isEmpty()) {
        Print(stderr, QStringLiteral("zorvane-filer: ") + cl.error + QStringLiteral("\n") +
                          zv::UsageText(QString::fromLocal8Bit(argv[0])));
        return 2;
    }
    if (AnswerInformation(cl, argv[0])) {
        return 0;
    }
    if (auto* gui = qobject_cast<QApplication*>(app.get())) {
        PrepareHebrewUi(*gui);
    }
    if (cl.batch) {
        zv::SetUi(std::make_unique<zv::ConsoleUi>());
    } else {
        zv::SetUi(std::make_unique<zv::QtUi>());
    }
    QString archived;
    bool usageError = false;
    const int status =
        zv::Main(zv::DecodeArgumentText(cl.request), [&](int& mode, QString& path, QString& name) {
            // Checked only for a request that passed Main's checks, so that a missing
            // installation is reported as such also in batch runs.
            if (cl.batch && cl.filing.client.isEmpty()) {
                Print(stderr, QStringLiteral("zorvane-filer: --batch needs --client\n") +
                                  zv::UsageText(QString::fromLocal8Bit(argv[0])));
                usageError = true;
                return;
            }
            archived = zv::HandleFilingRequest(cl, mode, path, name);
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

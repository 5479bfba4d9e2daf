// The program with its windows, loaded by zorvane-filer for every run that may show one.

#include <QApplication>
#include <QLibraryInfo>
#include <QTranslator>

#include "app/run_request.h"
#include "app/windows_module.h"
#include "filing/filing_request_handler.h"
#include "startup/command_line.h"
#include "ui/console_ui.h"
#include "ui/font_fix.h"
#include "ui/qt_ui.h"
#include "util/ui.h"

namespace {

// Hebrew button texts in Qt's own dialogs, right to left, and a Hebrew-capable family where
// the suite's font is not installed.
void PrepareHebrewUi() {
    QApplication::setLayoutDirection(Qt::RightToLeft);
    auto* translator = new QTranslator(qApp);
    if (translator->load(QStringLiteral("qtbase_he"),
                         QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
        QApplication::installTranslator(translator);
    }
    zv::SubstituteFixedFont();
}

}  // namespace

extern "C" Q_DECL_EXPORT int zv_run_with_windows(int argc, char** argv) {
    // A usage error (unless it is one of Qt's own options, which QApplication takes out of
    // argv) and --batch after Qt's options run without a display.
    const zv::CommandLine early = zv::ParseCommandLine(zv::ProgramArguments(argc, argv));
    if ((early.batch || !early.error.isEmpty()) && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM") &&
        qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY")) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }
    QApplication app(argc, argv);
    const zv::CommandLine cl = zv::ParseCommandLine(zv::ProgramArguments(argc, argv));
    if (!cl.error.isEmpty()) {
        zv::Print(stderr, QStringLiteral("zorvane-filer: ") + cl.error + QStringLiteral("\n") +
                              zv::UsageText(QString::fromLocal8Bit(argv[0])));
        return 2;
    }
    if (zv::AnswerInformation(cl, argv[0])) {
        return 0;
    }
    PrepareHebrewUi();
    if (cl.batch) {
        zv::SetUi(std::make_unique<zv::ConsoleUi>());
    } else {
        zv::SetUi(std::make_unique<zv::QtUi>());
    }
    return zv::RunRequest(cl, argv[0], zv::HandleFilingRequest);
}

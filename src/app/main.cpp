// zorvane-filer: files one document of the Zorvane suite per run.

#include <QCoreApplication>
#include <memory>

#include "app/run_request.h"
#include "app/windows_module.h"
#include "filing/batch_filing.h"
#include "startup/command_line.h"
#include "ui/console_ui.h"
#include "util/ui.h"

int main(int argc, char** argv) {
    // Before Qt starts, so that --help needs no display.
    const zv::CommandLine cl = zv::ParseCommandLine(zv::ProgramArguments(argc, argv));
    if (cl.error.isEmpty() && zv::AnswerInformation(cl, argv[0])) {
        return 0;
    }
    // Everything but a clean --batch run may show a window, or needs QApplication to take
    // Qt's own options out of argv.
    if (!cl.batch || !cl.error.isEmpty()) {
        return zv::RunWithWindows(argc, argv);
    }
    QCoreApplication app(argc, argv);
    zv::SetUi(std::make_unique<zv::ConsoleUi>());
    return zv::RunRequest(cl, argv[0], zv::HandleBatchRequest);
}

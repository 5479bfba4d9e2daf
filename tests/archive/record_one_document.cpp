// Files one archived document the way one filing process does, once told to start on its
// standard input, so that a test can file from many processes at one moment.
// Usage: record_one_document MAINPATH FILE. Exit code 0 when the row was saved and nothing
// was reported; messages go to standard error.
#include <QCoreApplication>
#include <QFileInfo>
#include <iostream>
#include <string>

#include "archive/docs_row.h"
#include "scripted_ui.h"
#include "util/state.h"

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    const QStringList args = QCoreApplication::arguments();
    if (args.size() != 3) {
        return 2;
    }
    zv::SetMainPath(args[1]);
    zv::SetMyUserName(QStringLiteral("filer"));
    zv::SetMyUser(QStringLiteral("7"));
    zv::test::ScopedScriptedUi ui;

    zv::DocDetails details;
    details.handlers = QFileInfo(args[2]).completeBaseName();
    details.reminder = true;
    details.reminderDate = QDate(2026, 12, 20);
    details.popup = true;

    std::cout << "ready" << std::endl;
    std::string go;
    std::getline(std::cin, go);

    const bool saved = zv::AddDocToListByAddIn(args[2], &details);
    for (const QString& text : ui->Texts()) {
        std::cerr << text.toStdString() << '\n';
    }
    return saved && ui->Texts().isEmpty() ? 0 : 1;
}

#include "ui/console_ui.h"

#include <QCoreApplication>
#include <QWidget>
#include <cstdio>

namespace zv {

int ConsoleUi::MsgBox(const QString& text, int style, const QString&) {
    QString line = text;
    line.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    const QByteArray bytes = (line + QLatin1Char('\n')).toUtf8();
    std::fwrite(bytes.constData(), 1, static_cast<size_t>(bytes.size()), stderr);
    std::fflush(stderr);
    return DefaultAnswer(style);
}

void ConsoleUi::ShowModal(QWidget& window) {
    // As if the user closed it: pickers then report IsCancel. Called by name, so that a batch
    // run, which never makes a window, links no window code.
    QMetaObject::invokeMethod(&window, "close", Qt::DirectConnection);
}

void ConsoleUi::DoEvents() {
    if (QCoreApplication::instance()) {
        QCoreApplication::processEvents();
    }
}

}  // namespace zv

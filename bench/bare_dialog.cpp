// bare_dialog [TEXT]: a Qt program that shows one empty dialog, the baseline of the time from
// process start to the filing dialog shown; with TEXT, a right-to-left dialog holding one
// label of that text, which is what any dialog that draws text must first pay for (the
// font configuration, a font, shaping).
#include <QApplication>
#include <QDialog>
#include <QLabel>
#include <QVBoxLayout>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QDialog dialog;
    if (argc > 1) {
        QApplication::setLayoutDirection(Qt::RightToLeft);
        auto* layout = new QVBoxLayout(&dialog);
        layout->addWidget(new QLabel(QString::fromLocal8Bit(argv[1])));
    }
    dialog.show();
    return app.exec();
}

// bare_dialog: a Qt program that shows one empty dialog; the baseline of the time from
// process start to the filing dialog shown.
#include <QApplication>
#include <QDialog>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QDialog dialog;
    dialog.show();
    return app.exec();
}

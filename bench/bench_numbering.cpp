// bench_numbering FOLDER [RUNS]
// Times the numbering button's search for the next free number (GetNextFileName) on a
// folder, as the dialog runs it for a .doc source; prints the median in milliseconds and
// the name it proposes.
#include <QCoreApplication>
#include <QElapsedTimer>
#include <algorithm>
#include <cstdio>
#include <vector>

#include "filing_dialog/file_naming.h"

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    if (argc < 2) {
        std::fprintf(stderr, "usage: bench_numbering FOLDER [RUNS]\n");
        return 2;
    }
    const QString folder = QString::fromLocal8Bit(argv[1]);
    const int runs = argc > 2 ? std::max(1, atoi(argv[2])) : 5;
    std::vector<double> ms;
    QString name;
    for (int i = 0; i < runs; ++i) {
        QElapsedTimer timer;
        timer.start();
        name = zv::GetNextFileName(folder, QStringLiteral("DOC"), QStringLiteral("T"));
        ms.push_back(static_cast<double>(timer.nsecsElapsed()) / 1e6);
    }
    std::sort(ms.begin(), ms.end());
    std::printf("%.1f\t%s\n", ms[ms.size() / 2], qPrintable(name));
    return name.isEmpty() ? 1 : 0;
}

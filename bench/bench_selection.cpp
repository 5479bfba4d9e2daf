// Times the client and name list windows on a large installation, each next to the bare
// engine (the sqlite3 shell, psql) running the same query in the same run.
//
//   bench_selection DIR [--server SOCKETDIR,PORT] [--client-number N] [--runs N]
//
// DIR is an installation made by zorvane-sample-install --large (with --server for the
// PostgreSQL figures). Prints a Markdown table of median times in milliseconds.

#include <QApplication>
#include <QCommandLineParser>
#include <QElapsedTimer>
#include <QLineEdit>
#include <QProcess>
#include <QRegularExpression>
#include <QTemporaryFile>
#include <algorithm>
#include <cstdio>
#include <functional>
#include <vector>

#include "data/connection_string.h"
#include "data/database.h"
#include "selection/list_model.h"
#include "selection/list_query.h"
#include "selection/list_window.h"
#include "ui/console_ui.h"
#include "util/state.h"

namespace zv {
namespace {

struct Case {
    const char* what;
    bool names;
    QString clientNum;  // names window opened for this client
    bool search;        // false: opening the window
    QString text;
};

struct Target {
    bool server;
    QString mainPath;
    QString socketDir;
    QString port;
};

double Median(std::vector<double> v) {
    std::sort(v.begin(), v.end());
    return v[v.size() / 2];
}

double TimeMs(const std::function<void()>& run) {
    QElapsedTimer t;
    t.start();
    run();
    return static_cast<double>(t.nsecsElapsed()) / 1e6;
}

ListVariant VariantOf(const Case& c, bool server) {
    if (c.names) {
        return server ? ListVariant::FrmLookForAdo : ListVariant::FrmLookFor;
    }
    return server ? ListVariant::FrmLakAdo : ListVariant::FrmLak;
}

ListQuery QueryOf(const Case& c, bool server) {
    if (!c.names) {
        return ClientListQuery(server, c.text);
    }
    return c.search ? NamesSearchQuery(server, c.clientNum, c.text)
                    : NamesOpenQuery(server, c.clientNum);
}

// The text the engine's own shell runs. The file database reads the Jet texts through
// registered functions; its shell knows SQLite's LIKE, whose wildcard is "%".
QString ShellSql(const Target& target, const Case& c) {
    const QString sql = QueryOf(c, target.server).Text();
    auto db =
        target.server
            ? Database::OpenConnectionString(GetConnectionByDbName(c.names ? "ZORVA" : "OFFICE"))
            : Database::OpenFile(c.names ? "\\ZORVA.MDB" : "\\OFFICE.MDB");
    QString engine = db->EngineSql(sql);
    if (target.server) {
        return engine;
    }
    static const QRegularExpression pattern(QStringLiteral("LIKE '((?:[^']|'')*)'"));
    QString shell;
    qsizetype from = 0;
    for (auto it = pattern.globalMatch(engine); it.hasNext();) {
        const auto m = it.next();
        QString literal = m.captured(1);
        literal.replace(QLatin1Char('*'), QLatin1Char('%')).replace(QLatin1Char('?'), '_');
        shell += engine.mid(from, m.capturedStart(1) - from) + literal;
        from = m.capturedEnd(1);
    }
    return shell + engine.mid(from);
}

struct ShellTime {
    double engineMs;  // the shell's own timer: running the query and printing its rows
    double wallMs;    // the whole shell process, connection included
};

ShellTime ShellMs(const Target& target, const Case& c) {
    QTemporaryFile out;
    out.open();
    QProcess p;
    p.setStandardOutputFile(out.fileName());
    const QString sql = ShellSql(target, c);
    QString program;
    QStringList args;
    QByteArray input;
    if (target.server) {
        program = QStringLiteral("psql");
        args = {"-X", "-q",
                "-h", target.socketDir,
                "-p", target.port,
                "-U", "postgres",
                "-d", (c.names ? "ZORVA" : "OFFICE") + VolnaGlobNum(),
                "-c", "\\timing on",
                "-c", sql};
    } else {
        program = QStringLiteral("sqlite3");
        args = {target.mainPath + (c.names ? "/ZORVA.MDB" : "/OFFICE.MDB")};
        input = ".timer on\n" + sql.toUtf8() + ";\n";
    }
    const double wall = TimeMs([&] {
        p.start(program, args);
        p.write(input);
        p.closeWriteChannel();
        p.waitForFinished(-1);
    });
    if (p.exitStatus() != QProcess::NormalExit || p.exitCode() != 0) {
        std::fprintf(stderr, "%s failed: %s\n", qPrintable(program),
                     p.readAllStandardError().constData());
    }
    // "Time: 12.345 ms" (psql) or "Run Time: real 0.012 ..." (sqlite3, seconds) at the end.
    out.seek(std::max<qint64>(0, out.size() - 200));
    const QString tail = QString::fromUtf8(out.readAll());
    static const QRegularExpression psqlTime(QStringLiteral("Time: ([0-9.]+) ms"));
    static const QRegularExpression sqliteTime(QStringLiteral("Run Time: real ([0-9.]+)"));
    const auto m = (target.server ? psqlTime : sqliteTime).match(tail);
    const double engine = m.captured(1).toDouble() * (target.server ? 1.0 : 1000.0);
    return {engine, wall};
}

struct WindowTime {
    double ms;       // opening, or a search repeated in an open window
    double firstMs;  // searches: the first search of a fresh window
    long long rows;
};

// Opening: a fresh window shown and painted. Searching: the search of an open window, once
// on a fresh window and once more.
WindowTime WindowMs(const Target& target, const Case& c) {
    ListWindow w(VariantOf(c, target.server));
    w.SetClientNum(c.clientNum);
    WindowTime t{};
    auto show = [&] {
        w.show();
        QApplication::processEvents();
    };
    if (!c.search) {
        t.ms = TimeMs(show);
    } else {
        show();
        w.findChild<QLineEdit*>(QStringLiteral("txtSearch"))->setText(c.text);
        auto search = [&] {
            w.DoSearch();
            QApplication::processEvents();
        };
        t.firstMs = TimeMs(search);
        t.ms = TimeMs(search);
    }
    t.rows = w.RecordCount();
    w.close();
    return t;
}

void Run(const Target& target, const std::vector<Case>& cases, int runs) {
    SetMainPath(target.mainPath);
    SetIsOffice(target.server);
    SetIsZorva(target.server);
    std::printf("\n%s\n\n", target.server ? "PostgreSQL" : "File database (SQLite)");
    std::printf(
        "| window | operation | rows | window ms | first search ms | engine ms | "
        "shell process ms | ratio |\n");
    std::printf("|---|---|---:|---:|---:|---:|---:|---:|\n");
    for (const auto& c : cases) {
        std::vector<double> window;
        std::vector<double> first;
        std::vector<double> engine;
        std::vector<double> shell;
        long long rows = 0;
        WindowMs(target, c);  // warm the caches for both
        ShellMs(target, c);
        for (int i = 0; i < runs; ++i) {
            const auto timed = WindowMs(target, c);
            window.push_back(timed.ms);
            first.push_back(timed.firstMs);
            rows = timed.rows;
            const auto bare = ShellMs(target, c);
            engine.push_back(bare.engineMs);
            shell.push_back(bare.wallMs);
        }
        const double w = Median(window);
        const double e = Median(engine);
        // The shell's timer counts whole milliseconds on the file database.
        std::printf("| %s | %s | %lld | %.1f | %s | %.1f | %.1f | %.2f |\n",
                    qPrintable(ListWindow::FormName(VariantOf(c, target.server))), c.what, rows, w,
                    c.search ? qPrintable(QString::number(Median(first), 'f', 1)) : "", e,
                    Median(shell), w / std::max(e, 1.0));
        std::fflush(stdout);
    }
}

}  // namespace
}  // namespace zv

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
    }
    QApplication app(argc, argv);
    QCommandLineParser parser;
    parser.addPositionalArgument(QStringLiteral("DIR"), QStringLiteral("large installation"));
    parser.addOptions({
        {QStringLiteral("server"), QStringLiteral("PostgreSQL socket folder and port"),
         QStringLiteral("SOCKETDIR,PORT")},
        {QStringLiteral("client-number"), QStringLiteral("installation's client number"),
         QStringLiteral("N"), QStringLiteral("23")},
        {QStringLiteral("server-only"), QStringLiteral("skip the file database")},
        {QStringLiteral("runs"), QStringLiteral("timed runs per figure"), QStringLiteral("N"),
         QStringLiteral("5")},
    });
    parser.addHelpOption();
    parser.process(app);
    if (parser.positionalArguments().size() != 1) {
        parser.showHelp(2);
    }
    zv::SetUi(std::make_unique<zv::ConsoleUi>());
    zv::SetMyUser(QStringLiteral("1"));
    zv::SetVolnaGlobNum(parser.value(QStringLiteral("client-number")));
    const int runs = std::max(1, parser.value(QStringLiteral("runs")).toInt());

    const std::vector<zv::Case> cases{
        {"open", false, {}, false, {}},
        {"search, few rows (\"O'Neil\")", false, {}, true, QStringLiteral("O'Neil")},
        {"search, many rows (\"כהן\")", false, {}, true, QStringLiteral("כהן")},
        {"open (empty until a search)", true, {}, false, {}},
        {"open, one client's cases", true, QStringLiteral("1001"), false, {}},
        {"search, few rows (\"O'Neil\")", true, {}, true, QStringLiteral("O'Neil")},
        {"search, many rows (\"כהן\")", true, {}, true, QStringLiteral("כהן")},
        {"search, every name (empty text)", true, {}, true, {}},
    };
    const QString dir = parser.positionalArguments().first();
    if (!parser.isSet(QStringLiteral("server-only"))) {
        zv::Run({false, dir, {}, {}}, cases, runs);
    }
    const QString server = parser.value(QStringLiteral("server"));
    if (!server.isEmpty()) {
        zv::SetProvider(QStringLiteral("PostgreSQL"));
        zv::SetDataSource(server);
        zv::SetUserID(QStringLiteral("postgres"));
        zv::Run({true, dir, server.section(',', 0, 0), server.section(',', 1)}, cases, runs);
    }
    return 0;
}

#include "filing_fixture.h"

#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QDirIterator>
#include <QFileInfo>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QTableView>
#include <QTest>
#include <stdexcept>

#include "filing/filing_request_handler.h"
#include "filing_dialog/frm_get_doc_det.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "selection/list_model.h"
#include "selection/list_window.h"
#include "startup/backend_selection.h"
#include "startup/main_entry.h"
#include "startup/request_text.h"
#include "startup/settings.h"
#include "test_files.h"
#include "util/clock.h"

namespace zv::test {
namespace {

QString Written(const QString& path, const QByteArray& content) {
    if (!WriteFile(path, content)) {
        throw std::runtime_error("cannot write " + path.toStdString());
    }
    return path;
}

qsizetype RowCount(const QString& database, const QString& table) {
    try {
        return Rows(database, QStringLiteral("SELECT * FROM ") + table).size();
    } catch (const std::exception&) {
        return -1;
    }
}

template <class T>
T& Child(QWidget& w, const char* name) {
    T* child = w.findChild<T*>(QLatin1String(name));
    if (!child) {
        qFatal("no control %s", name);
    }
    return *child;
}

// The list window's script: the first row whose field equals value is chosen.
void QueueChoice(ScriptedUi& ui, const char* field, const QString& value) {
    ui.QueueModal([=](QWidget& window) {
        auto& w = dynamic_cast<ListWindow&>(window);
        ListModel& model = w.Model();
        while (model.canFetchMore({})) {
            model.fetchMore({});
        }
        for (int i = 0; i < model.rowCount(); ++i) {
            if (model.Record(i).value(QLatin1String(field)).toString() == value) {
                Child<QTableView>(w, "TDBGrid1").setCurrentIndex(model.index(i, 0));
                Child<QPushButton>(w, "CmdOK").click();
                return;
            }
        }
        QFAIL(qPrintable(QStringLiteral("no row with %1 = %2").arg(QLatin1String(field), value)));
    });
}

}  // namespace

FilingFixture::FilingFixture(bool docsOnServer, bool bmOnServer) {
    SampleOptions options;
    if (docsOnServer || bmOnServer) {
        // One client number per process, so that tests replace the same server databases.
        static const SampleOptions serverOptions = TestServerOptions();
        options = serverOptions;
        if (options.serverDataSource.isEmpty()) {
            throw std::runtime_error("no PostgreSQL test cluster: the test needs the pg fixture");
        }
        options.onServerDocs = docsOnServer;
        options.onServerBM = bmOnServer;
    }
    CreateSampleInstallation(env_.DataDir(), options);
    // The programs started on it say nothing about a missing runtime folder.
    const QString runtime = env_.Root() + QStringLiteral("/runtime");
    QDir().mkpath(runtime);
    QFile::setPermissions(runtime, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    qputenv("XDG_RUNTIME_DIR", runtime.toUtf8());
    // The values start-up sets, for reading the rows back in this process.
    SetBasicParam();
    GetMSSQLParam();
    SetClock([] { return Moment(); });
}

FilingFixture::~FilingFixture() {
    SetClock({});
}

QString FilingFixture::Source(const QString& fileName, const QByteArray& content) const {
    return Written(env_.Root() + QStringLiteral("/inbox/") + fileName, content);
}

QString FilingFixture::ArchiveFile(const QString& relPath, const QByteArray& content) const {
    return Written(Docs() + QLatin1Char('/') + relPath, content);
}

QString FilingFixture::Request(int mode, const QString& path, const QString& name) {
    const QString sep{QChar(kRequestSeparator)};
    return QString::number(mode) + sep + path + sep + name;
}

QString FilingFixture::RunWithDialog(int mode, const QString& path, const QString& name) {
    QString archived;
    const CommandLine cl;
    Main(Request(mode, path, name),
         [&](int& m, QString& p, QString& n) { archived = HandleFilingRequest(cl, m, p, n); });
    return archived;
}

ProcessResult FilingFixture::RunBatch(const QStringList& options, int mode, const QString& path,
                                      const QString& name) const {
    QProcess p;
    p.setProcessEnvironment(Environment());
    p.start(QStringLiteral(ZV_FILER),
            QStringList{"--batch"} + options + QStringList{Request(mode, path, name)});
    if (!p.waitForFinished(60000)) {
        p.kill();
        p.waitForFinished();
        return {};
    }
    return {p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -2,
            QString::fromUtf8(p.readAllStandardOutput()),
            QString::fromUtf8(p.readAllStandardError())};
}

QList<QVariantMap> FilingFixture::DocsRows() {
    return Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT * FROM DOCS ORDER BY FULLNAME"));
}

QStringList FilingFixture::State() const {
    QStringList files;
    const QDir root(DataDir());
    QDirIterator it(DataDir(), QDir::Files | QDir::Hidden | QDir::System,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString rel = root.relativeFilePath(it.next());
        // Databases only by name: a failed write may leave them another size.
        files << (rel.startsWith(QLatin1String("DOCS/"))
                      ? rel + QLatin1Char(' ') + QString::number(it.fileInfo().size())
                      : rel);
    }
    files.sort();
    return files << QStringLiteral("DOCS rows: %1").arg(RowCount("MDOCS", "DOCS"))
                 << QStringLiteral("UMEMO rows: %1").arg(RowCount("BM", "UMEMO"));
}

QString FullName(const QString& relPath) {
    return QStringLiteral("\\DOCS\\") +
           QString(relPath).replace(QLatin1Char('/'), QLatin1Char('\\'));
}

QByteArray Content(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

QStringList FolderEntries(const QString& path) {
    return QDir(path).entryList(
        QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot, QDir::Name);
}

Unwritable::Unwritable(const QString& path) : path_(path), holds_(Set(true)) {}

Unwritable::~Unwritable() {
    if (holds_) {
        Set(false);
    }
}

bool Unwritable::Set(bool on) const {
    if (::geteuid() != 0) {
        // A file is kept by its folder; a folder by its own permissions.
        const QFileInfo info(path_);
        const QString target = info.isDir() ? path_ : info.path();
        return ::chmod(QFile::encodeName(target).constData(), on ? 0555 : 0755) == 0;
    }
    // Permissions do not stop root; the immutable attribute does, where the file system has it.
    const int fd = ::open(QFile::encodeName(path_).constData(), O_RDONLY | O_NONBLOCK);
    int flags = 0;
    bool ok = fd >= 0 && ::ioctl(fd, FS_IOC_GETFLAGS, &flags) == 0;
    if (ok) {
        flags = on ? (flags | FS_IMMUTABLE_FL) : (flags & ~FS_IMMUTABLE_FL);
        ok = ::ioctl(fd, FS_IOC_SETFLAGS, &flags) == 0;
    }
    if (fd >= 0) {
        ::close(fd);
    }
    return ok;
}

void QueueFilingDialog(ScriptedUi& ui, const DialogInput& input,
                       const std::function<void(FrmGetDocDet&)>& check) {
    ui.QueueModal([input, check](QWidget& window) {
        auto& d = dynamic_cast<FrmGetDocDet&>(window);
        if (check) {
            check(d);
        }
        if (!input.confirm) {
            d.close();
            return;
        }
        Child<QPushButton>(d, "CmdLak").click();
        if (!input.tik.isEmpty()) {
            Child<QPushButton>(d, "CmdTik").click();
        }
        if (input.name) {
            Child<QLineEdit>(d, "TxtTeur").setText(*input.name);
        }
        Child<QComboBox>(d, "CboTeur").setCurrentText(input.description);
        Child<QLineEdit>(d, "TxtRemark").setText(input.remark);
        if (!input.reminderTime.isEmpty()) {
            Child<QCheckBox>(d, "ChkIsMemo").click();
            Child<QLineEdit>(d, "TDBTime1").setText(input.reminderTime);
            if (input.popup) {
                Child<QCheckBox>(d, "ChkIsJumpMemo").click();
            }
        }
        Child<QPushButton>(d, "CmdOK").click();
    });
    // The list windows open from inside the dialog, before any window the request shows
    // after it.
    if (input.confirm) {
        QueueChoice(ui, "NUM", QStringLiteral("1001"));
        if (!input.tik.isEmpty()) {
            QueueChoice(ui, "Tik", input.tik);
        }
    }
}

}  // namespace zv::test

#include "filing_fixture.h"

#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QUuid>
#include <stdexcept>

#include "filing/filing_request_handler.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "startup/backend_selection.h"
#include "startup/main_entry.h"
#include "startup/request_text.h"
#include "startup/settings.h"
#include "test_files.h"
#include "util/clock.h"
#include "util/state.h"

namespace zv::test {
namespace {

bool SetImmutable(const QString& path, bool on) {
    const int fd = ::open(QFile::encodeName(path).constData(), O_RDONLY | O_NONBLOCK);
    if (fd < 0) {
        return false;
    }
    int flags = 0;
    bool ok = ::ioctl(fd, FS_IOC_GETFLAGS, &flags) == 0;
    if (ok) {
        flags = on ? (flags | FS_IMMUTABLE_FL) : (flags & ~FS_IMMUTABLE_FL);
        ok = ::ioctl(fd, FS_IOC_SETFLAGS, &flags) == 0;
    }
    ::close(fd);
    return ok;
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

QDateTime FilingFixture::Moment() {
    return QDateTime(QDate(2026, 3, 17), QTime(14, 5, 30));
}

QString FilingFixture::Source(const QString& fileName, const QByteArray& content) const {
    const QString path = env_.Root() + QStringLiteral("/inbox/") + fileName;
    if (!WriteFile(path, content)) {
        throw std::runtime_error("cannot write " + path.toStdString());
    }
    return path;
}

QString FilingFixture::ArchiveFile(const QString& relPath, const QByteArray& content) const {
    const QString path = Docs() + QLatin1Char('/') + relPath;
    if (!WriteFile(path, content)) {
        throw std::runtime_error("cannot write " + path.toStdString());
    }
    return path;
}

QString FilingFixture::Docs() const {
    return env_.DataDir() + QStringLiteral("/DOCS");
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

ProcessResult FilingFixture::RunProgram(const QStringList& args) const {
    QProcess p;
    p.setProcessEnvironment(env_.ProgramEnvironment());
    p.start(QStringLiteral(ZV_FILER), args);
    if (!p.waitForFinished(60000)) {
        p.kill();
        p.waitForFinished();
        return {};
    }
    ProcessResult r;
    r.status = p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -2;
    r.out = QString::fromUtf8(p.readAllStandardOutput());
    r.err = QString::fromUtf8(p.readAllStandardError());
    return r;
}

QString FullName(const QString& relPath) {
    return QStringLiteral("\\DOCS\\") +
           QString(relPath).replace(QLatin1Char('/'), QLatin1Char('\\'));
}

QList<QVariantMap> FilingFixture::DocsRows() {
    return Rows(QStringLiteral("MDOCS"), QStringLiteral("SELECT * FROM DOCS ORDER BY FULLNAME"));
}

void FilingFixture::ExecFile(const QString& database, const QString& sql) const {
    const QString name = QUuid::createUuid().toString();
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(env_.DataDir() + QLatin1Char('/') + database + QStringLiteral(".MDB"));
        QSqlQuery q(db);
        if (!db.open() || !q.exec(sql)) {
            throw std::runtime_error("cannot run " + sql.toStdString());
        }
    }
    QSqlDatabase::removeDatabase(name);
}

QByteArray Content(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

QStringList FolderEntries(const QString& path) {
    return QDir(path).entryList(
        QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot, QDir::Name);
}

Unwritable::Unwritable(const QString& path) : path_(path) {
    if (::geteuid() == 0) {
        // Permissions do not stop root; the immutable attribute does, where the file system
        // has it.
        byFlag_ = true;
        holds_ = SetImmutable(path_, true);
    } else {
        // A file is kept by its folder; a folder by its own permissions.
        const QFileInfo info(path_);
        const QString target = info.isDir() ? path_ : info.path();
        holds_ = ::chmod(QFile::encodeName(target).constData(), 0555) == 0;
    }
}

Unwritable::~Unwritable() {
    if (!holds_) {
        return;
    }
    if (byFlag_) {
        SetImmutable(path_, false);
    } else {
        const QFileInfo info(path_);
        const QString target = info.isDir() ? path_ : info.path();
        ::chmod(QFile::encodeName(target).constData(), 0755);
    }
}

}  // namespace zv::test

#include "sample_install/sample_install.h"

#include <QDir>
#include <QFile>
#include <QSqlDatabase>
#include <QUuid>
#include <future>
#include <stdexcept>

#include "sample_install/sample_data.h"
#include "sample_install/sample_server.h"
#include "sample_install/schema_script.h"
#include "sample_install/table_loader.h"
#include "util/settings_store.h"

namespace zv {

namespace {

void MakeFolder(const QString& path) {
    if (!QDir().mkpath(path))
        throw std::runtime_error("cannot create folder " + path.toStdString());
}

void WriteFile(const QString& path, const QByteArray& content) {
    QFile f(path);
    if (!f.open(QIODevice::WriteOnly | QIODevice::Truncate) || f.write(content) != content.size())
        throw std::runtime_error("cannot write " + path.toStdString());
}

void CreateFileDatabase(const QString& path, const QString& database, const QStringList& schema,
                        const SampleData& data) {
    if (QFile::exists(path) && !QFile::remove(path))
        throw std::runtime_error("cannot replace " + path.toStdString());
    const QString connection = QStringLiteral("zv-sample-") + QUuid::createUuid().toString();
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), connection);
        db.setDatabaseName(path);
        if (!db.open())
            throw std::runtime_error("cannot create " + path.toStdString());
        // The file is new: a crash leaves a file to delete, nothing to recover.
        ExecOrThrow(db, QStringLiteral("PRAGMA synchronous=OFF"));
        for (const QString& index : LoadDatabase(db, database, schema, data))
            ExecOrThrow(db, index);
        db.close();
    }
    QSqlDatabase::removeDatabase(connection);
}

}  // namespace

const QStringList& FileDatabaseNames() {
    static const QStringList names{"OFFICE", "MDOCS", "BM", "ZORVA", "MADAD", "MAIN", "PUB"};
    return names;
}

const QStringList& SampleDocBasicFolders() {
    static const QStringList folders{"מכתבים", "חוזים", "כתבי בית דין"};
    return folders;
}

void CreateSampleInstallation(const QString& dir, const SampleOptions& options) {
    const QDir root(QDir(dir).absolutePath());
    MakeFolder(root.path());
    WriteFile(root.filePath(QStringLiteral("Zorvane.Exe")), "Zorvane sample installation\n");
    MakeFolder(root.filePath(QStringLiteral("Def")));
    MakeFolder(root.filePath(QStringLiteral("DOCS/MAILIN")));
    for (const QString& inner : SampleDocBasicFolders())
        MakeFolder(root.filePath(QStringLiteral("DOCS/DOCBASIC/") + inner));

    const SampleData data(options);
    // The server loads while the files are written.
    std::future<void> server;
    if (!options.serverDataSource.isEmpty()) {
        server = std::async(std::launch::async,
                            [&options, &data] { CreateServerDatabases(options, data); });
    }
    const QList<SchemaSection> schema = LoadSchema(QStringLiteral("sqlite"));
    for (const QString& name : FileDatabaseNames()) {
        CreateFileDatabase(root.filePath(name + QStringLiteral(".MDB")), name,
                           SchemaStatements(schema, name), data);
    }
    if (server.valid()) {
        server.get();
        WriteServerSettingsFile(root.path(), options);
    }
    if (options.writeSettings)
        WriteSampleSettings(root.path(), options);
}

void WriteSampleSettings(const QString& dir, const SampleOptions& options) {
    const QString app = QStringLiteral("Kavex32");
    const QString section = QStringLiteral("General");
    SaveSetting(app, section, QStringLiteral("MainPath"), QDir::toNativeSeparators(dir));
    SaveSetting(app, section, QStringLiteral("MyUserName"), options.myUserName);
    SaveSetting(app, section, QStringLiteral("MyUser"), options.myUser);
    SaveSetting(app, section, QStringLiteral("VolnaGlobNum"), options.volnaGlobNum);
    SaveSetting(app, section, QStringLiteral("LNUM"), options.officeCode);
}

}  // namespace zv

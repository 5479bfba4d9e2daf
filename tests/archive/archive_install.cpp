#include "archive_install.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <stdexcept>

#include "data/database.h"
#include "data/recordset.h"
#include "sample_install/sample_install.h"
#include "sample_install/test_server.h"
#include "util/state.h"

namespace zv::test {
namespace {

bool OnServer(const QString& database) {
    return database == QLatin1String("MDOCS") ? IsDocs() : IsBM();
}

}  // namespace

ArchiveInstall::ArchiveInstall(bool docsOnServer, bool bmOnServer) {
    const bool server = docsOnServer || bmOnServer;
    // One client number per process: each test replaces the same four server databases
    // instead of leaving four more behind in the cluster.
    static const SampleOptions serverOptions = TestServerOptions();
    SampleOptions options = server ? serverOptions : SampleOptions();
    if (server && options.serverDataSource.isEmpty()) {
        throw std::runtime_error("no PostgreSQL test cluster: the test needs the pg fixture");
    }
    options.writeSettings = false;
    options.onServerDocs = docsOnServer;
    options.onServerBM = bmOnServer;
    CreateSampleInstallation(MainDir(), options);

    SetMainPath(QDir(MainDir()).absolutePath());
    SetMyUserName(options.myUserName);
    SetMyUser(options.myUser);
    SetVolnaGlobNum(options.volnaGlobNum);
    if (!options.serverDataSource.isEmpty()) {
        SetProvider(QStringLiteral("PostgreSQL"));
        SetDataSource(options.serverDataSource);
        SetUserID(options.serverUser);
        SetPassWord(options.serverPassword);
    }
    SetIsDocs(docsOnServer);
    SetIsBM(bmOnServer);
}

QString ArchiveInstall::MakeFile(const QString& relPath) const {
    const QString path = MainPath() + QLatin1Char('/') + relPath;
    QDir().mkpath(QFileInfo(path).path());
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly) || file.write("document\n") < 0) {
        throw std::runtime_error("cannot write " + path.toStdString());
    }
    return path;
}

QList<QVariantMap> ArchiveInstall::Rows(const QString& database, const QString& sql) const {
    auto db = Database::Open(database, OnServer(database));
    auto rs = db->OpenRecordset(sql, dbOpenSnapshot);
    QList<QVariantMap> rows;
    for (; rs->RecordCount() > 0 && !rs->EOF(); rs->MoveNext()) {
        QVariantMap row;
        for (int i = 0; i < rs->FieldCount(); ++i) {
            row.insert(rs->FieldName(i).toUpper(), rs->Value(rs->FieldName(i)));
        }
        rows << row;
    }
    return rows;
}

void ArchiveInstall::Execute(const QString& database, const QString& sql) const {
    Database::Open(database, OnServer(database))->Execute(sql);
}

}  // namespace zv::test

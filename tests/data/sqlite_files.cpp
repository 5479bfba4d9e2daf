#include "sqlite_files.h"

#include <sqlite3.h>

#include <QDir>
#include <stdexcept>

namespace zv::test {
namespace {

sqlite3* OpenRaw(const QString& mainPath, const QString& name) {
    QDir().mkpath(mainPath);
    const QByteArray path = (mainPath + QLatin1Char('/') + name + QStringLiteral(".MDB")).toUtf8();
    sqlite3* db = nullptr;
    if (sqlite3_open(path.constData(), &db) != SQLITE_OK) {
        throw std::runtime_error(sqlite3_errmsg(db));
    }
    // Test files need no durability; this keeps a fixture per test row cheap.
    sqlite3_exec(db, "PRAGMA synchronous=OFF; PRAGMA journal_mode=MEMORY", nullptr, nullptr,
                 nullptr);
    return db;
}

}  // namespace

void MakeFileDb(const QString& mainPath, const QString& name, const QStringList& statements) {
    sqlite3* db = OpenRaw(mainPath, name);
    for (const QString& s : statements) {
        char* message = nullptr;
        if (sqlite3_exec(db, s.toUtf8().constData(), nullptr, nullptr, &message) != SQLITE_OK) {
            const std::string text =
                std::string(message ? message : "?") + " in " + s.toStdString();
            sqlite3_free(message);
            sqlite3_close(db);
            throw std::runtime_error(text);
        }
    }
    sqlite3_close(db);
}

QString QueryFileDb(const QString& mainPath, const QString& name, const QString& sql) {
    sqlite3* db = OpenRaw(mainPath, name);
    sqlite3_stmt* stmt = nullptr;
    QString result;
    if (sqlite3_prepare_v2(db, sql.toUtf8().constData(), -1, &stmt, nullptr) == SQLITE_OK &&
        sqlite3_step(stmt) == SQLITE_ROW) {
        const unsigned char* text = sqlite3_column_text(stmt, 0);
        result = text ? QString::fromUtf8(reinterpret_cast<const char*>(text)) : QString();
    }
    sqlite3_finalize(stmt);
    sqlite3_close(db);
    return result;
}

}  // namespace zv::test

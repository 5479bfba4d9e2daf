#include "data/data_errors.h"

#include <QStringList>

namespace zv {
namespace {

// SQLite result codes (primary and extended).
constexpr int kSqliteBusy = 5;
constexpr int kSqliteLocked = 6;
constexpr int kSqliteReadOnly = 8;
constexpr int kSqliteNotADb = 26;

QString Text(const QSqlError& error) {
    const QString db = error.databaseText().trimmed();
    return db.isEmpty() ? error.driverText().trimmed() : db;
}

VbError SqliteError(const QSqlError& error, const QString& source) {
    const int code = error.nativeErrorCode().toInt() & 0xff;
    const QString text = Text(error);
    if (text.contains(QLatin1String("UNIQUE constraint failed")) ||
        text.contains(QLatin1String("PRIMARY KEY constraint failed"))) {
        return VbError(err::JetDuplicate, StandardDescription(err::JetDuplicate), source);
    }
    if (text.contains(QLatin1String("NOT NULL constraint failed"))) {
        return VbError(err::JetNullField, text, source);
    }
    if (text.startsWith(QLatin1String("no such table"))) {
        return VbError(err::JetCannotFindTable, text, source);
    }
    if (code == kSqliteBusy || code == kSqliteLocked) {
        return VbError(err::JetLocked, StandardDescription(err::JetLocked), source);
    }
    if (code == kSqliteReadOnly) {
        return VbError(err::JetReadOnly, StandardDescription(err::JetReadOnly), source);
    }
    if (code == kSqliteNotADb) {
        return VbError(err::JetUnrecognizedFormat, QStringLiteral("Unrecognized database format."),
                       source);
    }
    return VbError(err::JetGeneric, text, source);
}

VbError PostgresError(const QSqlError& error, const QString& source) {
    const QString state = error.nativeErrorCode();
    // SQLSTATE class 23: integrity constraint violation.
    if (state.startsWith(QLatin1String("23"))) {
        return VbError(err::ServerIntegrity, Text(error), source);
    }
    if (state.isEmpty() || state.startsWith(QLatin1String("08")) ||
        error.type() == QSqlError::ConnectionError) {
        return VbError(err::ServerGeneric, Text(error), source);
    }
    return VbError(err::ServerCommand, Text(error), source);
}

VbError SqlServerError(const QSqlError& error, const QString& source) {
    // Native numbers of SQL Server: 2627 primary key, 2601 unique index, 547 foreign key or
    // check, 515 Null into a required column.
    const QString native = error.nativeErrorCode();
    for (const char* n : {"2627", "2601", "547", "515"}) {
        if (native.split(QLatin1Char(';')).contains(QLatin1String(n))) {
            return VbError(err::ServerIntegrity, Text(error), source);
        }
    }
    if (error.type() == QSqlError::ConnectionError) {
        return VbError(err::ServerGeneric, Text(error), source);
    }
    return VbError(err::ServerCommand, Text(error), source);
}

}  // namespace

VbError DataError(long number, const QString& source) {
    const char* text = nullptr;
    switch (number) {
        case err::AdoInvalidArgument:
            text =
                "Arguments are of the wrong type, are out of acceptable range, or are in "
                "conflict with one another.";
            break;
        case err::JetUpdateWithoutEdit:
            text = "Update or CancelUpdate without AddNew or Edit.";
            break;
        case err::JetNoCurrentRecord:
            text = "No current record.";
            break;
        case err::JetNotValidBookmark:
            text = "Not a valid bookmark.";
            break;
        case err::JetRecordChanged:
            text = "The data has been changed by another user.";
            break;
        case err::ServerRowNotFound:
            text =
                "Row cannot be located for updating. Some values may have been changed "
                "since it was last read.";
            break;
        case err::AdoObjectClosed:
            text = "Operation is not allowed when the object is closed.";
            break;
        case err::AdoObjectOpen:
            text = "Operation is not allowed when the object is open.";
            break;
        default:
            return MakeError(number, source);
    }
    return VbError(number, QString::fromLatin1(text), source);
}

VbError EngineError(Engine engine, const QSqlError& error, const QString& source) {
    switch (engine) {
        case Engine::Sqlite:
            return SqliteError(error, source);
        case Engine::Postgres:
            return PostgresError(error, source);
        case Engine::SqlServer:
            return SqlServerError(error, source);
    }
    return VbError(err::ServerGeneric, Text(error), source);
}

}  // namespace zv

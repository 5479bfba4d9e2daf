#include "data/recordset.h"

#include <QRegularExpression>
#include <QSqlDriver>
#include <QSqlField>
#include <QSqlRecord>
#include <QVector>

#include "data/connection.h"
#include "data/values.h"

namespace zv {

namespace {

struct Row {
    qint64 id = 0;  // bookmark
    QVector<QVariant> values;
};

// The one table of "SELECT ... FROM table ..."; empty when the query reads several.
QString SourceTable(const QString& sql) {
    static const QRegularExpression from(
        QStringLiteral("\\bFROM\\s+(?:\\[([^\\]]+)\\]|\"([^\"]+)\"|([A-Za-z_][A-Za-z0-9_]*))"
                       "(\\s*,|\\s+(?:INNER|LEFT|RIGHT|FULL|CROSS|JOIN)\\b)?"),
        QRegularExpression::CaseInsensitiveOption);
    const QRegularExpressionMatch m = from.match(sql);
    if (!m.hasMatch() || !m.captured(4).isEmpty()) {
        return {};
    }
    for (int i = 1; i <= 3; ++i) {
        if (!m.captured(i).isEmpty()) {
            return m.captured(i);
        }
    }
    return {};
}

bool SameNumber(const QVariant& a, const QString& text) {
    bool ok = false;
    bool okA = false;
    const double d = text.toDouble(&ok);
    const double v = a.toDouble(&okA);
    return ok && okA && !IsNullVal(a) && v == d;
}

}  // namespace

struct Recordset::Impl {
    std::shared_ptr<Connection> conn;
    DbKind kind = DbKind::File;
    int type = dbOpenDynaset;
    QString source;
    bool open = false;

    QStringList fields;
    QStringList declared;  // file kind: declared column types
    QVector<Row> rows;
    qsizetype pos = -1;  // -1 before the first row, rows.size() after the last
    qint64 nextId = 1;

    int editMode = dbEditNone;
    QVector<QVariant> buffer;
    QVector<bool> dirty;
    qint64 lastModified = 0;

    // Filled on the first edit or key lookup.
    bool tableRead = false;
    QString table;
    QStringList keyFields;   // the table's key columns, named as in fields
    bool updatable = false;  // one table, and every field is a column of it

    void RequireOpen() const {
        if (!open) {
            throw DataError(err::AdoObjectClosed);
        }
    }
    bool OnRow() const { return pos >= 0 && pos < rows.size(); }

    int FieldIndex(const QString& name) const {
        for (int i = 0; i < fields.size(); ++i) {
            if (fields[i].compare(name, Qt::CaseInsensitive) == 0) {
                return i;
            }
        }
        return -1;
    }
    int RequireField(const QString& name) const {
        const int i = FieldIndex(name);
        if (i < 0) {
            throw VbError(err::JetNoField, StandardDescription(err::JetNoField) +
                                               QStringLiteral(" (") + name + QLatin1Char(')'));
        }
        return i;
    }

    void Load() {
        const QString sql = conn->EngineSql(source);
        QSqlQuery q = conn->Run(sql);
        declared = conn->DeclaredTypes(sql);
        const QSqlRecord rec = q.record();
        fields.clear();
        for (int i = 0; i < rec.count(); ++i) {
            fields << rec.fieldName(i);
        }
        rows.clear();
        while (q.next()) {
            Row r{nextId++, {}};
            r.values.reserve(fields.size());
            for (int i = 0; i < fields.size(); ++i) {
                r.values << (i < declared.size() ? Connection::FromSqlite(q.value(i), declared[i])
                                                 : q.value(i));
            }
            rows << r;
        }
        q.finish();
        pos = rows.isEmpty() ? -1 : 0;
        editMode = dbEditNone;
        open = true;
    }

    void ReadTable() {
        if (tableRead) {
            return;
        }
        tableRead = true;
        table = SourceTable(source);
        if (table.isEmpty()) {
            return;
        }
        const QSqlRecord columns = conn->Db().driver()->record(conn->CatalogueName(table));
        updatable = true;
        for (const QString& f : fields) {
            updatable = updatable && columns.contains(f);
        }
        const QStringList keys = conn->KeyColumns(table);
        for (const QString& f : fields) {
            if (keys.contains(f, Qt::CaseInsensitive)) {
                keyFields << f;
            }
        }
        // A key that the query does not select cannot find the row again.
        if (keyFields.size() != keys.size()) {
            keyFields.clear();
        }
    }

    void RequireUpdatable() {
        ReadTable();
        if ((kind == DbKind::File && type == dbOpenSnapshot) || !updatable) {
            throw MakeError(err::JetReadOnly);
        }
    }

    QString TableInSql() const {
        if (conn->GetEngine() == Engine::Postgres) {
            static const QRegularExpression plain(QStringLiteral("^[A-Za-z_][A-Za-z0-9_]*$"));
            if (plain.match(table).hasMatch()) {
                return table;
            }
            return conn->QuoteIdentifier(table.toLower());
        }
        return conn->QuoteIdentifier(table);
    }

    void BeginAdd() {
        RequireUpdatable();
        buffer = QVector<QVariant>(fields.size(), Null());
        dirty = QVector<bool>(fields.size(), false);
        editMode = dbEditAdd;
    }

    void BeginEdit() {
        if (!OnRow()) {
            throw DataError(err::JetNoCurrentRecord);
        }
        RequireUpdatable();
        buffer = rows[pos].values;
        dirty = QVector<bool>(fields.size(), false);
        editMode = dbEditInProgress;
    }

    // The saved row as the engine returned it, laid out in this recordset's fields.
    QVector<QVariant> Returned(QSqlQuery& q, const QVector<QVariant>& fallback) const {
        QVector<QVariant> values = fallback;
        const QSqlRecord rec = q.record();
        for (int i = 0; i < fields.size(); ++i) {
            const int c = rec.indexOf(fields[i]);
            if (c >= 0) {
                values[i] = i < declared.size() ? Connection::FromSqlite(q.value(c), declared[i])
                                                : q.value(c);
            }
        }
        return values;
    }

    QVector<QVariant> Insert() {
        QStringList columns, marks;
        QVariantList values;
        for (int i = 0; i < fields.size(); ++i) {
            if (dirty[i]) {
                columns << conn->QuoteIdentifier(fields[i]);
                marks << QStringLiteral("?");
                values << buffer[i];
            }
        }
        const bool sqlServer = conn->GetEngine() == Engine::SqlServer;
        QString sql = QStringLiteral("INSERT INTO ") + TableInSql();
        if (columns.isEmpty()) {
            sql += sqlServer ? QStringLiteral(" OUTPUT INSERTED.* DEFAULT VALUES")
                             : QStringLiteral(" DEFAULT VALUES RETURNING *");
        } else {
            sql += QStringLiteral(" (") + columns.join(QStringLiteral(", ")) + QLatin1Char(')');
            sql += sqlServer ? QStringLiteral(" OUTPUT INSERTED.* VALUES (")
                             : QStringLiteral(" VALUES (");
            sql += marks.join(QStringLiteral(", ")) + QLatin1Char(')');
            if (!sqlServer) {
                sql += QStringLiteral(" RETURNING *");
            }
        }
        QSqlQuery q = conn->Run(sql, values);
        if (!q.next()) {
            return buffer;
        }
        QVector<QVariant> saved = Returned(q, buffer);
        q.finish();
        return saved;
    }

    QVector<QVariant> UpdateRow() {
        const QVector<QVariant>& original = rows[pos].values;
        QStringList sets, conditions;
        QVariantList values;
        for (int i = 0; i < fields.size(); ++i) {
            if (dirty[i]) {
                sets << conn->QuoteIdentifier(fields[i]) + QStringLiteral(" = ?");
                values << buffer[i];
            }
        }
        if (sets.isEmpty()) {
            return original;
        }
        // By the primary key; without one, by every value as it was read.
        QStringList where = keyFields;
        for (const QString& k : keyFields) {
            if (IsNullVal(original[FieldIndex(k)])) {
                where.clear();  // a unique index admits many Nulls
            }
        }
        if (where.isEmpty()) {
            where = fields;
        }
        for (const QString& f : where) {
            const QVariant& v = original[FieldIndex(f)];
            if (IsNullVal(v) || !v.isValid()) {
                conditions << conn->QuoteIdentifier(f) + QStringLiteral(" IS NULL");
            } else {
                conditions << conn->QuoteIdentifier(f) + QStringLiteral(" = ?");
                values << v;
            }
        }
        const bool sqlServer = conn->GetEngine() == Engine::SqlServer;
        QString sql = QStringLiteral("UPDATE ") + TableInSql() + QStringLiteral(" SET ") +
                      sets.join(QStringLiteral(", "));
        if (sqlServer) {
            sql += QStringLiteral(" OUTPUT INSERTED.*");
        }
        sql += QStringLiteral(" WHERE ") + conditions.join(QStringLiteral(" AND "));
        if (!sqlServer) {
            sql += QStringLiteral(" RETURNING *");
        }
        QSqlQuery q = conn->Run(sql, values);
        if (!q.next()) {
            throw DataError(kind == DbKind::File ? err::JetRecordChanged : err::ServerRowNotFound);
        }
        QVector<QVariant> saved = Returned(q, buffer);
        q.finish();
        return saved;
    }

    void Save() {
        if (editMode == dbEditNone) {
            if (kind == DbKind::File) {
                throw DataError(err::JetUpdateWithoutEdit);
            }
            return;
        }
        ReadTable();
        if (editMode == dbEditAdd) {
            Row r{nextId++, Insert()};
            rows << r;
            lastModified = r.id;
            if (kind == DbKind::Server) {
                pos = rows.size() - 1;
            }
        } else {
            rows[pos].values = UpdateRow();
            lastModified = rows[pos].id;
        }
        editMode = dbEditNone;
        buffer.clear();
        dirty.clear();
    }

    // The server kind saves an edited row before leaving it.
    void BeforeMove() {
        RequireOpen();
        if (kind == DbKind::Server && editMode != dbEditNone) {
            Save();
        }
    }
};

Recordset::Recordset(std::unique_ptr<Impl> impl) : d_(std::move(impl)) {}
Recordset::~Recordset() = default;

std::unique_ptr<Recordset> Recordset::OpenOn(std::shared_ptr<Connection> connection, DbKind kind,
                                             const QString& sql, int type) {
    auto impl = std::make_unique<Impl>();
    impl->conn = std::move(connection);
    impl->kind = kind;
    impl->type = type;
    impl->source = sql;
    impl->Load();
    return std::unique_ptr<Recordset>(new Recordset(std::move(impl)));
}

DbKind Recordset::Kind() const {
    return d_->kind;
}

int Recordset::FieldCount() const {
    return int(d_->fields.size());
}

QString Recordset::FieldName(int index) const {
    if (index < 0 || index >= d_->fields.size()) {
        throw MakeError(err::JetNoField);
    }
    return d_->fields[index];
}

QVariant Recordset::Value(const QString& name) const {
    d_->RequireOpen();
    const int i = d_->RequireField(name);
    if (d_->editMode != dbEditNone) {
        return d_->buffer[i];
    }
    if (!d_->OnRow()) {
        throw DataError(err::JetNoCurrentRecord);
    }
    return d_->rows[d_->pos].values[i];
}

void Recordset::SetValue(const QString& name, const QVariant& value) {
    d_->RequireOpen();
    const int i = d_->RequireField(name);
    if (d_->editMode == dbEditNone) {
        if (d_->kind == DbKind::File) {
            throw DataError(err::JetUpdateWithoutEdit);
        }
        d_->BeginEdit();
    }
    d_->buffer[i] = value;
    d_->dirty[i] = true;
}

int Recordset::RecordCount() const {
    d_->RequireOpen();
    return int(d_->rows.size());
}

int Recordset::AbsolutePosition() const {
    return d_->open && d_->OnRow() ? int(d_->pos) : -1;
}

bool Recordset::BOF() const {
    d_->RequireOpen();
    return d_->rows.isEmpty() || d_->pos < 0;
}

bool Recordset::EOF() const {
    d_->RequireOpen();
    return d_->rows.isEmpty() || d_->pos >= d_->rows.size();
}

void Recordset::MoveFirst() {
    d_->BeforeMove();
    if (d_->rows.isEmpty()) {
        throw DataError(err::JetNoCurrentRecord);
    }
    d_->editMode = dbEditNone;
    d_->pos = 0;
}

void Recordset::MoveNext() {
    d_->BeforeMove();
    if (EOF()) {
        throw DataError(err::JetNoCurrentRecord);
    }
    d_->editMode = dbEditNone;
    ++d_->pos;
}

void Recordset::AddNew() {
    d_->RequireOpen();
    if (d_->kind == DbKind::Server && d_->editMode != dbEditNone) {
        d_->Save();
    }
    d_->BeginAdd();
}

void Recordset::Edit() {
    d_->RequireOpen();
    d_->BeginEdit();
}

void Recordset::Update() {
    d_->RequireOpen();
    d_->Save();
}

void Recordset::CancelUpdate() {
    d_->RequireOpen();
    if (d_->editMode == dbEditNone && d_->kind == DbKind::File) {
        throw DataError(err::JetUpdateWithoutEdit);
    }
    d_->editMode = dbEditNone;
    d_->buffer.clear();
    d_->dirty.clear();
}

int Recordset::EditMode() const {
    return d_->editMode;
}

void Recordset::SetBookmark(const QVariant& bookmark) {
    d_->BeforeMove();
    bool ok = false;
    const qint64 id = bookmark.toLongLong(&ok);
    for (qsizetype i = 0; ok && i < d_->rows.size(); ++i) {
        if (d_->rows[i].id == id) {
            d_->editMode = dbEditNone;
            d_->pos = i;
            return;
        }
    }
    throw DataError(err::JetNotValidBookmark);
}

QVariant Recordset::LastModified() const {
    if (d_->lastModified == 0) {
        throw DataError(err::JetNotValidBookmark);
    }
    return d_->lastModified;
}

QString Recordset::Name() const {
    return d_->source;
}

QString Recordset::KeyColumn() const {
    d_->ReadTable();
    return d_->keyFields.isEmpty() ? QString() : d_->keyFields.first();
}

QString Recordset::Source() const {
    return d_->source;
}

void Recordset::SetSource(const QString& sql) {
    if (d_->open) {
        throw DataError(err::AdoObjectOpen);
    }
    d_->source = sql;
    d_->tableRead = false;
    d_->table.clear();
    d_->keyFields.clear();
    d_->updatable = false;
}

void Recordset::Requery() {
    d_->RequireOpen();
    d_->Load();
}

void Recordset::Find(const QString& criterion) {
    d_->BeforeMove();
    static const QRegularExpression form(
        QStringLiteral("^\\s*\\[?([^\\]=\\s]+)\\]?\\s*=\\s*(.*?)\\s*$"));
    const QRegularExpressionMatch m = form.match(criterion);
    if (!m.hasMatch()) {
        throw DataError(err::AdoInvalidArgument);
    }
    const int field = d_->RequireField(m.captured(1));
    QString wanted = m.captured(2);
    const bool quoted = wanted.size() >= 2 && wanted.startsWith(QLatin1Char('\'')) &&
                        wanted.endsWith(QLatin1Char('\''));
    if (quoted) {
        wanted =
            wanted.mid(1, wanted.size() - 2).replace(QStringLiteral("''"), QStringLiteral("'"));
    }
    d_->editMode = dbEditNone;
    for (qsizetype i = qMax<qsizetype>(d_->pos, 0); i < d_->rows.size(); ++i) {
        const QVariant& v = d_->rows[i].values[field];
        const bool match =
            quoted ? (!IsNullVal(v) && v.toString().compare(wanted, Qt::CaseInsensitive) == 0)
                   : SameNumber(v, wanted);
        if (match) {
            d_->pos = i;
            return;
        }
    }
    d_->pos = d_->rows.size();
}

void Recordset::Open() {
    if (d_->open) {
        throw DataError(err::AdoObjectOpen);
    }
    d_->Load();
}

void Recordset::Close() {
    d_->RequireOpen();
    d_->open = false;
    d_->rows.clear();
    d_->pos = -1;
    d_->editMode = dbEditNone;
    d_->buffer.clear();
    d_->dirty.clear();
}

}  // namespace zv

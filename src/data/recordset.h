#pragma once
// A recordset of either kind. The file kind behaves as a DAO recordset (EditMode,
// Bookmark, LastModified, Name); the server kind as a client-side ADO keyset recordset
// (KEYCOLUMN, Requery, Find, Source). Saving issues a parameterised INSERT or UPDATE by the
// table's primary key (or, without one, by the row's values as read) and reads the saved
// row back, generated key included. The rows of the query are held in memory: recordsets
// are for small results; the list windows use a lazily fetched model on Handle().
//
// After Update of a new row the file kind stays where it was (LastModified names the new
// row); the server kind moves onto the new row. Moving the server kind off an edited row
// saves it first.

#include <QString>
#include <QVariant>
#include <cstdio>
#include <memory>

// The recordset property EOF shares its name with the C library's end-of-file macro, which
// nothing in this program uses; stdio is included first so that it cannot come back.
#undef EOF

#include "data/database.h"

namespace zv {

// DAO edit modes.
enum : int { dbEditNone = 0, dbEditInProgress = 1, dbEditAdd = 2 };

class Recordset {
  public:
    ~Recordset();
    Recordset(const Recordset&) = delete;
    Recordset& operator=(const Recordset&) = delete;

    DbKind Kind() const;
    bool IsServer() const { return Kind() == DbKind::Server; }

    // Fields, by name without regard to case. An unknown name is error 3265.
    int FieldCount() const;
    QString FieldName(int index) const;
    // The current row's value (or the pending edit's). A SQL NULL is a null QVariant.
    QVariant Value(const QString& name) const;
    // File kind: only inside AddNew/Edit (error 3020 otherwise). Server kind: edits the
    // current row in place, saved by Update.
    void SetValue(const QString& name, const QVariant& value);

    // Position
    int RecordCount() const;
    int AbsolutePosition() const;  // 0-based on both kinds; -1 when not on a row
    bool BOF() const;
    bool EOF() const;
    void MoveFirst();
    void MoveNext();

    // Editing
    void AddNew();
    void Edit();  // file kind
    void Update();
    void CancelUpdate();
    int EditMode() const;

    // File kind
    void SetBookmark(const QVariant& bookmark);
    QVariant LastModified() const;
    QString Name() const;  // the query text

    // Server kind
    // First column of the table's key: its primary key, or on a file database without one,
    // its first unique index. Empty when the table has none.
    QString KeyColumn() const;
    QString Source() const;
    void SetSource(const QString& sql);
    void Requery();
    void Find(const QString& criterion);  // "ID=1234": moves to the first match or to EOF
    void Open();
    void Close();

  private:
    friend class Database;
    struct Impl;
    explicit Recordset(std::unique_ptr<Impl> impl);
    static std::unique_ptr<Recordset> OpenOn(std::shared_ptr<Connection> connection, DbKind kind,
                                             const QString& sql, int type);
    std::unique_ptr<Impl> d_;
};

}  // namespace zv

#pragma once
// The SQL texts of the two list windows. A query keeps its table, condition and order apart,
// so that the record counter can ask the database for the number of rows of the very same
// condition instead of reading every row.

#include <QString>

namespace zv {

struct ListQuery {
    QString table;  // "[CLIENT]" or "[LOOKFOR]"
    QString where;  // empty: no condition
    QString order;  // "NUM", "OptKey, Tik" ...; empty: no order

    QString Text() const;       // "SELECT * FROM ..."
    QString CountText() const;  // "SELECT COUNT(*) FROM ..." with the same condition
};

// The client list: every client, or those whose number, names or telephone contain the
// text. The wildcard is "*" on a file database and "%" on a server; the text keeps any
// wildcard the user typed.
ListQuery ClientListQuery(bool server, const QString& text);

// The name and case list before any search: empty, or a client's own case files.
ListQuery NamesOpenQuery(bool server, const QString& clientNum);
// The name and case list searched for the text, within one client's cases or in all names.
ListQuery NamesSearchQuery(bool server, const QString& clientNum, const QString& text);

}  // namespace zv

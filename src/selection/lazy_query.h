#pragma once
// Reads the rows of one query a batch at a time, so that a list of a million rows opens
// after reading its first rows only. A file database steps a forward-only statement;
// PostgreSQL reads through a cursor, since its driver would otherwise fetch the whole
// result into memory before returning the first row.

#include <QSqlRecord>
#include <QString>
#include <vector>

namespace zv {

class Database;

class LazyQuery {
  public:
    // Runs the query (the suite's text; the engine's form is taken from db). Throws VbError.
    LazyQuery(Database& db, const QString& sql);
    ~LazyQuery();
    LazyQuery(const LazyQuery&) = delete;
    LazyQuery& operator=(const LazyQuery&) = delete;

    // Up to count further rows; fewer only at the end. Throws VbError.
    std::vector<QSqlRecord> Fetch(int count);
    bool AtEnd() const { return atEnd_; }
    // The number of rows of the whole query, read or not. A cursor counts them by moving
    // to its end and back; a statement of a file database is counted by countSql, the same
    // condition as "SELECT COUNT(*) ...". Throws VbError.
    long long TotalRows(const QString& countSql);

  private:
    struct Impl;
    Database& db_;
    bool atEnd_ = false;
    std::unique_ptr<Impl> d_;
};

}  // namespace zv

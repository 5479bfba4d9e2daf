#pragma once
// Reads the rows of one query a batch at a time, so that a list of a million rows opens
// after reading its first rows only. A file database steps a forward-only statement;
// PostgreSQL reads through a cursor, since its driver would otherwise fetch the whole
// result before returning the first row.

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

  private:
    struct Impl;
    Database& db_;
    bool atEnd_ = false;
    std::unique_ptr<Impl> d_;
};

// The single number a query such as "SELECT COUNT(*) ..." returns. Throws VbError.
long long QueryCount(Database& db, const QString& sql);

}  // namespace zv

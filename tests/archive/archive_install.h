#pragma once
// A fresh sample installation for one archive test, with the installation's values set as
// start-up sets them, and the documents and reminders on the back-ends the test chooses.

#include <QList>
#include <QString>
#include <QVariantMap>

#include "test_env.h"

namespace zv::test {

class ArchiveInstall {
  public:
    // Server databases are created when either flag asks for them; they need the
    // PostgreSQL cluster of the "pg" fixture.
    ArchiveInstall(bool docsOnServer, bool bmOnServer);

    QString MainDir() const { return env_.DataDir(); }
    // Creates a small file at a path below MainPath ("/" separators) and returns its full
    // path.
    QString MakeFile(const QString& relPath) const;

    // The rows of a query on a logical database where the back-end flags put it, each a map
    // from the upper-case column name to its value.
    QList<QVariantMap> Rows(const QString& database, const QString& sql) const;
    void Execute(const QString& database, const QString& sql) const;

  private:
    TestEnv env_;
};

}  // namespace zv::test

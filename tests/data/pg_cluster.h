#pragma once
// The PostgreSQL cluster of the server tests, announced by the CTest fixture "pg"
// (ZV_PG_HOST socket folder, ZV_PG_PORT, ZV_PG_USER). Databases are made and dropped over
// a connection of their own, without the code under test.

#include <QString>
#include <QStringList>

namespace zv::test {

class PgCluster {
  public:
    PgCluster();
    // Whether the variables are set and the socket is there.
    bool Available() const { return available_; }
    // "folder,port": the data source of a connection string.
    QString DataSource() const { return host_ + QLatin1Char(',') + port_; }
    QString User() const { return user_; }
    // Creates the database (name kept exactly as given) and runs the statements in it.
    void CreateDatabase(const QString& name, const QStringList& statements) const;
    void DropDatabase(const QString& name) const;
    // Runs statements in an existing database; returns the first value of the last one.
    QString Run(const QString& database, const QStringList& statements) const;

  private:
    bool available_ = false;
    QString host_, port_, user_;
};

// With CI=true a missing cluster fails the test; elsewhere the test is skipped.
bool ClusterRequired();

}  // namespace zv::test

#define ZV_REQUIRE_CLUSTER(cluster)                                                   \
    do {                                                                              \
        if (!(cluster).Available()) {                                                 \
            if (zv::test::ClusterRequired())                                          \
                QFAIL("no PostgreSQL test cluster: the pg fixture did not start it"); \
            QSKIP("no PostgreSQL test cluster (ZV_PG_HOST, ZV_PG_PORT)");             \
        }                                                                             \
    } while (false)

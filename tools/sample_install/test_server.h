#pragma once
// The PostgreSQL cluster of the server tests, as the CTest fixture "pg" announces it
// (ZV_PG_HOST, ZV_PG_PORT, ZV_PG_USER; cmake/ZvTest.cmake).

#include <QString>

#include "sample_install/sample_options.h"

namespace zv {

// Sample options on the test cluster, with a client number of their own so that tests
// running at the same time use different server databases. serverDataSource stays empty
// when the variables are not set or the cluster's socket is not there.
SampleOptions TestServerOptions();
// With CI=true a server test fails instead of skipping when the cluster is missing.
bool ServerTestsRequired();

}  // namespace zv

// In a QTest function, after `auto options = zv::TestServerOptions();`: skips the test (in
// CI: fails it) when the cluster is not there.
#define ZV_REQUIRE_TEST_SERVER(options)                                               \
    do {                                                                              \
        if ((options).serverDataSource.isEmpty()) {                                   \
            if (zv::ServerTestsRequired())                                            \
                QFAIL("no PostgreSQL test cluster: the pg fixture did not start it"); \
            QSKIP("no PostgreSQL test cluster (ZV_PG_HOST, ZV_PG_PORT)");             \
        }                                                                             \
    } while (false)

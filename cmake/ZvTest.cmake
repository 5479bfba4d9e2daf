# zv_add_test(NAME SOURCES ... LIBS ... LABELS ... [FIXTURES ...] [TIMEOUT s])
# One QTest program registered with CTest, run offscreen.
function(zv_add_test name)
    cmake_parse_arguments(T "" "TIMEOUT" "SOURCES;LIBS;LABELS;FIXTURES" ${ARGN})
    add_executable(${name} ${T_SOURCES})
    target_link_libraries(${name} PRIVATE ${T_LIBS} zv_test_support Qt6::Test)
    add_test(NAME ${name} COMMAND ${name} -platform offscreen)
    if(NOT T_TIMEOUT)
        set(T_TIMEOUT 120)
    endif()
    set_tests_properties(${name} PROPERTIES LABELS "${T_LABELS}" TIMEOUT ${T_TIMEOUT}
        ENVIRONMENT "QT_QPA_PLATFORM=offscreen;ZV_TEST_BUILD_DIR=${CMAKE_BINARY_DIR}")
    if(T_FIXTURES)
        set_tests_properties(${name} PROPERTIES FIXTURES_REQUIRED "${T_FIXTURES}")
    endif()
    if("pg" IN_LIST T_FIXTURES)
        zv_pg_fixture()
        set_property(TEST ${name} APPEND PROPERTY ENVIRONMENT
            "ZV_PG_HOST=${ZV_PG_DIR}" "ZV_PG_PORT=${ZV_PG_PORT}" "ZV_PG_USER=postgres")
    endif()
endfunction()

# FIXTURES pg: a throwaway PostgreSQL cluster (scripts/pg-cluster) started before the first
# test that needs it and stopped after the last. Such a test gets
#   ZV_PG_HOST  the socket folder of the cluster (build folder/pg)
#   ZV_PG_PORT  its port (the socket's name; no TCP)
#   ZV_PG_USER  the superuser, trusted without a password
# so that the data source of the sample installation is "$ZV_PG_HOST,$ZV_PG_PORT"
# (tools/sample_install/test_server.h). With CI=true a cluster that cannot start fails.
set(ZV_PG_DIR ${CMAKE_BINARY_DIR}/pg)
set(ZV_PG_PORT 55432)
function(zv_pg_fixture)
    get_property(defined GLOBAL PROPERTY ZV_PG_FIXTURE_DEFINED)
    if(defined)
        return()
    endif()
    set_property(GLOBAL PROPERTY ZV_PG_FIXTURE_DEFINED TRUE)
    add_test(NAME pg_cluster_start
        COMMAND ${PROJECT_SOURCE_DIR}/scripts/pg-cluster start ${ZV_PG_DIR} ${ZV_PG_PORT})
    add_test(NAME pg_cluster_stop
        COMMAND ${PROJECT_SOURCE_DIR}/scripts/pg-cluster stop ${ZV_PG_DIR})
    set_tests_properties(pg_cluster_start PROPERTIES FIXTURES_SETUP pg LABELS server
        SKIP_RETURN_CODE 77 TIMEOUT 60)
    set_tests_properties(pg_cluster_stop PROPERTIES FIXTURES_CLEANUP pg LABELS server TIMEOUT 60)
endfunction()

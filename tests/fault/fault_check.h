#pragma once
// What a filing that did not complete must leave: the installation as it was (no file added
// anywhere below MainPath, no DOCS or UMEMO row added) and the source where it was.

#include <QString>
#include <QStringList>

#include "filing_fixture.h"

namespace zv::test {

struct InstallationState {
    QStringList files;  // every file below MainPath, relative, with its size
    int docs = -1;      // DOCS rows; -1 when MDOCS could not be read
    int memos = -1;     // UMEMO rows; -1 when BM could not be read
};

InstallationState StateOf(const FilingFixture& f);

// In a QTest function: the installation is as before and the source holds content.
#define ZV_VERIFY_NOT_FILED(f, before, source, content)                  \
    do {                                                                 \
        const zv::test::InstallationState after_ = zv::test::StateOf(f); \
        QCOMPARE(after_.files, (before).files);                          \
        QCOMPARE(after_.docs, (before).docs);                            \
        QCOMPARE(after_.memos, (before).memos);                          \
        QCOMPARE(zv::test::Content(source), QByteArray(content));        \
    } while (false)

}  // namespace zv::test

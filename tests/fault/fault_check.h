#pragma once
// What a filing that did not complete must leave: the installation as it was (no file added
// anywhere below MainPath, no DOCS or UMEMO row added).

#include <QStringList>

#include "filing_fixture.h"

namespace zv::test {

// Every file below MainPath, relative (documents with their size), then the number of DOCS
// and UMEMO rows (-1 when the database cannot be read).
QStringList StateOf(const FilingFixture& f);

}  // namespace zv::test

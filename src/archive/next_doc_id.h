#pragma once
// The next document identifier of the file database.

#include <cstdint>

namespace zv {

// max(ID) + 1 of DOCS in MDOCS.MDB, read on a connection of its own; 1 for an empty table.
// 0 when the documents are on the server, which assigns identifiers itself.
int32_t GetNextIdDOCS();

}  // namespace zv

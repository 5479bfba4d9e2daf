#pragma once
// Adding and editing rows the same way on both kinds of recordset.

#include <cstdint>

namespace zv {

class Recordset;

void GAddNew(Recordset* rs);
void GEdit(Recordset* rs);
// Saves the pending row and leaves the recordset on it. mDb only appears in messages.
// Returns 0 when the row was saved (or nothing was pending), otherwise the number of the
// failure, which was reported or, for a duplicate, silently ignored.
long GUpdate(int16_t mDb, Recordset* rs);

}  // namespace zv

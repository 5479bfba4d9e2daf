#pragma once
// Back-end selection: per database of the suite, whether it is a file under MainPath or a
// database on the server, and the server login. Fills Provider, DataSource, UserID,
// PassWord and the flags IsOffice, IsDocs, IsBM, IsZorva of util/state.h.

#include <cstdint>

namespace zv {

// Module numbers of the databases whose place the MSql row decides.
namespace module {
constexpr int16_t Office = 9;
constexpr int16_t Zorva = 15;
constexpr int16_t BM = 17;
constexpr int16_t Docs = 25;
}  // namespace module

// Reads the login from MainPath/Def/MSSQLSetting.INI (section MSSQL, then the user's own
// section, else the shared section "000") and, when provider, data source and user are all
// known, this installation's MSql row of MAIN.MDB. A failure reading MAIN.MDB is reported
// as "N-0-GetMSSQLParam-..." and sets no flag. A flag once set stays set.
void GetMSSQLParam();

// The confirmation through which each module's flag is set: true for every module.
bool GetIsWorksMSSQL(int16_t moduleNumber, bool requested);

}  // namespace zv

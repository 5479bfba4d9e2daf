#pragma once
// The case-kind catalogue OptKeyNames: the suite's fixed case kinds and the office's own.

namespace zv {

// Rebuilds OptKeyNames: the eighteen fixed kinds, then every shown row of MTIK under the key
// 1000 + ID. A table that cannot be read is reported and leaves the fixed kinds.
void SetOptKeyLakTik();

}  // namespace zv

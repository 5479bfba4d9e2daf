#pragma once
// The filing request without a window (--batch): the options answer in place of the
// dialog, and the same filing runs.

#include <QString>

#include "startup/command_line.h"
#include "startup/filing_options.h"

namespace zv {

// Files the request as the dialog would have been confirmed with these options: the same
// labels, target and details. An unknown client, case, inner folder, origin or status, or a
// name the dialog would refuse, is reported and files nothing. Returns the archived file's
// path, or empty when nothing was filed.
QString FileWithoutWindow(int mode, const QString& path, const QString& name,
                          const FilingOptions& options);

// A --batch request that passed Main: selects the back-ends, then files without a window.
QString HandleBatchRequest(const CommandLine& cl, int mode, const QString& path,
                           const QString& name);

}  // namespace zv

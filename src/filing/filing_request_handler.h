#pragma once
// What Main hands a request to once it passed every check.

#include <QString>

#include "startup/command_line.h"

namespace zv {

// Selects the back-ends, then files the request: with the dialog, or from the batch options
// with --batch. Returns the archived file's path, empty when nothing was filed.
QString HandleFilingRequest(const CommandLine& cl, int mode, const QString& path,
                            const QString& name);

}  // namespace zv

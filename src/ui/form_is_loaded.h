#pragma once

#include <QString>

namespace zv {

// Whether a window of that name (its object name, without regard to case) exists, shown
// or hidden.
bool FormIsLoaded(const QString& name);

}  // namespace zv

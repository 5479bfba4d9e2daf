#pragma once
// The VB error number a call raises, for the data tests.

#include <functional>

#include "util/errors.h"

namespace zv::test {

// 0 when f returns.
inline long ErrorOf(const std::function<void()>& f) {
    try {
        f();
    } catch (const VbError& e) {
        return e.Number();
    }
    return 0;
}

}  // namespace zv::test

// Jet's Val on any text.

#include <cmath>

#include "data/jet_functions.h"
#include "fuzz_support.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString text = QString::fromUtf8(zv::fuzz::Bytes(data, size));
    if (std::isnan(zv::JetVal(text))) {
        zv::fuzz::Fail("Val is a number", text);
    }
    return 0;
}

// The filing request on the command line: bytes to text, text to fields, the mode field
// to a number.

#include "fuzz_support.h"
#include "startup/request_text.h"
#include "util/errors.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString text = zv::DecodeArgumentText(zv::fuzz::Bytes(data, size));
    const QStringList fields = zv::SplitRequest(text);
    if (fields.isEmpty()) {
        zv::fuzz::Fail("a request has at least one field", text);
    }
    // The fields are the stripped text, cut on the separator and nothing else.
    const QString joined = fields.join(QChar(zv::kRequestSeparator));
    if (!text.contains(joined) || joined.startsWith(QLatin1Char(' ')) ||
        joined.endsWith(QLatin1Char(' '))) {
        zv::fuzz::Fail("fields rejoin to the stripped request", text);
    }
    try {
        zv::RequestMode(fields.front());
    } catch (const zv::VbError& e) {
        if (e.Number() != zv::err::TypeMismatch && e.Number() != zv::err::Overflow) {
            zv::fuzz::Fail("the mode fails only as type mismatch or overflow", fields.front());
        }
    }
    return 0;
}

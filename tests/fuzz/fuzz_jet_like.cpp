// Jet's LIKE. Input: the pattern on the first line, the text on the second, an optional
// escape character on the third.

#include "data/jet_functions.h"
#include "fuzz_support.h"

namespace {

// The text as a pattern that matches only itself: every character escaped.
QString Escaped(const QString& text, QChar escape) {
    QString pattern;
    for (QChar c : text) {
        pattern += escape;
        pattern += c;
    }
    return pattern;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QStringList f = zv::fuzz::Fields(data, size, 3);
    const QChar escape = f.at(2).isEmpty() ? QChar() : f.at(2).front();
    zv::JetLike(f.at(0), f.at(1), escape);

    const QString& text = f.at(1);
    if (!zv::JetLike(QStringLiteral("*"), text)) {
        zv::fuzz::Fail("\"*\" matches every text", text);
    }
    if (!zv::JetLike(Escaped(text, QLatin1Char('\\')), text, QLatin1Char('\\'))) {
        zv::fuzz::Fail("a text escaped in full matches itself", text);
    }
    return 0;
}

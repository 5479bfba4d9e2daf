#pragma once
// What every fuzz driver shares: a Ui that shows nothing, and the split of an input into
// lines of text so that the corpora stay readable.

#include <QByteArray>
#include <QString>
#include <QStringList>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>

#include "util/ui.h"

namespace zv::fuzz {

// Message boxes answer with their default button; nothing is recorded, so a long run does
// not grow.
class QuietUi : public Ui {
  public:
    int MsgBox(const QString&, int style, const QString&) override { return DefaultAnswer(style); }
    void ShowModal(QWidget&) override {}
    void DoEvents() override {}
};

inline void InstallQuietUi() {
    SetUi(std::make_unique<QuietUi>());
}

inline QByteArray Bytes(const uint8_t* data, size_t size) {
    return QByteArray(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
}

// The first count - 1 lines of the input as UTF-8 text, then the rest (which may hold
// further line breaks) as the last field. Missing fields are empty.
inline QStringList Fields(const uint8_t* data, size_t size, int count) {
    const QByteArray bytes = Bytes(data, size);
    QStringList fields;
    qsizetype from = 0;
    for (int i = 0; i < count - 1; ++i) {
        const qsizetype nl = from <= bytes.size() ? bytes.indexOf('\n', from) : -1;
        const qsizetype end = nl < 0 ? bytes.size() : nl;
        fields << QString::fromUtf8(bytes.mid(from, end - from));
        from = nl < 0 ? bytes.size() + 1 : nl + 1;
    }
    fields << (from <= bytes.size() ? QString::fromUtf8(bytes.mid(from)) : QString());
    return fields;
}

// A broken property: print what broke and let libFuzzer keep the input.
[[noreturn]] inline void Fail(const char* what, const QString& detail) {
    std::fprintf(stderr, "property broken: %s\n%s\n", what, qPrintable(detail));
    std::abort();
}

}  // namespace zv::fuzz

#pragma once
// The fixed layout of client and case folders under MainPath/DOCS.

#include <QString>
#include <cstdint>

namespace zv {

// Width of the placeholder client number: 7 on the installation that carries the marker
// file LCN7.txt, 5 everywhere else.
int16_t GetClientNumWidth();

// The folder of a client or case, created when missing: clientNum C, kind letters K, sub-kind
// U (blank or non-numeric counts as 0), case number Q and case code N. Returns MainPath/DOCS
// itself when no rule fits the kind, and an empty string when the folder cannot be made.
QString GetDocsDirByClientTik(const QString& clientNum, const QString& kind, const QString& subKind,
                              const QString& caseNum, const QString& caseCode);

}  // namespace zv

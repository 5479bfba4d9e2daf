#pragma once
// The name of a row's kind from the case-kind catalogue (OptKeyNames).

#include <QString>
#include <QVariant>

namespace zv {

// The catalogue's name for the kind optKey; a kind not in the catalogue reads as its number.
// With byTikId, a general case (kind 11) reads as its user-defined kind, the entry under
// 1000 + tikId (empty text when the catalogue has no such entry). A Null or non-numeric
// tikId of a general case is error 94 (Invalid use of Null) or 13.
QString KindText(const QVariant& optKey, const QVariant& tikId, bool byTikId);

}  // namespace zv

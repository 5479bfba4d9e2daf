#pragma once
// The remark history kept in a document's Body: every filing with a remark adds one
// stamped entry under the earlier ones.

#include <QDateTime>
#include <QString>
#include <QVariant>

namespace zv {

// "<short date> <long time> (<user>)" in the system's formats; the long time carries no
// time zone, as the suite's users read it.
QString RemarkStamp(const QDateTime& moment, const QString& userName);
// The Body after adding a remark filed now by MyUserName: the first entry alone, later
// ones under a line of 60 "-".
QString AppendRemark(const QVariant& oldBody, const QString& remark);

}  // namespace zv

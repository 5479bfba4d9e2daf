#pragma once
// The filing request with the dialog: the user answers in FrmGetDocDet, a name clash in
// FrmSaveAs.

#include <QString>

namespace zv {

// Shows the filing dialog for the request (mode 1 a document, 2 a mail, any other mode
// files nothing), then files the source as the user confirmed. Returns the archived file's
// path, or empty when nothing was filed.
QString WorkWithStr(int mode, const QString& path, const QString& name);

}  // namespace zv

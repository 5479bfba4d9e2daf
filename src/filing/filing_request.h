#pragma once
// One filing request after the user's answer: the target resolved, the file copied into the
// archive, the document recorded, the source removed and the user told. The dialog and the
// batch options both end here, so a document is filed the same way with or without a window.

#include <QString>
#include <functional>
#include <optional>

#include "archive/doc_details.h"
#include "util/errors.h"

namespace zv {

// What the confirmed dialog (or the batch options) gives for one request.
struct FilingAnswer {
    QString fileNameToSave;  // full target path without extension
    QString nameText;        // the document name typed (TxtTeur); a mail's file name
    DocDetails details;
};

// A target that exists already.
struct Clash {
    QString existing;  // the file that is there
    QString proposed;  // the path to propose instead: folder, name and extension
    QString dir;       // the target folder, with its trailing separator
    bool document;     // mode 1; otherwise a mail
};
// Asked for each clash: returns dir + name + "." + extension, the proposed path itself to
// replace the existing file, or none to file nothing.
using ClashResolver = std::function<std::optional<QString>(const Clash&)>;

// The extension of the file a path names, without the dot; empty without one. A dot in a
// folder name is no extension.
QString ExtensionOf(const QString& path);

// Files the source path of a request answered by answer: mode 1 a document, 2 a mail, any
// other mode files nothing. Order: copy, record, then delete the source, which is kept when
// the row could not be saved. Every message goes through the Ui; a run-time failure is
// reported with the mode, path and name and ends the request (in a development run the next
// step runs). Returns the archived file's path, or empty when nothing was filed.
QString FileDocument(int mode, const QString& path, const QString& name, const FilingAnswer& answer,
                     const ClashResolver& resolve);

// The failure report of a filing request: "N-0-WorkWithStr-Description", then the error's
// source, the mode, the path and the name on lines of their own.
QString FilingFailureText(const VbError& e, int mode, const QString& path, const QString& name);

}  // namespace zv

#pragma once
// Target folder and file name helpers of the filing dialog. Plain folder and name logic: no
// widgets, so they are exercised without a window.

#include <QString>
#include <optional>

namespace zv {

// The characters refused in a file name.
QString ForbiddenNameChars();
// The message shown when one of them is refused.
QString ForbiddenNameMessage();

// The path with exactly one trailing separator; an empty path is refused with a message and
// gives an empty result.
QString CCpath(const QString& path);

// The part of a path after its last separator ("\" or "/"); unchanged without one.
QString TruncateFileName(const QString& path);

// The next free numbered file in folder: the folder (upper-cased, with a trailing separator),
// the letter, one more than the highest number already used after that letter, then "." and
// ext when ext is not empty. Empty when folder is empty or cannot be read. One pass over the
// folder, nothing read per file beyond its name and kind.
QString GetNextFileName(const QString& folder, const QString& ext, const QString& letter);

// Document-type letter and extension text for the numbering of a source name ("T"/"DOC" for
// a .doc file); none for an extension outside the table.
struct DocType {
    QString letter;
    QString ext;
};
std::optional<DocType> DocTypeOf(const QString& sourceName);

// The name that the numbering button puts into the document-name box, for the proposed
// name, the source extension and the folder selected in the folder view. None when nothing
// is to change.
std::optional<QString> NumberedName(const QString& defultName, const QString& sourceExt,
                                    const QString& selectedFolder);

}  // namespace zv

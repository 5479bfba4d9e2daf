#include "util/errors.h"

#include "util/ui.h"

namespace zv {

VbError::VbError(long number, QString description, QString source)
    : number_(number), description_(std::move(description)), source_(std::move(source)) {
    what_ = (QString::number(number_) + QStringLiteral(" ") + description_).toUtf8();
}

QString StandardDescription(long number) {
    switch (number) {
        case 5:
            return QStringLiteral("Invalid procedure call or argument");
        case err::Overflow:
            return QStringLiteral("Overflow");
        case err::TypeMismatch:
            return QStringLiteral("Type mismatch");
        case err::FileNotFound:
            return QStringLiteral("File not found");
        case err::FileAlreadyExists:
            return QStringLiteral("File already exists");
        case err::PermissionDenied:
            return QStringLiteral("Permission denied");
        case err::PathFileAccess:
            return QStringLiteral("Path/File access error");
        case err::PathNotFound:
            return QStringLiteral("Path not found");
        case err::ObjectRequired:
            return QStringLiteral("Object required");
        case err::JetDuplicate:
            return QStringLiteral(
                "The changes you requested to the table were not successful because they "
                "would create duplicate values in the index, primary key, or relationship.");
        case err::JetCannotOpen:
            return QStringLiteral("Could not find file.");
        case err::JetLocked:
            return QStringLiteral("Couldn't update; currently locked.");
        case err::JetNoField:
            return QStringLiteral("Item not found in this collection.");
        case err::JetReadOnly:
            return QStringLiteral("Cannot update. Database or object is read-only.");
        default:
            return QStringLiteral("Application-defined or object-defined error");
    }
}

VbError MakeError(long number, const QString& source) {
    return VbError(number, StandardDescription(number), source);
}

QString FormatPlain(const QString& tag, const VbError& e) {
    return QString::number(e.Number()) + QLatin1Char('-') + tag + QLatin1Char('-') +
           e.Description();
}

QString FormatWithLine(const QString& tag, const VbError& e) {
    return QString::number(e.Number()) + QStringLiteral("-0-") + tag + QLatin1Char('-') +
           e.Description();
}

VbError AsVbError(const std::exception& e) {
    if (auto* vb = dynamic_cast<const VbError*>(&e)) {
        return *vb;
    }
    return VbError(5, QString::fromUtf8(e.what()));
}

bool Step(const ErrorFormatter& format, const std::function<void()>& step) {
    try {
        step();
        return true;
    } catch (const std::exception& e) {
        MsgBox(format(AsVbError(e)), vbOKOnly);
        return false;
    }
}

}  // namespace zv

#pragma once
// Run-time failures carry a VB-style error number, a description and a source, so that
// messages read as the suite's users know them ("53-0-WorkWithStr-File not found").

#include <QString>
#include <exception>
#include <functional>

namespace zv {

// Error numbers used across the program.
namespace err {
constexpr long Overflow = 6;
constexpr long TypeMismatch = 13;
constexpr long FileNotFound = 53;
constexpr long FileAlreadyExists = 58;
constexpr long PermissionDenied = 70;
constexpr long PathFileAccess = 75;
constexpr long PathNotFound = 76;
constexpr long ObjectRequired = 424;
constexpr long JetDuplicate = 3022;            // duplicate value in a unique index (file database)
constexpr long JetCannotOpen = 3024;           // database file not found
constexpr long JetLocked = 3260;               // locked by another user past the busy timeout
constexpr long JetGeneric = 3146;              // other engine failure (ODBC--call failed)
constexpr long JetNoField = 3265;              // item not found in this collection
constexpr long JetReadOnly = 3027;             // database or object is read-only
constexpr long ServerIntegrity = -2147217873;  // 0x80040E2F: integrity constraint on the server
constexpr long ServerGeneric = -2147467259;    // 0x80004005: unspecified provider failure
}  // namespace err

class VbError : public std::exception {
  public:
    VbError(long number, QString description, QString source = {});
    long Number() const { return number_; }
    const QString& Description() const { return description_; }
    const QString& Source() const { return source_; }
    const char* what() const noexcept override { return what_.constData(); }

  private:
    long number_;
    QString description_;
    QString source_;
    QByteArray what_;
};

// The English description the runtime gives an error number ("File not found" for 53).
QString StandardDescription(long number);
// A VbError with the standard description of its number.
VbError MakeError(long number, const QString& source = {});

// Message formats of the failure reports. The line number is always 0.
// "N-Tag-Description"
QString FormatPlain(const QString& tag, const VbError& e);
// "N-0-Tag-Description"
QString FormatWithLine(const QString& tag, const VbError& e);

using ErrorFormatter = std::function<QString(const VbError&)>;

// Runs one step of a procedure that reports failures and goes on: a VbError (or any other
// exception, as error 5) thrown by the step is shown with OK only, no icon, in the given
// format. Returns whether the step completed.
bool Step(const ErrorFormatter& format, const std::function<void()>& step);

// The same failure as a VbError, for code that catches std::exception at a boundary.
VbError AsVbError(const std::exception& e);

}  // namespace zv

#pragma once
// The options of a filing without a window (--batch): what the user would otherwise choose
// in the filing dialog.

#include <QByteArray>
#include <QDate>
#include <QList>
#include <QString>
#include <optional>

namespace zv {

// What a batch filing does when the target file exists already.
enum class OnClash { Skip, Overwrite };

struct FilingOptions {
    bool given = false;                 // any of the options below was on the command line
    QString client;                     // --client: the client number
    QString caseNumber;                 // --case: one of the client's case files; empty: none
    std::optional<QString> name;        // --name: the document name
    bool number = false;                // --number: consecutive numbering in the folder
    QString innerFolder;                // --inner-folder: a DOCBASIC inner folder
    QString description;                // --description
    QString moreDescription;            // --more-description
    QString remark;                     // --remark
    std::optional<int> origin;          // --origin: origin code
    std::optional<int> status;          // --status: DOCSTATUS ID
    std::optional<QString> handlers;    // --handlers: display names joined by ";"
    std::optional<QDate> received;      // --received
    std::optional<QDate> created;       // --created
    std::optional<QDate> reminderDate;  // --reminder, its date
    QString reminderTime;               // --reminder, its time "HH:MM"
    bool popup = false;                 // --popup
    OnClash onClash = OnClash::Skip;    // --on-clash
};

// Reads the filing option at args[i], with its value ("--name X" or "--name=X"), and
// leaves i on the last argument it used. Returns false when args[i] is no filing option;
// a bad or missing value sets error.
bool ParseFilingOption(const QList<QByteArray>& args, qsizetype& i, FilingOptions& options,
                       QString& error);
// What the options lack or contradict once all are read: they need --batch, --batch needs
// --client, --popup needs --reminder, --name and --number exclude each other. Empty when
// they are consistent.
QString CheckFilingOptions(bool batch, const FilingOptions& options);
// The lines of the usage text that describe these options.
QString FilingOptionsUsage();

}  // namespace zv

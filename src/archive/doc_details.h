#pragma once
// What the archive reads from the confirmed filing dialog, copied into one plain value at
// confirmation, so that recording a document never touches a window.

#include <QDate>
#include <QString>
#include <optional>

namespace zv {

struct DocDetails {
    QString handlers;              // caption of LPersonal: display names joined by ";"
    QString description;           // text of CboTeur
    QString moreDescription;       // text of CboSecTeur
    QString remark;                // text of TxtRemark
    bool reminder = false;         // ChkIsMemo ticked
    QDate reminderDate;            // TDateMemo; a null date is the empty box (reads 0)
    QString reminderTime;          // text of TDBTime1, "HH:MM" or empty
    bool popup = false;            // ChkIsJumpMemo ticked
    QDate receivedDate;            // TDateRecieved; null when empty
    QDate createdDate;             // TDate; null when empty
    bool createdUnlocked = false;  // TDate enabled (after the access code)
    std::optional<int> origin;     // item data of the selected CboPartOf line; none: no selection
    std::optional<int> status;     // item data of the selected CboStatus line; none: no selection
    QString clientNumber;          // caption of LakNum
    QString kindLetter;            // caption of LblSug ("F": a client without a case)
    QString subKind;               // caption of LSugTik
    QString caseNumber;            // caption of LTik
    QString caseCode;              // caption of LTikNum
};

}  // namespace zv

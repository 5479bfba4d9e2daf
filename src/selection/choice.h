#pragma once
// The client and case choices of the filing dialog. They read and write the dialog's
// selection labels through this plain value, so the list windows never touch the dialog;
// the dialog copies the value back into its labels and refreshes its folder view when a
// choice returns true.

#include <QString>
#include <QVariant>

namespace zv {

struct ChoiceLabels {
    QString lakNum;       // LakNum: client number
    QString lakName;      // LakName: client display name
    QString lblSug;       // LblSug: kind letter(s), "F" for a client without a case
    QString lSugTik;      // LSugTik: sub-kind number
    QString lTik;         // LTik: case number
    QString lTikNum;      // LTikNum: case code
    QString lTeurSugTik;  // LTeurSugTik: name of the case kind
    QString lTeurTik;     // LTeurTik: case description
};

// CmdLak: the client list window; true when a client was chosen and the labels changed.
bool ChooseClient(ChoiceLabels& labels);
// CmdTik: the chosen client's case files; true when the window was confirmed, also from an
// empty list (the labels then stay as they were, and the folder view is refreshed).
bool ChooseClientCase(ChoiceLabels& labels);
// CmdGetTikByName: names and cases of the whole database; true when a row was chosen and
// taken. A row of a kind without a folder rule changes nothing and gives false.
bool ChooseCaseByName(ChoiceLabels& labels);
// The display name of a client number, or the number itself when unknown.
QString GetClientTeur(const QVariant& num);

}  // namespace zv

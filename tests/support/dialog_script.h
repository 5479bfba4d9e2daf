#pragma once
// Scripts for the windows of a filing request: the filing dialog filled as a user fills it
// (client and case chosen through their list windows), and the save-as dialog.

#include <QString>
#include <functional>
#include <optional>

#include "scripted_ui.h"

namespace zv {
class FrmGetDocDet;
class FrmSaveAs;
}  // namespace zv

namespace zv::test {

struct DialogInput {
    bool confirm = true;            // false: closed with the close box
    QString client{};               // chosen through the client button
    QString tik{};                  // empty: no case; otherwise chosen through the case button
    std::optional<QString> name{};  // typed into the name box; none keeps the proposal
    QString description{};
    QString remark{};
    bool reminder = false;
    QString reminderTime{};
    bool popup = false;
};

// Queues the filing dialog's script; check runs on the dialog before anything is changed.
void QueueFilingDialog(ScriptedUi& ui, const DialogInput& input,
                       const std::function<void(FrmGetDocDet&)>& check = {});
// Queues the save-as dialog's script: check runs first, then the name is replaced when
// rename is set, then it is confirmed, or cancelled when cancel is set.
void QueueSaveAs(ScriptedUi& ui, const std::function<void(FrmSaveAs&)>& check,
                 const std::optional<QString>& rename, bool cancel = false);

}  // namespace zv::test

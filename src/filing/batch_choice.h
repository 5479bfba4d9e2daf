#pragma once
// The client and case of a filing without a window, looked up as the dialog's client and
// case buttons find them, into the same selection labels.

#include <QString>
#include <optional>

#include "selection/choice.h"

namespace zv {

// The labels the client button sets for the client with this number; none when CLIENT has
// no such client.
std::optional<ChoiceLabels> ClientChoice(const QString& clientNum);

// Sets the case labels (kind letter, sub-kind, case number and code) for the case with this
// case number among the client's own case files, as the case button takes that row. False,
// and the labels unchanged, when the client has no such case.
bool AddCaseChoice(ChoiceLabels& labels, const QString& caseNumber);

}  // namespace zv

#pragma once
// The one source of "now" and "today", replaceable so that tests fix the moment.

#include <QDateTime>
#include <functional>

namespace zv {

QDateTime Now();
QDate Today();
// Replaces the clock; an empty function restores the system clock.
void SetClock(std::function<QDateTime()> clock);

}  // namespace zv

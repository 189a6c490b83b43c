#pragma once
// The one place Quillmark reads the clock: change stamps, backup names and log
// time stamps all come from here, so that tests can fix the time.

#include <QDateTime>

namespace qm {

QDateTime now();
// Fixes the time now() returns; an invalid QDateTime gives the real clock back.
void setclockfortests(const QDateTime& fixed);

} // namespace qm

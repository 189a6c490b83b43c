#pragma once
// Whether a file may be handed to the system to open in its default program.
// Paths of image files come from family files, which anyone can write, so a
// program or script must never be started that way: only existing regular
// files that are neither of a type the system runs nor marked executable.

#include <QString>

namespace qm {

// Why the file must not be opened, for the user; "" when it may be.
QString refuseopen(const QString& path);

// Whether a file name ends in an extension of programs, scripts, installers or
// shortcuts on any of the systems Quillmark runs on (letter case ignored;
// trailing dots and spaces, which Windows drops, are passed over; the name of
// an NTFS stream, after a colon, counts as well).
bool runnablename(const QString& name);

} // namespace qm

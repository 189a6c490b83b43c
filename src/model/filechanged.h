#pragma once
// Noticing that another program (usually Family Historian, which keeps the file
// open) has changed the family file since Quillmark read it.

#include "platform/filetime.h"

#include <QString>

namespace qm {

struct gedcomindex;

// Whether the file at path differs in last-modified time or size from what was
// noted when it was read (a file that has gone counts as changed).
bool filechanged(const QString& path, const filestamp& noted);
// The index's family file against the stamp noted by its load.
bool filechanged(const gedcomindex& index);

// path + " has been modified by another application and will be reloaded."
QString changedmessage(const QString& path);
// The family file is no longer there (deleted, renamed or moved outside):
// asks whether to open another family file.
QString filegonequestion(const QString& path);
// The same said during a save, which drops the images chosen for the entry.
QString changedonsavemessage(const QString& path, bool imageschosen);

} // namespace qm

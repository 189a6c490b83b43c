#pragma once
// Edit > "Undo Last Census Entry" without its window: says what the last
// change Quillmark made to the family file was and asks before undoing it;
// when it cannot be undone (none noted, already undone, the file changed
// since, its backup gone) says why instead. The undo itself is undolast's.

#include "writer/openfile.h"

#include <QString>

namespace qm {

class prompts;
struct settings;

// True when the family file was put back (the caller reads it again).
bool askundolast(const QString& familyfile, const settings& s, prompts& p);
// The same for the open family file, with its watch for outside changes paused.
toolend askundolast(openfile& file, prompts& p);

} // namespace qm

#pragma once
// The flag tools the main window offers: the Census Flags dialog from the
// Tools menu, and the flag check run after each load. Both work on the open
// family file and say how they ended; the caller reads the file again or ends
// the program.

#include "writer/openfile.h"

class QWidget;

namespace qm {

class prompts;

// "Census Flags...": the flag definitions are stored when the dialog closes;
// its Flag Check may rewrite the file. Runs with the watch paused.
toolend censusflags(openfile& file, prompts& p, QWidget* parent);

// After a load when "Flag Check" is on: when the flags are out of step, says
// so and opens the Flag Check dialog, with the watch paused.
toolend silentflagcheck(openfile& file, prompts& p, QWidget* parent);

} // namespace qm

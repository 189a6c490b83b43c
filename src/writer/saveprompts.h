#pragma once
// Shows the messages of a save's outcome the same way in every window, and
// tells the window what is left for it to do.

#include "writer/saveroad.h"

namespace qm {

class prompts;

enum class aftersave {
    saved,   // the change stands (a log error, if any, has been shown)
    changed, // another program changed the file: nothing shown, the window says so in its own words
    stay,    // nothing written, the message shown: the window stays as it was
    fatal,   // the rewrite failed, the message shown: the window ends the program
};

// Refused and failed backups are shown as warnings, a failed rewrite as an
// error; after a save, a census log entry that could not be written, and a
// change that could not be noted for an undo, are shown as warnings.
aftersave tellsaveoutcome(prompts& p, const saveoutcome& out);

} // namespace qm

#pragma once
// The Options dialog as the main window opens it: from the Tools menu, and at
// start when the settings are incomplete or their paths fail their checks.
// After Save the new settings are in use in the open file (and stored).

#include <functional>

class QString;
class QWidget;

namespace qm {

class openfile;
class prompts;

struct optionsend {
    bool saved = false;
    // The recording method, the country or "ID Only" changed: the entry is
    // cleared and the file read again.
    bool reloadneeded = false;
};

// "Options...". `donate` opens the donation page from the dialog.
optionsend showoptions(openfile& file, prompts& p, const std::function<void()>& donate, QWidget* parent);

// At start, once the settings are read: incomplete settings, or paths that
// fail their checks, are put right in the dialog before the file is loaded.
// It cannot be cancelled while the settings are incomplete. True when the
// dialog was shown and saved.
bool startoptions(openfile& file, prompts& p, const std::function<void()>& donate, QWidget* parent);

} // namespace qm

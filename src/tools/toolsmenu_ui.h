#pragma once
// The tools the main window offers from its Tools menu and Find button:
// the Census Date Check and the Find dialog. Both work on the open family file.

#include "writer/openfile.h"

#include <cstdint>

class QWidget;

namespace qm {

class peoplelistmodel;
class prompts;

// "Census Date Check...": `reload` when the file was rewritten or found
// changed, `fatal` when a rewrite failed. Runs with the watch paused.
toolend censusdatecheck(openfile& file, prompts& p, QWidget* parent);

// What the Find dialog gave: the individual chosen (-1 after Cancel or when
// none was shown), and whether the immediate family is to be rebuilt around it.
struct findchoice {
    int32_t person = -1;
    bool refocus = false;
};

// The Find dialog, opened at people[start] (or -1). `people` is what the
// main window's people list holds: the dialog offers it when the index is too
// large for the list of all individuals.
findchoice findindividual(const openfile& file, const peoplelistmodel& people, int32_t start, prompts& p,
                          QWidget* parent);

} // namespace qm

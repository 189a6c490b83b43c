#pragma once
// The image tools the main window offers: "Attach Images to Existing
// Sources..." from the Tools menu, and the Census Images dialog for the entry
// being saved. Both work on the open family file.

#include "writer/openfile.h"

#include <QString>

#include <vector>

class QWidget;

namespace qm {

class prompts;

// "Attach Images to Existing Sources...": the index is brought up to date
// after each attach; `reload` when images were attached or the file was
// changed outside. Runs with the watch paused.
toolend attachimages(openfile& file, prompts& p, QWidget* parent);

// The Census Images dialog for the entry being saved, offering titles built
// from its source. False when the user chose "Cancel saving census".
bool chooseentryimages(const entrysource& e, openfile& file, prompts& p, QWidget* parent,
                       std::vector<imagechoice>& chosen);

} // namespace qm

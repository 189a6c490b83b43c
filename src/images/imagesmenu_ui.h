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

// The source the entry being saved makes (a new one: its title and
// reference) or cites (an existing one: its title and where within it).
struct entrysource {
    bool fullentry = true;
    QString date;
    QString title;
    QString reference;
    QString sourcetitle;
    QString where;
};

// The Census Images dialog for the entry being saved, offering titles built
// from its source. False when the user chose "Cancel saving census".
bool chooseentryimages(const entrysource& e, openfile& file, prompts& p, QWidget* parent,
                       std::vector<imagechoice>& chosen);

} // namespace qm

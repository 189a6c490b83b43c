#pragma once
// The four most recently opened family files, slot 0 the most recent, and the
// other values the main window keeps about files: the default file and the
// folder the Open dialog starts in.

#include "platform/paths.h"

#include <QString>

#include <array>

namespace qm {

class settingsstore;

struct recentfiles {
    static constexpr int slotcount = 4;
    std::array<QString, slotcount> paths; // "" for a slot not in use

    // Reads "Recent Files  1".."Recent Files  4": the text trimmed; a value
    // shorter than 2 characters leaves the slot empty.
    void read(const settingsstore& store);
    // Writes every slot back (empty slotcount as "").
    void write(settingsstore& store) const;

    // Puts path into the first slot: it moves up from its own slot, or enters
    // anew and pushes the last slot's path out.
    void remember(const QString& path);
    // Removes path; the slotcount after it move up and the last becomes empty.
    void remove(const QString& path);

    bool inuse(int slot) const { return paths[static_cast<size_t>(slot)].size() > 1; }
    // Menu caption of a slot in use: "&1 path", or "&1.." + the last 40
    // characters of a longer path.
    QString caption(int slot) const;
};

// The registry name of a slot: "Recent Files" + " " + number, as
// "Recent Files  1" (the number is written with its leading space).
QString recentvaluename(int slot);

} // namespace qm

#pragma once
// The road every change to the family file takes, whichever feature asks for
// it: refuse text the file cannot hold and a census log that would land on a
// family file or a backup, take the family file's lock (one save at a time
// across Quillmark processes), refuse to write over a change made by another
// program, make the backup, rewrite the file (safely: it is replaced in one
// step or not at all), add the census log entry, note the new file stamp.
// The caller shows the outcome's messages and reloads the file afterwards.
//
// Another program's change is looked for before the backup, after it, and
// once more when the new content is on the disk, just before the family file
// is replaced: only a change made in the moment between that last look and the
// replace itself can still be lost (docs/saving.md).

#include "platform/filetime.h"
#include "writer/backups.h"
#include "writer/rewritefile.h"

#include <QString>

#include <functional>

namespace qm {

struct gedcomindex;
struct settings;

enum class savestatus {
    saved,
    refused,       // nothing written: text the file cannot hold, a bad log path, another Quillmark saving,
                   // or the rewrite found the entry out of date
    changed,       // the file was changed by another program: reload it; nothing written
    backupfailed,  // the backup could not be made; nothing written
    rewritefailed, // the family file is as it was; the program ends after the message
};

struct saveoutcome {
    savestatus status = savestatus::refused;
    QString message;    // for the user unless saved
    QString backuppath; // the backup made ("" when none)
    bool logwritten = false;
    QString logerror;   // after a save: the log entry could not be written (shown, the save stands)
    filestamp newstamp; // after a save: the family file's new stamp
    QString undoerror;  // after a save: what an undo needs could not be noted (shown, the save stands)
    rewriteresult rewrite;

    bool saved() const { return status == savestatus::saved; }
    // A failed rewrite ends the program once its message has been shown.
    bool fatal() const { return status == savestatus::rewritefailed; }
};

// Runs the road for one rewrite request over the index's family file.
//
// `made` is a backup already made while the file was being loaded (the
// command-line tool overlaps the two). It is taken when it holds the file as
// loaded (same last-modified time and size); otherwise it is removed and a new
// backup is made in its place.
saveoutcome savechange(const gedcomindex& index, const settings& s, const rewriterequest& request,
                       const backupresult* made = nullptr);

// Census entry: mode 1 of the above.
saveoutcome saveentry(const gedcomindex& index, const settings& s, const censusentry& entry,
                      const backupresult* made = nullptr);

// Tests: makes the rewrite meet an input it cannot open (as with a backup
// taken away or made unreadable after it was written).
void setinputfaultfortests(bool on);

// Tests: a hook called between the steps of a save, where a test plays the
// other program or the other Quillmark.
enum class savestep {
    locked,   // the lock is held, nothing looked at yet
    backedup, // the backup is made
    written,  // the new content is on the disk; the family file is not touched yet
};
void setsavehookfortests(std::function<void(savestep)> hook);

} // namespace qm

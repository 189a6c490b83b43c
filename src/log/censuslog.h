#pragma once
// The census log: a plain-text history, in words, of every change Quillmark
// made to a family file. Entries are appended, never rewritten; each starts
// with a line of 78 equals signs. Lines end in CR LF; the text is UTF-8.

#include "writer/censusentry.h"

#include <QString>

#include <vector>

namespace qm {

struct settings;

// What one change did, for its log entry.
struct logentry {
    int mode = 1; // 1 census entry, 2 images attached, 3 census dates, 4 flag check
    QString gedcomfile;

    // modes 1 and 2
    QString sourceid;
    QString title;
    QString reference;                  // mode 1 citing an existing source: where within it
    std::vector<selectionrec> selection; // mode 1: the entry's individuals
    QString flagname;                   // mode 1: name of the flag given, empty when none
    std::vector<imagechoice> chosenimages;

    // mode 3
    std::vector<datechange> datechanges;
    int occdateschanged = 0;

    // mode 4
    int flagchangecount = 0;
};

// The lines of the entry, without line ends, separator first.
QStringList loglines(const settings& s, const logentry& e);

// Appends the entry to the log at s.logpath. Returns the message for the user
// when the log could not be written, with the system's reason (the entry is
// then lost), or "".
QString writelogentry(const settings& s, const logentry& e);

// Why the census log must not be kept at logpath: it is the family file
// (familyfile may be ""), a GEDCOM file, or a file in the backup folder, where
// appending would change a family file or a backup. "" when it may.
QString refuselogpath(const QString& logpath, const QString& familyfile, const QString& backupfolder);

// Opens the log for appending, creating it when absent. Returns the message
// for the user when it cannot be written to, or "".
QString checklogfile(const QString& logpath);

// The separator line that starts every entry.
QString logseparator();

// Appends the entry noting that an image file was renamed to match its title;
// returns like writelogentry.
QString writerenameentry(const settings& s, const QString& from, const QString& to);

// Appends the entry noting that the last change to a family file was undone:
// what that change was and when it was made (summary, made), the backup put
// back, and the backup of the file as it was before the undo. Returns like
// writelogentry.
QString writeundoentry(const settings& s, const QString& gedcomfile, const QString& summary, const QString& made,
                       const QString& restoredfrom, const QString& backup);

// The local date and time as log entries give it ("2026-12-04 23:50:07").
QString logtimestamp();

} // namespace qm

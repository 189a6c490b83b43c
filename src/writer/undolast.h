#pragma once
// Taking back the last change Quillmark made to a family file.
//
// After every change (a census entry, images attached, census dates, flags)
// the save road notes beside the backups what is needed to undo it: a small
// file "QM Undo " + key + ".json" in the backup folder, one per family file
// (the key is the hash of the family file's full path, so that family files
// sharing the folder do not meet). It holds the family file's full path, what
// the change was and when, the backup that holds the file as it was before,
// and the family file's stamp right after the change: last-modified time, size
// and content hash. The hash is kept because an undo puts a whole older file
// back: a later edit by another program that kept the size and the time (an
// edit of one digit on a file system that counts time in 2-second steps, a
// program that sets the time back) would be lost by it, and only the content
// tells. The hash is taken of the bytes as they are written, so a change made
// just after the save cannot slip into it.
//
// undolast puts the family file back as it was before that change, only when
// the file still holds exactly what the change wrote. It takes the road a save
// takes: the family file's lock, the current file backed up first, the backup
// copied over the family file in one step that keeps the file's identity
// (owner, links, attributes), a census log entry. Its new last-modified time is
// the time of the undo, so that other programs see the file has changed.
//
// An undo is one step back, not a toggle: a second undo is refused, naming the
// backup that holds the file as it was before the first undo, and the next
// change made to the file can be undone again. (An undo that undid itself
// would let two presses of one menu item swap two versions of the file.)

#include "platform/filetime.h"

#include <QString>

#include <cstdint>

namespace qm {

struct gedcomindex;
struct rewriterequest;
struct rewriteresult;
struct saveoutcome;
struct settings;

// What is noted about the last change to a family file.
struct lastchange {
    bool known = false;  // a note of a change to this file was found and read
    QString problem;     // a note was found but cannot be used: why ("" otherwise)
    QString notepath;    // where the note is (or would be)
    QString gedcomfile;  // the family file's full path
    int mode = 0;        // the rewrite mode of the change (1 census entry ... 4 flags)
    QString summary;     // what the change was, as the census log words it
    QString made;        // when ("2026-12-04 23:50:07")
    QString backuppath;  // the backup holding the file as it was before the change
    filestamp backupstamp;
    filestamp after;     // the family file right after the change
    uint64_t hash = 0;   // its content hash then
    QString undone;      // when the change was undone, "" when it was not
    QString undobackup;  // the backup the undo made of the file as it was before the undo
};

// The note of the last change to familyfile kept in backupfolder.
lastchange readlastchange(const QString& familyfile, const QString& backupfolder);

// Notes a change the save road has just saved (out.saved()). "" or why the
// note could not be written; the change stands either way, but cannot then be
// undone (an older note no longer matches the file, and is refused).
QString notelastchange(const gedcomindex& index, const settings& s, const rewriterequest& request,
                       const saveoutcome& out);

// What a change was, as the census log words it ("Census entry added: ... (ID: 23), 4 individuals").
QString changesummary(const rewriterequest& request, const rewriteresult& result);

enum class undostatus {
    undone,
    refused,      // nothing known, already undone, the file changed since, the backup gone, another Quillmark saving
    backupfailed, // the current file could not be backed up; nothing written
    failed,       // the replace failed; the family file is as it was (message says so)
};

struct undooutcome {
    undostatus status = undostatus::refused;
    QString message;      // for the user unless undone
    QString summary;      // the change undone
    QString restoredfrom; // the backup put back
    QString backuppath;   // the backup of the file as it was before the undo
    bool logwritten = false;
    QString logerror;     // the census log entry could not be written (the undo stands)
    QString noteerror;    // the note could not be marked as undone (the undo stands)
    filestamp newstamp;   // the family file's stamp after the undo

    bool undone() const { return status == undostatus::undone; }
};

// Puts back familyfile as it was before the last change Quillmark made to it.
undooutcome undolast(const QString& familyfile, const settings& s);

// The question a window asks before undoing: what will be undone.
QString undoquestion(const lastchange& c);

} // namespace qm

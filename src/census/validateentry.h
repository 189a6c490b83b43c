#pragma once
// The checks "Save Census Entry" makes before anything is written, in their
// fixed order, each with its message. The entry form and quillmark-cli both
// run them over plain data.

#include "writer/censusentry.h"

#include <QString>

#include <vector>

namespace qm {

class prompts;
struct gedcomindex;
struct settings;

// What the entry form holds at the moment of saving (the household's rows
// already stored into the selection).
struct entryform {
    bool fullentry = true;   // panel 0: a new source for the entry; panel 1: an existing one is cited
    QString yeartext;        // the census year chosen in the year list, "" when none is chosen
    QString officialdate;    // the official date of that census ("" when none)
    QString datetext;        // the census date box
    QString place;
    QString address;
    QString title;           // panel 0: the full title
    QString reference;       // panel 0: census reference; panel 1: where within source
    QString other;           // panel 0: other information
    QString sourceid;        // the source number label: next free number, or the chosen source
    QString sourcetext;
    QString notetext;
    std::vector<selectionrec> selection;
};

// The control a failed check sends the focus to.
enum class entryfield { none, place, title, wherewithinsource, date, sourcetext };

struct entrycheck {
    bool ok = false;
    QString message;        // the first failing check's message ("" when the user answered No)
    entryfield focus = entryfield::none;
    QString entrydate;      // when ok: the census date, normalised as the date box now shows it
    bool datechanged = false; // the date box text was normalised
};

// Runs the checks from "at least 1 person" to "Census date not specified".
// When p is given and "No Source Text Warning" is on, a missing source text is
// then asked about ("Save census"); answering No fails the check with no message.
entrycheck validateentry(const entryform& form, const settings& s, prompts* p = nullptr);

// "You must first enter an age for this individual": the age check of the rows.
QString noagemessage();

// Checks of a household given by record numbers rather than picked from the
// lists (quillmark-cli): every individual known and chosen once, every age a
// number of at most 3 digits with an age type of Y, M or D. The first failing
// message, or "".
QString checkhousehold(const std::vector<selectionrec>& selection);

// The position in `sources` of the census source with that number, or -1.
int findcensussource(const gedcomindex& index, const QString& sourceid);
QString notcensussourcemessage(const QString& sourceid);

// The entry the rewrite is given for a form that passed the checks, dated
// `entrydate` (the census date as the checks wrote it).
censusentry entryfromform(const entryform& form, const QString& entrydate);

} // namespace qm

#pragma once
// What a change to the family file is made of: the census entry being saved,
// the images chosen for a source, and the change lists of the census date check
// and the flag check. Plain records, filled by the windows or the command-line
// tool and read by the rewrite and the census log.

#include <QString>

#include <cstdint>
#include <vector>

namespace qm {

// One individual of the entry: one census row.
struct selectionrec {
    int32_t id = 0;          // record number of the individual
    QString name;            // name as shown in the row
    QString age;             // age typed, trimmed, at most 3 digits
    QChar agetype = u'Y';    // 'Y' years, 'M' months, 'D' days
    QString occupation;      // occupation typed, trimmed
    int32_t personindex = -1; // position in the index's `people`
    bool found = false;      // used while the file is reloaded

    // Birth details given for this individual (birth details dialog): a
    // calculated birth event is written when `birthedited` is set.
    bool birthedited = false;
    QString birthdate;  // GEDCOM date text, such as "ABT 1851"
    QString birthplace;
};

// One image chosen for a census source.
struct imagechoice {
    int32_t objectid = 0; // the multimedia record number (new or existing)
    QString form;         // file format, such as "jpg"
    QString title;
    QString file;         // path of the image file
    QString date;         // the "_DATE" value
    bool isnew = false;   // a new multimedia record is written for it
    int titlenumber = 0;
    QString xref;         // an existing record: its identifier as the file writes it ("O0007"); "" = "O" + objectid
};

// The source the census entry being saved makes (a new one: its title and
// reference) or cites (an existing one: its title and where within it), as
// typed: the Census Images dialog builds its titles from it.
struct entrysource {
    bool fullentry = true;
    QString date;
    QString title;
    QString reference;
    QString sourcetitle;
    QString where;
};

// One distinct census event date found by the census date check.
struct datechange {
    QString founddate;  // the date as found after "2 DATE "
    int32_t count = 0;  // census events with this date
    QString newdate;    // replacement, "" when none
    int censusrow = -1; // row of the census table; -1 no proposal, -2 refused
    int datekind = 0;   // 0 unrecognised, 1 official of the chosen country, 2 of another country

    bool applies() const { return !newdate.isEmpty() && datekind == 0; }
};

// One flag to give to or take from an individual (flag check).
struct flagchange {
    int32_t person = -1; // position in `people`
    int32_t flag = -1;   // position in the flag table
    bool add = true;
};

// The census entry being saved (mode 1 of the rewrite).
struct censusentry {
    QString sourceid;   // S number of the source to create (full entry) or cite, digits only
    QString title;      // full entry: the new source's title; otherwise the cited source's title
    QString place;
    QString address;
    QString reference;  // full entry: census reference; otherwise where-within-source; trimmed
    QString sourcetext; // multi-line
    QString notetext;   // multi-line
    QString other;      // full entry: other information (for the title)
    QString entrydate;  // census date of the entry, such as "30 MAR 1851"
    int year = 0;       // census year chosen (the year shown, which for Canada 1851 differs from the date's)
    std::vector<selectionrec> selection;
    std::vector<imagechoice> chosenimages;
};

} // namespace qm

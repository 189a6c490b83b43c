#pragma once
// The user's settings, read once at start from the settings store and written
// back by the options dialog. Value names, text forms and reading rules are
// those the store has always held, so a store written by an earlier version
// reads the same.

#include <QString>
#include <QStringList>

#include <cstdint>

namespace qm {

class settingsstore;

struct settings {
    // group 1
    bool fullentry = true;       // "Full Entry": a new census source for each entry
    bool sourceinnote = false;   // "Source in Note"
    bool keeplog = true;         // "Keep Log"
    QString logpath;             // "Log Path"
    // group 2
    QString country = QStringLiteral("UK"); // "Country": "UK", "USA", "Ireland" or "Canada"
    bool birthdate = true;       // "Birthdate"
    int certainty = -1;          // "Certainty": 0..3, -1 = no QUAY line
    bool residence = false;      // "Residence"
    // group 3
    QString sourcetype = QStringLiteral("Census"); // "Source Type"
    // group 4
    bool requestimage = true;    // "Request Image"
    // group 5
    bool idonly = false;         // "ID Only"
    bool autoreference = false;  // "Auto Reference"
    // group 6
    QString backupfolder;        // "Backup Folder"
    // group 7
    bool flaguse = false;        // "Flag Use"
    bool flagcheck = false;      // "Flag Check"
    bool opt1entrydate = false;  // "Opt1 Entry Date"
    bool opt1whereinsource = false; // "Opt1 Where in Source"
    bool opt1publicationinfo = false; // "Opt1 Publication Info"
    bool requestimages2 = false; // "Request Images 2"
    bool image2event = false;    // "Image 2 Event"
    bool entrydatetoday = false; // "Entry Date Today"
    bool occplace = true;        // "Occ Place"
    bool occage = false;         // "Occ Age"
    bool sharednote = false;     // "Shared Note"
    QString title = QStringLiteral("Census {YEAR} {PLACE} {REF} ({OTHER})"); // "Title"
    // group 8
    bool asid = true;            // "ASID"
    bool fileopendefault = true; // "File Open Default"
    bool sourcenote = false;     // "Source Note"
    // group 9
    bool occscholar = true;      // "Occ Scholar"
    // group 10
    bool birthsecondaryevidence = false; // "Birth Secondary Evidence"
    // group 11
    bool alternateseparator = false;     // "Alternate Separator"
    QString alternateseparatorcharacter = QStringLiteral("-"); // "Alternate Separator Character"
    bool marriagecondition = false;      // "Marriage Condition"
    bool nosourcetextwarning = true;     // "No Source Text Warning"

    // outside the groups
    int64_t count = 0;           // "Count": census entries saved
    QString imagefolder;         // "Image Folder"
    QString imageoption = QStringLiteral("0"); // "Image Option"
    bool renamefile = false;     // "Rename File"
    // "Household Check": the household is compared with the tree before a
    // census entry is saved. One character, on unless "0"; read whatever
    // happened to the groups, so that a store without it keeps the check on.
    bool householdcheck = true;

    // Settings incomplete (first run, or written by an older version): the
    // options dialog opens at start; saving the options clears it.
    bool firststart = false;
};

QString defaulttitletemplate(); // "Census {YEAR} {PLACE} {REF} ({OTHER})"

// The folder Quillmark writes its own files to (census log, backups).
QString programfolder();
QString defaultlogpath();
// "Backups" in the program folder (made when missing): apart from the census
// log, which is never kept in the backup folder.
QString defaultbackupfolder();

// The settings a value takes when it is absent or not accepted, with the log
// path and backup folder in the program folder.
settings defaultsettings();

struct settingsload {
    settings values;
    // The log and backup-folder checks are due before the first file is opened
    // (all groups were read, so the paths are the user's own).
    bool pathchecksdue = false;
    // The values that took their defaults because the store lacks them or
    // holds them in a form not accepted (with all the later values of the
    // group order, which follow them), by their names.
    QStringList defaulted;
};

// The names of the values read from the store, in the order they are read.
QStringList settingnames();

settingsload loadsettings(settingsstore& store);
void savesettings(settingsstore& store, const settings& s);
void saveflagsettings(settingsstore& store, const settings& s);

} // namespace qm

#pragma once
// What the options dialog decides, apart from its window: the log file name
// chosen, the backup folder as stored, the certainty of the assessment
// buttons, the enabling of dependent controls, the title example, the
// "Default Settings" values and the whole of Save.
//
// The dialog holds its controls' values in a `settings` value (the form); the
// settings in use change only when Save succeeds.

#include "settings/settings.h"

#include <QString>
#include <QStringList>

namespace qm {

class prompts;
class settingsstore;

// The values remembered when the dialog opens: a change of any of them on
// Save clears the entry on the main window.
struct optionsopening {
    bool fullentry = true;
    QString country;
    bool idonly = false;

    static optionsopening of(const settings& s) { return {s.fullentry, s.country, s.idonly}; }
};

// The form after "Default Settings": the defaults of every value the dialog
// shows, except "Marriage Condition", which the button leaves as it is. Values
// the dialog does not show are kept from `form`.
settings dialogdefaults(const settings& form);

// Copies the values the dialog edits from `form` into `to`; "Flag Use",
// "Flag Check", "Birth Secondary Evidence" and the values outside the groups
// stay as they are in `to`.
void takeoptions(settings& to, const settings& form);

// Which dependent controls are enabled for the values on the form.
struct optionsenabling {
    bool logpath = true;        // pathtxt, pathbut: while "Keep Log" is ticked
    bool entrydatetoday = true; // method 1: while "Opt1 Entry Date" is ticked; method 2: always
    bool image2event = true;    // method 2: while "Request Images 2" is ticked
    bool separator = false;     // separatortxt: while "Alternate Separator" is ticked
    bool autoreference = true;  // autorefchk: UK only
};
optionsenabling enablingof(const settings& form);

// The assessment buttons: choice -1 is "Do not record Assessment", 0 to 3 the
// buttons from primary to unreliable evidence, which record the GEDCOM
// certainty 3 to 0.
int certaintyofchoice(int choice);
int choiceofcertainty(int certainty);

// The log file chosen in the save dialog: the path to show, or the message
// when it cannot be used. A name ending in "ged" (any case) is refused, as the
// log would be written into a family file; a name without ".txt" gets it.
struct logname {
    QString path;
    QString error;
};
logname chooselogname(const QString& chosen);
QString gedcomlogmessage();

// The backup folder as stored: trimmed, without a trailing "\" when longer
// than one character. Off Windows a trailing "/" goes the same way, so that
// "/home/me/backups/" and "/home/me/backups" are one folder; "/" stays.
QString trimbackupfolder(const QString& folder);

// The seven placeholders in the order they are replaced.
QStringList titleplaceholders();
// The example output of a title template: the second census of the census
// table, at 43 Knutsford Road, Warrington, Lancashire, reference HO107/2204/151,
// for John Smith.
QString titleexample(const QString& templ);

QString noseparatormessage();
QString methodchangequestion();
QString countrychangequestion();
QString idonlychangequestion();

// Save, in its order: the log file is created; a change of method (or else of
// country) is confirmed; an empty separator stops; a change of "ID Only" is
// confirmed when nothing was asked yet; the paths are checked; the settings
// are written to the store.
enum class optionsstop {
    none,        // saved
    logfile,     // the log file could not be created (the message was shown)
    declined,    // a change was not confirmed
    noseparator, // the separator character is empty: the window shows noseparatormessage()
    paths,       // checkpaths found a problem (its message was shown)
};

struct optionssave {
    optionsstop stop = optionsstop::none;
    settings values;           // when saved: the settings now in use
    bool reloadneeded = false; // when saved: the entry on the main window must be cleared
    bool saved() const { return stop == optionsstop::none; }
};

// `current` are the settings in use, `form` the dialog's values. Nothing is
// written to the store unless every step passes.
optionssave saveoptions(prompts& p, settingsstore& store, const settings& current, const settings& form,
                        const optionsopening& opening);

} // namespace qm

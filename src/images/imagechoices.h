#pragma once
// The images chosen for one census source: the checks a new image file must
// pass, the titles offered for it and their numbers, renaming the file to its
// title, and the rows the image dialogs show. Plain functions over the list of
// chosen images (imagechoice, censusentry.h) and the index's multimedia records.

#include "writer/censusentry.h"

#include <QString>

#include <cstdint>
#include <vector>

namespace qm {

struct gedcomindex;
struct objectrec;
struct settings;
class settingsstore;

// A title made fit for a file name: each of : \ / ? * < > | ' " becomes "_".
QString cleanfilename(QString text);

// The file type shown as "File Type:": ".bmp" "bmp", ".gif" "gif", ".jpg"
// "jpeg", ".pcx" "pcx", ".tif" "tif"; otherwise the text after the last "." of
// the file name, lower case and trimmed; "" when the name has none.
QString imagefiletype(const QString& path);

// The file name without its folder and its extension (kept whole when its
// only "." is its first character, or when it has none).
QString titlefromfilename(const QString& path);

// The number the next new image titled `base` gets: one more than the highest
// among the new images of that exact title, or 1.
int nexttitlenumber(const std::vector<imagechoice>& chosen, const QString& base);

// The title followed by " " + number when the number is 2 or more.
QString fulltitle(const QString& title, int number);
QString fulltitle(const imagechoice& image);

// Why a file cannot be taken as a new image ("" when it can): an application
// program, a GEDCOM file, an image already chosen, or the file of one of the
// family file's multimedia records (compared ignoring letter case; a record's
// relative path is taken from the family file's folder).
QString refusenewimage(const QString& path, const std::vector<imagechoice>& chosen, const gedcomindex& index);

// The preview's message for a file it cannot read as a picture.
QString previewfailedtext();

// For the command-line tool, which shows no preview: why a file cannot be
// read as a picture ("" when it may be). It must be a readable, non-empty
// regular file, and a file named as a BMP, GIF, JPEG, PNG or TIFF picture must
// begin as one. Formats the preview cannot show are accepted, as there.
QString imagefileproblem(const QString& path);

// Why an existing multimedia record cannot be chosen ("" when it can): it has
// been chosen already.
QString refuseexistingimage(int32_t objectid, const std::vector<imagechoice>& chosen);

// The O number the first new image gets is one more than this.
int32_t firstobjectbase(const gedcomindex& index);

// Appends a new image: objectid = ++nextobjectid.
const imagechoice& addnewimage(std::vector<imagechoice>& chosen, int32_t& nextobjectid, const QString& file,
                               const QString& title, int titlenumber, const QString& date);
// Appends an existing multimedia record (titlenumber 0, not new).
const imagechoice& addexistingimage(std::vector<imagechoice>& chosen, const objectrec& object);

// Row of the Census Images list: position (1-based) + ": " + full title, trimmed.
QString imagerow(int position, const imagechoice& image);
// Row of the chooser when it shows paths: "..." + the last 80 characters.
QString pathrow(const QString& file);
// "CENSUS" in the record's title or file path, ignoring case.
bool mentionscensus(const objectrec& object);

// The values the Add a new image... dialog keeps in the settings store: the
// folder of the last image file chosen, the title option last used (0-3) and
// the state of "Rename the file to match the title?". Read afresh each time,
// since the dialog writes them while the program runs.
struct imagedialogvalues {
    QString folder;
    int option = 0;
    bool rename = false;
};
imagedialogvalues readimagevalues(const settingsstore& store, const settings& s);
void saveimagefolder(settingsstore& store, const QString& chosenfile);
void saveimagechoice(settingsstore& store, int option, bool rename);

// Renaming a chosen file to match its title.
struct renameresult {
    QString path;     // the file's path afterwards (unchanged when not renamed)
    QString message;  // why it could not be renamed, for the user; "" when done
    QString logerror; // the census log could not be written to; the rename stands
    bool renamed = false;
    bool ok() const { return message.isEmpty(); }
};

// The path the file gets: its folder + cleanfilename(full title), trimmed,
// + its extension.
QString renamedpath(const QString& path, const QString& title);

// Renames the file to renamedpath() unless that differs from it only in
// letter case; refuses when a file of that name exists. With "Keep Log" on, a
// successful rename is noted in the census log.
renameresult renametotitle(const QString& path, const QString& title, const settings& s);

} // namespace qm

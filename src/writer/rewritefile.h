#pragma once
// The one operation through which every change reaches the family file.
//
// rewritefile copies the family file line by line from an input (the backup
// copy, or the family file itself) to the family file's path, and on the way
// inserts, replaces or drops lines. It serves four callers, told apart by the
// mode: a census entry, images attached to an existing source, census dates
// changed, flags changed.
//
// The output goes to a temporary file beside the family file that replaces it
// in one atomic step at the end, so a run that fails at any point leaves the
// family file byte for byte as it was. The run never shows anything: it
// returns the user's message, and the caller shows it (and, for a failed run,
// ends the program as it always has).
//
// Where new records go: each after the record numbered one less (OBJE after
// the last multimedia record, NOTE after the note maxnoteid, SOUR after the
// source sourceid - 1), the first of its kind before the first record of the
// kinds that follow it. A record whose anchor never comes is written before
// "0 TRLR" rather than lost. The end of the file stands in for a missing
// "0 TRLR": the census block and change stamp of an individual whose record
// ends the file, and any new record still due, are written there. An
// individual of the entry whose record is not in the file, or a source to
// extend that is not there, refuses the run with the file untouched.
//
// Flags: an individual whose flags change keeps them under one "1 _FLGS"
// header, where its block stood, or just before "1 CHAN" when the block came
// after it (several blocks are joined into the first). The result counts the
// flag lines actually written and taken away, which the census log reports.

#include "model/gedcomindex.h"
#include "platform/encoding.h"
#include "platform/replacefile.h"
#include "settings/settings.h"
#include "writer/censusentry.h"

#include <QString>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace qm {

enum class rewritemode : int {
    censusentry = 1,  // save a census entry
    attachimages = 2, // link images to an existing census source
    censusdates = 3,  // census date check
    flagchanges = 4,  // flag check
};

// What one run is asked to do, beside the index and the settings.
struct rewriterequest {
    rewritemode mode = rewritemode::censusentry;
    // Mode 1: the whole entry. Mode 2: only sourceid (the source to extend),
    // title and chosenimages are read.
    censusentry entry;
    std::vector<datechange> datechanges; // mode 3
    std::vector<flagchange> flagchanges; // mode 4
};

// What a run did: the user's message when it failed, and what the census log
// and the caller's in-memory state need when it succeeded.
struct rewriteresult {
    bool ok = false;
    // The run was refused before anything was written (typed text the file's
    // encoding cannot hold, an input that cannot be opened ...). The family
    // file is untouched; `message` says why.
    bool refused = false;
    // The last check before the replace said no: nothing was written.
    bool withdrawn = false;
    // The new content was copied into the existing file (linked, or owned by
    // someone the new file could not be given to); damaged: that copy failed
    // part way, so only the backup holds the file now.
    bool inplace = false;
    bool damaged = false;
    QString error;   // what failed, as the system describes it
    QString message; // the whole message for the user when !ok

    std::optional<size_t> entryflag; // mode 1: the flag given (position in the index's flag table)
    int32_t flaggiven = 0;           // mode 1: individuals given the entry flag (its count rises by this)
    int32_t flagchangesmade = 0;     // mode 4: flag lines written and taken away
    int32_t occdateschanged = 0;     // mode 3: OCCU dates replaced
    int32_t censusdateschanged = 0;  // mode 3: CENS dates replaced
    int32_t maxnoteid = 0;           // the index's value, raised to the new note's number
    int32_t maxobjectid = 0;         // the index's value, or the number of the last OBJE record written
    int32_t censusblocks = 0;        // mode 1: individuals whose census block was written
    int32_t linksadded = 0;          // mode 2: image links written into the source
    int64_t lines = 0;               // lines written
    uint64_t writtenhash = 0;        // the hash of the family file as written (platform/contenthash.h)
};

// Runs the rewrite from inputpath to outputpath (they may be the same path).
// The file's encoding and byte-order mark are those found when the input is
// read; the index supplies the people, flags, maxnoteid and maxobjectid.
// `beforereplace` is asked once the new content is on the disk, just before
// the family file is touched; when it says no, the run is withdrawn.
rewriteresult rewritefile(const QString& inputpath, const QString& outputpath, const gedcomindex& index,
                          const settings& s, const rewriterequest& request,
                          const replacefile::lastcheck& beforereplace = {});

// The same run over bytes held in memory (tests, fuzzing); output gets the
// bytes that would have been written.
rewriteresult rewritebytes(std::string_view input, std::string& output, const gedcomindex& index,
                           const settings& s, const rewriterequest& request);

// "An error occurred (" + description + ")...: ... program will close when you press OK".
QString rewritefailuremessage(rewritemode mode, const QString& description);

// Checks, before anything is written, that every text the request will put
// into the file can be held by the file's encoding. Returns "" when it can,
// otherwise the message for the user naming the first character that cannot.
QString checkencodable(const rewriterequest& request, const settings& s, textencoding enc);

// The number of the shared note a mode 1 run would create (maxnoteid + 1, or 1).
int32_t newnotenumber(int32_t maxnoteid);

// Today's date and the time now as written into change stamps and citation
// dates ("04 DEC 2026", "13:05:09"), English month abbreviations whatever the
// locale, from the program's clock.
std::string gedcomtoday();
std::string gedcomtimenow();

} // namespace qm

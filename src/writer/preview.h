#pragma once
// What a change would write, shown before it is made. The rewrite runs over
// the family file's bytes into memory: the very run the save makes (the same
// checks, the same rewritefile steps), writing into a buffer instead of the
// file, so that what is shown is what will be written. The new content is then
// compared with the file record by record (records start at level-0 lines;
// a change adds records and changes lines within them, never moves them), and
// the changed records are compared line by line.
//
// Nothing is written, locked or logged. Change stamps ("1 CHAN" ... "3 TIME")
// carry the moment of the preview; the save writes the moment of the save.
// The preview holds the new content whole: memory for the size of the file.

#include "writer/rewritefile.h"

#include <QString>

#include <cstdint>
#include <string>
#include <vector>

namespace qm {

enum class difftag { same, removed, added };

struct diffline {
    difftag tag = difftag::same;
    QString text; // the line without its line end, decoded from the file's encoding
};

// One record the change touches.
struct previewrecord {
    QString header;       // its level-0 line ("0 @I12@ INDI")
    bool added = false;   // the change adds it whole
    int64_t oldline = 0;  // its first line's number in the file as it is (0 when added)
    int64_t newline = 0;  // and in the file as the change writes it
    std::vector<diffline> lines; // the whole record, old and new merged as a line diff
};

// Lines between the records above, the same in both files: how many, and
// those near the records, for context.
struct previewgap {
    int64_t count = 0;
    std::vector<QString> head; // the first of them (all of them when they are few)
    std::vector<QString> tail; // the last of them, when there are more than head holds
};

struct savepreview {
    bool ok = false;
    bool changed = false; // another program changed the file since it was loaded: reload it
    QString message;      // for the user unless ok

    QString gedcomfile;
    std::vector<previewrecord> records; // in file order
    std::vector<previewgap> gaps;       // before each record, and after the last: records.size() + 1
    // The file has line ends other than CR LF (or a last line without one):
    // the change writes every line end as CR LF, so those lines change in
    // their ends too, which the lines above do not show.
    bool lineends = false;
    std::string newcontent; // the bytes the change would write
    rewriteresult rewrite;
};

// Lines of context a gap keeps on each side.
inline constexpr int previewcontext = 3;

savepreview previewchange(const gedcomindex& index, const settings& s, const rewriterequest& request);
// A census entry: mode 1 of the above.
savepreview previewentry(const gedcomindex& index, const settings& s, const censusentry& entry);

// The preview as a unified diff ("--- a/family.ged", "+++ b/family.ged",
// hunks with three lines of context, each headed by the record it changes),
// lines separated by "\n". Empty when nothing would change.
QString unifieddiff(const savepreview& preview);

} // namespace qm

#pragma once
// The new level-0 records a census write adds to the family file (multimedia
// records of new images, the source record of a full entry, the shared census
// note) and the small line formats they share with the rewrite. Each writer
// only appends lines; the rewrite decides where the records go.

#include "settings/settings.h"
#include "writer/censusentry.h"
#include "writer/linewriter.h"

#include <QString>

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace qm {

// A typed one-line value as written after a tag: trimmed, UTF-8, any line
// break inside it turned into a space, so that it stays one line of the file,
// and escaped by typedvalue().
std::string oneline(const QString& text);

// A typed value as GEDCOM writes it: a leading "@" doubled, so that no typed
// text can be read as a pointer to a record ("@N1@").
std::string typedvalue(std::string value);

// A multi-line text: the first line after `first`, every later one after
// `cont`. CR LF, LF and CR each end a line; a text ending in a line break
// gives no empty last line. Text is written as typed, without trimming, but
// a line that begins with "@" gets it doubled (typedvalue).
void writemultiline(linewriter& out, std::string_view text, std::string_view first, std::string_view cont);

// The pointer to a chosen image's multimedia record: "@O7@", or the
// identifier of an existing record as its file writes it ("@O0007@").
std::string objectpointer(const imagechoice& image);

// "1 CHAN", "2 DATE " + today, "3 TIME " + now.
void writechangestamp(linewriter& out);

// One OBJE record for each new image, in list order. Returns the number of
// the last record written (maxobjectid when none was).
int32_t writeobjectrecords(linewriter& out, const std::vector<imagechoice>& images, const settings& s,
                           int32_t maxobjectid);

// A source's links to its images: "1 OBJE @O<n>@" for each, with "2 _ASID 1"
// under a new image when that setting is on.
void writeimagelinks(linewriter& out, const std::vector<imagechoice>& images, const settings& s);

// The SOUR record of a full census entry.
void writesourcerecord(linewriter& out, const censusentry& entry, const settings& s);

// The shared census NOTE record number `notenumber`.
void writenoterecord(linewriter& out, int32_t notenumber, const censusentry& entry);

// The four-digit year of a census date text ("30 MAR 1851" gives "1851");
// `fallback` when the text does not end in one.
std::string censusyear(const QString& entrydate, int fallback);

} // namespace qm

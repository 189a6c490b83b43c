#pragma once
// The logic behind Attach Images to Existing Sources: the census date of each
// source (worked out from the events that cite it), the list of sources the
// user picks from, what is shown of the source picked, and the index brought
// up to date after images were attached to it.

#include "model/gedcomindex.h"
#include "writer/censusentry.h"

#include <QString>
#include <QStringList>

#include <cstdint>
#include <string_view>
#include <vector>

namespace qm {

class linereader;

// Census dates of the sources, read from the family file in one pass: a
// source cited by events that all carry the same plain day-month-year date gets
// that date as its `censusdate`; one cited under differing dates, or under a
// date that is not a calendar date ("ABT 1881"), is marked `censusdatesought`.
// Birth events citing a census source, change stamps and citations that come
// before any date of their event are passed over. Sources already settled keep
// what they have. Returns "" or, when the file cannot be read, why not.
QString findcensusdates(gedcomindex& index);
// The same over a reader already open on the file's lines (tests).
void findcensusdates(gedcomindex& index, linereader& reader);

// Which sources the list offers.
enum class sourcefilter { all = 0, census = 1, text = 2 };

// Positions in `sources` of the sources listed, in file order. With `text`,
// those whose title holds the search text (trimmed, letter case ignored).
// With noimagesonly, only sources with no images linked.
std::vector<int32_t> filtersources(const gedcomindex& index, sourcefilter filter, const QString& searchtext,
                                   bool noimagesonly);

// "1 source", "0 sources", "12 sources".
QString sourcecounttext(size_t count);

// The census date shown for a source: its date, or "Unknown".
QString sourcedatetext(const sourcerec& source);

// Titles of the multimedia records linked to a source, in link order (a link
// to a record that is not in the file shows nothing).
QStringList attachedimagetitles(const gedcomindex& index, const sourcerec& source);

// Positions in `people` of the individuals citing the source with this record
// number, each once, in people order.
std::vector<int32_t> citingpeople(const gedcomindex& index, int32_t sourceid);

// Takes out of `chosen` the existing images already linked to the source (a
// second link would only show the image twice) and returns them.
std::vector<imagechoice> dropalreadylinked(const sourcerec& source, std::vector<imagechoice>& chosen);
// "The image ... is already attached to this source ..." for those images.
QString alreadylinkedmessage(const std::vector<imagechoice>& dropped);

// After images were attached to sources[sourcepos] and the file rewritten:
// the new multimedia records are added to `objects`, every image chosen is
// linked to the source, the highest object number is raised past the new
// records (so that a second attach numbers its images after them) and the
// file's new stamp is noted.
void recordattached(gedcomindex& index, int32_t sourcepos, const std::vector<imagechoice>& chosen,
                    const filestamp& newstamp);

// gedcomfile + " has been modified by another application. Images will not be
// attached ...": the refusal when the file was changed outside Quillmark.
QString attachchangedmessage(const QString& gedcomfile);

} // namespace qm

#pragma once
// What the rewrite checks before it writes anything, and the texts it uses
// for the user.

#include "writer/rewritefile.h"

namespace qm {

// The flag lines a run will write must fit the file's encoding too; "" when
// they do, else the message for the user.
QString checkflagnames(const gedcomindex& ix, const settings& s, const rewriterequest& rq, textencoding enc);

// The records a run cites must be told apart by their identifiers, and those
// it creates must get numbers no record has: "" when they do, else the
// message for the user (an individual or source whose number belongs to two
// records; no number left for a new source, note or multimedia record).
QString checkidentifiers(const gedcomindex& ix, const settings& s, const rewriterequest& rq);

} // namespace qm

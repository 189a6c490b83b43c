#pragma once
// What the rewrite checks before it writes anything, and the texts it uses
// for the user.

#include "writer/rewritefile.h"

namespace qm {

// The flag lines a run will write must fit the file's encoding too; "" when
// they do, else the message for the user.
QString checkflagnames(const gedcomindex& ix, const settings& s, const rewriterequest& rq, textencoding enc);

} // namespace qm

#include "images/imagesfrm.h"

#include "images/imagechoices.h"
#include "model/gedcomindex.h"

namespace qm {

imagesfrm::imagesfrm(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                     prompts& p, QWidget* parent)
    : QDialog(parent), request_(r), index_(index), settings_(s), store_(store), prompts_(p)
{
    setObjectName(QStringLiteral("imagesfrm"));
    setWindowTitle(QStringLiteral("Census Images"));
    nextobjectid_ = firstobjectbase(index);
}

imagesfrm::~imagesfrm() = default;

bool imagesfrm::choose(const imagerequest&, const gedcomindex&, const settings&, settingsstore&, prompts&,
                       std::vector<imagechoice>& chosen, QWidget*)
{
    chosen.clear();
    return true;
}

} // namespace qm

#include "app/mainfrm.h"

namespace qm {

// The Census Images dialog for the entry being saved.
bool mainfrm::chooseentryimages(std::vector<imagechoice>& chosen)
{
    chosen.clear();
    return true;
}

} // namespace qm

#include "app/mainfrm.h"

namespace qm {

// The Find dialog, from the Find button: the individual chosen, or -1.
int32_t mainfrm::runfind(int32_t)
{
    comingsoon();
    return -1;
}

} // namespace qm

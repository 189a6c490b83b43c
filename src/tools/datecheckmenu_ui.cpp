#include "app/mainfrm.h"

namespace qm {

// "Census Date Check...".
void mainfrm::censusdatecheck()
{
    comingsoon();
}

} // namespace qm

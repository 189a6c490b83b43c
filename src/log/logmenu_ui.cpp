#include "app/mainfrm.h"

namespace qm {

// "View Log..." and "Clear Log File".
void mainfrm::viewlog()
{
    comingsoon();
}

void mainfrm::clearlogfile()
{
    comingsoon();
}

} // namespace qm

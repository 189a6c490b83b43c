#include "app/mainfrm.h"

namespace qm {

// "Census Flags...".
void mainfrm::censusflags()
{
    comingsoon();
}

} // namespace qm

#include "app/mainfrm.h"

namespace qm {

// "Options...".
void mainfrm::showoptions()
{
    comingsoon();
}

void mainfrm::startoptions()
{
}

} // namespace qm

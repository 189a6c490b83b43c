#include "app/mainfrm.h"

namespace qm {

// "Attach Images to Existing Sources...".
void mainfrm::attachimages()
{
    comingsoon();
}

} // namespace qm

#include "app/mainfrm.h"

namespace qm {

// "Make a Donation..." and "About Quillmark...".
void mainfrm::donate()
{
    comingsoon();
}

void mainfrm::about()
{
    comingsoon();
}

// The donation reminder after the 10th, the 20th and every 50th saved entry.
void mainfrm::milestone()
{
}

} // namespace qm

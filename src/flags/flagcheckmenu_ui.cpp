#include "app/mainfrm.h"

namespace qm {

// The flag check run silently after each load when "Flag Check" is on.
void mainfrm::silentflagcheck()
{
}

} // namespace qm

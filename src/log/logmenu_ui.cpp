#include "app/mainfrm.h"

#include "log/clearlog.h"
#include "log/logfrm.h"

namespace qm {

// "View Log..." and "Clear Log File".
void mainfrm::viewlog()
{
    logfrm::view(file_.currentsettings().logpath, prompts_, this);
}

void mainfrm::clearlogfile()
{
    clearlog(prompts_, file_.currentsettings().logpath);
}

} // namespace qm

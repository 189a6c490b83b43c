#include "writer/saveprompts.h"

#include "platform/prompts.h"

namespace qm {

aftersave tellsaveoutcome(prompts& p, const saveoutcome& out)
{
    switch (out.status) {
    case savestatus::saved:
        if (!out.logerror.isEmpty())
            p.tell(out.logerror, icon::critical);
        if (!out.undoerror.isEmpty())
            p.tell(out.undoerror, icon::exclamation);
        return aftersave::saved;
    case savestatus::changed:
        return aftersave::changed;
    case savestatus::refused:
    case savestatus::backupfailed:
        p.tell(out.message, icon::exclamation);
        return aftersave::stay;
    case savestatus::rewritefailed:
        p.tell(out.message, icon::critical);
        return aftersave::fatal;
    }
    return aftersave::stay;
}

} // namespace qm

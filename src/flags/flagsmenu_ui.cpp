#include "flags/flagsmenu_ui.h"

#include "flags/flagcheck.h"
#include "flags/flagcheckfrm.h"
#include "flags/flagfrm.h"
#include "platform/prompts.h"

namespace qm {

toolend censusflags(openfile& file, prompts& p, QWidget* parent)
{
    if (!file.index())
        return toolend::unchanged;
    const pausewatch paused = file.pause();
    bool fatal = false;
    flagfrm* owner = nullptr;
    flagfrm d(
        *file.index(), file.currentsettings(), file.store(), p,
        [&] {
            const toolend end = flagcheckfrm::open(*file.index(), file.currentsettings(), file.store(), p, owner);
            fatal = end == toolend::fatal;
            return end != toolend::unchanged;
        },
        parent);
    owner = &d;
    d.exec();
    if (fatal)
        return toolend::fatal;
    return d.reloadneeded() ? toolend::reload : toolend::unchanged;
}

toolend silentflagcheck(openfile& file, prompts& p, QWidget* parent)
{
    if (!file.index() || file.index()->people.empty())
        return toolend::unchanged;
    bool outofstep = false;
    {
        busycursor busy(p);
        outofstep = flagsoutofstep(*file.index());
    }
    if (!outofstep)
        return toolend::unchanged;
    p.tell(flagsoutofsyncmessage());
    const pausewatch paused = file.pause();
    return flagcheckfrm::open(*file.index(), file.currentsettings(), file.store(), p, parent);
}

} // namespace qm

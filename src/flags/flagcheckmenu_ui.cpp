#include "app/mainfrm.h"
#include "flags/flagcheck.h"
#include "flags/flagcheckfrm.h"
#include "platform/prompts.h"

#include <QCoreApplication>
#include <QThread>
#include <QTimer>

namespace qm {

// The flag check run silently after each load when "Flag Check" is on: when
// the flags are out of step the Flag Check dialog opens, and the file is read
// again when it was rewritten (or changed outside the program).
void mainfrm::silentflagcheck()
{
    if (!file_.index() || file_.index()->people.empty())
        return;
    bool outofstep = false;
    {
        busycursor busy(prompts_);
        outofstep = flagsoutofstep(*file_.index());
    }
    if (!outofstep)
        return;
    prompts_.tell(flagsoutofsyncmessage());
    const pausewatch paused = file_.pause();
    const flagcheckend end = flagcheckfrm::open(*file_.index(), file_.currentsettings(), file_.store(), prompts_, this);
    if (end == flagcheckend::fatal) {
        endprogram();
        // At start the event loop is not running yet: leave it as soon as it does.
        if (QThread::currentThread()->loopLevel() == 0)
            QTimer::singleShot(0, qApp, [] { QCoreApplication::exit(1); });
        return;
    }
    if (end == flagcheckend::reload)
        file_.reload();
}

} // namespace qm

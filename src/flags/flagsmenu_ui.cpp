#include "app/mainfrm.h"

#include "flags/flagcheckfrm.h"
#include "flags/flagfrm.h"

namespace qm {

// "Census Flags...": the flag definitions are stored when the dialog closes;
// the file is read again when its Flag Check rewrote it, and the program ends
// when that rewrite failed.
void mainfrm::censusflags()
{
    if (!file_.index())
        return;
    bool fatal = false;
    runtool([this, &fatal] {
        flagfrm* owner = nullptr;
        flagfrm d(
            *file_.index(), file_.currentsettings(), file_.store(), prompts_,
            [this, &fatal, &owner] {
                const flagcheckend end = flagcheckfrm::open(*file_.index(), file_.currentsettings(), file_.store(), prompts_, owner);
                fatal = end == flagcheckend::fatal;
                return end != flagcheckend::unchanged;
            },
            this);
        owner = &d;
        d.exec();
        if (d.reloadneeded() && !fatal)
            reloadneeded_ = true;
    });
    if (fatal)
        endprogram();
}

} // namespace qm

#include "app/mainfrm.h"
#include "tools/datecheckfrm.h"

namespace qm {

// "Census Date Check...": the dialog runs with the watch for outside changes
// off; the file is read again when it was rewritten (or found changed), and a
// failed rewrite ends the program.
void mainfrm::censusdatecheck()
{
    if (!file_.index())
        return;
    bool fatal = false;
    runtool([this, &fatal] {
        Datecheckfrm dialog(prompts_, *file_.index(), file_.currentsettings(), this);
        dialog.exec();
        fatal = dialog.fatal();
        reloadneeded_ = dialog.reloadneeded() && !fatal;
    });
    if (fatal)
        endprogram();
}

} // namespace qm

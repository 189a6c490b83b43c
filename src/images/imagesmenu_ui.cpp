#include "app/mainfrm.h"

#include "census/entrypanel_ui.h"
#include "images/imagesfrm.h"

#include <QComboBox>
#include <QLineEdit>

namespace qm {

// Save step: the Census Images dialog for the entry being saved. The titles it
// offers are built from the source the entry makes or cites and from its
// reference.
bool mainfrm::chooseentryimages(std::vector<imagechoice>& chosen)
{
    chosen.clear();
    if (!file_.index())
        return true;
    const entrypanel* p = panel();
    imagerequest r;
    r.context = 1;
    r.fullentry = sourcemode_ == 0;
    r.imagedate = p->fixeddatetxt->text();
    if (r.fullentry) {
        r.sourcetitle = p->titletxt->text();
        r.sourcebase = p->titletxt->text().trimmed();
        r.referencebase = p->referencetxt->text().trimmed();
    } else {
        const QString where = p->wherewithinsourcetxt->text().trimmed();
        r.sourcetitle = p->sourcecom->currentText();
        r.sourcebase = p->sourcecom->currentText().trimmed() + QStringLiteral(" (") + where + QStringLiteral(")");
        r.referencebase = where;
    }
    return imagesfrm::choose(r, *file_.index(), file_.currentsettings(), file_.store(), prompts_, chosen, this);
}

} // namespace qm

#include "app/mainfrm.h"

#include "census/householdpanel_ui.h"
#include "census/peoplelist_ui.h"
#include "model/loadgedcom.h"
#include "platform/prompts.h"
#include "tools/findfrm.h"
#include "tools/findindividual.h"

namespace qm {

// The Find dialog, from the Find button: the individual chosen, or -1. Sets
// refocus when the immediate family is to be rebuilt around it.
int32_t mainfrm::runfind(int32_t start, bool& refocus)
{
    if (!file_.index())
        return -1;
    std::vector<listentry> entries;
    {
        busycursor busy(prompts_);
        std::vector<listentry> mainlist;
        // Above 32,000 individuals the dialog offers what the people list holds.
        if (!peoplelistshown(*file_.index())) {
            const peoplelistmodel* people = household_->panel()->people;
            mainlist.reserve(static_cast<size_t>(people->rowCount()));
            for (int r = 0; r < people->rowCount(); ++r)
                mainlist.push_back({people->textat(r), people->personat(r)});
        }
        entries = findlist(*file_.index(), file_.currentsettings().idonly, std::move(mainlist));
    }
    findfrm dialog(*file_.index(), std::move(entries), start, prompts_, this);
    if (dialog.exec() != QDialog::Accepted)
        return -1;
    refocus = dialog.refocus();
    return dialog.result();
}

} // namespace qm

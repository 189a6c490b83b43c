#include "tools/toolsmenu_ui.h"

#include "census/peoplelist_ui.h"
#include "model/loadgedcom.h"
#include "platform/prompts.h"
#include "tools/datecheckfrm.h"
#include "tools/findfrm.h"
#include "tools/findindividual.h"

namespace qm {

toolend censusdatecheck(openfile& file, prompts& p, QWidget* parent)
{
    if (!file.index())
        return toolend::unchanged;
    const pausewatch paused = file.pause();
    Datecheckfrm dialog(p, *file.index(), file.currentsettings(), parent);
    dialog.exec();
    if (dialog.fatal())
        return toolend::fatal;
    return dialog.reloadneeded() ? toolend::reload : toolend::unchanged;
}

findchoice findindividual(const openfile& file, const peoplelistmodel& people, int32_t start, prompts& p,
                          QWidget* parent)
{
    if (!file.index())
        return {};
    std::vector<listentry> entries;
    {
        busycursor busy(p);
        std::vector<listentry> mainlist;
        // Above 32,000 individuals the dialog offers what the people list holds.
        if (!peoplelistshown(*file.index())) {
            mainlist.reserve(static_cast<size_t>(people.rowCount()));
            for (int r = 0; r < people.rowCount(); ++r)
                mainlist.push_back({people.textat(r), people.personat(r)});
        }
        entries = findlist(*file.index(), file.currentsettings().idonly, std::move(mainlist));
    }
    findfrm dialog(*file.index(), std::move(entries), start, p, parent);
    if (dialog.exec() != QDialog::Accepted)
        return {};
    return {dialog.result(), dialog.refocus()};
}

} // namespace qm

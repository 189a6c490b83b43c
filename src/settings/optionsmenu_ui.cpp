#include "settings/optionsmenu_ui.h"

#include "platform/prompts.h"
#include "settings/optionsfrm.h"
#include "writer/backups.h"
#include "writer/openfile.h"

namespace qm {

optionsend showoptions(openfile& file, prompts& p, const std::function<void()>& donate, QWidget* parent)
{
    optionsfrm f(p, file.store(), file.currentsettings(), donate, parent);
    if (f.exec() != QDialog::Accepted)
        return {};
    file.usesettings(f.saved());
    return {true, f.reloadneeded()};
}

bool startoptions(openfile& file, prompts& p, const std::function<void()>& donate, QWidget* parent)
{
    if (!file.currentsettings().firststart && checkpaths(p, file.currentsettings()))
        file.currentsettings().firststart = true;
    if (!file.currentsettings().firststart)
        return false;
    return showoptions(file, p, donate, parent).saved;
}

} // namespace qm

#include "app/mainfrm.h"

#include "census/entrypanel_ui.h"
#include "platform/prompts.h"
#include "settings/optionsfrm.h"
#include "writer/backups.h"

#include <QLineEdit>

namespace qm {

// "Options...": after Save the new settings take effect; a change of the
// recording method, the country or "ID Only" clears the entry and reads the
// file again.
void mainfrm::showoptions()
{
    runtool([this] {
        optionsfrm f(prompts_, store_, settings_, [this] { donate(); }, this);
        if (f.exec() != QDialog::Accepted)
            return;
        settings_ = f.saved();
        if (f.reloadneeded()) {
            clearentry();
            settitleandpanel();
            reloadneeded_ = true;
        } else {
            viewlogmen_->setEnabled(settings_.keeplog);
            attachbut_->setEnabled(settings_.fullentry);
        }
        if (settings_.fullentry && !panel_[0]->titletxt->text().isEmpty())
            refreshtitle();
    });
}

// At start, once the settings are read: incomplete settings, or paths that
// fail their checks, are put right in the options dialog before the file is
// loaded. It cannot be cancelled while the settings are incomplete.
void mainfrm::startoptions()
{
    if (!settings_.firststart && checkpaths(prompts_, settings_))
        settings_.firststart = true;
    if (!settings_.firststart)
        return;
    optionsfrm f(prompts_, store_, settings_, [this] { donate(); }, this);
    if (f.exec() != QDialog::Accepted)
        return;
    settings_ = f.saved();
    settitleandpanel();
}

} // namespace qm

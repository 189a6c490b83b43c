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
        optionsfrm f(prompts_, file_.store(), file_.currentsettings(), [this] { donate(); }, this);
        if (f.exec() != QDialog::Accepted)
            return;
        file_.usesettings(f.saved());
        if (f.reloadneeded()) {
            clearentry();
            settitleandpanel(file_.path());
            reloadneeded_ = true;
        } else {
            viewlogmen_->setEnabled(file_.currentsettings().keeplog);
            attachbut_->setEnabled(file_.currentsettings().fullentry);
        }
        if (file_.currentsettings().fullentry && !panel()->titletxt->text().isEmpty())
            form_->refreshtitle();
    });
}

// At start, once the settings are read: incomplete settings, or paths that
// fail their checks, are put right in the options dialog before the file is
// loaded. It cannot be cancelled while the settings are incomplete.
void mainfrm::startoptions(const QString& path)
{
    if (!file_.currentsettings().firststart && checkpaths(prompts_, file_.currentsettings()))
        file_.currentsettings().firststart = true;
    if (!file_.currentsettings().firststart)
        return;
    optionsfrm f(prompts_, file_.store(), file_.currentsettings(), [this] { donate(); }, this);
    if (f.exec() != QDialog::Accepted)
        return;
    file_.usesettings(f.saved());
    settitleandpanel(path);
}

} // namespace qm

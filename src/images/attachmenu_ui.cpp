#include "app/mainfrm.h"
#include "images/attachimagesfrm.h"
#include "images/imagesfrm.h"

namespace qm {

// "Attach Images to Existing Sources...": the index is brought up to date
// after each attach; the file is read again once the dialog closes.
void mainfrm::attachimages()
{
    // Nothing to attach to while no family file could be read.
    if (!file_.index() || file_.index()->gedcomfile.isEmpty())
        return;
    bool fatal = false;
    runtool([this, &fatal] {
        const auto chooser = [this](const QString& title, const QString& date, QWidget* parent) {
            imagerequest r;
            r.context = 2;
            r.sourcetitle = title;
            r.imagedate = date;
            r.sourcebase = title.trimmed();
            r.fullentry = file_.currentsettings().fullentry;
            std::vector<imagechoice> chosen;
            imagesfrm::choose(r, *file_.index(), file_.currentsettings(), file_.store(), prompts_, chosen, parent);
            return chosen;
        };
        Attachimagesfrm d(*file_.index(), file_.currentsettings(), prompts_, chooser, this);
        d.exec();
        fatal = d.fatal();
        // Images attached, or the file changed outside: read it again.
        reloadneeded_ = !fatal && (d.imagesattached() || d.filechanged());
    });
    if (fatal)
        endprogram();
}

} // namespace qm

#include "images/imagesmenu_ui.h"

#include "images/attachimagesfrm.h"
#include "images/imagesfrm.h"

namespace qm {

toolend attachimages(openfile& file, prompts& p, QWidget* parent)
{
    // Nothing to attach to while no family file could be read.
    if (!file.index() || file.index()->gedcomfile.isEmpty())
        return toolend::unchanged;
    const pausewatch paused = file.pause();
    const auto chooser = [&file, &p](const QString& title, const QString& date, QWidget* owner) {
        imagerequest r;
        r.context = 2;
        r.sourcetitle = title;
        r.imagedate = date;
        r.sourcebase = title.trimmed();
        r.fullentry = file.currentsettings().fullentry;
        std::vector<imagechoice> chosen;
        imagesfrm::choose(r, *file.index(), file.currentsettings(), file.store(), p, chosen, owner);
        return chosen;
    };
    Attachimagesfrm d(*file.index(), file.currentsettings(), p, chooser, parent);
    d.exec();
    if (d.fatal())
        return toolend::fatal;
    return d.imagesattached() || d.filechanged() ? toolend::reload : toolend::unchanged;
}

bool chooseentryimages(const entrysource& e, openfile& file, prompts& p, QWidget* parent,
                       std::vector<imagechoice>& chosen)
{
    chosen.clear();
    if (!file.index())
        return true;
    imagerequest r;
    r.context = 1;
    r.fullentry = e.fullentry;
    r.imagedate = e.date;
    if (r.fullentry) {
        r.sourcetitle = e.title;
        r.sourcebase = e.title.trimmed();
        r.referencebase = e.reference.trimmed();
    } else {
        const QString where = e.where.trimmed();
        r.sourcetitle = e.sourcetitle;
        r.sourcebase = e.sourcetitle.trimmed() + QStringLiteral(" (") + where + QStringLiteral(")");
        r.referencebase = where;
    }
    return imagesfrm::choose(r, *file.index(), file.currentsettings(), file.store(), p, chosen, parent);
}

} // namespace qm

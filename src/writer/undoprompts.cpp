#include "writer/undoprompts.h"

#include "platform/filetime.h"
#include "platform/prompts.h"
#include "settings/settings.h"
#include "writer/undolast.h"

#include <QDir>

namespace qm {

bool askundolast(const QString& familyfile, const settings& s, prompts& p)
{
    const lastchange c = readlastchange(familyfile, s.backupfolder);
    // Asked only when the undo can go ahead as things stand; otherwise the
    // undo refuses at once with its reason.
    const bool possible = c.known && c.problem.isEmpty() && c.undone.isEmpty() && stampof(familyfile) == c.after;
    if (possible && !p.yes(undoquestion(c), icon::question, answer::no, QStringLiteral("Undo Last Census Entry")))
        return false;
    undooutcome u;
    {
        busycursor busy(p);
        u = undolast(familyfile, s);
    }
    if (!u.undone()) {
        p.tell(u.message, u.status == undostatus::refused ? icon::exclamation : icon::critical);
        return u.status == undostatus::failed;
    }
    QString done = QStringLiteral("Undone: %1.\n\nThe file as it was before the undo is in the backup %2.")
                       .arg(u.summary, QDir::toNativeSeparators(u.backuppath));
    p.tell(done, icon::information, QStringLiteral("Undo Last Census Entry"));
    for (const QString& warning : {u.logerror, u.noteerror})
        if (!warning.isEmpty())
            p.tell(warning, icon::exclamation);
    return true;
}

toolend askundolast(openfile& file, prompts& p)
{
    const pausewatch paused = file.pause();
    return askundolast(file.path(), file.currentsettings(), p) ? toolend::reload : toolend::unchanged;
}

} // namespace qm

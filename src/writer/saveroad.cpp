#include "writer/saveroad.h"

#include "log/censuslog.h"
#include "model/filechanged.h"
#include "model/gedcomindex.h"
#include "platform/familylock.h"
#include "platform/replacefile.h"
#include "settings/settings.h"
#include "writer/rewritechecks.h"
#include "writer/undolast.h"

#include <QDir>
#include <QFile>

namespace qm {

namespace {

bool& inputfault()
{
    static bool on = false;
    return on;
}

std::function<void(savestep)>& savehook()
{
    static std::function<void(savestep)> hook;
    return hook;
}

void reached(savestep step)
{
    if (savehook())
        savehook()(step);
}

bool anyimages(const rewriterequest& rq)
{
    return (rq.mode == rewritemode::censusentry || rq.mode == rewritemode::attachimages)
        && !rq.entry.chosenimages.empty();
}

logentry logfor(const gedcomindex& index, const rewriterequest& rq, const rewriteresult& r)
{
    logentry e;
    e.mode = static_cast<int>(rq.mode);
    e.gedcomfile = index.gedcomfile;
    e.sourceid = rq.entry.sourceid;
    e.title = rq.entry.title;
    e.reference = rq.entry.reference;
    switch (rq.mode) {
    case rewritemode::censusentry:
        e.selection = rq.entry.selection;
        if (r.entryflag && *r.entryflag < index.flags.size())
            e.flagname = qs(index.flags[*r.entryflag].name);
        e.chosenimages = rq.entry.chosenimages;
        break;
    case rewritemode::attachimages:
        e.chosenimages = rq.entry.chosenimages;
        break;
    case rewritemode::censusdates:
        e.datechanges = rq.datechanges;
        e.occdateschanged = r.occdateschanged;
        break;
    case rewritemode::flagchanges:
        e.flagchangecount = r.flagchangesmade;
        break;
    }
    return e;
}

} // namespace

void setinputfaultfortests(bool on)
{
    inputfault() = on;
}

void setsavehookfortests(std::function<void(savestep)> hook)
{
    savehook() = std::move(hook);
}

saveoutcome savechange(const gedcomindex& index, const settings& s, const rewriterequest& request,
                       const backupresult* made)
{
    saveoutcome out;
    const QString& family = index.gedcomfile;
    // A backup made ahead is of no use when nothing is written.
    const auto dropmade = [made] {
        if (made && made->ok())
            QFile::remove(made->path);
    };
    const auto changed = [&] {
        out.status = savestatus::changed;
        out.message = changedonsavemessage(family, anyimages(request));
        return out;
    };

    out.message = checkencodable(request, s, index.encoding);
    if (out.message.isEmpty())
        out.message = checkidentifiers(index, s, request);
    if (out.message.isEmpty() && s.keeplog) {
        out.message = refuselogpath(s.logpath, family, s.backupfolder);
        if (!out.message.isEmpty())
            out.message += QStringLiteral(" Nothing has been changed.");
    }
    familylock lock(family);
    if (out.message.isEmpty())
        out.message = lock.acquire();
    if (!out.message.isEmpty()) {
        dropmade();
        out.status = savestatus::refused;
        return out;
    }
    reached(savestep::locked);
    if (filechanged(index)) {
        dropmade();
        return changed();
    }

    backupresult backup;
    const filestamp madestamp = made && made->ok() ? stampof(made->path) : filestamp();
    if (madestamp.exists && madestamp.modified == index.gedcomdate.modified && madestamp.size == index.gedcomdate.size) {
        backup = *made;
    } else {
        dropmade();
        backup = makebackup(family, s.backupfolder);
    }
    if (!backup.ok()) {
        out.status = savestatus::backupfailed;
        out.message = backup.error;
        return out;
    }
    reached(savestep::backedup);
    // A change that slipped in while the copy was made would be lost with the
    // rewrite: look once more now that the backup holds what is rewritten.
    if (filechanged(index)) {
        QFile::remove(backup.path);
        return changed();
    }
    out.backuppath = backup.path;

    // The last look, when the new content is on the disk: the rewrite read the
    // backup, so a change made meanwhile would be lost by the replace. A file
    // that is written in place needs its backup on the disk first.
    QString backupunsynced;
    const auto beforereplace = [&](bool inplace) {
        reached(savestep::written);
        if (filechanged(index))
            return false;
        if (inplace)
            backupunsynced = syncexisting(backup.path);
        return backupunsynced.isEmpty();
    };
    const QString input = inputfault() ? backup.path + QStringLiteral(".unreadable/") : backup.path;
    out.rewrite = rewritefile(input, family, index, s, request, beforereplace);
    if (out.rewrite.withdrawn) {
        QFile::remove(backup.path);
        out.backuppath.clear();
        if (backupunsynced.isEmpty())
            return changed();
        out.status = savestatus::backupfailed;
        out.message = backupfailedmessage() + QStringLiteral(" (") + backupunsynced + QStringLiteral(")");
        return out;
    }
    if (!out.rewrite.ok) {
        out.status = out.rewrite.refused ? savestatus::refused : savestatus::rewritefailed;
        out.message = out.rewrite.message;
        // A copy in place that failed part way is undone from the backup.
        if (out.rewrite.damaged) {
            const QString notrestored = copyintofile(backup.path, family);
            if (!notrestored.isEmpty())
                out.message += QStringLiteral(" The family file could not be put back as it was (") + notrestored
                    + QStringLiteral("): the backup ") + QDir::toNativeSeparators(backup.path)
                    + QStringLiteral(" holds it.");
        }
        return out;
    }

    out.status = savestatus::saved;
    out.newstamp = stampof(family);
    out.undoerror = notelastchange(index, s, request, out);
    if (s.keeplog) {
        out.logerror = writelogentry(s, logfor(index, request, out.rewrite));
        out.logwritten = out.logerror.isEmpty();
    }
    return out;
}

saveoutcome saveentry(const gedcomindex& index, const settings& s, const censusentry& entry, const backupresult* made)
{
    rewriterequest rq;
    rq.mode = rewritemode::censusentry;
    rq.entry = entry;
    return savechange(index, s, rq, made);
}

} // namespace qm

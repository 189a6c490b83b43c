#include "writer/saveroad.h"

#include "log/censuslog.h"
#include "model/filechanged.h"
#include "model/gedcomindex.h"
#include "settings/settings.h"

#include <QFile>

namespace qm {

namespace {

bool& inputfault()
{
    static bool on = false;
    return on;
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

    out.message = checkencodable(request, s, index.encoding);
    if (!out.message.isEmpty()) {
        dropmade();
        out.status = savestatus::refused;
        return out;
    }
    if (filechanged(index)) {
        dropmade();
        out.status = savestatus::changed;
        out.message = changedonsavemessage(family, anyimages(request));
        return out;
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
    // A change that slipped in while the copy was made would be lost with the
    // rewrite: look once more now that the backup holds what is rewritten.
    if (filechanged(index)) {
        QFile::remove(backup.path);
        out.status = savestatus::changed;
        out.message = changedonsavemessage(family, anyimages(request));
        return out;
    }
    out.backuppath = backup.path;

    const QString input = inputfault() ? backup.path + QStringLiteral(".unreadable/") : backup.path;
    out.rewrite = rewritefile(input, family, index, s, request);
    if (!out.rewrite.ok) {
        out.status = out.rewrite.refused ? savestatus::refused : savestatus::rewritefailed;
        out.message = out.rewrite.message;
        return out;
    }

    out.status = savestatus::saved;
    out.newstamp = stampof(family);
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

#include "writer/undolast.h"

#include "log/censuslog.h"
#include "model/gedcomindex.h"
#include "platform/contenthash.h"
#include "platform/familylock.h"
#include "platform/paths.h"
#include "platform/replacefile.h"
#include "settings/settings.h"
#include "writer/backups.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QJsonDocument>
#include <QJsonObject>
#include <QSaveFile>

#include <vector>

namespace qm {

namespace {

QString native(const QString& path)
{
    return QDir::toNativeSeparators(path);
}

QString notepath(const QString& familyfile, const QString& backupfolder)
{
    // Every name of the file (through symbolic links) shares one note.
    QString key = canonicalpath(familyfile);
#ifdef Q_OS_WIN
    key = key.toLower(); // one file whatever the letter case it is named in
#endif
    contenthash h;
    h.add(key.toStdString());
    return QDir(backupfolder.trimmed()).filePath(QStringLiteral("QM Undo ") + hashtext(h.value()) + QStringLiteral(".json"));
}

QJsonObject stampjson(const filestamp& s)
{
    return {{QStringLiteral("modified"), static_cast<double>(s.modified)},
            {QStringLiteral("size"), static_cast<double>(s.size)}};
}

filestamp stampfrom(const QJsonValue& v)
{
    filestamp s;
    const QJsonObject o = v.toObject();
    s.exists = o.value(QStringLiteral("size")).isDouble() && o.value(QStringLiteral("modified")).isDouble();
    s.modified = static_cast<int64_t>(o.value(QStringLiteral("modified")).toDouble());
    s.size = static_cast<int64_t>(o.value(QStringLiteral("size")).toDouble());
    return s;
}

// Writes the note, replacing the old one in one step. "" or the system's reason.
QString writenote(const lastchange& c)
{
    const QJsonObject o{
        {QStringLiteral("file"), c.gedcomfile},
        {QStringLiteral("mode"), c.mode},
        {QStringLiteral("summary"), c.summary},
        {QStringLiteral("made"), c.made},
        {QStringLiteral("backup"), c.backuppath},
        {QStringLiteral("backupstamp"), stampjson(c.backupstamp)},
        {QStringLiteral("after"), stampjson(c.after)},
        {QStringLiteral("hash"), hashtext(c.hash)},
        {QStringLiteral("undone"), c.undone},
        {QStringLiteral("undobackup"), c.undobackup},
    };
    QSaveFile f(c.notepath);
    if (!f.open(QIODevice::WriteOnly) || f.write(QJsonDocument(o).toJson()) < 0 || !f.commit())
        return f.errorString().isEmpty() ? QStringLiteral("unknown error") : f.errorString();
    return QString();
}

// Why the note cannot be used, or "": it must be this file's, and its backup
// a backup of the backup folder (a note edited by hand must not make the undo
// copy some other file over the family file).
QString checknote(const lastchange& c, const QString& familyfile, const QString& backupfolder)
{
    if (!samefilepath(c.gedcomfile, canonicalpath(familyfile)))
        return QStringLiteral("it is the note of another file, %1").arg(native(c.gedcomfile));
    const QFileInfo backup(c.backuppath);
    if (c.mode < 1 || c.mode > 4 || !c.after.exists || !c.backupstamp.exists || !isbackupname(backup.fileName())
        || !samefilepath(canonicalpath(backup.absolutePath()), canonicalpath(backupfolder.trimmed())))
        return QStringLiteral("it does not hold what an undo needs");
    return QString();
}

undooutcome refused(const QString& message, undostatus status = undostatus::refused)
{
    undooutcome u;
    u.status = status;
    u.message = message;
    return u;
}

} // namespace

lastchange readlastchange(const QString& familyfile, const QString& backupfolder)
{
    lastchange c;
    c.notepath = notepath(familyfile, backupfolder);
    QFile f(c.notepath);
    if (!f.exists())
        return c;
    c.known = true;
    QJsonParseError error;
    const QJsonDocument doc = f.open(QIODevice::ReadOnly) ? QJsonDocument::fromJson(f.readAll(), &error) : QJsonDocument();
    if (!doc.isObject()) {
        c.known = false;
        c.problem = f.error() != QFileDevice::NoError ? f.errorString() : QStringLiteral("it is not a note Quillmark wrote");
        return c;
    }
    const QJsonObject o = doc.object();
    c.gedcomfile = o.value(QStringLiteral("file")).toString();
    c.mode = o.value(QStringLiteral("mode")).toInt();
    c.summary = o.value(QStringLiteral("summary")).toString();
    c.made = o.value(QStringLiteral("made")).toString();
    c.backuppath = o.value(QStringLiteral("backup")).toString();
    c.backupstamp = stampfrom(o.value(QStringLiteral("backupstamp")));
    c.after = stampfrom(o.value(QStringLiteral("after")));
    bool ok = false;
    c.hash = o.value(QStringLiteral("hash")).toString().toULongLong(&ok, 16);
    c.undone = o.value(QStringLiteral("undone")).toString();
    c.undobackup = o.value(QStringLiteral("undobackup")).toString();
    c.problem = ok ? checknote(c, familyfile, backupfolder) : QStringLiteral("it does not hold what an undo needs");
    if (!c.problem.isEmpty())
        c.known = false;
    return c;
}

QString changesummary(const rewriterequest& rq, const rewriteresult& r)
{
    const QString source = rq.entry.title.trimmed() + QStringLiteral(" (ID: ") + rq.entry.sourceid.trimmed() + u')';
    switch (rq.mode) {
    case rewritemode::censusentry: {
        const auto n = static_cast<int>(rq.entry.selection.size());
        return QStringLiteral("Census entry added: %1, %2 %3")
            .arg(source)
            .arg(n)
            .arg(n == 1 ? QStringLiteral("individual") : QStringLiteral("individuals"));
    }
    case rewritemode::attachimages:
        return QStringLiteral("Image(s) attached: ") + source;
    case rewritemode::censusdates:
        return QStringLiteral("Census dates changed: %1 census event dates and %2 occupation dates")
            .arg(r.censusdateschanged)
            .arg(r.occdateschanged);
    case rewritemode::flagchanges:
        return QStringLiteral("Flag Check changes made: %1 changes").arg(r.flagchangesmade);
    }
    return QString();
}

QString notelastchange(const gedcomindex& index, const settings& s, const rewriterequest& request,
                       const saveoutcome& out)
{
    lastchange c;
    c.notepath = notepath(index.gedcomfile, s.backupfolder);
    c.gedcomfile = canonicalpath(index.gedcomfile);
    c.mode = static_cast<int>(request.mode);
    c.summary = changesummary(request, out.rewrite);
    c.made = logtimestamp();
    c.backuppath = QFileInfo(out.backuppath).absoluteFilePath();
    c.backupstamp = stampof(out.backuppath);
    c.after = out.newstamp;
    c.hash = out.rewrite.writtenhash;
    const QString error = writenote(c);
    if (error.isEmpty())
        return error;
    // An older note must not stay behind to be refused later for the wrong reason.
    QFile::remove(c.notepath);
    return QStringLiteral("Quillmark could not note this change in %1 (%2), so it cannot be undone.")
        .arg(native(c.notepath), error);
}

QString undoquestion(const lastchange& c)
{
    return QStringLiteral("Undo the last change Quillmark made to %1?\n\n%2 (made %3)\n\nThe file will be put back as "
                          "it was before that change, from the backup %4. The file as it is now is backed up first.")
        .arg(native(c.gedcomfile), c.summary, c.made, native(c.backuppath));
}

undooutcome undolast(const QString& familyfile, const settings& s)
{
    const QString family = native(canonicalpath(familyfile));
    familylock lock(familyfile);
    if (const QString busy = lock.acquire(); !busy.isEmpty())
        return refused(busy);

    const lastchange c = readlastchange(familyfile, s.backupfolder);
    if (!c.problem.isEmpty())
        return refused(QStringLiteral("The note of the last change Quillmark made to %1 (%2) cannot be used: %3. "
                                      "Nothing has been changed.")
                           .arg(family, native(c.notepath), c.problem));
    if (!c.known)
        return refused(QStringLiteral("Quillmark has no change to %1 that it can undo: no change it made to that file "
                                      "is noted in the backup folder %2. Nothing has been changed.")
                           .arg(family, native(s.backupfolder)));
    if (!c.undone.isEmpty())
        return refused(QStringLiteral("The last change Quillmark made to %1 (%2, made %3) was undone at %4, and an "
                                      "undo is not undone again. The file as it was before that undo is in the "
                                      "backup %5.")
                           .arg(family, c.summary, c.made, c.undone, native(c.undobackup)));
    const QString changedsince =
        QStringLiteral("%1 has been changed since Quillmark's last change to it (%2, made %3), so that change cannot "
                       "be undone: undoing it would lose the later changes. Nothing has been changed. The file as it "
                       "was before that change is in the backup %4.")
            .arg(family, c.summary, c.made, native(c.backuppath));
    if (stampof(familyfile) != c.after)
        return refused(changedsince);
    if (stampof(c.backuppath) != c.backupstamp)
        return refused(QStringLiteral("The backup %1, which holds %2 as it was before the last change (%3, made %4), "
                                      "is no longer there or has been changed, so that change cannot be undone. "
                                      "Nothing has been changed.")
                           .arg(native(c.backuppath), family, c.summary, c.made));
    uint64_t hash = 0;
    QString why;
    if (!hashfile(familyfile, hash, &why))
        return refused(QStringLiteral("%1 could not be read (%2), so the last change cannot be undone. Nothing has "
                                      "been changed.")
                           .arg(family, why));
    if (hash != c.hash)
        return refused(changedsince);
    if (s.keeplog) {
        if (const QString bad = refuselogpath(s.logpath, familyfile, s.backupfolder); !bad.isEmpty())
            return refused(bad + QStringLiteral(" Nothing has been changed."));
    }

    // The file as it is now is backed up first, like any change.
    const backupresult backup = makebackup(familyfile, s.backupfolder);
    if (!backup.ok())
        return refused(backup.error, undostatus::backupfailed);
    const auto withdraw = [&](const QString& message, undostatus status = undostatus::refused) {
        QFile::remove(backup.path);
        return refused(message, status);
    };
    if (stampof(familyfile) != c.after)
        return withdraw(changedsince);

    QFile from(c.backuppath);
    replacefile to(familyfile);
    if (!from.open(QIODevice::ReadOnly))
        return withdraw(QStringLiteral("The backup %1 could not be read (%2), so the last change was not undone. "
                                       "Nothing has been changed.")
                            .arg(native(c.backuppath), from.errorString()));
    if (!to.open())
        return withdraw(QStringLiteral("An error occurred (%1): the last change was not undone, and %2 is as it was.")
                            .arg(to.errorstring(), family),
                        undostatus::failed);
    std::vector<char> buf(1 << 20);
    for (;;) {
        const qint64 n = from.read(buf.data(), static_cast<qint64>(buf.size()));
        if (n < 0 || (n > 0 && !to.write(buf.data(), n))) {
            const QString error = n < 0 ? from.errorString() : to.errorstring();
            to.cancel();
            return withdraw(QStringLiteral("An error occurred (%1): the last change was not undone, and %2 is as it "
                                           "was.")
                                .arg(error, family),
                            undostatus::failed);
        }
        if (n == 0)
            break;
    }
    // The last look, as for a save; a file written in place needs its backup on the disk first.
    QString backupunsynced;
    const replacefile::outcome done = to.commit([&](bool inplace) {
        if (stampof(familyfile) != c.after)
            return false;
        if (inplace)
            backupunsynced = syncexisting(backup.path);
        return backupunsynced.isEmpty();
    });
    if (done == replacefile::outcome::withdrawn)
        return withdraw(backupunsynced.isEmpty() ? changedsince
                                                 : backupfailedmessage() + QStringLiteral(" (") + backupunsynced + u')',
                        backupunsynced.isEmpty() ? undostatus::refused : undostatus::backupfailed);
    if (done == replacefile::outcome::failed) {
        QString message = QStringLiteral("An error occurred (%1): the last change was not undone").arg(to.errorstring());
        if (!to.damaged())
            return withdraw(message + QStringLiteral(", and %1 is as it was.").arg(family), undostatus::failed);
        // A copy in place that failed part way is undone from the backup just made.
        const QString notrestored = copyintofile(backup.path, familyfile);
        message += notrestored.isEmpty()
            ? QStringLiteral(", and %1 has been put back as it was.").arg(family)
            : QStringLiteral(". %1 could not be put back as it was (%2): the backup %3 holds it.")
                  .arg(family, notrestored, native(backup.path));
        undooutcome u = refused(message, undostatus::failed);
        u.backuppath = backup.path;
        return u;
    }

    undooutcome u;
    u.status = undostatus::undone;
    u.summary = c.summary;
    u.restoredfrom = c.backuppath;
    u.backuppath = backup.path;
    u.newstamp = stampof(familyfile);
    lastchange marked = c;
    marked.undone = logtimestamp();
    marked.undobackup = QFileInfo(backup.path).absoluteFilePath();
    if (const QString error = writenote(marked); !error.isEmpty()) {
        // The note no longer matches the file, so it would be refused anyway: it goes.
        QFile::remove(c.notepath);
        u.noteerror = QStringLiteral("Quillmark could not note the undo in %1 (%2).").arg(native(c.notepath), error);
    }
    if (s.keeplog) {
        u.logerror = writeundoentry(s, canonicalpath(familyfile), c.summary, c.made, c.backuppath, backup.path);
        u.logwritten = u.logerror.isEmpty();
    }
    return u;
}

} // namespace qm

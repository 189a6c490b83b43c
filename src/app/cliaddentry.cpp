// quillmark-cli add-entry: saves one census entry (a new census source, or a
// citation of an existing one) into a family file without windows, through the
// same checks and the same save road as "Save Census Entry". The household
// check's findings are printed as warnings (--strict refuses the entry on
// them); --dry-run prints what the save would write, as a unified diff, and
// writes nothing.
#include "app/cli.h"

#include "app/clientry.h"
#include "census/householdcheck.h"
#include "model/gedcomindex.h"
#include "writer/preview.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QFile>
#include <QJsonObject>

#include <future>

namespace qm {

namespace {

// Removes a backup made ahead when the entry is refused before it was used.
struct backupguard {
    QString path;
    ~backupguard()
    {
        if (!path.isEmpty())
            QFile::remove(path);
    }
};

} // namespace

int cliaddentry(QStringList args)
{
    QString inipath, error, entrypath;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    const bool strict = args.removeAll(QStringLiteral("--strict")) > 0;
    const bool dryrun = args.removeAll(QStringLiteral("--dry-run")) > 0;
    for (qsizetype i = 0; i < args.size(); ++i) {
        if (args[i] == QLatin1String("--entry") && i + 1 < args.size()) {
            entrypath = args[i + 1];
            args.remove(i, 2);
            break;
        }
        if (args[i].startsWith(QLatin1String("--entry="))) {
            entrypath = args[i].mid(8);
            args.remove(i);
            break;
        }
    }
    if (!endargs(args, operands, error))
        return clifail(error);
    if (args.size() != 1 || entrypath.isEmpty())
        return clifail(QStringLiteral("add-entry needs a family file and an entry: quillmark-cli add-entry FILE "
                                      "--entry ENTRY.json [--strict] [--dry-run] [--settings S.ini]"));
    const QString path = args.front();
    error = checkfamilypath(path);
    if (!error.isEmpty())
        return clifail(error);

    QFile ef(entrypath);
    if (!ef.open(QIODevice::ReadOnly))
        return clifail(QStringLiteral("cannot read the entry file %1: %2").arg(QDir::toNativeSeparators(entrypath), ef.errorString()));
    entryfile e;
    if (!readentry(ef.readAll(), e, error))
        return clifail(error);

    const auto f = opensettings(inipath, &error);
    if (!f)
        return clifail(error);
    const settings& s = f->values();

    // The backup copy is made while the file loads: the copy is mostly the
    // kernel's and the disk's work, the load the processor's. The save road
    // takes it only if the file is still as loaded. A dry run makes none.
    std::future<backupresult> early;
    if (!dryrun)
        early = std::async(std::launch::async, [&path, folder = s.backupfolder] { return makebackup(path, folder); });
    const readoutcome loaded = loadfamily(*f, path);
    const backupresult made = early.valid() ? early.get() : backupresult();
    backupguard guard{made.path};
    if (!loaded.ok)
        return clifail(loaded.error);
    const gedcomindex& ix = *f->file.index();

    censusentry entry;
    error = makeentry(e, ix, s, entry);
    if (!error.isEmpty())
        return clifail(error);

    // The household against the tree; --strict asks for it even when the setting turns it off.
    if (s.householdcheck || strict) {
        const std::vector<householdfinding> findings = householdcheck(ix, s, entry);
        for (const householdfinding& x : findings) {
            if (x.severity == findingseverity::warning)
                cliwarn(findingline(x));
            else
                clinote(findingline(x));
        }
        if (strict && anywarning(findings))
            return clifail(QStringLiteral("the household check found problems (above), so the entry was not saved "
                                          "(--strict)"));
    }
    if (dryrun) {
        const savepreview preview = previewentry(ix, s, entry);
        if (!preview.ok)
            return clifail(preview.message);
        printtext(unifieddiff(preview));
        f->file.abandonindex();
        return 0;
    }

    guard.path.clear(); // the save road uses the backup or removes it
    rewriterequest request;
    request.mode = rewritemode::censusentry;
    request.entry = entry;
    const saveoutcome out = f->file.save(request, &made);
    if (!clisaved(out))
        return clifailure;

    QJsonObject result;
    result.insert(QStringLiteral("backup"), QDir::toNativeSeparators(out.backuppath));
    result.insert(QStringLiteral("source"), entry.sourceid.toInt());
    result.insert(QStringLiteral("individuals"), static_cast<int>(entry.selection.size()));
    result.insert(QStringLiteral("log"), out.logwritten);
    result.insert(QStringLiteral("images"), static_cast<int>(entry.chosenimages.size()));
    printjson(result);
    // The process ends here: taking a large index apart would only cost time.
    f->file.abandonindex();
    return 0;
}

} // namespace qm

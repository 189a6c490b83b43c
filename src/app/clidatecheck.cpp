// quillmark-cli date-check: lists the census event dates of a family file as
// the Census Date Check dialog does, and with --apply makes the suggested
// changes as its "Make Suggested Changes" button does.
#include "app/cli.h"

#include "model/gedcomindex.h"
#include "tools/datecheck.h"

#include <QDir>

#include <cstdio>

namespace qm {

namespace {

void printlist(const QString& heading, const std::vector<datelistentry>& entries)
{
    printline(heading);
    for (const datelistentry& e : entries)
        printline(e.text);
}

QString usage()
{
    return QStringLiteral("date-check needs one family file: quillmark-cli date-check FILE [--country C] [--apply] "
                          "[--settings S.ini]");
}

} // namespace

int clidatecheck(QStringList args)
{
    QString inipath, error;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    bool apply = false;
    QString country;
    QStringList files;
    error = readapplyargs(args, QStringLiteral("--country"),
                          QStringLiteral("--country needs one of UK, USA, Ireland, Canada"),
                          [&country](const QString& given) { return takecountry(given, &country); }, &apply, &files);
    if (!error.isEmpty())
        return clifail(error);
    files += operands;
    const auto f = openfamily(files, usage(), inipath);
    if (!f)
        return clifailure;
    if (country.isEmpty())
        country = f->values().country;
    const gedcomindex& ix = *f->file.index();

    datecheckstate check(ix);
    check.choosecountry(country);
    const datelists lists = check.lists();
    printlist(QStringLiteral("Unknown Census dates:"), lists.unknown);
    printlist(currentcountrycaption(check.country()), lists.current);
    printlist(othercountrycaption(check.country()), lists.other);
    std::fflush(stdout);
    if (!apply || !lists.canchange) {
        f->file.abandonindex(); // the system takes the memory back faster
        return 0;
    }

    const saveoutcome out = makedatechanges(f->file, check.changes());
    if (!clisaved(out))
        return clifailure;
    printline(QStringLiteral("Changed %1 census event dates and %2 occupation dates")
                  .arg(out.rewrite.censusdateschanged)
                  .arg(out.rewrite.occdateschanged));
    printline(QStringLiteral("Backup: ") + QDir::toNativeSeparators(out.backuppath));
    std::fflush(stdout);
    f->file.abandonindex();
    return 0;
}

} // namespace qm

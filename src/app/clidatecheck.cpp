// quillmark-cli date-check: lists the census event dates of a family file as
// the Census Date Check dialog does, and with --apply makes the suggested
// changes as its "Make Suggested Changes" button does.
#include "app/cli.h"

#include "flags/flagtable.h"
#include "model/loadgedcom.h"
#include "tools/datecheck.h"

#include <QDir>
#include <QFileInfo>

#include <cstdio>

namespace qm {

namespace {

void printline(const QString& text)
{
    const QByteArray bytes = text.toUtf8() + '\n';
    std::fwrite(bytes.constData(), 1, static_cast<size_t>(bytes.size()), stdout);
}

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
    if (!takesettingsoption(args, &inipath, &error))
        return clifail(error);
    bool apply = false;
    QString country;
    QStringList files;
    static const QString countryflag = QStringLiteral("--country");
    for (qsizetype i = 0; i < args.size(); ++i) {
        const QString& a = args[i];
        QString given;
        if (a == QLatin1String("--apply")) {
            apply = true;
            continue;
        }
        if (a == countryflag) {
            if (i + 1 >= args.size())
                return clifail(QStringLiteral("--country needs one of UK, USA, Ireland, Canada"));
            given = args[++i];
        } else if (a.startsWith(countryflag + QLatin1Char('='))) {
            given = a.mid(countryflag.size() + 1);
        } else if (a.startsWith(QLatin1Char('-')) && a != QLatin1String("-")) {
            return clifail(QStringLiteral("unknown option %1 (see quillmark-cli --help)").arg(a));
        } else {
            files.push_back(a);
            continue;
        }
        country.clear();
        for (const QString& c : datecheckcountries())
            if (given.trimmed().compare(c, Qt::CaseInsensitive) == 0)
                country = c;
        if (country.isEmpty())
            return clifail(QStringLiteral("--country %1: give one of UK, USA, Ireland, Canada").arg(given));
    }
    if (files.size() != 1)
        return clifail(usage());
    const QString path = files.front();
    const QFileInfo info(path);
    if (!info.exists())
        return clifail(QStringLiteral("%1: no such file").arg(QDir::toNativeSeparators(path)));
    if (info.isDir())
        return clifail(QStringLiteral("%1 is a folder, not a family file").arg(QDir::toNativeSeparators(path)));

    const auto s = opensettings(inipath, &error);
    if (!s)
        return clifail(error);
    if (country.isEmpty())
        country = s->values.country;
    flagtable flagdefs;
    if (!loadflagdefs(*s->store, flagdefs))
        cliwarn(flagloaderrormessage());
    loadresult r = loadgedcom(path, flagdefs);
    if (!r.index)
        return clifail(r.error);
    const gedcomindex& ix = *r.index;
    if (!ix.hashead)
        return clifail(QStringLiteral("%1 is not a GEDCOM family file: it has no \"0 HEAD\" line")
                           .arg(QDir::toNativeSeparators(path)));

    datecheckstate check(ix);
    check.choosecountry(country);
    const datelists lists = check.lists();
    printlist(QStringLiteral("Unknown Census dates:"), lists.unknown);
    printlist(currentcountrycaption(check.country()), lists.current);
    printlist(othercountrycaption(check.country()), lists.other);
    std::fflush(stdout);
    if (!apply || !lists.canchange) {
        (void)r.index.release(); // the system takes the memory back faster
        return 0;
    }

    const saveoutcome out = makedatechanges(ix, s->values, check.changes());
    if (!out.saved())
        return clifail(out.message);
    if (!out.logerror.isEmpty())
        cliwarn(out.logerror);
    printline(QStringLiteral("Changed %1 census event dates and %2 occupation dates")
                  .arg(out.rewrite.censusdateschanged)
                  .arg(out.rewrite.occdateschanged));
    printline(QStringLiteral("Backup: ") + QDir::toNativeSeparators(out.backuppath));
    std::fflush(stdout);
    (void)r.index.release();
    return 0;
}

} // namespace qm

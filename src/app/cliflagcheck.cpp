// quillmark-cli flag-check: lists the census flags out of step with the census
// events, as the Flag Check dialog does, and with --apply makes the changes.
#include "app/cli.h"

#include "flags/flagcheck.h"
#include "model/gedcomindex.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "writer/saveroad.h"

#include <QDir>

#include <cstdio>
#include <map>
#include <string>

namespace qm {

namespace {

QString usage()
{
    return QStringLiteral("flag-check needs one family file: quillmark-cli flag-check FILE [--apply] "
                          "[--country-for PLACE=COUNTRY]... [--settings S.ini]");
}

} // namespace

int cliflagcheck(QStringList args)
{
    QString inipath, error;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    bool apply = false;
    std::map<std::string, QString> countryfor; // place key -> country
    QStringList files;
    const auto takeanswer = [&countryfor](const QString& answer) {
        // The country follows the last "=": place names may hold one, countries never do.
        const qsizetype eq = answer.lastIndexOf(QLatin1Char('='));
        const QString country = eq < 0 ? QString() : censuscountry(answer.mid(eq + 1));
        if (country.isEmpty())
            return QStringLiteral("--country-for %1: give PLACE=COUNTRY with COUNTRY one of UK, USA, "
                                  "Ireland, Canada")
                .arg(answer);
        countryfor[placekey(u8(answer.left(eq)))] = country;
        return QString();
    };
    error = readapplyargs(args, QStringLiteral("--country-for"), QStringLiteral("--country-for needs PLACE=COUNTRY"),
                          takeanswer, &apply, &files);
    if (!error.isEmpty())
        return clifail(error);
    files += operands;
    const auto f = openfamily(files, usage(), inipath);
    if (!f)
        return clifailure;
    gedcomindex& ix = *f->file.index();

    // The country question is answered from --country-for, or the check fails naming the event.
    QString unanswered;
    const countryasker ask = [&](const countryquestion& q) -> countrychoice {
        const personrec& p = ix.people[static_cast<size_t>(q.person)];
        const auto given = countryfor.find(placekey(q.place));
        const QString event = QStringLiteral("individual %1 (ID: %2) has a census event (date %3, place %4)")
                                  .arg(qs(p.name), QString::number(p.id), qs(q.date),
                                       q.place.empty() ? QStringLiteral("none") : qs(q.place));
        const QString countries = q.countries.join(QStringLiteral(", "));
        if (given == countryfor.end()) {
            unanswered = event + QStringLiteral(" that matches the flags of %1: say which with --country-for \"%2=COUNTRY\"")
                                     .arg(countries, qs(q.place));
            return {};
        }
        const qsizetype at = q.countries.indexOf(given->second);
        if (at < 0) {
            unanswered = event + QStringLiteral(" that matches the flags of %1, not of %2 given by --country-for")
                                     .arg(countries, given->second);
            return {};
        }
        return {static_cast<int>(at), false};
    };
    const flagcheckresult check = checkflags(ix, true, f->values().country, ask);
    if (check.cancelled)
        return clifail(unanswered);

    printline(flagsaddheading());
    for (const QString& row : check.addlist())
        printline(row);
    printline(flagsremoveheading());
    for (const QString& row : check.removelist())
        printline(row);
    std::fflush(stdout);
    if (!apply || !check.canchange())
        return 0;

    rewriterequest request;
    request.mode = rewritemode::flagchanges;
    request.flagchanges = check.changes;
    const saveoutcome out = f->file.save(request);
    if (!clisaved(out))
        return clifailure;
    printline(QStringLiteral("Backup: ") + QDir::toNativeSeparators(out.backuppath));
    std::fflush(stdout);
    return 0;
}

} // namespace qm

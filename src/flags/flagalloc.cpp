#include "flags/flagalloc.h"

#include "census/censustable.h"
#include "model/gedcomindex.h"
#include "platform/encoding.h"

#include <algorithm>

namespace qm {

namespace {

constexpr int columnwidth = 15;

QString refusal(const QString& country, const QString& chosen)
{
    return QStringLiteral("Another flag has already been associated with ") + country + QLatin1Char(' ') + chosen +
           QStringLiteral(". Either choose another date or press cancel.");
}

bool holds(const gedcomindex& index, int32_t flag)
{
    return std::any_of(index.people.begin(), index.people.end(), [flag](const personrec& p) {
        return std::find(p.flagids.begin(), p.flagids.end(), flag) != p.flagids.end();
    });
}

} // namespace

const QStringList& flagcountries()
{
    static const QStringList countries{QStringLiteral("UK"), QStringLiteral("USA"), QStringLiteral("Ireland"),
                                       QStringLiteral("Canada")};
    return countries;
}

QString flagrowtext(const flagrec& f)
{
    return qs(f.date).leftJustified(columnwidth) + qs(f.country).leftJustified(columnwidth) + qs(f.name);
}

QString flagheading()
{
    return QStringLiteral("Census Date").leftJustified(columnwidth) +
           QStringLiteral("Country").leftJustified(columnwidth) + QStringLiteral("Flag name");
}

std::vector<size_t> allocatedflags(const flagtable& table)
{
    std::vector<size_t> out;
    for (size_t i = 0; i < table.size(); ++i)
        if (!table[i].date.empty())
            out.push_back(i);
    return out;
}

std::vector<size_t> unallocatedflags(const flagtable& table)
{
    std::vector<size_t> out;
    for (size_t i = 0; i < table.size(); ++i)
        if (table[i].date.empty())
            out.push_back(i);
    return out;
}

size_t allocateflag(flagtable& table, const QString& name, const QString& date, const QString& country,
                    std::optional<size_t> chosen)
{
    const std::string n = u8(name);
    size_t at = table.size();
    // The flag picked from the list, not merely the first of its name: flags
    // read from the family file may share a name under different codes.
    if (chosen && *chosen < table.size() && table[*chosen].name == n)
        at = *chosen;
    else
        at = static_cast<size_t>(std::find_if(table.begin(), table.end(),
                                              [&](const flagrec& f) { return f.name == n; }) -
                                 table.begin());
    if (at == table.size()) {
        flagrec f;
        f.code = codeforflag(name);
        f.name = n;
        table.push_back(std::move(f));
    }
    table[at].date = u8(date);
    table[at].country = u8(country);
    return at;
}

void deleteflag(gedcomindex& index, size_t flag)
{
    flagtable& table = index.flags;
    if (flag >= table.size())
        return;
    const auto f = static_cast<int32_t>(flag);
    // The count says whether anyone holds the flag; the individuals are asked
    // as well, so that a flag still held is never taken out from under them.
    if (table[flag].count >= 1 || holds(index, f)) {
        table[flag].date.clear();
        return;
    }
    table.erase(table.begin() + static_cast<std::ptrdiff_t>(flag));
    for (personrec& p : index.people)
        for (int32_t& id : p.flagids)
            if (id > f)
                --id;
}

QStringList flagdates(const flagtable& table, const QString& country)
{
    const std::string c = u8(country);
    QStringList out;
    for (const censusdef& d : censustable()) {
        if (d.country != country)
            continue;
        const std::string date = u8(d.date);
        const bool taken = std::any_of(table.begin(), table.end(),
                                       [&](const flagrec& f) { return f.date == date && f.country == c; });
        if (!taken)
            out << d.date;
    }
    return out;
}

std::optional<QString> refusedate(const flagtable& table, const QString& country, const QString& date)
{
    const std::string c = u8(country);
    const std::string d = u8(date);
    for (const flagrec& f : table)
        if (!f.date.empty() && f.country == c && d.find(f.date) != std::string::npos)
            return refusal(country, date);
    return std::nullopt;
}

std::optional<QString> refuseyear(const flagtable& table, const QString& country, const QString& year)
{
    const std::string c = u8(country);
    const std::string y = u8(year);
    if (y.empty())
        return std::nullopt;
    for (const flagrec& f : table)
        if (f.country == c && f.date.find(y) != std::string::npos)
            return refusal(country, year);
    return std::nullopt;
}

std::optional<namerefusal> refuseflagname(const flagtable& table, const QString& typed)
{
    const QString name = typed.trimmed();
    const std::string code = codeforflag(name);
    // A code of underscores only says nothing of the flag (and "__" is too
    // short to be read back as a definition).
    if (name.isEmpty() || code.find_first_not_of('_') == std::string::npos)
        return namerefusal{QStringLiteral("This is an invalid flag name"), true};
    const std::string n = u8(name);
    for (const flagrec& f : table) {
        if (f.name == n)
            return namerefusal{QStringLiteral("There is already a flag with this name"), false};
        if (f.code == code)
            return namerefusal{
                QStringLiteral("Name is too similar to an existing flag name. Please choose another name. If an "
                               "existing flagname has the same first 13 characters (ignoring anything other than "
                               "letters, digits or spaces) then they are deemed to be too similar."),
                false};
    }
    return std::nullopt;
}

QString flaguseprompt()
{
    return QStringLiteral(
        "Do you want to automatically add flags to any census records you create for the censuses listed?");
}

} // namespace qm

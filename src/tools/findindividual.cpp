#include "tools/findindividual.h"

#include "model/loadgedcom.h"
#include "platform/encoding.h"

namespace qm {

namespace {
bool alldigits(const QString& s)
{
    if (s.isEmpty())
        return false;
    for (const QChar c : s) {
        if (c < u'0' || c > u'9')
            return false;
    }
    return true;
}
} // namespace

QString censusdatetext(const QString& date)
{
    QString d = date;
    if (d.startsWith(u'('))
        d.remove(0, 1);
    if (d.endsWith(u')'))
        d.chop(1);
    if (d.size() >= 4) {
        const QString last = d.mid(d.lastIndexOf(u' ') + 1);
        if (alldigits(last))
            return last;
    }
    return d;
}

QString censusagetext(const QString& age)
{
    const QString a = age.trimmed();
    if (a.isEmpty())
        return QStringLiteral("?");
    const QChar unit = a.back().toLower();
    const QString number = a.left(a.size() - 1);
    // Only a number and its unit: GEDCOM words such as CHILD keep their last letter.
    if (!alldigits(number))
        return a;
    if (unit == u'y')
        return number;
    if (unit == u'm')
        return number + (number == QLatin1String("1") ? QStringLiteral(" month") : QStringLiteral(" months"));
    if (unit == u'd')
        return number + (number == QLatin1String("1") ? QStringLiteral(" day") : QStringLiteral(" days"));
    return a;
}

QString censusline(const censusrec& c)
{
    QString line = censusdatetext(qs(c.date)) + QStringLiteral(": aged ") + censusagetext(qs(c.age)) +
                   QStringLiteral(" at ") + qs(c.place);
    if (!c.address.empty())
        line += QStringLiteral(" (") + qs(c.address) + QLatin1Char(')');
    return line;
}

QStringList censuslines(const personrec& p)
{
    QStringList out;
    for (const censusrec& c : p.census)
        out << censusline(c);
    if (out.isEmpty())
        out << QStringLiteral("(Does not have any census events recorded)");
    return out;
}

relatives findrelatives(const gedcomindex& index, int32_t k)
{
    relatives out;
    if (k < 0 || static_cast<size_t>(k) >= index.people.size())
        return out;
    const personrec& of = index.people[static_cast<size_t>(k)];
    for (size_t jj = 0; jj < index.people.size(); ++jj) {
        const auto j = static_cast<int32_t>(jj);
        if (j == k)
            continue;
        const personrec& p = index.people[jj];
        bool found = false;
        if (of.famc != 0) {
            for (int32_t a : p.fams) {
                if (a == of.famc) {
                    out.parents.push_back(j);
                    found = true;
                }
            }
        }
        for (int32_t a : p.fams) {
            for (int32_t b : of.fams) {
                if (a == b && a != 0) {
                    out.spouses.push_back(j);
                    found = true;
                }
            }
        }
        if (!found && p.famc != 0) {
            for (int32_t b : of.fams) {
                if (b == p.famc)
                    out.children.push_back(j);
            }
        }
    }
    return out;
}

std::vector<listentry> findlist(const gedcomindex& index, bool idonly, std::vector<listentry> mainlist)
{
    if (!peoplelistshown(index))
        return mainlist;
    std::vector<listentry> out;
    out.reserve(index.people.size());
    for (int32_t k : sortedpeople(index, idonly))
        out.push_back({personlabel(index.people[static_cast<size_t>(k)], idonly), k});
    return out;
}

int findbyname(const std::vector<listentry>& entries, const QString& start)
{
    for (size_t r = 0; r < entries.size(); ++r) {
        if (entries[r].text.startsWith(start, Qt::CaseInsensitive))
            return static_cast<int>(r);
    }
    return -1;
}

int findbyid(const gedcomindex& index, const std::vector<listentry>& entries, int32_t id)
{
    for (size_t r = 0; r < entries.size(); ++r) {
        const int32_t k = entries[r].person;
        if (k >= 0 && static_cast<size_t>(k) < index.people.size() && index.people[static_cast<size_t>(k)].id == id)
            return static_cast<int>(r);
    }
    return -1;
}

int32_t personofid(const gedcomindex& index, int32_t id)
{
    for (size_t k = 0; k < index.people.size(); ++k) {
        if (index.people[k].id == id)
            return static_cast<int32_t>(k);
    }
    return -1;
}

} // namespace qm

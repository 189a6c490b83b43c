#include "images/sourcedates.h"

#include "model/dates.h"
#include "platform/encoding.h"
#include "platform/linereader.h"

#include <QDir>

#include <algorithm>
#include <unordered_map>

namespace qm {

namespace {

// Indented lines are recognised as if they began at their level number.
std::string_view unindent(std::string_view line)
{
    size_t i = 0;
    while (i < line.size() && (line[i] == ' ' || line[i] == '\t'))
        ++i;
    return line.substr(i);
}

std::string_view trimmed(std::string_view s)
{
    const auto blank = [](char c) { return c == ' ' || c == '\t'; };
    while (!s.empty() && blank(s.front()))
        s.remove_prefix(1);
    while (!s.empty() && blank(s.back()))
        s.remove_suffix(1);
    return s;
}

// The record number of "2 SOUR @S12@ ...": the digits from the tenth character
// up to the next "@"; 0 when they are not a number.
int32_t citedsource(std::string_view t)
{
    std::string_view digits = t.substr(9);
    digits = digits.substr(0, digits.find('@'));
    if (digits.empty() || digits.size() > 9)
        return 0;
    int32_t n = 0;
    for (const char c : digits) {
        if (c < '0' || c > '9')
            return 0;
        n = n * 10 + (c - '0');
    }
    return n;
}

// A date worth keeping as a source's census date: a plain calendar date,
// not a qualified one ("ABT 1881") or a bare year.
bool calendardate(const std::string& date)
{
    return recognisedate(qs(date)).has_value();
}

// The upper-case UTF-8 form of a date value read from the file.
void setdate(std::string& out, std::string_view bytes, textencoding enc)
{
    bytes = trimmed(bytes);
    if (allascii(bytes)) {
        out.assign(bytes);
        for (char& c : out)
            if (c >= 'a' && c <= 'z')
                c = static_cast<char>(c - 'a' + 'A');
        return;
    }
    out = u8(qs(toutf8(bytes, enc)).toUpper());
}

} // namespace

QString findcensusdates(gedcomindex& index)
{
    linereader reader;
    QString error;
    if (!reader.open(index.gedcomfile, &error))
        return error;
    findcensusdates(index, reader);
    return reader.failed() ? reader.errorstring() : QString();
}

void findcensusdates(gedcomindex& index, linereader& reader)
{
    // The first source with each record number.
    std::unordered_map<int32_t, size_t> byid;
    byid.reserve(index.sources.size());
    for (size_t i = 0; i < index.sources.size(); ++i)
        byid.emplace(index.sources[i].id, i);

    std::string date; // date of the current event, "" when none (yet)
    bool counting = false;
    bool birth = false;
    std::string_view line;
    while (reader.next(line)) {
        const std::string_view t = unindent(line);
        if (t.empty())
            continue;
        if (t[0] == '0') {
            // A new record: no event is open.
            date.clear();
            counting = false;
            continue;
        }
        if (t.starts_with("1 ")) {
            date.clear();
            counting = !t.starts_with("1 CHAN");
            birth = t.starts_with("1 BIRT");
            continue;
        }
        if (!counting)
            continue;
        if (t.starts_with("2 DATE ")) {
            setdate(date, t.substr(6), reader.encoding());
            continue;
        }
        if (date.empty() || !t.starts_with("2 SOUR @S"))
            continue;
        const auto it = byid.find(citedsource(t));
        if (it == byid.end())
            continue;
        sourcerec& s = index.sources[it->second];
        if ((birth && s.iscensus) || s.censusdatesought)
            continue;
        if (!s.censusdate.empty()) {
            if (s.censusdate != date)
                s.censusdatesought = true;
        } else if (calendardate(date)) {
            s.censusdate = date;
        } else {
            s.censusdatesought = true;
        }
    }
}

std::vector<int32_t> filtersources(const gedcomindex& index, sourcefilter filter, const QString& searchtext,
                                   bool noimagesonly)
{
    const QString wanted = searchtext.trimmed().toLower();
    std::vector<int32_t> out;
    for (size_t i = 0; i < index.sources.size(); ++i) {
        const sourcerec& s = index.sources[i];
        if (noimagesonly && !s.objectids.empty())
            continue;
        bool include = false;
        switch (filter) {
        case sourcefilter::all:
            include = true;
            break;
        case sourcefilter::census:
            include = s.iscensus;
            break;
        case sourcefilter::text:
            include = qs(s.title).toLower().contains(wanted);
            break;
        }
        if (include)
            out.push_back(static_cast<int32_t>(i));
    }
    return out;
}

QString sourcecounttext(size_t count)
{
    return QString::number(count) + (count == 1 ? QStringLiteral(" source") : QStringLiteral(" sources"));
}

QString sourcedatetext(const sourcerec& source)
{
    if (source.censusdate.empty() || source.censusdatesought)
        return QStringLiteral("Unknown");
    return qs(source.censusdate);
}

QStringList attachedimagetitles(const gedcomindex& index, const sourcerec& source)
{
    QStringList out;
    for (const int32_t id : source.objectids) {
        const auto it = std::find_if(index.objects.begin(), index.objects.end(),
                                     [id](const objectrec& o) { return o.id == id; });
        out << (it == index.objects.end() ? QString() : qs(it->title));
    }
    return out;
}

std::vector<int32_t> citingpeople(const gedcomindex& index, int32_t sourceid)
{
    std::vector<int32_t> out;
    for (size_t i = 0; i < index.people.size(); ++i) {
        const indexlist<int32_t>& cited = index.people[i].sourceids;
        if (std::find(cited.begin(), cited.end(), sourceid) != cited.end())
            out.push_back(static_cast<int32_t>(i));
    }
    return out;
}

std::vector<imagechoice> dropalreadylinked(const sourcerec& source, std::vector<imagechoice>& chosen)
{
    std::vector<imagechoice> dropped;
    std::erase_if(chosen, [&](const imagechoice& c) {
        const bool linked =
            !c.isnew && std::find(source.objectids.begin(), source.objectids.end(), c.objectid) != source.objectids.end();
        if (linked)
            dropped.push_back(c);
        return linked;
    });
    return dropped;
}

QString alreadylinkedmessage(const std::vector<imagechoice>& dropped)
{
    QStringList names;
    for (const imagechoice& c : dropped)
        names << QStringLiteral("'%1' (ID: %2)").arg(c.title).arg(c.objectid);
    if (names.isEmpty())
        return QString();
    return (names.size() == 1 ? QStringLiteral("The image ") + names.front()
                                    + QStringLiteral(" is already attached to this source, so it is not attached again.")
                              : QStringLiteral("The images ") + names.join(QStringLiteral(", "))
                                    + QStringLiteral(" are already attached to this source, so they are not attached again."));
}

void recordattached(gedcomindex& index, int32_t sourcepos, const std::vector<imagechoice>& chosen,
                    const filestamp& newstamp)
{
    const auto keep = [&index](const QString& text) { return index.arena.store(u8(text)); };
    sourcerec& s = index.sources[static_cast<size_t>(sourcepos)];
    for (const imagechoice& img : chosen) {
        if (img.isnew) {
            objectrec o;
            o.id = img.objectid;
            o.form = keep(img.form);
            o.title = keep(img.title);
            o.file = keep(img.file);
            o.date = keep(img.date);
            index.objects.push_back(o);
            index.maxobjectid = std::max(index.maxobjectid, img.objectid);
        }
        s.objectids.push_back(img.objectid);
    }
    index.gedcomdate = newstamp;
}

QString attachchangedmessage(const QString& gedcomfile)
{
    return QDir::toNativeSeparators(gedcomfile)
        + QStringLiteral(" has been modified by another application. Images will not be attached to this source and "
                         "new images will not be added as a precaution to ensure there is no data loss. This form will "
                         "now close and the file will be reloaded.");
}

} // namespace qm

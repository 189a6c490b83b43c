// The entry file of quillmark-cli add-entry, read and checked (clientry.h).
#include "app/clientry.h"

#include "census/birthdate.h"
#include "census/censustable.h"
#include "census/validateentry.h"
#include "images/imagechoices.h"
#include "model/dates.h"
#include "model/gedcomindex.h"
#include "settings/settings.h"
#include "writer/maketitle.h"

#include <QDir>
#include <QFileInfo>
#include <QHash>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

#include <algorithm>
#include <cmath>

namespace qm {

namespace {


// Line breaks as the form's text boxes give them.
QString crlf(QString text)
{
    text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    text.replace(u'\r', u'\n');
    text.replace(QStringLiteral("\n"), QStringLiteral("\r\n"));
    return text;
}

bool readtext(const QJsonObject& o, const char* key, QString& out, QString& error)
{
    const QJsonValue v = o.value(QLatin1String(key));
    if (v.isUndefined() || v.isNull())
        return true;
    if (!v.isString()) {
        error = QStringLiteral("\"%1\" must be a text").arg(QLatin1String(key));
        return false;
    }
    out = v.toString();
    return true;
}

// The objects of the list `key` (absent: none). False when it is no list of
// objects, with the message naming the first that is not one.
bool objectlist(const QJsonObject& o, const char* key, const char* item, std::vector<QJsonObject>& out, QString& error)
{
    out.clear();
    const QJsonValue list = o.value(QLatin1String(key));
    if (!list.isUndefined() && !list.isNull() && !list.isArray()) {
        error = QStringLiteral("\"%1\" must be a list").arg(QLatin1String(key));
        return false;
    }
    for (const QJsonValue& v : list.toArray()) {
        if (!v.isObject()) {
            error = QStringLiteral("%1 %2 of the list must be an object").arg(QLatin1String(item)).arg(out.size() + 1);
            return false;
        }
        out.push_back(v.toObject());
    }
    return true;
}

// A whole number given as a JSON number or as a text of digits.
bool readnumber(const QJsonValue& v, const QString& what, int64_t& out, QString& error)
{
    bool ok = false;
    if (v.isDouble()) {
        // In range before it is converted: a double beyond int64_t has no conversion.
        const double d = v.toDouble();
        ok = d >= 0 && d < 2147483648.0 && d == std::floor(d);
        out = ok ? static_cast<int64_t>(d) : 0;
    } else if (v.isString()) {
        out = v.toString().trimmed().toInt(&ok);
        ok = ok && out >= 0;
    }
    if (!ok)
        error = QStringLiteral("%1 must be a whole number").arg(what);
    return ok;
}

// The entry's images as the Census Images dialog would give them: new images
// numbered by title and given the next free O numbers, existing records
// linked. "" or why one is refused.
QString chooseimages(const std::vector<entryimage>& images, const gedcomindex& ix, const QString& date,
                     std::vector<imagechoice>& chosen)
{
    int32_t nextobjectid = firstobjectbase(ix);
    for (const entryimage& image : images) {
        if (image.object) {
            const auto found = std::find_if(ix.objects.begin(), ix.objects.end(),
                                            [&](const objectrec& o) { return o.id == *image.object; });
            if (found == ix.objects.end())
                return QStringLiteral("there is no multimedia record @O%1@ in the family file").arg(*image.object);
            if (const QString refused = refuseexistingimage(found->id, chosen); !refused.isEmpty())
                return refused;
            addexistingimage(chosen, *found);
            continue;
        }
        // A record may hold the path as given or in full: both are compared.
        const QString path = QFileInfo(image.file.trimmed()).absoluteFilePath();
        for (const QString& p : {image.file.trimmed(), path})
            if (const QString refused = refusenewimage(p, chosen, ix); !refused.isEmpty())
                return refused;
        if (!QFileInfo(path).isFile())
            return QStringLiteral("%1: no such image file").arg(QDir::toNativeSeparators(path));
        if (const QString unreadable = imagefileproblem(path); !unreadable.isEmpty())
            return QStringLiteral("%1: %2").arg(QDir::toNativeSeparators(path), unreadable);
        const QString title = image.title.trimmed().isEmpty() ? titlefromfilename(path) : image.title.trimmed();
        addnewimage(chosen, nextobjectid, QDir::toNativeSeparators(path), title, nexttitlenumber(chosen, title), date);
    }
    return QString();
}

// The census the entry names: by its year, or else the one whose official day
// (or, failing that, whose year) the date falls on.
const censusdef* choosecensus(const entryfile& e, const QString& country)
{
    if (e.year)
        return lookupcensus(country, *e.year);
    if (!e.date)
        return nullptr;
    const std::optional<QDate> day = recognisedate(*e.date);
    if (!day)
        return nullptr;
    for (const censusdef& c : censustable())
        if (c.country == country && recognisedate(c.date) == day)
            return &c;
    return lookupcensus(country, day->year());
}

} // namespace

bool readentry(const QByteArray& bytes, entryfile& e, QString& error)
{
    QJsonParseError perr;
    const QJsonDocument doc = QJsonDocument::fromJson(bytes, &perr);
    if (doc.isNull()) {
        error = QStringLiteral("the entry file is not valid JSON: %1 at offset %2").arg(perr.errorString()).arg(perr.offset);
        return false;
    }
    if (!doc.isObject()) {
        error = QStringLiteral("the entry file must hold one JSON object");
        return false;
    }
    const QJsonObject o = doc.object();
    int64_t n = 0;
    if (o.contains(QLatin1String("year"))) {
        if (!readnumber(o.value(QLatin1String("year")), QStringLiteral("\"year\""), n, error))
            return false;
        e.year = static_cast<int>(n);
    }
    if (o.contains(QLatin1String("date"))) {
        e.date.emplace();
        if (!readtext(o, "date", *e.date, error))
            return false;
    }
    if (o.contains(QLatin1String("title"))) {
        e.title.emplace();
        if (!readtext(o, "title", *e.title, error))
            return false;
    }
    if (o.contains(QLatin1String("source"))) {
        if (!readnumber(o.value(QLatin1String("source")), QStringLiteral("\"source\""), n, error))
            return false;
        e.source = static_cast<int32_t>(n);
    }
    if (!readtext(o, "place", e.place, error) || !readtext(o, "address", e.address, error)
        || !readtext(o, "reference", e.reference, error) || !readtext(o, "source_text", e.sourcetext, error)
        || !readtext(o, "note_text", e.notetext, error) || !readtext(o, "other", e.other, error))
        return false;
    e.sourcetext = crlf(e.sourcetext);
    e.notetext = crlf(e.notetext);

    std::vector<QJsonObject> list;
    if (!objectlist(o, "individuals", "individual", list, error))
        return false;
    int k = 0;
    for (const QJsonObject& p : list) {
        ++k;
        entryperson person;
        if (!readnumber(p.value(QLatin1String("id")), QStringLiteral("\"id\" of individual %1").arg(k), n, error))
            return false;
        person.id = static_cast<int32_t>(n);
        const QJsonValue age = p.value(QLatin1String("age"));
        if (age.isDouble() && age.toDouble() >= 0 && age.toDouble() == static_cast<double>(age.toInt()))
            person.age = QString::number(age.toInt());
        else if (!readtext(p, "age", person.age, error))
            return false;
        QString type = QStringLiteral("Y");
        if (!readtext(p, "agetype", type, error) || !readtext(p, "occupation", person.occupation, error))
            return false;
        // Anything but one letter Y, M or D is refused by the household check.
        person.agetype = type.trimmed().size() == 1 ? type.trimmed()[0].toUpper() : QChar(u'?');
        if (p.contains(QLatin1String("birthplace"))) {
            person.birthplace.emplace();
            if (!readtext(p, "birthplace", *person.birthplace, error))
                return false;
        }
        e.people.push_back(std::move(person));
    }

    if (!objectlist(o, "images", "image", list, error))
        return false;
    k = 0;
    for (const QJsonObject& i : list) {
        ++k;
        entryimage image;
        if (i.contains(QLatin1String("object"))) {
            if (i.contains(QLatin1String("file")) || i.contains(QLatin1String("title"))) {
                error = QStringLiteral("image %1 of the list must have either \"object\" or \"file\"").arg(k);
                return false;
            }
            if (!readnumber(i.value(QLatin1String("object")), QStringLiteral("\"object\" of image %1").arg(k), n, error))
                return false;
            image.object = static_cast<int32_t>(n);
        } else {
            if (!readtext(i, "file", image.file, error) || !readtext(i, "title", image.title, error))
                return false;
            if (image.file.trimmed().isEmpty()) {
                error = QStringLiteral("image %1 of the list must have \"file\" or \"object\"").arg(k);
                return false;
            }
        }
        e.images.push_back(std::move(image));
    }
    return true;
}

QString makeentry(const entryfile& e, const gedcomindex& ix, const settings& s, censusentry& entry)
{
    // The household, looked up in one pass over the individuals.
    QHash<int32_t, int32_t> wanted;
    for (const entryperson& p : e.people)
        wanted.insert(p.id, -1);
    for (size_t i = 0; i < ix.people.size(); ++i) {
        const auto it = wanted.find(ix.people[i].id);
        if (it != wanted.end() && *it < 0)
            *it = static_cast<int32_t>(i);
    }
    entryform form;
    for (const entryperson& p : e.people) {
        selectionrec r;
        r.id = p.id;
        r.personindex = wanted.value(p.id, -1);
        if (r.personindex >= 0)
            r.name = qs(ix.people[static_cast<size_t>(r.personindex)].name);
        r.age = p.age.trimmed();
        r.agetype = p.agetype;
        r.occupation = p.occupation.trimmed();
        form.selection.push_back(r);
    }
    QString error = checkhousehold(form.selection);
    if (!error.isEmpty())
        return error;

    const QString country = s.country;
    const censusdef* census = choosecensus(e, country);
    form.fullentry = s.fullentry;
    form.yeartext = census ? QString::number(census->year) : QString();
    form.officialdate = census ? census->date : QString();
    form.datetext = e.date ? *e.date : form.officialdate;
    form.place = e.place;
    form.address = e.address;
    form.reference = e.reference;
    form.other = e.other;
    form.sourcetext = e.sourcetext;
    form.notetext = e.notetext;
    int sourcepos = -1;
    if (s.fullentry) {
        form.sourceid = QString::number(ix.nextsourceid);
        if (e.title) {
            form.title = *e.title;
        } else {
            const datecheck d = validdate(form.datetext, form.officialdate);
            form.title = maketitle(s.title, form.yeartext, d.newtext.value_or(form.datetext), form.place, form.address,
                                   form.other, form.reference.trimmed(), country);
        }
    } else if (e.source) {
        form.sourceid = QString::number(*e.source);
    }
    const entrycheck check = validateentry(form, s);
    if (!check.ok)
        return check.message;
    if (!s.fullentry) {
        sourcepos = findcensussource(ix, form.sourceid);
        if (sourcepos < 0)
            return notcensussourcemessage(form.sourceid);
        form.title = qs(ix.sources[static_cast<size_t>(sourcepos)].title);
    }

    entry = entryfromform(form, check.entrydate);
    error = chooseimages(e.images, ix, check.entrydate, entry.chosenimages);
    if (!error.isEmpty())
        return error;
    // Birth details as the birth details dialog gives them: only to individuals
    // with neither birth date nor birth place in the file.
    for (size_t k = 0; k < e.people.size(); ++k) {
        selectionrec& r = entry.selection[k];
        const personrec& person = ix.people[static_cast<size_t>(r.personindex)];
        if (!e.people[k].birthplace || person.hasbirthdate || person.hasbirthplace)
            continue;
        r.birthedited = true;
        r.birthdate = calculatedbirthdate(entry.entrydate, r.age, r.agetype);
        r.birthplace = e.people[k].birthplace->trimmed();
    }
    return QString();
}

} // namespace qm

#include "census/validateentry.h"

#include "model/dates.h"
#include "model/gedcomindex.h"
#include "platform/prompts.h"
#include "settings/settings.h"

#include <QSet>

#include <algorithm>

namespace qm {

namespace {

entrycheck fail(const QString& message, entryfield focus = entryfield::none)
{
    entrycheck c;
    c.message = message;
    c.focus = focus;
    return c;
}

QString who(const selectionrec& r)
{
    return r.name.isEmpty() ? QString::number(r.id) : r.name + QStringLiteral(" (") + QString::number(r.id) + u')';
}

} // namespace

QString noagemessage()
{
    return QStringLiteral("You must first enter an age for this individual");
}

entrycheck validateentry(const entryform& form, const settings& s, prompts* p)
{
    if (form.selection.empty())
        return fail(QStringLiteral("The census entry must refer to at least 1 person!"));
    if (form.place.trimmed().isEmpty())
        return fail(QStringLiteral("Location must be specified"), entryfield::place);
    if (form.fullentry) {
        if (form.title.trimmed().size() < 12)
            return fail(QStringLiteral("You must provide a full title for the entry"), entryfield::title);
    } else if (form.reference.trimmed().size() < 3) {
        return fail(QStringLiteral("You must enter the text for the 'Where within Source' entry"),
                    entryfield::wherewithinsource);
    }
    if (!form.fullentry && form.sourceid.trimmed().isEmpty())
        return fail(QStringLiteral("You must select a source from the drop-down list"));
    if (form.yeartext.trimmed().isEmpty())
        return fail(QStringLiteral("You must select a census year from the list"));

    const datecheck d = validdate(form.datetext, form.officialdate);
    if (!d.isdate)
        return fail(QStringLiteral("Invalid date - reselect the year from the list box above to reset to original value"),
                    entryfield::date);
    entrycheck c;
    c.entrydate = d.newtext.value_or(form.datetext);
    c.datechanged = d.newtext.has_value() && *d.newtext != form.datetext;
    if (c.entrydate.isEmpty())
        return fail(QStringLiteral("Census date not specified"));

    if (p && s.nosourcetextwarning && form.sourcetext.trimmed().size() < 3) {
        const message question{QStringLiteral("The Source Text hasn't been filled in. Are you sure you want to save this "
                                              "census record without entering this information?"),
                               QStringLiteral("Save census"), buttons::yesno, icon::question, answer::no};
        if (p->ask(question) != answer::yes) {
            c.focus = entryfield::sourcetext;
            return c;
        }
    }
    c.ok = true;
    return c;
}

QString checkhousehold(const std::vector<selectionrec>& selection)
{
    QSet<int32_t> seen;
    for (const selectionrec& r : selection) {
        if (r.personindex < 0)
            return QStringLiteral("There is no individual with the record number %1 in the family file").arg(r.id);
        if (seen.contains(r.id))
            return QStringLiteral("The individual %1 is in the census entry more than once").arg(who(r));
        seen.insert(r.id);
        const QString age = r.age.trimmed();
        if (age.isEmpty())
            return noagemessage() + QStringLiteral(": ") + who(r);
        if (age.size() > 3 || !std::all_of(age.begin(), age.end(), [](QChar c) { return c >= u'0' && c <= u'9'; }))
            return QStringLiteral("The age of %1 must be a number of at most 3 digits, not \"%2\"").arg(who(r), r.age);
        if (r.agetype != u'Y' && r.agetype != u'M' && r.agetype != u'D')
            return QStringLiteral("The age type of %1 must be Y (years), M (months) or D (days)").arg(who(r));
    }
    return QString();
}

int findcensussource(const gedcomindex& index, const QString& sourceid)
{
    bool ok = false;
    const int id = sourceid.trimmed().toInt(&ok);
    if (!ok)
        return -1;
    for (size_t i = 0; i < index.sources.size(); ++i)
        if (index.sources[i].id == id)
            return index.sources[i].iscensus ? static_cast<int>(i) : -1;
    return -1;
}

QString notcensussourcemessage(const QString& sourceid)
{
    return QStringLiteral("The source number %1 is not a census source of the family file").arg(sourceid);
}

censusentry entryfromform(const entryform& form, const QString& entrydate)
{
    censusentry e;
    e.sourceid = form.sourceid.trimmed();
    e.title = form.title;
    e.place = form.place;
    e.address = form.address;
    e.reference = form.reference.trimmed();
    e.sourcetext = form.sourcetext;
    e.notetext = form.notetext;
    e.other = form.other;
    e.entrydate = entrydate;
    e.year = form.yeartext.toInt();
    e.selection = form.selection;
    return e;
}

} // namespace qm

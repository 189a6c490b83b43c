#include "flags/flagcheck.h"

#include "model/loadgedcom.h"
#include "platform/encoding.h"

#include <QDir>

namespace qm {

namespace {

// "'NAME' flag to individual ..." (add) or "'NAME' flag from individual ...".
QString flagrow(const flagrec& f, const personrec& p, bool add)
{
    const QString linkword = add ? QStringLiteral("' flag to individual ") : QStringLiteral("' flag from individual ");
    return QStringLiteral("'") + qs(f.name) + linkword + qs(p.name) + QStringLiteral(" (ID: ") + QString::number(p.id) +
           QStringLiteral(")");
}

bool holds(const personrec& p, size_t flag)
{
    for (const int32_t f : p.flagids)
        if (f >= 0 && static_cast<size_t>(f) == flag)
            return true;
    return false;
}

// The first candidate of that country, or -1.
int candidateof(const flagtable& flags, const std::vector<size_t>& candidates, std::string_view country)
{
    for (size_t i = 0; i < candidates.size(); ++i)
        if (flags[candidates[i]].country == country)
            return static_cast<int>(i);
    return -1;
}

class checker {
public:
    // `learn` is the index whose places learn countries; null in silent mode.
    checker(const gedcomindex& index, gedcomindex* learn, const QString& country, const countryasker& ask)
        : x_(index), learn_(learn), interactive_(learn != nullptr), country_(country), ask_(ask)
    {
    }

    flagcheckresult run()
    {
        for (size_t k = 0; k < x_.people.size(); ++k) {
            ++r_.peoplechecked;
            if (!missing(static_cast<int32_t>(k)))
                return r_; // cancelled
            if (!interactive_ && r_.outofstep)
                return r_;
            superfluous(static_cast<int32_t>(k));
            if (!interactive_ && r_.outofstep)
                return r_;
        }
        return r_;
    }

private:
    // The missing flags of one individual. False when the check was cancelled.
    bool missing(int32_t k)
    {
        const personrec& p = x_.people[static_cast<size_t>(k)];
        const size_t firstofperson = r_.changes.size();
        std::vector<size_t> candidates;
        for (const censusrec& e : p.census) {
            candidates.clear();
            for (size_t f = 0; f < x_.flags.size(); ++f)
                if (eventmatchesflag(e.date, x_.flags[f]))
                    candidates.push_back(f);
            if (candidates.empty())
                continue;
            bool held = false;
            for (const size_t f : candidates)
                held = held || holds(p, f);
            if (held)
                continue;
            r_.outofstep = true;
            if (!interactive_)
                continue; // the rest of this individual's events, then stop
            size_t flag = candidates.front();
            if (candidates.size() > 1) {
                const int chosen = choose(k, e, candidates);
                if (chosen < 0) {
                    r_.cancelled = true;
                    r_.changes.clear();
                    r_.addrows.clear();
                    r_.removerows.clear();
                    return false;
                }
                flag = candidates[static_cast<size_t>(chosen)];
            }
            bool listed = false;
            for (size_t i = firstofperson; i < r_.changes.size() && !listed; ++i)
                listed = static_cast<size_t>(r_.changes[i].flag) == flag;
            if (listed)
                continue;
            r_.changes.push_back(flagchange{k, static_cast<int32_t>(flag), true});
            r_.addrows.push_back(flagrow(x_.flags[flag], p, true));
        }
        return true;
    }

    void superfluous(int32_t k)
    {
        const personrec& p = x_.people[static_cast<size_t>(k)];
        for (const int32_t f : p.flagids) {
            if (f < 0 || static_cast<size_t>(f) >= x_.flags.size())
                continue;
            const flagrec& flag = x_.flags[static_cast<size_t>(f)];
            if (flag.date.empty())
                continue;
            bool matched = false;
            for (const censusrec& e : p.census)
                matched = matched || eventmatchesflag(e.date, flag);
            if (matched)
                continue;
            r_.outofstep = true;
            if (!interactive_)
                return;
            r_.changes.push_back(flagchange{k, f, false});
            r_.removerows.push_back(flagrow(flag, p, false));
        }
    }

    // The candidate an event stands for: by its place's known country, else
    // by asking. -1 when the question was cancelled.
    int choose(int32_t k, const censusrec& e, const std::vector<size_t>& candidates)
    {
        const int at = e.place.empty() ? -1 : findplace(x_, e.place);
        if (at >= 0) {
            const std::string& known = x_.places[static_cast<size_t>(at)].country;
            // A country none of the candidates has is asked as for an unknown place.
            const int c = known.empty() ? -1 : candidateof(x_.flags, candidates, known);
            if (c >= 0)
                return c;
        }
        if (!ask_)
            return -1;
        countryquestion q;
        q.person = k;
        q.date = e.date;
        q.place = e.place;
        q.candidates = candidates;
        for (const size_t f : candidates)
            q.countries.push_back(qs(x_.flags[f].country));
        q.preselected = static_cast<int>(q.countries.indexOf(country_));
        const countrychoice a = ask_(q);
        if (a.chosen < 0 || a.chosen >= static_cast<int>(candidates.size()))
            return -1;
        if (a.always && at >= 0)
            learn_->places[static_cast<size_t>(at)].country = x_.flags[candidates[static_cast<size_t>(a.chosen)]].country;
        return a.chosen;
    }

    const gedcomindex& x_;
    gedcomindex* learn_;
    bool interactive_;
    QString country_;
    countryasker ask_;
    flagcheckresult r_;
};

} // namespace

bool eventmatchesflag(std::string_view eventdate, const flagrec& flag)
{
    if (flag.date.empty())
        return false;
    if (flag.date == eventdate)
        return true;
    return flag.date.size() == 4 && eventdate.find(flag.date) != std::string_view::npos;
}

QStringList flagcheckresult::addlist() const
{
    if (addrows.isEmpty())
        return {QStringLiteral("(There are no individuals with missing census flags)")};
    return addrows;
}

QStringList flagcheckresult::removelist() const
{
    if (removerows.isEmpty())
        return {QStringLiteral("(There are no individuals with census flags that need to be removed)")};
    return removerows;
}

flagcheckresult checkflags(gedcomindex& index, bool interactive, const QString& country, const countryasker& ask)
{
    return checker(index, interactive ? &index : nullptr, country, ask).run();
}

bool flagsoutofstep(const gedcomindex& index)
{
    return checker(index, nullptr, QString(), {}).run().outofstep;
}

QString flagcheckcancelledmessage()
{
    return QStringLiteral("Flag check was cancelled. The flags in the file have not been changed.");
}

QString flagsoutofsyncmessage()
{
    return QStringLiteral("The census flags in your file are out of sync with the census entries. The Flagcheck "
                          "form will now be displayed so that you can make changes if required.");
}

QString flagsfilechangedmessage(const QString& path)
{
    return QDir::toNativeSeparators(path) + QStringLiteral(" has been modified by another application. Flags will not be changed as a "
                                 "precaution to ensure there is no data loss. This form will now close and the "
                                 "file will be reloaded.");
}

QString flagchangesquestion()
{
    return QStringLiteral("Are you sure you want to set/unset flags as suggested?");
}

QString flagsaddheading()
{
    return QStringLiteral("Flags that need to be added to individuals:");
}

QString flagsremoveheading()
{
    return QStringLiteral("Flags that need to be removed from individuals:");
}

} // namespace qm

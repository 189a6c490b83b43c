#include "census/selection.h"

#include "model/labelorder.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"

#include <algorithm>

namespace qm {

namespace {
rowvalues rowof(const selectionrec& s)
{
    rowvalues r;
    r.name = s.name;
    r.id = QString::number(s.id);
    r.age = s.age;
    r.agetype = s.agetype.isNull() ? QString() : QString(s.agetype);
    r.occupation = s.occupation;
    r.chosen = QString::number(s.personindex);
    return r;
}
} // namespace

int householdrows::checkages() const
{
    for (int r = 0; r < visible && r < selectioncount - toprow; ++r) {
        if (rows[static_cast<size_t>(r)].age.trimmed().isEmpty())
            return r;
    }
    return -1;
}

void householdrows::storerows()
{
    if (selectioncount < 1)
        return;
    selection.resize(static_cast<size_t>(selectioncount));
    const int last = std::min(toprow + visible - 1, selectioncount - 1);
    for (int i = toprow; i <= last; ++i) {
        const rowvalues& r = rows[static_cast<size_t>(i - toprow)];
        selectionrec& s = selection[static_cast<size_t>(i)];
        s.id = r.id.toInt();
        s.name = r.name;
        s.age = r.age.trimmed();
        // An emptied unit box means years, the unit an age has without one.
        const QString unit = r.agetype.trimmed();
        s.agetype = unit.isEmpty() ? QChar(u'Y') : unit.front();
        s.occupation = r.occupation.trimmed();
        s.personindex = r.chosen.toInt();
    }
}

void householdrows::clearrow(int r)
{
    rows[static_cast<size_t>(r)] = rowvalues{};
}

void householdrows::showrows(int t)
{
    for (int r = 0; r < visible; ++r) {
        if (t + r >= selectioncount)
            clearrow(r);
        else
            rows[static_cast<size_t>(r)] = rowof(selection[static_cast<size_t>(t + r)]);
    }
}

bool householdrows::has(int32_t id) const
{
    for (int i = 0; i < selectioncount && i < static_cast<int>(selection.size()); ++i) {
        if (selection[static_cast<size_t>(i)].id == id)
            return true;
    }
    return false;
}

int householdrows::add(const personrec& person, int32_t index)
{
    if (selectioncount - toprow > visible - 1) {
        toprow = selectioncount - (visible - 1);
        showrows(toprow);
    }
    const int r = selectioncount - toprow;
    rowvalues& row = rows[static_cast<size_t>(r)];
    row = rowvalues{};
    row.name = qs(person.name);
    row.id = QString::number(person.id);
    row.chosen = QString::number(index);
    ++selectioncount;
    // Keep selection as long as the rows, so that a delete before the next
    // store has entries to move.
    if (static_cast<int>(selection.size()) < selectioncount)
        selection.resize(static_cast<size_t>(selectioncount));
    selectionrec& s = selection[static_cast<size_t>(selectioncount - 1)];
    s = selectionrec{};
    s.id = person.id;
    s.name = row.name;
    s.personindex = index;
    return r;
}

void householdrows::scrollup()
{
    if (toprow < 1)
        return;
    --toprow;
    showrows(toprow);
}

void householdrows::scrolldown()
{
    if (!downshown())
        return;
    ++toprow;
    showrows(toprow);
}

int householdrows::deleterow(int r)
{
    if (r < 0 || r >= rowsused())
        return -1;
    if (selectioncount < 2) {
        clear();
        return -1;
    }
    const int i = toprow + r;
    if (selectioncount > toprow + visible || toprow == 0) {
        for (int k = r; k < visible - 1; ++k) {
            const rowvalues& below = rows[static_cast<size_t>(k + 1)];
            if (below.id.isEmpty())
                clearrow(k);
            else
                rows[static_cast<size_t>(k)] = below;
        }
        if (downshown())
            rows[visible - 1] = rowof(selection[static_cast<size_t>(toprow + visible)]);
        else
            clearrow(visible - 1);
        --selectioncount;
    } else {
        for (int k = r; k > 0; --k)
            rows[static_cast<size_t>(k)] = rows[static_cast<size_t>(k - 1)];
        --toprow;
        --selectioncount;
        rows[0] = rowof(selection[static_cast<size_t>(toprow)]);
    }
    // The entries after the deleted one move down; the table is trimmed to
    // selectioncount by the next storerows.
    if (i < static_cast<int>(selection.size()))
        selection.erase(selection.begin() + i);
    selection.resize(static_cast<size_t>(std::max(selectioncount, static_cast<int>(selection.size()))));
    const int last = rowsused() - 1;
    return rows[static_cast<size_t>(last)].chosen.toInt();
}

void householdrows::clear()
{
    selection.clear();
    selectioncount = 0;
    toprow = 0;
    for (int r = 0; r < visible; ++r)
        clearrow(r);
}

std::vector<listentry> immediatefamily(const gedcomindex& index, int32_t k, bool idonly)
{
    std::vector<listentry> out;
    if (k < 0 || static_cast<size_t>(k) >= index.people.size())
        return out;
    const personrec& of = index.people[static_cast<size_t>(k)];
    const auto add = [&](const char* kind, const personrec& p, int32_t j) {
        out.push_back({QString::fromLatin1(kind) + personlabel(p, idonly), j});
    };
    for (size_t jj = 0; jj < index.people.size(); ++jj) {
        const int32_t j = static_cast<int32_t>(jj);
        if (j == k)
            continue;
        const personrec& p = index.people[jj];
        if (p.famc != 0 && p.famc == of.famc) {
            add("SIB ", p, j);
            continue;
        }
        bool wed = false;
        for (int32_t a : p.fams) {
            for (int32_t b : of.fams) {
                if (a == b && a != 0) {
                    add("WED ", p, j);
                    wed = true;
                }
            }
        }
        bool child = false;
        if (!wed && p.famc != 0) {
            for (int32_t b : of.fams) {
                if (b == p.famc) {
                    add("CHI ", p, j);
                    child = true;
                }
            }
        }
        if (!wed && !child && of.famc != 0) {
            for (int32_t a : p.fams) {
                if (a == of.famc)
                    add("PAR ", p, j);
            }
        }
    }
    std::vector<listentry> sorted;
    sorted.reserve(out.size());
    for (size_t i : labelorder(out.size(), [&out](size_t i) { return out[i].text; }))
        sorted.push_back(std::move(out[i]));
    return sorted;
}

alivelist couldbealive(const gedcomindex& index, const QDate& censusday, dateorder order, int cap)
{
    alivelist out;
    const int upper = censusday.year() + 5;
    const int lower = censusday.year() - 5;
    const std::optional<QDate> census(censusday);
    QString text;
    for (size_t k = 0; k < index.people.size(); ++k) {
        const personrec& p = index.people[k];
        int born = -9999;
        if (p.hasbirthdate) {
            text = qs(p.birthdate);
            const datephraseyears d = dateyears(text, census, order);
            born = d.agecomputed ? d.earliestyear : -9999;
        }
        if (born > upper)
            continue;
        if (born != -9999 && born + 130 <= lower)
            continue;
        int died = 9999;
        if (p.hasdeathdate) {
            text = qs(p.deathdate);
            const datephraseyears d = dateyears(text, census, order);
            if (d.agecomputed)
                died = d.latestyear;
        }
        if (died < lower)
            continue;
        out.people.push_back(static_cast<int32_t>(k));
        if (static_cast<int>(out.people.size()) > cap) {
            out.toomany = true;
            break;
        }
    }
    return out;
}

std::vector<int32_t> sortbylabel(const gedcomindex& index, std::vector<int32_t> positions, bool idonly)
{
    std::vector<int32_t> out;
    out.reserve(positions.size());
    for (size_t i : labelorder(positions.size(), [&](size_t i) {
             return personlabel(index.people[static_cast<size_t>(positions[i])], idonly);
         }))
        out.push_back(positions[i]);
    return out;
}

} // namespace qm

#include "census/autotext.h"

#include <algorithm>
#include <array>

namespace qm {

namespace {

enum cell { name = 1, surname, age, occupation, birthplace, related, condition };

struct record {
    std::array<QString, 8> cells; // 1..7 used
    QString& operator[](int c) { return cells[static_cast<size_t>(c)]; }
};

enum class marital { none, married, single, widowed };

QString conditionword(marital m, censuskind kind)
{
    const bool late = kind == censuskind::uklate;
    switch (m) {
    case marital::married:
        return late ? QStringLiteral("M") : QStringLiteral("Mar");
    case marital::single:
        return late ? QStringLiteral("S") : QStringLiteral("Unm");
    case marital::widowed:
        return late ? QStringLiteral("W") : QStringLiteral("Wid");
    case marital::none:
        break;
    }
    return QString();
}

const personrec* personof(const selectionrec& row, const gedcomindex& index)
{
    if (row.personindex < 0 || static_cast<size_t>(row.personindex) >= index.people.size())
        return nullptr;
    return &index.people[static_cast<size_t>(row.personindex)];
}

bool isspouseof(const indexlist<int32_t>& fams, int32_t family)
{
    return family != 0 && std::find(fams.begin(), fams.end(), family) != fams.end();
}

bool female(const personrec& p)
{
    return p.sex == "F";
}

} // namespace

std::optional<autotextproblem> checkautotextdate(const QString& censusdate, dateorder order)
{
    if (censusdate.isEmpty())
        return autotextproblem{
            QStringLiteral("Before using the Auto-text function, you must first choose a date for the census"),
            false};
    if (!recognisedate(censusdate, order))
        return autotextproblem{QStringLiteral("You have not selected a valid date for the census - reselect the "
                                              "year from the list box above to reset to original value"),
                               true};
    return std::nullopt;
}

censuskind autotextkind(const QString& country, const QString& censusdate, dateorder order)
{
    if (country != QLatin1String("UK"))
        return censuskind::other;
    const std::optional<QDate> day = recognisedate(censusdate, order);
    if (!day)
        return censuskind::other;
    if (*day == QDate(1841, 6, 6))
        return censuskind::uk1841;
    if (*day == QDate(1901, 3, 31) || *day == QDate(1891, 4, 5))
        return censuskind::uklate;
    return censuskind::other;
}

QString idmismatchmessage()
{
    return QStringLiteral("ID doesn't match - something wrong here. Please contact Quillmark author - see help "
                          "file for details");
}

birthcheck checkbirth(const selectionrec& row, const gedcomindex& index)
{
    const personrec* p = personof(row, index);
    if (!p || p->id != row.id)
        return birthcheck::idmismatch;
    if (!p->hasbirthdate && !p->hasbirthplace && !p->birthedited && !row.birthedited)
        return birthcheck::ask;
    return birthcheck::none;
}

QString autotext(const std::vector<selectionrec>& rows, const gedcomindex& index, const QString& censusdate,
                 const QString& country, const settings& s, dateorder order)
{
    const censuskind kind = autotextkind(country, censusdate, order);
    const bool conditioncolumn = s.marriagecondition && kind != censuskind::uk1841;
    const personrec nobody;
    const personrec* head = rows.empty() ? &nobody : personof(rows.front(), index);
    if (!head)
        head = &nobody;

    std::vector<record> records(rows.size());
    for (size_t i = 0; i < rows.size(); ++i) {
        const selectionrec& row = rows[i];
        const personrec* found = personof(row, index);
        const personrec& p = found ? *found : nobody;
        record& r = records[i];

        const qsizetype comma = row.name.indexOf(QLatin1String(", "));
        if (comma >= 0) {
            r[surname] = row.name.left(comma);
            r[name] = row.name.mid(comma + 2);
        }

        bool numeric = false;
        const int years = row.age.toInt(&numeric);
        r[age] = row.age;
        if (row.agetype == u'M')
            r[age] += QLatin1String(" mths");
        else if (row.agetype == u'D')
            r[age] += QLatin1String(" days");

        r[occupation] = row.occupation;
        if (row.occupation.isEmpty() && !s.occscholar && row.agetype == u'Y' && years > 3 && years < 16)
            r[occupation] = QStringLiteral("Scholar");

        r[birthplace] = row.birthedited ? row.birthplace : qs(p.birthplace);

        marital m = marital::none;
        if (i == 0) {
            r[related] = QStringLiteral("Head");
            m = row.agetype == u'Y' && years > 20 ? marital::married : marital::single;
        } else if (std::any_of(p.fams.begin(), p.fams.end(),
                               [&](int32_t f) { return isspouseof(head->fams, f); })) {
            if (female(p)) {
                r[surname] = records[0][surname];
                r[related] = QStringLiteral("Wife");
            } else {
                r[related] = QStringLiteral("Husb");
                records[0][surname] = r[surname];
            }
            m = marital::married;
        } else if (isspouseof(head->fams, p.famc)) {
            r[related] = female(p) ? QStringLiteral("Dau") : QStringLiteral("Son");
            m = marital::single;
        } else if (p.famc != 0 && p.famc == head->famc) {
            r[related] = female(p) ? QStringLiteral("Sis") : QStringLiteral("Bro");
            m = marital::single;
        } else if (isspouseof(p.fams, head->famc)) {
            if (female(p)) {
                r[surname] = records[0][surname];
                r[related] = QStringLiteral("Mother");
            } else {
                r[related] = QStringLiteral("Father");
            }
            m = marital::widowed;
        }
        if (conditioncolumn)
            r[condition] = conditionword(m, kind);

        r[name] = (r[name] + QLatin1Char(' ') + r[surname]).trimmed();
    }

    record heading;
    heading[name] = QStringLiteral("Name");
    heading[age] = QStringLiteral("Age");
    heading[occupation] = QStringLiteral("Occupation");
    heading[birthplace] = QStringLiteral("Birth Place");
    heading[related] = QStringLiteral("Related");
    heading[condition] = QStringLiteral("Cond");

    // A separator setting left empty would run the columns together.
    const QString separator = s.alternateseparator && !s.alternateseparatorcharacter.isEmpty()
                                  ? s.alternateseparatorcharacter.left(1)
                                  : QStringLiteral("\t");
    auto line = [&](record& r, bool isheading) {
        for (int c : {name, age, occupation, related, condition})
            r[c] += separator;
        if (kind == censuskind::uk1841)
            return r[name] + r[age] + r[occupation] + (isheading ? QStringLiteral("Where Born") : QString());
        if (conditioncolumn)
            return r[name] + r[related] + r[condition] + r[age] + r[occupation] + r[birthplace];
        return r[name] + r[related] + r[age] + r[occupation] + r[birthplace];
    };

    const QString crlf = QStringLiteral("\r\n");
    QString text = line(heading, true) + crlf;
    for (record& r : records)
        text += line(r, false) + crlf;
    return text;
}

} // namespace qm

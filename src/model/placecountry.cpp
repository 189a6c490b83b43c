#include "model/placecountry.h"

#include "model/loadgedcom.h"
#include "platform/encoding.h"

#include <QHash>

namespace qm {

namespace {

// The names, case-folded, by country.
const QHash<QString, countrycode>& countrynames()
{
    static const QHash<QString, countrycode> names = [] {
        QHash<QString, countrycode> h;
        const auto add = [&h](countrycode c, std::initializer_list<const char*> list) {
            for (const char* n : list)
                h.insert(QString::fromUtf8(n).toCaseFolded(), c);
        };
        add(countrycode::uk, {"England", "Wales", "Scotland", "Isle of Man", "Channel Islands", "Jersey", "Guernsey",
                              "Alderney", "Sark", "UK", "U.K.", "United Kingdom", "Great Britain", "Britain", "GB"});
        add(countrycode::usa,
            {"United States", "United States of America", "USA", "U.S.A.", "US", "U.S.", "America",
             "Alabama", "Alaska", "Arizona", "Arkansas", "California", "Colorado", "Connecticut", "Delaware",
             "District of Columbia", "Florida", "Georgia", "Hawaii", "Idaho", "Illinois", "Indiana", "Iowa",
             "Kansas", "Kentucky", "Louisiana", "Maine", "Maryland", "Massachusetts", "Michigan", "Minnesota",
             "Mississippi", "Missouri", "Montana", "Nebraska", "Nevada", "New Hampshire", "New Jersey",
             "New Mexico", "New York", "North Carolina", "North Dakota", "Ohio", "Oklahoma", "Oregon",
             "Pennsylvania", "Rhode Island", "South Carolina", "South Dakota", "Tennessee", "Texas", "Utah",
             "Vermont", "Virginia", "Washington", "West Virginia", "Wisconsin", "Wyoming",
             // Two-letter codes; CA, DE and IN also name Canada, Germany and India.
             "AL", "AK", "AZ", "AR", "CO", "CT", "DC", "FL", "GA", "HI", "ID", "IL", "IA", "KS", "KY", "LA", "ME",
             "MD", "MA", "MI", "MN", "MS", "MO", "MT", "NE", "NV", "NH", "NJ", "NM", "NY", "NC", "ND", "OH", "OK",
             "OR", "PA", "RI", "SC", "SD", "TN", "TX", "UT", "VT", "VA", "WA", "WV", "WI", "WY"});
        add(countrycode::ireland,
            {"Ireland", "Éire", "Eire", "Northern Ireland", "Antrim", "Armagh", "Carlow", "Cavan", "Clare", "Cork",
             "Donegal", "Down", "Dublin", "Fermanagh", "Galway", "Kerry", "Kildare", "Kilkenny", "Laois", "Leitrim",
             "Limerick", "Londonderry", "Derry", "Longford", "Louth", "Mayo", "Meath", "Monaghan", "Offaly",
             "Roscommon", "Sligo", "Tipperary", "Tyrone", "Waterford", "Westmeath", "Wexford", "Wicklow",
             "King's County", "Kings County", "Queen's County", "Queens County"});
        add(countrycode::canada,
            {"Canada", "Ontario", "Quebec", "Québec", "Nova Scotia", "New Brunswick", "Manitoba", "British Columbia",
             "Prince Edward Island", "Saskatchewan", "Alberta", "Yukon", "Northwest Territories", "Nunavut",
             "Upper Canada", "Lower Canada", "Canada West", "Canada East", "ON", "QC", "PQ", "NS", "NB", "MB", "BC",
             "PE", "PEI", "SK", "AB", "YT", "NT", "NU"});
        add(countrycode::other,
            {"Australia", "New South Wales", "Queensland", "South Australia", "Western Australia", "Tasmania",
             "Van Diemen's Land", "New Zealand", "South Africa", "Cape Colony", "Natal", "India", "Newfoundland",
             "Jamaica", "Bermuda", "Germany", "Prussia", "France", "Belgium", "Netherlands", "Holland", "Denmark",
             "Norway", "Sweden", "Switzerland", "Austria", "Italy", "Spain", "Portugal", "Poland", "Russia",
             "Mexico", "Argentina"});
        return h;
    }();
    return names;
}

std::string_view trimmed(std::string_view s)
{
    while (!s.empty() && (s.front() == ' ' || s.front() == '\t'))
        s.remove_prefix(1);
    while (!s.empty() && (s.back() == ' ' || s.back() == '\t'))
        s.remove_suffix(1);
    return s;
}

} // namespace

QString countryname(countrycode c)
{
    switch (c) {
    case countrycode::uk:
        return QStringLiteral("UK");
    case countrycode::usa:
        return QStringLiteral("USA");
    case countrycode::ireland:
        return QStringLiteral("Ireland");
    case countrycode::canada:
        return QStringLiteral("Canada");
    case countrycode::unknown:
    case countrycode::other:
        break;
    }
    return QString();
}

countrycode countryofname(const QString& country)
{
    for (countrycode c : {countrycode::uk, countrycode::usa, countrycode::ireland, countrycode::canada})
        if (country == countryname(c))
            return c;
    return countrycode::unknown;
}

countrycode countryofplacename(std::string_view place)
{
    const size_t comma = place.rfind(',');
    const std::string_view last = trimmed(comma == std::string_view::npos ? place : place.substr(comma + 1));
    if (last.empty())
        return countrycode::unknown;
    QString key = qs(last).toCaseFolded();
    const QHash<QString, countrycode>& names = countrynames();
    if (const auto it = names.constFind(key); it != names.cend())
        return it.value();
    // "Co. Cork", "County Cork".
    for (const QLatin1StringView county : {QLatin1StringView("county "), QLatin1StringView("co. "),
                                           QLatin1StringView("co ")}) {
        if (key.startsWith(county)) {
            const auto it = names.constFind(key.sliced(county.size()).trimmed());
            if (it != names.cend() && it.value() == countrycode::ireland)
                return countrycode::ireland;
        }
    }
    return countrycode::unknown;
}

countrycode placecountry(const gedcomindex& index, std::string_view place)
{
    if (const int at = place.empty() ? -1 : findplace(index, place); at >= 0) {
        const countrycode learnt = countryofname(qs(index.places[static_cast<size_t>(at)].country));
        if (learnt != countrycode::unknown)
            return learnt;
    }
    return countryofplacename(place);
}

} // namespace qm

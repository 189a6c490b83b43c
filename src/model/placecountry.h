#pragma once
// The country of a place, as far as its name tells: read from the last
// comma-separated part of the name ("Leeds, Yorkshire, England" -> UK),
// trimmed, in any letter case, through a short list of names:
//
//   UK       England, Wales, Scotland, Isle of Man, Channel Islands, Jersey,
//            Guernsey, Alderney, Sark, UK, U.K., United Kingdom, Great Britain,
//            Britain, GB
//   USA      United States, United States of America, USA, U.S.A., US, U.S.,
//            America, the 50 states and the District of Columbia by name, and
//            their two-letter codes except CA (California or Canada), DE
//            (Delaware or Germany) and IN (Indiana or India)
//   Ireland  Ireland, Éire, Eire, Northern Ireland (the censuses of Ireland
//            1901 and 1911 cover the whole island) and its 32 counties, with
//            or without "Co.", "Co" or "County" in front ("Co. Cork"), and
//            King's County and Queen's County, their old names
//   Canada   Canada, its provinces and territories by name (Upper and Lower
//            Canada, Canada West and East included) and their codes ON, QC, PQ,
//            NS, NB, MB, BC, PE, PEI, SK, AB, YT, NT, NU
//   other    countries outside the four that families of the four often went
//            to or came from: Australia and its colonies (New South Wales,
//            Queensland, South Australia, Western Australia, Tasmania, Van
//            Diemen's Land), New Zealand, South Africa, Cape Colony, Natal,
//            India, Newfoundland (not part of Canada in any census of the
//            table), Jamaica, Bermuda, Germany, Prussia, France, Belgium,
//            Netherlands, Holland, Denmark, Norway, Sweden, Switzerland,
//            Austria, Italy, Spain, Portugal, Poland, Russia, Mexico, Argentina
//
// Any other name, or an empty one, tells no country. The flag check may learn
// a place's country from the user; that country wins over the name.

#include <QString>

#include <cstdint>
#include <string_view>

namespace qm {

struct gedcomindex;

enum class countrycode : int8_t { unknown = -1, uk = 0, usa = 1, ireland = 2, canada = 3, other = 4 };

// The census country of a code ("UK", "USA", "Ireland", "Canada", as
// flagcountries() spells them), "" for unknown and other.
QString countryname(countrycode c);
// The code of a census country spelt as flagcountries() does; unknown otherwise.
countrycode countryofname(const QString& country);

// The country the (UTF-8) name of a place tells.
countrycode countryofplacename(std::string_view place);

// The country of a place of the index: the one learnt for its group (the
// flag check's "Assume all census records for this place are in the selected
// country."), else the one its name tells.
countrycode placecountry(const gedcomindex& index, std::string_view place);

} // namespace qm

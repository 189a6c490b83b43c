#pragma once
// The national censuses Quillmark knows: country, year, official census day
// and (for the United Kingdom) the archive reference prefix of its pages.
// The table is fixed; other code walks it from the first row and takes the
// first match, so the order of the rows matters.

#include <QString>
#include <QStringList>

#include <cstdint>
#include <vector>

namespace qm {

struct censusdef {
    QString country;   // "UK", "USA", "Ireland" or "Canada"
    int16_t year = 0;
    QString date;      // official census day as a GEDCOM date, "3 APR 1881"
    QString refprefix; // archive reference prefix, "RG11/"; empty where none is known
};

// The 33 censuses in their fixed order (row 1 of the table at position 0).
const std::vector<censusdef>& censustable();

// Year texts of the country's censuses in table order, for the year list.
QStringList fillyears(const QString& country);
// Caption of the year label: "UK Census Year:".
QString censusyearcaption(const QString& country);

// Position in censustable() of the first census of that country and year,
// or -1.
int findcensusrow(const QString& country, int year);
const censusdef* lookupcensus(const QString& country, int year);

// "Serious Error - the year and country chosen are not supported by ..."
QString seriouscensuserror();

// What the entry form reads when a census year is chosen.
struct censuschoice {
    QString yeartext;      // text of the year list
    QString country;       // setting "Country"
    bool autoreference = false; // setting "Auto Reference"
    bool fullentry = true;      // setting "Full Entry": decides the reference field
    QString referencetext; // text of the reference field
    QString lastrefprefix; // the prefix the form last filled in; empty at start
};

struct censusfound {
    QString date;  // official census day for the date box; empty when none
    QString error; // message to show when the year and country match no census
    // With "Auto Reference", when the reference field is empty or still holds
    // the prefix last filled in: its new text and where the cursor goes.
    bool setreference = false;
    QString referencetext;
    int cursor = 0;
    QString lastrefprefix; // the form's lastrefprefix after the choice
};

censusfound findcensus(const censuschoice& choice);

} // namespace qm

#pragma once
// The household of the census entry being typed: the individuals chosen, the
// ten visible census rows that show them, and the lists the individuals are
// chosen from (who could be alive at the census, the immediate family).
//
// The visible rows are held here as plain values (`rows`); the window copies
// them to and from its controls around each operation. As in the form, a row
// typed into since the last `storerows` exists only in `rows`: every reader of
// `selection` calls `checkages` and `storerows` first.

#include "model/dates.h"
#include "model/gedcomindex.h"
#include "writer/censusentry.h"

#include <QString>

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

namespace qm {

// The contents of one visible census row.
struct rowvalues {
    QString name;    // namelab
    QString id;      // idlab: record number
    QString age;     // agetxt
    QString agetype = QStringLiteral("Y"); // agetypetxt
    QString occupation; // occtxt
    QString chosen;  // chosenlab: position in people

    // The delete button and information picture are shown on rows in use.
    bool shown() const { return !id.isEmpty(); }
};

class householdrows {
public:
    static constexpr int visible = 10;

    std::vector<selectionrec> selection; // complete only after storerows
    int selectioncount = 0;
    int toprow = 0; // index in selection of visible row 0
    std::array<rowvalues, visible> rows;

    bool upshown() const { return toprow >= 1; }
    bool downshown() const { return selectioncount > toprow + visible; }
    // Rows counted from the window that the key filters treat as in use.
    bool rowinuse(int r) const { return selectioncount > r; }
    // Visible rows holding an individual.
    int rowsused() const { return std::min(visible, selectioncount - toprow); }

    // The first visible row in use whose age is empty, or -1.
    int checkages() const;
    void storerows();
    void showrows(int t);
    void clearrow(int r);
    // After storerows: whether the individual with this record number is chosen.
    bool has(int32_t id) const;
    // Adds people[index] as a new row, scrolling when the ten rows are full.
    // Returns the visible row it went into.
    int add(const personrec& person, int32_t index);
    void scrollup();   // caller has run checkages and storerows
    void scrolldown(); // likewise
    // Removes the individual of visible row r. Returns the position in people
    // of the individual now shown last, or -1 when the entry is empty.
    int deleterow(int r);
    void clear();
};

// One entry of a list of individuals: its text and the individual's position.
struct listentry {
    QString text;
    int32_t person = -1;
};

// The immediate family of people[k]: "SIB ", "WED ", "CHI " and "PAR " +
// personlabel, in label order (model/labelorder.h).
std::vector<listentry> immediatefamily(const gedcomindex& index, int32_t k, bool idonly);

// Individuals who could be alive at a census of the given day: positions in
// people, in people order. Stops once it holds more than `cap` entries.
struct alivelist {
    std::vector<int32_t> people;
    bool toomany = false; // more than cap candidates: only cap + 1 are held
};
alivelist couldbealive(const gedcomindex& index, const QDate& censusday, dateorder order, int cap = 32000);

// The individuals at these positions in label order (personlabel; see
// model/labelorder.h); equal labels keep their order.
std::vector<int32_t> sortbylabel(const gedcomindex& index, std::vector<int32_t> positions, bool idonly);

} // namespace qm

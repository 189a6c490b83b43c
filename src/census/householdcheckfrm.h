#pragma once
// The household check's findings, shown before a census entry is saved: one
// line per finding with the row it concerns, "Save anyway" to go on with the
// save and "Go back" (the default, and Escape) to return to the form at the
// row of the finding chosen.

#include "census/householdcheck.h"

#include <QDialog>

#include <optional>
#include <vector>

class QTreeWidget;

namespace qm {

class householdcheckfrm : public QDialog {
    Q_OBJECT
public:
    householdcheckfrm(const std::vector<householdfinding>& findings, QWidget* parent = nullptr);

    // The row (position in the entry's selection) of the finding chosen in
    // the list, the first finding's when none is.
    int chosenrow() const;

    // Shows the findings modally when there are any. Nothing when there are
    // none or "Save anyway" was pressed; the row to go back to after "Go back".
    static std::optional<int> ask(const std::vector<householdfinding>& findings, QWidget* parent);

private:
    const std::vector<householdfinding>& findings_;
    QTreeWidget* findingslst_;
};

} // namespace qm

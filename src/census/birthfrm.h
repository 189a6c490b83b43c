#pragma once
// Birth Details: offered for an individual of the entry who has no birth date,
// birth place or birth details yet. Shows the birth date calculated from the
// census date and age, asks for the birth place (with place completion), and
// on "Create Birth Event" gives both back for the row's calculated birth event.

#include "model/gedcomindex.h"
#include "writer/censusentry.h"

#include <QDialog>
#include <QString>

#include <functional>
#include <optional>
#include <vector>

class QLabel;
class QLineEdit;
class QPushButton;

namespace qm {

class prompts;

// What "Create Birth Event" gives back. The caller stores it in the row
// (applyto) and adds a non-empty place to the index's places (insertplace), so
// that later completions offer it.
struct birthdetails {
    QString birthdate;  // the calculated date as shown: "1806", "SEP 1850", "13 FEB 1851"
    QString birthplace; // trimmed; may be empty when the user confirmed that

    void applyto(selectionrec& row) const
    {
        row.birthedited = true;
        row.birthdate = birthdate;
        row.birthplace = birthplace;
    }
};

class birthfrm : public QDialog {
    Q_OBJECT
public:
    // `places` is the index's place table, used for completion; it must
    // outlive the dialog. `entrydate` is the census date of the entry.
    birthfrm(const selectionrec& row, const QString& entrydate, const std::vector<placerec>& places,
             prompts& asker, QWidget* parent = nullptr);

    // Set once the dialog was accepted with "Create Birth Event".
    const std::optional<birthdetails>& details() const { return details_; }

    // Shows the dialog modally; the details after "Create Birth Event", nothing
    // after "Do Not Create Birth Event" (the individual is asked again next
    // time). `help`, when given, is run by the Help button.
    static std::optional<birthdetails> ask(const selectionrec& row, const QString& entrydate,
                                           const std::vector<placerec>& places, prompts& asker,
                                           QWidget* parent, std::function<void()> help = {});

signals:
    // The Help button was pressed: the main window shows the dialog's help page.
    void helprequested();

private:
    void create();

    prompts& asker_;
    QLabel* doblab_;
    QLineEdit* birthplacetxt_;
    std::optional<birthdetails> details_;
};

} // namespace qm

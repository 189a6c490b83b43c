#pragma once
// Census Date Check: the distinct dates of the file's census events in three
// lists (the chosen country's census days, other countries' census days,
// unrecognised dates with the census proposed for each), the user's edits of
// the proposals, the individuals or places of a date, and "Make Suggested
// Changes", which rewrites the file through the save road.

#include "tools/datecheck.h"

#include <QDialog>

#include <array>
#include <vector>

class QComboBox;
class QGroupBox;
class QLabel;
class QListView;
class QListWidget;
class QPushButton;
class QRadioButton;
class QStringListModel;

namespace qm {

class prompts;
struct gedcomindex;
struct settings;

class Datecheckfrm : public QDialog {
    Q_OBJECT
public:
    // The index and settings must outlive the dialog.
    Datecheckfrm(prompts& p, const gedcomindex& index, const settings& s, QWidget* parent = nullptr);

    // The family file was rewritten, or found changed by another program: the
    // main window reads it again.
    bool reloadneeded() const { return reloadneeded_; }
    // The rewrite failed (its message has been shown): the program ends.
    bool fatal() const { return fatal_; }

private:
    void build();
    void countrychosen(int option);
    void filllists();
    void listselected(QListWidget* list);
    void showdetails();
    void suggestchosen(int option);
    void okclicked();
    void makechanges();
    int checkedsuggestion() const;

    prompts& prompts_;
    const gedcomindex& index_;
    const settings& settings_;
    datecheckstate state_;
    int selected_ = -1; // entry of the changes selected in one of the lists
    bool filling_ = false;
    bool reloadneeded_ = false;
    bool fatal_ = false;
    std::vector<detailentry> details_;

    std::array<QRadioButton*, 4> countryopt_{};
    QListWidget* changelst_ = nullptr;
    QListWidget* currentlst_ = nullptr;
    QListWidget* countrylst_ = nullptr;
    QLabel* currentcountrylab_ = nullptr;
    QLabel* countrylab_ = nullptr;
    QPushButton* changebut_ = nullptr;
    QPushButton* exitbut_ = nullptr;
    QGroupBox* suggestionframe_ = nullptr;
    QLabel* datelab_ = nullptr;
    std::array<QRadioButton*, 3> suggestopt_{};
    QComboBox* suggestcombo_ = nullptr;
    QPushButton* OKbut_ = nullptr;
    QPushButton* cancelbut_ = nullptr;
    QGroupBox* detailsframe_ = nullptr;
    std::array<QRadioButton*, 2> peopleopt_{};
    QListView* peoplelst_ = nullptr;
    QStringListModel* peoplemodel_ = nullptr;
};

} // namespace qm

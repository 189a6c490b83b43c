#pragma once
// The household of the census entry being typed: the people and family lists
// the individuals are chosen from, the census rows that show them, the
// information line about the individual chosen last, and the Find button.
//
// Inputs: the open family file (its index; the household refills its lists
// after every read of the file), the prompts, the entry form (its census date
// and year, which decide who could be alive and the ages shown) and the
// parent widget its controls are made in; the window lays them out. The Find
// dialog is the caller's (`find`), and so is the look at the family file
// after it (filecheck()): a file gone or changed is the program's business.

#include "census/selection.h"

#include <QObject>

#include <cstdint>
#include <functional>
#include <vector>

class QLabel;
class QPushButton;
class QWidget;

namespace qm {

class censusform;
class householdpanel;
class openfile;
class prompts;

class householdform : public QObject {
    Q_OBJECT
public:
    householdform(openfile& file, prompts& p, censusform& form, QWidget* parent);

    // Controls for the window's layout, in the order they were made.
    QPushButton* findbutton() const { return findbut_; }
    QLabel* infolabel() const { return infolab_; }
    householdpanel* panel() const { return panel_; }

    const householdrows& rows() const { return rows_; }
    householdrows& rows() { return rows_; }

    // The Find dialog starting at people[start]: the individual chosen or -1,
    // and whether the immediate family is to be rebuilt around it.
    std::function<int32_t(int32_t start, bool& refocus)> find;

    // Refills the lists from the index (after every read of the file).
    void refill();
    // Reads the family file again, keeping the individuals chosen when they
    // are all still in it (found again by record number once it is read).
    void reload();

    // The census year has been chosen: the people list offers everyone, or
    // who could be alive at the census date.
    void yearchosen();
    // The census date changed: the age of the individual chosen last.
    void datechanged();

    // Every row of the household has an age (the first that has not gets the
    // focus, with a message).
    bool checkages();
    void storerows();
    // Row r shown (scrolled to when hidden), its age box focused and selected.
    void focusage(int r);
    // The individuals of the entry, with the birth details given for them.
    std::vector<selectionrec> currentselection() const;

    // people[k] chosen and the immediate family rebuilt around it, as after Find.
    void showfound(int32_t k);

    // Empties the household (rows, information, captions).
    void clear();
    // No individual chosen in the lists (Clear all).
    void clearchoices();

signals:
    // The family file is to be looked at for outside changes (after Find).
    void filecheck();

private:
    void afterread();
    void keepchoices();
    void fillallpeople();
    void fillalivepeople();
    void fillfamily(int32_t k);
    void showallclicked();
    void peopleclicked(int row);
    void familyclicked(int row);
    void selectperson(int32_t k);
    void showrows(int t);
    void scrollup();
    void scrolldown();
    void deleterow(int r);
    void inforow(int r);
    void showpersoninfo(int32_t k);
    void findclicked();
    void pullrows();
    void pushrows();

    openfile& file_;
    prompts& prompts_;
    censusform& form_;
    householdrows rows_;
    bool reloading_ = false;
    int32_t findresult_ = -1;
    bool fromfind_ = false; // the Find dialog asked for the immediate family to be rebuilt

    QPushButton* findbut_ = nullptr;
    QLabel* infolab_ = nullptr;
    householdpanel* panel_ = nullptr;
};

} // namespace qm

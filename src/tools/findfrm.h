#pragma once
// Find Individual: finds an individual for the census entry by the start of a
// name, by record number, or by browsing from one individual to its parents,
// spouses and children, showing each one's birth and census events.

#include "census/selection.h"
#include "model/gedcomindex.h"

#include <QDialog>

#include <cstdint>
#include <vector>

class QCheckBox;
class QLabel;
class QLineEdit;
class QListView;
class QListWidget;
class QListWidgetItem;
class QPushButton;

namespace qm {

class peoplelistmodel;
class prompts;

class findfrm : public QDialog {
    Q_OBJECT
public:
    // `entries` is the list to search (findlist); `start` the position in
    // people of the individual shown at opening, or -1.
    findfrm(const gedcomindex& index, std::vector<listentry> entries, int32_t start, prompts& asker,
            QWidget* parent = nullptr);

    // After OK: the individual shown (-1 when none), and whether the immediate
    // family is to be rebuilt around it. -1 after Cancel.
    int32_t result() const { return result_; }
    bool refocus() const { return refocus_; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void build();
    void showperson(int32_t k);
    void peoplechosen();
    void namesearch(const QString& text);
    void idsearch();
    void relativechosen(QListWidgetItem* item);
    void selectrow(int row);
    void ok();

    const gedcomindex& index_;
    std::vector<listentry> entries_;
    prompts& asker_;
    bool preselected_ = false;
    int32_t result_ = -1;
    bool refocus_ = false;

    QLineEdit* searchnametxt_ = nullptr;
    QListView* peoplelst_ = nullptr;
    peoplelistmodel* people_ = nullptr;
    QLabel* countlab_ = nullptr;
    QLineEdit* IDfindtxt_ = nullptr;
    QPushButton* IDfindbut_ = nullptr;
    QLineEdit* nametxt_ = nullptr;
    QLineEdit* idtxt_ = nullptr;
    QLineEdit* dobtxt_ = nullptr;
    QLineEdit* placetxt_ = nullptr;
    QListWidget* censuslst_ = nullptr;
    QListWidget* parentlst_ = nullptr;
    QListWidget* spouselst_ = nullptr;
    QListWidget* childrenlst_ = nullptr;
    QCheckBox* refocuschk_ = nullptr;
    QPushButton* okbut_ = nullptr;
    QPushButton* Cancelbut_ = nullptr;
    QPushButton* helpbut_ = nullptr;
};

} // namespace qm

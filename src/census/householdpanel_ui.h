#pragma once
// The lower half of the main window: the people list with its caption and
// "Show All", the immediate family list, and the ten census rows. Controls
// only; the household (household_ui.h) fills them and handles their clicks.

#include "census/censusrows_ui.h"
#include "census/peoplelist_ui.h"

#include <QWidget>

class QCheckBox;
class QLabel;
class QListView;
class QStackedWidget;

namespace qm {

class householdpanel : public QWidget {
    Q_OBJECT
public:
    explicit householdpanel(QWidget* parent = nullptr);

    QLabel* alllab = nullptr;
    QCheckBox* allpeoplechk = nullptr;
    QListView* allpeoplelst = nullptr;
    QLabel* NopeopleLab = nullptr;
    QLabel* immediatefamilylab = nullptr;
    QListView* familylst = nullptr;
    censusrowsview* rows = nullptr;

    peoplelistmodel* people = nullptr;
    peoplelistmodel* family = nullptr;

    // Shows the people list, or hides it and uncovers NopeopleLab.
    void showpeoplelist(bool shown);
    bool peoplelistshown() const;
    void setpeoplecaption(const QString& caption);
    void setfamilycaption(const QString& caption);

signals:
    // An entry was chosen with the mouse or with Enter.
    void personchosen(int row);
    void familychosen(int row);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QStackedWidget* stack_ = nullptr;
};

} // namespace qm

#pragma once
// The ten census rows of the main window: name, age, age unit, occupation and
// record ID of the individuals of the household, with a delete button and an
// information button on each row in use, and the scroll buttons.
//
// The rows only show and collect values; the main window runs the household
// logic (householdrows) and hands the result back with show().

#include "census/selection.h"

#include <QWidget>

#include <array>

class QLabel;
class QLineEdit;
class QToolButton;

namespace qm {

class censusrowsview : public QWidget {
    Q_OBJECT
public:
    explicit censusrowsview(QWidget* parent = nullptr);

    // The values the controls hold now.
    std::array<rowvalues, householdrows::visible> values() const;
    // Shows the rows and scroll buttons of h.
    void show(const householdrows& h);

    QLineEdit* agebox(int r) const { return rows_[static_cast<size_t>(r)].agetxt; }
    QLineEdit* unitbox(int r) const { return rows_[static_cast<size_t>(r)].agetypetxt; }
    QLineEdit* occupationbox(int r) const { return rows_[static_cast<size_t>(r)].occtxt; }

signals:
    void deleterequested(int row);
    void inforequested(int row);
    void uprequested();
    void downrequested();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    struct rowcontrols {
        QLabel* namelab = nullptr;
        QLabel* idlab = nullptr;
        QLineEdit* agetxt = nullptr;
        QLineEdit* agetypetxt = nullptr;
        QLineEdit* occtxt = nullptr;
        QLabel* chosenlab = nullptr;
        QToolButton* PicInfo = nullptr;
        QToolButton* deleterowbut = nullptr;
    };
    int rowof(QObject* o) const;

    std::array<rowcontrols, householdrows::visible> rows_;
    QToolButton* upbut_ = nullptr;
    QToolButton* downbut_ = nullptr;
    int selectioncount_ = 0; // rows r < selectioncount_ take keys
};

} // namespace qm

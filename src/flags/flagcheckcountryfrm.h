#pragma once
// Flag Check - Choose Country: asked when one census event of an individual
// matches the allocated flags of more than one country. One option per
// candidate flag, captioned with its country.

#include "flags/flagcheck.h"

#include <QDialog>

#include <array>

class QCheckBox;
class QRadioButton;

namespace qm {

class flagcheckcountryfrm : public QDialog {
    Q_OBJECT
public:
    // `name` and `id` are the individual's; the question gives the event and its candidates.
    flagcheckcountryfrm(const countryquestion& q, const QString& name, int32_t id, QWidget* parent = nullptr);

    // The answer: chosen -1 after "Cancel", or after "OK" with no country selected.
    countrychoice choice() const { return choice_; }

    // Asks modally.
    static countrychoice ask(const countryquestion& q, const QString& name, int32_t id, QWidget* parent);

    static constexpr int optioncount = 4;

private:
    void ok();

    std::vector<QRadioButton*> countryopt_;
    QCheckBox* alwayschk_ = nullptr;
    countrychoice choice_;
};

} // namespace qm

#pragma once
// Census Flag Date: picks the census (a census date, or its year) that a flag
// is to stand for, among the censuses of one country that no flag of that
// country covers yet.

#include "flags/flagtable.h"

#include <QDialog>
#include <QString>

#include <array>
#include <optional>

class QLineEdit;
class QListWidget;
class QPushButton;
class QRadioButton;

namespace qm {

class prompts;

class flagdatefrm : public QDialog {
    Q_OBJECT
public:
    struct census {
        QString country;
        QString date; // a census date ("3 APR 1881") or a year ("1881")
    };

    // Opens on the country of the setting (UK when it names no census country).
    flagdatefrm(const flagtable& table, const QString& country, prompts& p, QWidget* parent = nullptr);

    // Set when the dialog was closed by "< Select Date" or "< Select Year".
    const std::optional<census>& chosen() const { return chosen_; }

private:
    void countrychosen(int which);
    void rowchosen();
    void select(bool year);

    const flagtable& table_;
    prompts& prompts_;
    QString country_;
    std::optional<census> chosen_;

    std::array<QRadioButton*, 4> countryopt_{};
    QListWidget* datelst_;
    QLineEdit* datelab_;
    QLineEdit* yearlab_;
    QPushButton* datebut_;
    QPushButton* Yearbut_;
};

} // namespace qm

#pragma once
// Census Flag Names: picks the name of the flag to allocate, either an
// existing flag that stands for no census yet or a new name, which must not
// be a flag's name already nor give an existing flag's code.

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

class flagnamefrm : public QDialog {
    Q_OBJECT
public:
    struct flagname {
        QString name;
        std::optional<size_t> existing; // the flag's position when an existing flag was chosen
    };

    flagnamefrm(const flagtable& table, prompts& p, QWidget* parent = nullptr);

    // Set when the dialog was closed by "OK".
    const std::optional<flagname>& chosen() const { return chosen_; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void optionchosen(int which);
    void updateok();
    void ok();

    const flagtable& table_;
    prompts& prompts_;
    std::optional<flagname> chosen_;

    std::array<QRadioButton*, 2> optflag_{};
    QListWidget* flagslst_;
    QLineEdit* flagnametxt_;
    QPushButton* okbut_;
};

} // namespace qm

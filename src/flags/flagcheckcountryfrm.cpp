#include "flags/flagcheckcountryfrm.h"

#include "platform/encoding.h"
#include "platform/formparts_ui.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

flagcheckcountryfrm::flagcheckcountryfrm(const countryquestion& q, const QString& name, int32_t id, QWidget* parent)
    : QDialog(parent)
{
    setObjectName(QStringLiteral("flagcheckcountryfrm"));
    setWindowTitle(QStringLiteral("Flag Check - Choose Country"));
    setModal(true);

    auto* intro = new QLabel(QStringLiteral("The following individual has a census record which could be flagged "
                                            "against more than one of the flags you have allocated. Please select "
                                            "the country that this record applies to:"),
                             this);
    intro->setWordWrap(true);
    intro->setMinimumWidth(420);

    auto* grid = new QGridLayout;
    grid->setColumnStretch(1, 1);
    int line = 0;
    auto add = [&](const QString& caption, QLabel* value) {
        grid->addWidget(new QLabel(caption, this), line, 0);
        grid->addWidget(value, line, 1);
        ++line;
    };
    add(QStringLiteral("Name:"), valuelabel(this, QStringLiteral("namelab"), QStringLiteral("Name"), name));
    add(QStringLiteral("ID:"), valuelabel(this, QStringLiteral("idlab"), QStringLiteral("ID"), QString::number(id)));
    add(QStringLiteral("Date:"), valuelabel(this, QStringLiteral("datelab"), QStringLiteral("Date"), qs(q.date)));
    add(QStringLiteral("Place:"), valuelabel(this, QStringLiteral("placelab"), QStringLiteral("Place"), qs(q.place)));

    // Four options, hidden until used; more only for definitions edited outside the program.
    auto* options = new QHBoxLayout;
    const int shown = static_cast<int>(q.countries.size());
    for (int i = 0; i < std::max(optioncount, shown); ++i) {
        auto* o = new QRadioButton(this);
        o->setObjectName(QStringLiteral("countryopt%1").arg(i));
        if (i < shown) {
            o->setText(q.countries.at(i));
            o->setAccessibleName(q.countries.at(i));
            o->setChecked(i == q.preselected);
        } else {
            o->setVisible(false);
        }
        options->addWidget(o);
        countryopt_.push_back(o);
    }
    options->addStretch(1);

    alwayschk_ = new QCheckBox(QStringLiteral("&Assume all census records for this place are in the selected country."),
                               this);
    alwayschk_->setObjectName(QStringLiteral("alwayschk"));
    alwayschk_->setAccessibleName(QStringLiteral("Assume all census records for this place are in the selected country"));

    const okcancel buttons = okcancelrow(this);
    QPushButton* okbut = buttons.ok;
    QPushButton* cancelbut = buttons.cancel;

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(intro);
    layout->addLayout(grid);
    layout->addLayout(options);
    layout->addWidget(alwayschk_);
    layout->addLayout(buttons.row);
    layout->setSizeConstraint(QLayout::SetFixedSize);

    QWidget* previous = nullptr;
    for (QRadioButton* o : countryopt_) {
        if (previous)
            setTabOrder(previous, o);
        previous = o;
    }
    setTabOrder(previous, alwayschk_);
    setTabOrder(alwayschk_, okbut);
    setTabOrder(okbut, cancelbut);
    if (q.preselected >= 0 && q.preselected < shown)
        countryopt_[static_cast<size_t>(q.preselected)]->setFocus();
    else if (shown > 0)
        countryopt_.front()->setFocus();

    connect(okbut, &QPushButton::clicked, this, &flagcheckcountryfrm::ok);
    connect(cancelbut, &QPushButton::clicked, this, &QDialog::reject);
}

void flagcheckcountryfrm::ok()
{
    choice_ = countrychoice{};
    for (size_t i = 0; i < countryopt_.size(); ++i) {
        if (countryopt_[i]->isChecked()) {
            choice_.chosen = static_cast<int>(i);
            break;
        }
    }
    choice_.always = alwayschk_->isChecked();
    accept();
}

countrychoice flagcheckcountryfrm::ask(const countryquestion& q, const QString& name, int32_t id, QWidget* parent)
{
    flagcheckcountryfrm dialog(q, name, id, parent);
    if (dialog.exec() != QDialog::Accepted)
        return countrychoice{};
    return dialog.choice();
}

} // namespace qm

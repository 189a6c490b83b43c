#include "census/birthfrm.h"

#include "census/birthdate.h"
#include "census/placecompleter_ui.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

namespace {

QString agetext(const selectionrec& row)
{
    if (row.agetype == u'M')
        return row.age + QStringLiteral(" months");
    if (row.agetype == u'D')
        return row.age + QStringLiteral(" days");
    return row.age;
}

} // namespace

birthfrm::birthfrm(const selectionrec& row, const QString& entrydate, const std::vector<placerec>& places,
                   prompts& asker, QWidget* parent)
    : QDialog(parent), asker_(asker)
{
    setObjectName(QStringLiteral("birthfrm"));
    setWindowTitle(QStringLiteral("Birth Details"));
    setModal(true);

    auto* intro = new QLabel(
        QStringLiteral("The following person does not currently have a birth event recorded in your family "
                       "history file:"),
        this);
    intro->setWordWrap(true);

    auto* grid = new QGridLayout;
    grid->setColumnStretch(1, 1);
    int line = 0;
    auto add = [&](QLabel* caption, QLabel* value) {
        grid->addWidget(caption, line, 0);
        grid->addWidget(value, line, 1);
        ++line;
    };
    add(new QLabel(QStringLiteral("Name:"), this), valuelabel(this, QStringLiteral("namelab"), QStringLiteral("Name"), row.name));
    add(new QLabel(QStringLiteral("ID:"), this),
        valuelabel(this, QStringLiteral("idlab"), QStringLiteral("ID"), QString::number(row.id)));
    add(new QLabel(QStringLiteral("Age:"), this), valuelabel(this, QStringLiteral("agelab"), QStringLiteral("Age"), agetext(row)));
    auto* occtitlelab = new QLabel(QStringLiteral("Occupation:"), this);
    occtitlelab->setObjectName(QStringLiteral("occtitlelab"));
    auto* occlab = valuelabel(this, QStringLiteral("occlab"), QStringLiteral("Occupation"), row.occupation);
    add(occtitlelab, occlab);
    const bool showocc = row.occupation.size() > 1;
    occtitlelab->setVisible(showocc);
    occlab->setVisible(showocc);

    auto* dobcaption = new QLabel(QStringLiteral("The calculated date of birth will be recorded as:"), this);
    const QString calculated = calculatedbirthdate(entrydate, row.age, row.agetype);
    doblab_ = valuelabel(this, QStringLiteral("doblab"), QStringLiteral("Calculated date of birth"), calculated);
    QFont bold = doblab_->font();
    bold.setBold(true);
    doblab_->setFont(bold);
    auto* placecaption = new QLabel(QStringLiteral("Enter the place of birth:"), this);
    birthplacetxt_ = new QLineEdit(this);
    birthplacetxt_->setObjectName(QStringLiteral("birthplacetxt"));
    birthplacetxt_->setAccessibleName(QStringLiteral("Place of birth"));
    placecaption->setBuddy(birthplacetxt_);
    placecompleter::attach(birthplacetxt_, places);

    auto* okbut = new QPushButton(QStringLiteral("Create Birth Event"), this);
    okbut->setObjectName(QStringLiteral("okbut"));
    okbut->setDefault(true);
    // Without a census date and age there is no date to record.
    okbut->setEnabled(!calculated.isEmpty());
    auto* cancelbut = new QPushButton(QStringLiteral("Do Not Create Birth Event"), this);
    cancelbut->setObjectName(QStringLiteral("cancelbut"));
    cancelbut->setAutoDefault(false);
    auto* helpbut = new QPushButton(QStringLiteral("Help"), this);
    helpbut->setObjectName(QStringLiteral("helpbut"));
    helpbut->setAutoDefault(false);

    auto* buttons = new QHBoxLayout;
    buttons->addWidget(okbut);
    buttons->addWidget(cancelbut);
    buttons->addStretch(1);
    buttons->addWidget(helpbut);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(intro);
    layout->addLayout(grid);
    layout->addWidget(dobcaption);
    layout->addWidget(doblab_);
    layout->addWidget(placecaption);
    layout->addWidget(birthplacetxt_);
    layout->addLayout(buttons);
    layout->setSizeConstraint(QLayout::SetFixedSize);

    setTabOrder(birthplacetxt_, okbut);
    setTabOrder(okbut, cancelbut);
    setTabOrder(cancelbut, helpbut);
    birthplacetxt_->setFocus();

    connect(okbut, &QPushButton::clicked, this, &birthfrm::create);
    connect(cancelbut, &QPushButton::clicked, this, &QDialog::reject);
    connect(helpbut, &QPushButton::clicked, this, &birthfrm::helprequested);
}

void birthfrm::create()
{
    const QString place = birthplacetxt_->text().trimmed();
    if (place.isEmpty()) {
        message m;
        m.text = QStringLiteral("You have not entered a birth place. Please click OK if you are sure you don't want "
                                "to record a place of birth.");
        m.choice = buttons::okcancel;
        m.kind = icon::question;
        m.defaultanswer = answer::cancel;
        if (asker_.ask(m) != answer::ok) {
            birthplacetxt_->clear();
            birthplacetxt_->setFocus();
            return;
        }
    }
    details_ = birthdetails{doblab_->text().trimmed(), place};
    accept();
}

std::optional<birthdetails> birthfrm::ask(const selectionrec& row, const QString& entrydate,
                                          const std::vector<placerec>& places, prompts& asker, QWidget* parent,
                                          std::function<void()> help)
{
    birthfrm dialog(row, entrydate, places, asker, parent);
    if (help)
        connect(&dialog, &birthfrm::helprequested, &dialog, help);
    if (dialog.exec() != QDialog::Accepted)
        return std::nullopt;
    return dialog.details();
}

} // namespace qm

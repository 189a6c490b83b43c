#include "flags/flagdatefrm.h"

#include "flags/flagalloc.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QButtonGroup>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

flagdatefrm::flagdatefrm(const flagtable& table, const QString& country, prompts& p, QWidget* parent)
    : QDialog(parent), table_(table), prompts_(p)
{
    setObjectName(QStringLiteral("flagdatefrm"));
    setWindowTitle(QStringLiteral("Census Flag Date"));
    setModal(true);

    auto* countries = new QGroupBox(this);
    auto* group = new QButtonGroup(this);
    auto* countrylayout = new QVBoxLayout(countries);
    const char* names[] = {"ukopt", "usaopt", "IrelandOpt", "CanadaOpt"};
    const QString texts[] = {QStringLiteral("&UK"), QStringLiteral("U&SA"), QStringLiteral("&Ireland"),
                             QStringLiteral("C&anada")};
    for (int i = 0; i < 4; ++i) {
        auto* o = new QRadioButton(texts[i], countries);
        o->setObjectName(QString::fromLatin1(names[i]));
        o->setAccessibleName(flagcountries()[i]);
        group->addButton(o, i);
        countrylayout->addWidget(o);
        countryopt_[static_cast<size_t>(i)] = o;
    }
    countrylayout->addStretch(1);

    auto* listcaption = new QLabel(QStringLiteral("Census &Dates:"), this);
    datelst_ = new QListWidget(this);
    datelst_->setObjectName(QStringLiteral("datelst"));
    datelst_->setAccessibleName(QStringLiteral("Census Dates"));
    listcaption->setBuddy(datelst_);
    datelab_ = shownfield(this, "datelab", QStringLiteral("Census date"));
    yearlab_ = shownfield(this, "yearlab", QStringLiteral("Census Year"));
    datebut_ = plainbutton(this, "datebut", QStringLiteral("< Select Dat&e"), QStringLiteral("Select Date"));
    Yearbut_ = plainbutton(this, "Yearbut", QStringLiteral("< Select &Year"), QStringLiteral("Select Year"));
    datebut_->setDefault(true);
    auto* cancelbut = plainbutton(this, "cancelbut", QStringLiteral("Cancel"), QStringLiteral("Cancel"));
    auto* helpbut = plainbutton(this, "helpbut", QStringLiteral("&Help"), QStringLiteral("Help"));

    auto* chosen = new QGridLayout;
    chosen->addWidget(new QLabel(QStringLiteral("Census date:"), this), 0, 0);
    chosen->addWidget(datelab_, 0, 1);
    chosen->addWidget(datebut_, 0, 2);
    chosen->addWidget(new QLabel(QStringLiteral("Census Year:"), this), 1, 0);
    chosen->addWidget(yearlab_, 1, 1);
    chosen->addWidget(Yearbut_, 1, 2);

    auto* listcolumn = new QVBoxLayout;
    listcolumn->addWidget(listcaption);
    listcolumn->addWidget(datelst_, 1);
    auto* top = new QHBoxLayout;
    top->addWidget(countries);
    top->addLayout(listcolumn, 1);

    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(cancelbut);
    buttons->addWidget(helpbut);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top, 1);
    layout->addLayout(chosen);
    layout->addLayout(buttons);
    datelst_->setMinimumHeight(datelst_->fontMetrics().height() * 9);

    setTabOrder(countryopt_[0], datelst_);
    setTabOrder(datelst_, datebut_);
    setTabOrder(datebut_, Yearbut_);
    setTabOrder(Yearbut_, cancelbut);
    setTabOrder(cancelbut, helpbut);

    connect(group, &QButtonGroup::idClicked, this, &flagdatefrm::countrychosen);
    connect(datelst_, &QListWidget::itemSelectionChanged, this, &flagdatefrm::rowchosen);
    connect(datelst_, &QListWidget::itemActivated, this, [this] { select(false); });
    connect(datebut_, &QPushButton::clicked, this, [this] { select(false); });
    connect(Yearbut_, &QPushButton::clicked, this, [this] { select(true); });
    connect(cancelbut, &QPushButton::clicked, this, &QDialog::reject);
    connect(helpbut, &QPushButton::clicked, this, [this] { prompts_.showhelp(45); });

    const qsizetype at = flagcountries().indexOf(country);
    const int which = at < 0 ? 0 : static_cast<int>(at);
    countryopt_[static_cast<size_t>(which)]->setChecked(true);
    countrychosen(which);
    datelst_->setFocus();
}

void flagdatefrm::countrychosen(int which)
{
    country_ = flagcountries()[which];
    datelst_->clear();
    datelst_->addItems(flagdates(table_, country_));
    rowchosen();
}

void flagdatefrm::rowchosen()
{
    const QList<QListWidgetItem*> selected = datelst_->selectedItems();
    const QString date = selected.isEmpty() ? QString() : selected.front()->text();
    datelab_->setText(date);
    // The year of the census day (the Canadian census of 1851 was taken in 1852,
    // and its events carry that year).
    yearlab_->setText(date.right(4));
    datebut_->setEnabled(!date.isEmpty());
    Yearbut_->setEnabled(!date.isEmpty());
}

void flagdatefrm::select(bool year)
{
    const QString chosen = year ? yearlab_->text() : datelab_->text();
    if (chosen.isEmpty())
        return;
    const auto refused = year ? refuseyear(table_, country_, chosen) : refusedate(table_, country_, chosen);
    if (refused) {
        prompts_.tell(*refused);
        return;
    }
    chosen_ = census{country_, chosen};
    accept();
}

} // namespace qm

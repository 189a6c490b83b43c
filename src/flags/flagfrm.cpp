#include "flags/flagfrm.h"

#include "flags/flagalloc.h"
#include "flags/flagdatefrm.h"
#include "flags/flagnamefrm.h"
#include "flags/flagtable.h"
#include "model/gedcomindex.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "settings/settings.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

flagfrm::flagfrm(gedcomindex& index, settings& s, settingsstore& store, prompts& p, std::function<bool()> flagcheck,
                 QWidget* parent)
    : QDialog(parent), index_(index), settings_(s), store_(store), prompts_(p), flagcheck_(std::move(flagcheck))
{
    setObjectName(QStringLiteral("flagfrm"));
    setWindowTitle(QStringLiteral("Census Flags"));
    setModal(true);

    // Allocate Flags
    auto* allocate = new QGroupBox(QStringLiteral("Allocate Flags"), this);
    datelab_ = shownfield(allocate, "datelab", QStringLiteral("Census"));
    auto* Datebut = plainbutton(allocate, "Datebut", QStringLiteral("..."), QStringLiteral("Choose census"));
    countrylab_ = shownfield(allocate, "countrylab", QStringLiteral("Country"));
    flaglab_ = shownfield(allocate, "flaglab", QStringLiteral("Flag name"));
    auto* flagbut = plainbutton(allocate, "flagbut", QStringLiteral("..."), QStringLiteral("Choose flag name"));
    for (QPushButton* b : {Datebut, flagbut})
        b->setMaximumWidth(b->fontMetrics().horizontalAdvance(QStringLiteral("....")) * 3);
    auto* censuscaption = new QLabel(QStringLiteral("&Census:"), allocate);
    censuscaption->setBuddy(Datebut);
    auto* namecaption = new QLabel(QStringLiteral("Flag &Name:"), allocate);
    namecaption->setBuddy(flagbut);

    const QFont fixed = fixedfont();
    auto* heading = new QLabel(flagheading(), allocate);
    heading->setObjectName(QStringLiteral("headinglab"));
    heading->setFont(fixed);
    heading->setTextFormat(Qt::PlainText);
    flagslst_ = new QListWidget(allocate);
    flagslst_->setObjectName(QStringLiteral("flagslst"));
    flagslst_->setAccessibleName(QStringLiteral("Census flags"));
    flagslst_->setFont(fixed);
    flagslst_->setSelectionMode(QAbstractItemView::SingleSelection);
    const int listwidth = QFontMetrics(fixed).horizontalAdvance(QString(52, QLatin1Char('M')));
    flagslst_->setMinimumSize(listwidth, QFontMetrics(fixed).height() * 10);
    heading->setBuddy(flagslst_);
    delbut_ = plainbutton(allocate, "delbut", QStringLiteral("&Delete Census Flag"), QStringLiteral("Delete Census Flag"));

    auto* grid = new QGridLayout;
    grid->addWidget(censuscaption, 0, 0);
    grid->addWidget(datelab_, 0, 1);
    grid->addWidget(Datebut, 0, 2);
    grid->addWidget(countrylab_, 0, 3);
    grid->addWidget(namecaption, 1, 0);
    grid->addWidget(flaglab_, 1, 1);
    grid->addWidget(flagbut, 1, 2);
    grid->setColumnStretch(1, 2);
    grid->setColumnStretch(3, 1);
    auto* dellayout = new QHBoxLayout;
    dellayout->addStretch(1);
    dellayout->addWidget(delbut_);
    auto* allocatelayout = new QVBoxLayout(allocate);
    allocatelayout->addLayout(grid);
    allocatelayout->addWidget(heading);
    allocatelayout->addWidget(flagslst_, 1);
    allocatelayout->addLayout(dellayout);

    // Flag Options
    auto* options = new QGroupBox(QStringLiteral("Flag Options"), this);
    flagschk_ = new QCheckBox(QStringLiteral("&Automatically record flags when saving census records"), options);
    flagschk_->setObjectName(QStringLiteral("flagschk"));
    flagschk_->setAccessibleName(QStringLiteral("Automatically record flags when saving census records"));
    flagcheckbut_ = plainbutton(options, "flagcheckbut", QStringLiteral("Flag Chec&k"), QStringLiteral("Flag Check"));
    auto* note = new QLabel(
        QStringLiteral("(Flag Check will list any flags that should be added or removed in your GEDCOM file to ensure "
                       "consistency with the flag allocations above. Optionally any suggested changes can be carried "
                       "out for you)"),
        options);
    note->setObjectName(QStringLiteral("notelab"));
    note->setWordWrap(true);
    auto* checkrow = new QHBoxLayout;
    checkrow->addWidget(flagcheckbut_, 0, Qt::AlignTop);
    checkrow->addWidget(note, 1);
    auto* optionslayout = new QVBoxLayout(options);
    optionslayout->addWidget(flagschk_);
    optionslayout->addLayout(checkrow);

    auto* okbut = plainbutton(this, "okbut", QStringLiteral("Close"), QStringLiteral("Close"));
    okbut->setDefault(true);
    auto* helpbut = plainbutton(this, "helpbut", QStringLiteral("&Help"), QStringLiteral("Help"));
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(okbut);
    buttons->addWidget(helpbut);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(allocate, 1);
    layout->addWidget(options);
    layout->addLayout(buttons);

    setTabOrder(Datebut, flagbut);
    setTabOrder(flagbut, flagslst_);
    setTabOrder(flagslst_, delbut_);
    setTabOrder(delbut_, flagschk_);
    setTabOrder(flagschk_, flagcheckbut_);
    setTabOrder(flagcheckbut_, okbut);
    setTabOrder(okbut, helpbut);

    // The stored setting is shown, not stored again: only a click stores it.
    flagschk_->setChecked(settings_.flaguse);
    clearfields();
    filllist();

    connect(Datebut, &QPushButton::clicked, this, &flagfrm::choosedate);
    connect(flagbut, &QPushButton::clicked, this, &flagfrm::choosename);
    connect(delbut_, &QPushButton::clicked, this, &flagfrm::deleteselected);
    connect(flagslst_, &QListWidget::itemSelectionChanged, this,
            [this] { delbut_->setEnabled(!flagslst_->selectedItems().isEmpty()); });
    connect(flagschk_, &QCheckBox::clicked, this, &flagfrm::flaguseclicked);
    connect(flagcheckbut_, &QPushButton::clicked, this, &flagfrm::runflagcheck);
    connect(okbut, &QPushButton::clicked, this, &QDialog::accept);
    connect(helpbut, &QPushButton::clicked, this, [this] { prompts_.showhelp(45); });
    okbut->setFocus();
}

void flagfrm::filllist()
{
    flagslst_->clear();
    for (const size_t i : allocatedflags(index_.flags))
        addrow(i);
    delbut_->setEnabled(false);
    enableflagcheck();
}

void flagfrm::addrow(size_t flag)
{
    auto* item = new QListWidgetItem(flagrowtext(index_.flags[flag]), flagslst_);
    item->setData(Qt::UserRole, static_cast<qulonglong>(flag));
}

void flagfrm::clearfields()
{
    datelab_->clear();
    flaglab_->clear();
    countrylab_->clear();
    chosenflag_.reset();
}

void flagfrm::enableflagcheck()
{
    flagcheckbut_->setEnabled(!index_.people.empty() && flagslst_->count() > 0);
}

void flagfrm::setcensus(const QString& country, const QString& date)
{
    countrylab_->setText(country);
    datelab_->setText(date);
    tryallocate();
}

void flagfrm::setflagname(const QString& name, std::optional<size_t> existing)
{
    flaglab_->setText(name);
    chosenflag_ = existing;
    tryallocate();
}

void flagfrm::tryallocate()
{
    if (datelab_->text().isEmpty() || flaglab_->text().isEmpty())
        return;
    const size_t flag =
        allocateflag(index_.flags, flaglab_->text(), datelab_->text(), countrylab_->text(), chosenflag_);
    clearfields();
    addrow(flag);
    flagslst_->setCurrentRow(flagslst_->count() - 1);
    if (!flagschk_->isChecked() && prompts_.yes(flaguseprompt(), icon::question)) {
        flagschk_->setChecked(true);
        flaguseclicked(true);
    }
    enableflagcheck();
}

void flagfrm::deleteselected()
{
    const QList<QListWidgetItem*> selected = flagslst_->selectedItems();
    if (selected.isEmpty())
        return;
    deleteflag(index_, static_cast<size_t>(selected.front()->data(Qt::UserRole).toULongLong()));
    clearfields();
    filllist();
}

void flagfrm::choosedate()
{
    flagdatefrm d(index_.flags, settings_.country, prompts_, this);
    if (d.exec() == QDialog::Accepted && d.chosen())
        setcensus(d.chosen()->country, d.chosen()->date);
}

void flagfrm::choosename()
{
    flagnamefrm d(index_.flags, prompts_, this);
    if (d.exec() == QDialog::Accepted && d.chosen())
        setflagname(d.chosen()->name, d.chosen()->existing);
}

void flagfrm::flaguseclicked(bool on)
{
    settings_.flaguse = on;
    saveflagsettings(store_, settings_);
}

void flagfrm::runflagcheck()
{
    if (flagcheck_ && flagcheck_()) {
        reloadneeded_ = true;
        accept();
    }
}

void flagfrm::done(int r)
{
    saveflagdefs(store_, index_.flags);
    QDialog::done(r);
}

} // namespace qm

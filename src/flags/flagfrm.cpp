#include "flags/flagfrm.h"

#include "flags/flagalloc.h"
#include "flags/flagdatefrm.h"
#include "flags/flagnamefrm.h"
#include "flags/flagtable.h"
#include "model/gedcomindex.h"
#include "platform/prompts.h"
#include "settings/settings.h"

#include <QCheckBox>
#include <QFontDatabase>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

namespace {

QFont listfont()
{
    QFont font = QFontDatabase::systemFont(QFontDatabase::FixedFont);
    if (QFontDatabase::hasFamily(QStringLiteral("Courier New")))
        font.setFamily(QStringLiteral("Courier New"));
    return font;
}

QLineEdit* field(const char* name, const QString& accessible, QWidget* parent)
{
    auto* f = new QLineEdit(parent);
    f->setObjectName(QString::fromLatin1(name));
    f->setAccessibleName(accessible);
    f->setReadOnly(true);
    f->setFocusPolicy(Qt::NoFocus);
    return f;
}

QPushButton* button(const char* name, const QString& text, const QString& accessible, QWidget* parent)
{
    auto* b = new QPushButton(text, parent);
    b->setObjectName(QString::fromLatin1(name));
    b->setAccessibleName(accessible);
    b->setAutoDefault(false);
    return b;
}

} // namespace

flagfrm::flagfrm(gedcomindex& index, settings& s, settingsstore& store, prompts& p, std::function<bool()> flagcheck,
                 QWidget* parent)
    : QDialog(parent), index_(index), settings_(s), store_(store), prompts_(p), flagcheck_(std::move(flagcheck))
{
    setObjectName(QStringLiteral("flagfrm"));
    setWindowTitle(QStringLiteral("Census Flags"));
    setModal(true);

    // Allocate Flags
    auto* allocate = new QGroupBox(QStringLiteral("Allocate Flags"), this);
    datelab_ = field("datelab", QStringLiteral("Census"), allocate);
    auto* Datebut = button("Datebut", QStringLiteral("..."), QStringLiteral("Choose census"), allocate);
    countrylab_ = field("countrylab", QStringLiteral("Country"), allocate);
    flaglab_ = field("flaglab", QStringLiteral("Flag name"), allocate);
    auto* flagbut = button("flagbut", QStringLiteral("..."), QStringLiteral("Choose flag name"), allocate);
    for (QPushButton* b : {Datebut, flagbut})
        b->setMaximumWidth(b->fontMetrics().horizontalAdvance(QStringLiteral("....")) * 3);
    auto* censuscaption = new QLabel(QStringLiteral("&Census:"), allocate);
    censuscaption->setBuddy(Datebut);
    auto* namecaption = new QLabel(QStringLiteral("Flag &Name:"), allocate);
    namecaption->setBuddy(flagbut);

    const QFont fixed = listfont();
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
    delbut_ = button("delbut", QStringLiteral("&Delete Census Flag"), QStringLiteral("Delete Census Flag"), allocate);

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
    flagcheckbut_ = button("flagcheckbut", QStringLiteral("Flag Chec&k"), QStringLiteral("Flag Check"), options);
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

    auto* okbut = button("okbut", QStringLiteral("Close"), QStringLiteral("Close"), this);
    okbut->setDefault(true);
    auto* helpbut = button("helpbut", QStringLiteral("&Help"), QStringLiteral("Help"), this);
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

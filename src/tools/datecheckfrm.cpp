#include "tools/datecheckfrm.h"

#include "flags/flagalloc.h"
#include "model/gedcomindex.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "settings/settings.h"
#include "writer/saveprompts.h"

#include <QButtonGroup>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QListView>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QStringListModel>
#include <QVBoxLayout>

namespace qm {

namespace {

QPushButton* button(const QString& text, const QString& name, QWidget* parent)
{
    auto* b = named(new QPushButton(text, parent), name, QString(text).remove(QLatin1Char('&')));
    b->setAutoDefault(false);
    return b;
}

QListWidget* datelist(const QString& name, const QString& accessible, QWidget* parent)
{
    auto* l = named(new QListWidget(parent), name, accessible);
    l->setSelectionMode(QAbstractItemView::SingleSelection);
    l->setUniformItemSizes(true);
    l->setMinimumWidth(460);
    return l;
}

} // namespace

Datecheckfrm::Datecheckfrm(prompts& p, const gedcomindex& index, const settings& s, QWidget* parent)
    : QDialog(parent), prompts_(p), index_(index), settings_(s), state_(index)
{
    setObjectName(QStringLiteral("Datecheckfrm"));
    setWindowTitle(QStringLiteral("Census Date Check"));
    setModal(true);
    if (parent)
        setWindowIcon(parent->windowIcon());
    build();

    const int option = countryoption(s.country);
    countryopt_[static_cast<size_t>(option)]->setChecked(true);
    countrychosen(option);
    suggestcombo_->clear();
    const QStringList choices = censuschoices();
    for (int row = 1; row <= choices.size(); ++row)
        suggestcombo_->addItem(choices[row - 1], row);
    suggestcombo_->setCurrentIndex(-1);
    changelst_->setFocus();
}

void Datecheckfrm::build()
{
    auto* countries = named(new QGroupBox(QStringLiteral("Most of my census entries are for:"), this),
                            QStringLiteral("countryframe"), QStringLiteral("Most of my census entries are for"));
    auto* countryrow = new QHBoxLayout(countries);
    auto* countrygroup = new QButtonGroup(this);
    const std::array<QString, 4> countrytexts = {QStringLiteral("&UK"), QStringLiteral("U&SA"), QStringLiteral("&Ireland"),
                                                 QStringLiteral("Ca&nada")};
    for (int i = 0; i < 4; ++i) {
        auto* o = named(new QRadioButton(countrytexts[static_cast<size_t>(i)], countries),
                        QStringLiteral("countryopt%1").arg(i), flagcountries()[i]);
        countrygroup->addButton(o, i);
        countryrow->addWidget(o);
        countryopt_[static_cast<size_t>(i)] = o;
    }
    countryrow->addStretch(1);
    connect(countrygroup, &QButtonGroup::idClicked, this, &Datecheckfrm::countrychosen);

    auto* changecaption = new QLabel(QStringLiteral("Unknown Census &dates:"), this);
    changelst_ = datelist(QStringLiteral("changelst"), QStringLiteral("Unknown Census dates"), this);
    changecaption->setBuddy(changelst_);
    currentcountrylab_ = named(new QLabel(this), QStringLiteral("currentcountrylab"), QString());
    currentlst_ = datelist(QStringLiteral("currentlst"), QString(), this);
    currentcountrylab_->setBuddy(currentlst_);
    countrylab_ = named(new QLabel(this), QStringLiteral("countrylab"), QString());
    countrylst_ = datelist(QStringLiteral("countrylst"), QString(), this);
    countrylab_->setBuddy(countrylst_);
    for (QListWidget* l : {changelst_, currentlst_, countrylst_})
        connect(l, &QListWidget::itemSelectionChanged, this, [this, l] { listselected(l); });

    auto* left = new QVBoxLayout;
    left->addWidget(countries);
    left->addWidget(changecaption);
    left->addWidget(changelst_, 2);
    left->addWidget(currentcountrylab_);
    left->addWidget(currentlst_, 1);
    left->addWidget(countrylab_);
    left->addWidget(countrylst_, 1);

    // Edit Suggestions.
    suggestionframe_ = named(new QGroupBox(QStringLiteral("Edit Suggestions"), this), QStringLiteral("suggestionframe"),
                             QStringLiteral("Edit Suggestions"));
    auto* edit = new QGridLayout(suggestionframe_);
    edit->addWidget(new QLabel(QStringLiteral("Census Date:"), suggestionframe_), 0, 0);
    datelab_ = showsvalue(new QLabel(suggestionframe_), QStringLiteral("datelab"), QStringLiteral("Census Date"));
    datelab_->setTextFormat(Qt::PlainText);
    QFont bold = datelab_->font();
    bold.setBold(true);
    datelab_->setFont(bold);
    edit->addWidget(datelab_, 0, 1);
    auto* suggestgroup = new QButtonGroup(this);
    const std::array<QString, 3> suggesttexts = {QStringLiteral("A&gree with Quillmark Suggestion"),
                                                 QStringLiteral("Don't make change (current date is co&rrect)"),
                                                 QStringLiteral("Change &to:")};
    for (int i = 0; i < 3; ++i) {
        auto* o = named(new QRadioButton(suggesttexts[static_cast<size_t>(i)], suggestionframe_),
                        QStringLiteral("suggestopt%1").arg(i),
                        QString(suggesttexts[static_cast<size_t>(i)]).remove(QLatin1Char('&')));
        suggestgroup->addButton(o, i);
        edit->addWidget(o, i + 1, 0, 1, 2);
        suggestopt_[static_cast<size_t>(i)] = o;
    }
    connect(suggestgroup, &QButtonGroup::idClicked, this, &Datecheckfrm::suggestchosen);
    suggestcombo_ = named(new QComboBox(suggestionframe_), QStringLiteral("suggestcombo"), QStringLiteral("Change to census"));
    suggestcombo_->setEnabled(false);
    suggestcombo_->setSizeAdjustPolicy(QComboBox::AdjustToContents);
    edit->addWidget(suggestcombo_, 4, 0, 1, 2);
    OKbut_ = named(new QPushButton(QStringLiteral("&OK"), suggestionframe_), QStringLiteral("OKbut"), QStringLiteral("OK"));
    OKbut_->setDefault(true);
    cancelbut_ = button(QStringLiteral("Cancel"), QStringLiteral("cancelbut"), suggestionframe_);
    auto* editbuttons = new QHBoxLayout;
    editbuttons->addStretch(1);
    editbuttons->addWidget(OKbut_);
    editbuttons->addWidget(cancelbut_);
    edit->addLayout(editbuttons, 5, 0, 1, 2);
    connect(OKbut_, &QPushButton::clicked, this, &Datecheckfrm::okclicked);
    connect(cancelbut_, &QPushButton::clicked, this, &Datecheckfrm::filllists);
    QSizePolicy keep = suggestionframe_->sizePolicy();
    keep.setRetainSizeWhenHidden(true);
    suggestionframe_->setSizePolicy(keep);

    // Census Details.
    detailsframe_ = named(new QGroupBox(QStringLiteral("Census Details"), this), QStringLiteral("detailsframe"),
                          QStringLiteral("Census Details"));
    auto* details = new QVBoxLayout(detailsframe_);
    auto* peoplegroup = new QButtonGroup(this);
    const std::array<QString, 2> peopletexts = {
        QStringLiteral("Show all Indi&viduals with census events for the selected date"),
        QStringLiteral("Show all &places mentioned in census events with the selected date")};
    for (int i = 0; i < 2; ++i) {
        auto* o = named(new QRadioButton(peopletexts[static_cast<size_t>(i)], detailsframe_),
                        QStringLiteral("peopleopt%1").arg(i),
                        QString(peopletexts[static_cast<size_t>(i)]).remove(QLatin1Char('&')));
        peoplegroup->addButton(o, i);
        details->addWidget(o);
        peopleopt_[static_cast<size_t>(i)] = o;
    }
    peopleopt_[0]->setChecked(true);
    connect(peoplegroup, &QButtonGroup::idClicked, this, [this] { showdetails(); });
    peoplelst_ = named(new QListView(detailsframe_), QStringLiteral("peoplelst"), QStringLiteral("Census Details"));
    peoplemodel_ = new QStringListModel(this);
    peoplelst_->setModel(peoplemodel_);
    peoplelst_->setUniformItemSizes(true);
    peoplelst_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    peoplelst_->setMinimumWidth(380);
    details->addWidget(peoplelst_, 1);
    detailsframe_->setEnabled(false);

    auto* right = new QVBoxLayout;
    right->addWidget(suggestionframe_);
    right->addWidget(detailsframe_, 1);

    auto* columns = new QHBoxLayout;
    columns->addLayout(left, 3);
    columns->addLayout(right, 2);

    changebut_ = button(QStringLiteral("&Make Suggested Changes"), QStringLiteral("changebut"), this);
    exitbut_ = button(QStringLiteral("&Close"), QStringLiteral("exitbut"), this);
    auto* helpbut = button(QStringLiteral("&Help"), QStringLiteral("helpbut"), this);
    connect(changebut_, &QPushButton::clicked, this, &Datecheckfrm::makechanges);
    connect(exitbut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(helpbut, &QPushButton::clicked, this, [this] { prompts_.showhelp(35); });
    auto* bottom = new QHBoxLayout;
    bottom->addWidget(changebut_);
    bottom->addWidget(exitbut_);
    bottom->addStretch(1);
    bottom->addWidget(helpbut);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(columns, 1);
    layout->addLayout(bottom);
    resize(1180, 660);

    setTabOrder(countryopt_[0], changelst_);
    setTabOrder(changelst_, currentlst_);
    setTabOrder(currentlst_, countrylst_);
    setTabOrder(countrylst_, suggestopt_[0]);
    setTabOrder(suggestopt_[0], suggestopt_[1]);
    setTabOrder(suggestopt_[1], suggestopt_[2]);
    setTabOrder(suggestopt_[2], suggestcombo_);
    setTabOrder(suggestcombo_, OKbut_);
    setTabOrder(OKbut_, cancelbut_);
    setTabOrder(cancelbut_, peopleopt_[0]);
    setTabOrder(peopleopt_[0], peopleopt_[1]);
    setTabOrder(peopleopt_[1], peoplelst_);
    setTabOrder(peoplelst_, changebut_);
    setTabOrder(changebut_, exitbut_);
    setTabOrder(exitbut_, helpbut);
}

void Datecheckfrm::countrychosen(int option)
{
    const QString country = flagcountries()[option];
    currentcountrylab_->setText(currentcountrycaption(country));
    currentlst_->setAccessibleName(currentcountrylab_->text());
    countrylab_->setText(othercountrycaption(country));
    countrylst_->setAccessibleName(countrylab_->text());
    selected_ = -1;
    details_.clear();
    peoplemodel_->setStringList({});
    detailsframe_->setEnabled(false);
    {
        busycursor busy(prompts_);
        state_.choosecountry(country);
    }
    filllists();
}

void Datecheckfrm::filllists()
{
    filling_ = true;
    const datelists l = state_.lists();
    const auto fill = [](QListWidget* list, const std::vector<datelistentry>& entries) {
        list->clear();
        for (const datelistentry& e : entries) {
            auto* item = new QListWidgetItem(e.text, list);
            item->setData(Qt::UserRole, e.item);
        }
    };
    fill(changelst_, l.unknown);
    fill(currentlst_, l.current);
    fill(countrylst_, l.other);
    changebut_->setEnabled(l.canchange);
    suggestionframe_->hide();
    selected_ = -1;
    filling_ = false;
}

void Datecheckfrm::listselected(QListWidget* list)
{
    if (filling_)
        return;
    const QList<QListWidgetItem*> chosen = list->selectedItems();
    if (chosen.isEmpty())
        return;
    filling_ = true;
    for (QListWidget* other : {changelst_, currentlst_, countrylst_})
        if (other != list)
            other->clearSelection();
    filling_ = false;

    selected_ = chosen.front()->data(Qt::UserRole).toInt();
    showdetails();
    const datechange& d = state_.changes()[static_cast<size_t>(selected_)];
    datelab_->setText(d.founddate);
    const bool unknown = d.datekind == 0;
    suggestopt_[0]->setEnabled(unknown);
    suggestopt_[unknown ? 0 : 1]->setChecked(true);
    suggestcombo_->setCurrentIndex(-1);
    suggestcombo_->setEnabled(false);
    suggestionframe_->show();
}

void Datecheckfrm::showdetails()
{
    // A common date of a big file has hundreds of thousands of events.
    busycursor busy(prompts_);
    details_ = state_.details(selected_, peopleopt_[1]->isChecked());
    QStringList texts;
    texts.reserve(static_cast<qsizetype>(details_.size()));
    for (const detailentry& e : details_)
        texts << e.text;
    peoplemodel_->setStringList(texts);
    detailsframe_->setEnabled(!details_.empty());
}

void Datecheckfrm::suggestchosen(int option)
{
    suggestcombo_->setEnabled(option == 2);
    suggestcombo_->setCurrentIndex(-1);
    if (option == 2)
        suggestcombo_->setFocus();
}

int Datecheckfrm::checkedsuggestion() const
{
    for (int i = 0; i < 3; ++i)
        if (suggestopt_[static_cast<size_t>(i)]->isChecked())
            return i;
    return 0;
}

void Datecheckfrm::okclicked()
{
    const auto s = static_cast<suggestion>(checkedsuggestion());
    const int row = suggestcombo_->currentIndex() < 0 ? 0 : suggestcombo_->currentData().toInt();
    const QString error = state_.edit(selected_, s, row);
    if (!error.isEmpty()) {
        prompts_.tell(error, icon::exclamation);
        suggestcombo_->setFocus();
        return;
    }
    filllists();
    changelst_->setFocus();
}

void Datecheckfrm::makechanges()
{
    if (!prompts_.yes(makechangesquestion(), icon::exclamation))
        return;
    saveoutcome out;
    {
        busycursor busy(prompts_);
        out = makedatechanges(index_, settings_, state_.changes());
    }
    switch (tellsaveoutcome(prompts_, out)) {
    case aftersave::saved:
        reloadneeded_ = true;
        accept();
        return;
    case aftersave::changed:
        prompts_.tell(out.message, icon::exclamation);
        reloadneeded_ = true;
        reject();
        return;
    case aftersave::stay:
        return;
    case aftersave::fatal:
        fatal_ = true;
        reject();
        return;
    }
}

} // namespace qm

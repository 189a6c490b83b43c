#include "tools/findfrm.h"

#include "census/peoplelist_ui.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "tools/findindividual.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QListWidget>
#include <QPushButton>
#include <QRegularExpressionValidator>
#include <QVBoxLayout>

namespace qm {

namespace {

QListWidget* relativelist(QWidget* parent, const char* name, const QString& accessible)
{
    auto* l = named(new QListWidget(parent), name, accessible);
    l->setMinimumHeight(80);
    return l;
}

QGroupBox* framed(const QString& title, QWidget* inside, QWidget* parent)
{
    auto* g = new QGroupBox(title, parent);
    auto* layout = new QVBoxLayout(g);
    layout->addWidget(inside);
    return g;
}

} // namespace

findfrm::findfrm(const gedcomindex& index, std::vector<listentry> entries, int32_t start, prompts& asker,
                 QWidget* parent)
    : QDialog(parent), index_(index), entries_(std::move(entries)), asker_(asker)
{
    setObjectName(QStringLiteral("findfrm"));
    setWindowTitle(QStringLiteral("Find Individual"));
    setModal(true);
    if (parent)
        setWindowIcon(parent->window()->windowIcon());
    build();

    people_->setentries(entries_);
    countlab_->setText(QString::number(entries_.size()) + QStringLiteral(" individuals."));
    if (start != -1) {
        for (size_t r = 0; r < entries_.size(); ++r) {
            if (entries_[r].person == start) {
                // The individual of the last census row is shown, but OK waits
                // for one the user shows.
                preselected_ = true;
                selectrow(static_cast<int>(r));
                break;
            }
        }
    }
    searchnametxt_->setFocus();
}

void findfrm::build()
{
    searchnametxt_ = named(new QLineEdit(this), "searchnametxt", QStringLiteral("Search by name"));
    auto* searchlab = new QLabel(QStringLiteral("Search by &name:"), this);
    searchlab->setBuddy(searchnametxt_);

    people_ = new peoplelistmodel(this);
    peoplelst_ = named(new QListView(this), "peoplelst", QStringLiteral("Individuals"));
    peoplelst_->setModel(people_);
    peoplelst_->setUniformItemSizes(true);
    peoplelst_->setSelectionMode(QAbstractItemView::SingleSelection);
    peoplelst_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    peoplelst_->setMinimumWidth(280);
    countlab_ = showsvalue(new QLabel(this), QStringLiteral("countlab"), QStringLiteral("Number of individuals"));

    IDfindtxt_ = named(new QLineEdit(this), "IDfindtxt", QStringLiteral("Individual ID to find"));
    IDfindtxt_->setToolTip(
        QStringLiteral("Type in an individual ID to search for and click on the 'Find ID' button"));
    // Record numbers: digits only, and few enough to be a number.
    IDfindtxt_->setValidator(
        new QRegularExpressionValidator(QRegularExpression(QStringLiteral("[0-9]{0,9}")), IDfindtxt_));
    IDfindtxt_->setMaximumWidth(110);
    IDfindtxt_->installEventFilter(this);
    IDfindbut_ = named(new QPushButton(QStringLiteral("<Find &ID"), this), "IDfindbut", QStringLiteral("Find ID"));
    IDfindbut_->setAutoDefault(false);
    IDfindbut_->setEnabled(false);

    nametxt_ = readonlybox(this, "nametxt", QStringLiteral("Name"));
    idtxt_ = readonlybox(this, "idtxt", QStringLiteral("Individual ID"));
    dobtxt_ = readonlybox(this, "dobtxt", QStringLiteral("Date of Birth"));
    placetxt_ = readonlybox(this, "placetxt", QStringLiteral("Place of Birth"));
    censuslst_ = named(new QListWidget(this), "censuslst", QStringLiteral("Census Entries"));
    censuslst_->setMinimumHeight(90);

    auto* selected = new QGroupBox(QStringLiteral("Selected Individual"), this);
    auto* grid = new QGridLayout(selected);
    int line = 0;
    addcaptioned(grid, line, QStringLiteral("Name:"), nametxt_);
    addcaptioned(grid, line, QStringLiteral("Individual ID:"), idtxt_);
    addcaptioned(grid, line, QStringLiteral("Date of Birth:"), dobtxt_);
    addcaptioned(grid, line, QStringLiteral("Place of Birth:"), placetxt_);
    addcaptioned(grid, line, QStringLiteral("Census Entries:"), censuslst_);
    grid->setColumnStretch(1, 1);

    parentlst_ = relativelist(this, "parentlst", QStringLiteral("Parents"));
    spouselst_ = relativelist(this, "spouselst", QStringLiteral("Spouses"));
    childrenlst_ = relativelist(this, "childrenlst", QStringLiteral("Children"));
    for (QListWidget* l : {parentlst_, spouselst_, childrenlst_}) {
        l->installEventFilter(this);
        connect(l, &QListWidget::itemClicked, this, &findfrm::relativechosen);
    }
    auto* relativesrow = new QHBoxLayout;
    relativesrow->addWidget(framed(QStringLiteral("Parents"), parentlst_, this));
    relativesrow->addWidget(framed(QStringLiteral("Spouses"), spouselst_, this));
    relativesrow->addWidget(framed(QStringLiteral("Children"), childrenlst_, this));

    refocuschk_ = named(new QCheckBox(QStringLiteral("&Refocus Immediate Family"), this), "refocuschk",
                        QStringLiteral("Refocus Immediate Family"));
    okbut_ = named(new QPushButton(QStringLiteral("OK"), this), "okbut", QStringLiteral("OK"));
    okbut_->setDefault(true);
    okbut_->setEnabled(false);
    Cancelbut_ = named(new QPushButton(QStringLiteral("Cancel"), this), "Cancelbut", QStringLiteral("Cancel"));
    Cancelbut_->setAutoDefault(false);
    helpbut_ = named(new QPushButton(QStringLiteral("&Help"), this), "helpbut", QStringLiteral("Help"));
    helpbut_->setAutoDefault(false);

    auto* left = new QVBoxLayout;
    left->addWidget(searchlab);
    left->addWidget(searchnametxt_);
    left->addWidget(peoplelst_, 1);
    left->addWidget(countlab_);
    auto* idrow = new QHBoxLayout;
    auto* idlab = new QLabel(QStringLiteral("Record n&umber:"), this);
    idlab->setBuddy(IDfindtxt_);
    idrow->addWidget(idlab);
    idrow->addWidget(IDfindtxt_);
    idrow->addWidget(IDfindbut_);
    idrow->addStretch(1);
    left->addLayout(idrow);

    auto* right = new QVBoxLayout;
    right->addWidget(selected, 3);
    right->addLayout(relativesrow, 2);

    auto* top = new QHBoxLayout;
    top->addLayout(left, 2);
    top->addLayout(right, 3);

    auto* buttons = new QHBoxLayout;
    buttons->addWidget(refocuschk_);
    buttons->addStretch(1);
    buttons->addWidget(okbut_);
    buttons->addWidget(Cancelbut_);
    buttons->addWidget(helpbut_);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top, 1);
    layout->addLayout(buttons);
    resize(900, 580);

    setTabOrder(searchnametxt_, peoplelst_);
    setTabOrder(peoplelst_, IDfindtxt_);
    setTabOrder(IDfindtxt_, IDfindbut_);
    setTabOrder(IDfindbut_, nametxt_);
    setTabOrder(nametxt_, idtxt_);
    setTabOrder(idtxt_, dobtxt_);
    setTabOrder(dobtxt_, placetxt_);
    setTabOrder(placetxt_, censuslst_);
    setTabOrder(censuslst_, parentlst_);
    setTabOrder(parentlst_, spouselst_);
    setTabOrder(spouselst_, childrenlst_);
    setTabOrder(childrenlst_, refocuschk_);
    setTabOrder(refocuschk_, okbut_);
    setTabOrder(okbut_, Cancelbut_);
    setTabOrder(Cancelbut_, helpbut_);

    connect(peoplelst_->selectionModel(), &QItemSelectionModel::selectionChanged, this, &findfrm::peoplechosen);
    // A click on the entry already selected shows it too (the selection does not change).
    connect(peoplelst_, &QListView::clicked, this, &findfrm::peoplechosen);
    connect(searchnametxt_, &QLineEdit::textEdited, this, &findfrm::namesearch);
    connect(IDfindtxt_, &QLineEdit::textChanged, this,
            [this](const QString& text) { IDfindbut_->setEnabled(!text.isEmpty()); });
    connect(IDfindbut_, &QPushButton::clicked, this, &findfrm::idsearch);
    connect(okbut_, &QPushButton::clicked, this, &findfrm::ok);
    connect(Cancelbut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(helpbut_, &QPushButton::clicked, this, [this] { asker_.showhelp(14); });
}

bool findfrm::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) {
            // Enter in the ID box finds the ID; on a relative it browses to it.
            if (watched == IDfindtxt_) {
                if (IDfindbut_->isEnabled())
                    idsearch();
                return true;
            }
            if (auto* l = qobject_cast<QListWidget*>(watched); l && l->currentItem()) {
                relativechosen(l->currentItem());
                return true;
            }
        }
    }
    return QDialog::eventFilter(watched, event);
}

void findfrm::selectrow(int row)
{
    if (row < 0 || row >= people_->rowCount())
        return;
    const QModelIndex i = people_->index(row, 0);
    if (peoplelst_->selectionModel()->isSelected(i)) {
        showperson(people_->personat(row));
    } else {
        peoplelst_->selectionModel()->setCurrentIndex(i, QItemSelectionModel::ClearAndSelect);
    }
    peoplelst_->scrollTo(i);
}

void findfrm::peoplechosen()
{
    const QModelIndexList chosen = peoplelst_->selectionModel()->selectedIndexes();
    if (!chosen.isEmpty())
        showperson(people_->personat(chosen.front().row()));
}

void findfrm::showperson(int32_t k)
{
    if (k < 0 || static_cast<size_t>(k) >= index_.people.size())
        return;
    const personrec& p = index_.people[static_cast<size_t>(k)];
    nametxt_->setText(qs(p.name));
    idtxt_->setText(QString::number(p.id));
    dobtxt_->setText(p.hasbirthdate ? qs(p.birthdate) : QString());
    placetxt_->setText(p.hasbirthplace ? qs(p.birthplace) : QString());
    nametxt_->setCursorPosition(0);
    placetxt_->setCursorPosition(0);
    censuslst_->clear();
    for (const QString& line : censuslines(p)) {
        // Long lines are cut by the list's width: the tooltip shows them whole.
        auto* item = new QListWidgetItem(line, censuslst_);
        item->setToolTip(line);
    }

    const relatives r = findrelatives(index_, k);
    const auto fill = [this](QListWidget* l, const std::vector<int32_t>& who) {
        l->clear();
        for (int32_t j : who) {
            auto* item = new QListWidgetItem(qs(index_.people[static_cast<size_t>(j)].name), l);
            item->setData(Qt::UserRole, j);
        }
    };
    fill(parentlst_, r.parents);
    fill(spouselst_, r.spouses);
    fill(childrenlst_, r.children);

    if (preselected_)
        preselected_ = false;
    else
        okbut_->setEnabled(true);
}

void findfrm::namesearch(const QString& text)
{
    const int row = findbyname(entries_, text);
    if (row >= 0)
        selectrow(row);
}

void findfrm::idsearch()
{
    const int row = findbyid(index_, entries_, IDfindtxt_->text().toInt());
    if (row < 0) {
        asker_.tell(QStringLiteral("No individuals have this ID"));
        IDfindbut_->setEnabled(false);
        return;
    }
    selectrow(row);
    IDfindtxt_->clear();
}

void findfrm::relativechosen(QListWidgetItem* item)
{
    if (!item)
        return;
    const int32_t k = item->data(Qt::UserRole).toInt();
    peoplelst_->clearSelection();
    for (size_t r = 0; r < entries_.size(); ++r) {
        if (entries_[r].person == k) {
            selectrow(static_cast<int>(r));
            return;
        }
    }
    showperson(k);
}

void findfrm::ok()
{
    result_ = idtxt_->text().isEmpty() ? -1 : personofid(index_, idtxt_->text().toInt());
    refocus_ = refocuschk_->isChecked();
    accept();
}

} // namespace qm

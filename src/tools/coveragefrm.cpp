#include "tools/coveragefrm.h"

#include "census/censustable.h"
#include "model/gedcomindex.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QCheckBox>
#include <QColor>
#include <QComboBox>
#include <QEvent>
#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QSaveFile>
#include <QTableView>
#include <QTimer>
#include <QVBoxLayout>

namespace qm {

namespace {

const QStringList& countries()
{
    static const QStringList list = {QStringLiteral("UK"), QStringLiteral("USA"), QStringLiteral("Ireland"),
                                     QStringLiteral("Canada")};
    return list;
}

// What a cell's word means, for the line under the grid.
QString meaning(coveragecell c)
{
    switch (c) {
    case coveragecell::recorded:
        return QStringLiteral("the file has a census entry for it");
    case coveragecell::notalive:
        return QStringLiteral("born after the census day or died before it, as the dates tell");
    case coveragecell::uncertain:
        return QStringLiteral("the dates cannot tell whether the individual was alive on the census day");
    case coveragecell::elsewhere:
        return QStringLiteral("the file places the individual in another country at the time");
    case coveragecell::missing:
        break;
    }
    return QStringLiteral("alive on the census day as far as the file tells, and not recorded: press Enter or "
                          "double-click to transcribe it");
}

QColor background(coveragecell c)
{
    switch (c) {
    case coveragecell::recorded:
        return QColor(0xc8, 0xe6, 0xc9);
    case coveragecell::notalive:
        return QColor(0xe6, 0xe6, 0xe6);
    case coveragecell::uncertain:
        return QColor(0xff, 0xf1, 0xbf);
    case coveragecell::elsewhere:
        return QColor(0xc6, 0xdc, 0xf5);
    case coveragecell::missing:
        break;
    }
    return QColor(0xf8, 0xc4, 0xc4);
}

QString number(qsizetype n)
{
    return QLocale().toString(static_cast<qlonglong>(n));
}

} // namespace

QString coveragecelltext(coveragecell c)
{
    static const char16_t* const symbols[] = {u"\u2714", u"\u2013", u"?", u"\u2192", u"\u2718"};
    return QString::fromUtf16(symbols[static_cast<size_t>(c)]) + u' ' + QString::fromUtf8(coverageword(c));
}

// coveragemodel

void coveragemodel::setrows(const gedcomindex* index, const censuscoverage* c, std::vector<int32_t> rows)
{
    beginResetModel();
    index_ = index;
    coverage_ = c;
    rows_ = std::move(rows);
    totals_ = c ? countcells(*c, rows_) : std::vector<std::array<int32_t, coveragecellkinds>>{};
    endResetModel();
    if (c && c->columns() > 0)
        emit headerDataChanged(Qt::Horizontal, firstcensuscolumn, firstcensuscolumn + static_cast<int>(c->columns()) - 1);
}

int32_t coveragemodel::personat(int row) const
{
    return row >= 0 && static_cast<size_t>(row) < rows_.size() ? rows_[static_cast<size_t>(row)] : -1;
}

int coveragemodel::rowof(int32_t person) const
{
    const auto it = std::find(rows_.begin(), rows_.end(), person);
    return it == rows_.end() ? -1 : static_cast<int>(it - rows_.begin());
}

int coveragemodel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(rows_.size());
}

int coveragemodel::columnCount(const QModelIndex& parent) const
{
    return parent.isValid() || !coverage_ ? 0 : firstcensuscolumn + static_cast<int>(coverage_->columns());
}

QVariant coveragemodel::data(const QModelIndex& at, int role) const
{
    if (!at.isValid() || !index_ || !coverage_ || at.row() >= rowCount())
        return {};
    const auto k = static_cast<size_t>(rows_[static_cast<size_t>(at.row())]);
    const personrec& p = index_->people[k];
    const int census = censusat(at.column());
    if (census < 0) {
        if (role != Qt::DisplayRole && role != Qt::AccessibleTextRole)
            return {};
        if (at.column() == namecolumn)
            return qs(p.name);
        if (at.column() == idcolumn)
            return QString::number(p.id);
        const int16_t year = coverage_->birthyears[k];
        return year > 0 ? QString::number(year) : QString();
    }
    const coveragecell c = coverage_->cell(k, static_cast<size_t>(census));
    switch (role) {
    case Qt::DisplayRole:
        return coveragecelltext(c);
    case Qt::AccessibleTextRole:
        // The word, without the symbol, with the census it belongs to.
        return coverage_->year(static_cast<size_t>(census)) + QStringLiteral(": ")
            + QString::fromUtf8(coverageword(c));
    case Qt::ToolTipRole:
        return qs(p.name) + QStringLiteral(", ") + coverage_->year(static_cast<size_t>(census))
            + QStringLiteral(": ") + QString::fromUtf8(coverageword(c));
    case Qt::BackgroundRole:
        return background(c);
    case Qt::ForegroundRole:
        // Dark text on the light colours, whatever the colour scheme.
        return QColor(Qt::black);
    case Qt::TextAlignmentRole:
        return QVariant::fromValue(Qt::AlignCenter);
    default:
        return {};
    }
}

QVariant coveragemodel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation != Qt::Horizontal || !coverage_)
        return QAbstractTableModel::headerData(section, orientation, role);
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole && role != Qt::AccessibleTextRole)
        return {};
    switch (section) {
    case namecolumn:
        return QStringLiteral("Name");
    case idcolumn:
        return QStringLiteral("ID");
    case borncolumn:
        return QStringLiteral("Born");
    default:
        break;
    }
    const int census = censusat(section);
    if (census < 0 || static_cast<size_t>(census) >= coverage_->columns())
        return {};
    const auto& t = totals_[static_cast<size_t>(census)];
    const int32_t recorded = t[static_cast<size_t>(coveragecell::recorded)];
    const int32_t missing = t[static_cast<size_t>(coveragecell::missing)];
    const QString year = coverage_->year(static_cast<size_t>(census));
    if (role == Qt::DisplayRole)
        return QStringLiteral("%1\n%2 recorded\n%3 missing").arg(year, number(recorded), number(missing));
    const censusdef& def = censustable()[static_cast<size_t>(coverage_->censusrows[static_cast<size_t>(census)])];
    return QStringLiteral("%1 census (%2): %3 recorded, %4 missing")
        .arg(year, def.date, number(recorded), number(missing));
}

// coveragefrm

coveragefrm::coveragefrm(const gedcomindex& index, const settings& s, prompts& p, transcribefn transcribe,
                         QWidget* parent)
    : QDialog(parent), index_(&index), settings_(&s), prompts_(p), transcribe_(std::move(transcribe))
{
    setObjectName(QStringLiteral("coveragefrm"));
    setWindowTitle(QStringLiteral("Census Coverage"));
    setModal(false);
    if (parent)
        setWindowIcon(parent->windowIcon());
    build();
    busycursor busy(prompts_);
    {
        const QSignalBlocker block(countrycom_);
        countrycom_->setCurrentIndex(static_cast<int>(std::max<qsizetype>(0, countries().indexOf(settings_->country))));
    }
    compute();
    grid_->setFocus();
    if (model_->rowCount() > 0)
        grid_->setCurrentIndex(model_->index(0, coveragemodel::firstcensuscolumn));
}

void coveragefrm::build()
{
    countrycom_ = named(new QComboBox(this), "countrycom", QStringLiteral("Country"));
    countrycom_->addItems(countries());
    gapschk_ = named(new QCheckBox(QStringLiteral("Only individuals with a &gap"), this), "gapschk",
                     QStringLiteral("Only individuals with a gap"));
    relativescom_ = named(new QComboBox(this), "relativescom", QStringLiteral("Show"));
    relativescom_->addItems({QStringLiteral("Everyone"), QStringLiteral("Ancestors of"), QStringLiteral("Descendants of"),
                             QStringLiteral("All relatives of")});
    relativelab_ = showsvalue(new QLabel(this), QStringLiteral("relativelab"), QStringLiteral("Relatives of"));
    relativelab_->setTextFormat(Qt::PlainText);
    nametxt_ = named(new QLineEdit(this), "nametxt", QStringLiteral("Name contains"));
    nametxt_->setClearButtonEnabled(true);
    sortcom_ = named(new QComboBox(this), "sortcom", QStringLiteral("Order by"));
    sortcom_->addItems({QStringLiteral("Name"), QStringLiteral("Birth year")});

    const auto caption = [this](const QString& text, QWidget* buddy) {
        auto* l = new QLabel(text, this);
        l->setBuddy(buddy);
        return l;
    };
    auto* filters = new QHBoxLayout;
    filters->addWidget(caption(QStringLiteral("&Country:"), countrycom_));
    filters->addWidget(countrycom_);
    filters->addSpacing(12);
    filters->addWidget(caption(QStringLiteral("&Show:"), relativescom_));
    filters->addWidget(relativescom_);
    filters->addWidget(relativelab_, 1);
    filters->addSpacing(12);
    filters->addWidget(gapschk_);
    auto* search = new QHBoxLayout;
    search->addWidget(caption(QStringLiteral("&Name contains:"), nametxt_));
    search->addWidget(nametxt_, 1);
    search->addSpacing(12);
    search->addWidget(caption(QStringLiteral("&Order by:"), sortcom_));
    search->addWidget(sortcom_);

    grid_ = named(new QTableView(this), "coveragegrid", QStringLiteral("Census coverage"));
    model_ = new coveragemodel(this);
    grid_->setModel(model_);
    grid_->setSelectionMode(QAbstractItemView::SingleSelection);
    grid_->setSelectionBehavior(QAbstractItemView::SelectItems);
    grid_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    grid_->setTabKeyNavigation(false);
    grid_->setWordWrap(false);
    grid_->verticalHeader()->hide();
    // Fixed sizes: nothing is measured over the rows of a big file.
    const QFontMetrics fm = grid_->fontMetrics();
    grid_->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    grid_->verticalHeader()->setDefaultSectionSize(fm.height() + 6);
    QHeaderView* top = grid_->horizontalHeader();
    top->setSectionResizeMode(QHeaderView::Fixed);
    top->setDefaultSectionSize(fm.horizontalAdvance(QStringLiteral("888,888 recorded")) + 12);
    top->setDefaultAlignment(Qt::AlignCenter);
    grid_->installEventFilter(this);

    celllab_ = showsvalue(new QLabel(this), QStringLiteral("celllab"), QStringLiteral("Cell chosen"));
    celllab_->setTextFormat(Qt::PlainText);
    celllab_->setWordWrap(true);
    celllab_->setMinimumHeight(fm.lineSpacing() * 2 + 4);
    countlab_ = showsvalue(new QLabel(this), QStringLiteral("countlab"), QStringLiteral("Individuals shown"));
    countlab_->setTextFormat(Qt::PlainText);

    transcribebut_ = plainbutton(this, "transcribebut", QStringLiteral("&Transcribe..."),
                                 QStringLiteral("Transcribe this census"));
    transcribebut_->setToolTip(QStringLiteral("Start a census entry for the individual and census chosen in the grid "
                                              "(Enter or a double-click do the same)"));
    exportbut_ = plainbutton(this, "exportbut", QStringLiteral("&Export CSV..."), QStringLiteral("Export CSV"));
    helpbut_ = plainbutton(this, "helpbut", QStringLiteral("&Help"), QStringLiteral("Help"));
    closebut_ = plainbutton(this, "closebut", QStringLiteral("Close"), QStringLiteral("Close"));
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(countlab_, 1);
    buttons->addWidget(transcribebut_);
    buttons->addWidget(exportbut_);
    buttons->addWidget(helpbut_);
    buttons->addWidget(closebut_);

    auto* v = new QVBoxLayout(this);
    v->addLayout(filters);
    v->addLayout(search);
    v->addWidget(grid_, 1);
    v->addWidget(celllab_);
    v->addLayout(buttons);

    searchtimer_ = new QTimer(this);
    searchtimer_->setSingleShot(true);
    searchtimer_->setInterval(150);
    connect(searchtimer_, &QTimer::timeout, this, &coveragefrm::refilter);
    connect(nametxt_, &QLineEdit::textChanged, searchtimer_, qOverload<>(&QTimer::start));
    connect(countrycom_, &QComboBox::currentIndexChanged, this, [this] {
        busycursor busy(prompts_);
        compute();
    });
    connect(gapschk_, &QCheckBox::toggled, this, &coveragefrm::refilter);
    connect(relativescom_, &QComboBox::currentIndexChanged, this, &coveragefrm::relativeschosen);
    connect(sortcom_, &QComboBox::currentIndexChanged, this, [this] {
        busycursor busy(prompts_);
        order();
    });
    connect(grid_, &QTableView::doubleClicked, this, &coveragefrm::transcribecurrent);
    connect(grid_->selectionModel(), &QItemSelectionModel::currentChanged, this, &coveragefrm::currentchanged);
    connect(model_, &QAbstractItemModel::modelReset, this, &coveragefrm::currentchanged);
    connect(transcribebut_, &QPushButton::clicked, this, &coveragefrm::transcribecurrent);
    connect(exportbut_, &QPushButton::clicked, this, &coveragefrm::exportcsv);
    connect(helpbut_, &QPushButton::clicked, this, [this] { prompts_.showhelp(60); });
    connect(closebut_, &QPushButton::clicked, this, &QDialog::close);

    // A reset of the model gives the columns their default width again.
    connect(model_, &QAbstractItemModel::modelReset, this, [this] {
        const QFontMetrics m = grid_->fontMetrics();
        grid_->setColumnWidth(coveragemodel::namecolumn, m.averageCharWidth() * 32 + 12);
        grid_->setColumnWidth(coveragemodel::idcolumn, m.horizontalAdvance(QStringLiteral("8888888")) + 12);
        grid_->setColumnWidth(coveragemodel::borncolumn, m.horizontalAdvance(QStringLiteral("Born88")) + 12);
    });
    resize(1200, 680);
}

void coveragefrm::setindex(const gedcomindex& index, const settings& s)
{
    // The old index may be gone already: only record numbers kept from it are
    // used, and the cell chosen is found again by them (positions may move).
    const int column = grid_->currentIndex().column();
    model_->setrows(nullptr, nullptr, {});
    index_ = &index;
    settings_ = &s;
    relativeof_ = -1;
    int32_t found = -1;
    for (size_t j = 0; j < index.people.size(); ++j) {
        if (index.people[j].id == currentid_)
            found = static_cast<int32_t>(j);
        if (index.people[j].id == relativeid_)
            relativeof_ = static_cast<int32_t>(j);
    }
    if (relativeof_ < 0 && relativescom_->currentIndex() != 0) {
        const QSignalBlocker block(relativescom_);
        relativescom_->setCurrentIndex(0);
        relativelab_->clear();
    }
    {
        busycursor busy(prompts_);
        compute();
    }
    const int row = model_->rowof(found);
    if (row >= 0) {
        const QModelIndex i = model_->index(row, std::max(column, 0));
        grid_->setCurrentIndex(i);
        grid_->scrollTo(i);
    }
}

void coveragefrm::compute()
{
    model_->setrows(nullptr, nullptr, {});
    residence_ = settings_->residence;
    coverage_ = computecoverage(*index_, countrycom_->currentText(), residence_);
    order();
}

void coveragefrm::order()
{
    ordered_ = coverageorder(*index_, coverage_,
                             sortcom_->currentIndex() == 1 ? coveragesort::birthyear : coveragesort::name);
    refilter();
}

void coveragefrm::refilter()
{
    searchtimer_->stop();
    coveragefilter f;
    f.gapsonly = gapschk_->isChecked();
    f.name = nametxt_->text();
    const int relatives = relativescom_->currentIndex();
    if (relatives > 0 && relativeof_ >= 0) {
        f.relativeof = relativeof_;
        f.relatives = relatives == 1 ? relation::ancestors : relatives == 2 ? relation::descendants : relation::related;
    }
    const int32_t current = model_->personat(grid_->currentIndex().row());
    const int column = std::max(grid_->currentIndex().column(), coveragemodel::firstcensuscolumn);
    model_->setrows(index_, &coverage_, filtercoverage(*index_, coverage_, f, ordered_));
    countlab_->setText(QStringLiteral("%1 of %2 individuals shown").arg(number(model_->rowCount()),
                                                                       number(static_cast<qsizetype>(coverage_.people))));
    const int row = std::max(model_->rowof(current), model_->rowCount() > 0 ? 0 : -1);
    if (row >= 0) {
        const QModelIndex i = model_->index(row, std::min(column, model_->columnCount() - 1));
        grid_->setCurrentIndex(i);
        grid_->scrollTo(i);
    }
}

void coveragefrm::relativeschosen(int item)
{
    if (item <= 0) {
        relativeof_ = relativeid_ = -1;
        relativelab_->clear();
        refilter();
        return;
    }
    // The individual chosen in the grid, or the one chosen before.
    const int32_t k = model_->personat(grid_->currentIndex().row());
    if (k >= 0)
        relativeof_ = k;
    if (relativeof_ < 0) {
        prompts_.tell(QStringLiteral("Choose an individual in the grid first: the relatives shown are those of the "
                                     "individual chosen."));
        const QSignalBlocker block(relativescom_);
        relativescom_->setCurrentIndex(0);
        return;
    }
    const personrec& p = index_->people[static_cast<size_t>(relativeof_)];
    relativeid_ = p.id;
    relativelab_->setText(qs(p.name) + QStringLiteral(" (ID: ") + QString::number(p.id) + u')');
    busycursor busy(prompts_);
    refilter();
}

void coveragefrm::currentchanged()
{
    const QModelIndex at = grid_->currentIndex();
    const int32_t k = model_->personat(at.row());
    const int census = model_->censusat(at.column());
    bool missing = false;
    if (k < 0) {
        celllab_->setText(model_->rowCount() == 0 ? QStringLiteral("No individual is shown.") : QString());
    } else {
        const personrec& p = index_->people[static_cast<size_t>(k)];
        currentid_ = p.id;
        QString text = qs(p.name) + QStringLiteral(" (ID: ") + QString::number(p.id) + u')';
        if (census >= 0) {
            const coveragecell c = coverage_.cell(static_cast<size_t>(k), static_cast<size_t>(census));
            missing = c == coveragecell::missing;
            text += QStringLiteral(", census of ") + coverage_.year(static_cast<size_t>(census))
                + QStringLiteral(": ") + QString::fromUtf8(coverageword(c)) + QStringLiteral(": ") + meaning(c)
                + u'.';
        }
        celllab_->setText(text);
    }
    transcribebut_->setEnabled(missing);
}

void coveragefrm::transcribecurrent()
{
    const QModelIndex at = grid_->currentIndex();
    const int32_t k = model_->personat(at.row());
    const int census = model_->censusat(at.column());
    if (k < 0 || census < 0
        || coverage_.cell(static_cast<size_t>(k), static_cast<size_t>(census)) != coveragecell::missing)
        return;
    if (coverage_.country != settings_->country) {
        prompts_.tell(QStringLiteral("Census entries are made for the census country chosen in Options (%1). To "
                                     "transcribe a census of %2, choose %2 as the census country in Options first.")
                          .arg(settings_->country, coverage_.country));
        return;
    }
    if (transcribe_)
        transcribe_(k, coverage_.year(static_cast<size_t>(census)).toInt());
}

void coveragefrm::exportcsv()
{
    const QString folder = QFileInfo(index_->gedcomfile).absolutePath();
    const std::optional<QString> path =
        prompts_.savefile(QStringLiteral("Export Census Coverage"),
                          folder + QStringLiteral("/Census coverage %1.csv").arg(coverage_.country),
                          QStringLiteral("CSV files (*.csv);;All Files (*)"));
    if (!path || path->isEmpty())
        return;
    busycursor busy(prompts_);
    std::vector<size_t> columns(coverage_.columns());
    for (size_t c = 0; c < columns.size(); ++c)
        columns[c] = c;
    std::string out;
    appendcoveragecsvheading(out, coverage_, columns);
    for (const int32_t k : model_->rows())
        appendcoveragecsvrow(out, index_->people[static_cast<size_t>(k)], coverage_, static_cast<size_t>(k), columns);
    QSaveFile f(*path);
    const bool ok = f.open(QIODevice::WriteOnly)
        && f.write(out.data(), static_cast<qint64>(out.size())) == static_cast<qint64>(out.size()) && f.commit();
    if (!ok)
        prompts_.tell(QStringLiteral("The census coverage could not be written to %1: %2")
                          .arg(QDir::toNativeSeparators(*path), f.errorString()),
                      icon::exclamation);
}

void coveragefrm::changeEvent(QEvent* event)
{
    // Back from the options, whose "Residence" may have changed without the
    // file being read again.
    if (event->type() == QEvent::ActivationChange && settings_->residence != residence_)
        setindex(*index_, *settings_);
    QDialog::changeEvent(event);
}

bool coveragefrm::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == grid_ && event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) {
            transcribecurrent();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

} // namespace qm

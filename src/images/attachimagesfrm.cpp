#include "images/attachimagesfrm.h"

#include "images/sourcedates.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "settings/settings.h"
#include "writer/saveprompts.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

Attachimagesfrm::Attachimagesfrm(gedcomindex& index, const settings& s, prompts& p, imagechooser chooser,
                                 QWidget* parent)
    : QDialog(parent), index_(index), settings_(s), prompts_(p), chooser_(std::move(chooser))
{
    setObjectName(QStringLiteral("Attachimagesfrm"));
    setWindowTitle(QStringLiteral("Attach Images to Existing Sources"));
    setModal(true);
    build();
    sourceopt_[1]->setChecked(true); // fills the list
    QString error;
    {
        busycursor busy(prompts_);
        error = findcensusdates(index_);
    }
    // Without the file the dates stay unknown; everything else still works.
    if (!error.isEmpty())
        prompts_.tell(error, icon::exclamation);
    sourcelst_->setFocus();
}

void Attachimagesfrm::build()
{
    auto* sourcesframe = named(new QGroupBox(QStringLiteral("Sources"), this), "sourcesframe", QStringLiteral("Sources"));
    sourcelst_ = named(new QListWidget(sourcesframe), "sourcelst", QStringLiteral("Sources"));
    sourcelst_->setMinimumWidth(320);
    // Big files have tens of thousands of sources: rows of one height fill fast.
    sourcelst_->setUniformItemSizes(true);
    const std::array<QString, 3> captions = {QStringLiteral("Show &all"), QStringLiteral("Show &census sources"),
                                             QStringLiteral("Show sources that contain te&xt: ")};
    for (size_t i = 0; i < captions.size(); ++i) {
        auto* o = new QRadioButton(captions[i], sourcesframe);
        o->setObjectName(QStringLiteral("sourceopt%1").arg(i));
        o->setAccessibleName(QString(captions[i]).remove(u'&').trimmed());
        sourceopt_[i] = o;
        connect(o, &QRadioButton::toggled, this, [this, i](bool on) {
            if (on)
                optionchosen(static_cast<int>(i));
        });
    }
    searchtxt_ = named(new QLineEdit(sourcesframe), "searchtxt", QStringLiteral("Text the source titles contain"));
    searchtxt_->installEventFilter(this);
    searchbut_ = named(new QPushButton(QStringLiteral("&Search"), sourcesframe), "searchbut", QStringLiteral("Search"));
    searchbut_->setAutoDefault(false);
    searchbut_->setEnabled(false);
    imagecountchk_ = named(new QCheckBox(QStringLiteral("Only show sources with &no images attached"), sourcesframe),
                           "imagecountchk", QStringLiteral("Only show sources with no images attached"));
    countlab_ = showsvalue(new QLabel(sourcesframe), QStringLiteral("countlab"),
                           QStringLiteral("Number of sources listed"));

    auto* search = new QHBoxLayout;
    search->addWidget(sourceopt_[2]);
    search->addWidget(searchtxt_, 1);
    search->addWidget(searchbut_);
    auto* sl = new QVBoxLayout(sourcesframe);
    sl->addWidget(sourcelst_, 1);
    sl->addWidget(sourceopt_[0]);
    sl->addWidget(sourceopt_[1]);
    sl->addLayout(search);
    auto* below = new QHBoxLayout;
    below->addWidget(imagecountchk_);
    below->addStretch(1);
    below->addWidget(countlab_);
    sl->addLayout(below);

    auto* selectedframe = named(new QGroupBox(QStringLiteral("Selected Source"), this), "selectedframe",
                                QStringLiteral("Selected Source"));
    titletxt_ = readonlybox(selectedframe, "titletxt", QStringLiteral("Source Title"));
    Datetxt_ = readonlybox(selectedframe, "Datetxt", QStringLiteral("Date"));
    indextxt_ = readonlybox(selectedframe, "indextxt", QStringLiteral("Source ID"));
    imagelst_ = named(new QListWidget(selectedframe), "imagelst", QStringLiteral("Attached Images"));
    individualslst_ = named(new QListWidget(selectedframe), "individualslst",
                            QStringLiteral("Individuals linked to this source"));
    individualslst_->setUniformItemSizes(true);
    attachbut_ = named(new QPushButton(QStringLiteral("Attach &images to this source"), selectedframe), "attachbut",
                       QStringLiteral("Attach images to this source"));
    attachbut_->setAutoDefault(false);
    attachbut_->setEnabled(false);

    auto* grid = new QGridLayout(selectedframe);
    int row = 0;
    addcaptioned(grid, row, QStringLiteral("Source &Title:"), titletxt_);
    addcaptioned(grid, row, QStringLiteral("Dat&e:"), Datetxt_);
    addcaptioned(grid, row, QStringLiteral("Source I&D:"), indextxt_);
    auto* imagecaption = new QLabel(QStringLiteral("Attached I&mages:"), selectedframe);
    imagecaption->setBuddy(imagelst_);
    grid->addWidget(imagecaption, row++, 0, 1, 2);
    grid->addWidget(imagelst_, row++, 0, 1, 2);
    auto* peoplecaption = new QLabel(QStringLiteral("Individuals &linked to this source:"), selectedframe);
    peoplecaption->setBuddy(individualslst_);
    grid->addWidget(peoplecaption, row++, 0, 1, 2);
    grid->addWidget(individualslst_, row++, 0, 1, 2);
    grid->addWidget(attachbut_, row++, 0, 1, 2);
    grid->setColumnStretch(1, 1);
    grid->setRowStretch(4, 1);
    grid->setRowStretch(6, 2);

    auto* okbut = named(new QPushButton(QStringLiteral("OK"), this), "okbut", QStringLiteral("OK"));
    okbut->setDefault(true);
    auto* helpbut = named(new QPushButton(QStringLiteral("&Help"), this), "helpbut", QStringLiteral("Help"));
    helpbut->setAutoDefault(false);

    auto* frames = new QHBoxLayout;
    frames->addWidget(sourcesframe, 3);
    frames->addWidget(selectedframe, 2);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(okbut);
    buttons->addWidget(helpbut);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(frames, 1);
    layout->addLayout(buttons);
    resize(980, 560);

    setTabOrder(sourcelst_, sourceopt_[0]);
    setTabOrder(sourceopt_[0], sourceopt_[1]);
    setTabOrder(sourceopt_[1], sourceopt_[2]);
    setTabOrder(sourceopt_[2], searchtxt_);
    setTabOrder(searchtxt_, searchbut_);
    setTabOrder(searchbut_, imagecountchk_);
    setTabOrder(imagecountchk_, titletxt_);
    setTabOrder(titletxt_, Datetxt_);
    setTabOrder(Datetxt_, indextxt_);
    setTabOrder(indextxt_, imagelst_);
    setTabOrder(imagelst_, individualslst_);
    setTabOrder(individualslst_, attachbut_);
    setTabOrder(attachbut_, okbut);
    setTabOrder(okbut, helpbut);

    connect(sourcelst_, &QListWidget::itemSelectionChanged, this, &Attachimagesfrm::sourcechosen);
    connect(searchtxt_, &QLineEdit::textEdited, this, &Attachimagesfrm::searchedited);
    connect(searchbut_, &QPushButton::clicked, this, &Attachimagesfrm::fill);
    connect(imagecountchk_, &QCheckBox::toggled, this, &Attachimagesfrm::fill);
    connect(attachbut_, &QPushButton::clicked, this, &Attachimagesfrm::attach);
    connect(okbut, &QPushButton::clicked, this, &QDialog::accept);
    connect(helpbut, &QPushButton::clicked, this, [this] { prompts_.showhelp(19); });
}

bool Attachimagesfrm::eventFilter(QObject* watched, QEvent* event)
{
    // Return in the search box searches rather than closing the dialog.
    if (watched == searchtxt_ && event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) {
            if (!searchtxt_->text().isEmpty())
                sourceopt_[2]->setChecked(true);
            if (sourceopt_[2]->isChecked())
                fill();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

void Attachimagesfrm::fill()
{
    sourcefilter filter = sourcefilter::census;
    if (sourceopt_[0]->isChecked())
        filter = sourcefilter::all;
    else if (sourceopt_[2]->isChecked())
        filter = sourcefilter::text;
    listed_ = filtersources(index_, filter, searchtxt_->text(), imagecountchk_->isChecked());
    // All rows in one go: a list of a big file's sources fills in a moment.
    QStringList titles;
    titles.reserve(static_cast<qsizetype>(listed_.size()));
    for (const int32_t k : listed_)
        titles << qs(index_.sources[static_cast<size_t>(k)].title);
    const QSignalBlocker block(sourcelst_);
    sourcelst_->clear();
    sourcelst_->addItems(titles);
    countlab_->setText(sourcecounttext(listed_.size()));
}

void Attachimagesfrm::optionchosen(int option)
{
    if (option == 2) {
        searchbut_->setEnabled(true);
        searchtxt_->setFocus();
        return;
    }
    searchtxt_->clear();
    searchbut_->setEnabled(false);
    fill();
}

void Attachimagesfrm::searchedited(const QString& text)
{
    if (!text.isEmpty() && !sourceopt_[2]->isChecked())
        sourceopt_[2]->setChecked(true);
}

void Attachimagesfrm::sourcechosen()
{
    const QList<QListWidgetItem*> items = sourcelst_->selectedItems();
    const int row = items.isEmpty() ? -1 : sourcelst_->row(items.front());
    if (row < 0 || static_cast<size_t>(row) >= listed_.size())
        return;
    source_ = listed_[static_cast<size_t>(row)];
    const sourcerec& s = index_.sources[static_cast<size_t>(source_)];
    titletxt_->setText(qs(s.title));
    titletxt_->setCursorPosition(0);
    indextxt_->setText(QString::number(s.id));
    Datetxt_->setText(sourcedatetext(s));
    imagelst_->clear();
    imagelst_->addItems(attachedimagetitles(index_, s));
    QStringList people;
    for (const int32_t k : citingpeople(index_, s.id))
        people << personlabel(index_.people[static_cast<size_t>(k)], settings_.idonly);
    individualslst_->clear();
    individualslst_->addItems(people);
    attachbut_->setEnabled(true);
}

void Attachimagesfrm::cleardetails()
{
    source_ = -1;
    titletxt_->clear();
    Datetxt_->clear();
    indextxt_->clear();
    imagelst_->clear();
    individualslst_->clear();
    attachbut_->setEnabled(false);
}

void Attachimagesfrm::closeonchange()
{
    prompts_.tell(attachchangedmessage(index_.gedcomfile), icon::exclamation);
    changed_ = true;
    reject();
}

void Attachimagesfrm::attach()
{
    if (source_ < 0)
        return;
    if (qm::filechanged(index_)) {
        closeonchange();
        return;
    }
    std::vector<imagechoice> chosen = chooser_ ? chooser_(titletxt_->text(), Datetxt_->text(), this)
                                               : std::vector<imagechoice>();
    const std::vector<imagechoice> dropped = dropalreadylinked(index_.sources[static_cast<size_t>(source_)], chosen);
    if (!dropped.empty())
        prompts_.tell(alreadylinkedmessage(dropped), icon::information);
    if (chosen.empty())
        return;
    // A change made while the user was choosing is caught by savechange().

    rewriterequest rq;
    rq.mode = rewritemode::attachimages;
    rq.entry.sourceid = indextxt_->text();
    rq.entry.title = titletxt_->text();
    rq.entry.chosenimages = chosen;
    saveoutcome out;
    {
        busycursor busy(prompts_);
        out = savechange(index_, settings_, rq);
    }
    switch (tellsaveoutcome(prompts_, out)) {
    case aftersave::saved:
        break;
    case aftersave::changed:
        closeonchange();
        return;
    case aftersave::stay:
        return;
    case aftersave::fatal:
        fatal_ = true;
        reject();
        return;
    }
    recordattached(index_, source_, chosen, out.newstamp);
    attached_ = true;
    cleardetails();
    fill();
    sourcelst_->setFocus();
}

} // namespace qm

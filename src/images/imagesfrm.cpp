#include "images/imagesfrm.h"

#include "images/currentimagesfrm.h"
#include "images/imagechoices.h"
#include "images/imagedetails_ui.h"
#include "images/imagepreview_ui.h"
#include "images/newimagefrm.h"
#include "model/gedcomindex.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

bool imagesfrm::choose(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                       prompts& p, std::vector<imagechoice>& chosen, QWidget* parent)
{
    imagesfrm f(r, index, s, store, p, parent);
    const bool kept = f.exec() == QDialog::Accepted;
    chosen = kept ? f.chosen() : std::vector<imagechoice>();
    return !f.cancelsave();
}

imagesfrm::imagesfrm(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                     prompts& p, QWidget* parent)
    : QDialog(parent), request_(r), index_(index), settings_(s), store_(store), prompts_(p)
{
    setObjectName(QStringLiteral("imagesfrm"));
    setWindowTitle(QStringLiteral("Census Images"));
    nextobjectid_ = firstobjectbase(index);
    build();
    sourcetitlelab_->setText(request_.sourcetitle);
    cleardetails();
    refill();
}

imagesfrm::~imagesfrm() = default;

void imagesfrm::build()
{
    auto* layout = new QVBoxLayout(this);
    auto* sourceline = new QHBoxLayout;
    sourceline->addWidget(new QLabel(QStringLiteral("Current Source:"), this));
    sourcetitlelab_ = showsvalue(new QLabel(this), QStringLiteral("sourcetitlelab"), QStringLiteral("Current Source"));
    sourcetitlelab_->setWordWrap(true);
    sourcetitlelab_->setTextInteractionFlags(Qt::TextSelectableByMouse);
    sourceline->addWidget(sourcetitlelab_, 1);
    layout->addLayout(sourceline);

    imagelab_ = new QLabel(this);
    imagelab_->setObjectName(QStringLiteral("imagelab"));
    imagelab_->setWordWrap(true);
    layout->addWidget(imagelab_);
    auto* middle = new QHBoxLayout;
    auto* listcol = new QVBoxLayout;
    newimageslst_ = new QListWidget(this);
    newimageslst_->setObjectName(QStringLiteral("newimageslst"));
    newimageslst_->setAccessibleName(QStringLiteral("Images to be attached"));
    newimageslst_->setMinimumWidth(300);
    imagelab_->setBuddy(newimageslst_);
    listcol->addWidget(newimageslst_, 1);
    auto* linkline = new QHBoxLayout;
    addcurrentimagebut_ = new QPushButton(QStringLiteral("Link &current image"), this);
    addcurrentimagebut_->setObjectName(QStringLiteral("addcurrentimagebut"));
    addcurrentimagebut_->setAccessibleName(QStringLiteral("Link current image"));
    addcurrentimagebut_->setToolTip(QStringLiteral("Choose an image already in Family Historian"));
    Addnewbut_ = new QPushButton(QStringLiteral("Link &new image"), this);
    Addnewbut_->setObjectName(QStringLiteral("Addnewbut"));
    Addnewbut_->setAccessibleName(QStringLiteral("Link new image"));
    Addnewbut_->setToolTip(QStringLiteral("Add a new image to Family Historian and link to this source"));
    linkline->addWidget(addcurrentimagebut_);
    linkline->addWidget(Addnewbut_);
    listcol->addLayout(linkline);
    middle->addLayout(listcol, 1);

    Imagefrm_ = new QGroupBox(QStringLiteral("Selected Image"), this);
    Imagefrm_->setObjectName(QStringLiteral("Imagefrm"));
    auto* frame = new QVBoxLayout(Imagefrm_);
    imagepic_ = addimagedetails(Imagefrm_, frame, {"Image ID:", "Title:", "File Path:", "File Type:", "Image Date:"},
                                Imageinfotxt_, prompts_);
    unlinkbut_ = new QPushButton(QStringLiteral("&Unlink this image"), Imagefrm_);
    unlinkbut_->setObjectName(QStringLiteral("unlinkbut"));
    unlinkbut_->setAccessibleName(QStringLiteral("Unlink this image"));
    unlinkbut_->setAutoDefault(false);
    frame->addWidget(unlinkbut_, 0, Qt::AlignLeft);
    frame->addStretch(1);
    middle->addWidget(Imagefrm_);
    layout->addLayout(middle, 1);

    // A row of plain buttons: "Cancel saving census" is left out of the second context.
    auto* buttons = new QHBoxLayout;
    const auto addbutton = [&](const QString& caption, const char* name, const QString& accessible) {
        auto* b = new QPushButton(caption, this);
        b->setObjectName(QString::fromLatin1(name));
        b->setAccessibleName(accessible);
        b->setAutoDefault(false);
        buttons->addWidget(b);
        return b;
    };
    buttons->addStretch(1);
    okbut_ = addbutton(QStringLiteral("OK"), "okbut", QStringLiteral("OK"));
    cancelbut_ = addbutton(QStringLiteral("&Do not attach image(s)"), "cancelbut", QStringLiteral("Do not attach image(s)"));
    Cancelcensusbut_ = addbutton(QStringLiteral("Cancel &saving census"), "Cancelcensusbut",
                                 QStringLiteral("Cancel saving census"));
    Cancelcensusbut_->setVisible(request_.context == 1);
    Cancelcensusbut_->setEnabled(request_.context == 1);
    auto* help = addbutton(QStringLiteral("&Help"), "helpbut", QStringLiteral("Help"));
    addcurrentimagebut_->setAutoDefault(false);
    Addnewbut_->setAutoDefault(false);
    okbut_->setDefault(true);
    layout->addLayout(buttons);

    connect(okbut_, &QPushButton::clicked, this, &QDialog::accept);
    // "Do not attach image(s)": no images; the Escape key and the close box do the same.
    connect(cancelbut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(Cancelcensusbut_, &QPushButton::clicked, this, [this] {
        cancelsave_ = true;
        reject();
    });
    connect(help, &QPushButton::clicked, this, [this] { prompts_.showhelp(18); });
    connect(addcurrentimagebut_, &QPushButton::clicked, this, &imagesfrm::linkcurrent);
    connect(Addnewbut_, &QPushButton::clicked, this, &imagesfrm::linknew);
    connect(unlinkbut_, &QPushButton::clicked, this, &imagesfrm::unlink);
    connect(newimageslst_, &QListWidget::itemSelectionChanged, this,
            [this] { rowchosen(newimageslst_->selectedItems().isEmpty() ? -1 : newimageslst_->currentRow()); });

    setTabOrder(newimageslst_, addcurrentimagebut_);
    setTabOrder(addcurrentimagebut_, Addnewbut_);
    setTabOrder(Addnewbut_, Imageinfotxt_[0]);
    for (int i = 0; i < 4; ++i)
        setTabOrder(Imageinfotxt_[i], Imageinfotxt_[i + 1]);
    setTabOrder(Imageinfotxt_[4], imagepic_->box());
    setTabOrder(imagepic_->box(), unlinkbut_);
    setTabOrder(unlinkbut_, okbut_);
    setTabOrder(okbut_, cancelbut_);
    setTabOrder(cancelbut_, Cancelcensusbut_);
    setTabOrder(Cancelcensusbut_, help);
}

void imagesfrm::refreshheading()
{
    const bool rows = !chosen_.empty();
    QString text = request_.fullentry ? QStringLiteral("Images to be attached to this source")
                                      : QStringLiteral("Images to be attached to the census source citations");
    text += rows ? QStringLiteral(" (click on image title to view details or to unlink from source):")
                 : QStringLiteral(":");
    imagelab_->setText(text);
}

void imagesfrm::refill()
{
    const QSignalBlocker quiet(newimageslst_);
    newimageslst_->clear();
    for (size_t i = 0; i < chosen_.size(); ++i) {
        auto* item = new QListWidgetItem(imagerow(static_cast<int>(i) + 1, chosen_[i]), newimageslst_);
        item->setData(Qt::UserRole, static_cast<int>(i));
    }
    refreshheading();
    okbut_->setEnabled(!chosen_.empty());
    if (!chosen_.empty()) {
        const int last = static_cast<int>(chosen_.size()) - 1;
        newimageslst_->setCurrentRow(last);
        rowchosen(last);
    }
}

void imagesfrm::cleardetails()
{
    for (QLineEdit* t : Imageinfotxt_)
        t->clear();
    imagepic_->clear();
    unlinkbut_->setEnabled(false);
}

void imagesfrm::rowchosen(int row)
{
    if (row < 0 || static_cast<size_t>(row) >= chosen_.size()) {
        cleardetails();
        return;
    }
    const imagechoice& c = chosen_[static_cast<size_t>(row)];
    Imageinfotxt_[0]->setText(QString::number(c.objectid));
    Imageinfotxt_[1]->setText(fulltitle(c));
    Imageinfotxt_[2]->setText(c.file);
    Imageinfotxt_[2]->setCursorPosition(static_cast<int>(c.file.size()));
    Imageinfotxt_[3]->setText(c.form);
    Imageinfotxt_[4]->setText(c.date);
    imagepic_->showfile(c.file);
    unlinkbut_->setEnabled(true);
}

void imagesfrm::unlink()
{
    const int row = newimageslst_->selectedItems().isEmpty() ? -1 : newimageslst_->currentRow();
    if (row < 0 || static_cast<size_t>(row) >= chosen_.size())
        return;
    // The O number is not given back: a later new image takes the next one.
    chosen_.erase(chosen_.begin() + row);
    cleardetails();
    refill();
    if (chosen_.empty())
        Addnewbut_->setFocus();
}

void imagesfrm::linkcurrent()
{
    currentimagesfrm::pick(index_, prompts_, chosen_, this);
    cleardetails();
    refill();
}

void imagesfrm::linknew()
{
    newimagefrm::add(request_, index_, settings_, store_, prompts_, chosen_, nextobjectid_, this);
    cleardetails();
    refill();
}

} // namespace qm

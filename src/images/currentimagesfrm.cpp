#include "images/currentimagesfrm.h"

#include "images/imagechoices.h"
#include "images/imagedetails_ui.h"
#include "images/imagepreview_ui.h"
#include "model/gedcomindex.h"
#include "platform/encoding.h"
#include "platform/prompts.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

bool currentimagesfrm::pick(const gedcomindex& index, prompts& p, std::vector<imagechoice>& chosen, QWidget* parent)
{
    currentimagesfrm f(index, p, chosen, parent);
    return f.exec() == QDialog::Accepted;
}

currentimagesfrm::currentimagesfrm(const gedcomindex& index, prompts& p, std::vector<imagechoice>& chosen,
                                   QWidget* parent)
    : QDialog(parent), index_(index), prompts_(p), chosen_(chosen)
{
    setObjectName(QStringLiteral("currentimagesfrm"));
    setWindowTitle(QStringLiteral("Choose current image to link"));
    build();
    fill();
    imageslst_->setFocus();
}

void currentimagesfrm::build()
{
    auto* layout = new QVBoxLayout(this);
    auto* columns = new QHBoxLayout;
    auto* left = new QVBoxLayout;
    auto* listlab = new QLabel(QStringLiteral("Choose an &image from the list:"), this);
    imageslst_ = new QListWidget(this);
    imageslst_->setObjectName(QStringLiteral("imageslst"));
    imageslst_->setAccessibleName(QStringLiteral("Images in the family file"));
    imageslst_->setMinimumWidth(340);
    imageslst_->setUniformItemSizes(true);
    listlab->setBuddy(imageslst_);
    left->addWidget(listlab);
    left->addWidget(imageslst_, 1);
    censuschk_ = new QCheckBox(
        QStringLiteral("Only show images with the word 'census' in the title or file &path."), this);
    censuschk_->setObjectName(QStringLiteral("censuschk"));
    censuschk_->setAccessibleName(QStringLiteral("Only show census images"));
    showtitlesopt_ = new QRadioButton(QStringLiteral("Show image &titles"), this);
    showtitlesopt_->setObjectName(QStringLiteral("showtitlesopt"));
    showtitlesopt_->setAccessibleName(QStringLiteral("Show image titles"));
    showtitlesopt_->setChecked(true);
    showpathsopt_ = new QRadioButton(QStringLiteral("Show image file &names"), this);
    showpathsopt_->setObjectName(QStringLiteral("showpathsopt"));
    showpathsopt_->setAccessibleName(QStringLiteral("Show image file names"));
    left->addWidget(censuschk_);
    left->addWidget(showtitlesopt_);
    left->addWidget(showpathsopt_);
    columns->addLayout(left, 1);

    Imageframe_ = new QGroupBox(QStringLiteral("Image Details"), this);
    Imageframe_->setObjectName(QStringLiteral("Imageframe"));
    auto* frame = new QVBoxLayout(Imageframe_);
    imagepic_ = addimagedetails(Imageframe_, frame, {"Title:", "Image ID:", "File Path:", "File Type:", "Image Date:"},
                                Imageinfotxt_, prompts_);
    frame->addStretch(1);
    Imageframe_->setEnabled(false);
    columns->addWidget(Imageframe_);
    layout->addLayout(columns, 1);

    auto* buttons = new QDialogButtonBox(this);
    okbut_ = buttons->addButton(QStringLiteral("OK"), QDialogButtonBox::AcceptRole);
    okbut_->setObjectName(QStringLiteral("okbut"));
    okbut_->setAccessibleName(QStringLiteral("OK"));
    okbut_->setDefault(true);
    okbut_->setEnabled(false);
    cancelbut_ = buttons->addButton(QStringLiteral("Cancel"), QDialogButtonBox::RejectRole);
    cancelbut_->setObjectName(QStringLiteral("cancelbut"));
    cancelbut_->setAccessibleName(QStringLiteral("Cancel"));
    auto* help = buttons->addButton(QStringLiteral("&Help"), QDialogButtonBox::HelpRole);
    help->setObjectName(QStringLiteral("HelpBut"));
    help->setAccessibleName(QStringLiteral("Help"));
    layout->addWidget(buttons);

    connect(okbut_, &QPushButton::clicked, this, &currentimagesfrm::okclicked);
    connect(cancelbut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(help, &QPushButton::clicked, this, [this] { prompts_.showhelp(24); });
    connect(censuschk_, &QCheckBox::toggled, this, &currentimagesfrm::fill);
    connect(showtitlesopt_, &QRadioButton::toggled, this, &currentimagesfrm::fill);
    // The selection, not the current row: the list makes its first row current
    // without selecting it when it takes the focus.
    connect(imageslst_, &QListWidget::itemSelectionChanged, this, &currentimagesfrm::rowchosen);
    connect(imageslst_, &QListWidget::itemDoubleClicked, this, &currentimagesfrm::okclicked);

    setTabOrder(imageslst_, censuschk_);
    setTabOrder(censuschk_, showtitlesopt_);
    setTabOrder(showtitlesopt_, showpathsopt_);
    setTabOrder(showpathsopt_, Imageinfotxt_[0]);
    for (size_t i = 0; i < 4; ++i)
        setTabOrder(Imageinfotxt_[i], Imageinfotxt_[i + 1]);
    setTabOrder(Imageinfotxt_[4], imagepic_->box());
    setTabOrder(imagepic_->box(), okbut_);
    setTabOrder(okbut_, cancelbut_);
    setTabOrder(cancelbut_, help);
}

void currentimagesfrm::fill()
{
    busycursor busy(prompts_);
    const QSignalBlocker quiet(imageslst_);
    imageslst_->clear();
    const bool onlycensus = censuschk_->isChecked();
    const bool titles = showtitlesopt_->isChecked();
    for (size_t i = 0; i < index_.objects.size(); ++i) {
        const objectrec& o = index_.objects[i];
        if (onlycensus && !mentionscensus(o))
            continue;
        auto* item = new QListWidgetItem(titles ? qs(o.title) : pathrow(qs(o.file)), imageslst_);
        item->setData(Qt::UserRole, static_cast<int>(i));
    }
    // A refilled list has no row chosen.
    for (QLineEdit* t : Imageinfotxt_)
        t->clear();
    imagepic_->clear();
    okbut_->setEnabled(false);
    Imageframe_->setEnabled(false);
}

int currentimagesfrm::selectedobject() const
{
    const QListWidgetItem* item = imageslst_->currentItem();
    if (!item || !item->isSelected())
        return -1;
    const int k = item->data(Qt::UserRole).toInt();
    return k >= 0 && static_cast<size_t>(k) < index_.objects.size() ? k : -1;
}

void currentimagesfrm::rowchosen()
{
    const int k = selectedobject();
    if (k < 0)
        return;
    const objectrec& o = index_.objects[static_cast<size_t>(k)];
    Imageinfotxt_[0]->setText(qs(o.title));
    Imageinfotxt_[1]->setText(QString::number(o.id));
    Imageinfotxt_[2]->setText(qs(o.file));
    Imageinfotxt_[2]->setCursorPosition(static_cast<int>(qs(o.file).size()));
    Imageinfotxt_[3]->setText(qs(o.form));
    Imageinfotxt_[4]->setText(qs(o.date));
    // The path exactly as the family file gives it.
    imagepic_->showfile(qs(o.file));
    okbut_->setEnabled(true);
    Imageframe_->setEnabled(true);
}

void currentimagesfrm::okclicked()
{
    const int k = selectedobject();
    if (k < 0)
        return;
    const objectrec& o = index_.objects[static_cast<size_t>(k)];
    if (const QString refused = refuseexistingimage(o.id, chosen_); !refused.isEmpty()) {
        prompts_.tell(refused);
        return;
    }
    addexistingimage(chosen_, o);
    accept();
}

} // namespace qm

#include "images/newimagefrm.h"

#include "images/imagechoices.h"
#include "images/imagepreview_ui.h"
#include "platform/formparts_ui.h"
#include "platform/paths.h"
#include "platform/prompts.h"
#include "settings/settings.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QDialogButtonBox>
#include <QDir>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

namespace {

const QString owntitleprompt = QStringLiteral("Type your own title here...");

} // namespace

bool newimagefrm::add(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                      prompts& p, std::vector<imagechoice>& chosen, int32_t& nextobjectid, QWidget* parent)
{
    newimagefrm f(r, index, s, store, p, chosen, nextobjectid, parent);
    return f.exec() == QDialog::Accepted;
}

QString newimagefrm::filefilter()
{
    return QStringLiteral("Image Files (*.bmp *.jpg *.jpeg *.pcx *.tif *.png *.tga *.wmf);;"
                          "Bitmap Files (*.bmp);;JPEG Files (*.jpg *.jpeg);;PCX Files (*.pcx);;TIFF Files (*.tif);;"
                          "PNG Files (*.png);;Targa TGA Files (*.tga);;Placeable Metafiles (*.wmf);;All Files (*)");
}

newimagefrm::newimagefrm(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                         prompts& p, std::vector<imagechoice>& chosen, int32_t& nextobjectid, QWidget* parent)
    : QDialog(parent), request_(r), index_(index), settings_(s), store_(store), prompts_(p), chosen_(chosen),
      nextobjectid_(nextobjectid)
{
    setObjectName(QStringLiteral("newimagefrm"));
    setWindowTitle(QStringLiteral("Add a new image..."));
    build();

    const imagedialogvalues v = readimagevalues(store_, settings_);
    folder_ = v.folder;
    renamechk_->setChecked(v.rename);
    referenceavailable_ = request_.context != 2 && !request_.referencebase.trimmed().isEmpty();
    titleopt_[3]->setEnabled(referenceavailable_);
    titletxt_[3]->setEnabled(referenceavailable_);
    if (!referenceavailable_)
        titletxt_[3]->setText(QStringLiteral("No reference for this census was specified"));
    int option = v.option;
    if (option == 3 && !referenceavailable_)
        option = request_.context == 2 ? 2 : 0;
    titleopt_[static_cast<size_t>(option)]->setChecked(true);
    optionchosen(option);
    imageframe_->setEnabled(false);
    addbut_->setEnabled(false);
    choosefilebut_->setFocus();
}

void newimagefrm::build()
{
    auto* layout = new QVBoxLayout(this);
    auto* prompt = new QLabel(QStringLiteral("Select the image file you wish to link:"), this);
    layout->addWidget(prompt);
    auto* fileline = new QHBoxLayout;
    auto* pathlab = new QLabel(QStringLiteral("File &Path:"), this);
    filenametxt_ = readonlybox(this, "filenametxt", QStringLiteral("File Path"));
    filenametxt_->setMinimumWidth(420);
    pathlab->setBuddy(filenametxt_);
    choosefilebut_ = new QPushButton(QStringLiteral("..."), this);
    choosefilebut_->setObjectName(QStringLiteral("choosefilebut"));
    choosefilebut_->setAccessibleName(QStringLiteral("Choose the image file"));
    choosefilebut_->setToolTip(QStringLiteral("Choose the image file (Alt+F)"));
    choosefilebut_->setShortcut(QKeySequence(QStringLiteral("Alt+F")));
    choosefilebut_->setAutoDefault(false);
    fileline->addWidget(pathlab);
    fileline->addWidget(filenametxt_, 1);
    fileline->addWidget(choosefilebut_);
    layout->addLayout(fileline);

    imageframe_ = new QGroupBox(QStringLiteral("Image Details"), this);
    imageframe_->setObjectName(QStringLiteral("imageframe"));
    auto* grid = new QGridLayout(imageframe_);
    auto* typelab = new QLabel(QStringLiteral("File Type:"), imageframe_);
    filetypetxt_ = readonlybox(imageframe_, "filetypetxt", QStringLiteral("File Type"));
    auto* datelab = new QLabel(QStringLiteral("Image Date:"), imageframe_);
    Datetxt_ = readonlybox(imageframe_, "Datetxt", QStringLiteral("Image Date"));
    grid->addWidget(typelab, 0, 0);
    grid->addWidget(filetypetxt_, 0, 1);
    grid->addWidget(datelab, 1, 0);
    grid->addWidget(Datetxt_, 1, 1);

    auto* previewcol = new QVBoxLayout;
    previewcol->addWidget(new QLabel(QStringLiteral("Image preview:"), imageframe_));
    imagepic_ = new imagepreview(prompts_, QSize(200, 200), imageframe_);
    previewcol->addWidget(imagepic_);
    previewcol->addWidget(new QLabel(QStringLiteral("(Click on image to see full-size version)"), imageframe_));
    previewcol->addStretch(1);
    grid->addLayout(previewcol, 0, 2, 8, 1);

    grid->addWidget(new QLabel(QStringLiteral("Choose image title:"), imageframe_), 2, 0, 1, 2);
    static const char* const captions[4] = {"(&Same as the filename)", "(&derived from the source name)",
                                            "&Own title", "(derived from the &reference)"};
    static const char* const accessible[4] = {"Title same as the filename", "Title derived from the source name",
                                              "Own title", "Title derived from the reference"};
    auto* group = new QButtonGroup(this);
    for (int i = 0; i < 4; ++i) {
        auto* o = new QRadioButton(QString::fromLatin1(captions[i]), imageframe_);
        o->setObjectName(QStringLiteral("titleopt%1").arg(i));
        o->setAccessibleName(QString::fromLatin1(accessible[i]));
        auto* t = new QLineEdit(imageframe_);
        t->setObjectName(QStringLiteral("titletxt%1").arg(i));
        t->setAccessibleName(QString::fromLatin1(accessible[i]));
        t->setReadOnly(true);
        t->setMinimumWidth(300);
        group->addButton(o, i);
        titleopt_[static_cast<size_t>(i)] = o;
        titletxt_[static_cast<size_t>(i)] = t;
        grid->addWidget(o, 3 + i, 0);
        grid->addWidget(t, 3 + i, 1);
    }
    titletxt_[2]->setText(owntitleprompt);
    connect(group, &QButtonGroup::idClicked, this, &newimagefrm::optionchosen);
    renamechk_ = new QCheckBox(QStringLiteral("Re&name the file to match the title?"), imageframe_);
    renamechk_->setObjectName(QStringLiteral("renamechk"));
    renamechk_->setAccessibleName(QStringLiteral("Rename the file to match the title"));
    grid->addWidget(renamechk_, 7, 0, 1, 2);
    grid->setColumnStretch(1, 1);
    layout->addWidget(imageframe_);

    auto* buttons = new QDialogButtonBox(this);
    addbut_ = buttons->addButton(QStringLiteral("OK"), QDialogButtonBox::AcceptRole);
    addbut_->setObjectName(QStringLiteral("addbut"));
    addbut_->setAccessibleName(QStringLiteral("OK"));
    addbut_->setDefault(true);
    cancelbut_ = buttons->addButton(QStringLiteral("Cancel"), QDialogButtonBox::RejectRole);
    cancelbut_->setObjectName(QStringLiteral("cancelbut"));
    cancelbut_->setAccessibleName(QStringLiteral("Cancel"));
    auto* help = buttons->addButton(QStringLiteral("&Help"), QDialogButtonBox::HelpRole);
    help->setObjectName(QStringLiteral("helpbut"));
    help->setAccessibleName(QStringLiteral("Help"));
    layout->addWidget(buttons);
    // The buttons act themselves: OK may refuse and keep the dialog open.
    connect(addbut_, &QPushButton::clicked, this, &newimagefrm::addclicked);
    connect(cancelbut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(help, &QPushButton::clicked, this, [this] { prompts_.showhelp(23); });
    connect(choosefilebut_, &QPushButton::clicked, this, &newimagefrm::choosefile);

    setTabOrder(choosefilebut_, filenametxt_);
    setTabOrder(filenametxt_, titleopt_[0]);
    for (size_t i = 0; i < 4; ++i) {
        setTabOrder(titleopt_[i], titletxt_[i]);
        if (i < 3)
            setTabOrder(titletxt_[i], titleopt_[i + 1]);
    }
    setTabOrder(titletxt_[3], renamechk_);
    setTabOrder(renamechk_, imagepic_->box());
    setTabOrder(imagepic_->box(), addbut_);
    setTabOrder(addbut_, cancelbut_);
    setTabOrder(cancelbut_, help);
}

int newimagefrm::selectedoption() const
{
    for (int i = 0; i < 4; ++i)
        if (titleopt_[static_cast<size_t>(i)]->isChecked())
            return i;
    return 0;
}

void newimagefrm::optionchosen(int option)
{
    // Only the own title takes typing, and only while it is chosen.
    titletxt_[2]->setReadOnly(option != 2);
    if (option == 2) {
        titletxt_[2]->selectAll();
        titletxt_[2]->setFocus();
    }
    renamechk_->setEnabled(option != 0);
}

void newimagefrm::resetdetails()
{
    filenametxt_->clear();
    filetypetxt_->clear();
    Datetxt_->clear();
    titletxt_[0]->clear();
    titletxt_[1]->clear();
    titletxt_[2]->setText(owntitleprompt);
    if (referenceavailable_)
        titletxt_[3]->clear();
    imageframe_->setEnabled(false);
    addbut_->setEnabled(false);
}

void newimagefrm::choosefile()
{
    const std::optional<QString> chosenpath =
        prompts_.openfile(QStringLiteral("Select the image file you wish to link"), folder_, filefilter());
    if (!chosenpath)
        return;
    const QString path = QDir::toNativeSeparators(*chosenpath);
    folder_ = folderof(path);
    saveimagefolder(store_, path);

    if (const QString refused = refusenewimage(path, chosen_, index_); !refused.isEmpty()) {
        prompts_.tell(refused);
        return;
    }
    addbut_->setEnabled(false);
    filenametxt_->setText(path);
    filenametxt_->setCursorPosition(static_cast<int>(path.size()));
    filetypetxt_->setText(imagefiletype(path));

    const imagepreview::outcome shown = imagepic_->showfile(path);
    if (shown == imagepreview::outcome::notfound || shown == imagepreview::outcome::failed) {
        resetdetails();
        return;
    }
    Datetxt_->setText(request_.imagedate);
    titletxt_[0]->setText(titlefromfilename(path));
    sourcenumber_ = nexttitlenumber(chosen_, request_.sourcebase);
    titletxt_[1]->setText(fulltitle(request_.sourcebase, sourcenumber_));
    if (referenceavailable_) {
        referencenumber_ = nexttitlenumber(chosen_, request_.referencebase);
        titletxt_[3]->setText(fulltitle(request_.referencebase, referencenumber_));
    }
    imageframe_->setEnabled(true);
    addbut_->setEnabled(true);
}

void newimagefrm::addclicked()
{
    const QString path = filenametxt_->text();
    if (path.isEmpty())
        return;
    const int option = selectedoption();
    QString title;
    int number = 1;
    switch (option) {
    case 0:
        title = titletxt_[0]->text().trimmed();
        break;
    case 2:
        if (titletxt_[2]->text().isEmpty() || titletxt_[2]->text().startsWith(QLatin1String("Type your own"))) {
            prompts_.tell(QStringLiteral("You have selected the option to create your own custom title, but have not "
                                         "typed a title in yet."));
            titletxt_[2]->setFocus();
            return;
        }
        title = titletxt_[2]->text().trimmed();
        break;
    case 1:
        title = request_.sourcebase;
        number = sourcenumber_;
        break;
    case 3:
        title = request_.referencebase;
        number = referencenumber_;
        break;
    }
    if (title.trimmed().isEmpty()) {
        prompts_.tell(QStringLiteral("The title chosen for the image is empty. Please choose or type another title."));
        return;
    }
    QString file = path;
    if (renamechk_->isChecked() && renamechk_->isEnabled()) {
        const renameresult renamed = renametotitle(path, fulltitle(title, number), settings_);
        if (!renamed.ok()) {
            prompts_.tell(renamed.message);
            return;
        }
        if (!renamed.logerror.isEmpty())
            prompts_.tell(renamed.logerror, icon::critical);
        file = renamed.path;
    }
    addnewimage(chosen_, nextobjectid_, file, title, number, Datetxt_->text());
    saveimagechoice(store_, option, renamechk_->isChecked());
    accept();
}

} // namespace qm

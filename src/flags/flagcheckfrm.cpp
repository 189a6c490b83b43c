#include "flags/flagcheckfrm.h"

#include "flags/flagcheckcountryfrm.h"
#include "model/gedcomindex.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "settings/settings.h"
#include "writer/saveprompts.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

namespace {

QListWidget* rowlist(const QString& name, const QString& accessible, QWidget* parent)
{
    auto* l = named(new QListWidget(parent), name, accessible);
    l->setSelectionMode(QAbstractItemView::SingleSelection);
    l->setMinimumSize(520, 140);
    return l;
}

} // namespace

flagcheckfrm::flagcheckfrm(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent)
    : QDialog(parent), index_(index), settings_(s), store_(store), prompts_(p)
{
    setObjectName(QStringLiteral("flagcheckfrm"));
    setWindowTitle(QStringLiteral("Flag Check"));
    setModal(true);

    auto* addcaption = new QLabel(QStringLiteral("Flags that need to be &added to individuals:"), this);
    addlst_ = rowlist(QStringLiteral("addlst"), QStringLiteral("Flags that need to be added to individuals"), this);
    addcaption->setBuddy(addlst_);
    auto* removecaption = new QLabel(QStringLiteral("Flags that need to be &removed from individuals:"), this);
    removelst_ = rowlist(QStringLiteral("removelst"), QStringLiteral("Flags that need to be removed from individuals"),
                         this);
    removecaption->setBuddy(removelst_);

    flagschk_ = named(new QCheckBox(QStringLiteral("Al&ways run a flag check to check that flags are up to date each "
                                                   "time Quillmark loads family history files."),
                                    this),
                      "flagschk", QStringLiteral("Always run a flag check each time Quillmark loads family history files"));

    Changebut_ = plainbutton(this, "Changebut", QStringLiteral("&Make required changes"),
                             QStringLiteral("Make required changes"));
    closebut_ = named(new QPushButton(QStringLiteral("&Don't make changes"), this), "closebut",
                      QStringLiteral("Don't make changes"));
    closebut_->setDefault(true);
    helpbut_ = plainbutton(this, "helpbut", QStringLiteral("&Help"), QStringLiteral("Help"));

    auto* buttons = new QHBoxLayout;
    buttons->addWidget(Changebut_);
    buttons->addWidget(closebut_);
    buttons->addStretch(1);
    buttons->addWidget(helpbut_);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(addcaption);
    layout->addWidget(addlst_, 1);
    layout->addWidget(removecaption);
    layout->addWidget(removelst_, 1);
    layout->addWidget(flagschk_);
    layout->addLayout(buttons);

    setTabOrder(addlst_, removelst_);
    setTabOrder(removelst_, flagschk_);
    setTabOrder(flagschk_, Changebut_);
    setTabOrder(Changebut_, closebut_);
    setTabOrder(closebut_, helpbut_);

    connect(Changebut_, &QPushButton::clicked, this, &flagcheckfrm::makechanges);
    connect(closebut_, &QPushButton::clicked, this, &QDialog::reject);
    connect(helpbut_, &QPushButton::clicked, this, [this] { prompts_.showhelp(55); });
    connect(flagschk_, &QCheckBox::toggled, this, &flagcheckfrm::flagschanged);

    // The check runs as the dialog loads; a cancelled country question ends it.
    const countryasker ask = [this](const countryquestion& q) {
        const personrec& p = index_.people[static_cast<size_t>(q.person)];
        return flagcheckcountryfrm::ask(q, qs(p.name), p.id, this);
    };
    check_ = checkflags(index_, true, settings_.country, ask);
    if (check_.cancelled)
        prompts_.tell(flagcheckcancelledmessage());
    {
        busycursor busy(prompts_);
        addlst_->addItems(check_.addlist());
        removelst_->addItems(check_.removelist());
    }
    Changebut_->setEnabled(check_.canchange());

    loading_ = true;
    flagschk_->setChecked(settings_.flagcheck);
    loading_ = false;
    closebut_->setFocus();
}

void flagcheckfrm::flagschanged(bool on)
{
    if (loading_)
        return;
    settings_.flagcheck = on;
    saveflagsettings(store_, settings_);
}

void flagcheckfrm::makechanges()
{
    if (!check_.canchange() || !prompts_.yes(flagchangesquestion(), icon::exclamation))
        return;
    rewriterequest request;
    request.mode = rewritemode::flagchanges;
    request.flagchanges = check_.changes;
    saveoutcome out;
    {
        busycursor busy(prompts_);
        out = savechange(index_, settings_, request);
    }
    switch (tellsaveoutcome(prompts_, out)) {
    case aftersave::saved:
        index_.gedcomdate = out.newstamp;
        end_ = toolend::reload;
        accept();
        return;
    case aftersave::changed:
        prompts_.tell(flagsfilechangedmessage(index_.gedcomfile));
        end_ = toolend::reload;
        accept();
        return;
    case aftersave::stay:
        // Nothing was written: the dialog stays.
        return;
    case aftersave::fatal:
        end_ = toolend::fatal;
        accept();
        return;
    }
}

toolend flagcheckfrm::open(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent)
{
    flagcheckfrm dialog(index, s, store, p, parent);
    if (dialog.cancelled())
        return toolend::unchanged;
    dialog.exec();
    return dialog.outcome();
}

bool flagcheckfrm::run(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent)
{
    return open(index, s, store, p, parent) != toolend::unchanged;
}

} // namespace qm

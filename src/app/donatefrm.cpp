#include "app/donatefrm.h"

#include "app/milestone.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

QString donationpage()
{
    return QStringLiteral("https://quillmark.org/donate");
}

QString regulardonationpage()
{
    return QStringLiteral("https://quillmark.org/donate/regular");
}

donatefrm::donatefrm(prompts& opener, std::optional<int64_t> milestone, QWidget* parent)
    : QDialog(parent), opener_(opener)
{
    setObjectName(QStringLiteral("donatefrm"));
    setWindowTitle(milestone ? QStringLiteral("Milestone") : QStringLiteral("Would you like to make a donation?"));
    setModal(true);

    auto* mainlab = showsvalue(new QLabel(milestone ? milestonetext(*milestone) : QString(), this),
                               QStringLiteral("mainlab"), QStringLiteral("Milestone"));
    mainlab->setWordWrap(true);
    QFont bold = mainlab->font();
    bold.setBold(true);
    mainlab->setFont(bold);
    mainlab->setVisible(milestone.has_value());

    auto* asklab = new QLabel(
        QStringLiteral("Quillmark is free. It is written and kept up to date in its authors' own time, and donations "
                       "pay for the web site, for testing against new versions of Family Historian and for new "
                       "census years and countries.\n\nIf Quillmark saves you time with your family history, please "
                       "consider making a donation, once or regularly. Either button opens the donation page in your "
                       "web browser; nothing is sent from this program."),
        this);
    asklab->setObjectName(QStringLiteral("asklab"));
    asklab->setWordWrap(true);

    auto* once = named(new QPushButton(QStringLiteral("Make a &Donation..."), this), "donatebut",
                       QStringLiteral("Make a donation"));
    auto* regular = named(new QPushButton(QStringLiteral("Make a &Regular Donation..."), this), "regularbut",
                          QStringLiteral("Make a regular donation"));
    auto* close = named(new QPushButton(QStringLiteral("Close"), this), "closebut", QStringLiteral("Close"));
    close->setDefault(true);

    // A failure to open the page is not reported: the browser shows its own.
    connect(once, &QPushButton::clicked, this, [this] { opener_.openexternal(donationpage()); });
    connect(regular, &QPushButton::clicked, this, [this] { opener_.openexternal(regulardonationpage()); });
    connect(close, &QPushButton::clicked, this, &QDialog::accept);

    auto* buttons = new QDialogButtonBox(this);
    buttons->addButton(once, QDialogButtonBox::ActionRole);
    buttons->addButton(regular, QDialogButtonBox::ActionRole);
    buttons->addButton(close, QDialogButtonBox::RejectRole);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(mainlab);
    layout->addWidget(asklab);
    layout->addStretch(1);
    layout->addWidget(buttons);
    setMinimumWidth(fontMetrics().averageCharWidth() * 64);
    close->setFocus();
}

} // namespace qm

#include "census/householdcheckfrm.h"

#include "platform/formparts_ui.h"

#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace qm {

householdcheckfrm::householdcheckfrm(const std::vector<householdfinding>& findings, QWidget* parent)
    : QDialog(parent), findings_(findings)
{
    setObjectName(QStringLiteral("householdcheckfrm"));
    setWindowTitle(QStringLiteral("Household Check"));
    setModal(true);

    const bool warnings = anywarning(findings);
    auto* intro = new QLabel(warnings ? QStringLiteral("Compared with your family file, this household may hold "
                                                       "mistakes. Check each row below against the census before "
                                                       "saving.")
                                      : QStringLiteral("Compared with your family file, this household holds "
                                                       "something you may want to know before saving."),
                             this);
    intro->setWordWrap(true);

    findingslst_ = named(new QTreeWidget(this), "findingslst", QStringLiteral("Findings"));
    findingslst_->setColumnCount(3);
    findingslst_->setHeaderLabels({QStringLiteral("Row"), QStringLiteral("Kind"), QStringLiteral("Finding")});
    findingslst_->setRootIsDecorated(false);
    findingslst_->setWordWrap(true);
    findingslst_->setUniformRowHeights(false);
    findingslst_->header()->setStretchLastSection(true);
    for (const householdfinding& f : findings) {
        auto* item = new QTreeWidgetItem(
            findingslst_, {QString::number(f.row + 1),
                           f.severity == findingseverity::warning ? QStringLiteral("Warning") : QStringLiteral("Note"),
                           f.message});
        item->setToolTip(2, f.message);
    }
    findingslst_->resizeColumnToContents(0);
    findingslst_->resizeColumnToContents(1);
    if (findingslst_->topLevelItemCount() > 0)
        findingslst_->setCurrentItem(findingslst_->topLevelItem(0));
    intro->setBuddy(findingslst_);

    auto* savebut = plainbutton(this, "savebut", QStringLiteral("Save anyway"), QStringLiteral("Save anyway"));
    auto* backbut = new QPushButton(QStringLiteral("Go back"), this);
    backbut->setObjectName(QStringLiteral("backbut"));
    backbut->setToolTip(QStringLiteral("Return to the entry at the row of the finding chosen"));
    backbut->setDefault(true);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(savebut);
    buttons->addWidget(backbut);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(intro);
    layout->addWidget(findingslst_, 1);
    layout->addLayout(buttons);
    resize(760, 320);
    findingslst_->setFocus();

    connect(savebut, &QPushButton::clicked, this, &QDialog::accept);
    connect(backbut, &QPushButton::clicked, this, &QDialog::reject);
    // Enter or a double click on a finding goes back to its row.
    connect(findingslst_, &QTreeWidget::itemActivated, this, &QDialog::reject);
}

int householdcheckfrm::chosenrow() const
{
    const int k = findingslst_->indexOfTopLevelItem(findingslst_->currentItem());
    if (findings_.empty())
        return -1;
    return findings_[static_cast<size_t>(k < 0 ? 0 : k)].row;
}

std::optional<int> householdcheckfrm::ask(const std::vector<householdfinding>& findings, QWidget* parent)
{
    if (findings.empty())
        return std::nullopt;
    householdcheckfrm dialog(findings, parent);
    if (dialog.exec() == QDialog::Accepted)
        return std::nullopt;
    return dialog.chosenrow();
}

} // namespace qm

#include "app/mainfrm.h"
#include "census/entrypanel_ui.h"
#include "platform/prompts.h"
#include "tools/coveragefrm.h"

#include <QComboBox>

namespace qm {

// "Census Coverage...": one window, not modal, brought to the front when open.
void mainfrm::opencoverage()
{
    if (!file_.index())
        return;
    if (!coverage_) {
        coverage_ = new coveragefrm(*file_.index(), file_.currentsettings(), prompts_,
                                    [this](int32_t k, int year) { transcribegap(k, year); }, this);
        coverage_->setAttribute(Qt::WA_DeleteOnClose);
    }
    coverage_->show();
    coverage_->raise();
    coverage_->activateWindow();
}

// A missing cell chosen in the grid: its census year in the form (a household
// of another year being entered is given up only when the user agrees), the
// individual chosen and the immediate family shown around it, as after Find.
void mainfrm::transcribegap(int32_t k, int year)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size())
        return;
    QComboBox* years = form_->panel()->yearcom;
    const QString wanted = QString::number(year);
    if (years->currentIndex() < 0 || years->currentText().trimmed() != wanted) {
        if (household_->rows().selectioncount > 0) {
            if (!prompts_.yes(QStringLiteral("The census entry you are making has not been saved. Do you want to "
                                             "clear it and start an entry for the census of %1?")
                                  .arg(wanted),
                              icon::exclamation, answer::no))
                return;
            clearentry();
        }
        const int item = years->findText(wanted);
        if (item < 0)
            return;
        years->setCurrentIndex(item);
    }
    household_->showfound(k);
    raise();
    activateWindow();
}

} // namespace qm

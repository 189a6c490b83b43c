#include "census/household_ui.h"

#include "census/entryform_ui.h"
#include "census/householdpanel_ui.h"
#include "model/dates.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "writer/openfile.h"

#include <QCheckBox>
#include <QFrame>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPushButton>

#include <algorithm>

namespace qm {

householdform::householdform(openfile& file, prompts& p, censusform& form, QWidget* parent)
    : QObject(parent), file_(file), prompts_(p), form_(form)
{
    findbut_ = new QPushButton(QStringLiteral("Find..."), parent);
    findbut_->setObjectName(QStringLiteral("findbut"));
    findbut_->setToolTip(
        QStringLiteral("Click to find individuals by searching for name or browsing through relationships."));
    connect(findbut_, &QPushButton::clicked, this, &householdform::findclicked);

    infolab_ = showsvalue(new QLabel(parent), QStringLiteral("infolab"), QStringLiteral("Information"));
    infolab_->setWordWrap(true);
    infolab_->setTextFormat(Qt::PlainText);
    infolab_->setFrameShape(QFrame::StyledPanel);
    infolab_->setMinimumHeight(infolab_->fontMetrics().lineSpacing() * 2 + 6);
    infolab_->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);

    panel_ = new householdpanel(parent);
    connect(panel_->allpeoplechk, &QCheckBox::clicked, this, &householdform::showallclicked);
    connect(panel_, &householdpanel::personchosen, this, &householdform::peopleclicked);
    connect(panel_, &householdpanel::familychosen, this, &householdform::familyclicked);
    censusrowsview* rows = panel_->rows;
    connect(rows, &censusrowsview::deleterequested, this, &householdform::deleterow);
    connect(rows, &censusrowsview::inforequested, this, &householdform::inforow);
    connect(rows, &censusrowsview::uprequested, this, &householdform::scrollup);
    connect(rows, &censusrowsview::downrequested, this, &householdform::scrolldown);
    file_.onread([this] { afterread(); });
}

void householdform::refill()
{
    const gedcomindex& x = *file_.index();
    panel_->family->clear();
    panel_->people->clear();
    QCheckBox* all = panel_->allpeoplechk;
    if (peoplelistshown(x)) {
        busycursor busy(prompts_);
        const bool idonly = file_.currentsettings().idonly;
        panel_->people->setpeople(file_.index(), sortedpeople(x, idonly), idonly);
        panel_->showpeoplelist(true);
        all->setChecked(true);
        all->setEnabled(false);
        findbut_->setEnabled(true);
    } else {
        panel_->showpeoplelist(false);
        findbut_->setEnabled(false);
        all->setChecked(false);
        all->setEnabled(false);
    }
}

void householdform::pullrows()
{
    rows_.rows = panel_->rows->values();
}

void householdform::pushrows()
{
    panel_->rows->show(rows_);
}

void householdform::fillallpeople()
{
    busycursor busy(prompts_);
    if (file_.index()) {
        const bool idonly = file_.currentsettings().idonly;
        panel_->people->setpeople(file_.index(), sortedpeople(*file_.index(), idonly), idonly);
    }
    panel_->setpeoplecaption(QStringLiteral("All Individuals:"));
}

void householdform::fillalivepeople()
{
    if (!file_.index())
        return;
    busycursor busy(prompts_);
    const std::optional<QDate> day = recognisedate(form_.censusdate());
    if (!day)
        return;
    const bool idonly = file_.currentsettings().idonly;
    const alivelist alive = couldbealive(*file_.index(), *day, localedateorder());
    panel_->people->setpeople(file_.index(), sortbylabel(*file_.index(), alive.people, idonly), idonly);
    panel_->setpeoplecaption(QStringLiteral("Individuals in ") + form_.censusyear() + QLatin1Char(':'));
    if (alive.toomany)
        prompts_.tell(QStringLiteral("There are too many people to display them all in the list."));
    else
        findbut_->setEnabled(true);
    panel_->showpeoplelist(true);
}

void householdform::fillfamily(int32_t k)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size())
        return;
    busycursor busy(prompts_);
    panel_->family->setentries(immediatefamily(*file_.index(), k, file_.currentsettings().idonly));
    panel_->setfamilycaption(QStringLiteral("Immediate Family of ") +
                             qs(file_.index()->people[static_cast<size_t>(k)].name) + QLatin1Char(':'));
}

void householdform::yearchosen()
{
    if (file_.index() && peoplelistshown(*file_.index())) {
        QCheckBox* all = panel_->allpeoplechk;
        all->setEnabled(true);
        const bool was = all->isChecked();
        all->setChecked(true);
        panel_->setpeoplecaption(QStringLiteral("All Individuals:"));
        if (!was)
            fillallpeople();
    } else {
        fillalivepeople();
    }
}

void householdform::datechanged()
{
    // The age of the individual chosen last, who may be hidden below the rows.
    if (rows_.selectioncount > 0 && recognisedate(form_.censusdate())) {
        storerows();
        showpersoninfo(rows_.selection[static_cast<size_t>(rows_.selectioncount - 1)].personindex);
    }
}

void householdform::showallclicked()
{
    QCheckBox* all = panel_->allpeoplechk;
    if (!all->isEnabled())
        return;
    if (all->isChecked()) {
        fillallpeople();
        return;
    }
    if (!form_.censusdateok(true)) {
        prompts_.tell(QStringLiteral("The current census date is not valid. This must be corrected first."));
        // The list still holds everyone: the box says so too.
        all->setChecked(true);
        return;
    }
    fillalivepeople();
}

void householdform::peopleclicked(int row)
{
    int32_t k = -1;
    if (reloading_ && rows_.selectioncount > 0)
        k = rows_.selection[0].personindex;
    else if (findresult_ != -1)
        k = findresult_;
    else
        k = panel_->people->personat(row);
    if (k < 0)
        return;
    if (rows_.selectioncount == 0 || reloading_ || fromfind_)
        fillfamily(k);
    if (!reloading_)
        selectperson(k);
}

void householdform::familyclicked(int row)
{
    const int32_t k = panel_->family->personat(row);
    if (k >= 0)
        selectperson(k);
}

bool householdform::checkages()
{
    pullrows();
    const int r = rows_.checkages();
    if (r < 0)
        return true;
    prompts_.tell(QStringLiteral("You must first enter an age for this individual"));
    panel_->rows->agebox(r)->setFocus();
    return false;
}

void householdform::storerows()
{
    pullrows();
    rows_.storerows();
}

std::vector<selectionrec> householdform::currentselection() const
{
    std::vector<selectionrec> out(rows_.selection.begin(),
                                  rows_.selection.begin() + std::min<size_t>(rows_.selection.size(),
                                                                             static_cast<size_t>(rows_.selectioncount)));
    if (!file_.index())
        return out;
    // Details given before the row was deleted and chosen again still count.
    for (selectionrec& r : out) {
        if (r.birthedited || r.personindex < 0 || static_cast<size_t>(r.personindex) >= file_.index()->people.size())
            continue;
        const personrec& person = file_.index()->people[static_cast<size_t>(r.personindex)];
        if (person.id == r.id && person.birthedited) {
            r.birthedited = true;
            r.birthdate = qs(person.birthdate);
            r.birthplace = qs(person.birthplace);
        }
    }
    return out;
}

void householdform::showrows(int t)
{
    rows_.showrows(t);
    pushrows();
}

void householdform::focusage(int r)
{
    if (r < rows_.toprow || r >= rows_.toprow + householdrows::visible)
        showrows(std::max(0, r - householdrows::visible + 1));
    QLineEdit* age = panel_->rows->agebox(r - rows_.toprow);
    age->setFocus();
    age->selectAll();
}

void householdform::selectperson(int32_t k)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size())
        return;
    if (!checkages())
        return;
    storerows();
    const personrec& person = file_.index()->people[static_cast<size_t>(k)];
    if (rows_.has(person.id)) {
        prompts_.tell(QStringLiteral("This individual has already been selected"));
        return;
    }
    const QString censustext = form_.censusdate();
    const std::optional<QDate> censusday = recognisedate(censustext);
    for (const censusrec& c : person.census) {
        const std::optional<QDate> day = recognisedate(qs(c.date));
        if (!day || !censusday || *day != *censusday)
            continue;
        QString q = QStringLiteral("This individual already has a census record for ") + censustext;
        const QString place = qs(c.place).trimmed();
        if (!place.isEmpty())
            q += QStringLiteral(" at ") + place;
        q += QStringLiteral(". Are you sure you want to select this individual?");
        if (!prompts_.yes(q, icon::exclamation, answer::yes)) {
            if (rows_.selectioncount == 0)
                panel_->family->clear();
            return;
        }
    }
    const int r = rows_.add(person, k);
    pushrows();
    panel_->rows->agebox(r)->setFocus();
    form_.setautotext(true);
    showpersoninfo(k);
}

void householdform::scrollup()
{
    if (!checkages())
        return;
    storerows();
    rows_.scrollup();
    pushrows();
}

void householdform::scrolldown()
{
    if (!checkages())
        return;
    storerows();
    rows_.scrolldown();
    pushrows();
}

void householdform::deleterow(int r)
{
    pullrows();
    const int32_t last = rows_.deleterow(r);
    pushrows();
    if (rows_.selectioncount == 0) {
        panel_->allpeoplelst->clearSelection();
        infolab_->clear();
        panel_->family->clear();
        panel_->setfamilycaption(QStringLiteral("Immediate Family:"));
        form_.setautotext(false);
        return;
    }
    showpersoninfo(last);
}

void householdform::inforow(int r)
{
    if (!file_.index())
        return;
    pullrows();
    const int32_t id = rows_.rows[static_cast<size_t>(r)].id.toInt();
    for (size_t k = 0; k < file_.index()->people.size(); ++k) {
        if (file_.index()->people[k].id == id) {
            showpersoninfo(static_cast<int32_t>(k));
            return;
        }
    }
}

void householdform::showpersoninfo(int32_t k)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size()) {
        infolab_->clear();
        return;
    }
    infolab_->setText(personinfo(file_.index()->people[static_cast<size_t>(k)], form_.censusdate()));
}

void householdform::clear()
{
    rows_.clear();
    findresult_ = -1;
    pushrows();
    infolab_->clear();
    panel_->setpeoplecaption(QStringLiteral("All Individuals"));
    form_.setautotext(false);
    panel_->setfamilycaption(QStringLiteral("Immediate Family:"));
}

void householdform::clearchoices()
{
    panel_->allpeoplelst->clearSelection();
}

void householdform::showfound(int32_t k)
{
    findresult_ = k;
    fromfind_ = true;
    peopleclicked(-1);
    findresult_ = -1;
    fromfind_ = false;
}

void householdform::findclicked()
{
    if (!checkages())
        return;
    if (rows_.selectioncount > 0) {
        storerows();
        findresult_ = rows_.selection[static_cast<size_t>(rows_.selectioncount - 1)].personindex;
    } else {
        findresult_ = -1;
    }
    int32_t chosenid = -1;
    {
        const pausewatch paused = file_.pause();
        fromfind_ = false;
        const int32_t chosen = find && file_.index() ? find(findresult_, fromfind_) : -1;
        // The file may have changed while Find was open: it is looked at now, and
        // the individual chosen found again by record number after a reload (not
        // in another file opened instead of one that has gone).
        chosenid = chosen >= 0 ? file_.index()->people[static_cast<size_t>(chosen)].id : -1;
    }
    const QString file = file_.path();
    emit filecheck();
    findresult_ = -1;
    for (size_t k = 0; chosenid >= 0 && file_.path() == file && k < file_.index()->people.size() && findresult_ < 0; ++k)
        if (file_.index()->people[k].id == chosenid)
            findresult_ = static_cast<int32_t>(k);
    if (findresult_ != -1)
        peopleclicked(-1);
    fromfind_ = false;
    findresult_ = -1;
}

void householdform::reload()
{
    reloading_ = true;
    storerows();
    file_.reload();
    reloading_ = false;
}

void householdform::afterread()
{
    refill();
    if (reloading_)
        keepchoices();
}

void householdform::keepchoices()
{
    if (form_.censusdateok(false)) {
        if (file_.index() && peoplelistshown(*file_.index()))
            panel_->allpeoplechk->setEnabled(true);
        else
            fillalivepeople();
    }
    form_.forgetsource();
    if (rows_.selectioncount == 0)
        return;
    // The individuals chosen are found again by record number.
    for (selectionrec& s : rows_.selection)
        s.found = false;
    for (size_t k = 0; k < file_.index()->people.size(); ++k) {
        const personrec& p = file_.index()->people[k];
        for (int i = 0; i < rows_.selectioncount; ++i) {
            selectionrec& s = rows_.selection[static_cast<size_t>(i)];
            if (!s.found && s.id == p.id) {
                s.found = true;
                s.name = qs(p.name);
                s.personindex = static_cast<int32_t>(k);
            }
        }
    }
    bool all = true;
    for (int i = 0; i < rows_.selectioncount; ++i)
        all = all && rows_.selection[static_cast<size_t>(i)].found;
    if (!all) {
        prompts_.tell(QStringLiteral("At least one of the individuals already selected appears to no longer be in "
                                     "your file following changes made in another application. ") +
                      QStringLiteral("Therefore, the selections will be cleared to avoid the possibility of data "
                                     "corruption."));
        rows_.clear();
        pushrows();
        form_.setautotext(false);
        form_.focustext();
    } else {
        peopleclicked(-1);
        showrows(rows_.toprow);
    }
}

} // namespace qm

// The main window's household: the people and family lists, choosing
// individuals into the census rows, the rows themselves, and the reload that
// keeps them.
#include "app/mainfrm.h"

#include "census/entrypanel_ui.h"
#include "census/householdpanel_ui.h"
#include "model/dates.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/prompts.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPlainTextEdit>
#include <QPushButton>

namespace qm {

void mainfrm::pullrows()
{
    rows_.rows = household_->rows->values();
}

void mainfrm::pushrows()
{
    household_->rows->show(rows_);
}

void mainfrm::fillallpeople()
{
    busycursor busy(prompts_);
    if (file_.index())
        household_->people->setpeople(file_.index(), sortedpeople(*file_.index(), file_.currentsettings().idonly), file_.currentsettings().idonly);
    household_->setpeoplecaption(QStringLiteral("All Individuals:"));
}

void mainfrm::fillalivepeople()
{
    if (!file_.index())
        return;
    busycursor busy(prompts_);
    entrypanel* p = panel();
    const std::optional<QDate> day = recognisedate(p->fixeddatetxt->text());
    if (!day)
        return;
    const alivelist alive = couldbealive(*file_.index(), *day, localedateorder());
    household_->people->setpeople(file_.index(), sortbylabel(*file_.index(), alive.people, file_.currentsettings().idonly),
                                  file_.currentsettings().idonly);
    household_->setpeoplecaption(QStringLiteral("Individuals in ") + p->yearcom->currentText().trimmed() +
                                 QLatin1Char(':'));
    if (alive.toomany)
        prompts_.tell(QStringLiteral("There are too many people to display them all in the list."));
    else
        findbut_->setEnabled(true);
    household_->showpeoplelist(true);
}

void mainfrm::fillfamily(int32_t k)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size())
        return;
    busycursor busy(prompts_);
    household_->family->setentries(immediatefamily(*file_.index(), k, file_.currentsettings().idonly));
    household_->setfamilycaption(QStringLiteral("Immediate Family of ") +
                                 qs(file_.index()->people[static_cast<size_t>(k)].name) + QLatin1Char(':'));
}

void mainfrm::showallclicked()
{
    QCheckBox* all = household_->allpeoplechk;
    if (!all->isEnabled())
        return;
    if (all->isChecked()) {
        fillallpeople();
        return;
    }
    if (!censusdateok(true)) {
        prompts_.tell(QStringLiteral("The current census date is not valid. This must be corrected first."));
        // The list still holds everyone: the box says so too.
        all->setChecked(true);
        return;
    }
    fillalivepeople();
}

void mainfrm::peopleclicked(int row)
{
    int32_t k = -1;
    if (reloading_ && rows_.selectioncount > 0)
        k = rows_.selection[0].personindex;
    else if (findresult_ != -1)
        k = findresult_;
    else
        k = household_->people->personat(row);
    if (k < 0)
        return;
    if (rows_.selectioncount == 0 || reloading_ || fromfind_)
        fillfamily(k);
    if (!reloading_)
        selectperson(k);
}

void mainfrm::familyclicked(int row)
{
    const int32_t k = household_->family->personat(row);
    if (k >= 0)
        selectperson(k);
}

bool mainfrm::checkages()
{
    pullrows();
    const int r = rows_.checkages();
    if (r < 0)
        return true;
    prompts_.tell(QStringLiteral("You must first enter an age for this individual"));
    household_->rows->agebox(r)->setFocus();
    return false;
}

void mainfrm::storerows()
{
    pullrows();
    rows_.storerows();
}

void mainfrm::showrows(int t)
{
    rows_.showrows(t);
    pushrows();
}

void mainfrm::selectperson(int32_t k)
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
    const QString censustext = panel()->fixeddatetxt->text();
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
                household_->family->clear();
            return;
        }
    }
    const int r = rows_.add(person, k);
    pushrows();
    household_->rows->agebox(r)->setFocus();
    Autosourcebut_->setEnabled(true);
    showpersoninfo(k);
}

void mainfrm::scrollup()
{
    if (!checkages())
        return;
    storerows();
    rows_.scrollup();
    pushrows();
}

void mainfrm::scrolldown()
{
    if (!checkages())
        return;
    storerows();
    rows_.scrolldown();
    pushrows();
}

void mainfrm::deleterow(int r)
{
    pullrows();
    const int32_t last = rows_.deleterow(r);
    pushrows();
    if (rows_.selectioncount == 0) {
        household_->allpeoplelst->clearSelection();
        infolab_->clear();
        household_->family->clear();
        household_->setfamilycaption(QStringLiteral("Immediate Family:"));
        Autosourcebut_->setEnabled(false);
        return;
    }
    showpersoninfo(last);
}

void mainfrm::inforow(int r)
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

void mainfrm::showpersoninfo(int32_t k)
{
    if (!file_.index() || k < 0 || static_cast<size_t>(k) >= file_.index()->people.size()) {
        infolab_->clear();
        return;
    }
    infolab_->setText(personinfo(file_.index()->people[static_cast<size_t>(k)], panel()->fixeddatetxt->text()));
}

void mainfrm::clearentry()
{
    rows_.clear();
    findresult_ = -1;
    pushrows();
    for (entrypanel* p : panel_)
        p->clearfields(p->mode == 0 && file_.currentsettings().fullentry);
    infolab_->clear();
    household_->setpeoplecaption(QStringLiteral("All Individuals"));
    Autosourcebut_->setEnabled(false);
    household_->setfamilycaption(QStringLiteral("Immediate Family:"));
}

void mainfrm::findclicked()
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
        const int32_t chosen = runfind(findresult_);
        // The file may have changed while Find was open: it is looked at now, and
        // the individual chosen found again by record number after a reload (not
        // in another file opened instead of one that has gone).
        chosenid = chosen >= 0 ? file_.index()->people[static_cast<size_t>(chosen)].id : -1;
    }
    const QString file = file_.path();
    checkonactivate();
    findresult_ = -1;
    for (size_t k = 0; chosenid >= 0 && file_.path() == file && k < file_.index()->people.size() && findresult_ < 0; ++k)
        if (file_.index()->people[k].id == chosenid)
            findresult_ = static_cast<int32_t>(k);
    if (findresult_ != -1)
        peopleclicked(-1);
    fromfind_ = false;
    findresult_ = -1;
}

void mainfrm::checkonactivate()
{
    if (!file_.index() || file_.index()->people.empty() || checking_ || !file_.watching())
        return;
    checking_ = true;
    repaint();
    QApplication::processEvents();
    const QString path = file_.index()->gedcomfile;
    if (file_.missing()) {
        // Reloading could only fail: the user is told once, and may open another file.
        const bool told = gonetold_ == path;
        gonetold_ = path;
        checking_ = false;
        if (!told && prompts_.yes(filegonequestion(path), icon::exclamation))
            openfamilyfile(QStringLiteral("-1"));
        return;
    }
    gonetold_.clear();
    if (file_.changed()) {
        prompts_.tell(changedmessage(path));
        checking_ = false;
        reload();
        return;
    }
    checking_ = false;
}

void mainfrm::reload()
{
    reloading_ = true;
    storerows();
    file_.reload();
    if (censusdateok(false)) {
        if (file_.index() && peoplelistshown(*file_.index()))
            household_->allpeoplechk->setEnabled(true);
        else
            fillalivepeople();
    }
    if (sourcemode_ == 1)
        panel_[1]->sourceidlab->clear();
    if (rows_.selectioncount == 0) {
        reloading_ = false;
        return;
    }
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
        Autosourcebut_->setEnabled(false);
        panel()->texttxt->setFocus();
    } else {
        peopleclicked(-1);
        showrows(rows_.toprow);
    }
    reloading_ = false;
}

} // namespace qm

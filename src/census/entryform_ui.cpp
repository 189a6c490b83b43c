// The main window's entry form: choosing an existing source, the large text
// editor and the divider, Auto Text, the birth details asked for the
// household, and "Save Census Entry".
#include "app/mainfrm.h"

#include "census/autotext.h"
#include "census/birthfrm.h"
#include "census/censustable.h"
#include "census/entrypanel_ui.h"
#include "census/householdcheck.h"
#include "census/householdcheckfrm.h"
#include "census/householdpanel_ui.h"
#include "census/sourcetextfrm.h"
#include "census/validateentry.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/prompts.h"
#include "platform/settingsstore.h"
#include "writer/previewfrm.h"
#include "writer/saveprompts.h"

#include <QApplication>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QThread>

namespace qm {

namespace {

// The text boxes hold lines ending in LF; the entry and the family file have
// CR LF, as the command-line tool gives them too.
QString withlf(QString text)
{
    text.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    text.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return text;
}

QString withcrlf(const QString& text)
{
    return withlf(text).replace(QLatin1Char('\n'), QLatin1String("\r\n"));
}

} // namespace

void mainfrm::connectform()
{
    for (entrypanel* p : panel_) {
        connect(p->fulltextbut, &QPushButton::clicked, this, [this] { edittext(sourcetextfrm::sourcetext); });
        connect(p->notetextbut, &QPushButton::clicked, this, [this] { edittext(sourcetextfrm::sourcenote); });
        connect(p, &entrypanel::dividermoved, this, &mainfrm::dividermoved);
        if (p->sourcecom)
            connect(p->sourcecom, &QComboBox::currentIndexChanged, this, &mainfrm::sourcechosen);
        // A date normalised on leaving the box is a change of the title too.
        if (p->mode == 0)
            connect(p->fixeddatetxt, &QLineEdit::textChanged, this, &mainfrm::refreshtitle);
    }
    connect(Autosourcebut_, &QPushButton::clicked, this, &mainfrm::autotextclicked);
}

void mainfrm::sourcechosen(int item)
{
    entrypanel* p = panel_[1];
    if (item < 0 || sourcemode_ != 1 || !file_.index())
        return;
    const int position = p->sourcecom->itemData(item).toInt();
    if (position < 0 || static_cast<size_t>(position) >= file_.index()->sources.size())
        return;
    const sourcerec& source = file_.index()->sources[static_cast<size_t>(position)];
    p->sourceidlab->setText(QString::number(source.id));
    const QString title = qs(source.title);
    for (int y = 0; y < p->yearcom->count(); ++y) {
        if (title.contains(p->yearcom->itemText(y))) {
            p->yearcom->setCurrentIndex(y);
            break;
        }
    }
    p->locationtxt->setFocus();
}

void mainfrm::edittext(int mode)
{
    entrypanel* p = panel();
    QPlainTextEdit* box = mode == sourcetextfrm::sourcetext ? p->texttxt : p->notetxt;
    if (const std::optional<QString> text = sourcetextfrm::edit(mode, box->toPlainText(), this))
        box->setPlainText(withlf(*text));
}

void mainfrm::dividermoved(double share)
{
    divider_ = share;
    for (entrypanel* p : panel_)
        if (p != sender())
            p->setdivider(share);
}

std::vector<selectionrec> mainfrm::currentselection() const
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

void mainfrm::askbirthdetails(const QString& entrydate)
{
    if (!file_.index())
        return;
    const std::vector<selectionrec> current = currentselection();
    for (size_t i = 0; i < current.size(); ++i) {
        selectionrec& row = rows_.selection[i];
        row = current[i];
        switch (checkbirth(row, *file_.index())) {
        case birthcheck::none:
            break;
        case birthcheck::idmismatch:
            prompts_.tell(idmismatchmessage());
            break;
        case birthcheck::ask: {
            const std::optional<birthdetails> d = birthfrm::ask(row, entrydate, file_.index()->places, prompts_, this,
                                                                [this] { prompts_.showhelp(30); });
            if (!d)
                break;
            d->applyto(row);
            // Kept with the individual until the file is read again, so that
            // the individual is not asked twice.
            personrec& person = file_.index()->people[static_cast<size_t>(row.personindex)];
            person.birthedited = true;
            person.birthdate = file_.index()->arena.store(u8(d->birthdate));
            person.birthplace = file_.index()->arena.store(u8(d->birthplace));
            if (!d->birthplace.isEmpty())
                insertplace(*file_.index(), u8(d->birthplace));
            break;
        }
        }
    }
}

void mainfrm::autotextclicked()
{
    if (!file_.index() || !checkages())
        return;
    entrypanel* p = panel();
    const QString censusdate = p->fixeddatetxt->text();
    if (const std::optional<autotextproblem> problem = checkautotextdate(censusdate)) {
        prompts_.tell(problem->message);
        if (problem->focusdate)
            p->fixeddatetxt->setFocus();
        return;
    }
    if (rows_.selectioncount < 1)
        return;
    storerows();
    askbirthdetails(censusdate);
    p->texttxt->setPlainText(
        withlf(autotext(currentselection(), *file_.index(), censusdate, file_.currentsettings().country, file_.currentsettings())));
}

entryform mainfrm::currentform() const
{
    const entrypanel* p = panel();
    entryform f;
    f.fullentry = sourcemode_ == 0;
    if (p->yearcom->currentIndex() >= 0) {
        f.yeartext = p->yearcom->currentText().trimmed();
        if (const censusdef* def = lookupcensus(file_.currentsettings().country, f.yeartext.toInt()))
            f.officialdate = def->date;
    }
    f.datetext = p->fixeddatetxt->text();
    f.place = p->locationtxt->text();
    f.address = p->addresstxt->text();
    if (f.fullentry) {
        f.title = p->titletxt->text();
        f.reference = p->referencetxt->text();
        f.other = p->othertxt->text();
    } else {
        f.title = p->sourcecom->currentText();
        f.reference = p->wherewithinsourcetxt->text();
    }
    f.sourceid = p->sourceidlab->text();
    f.sourcetext = withcrlf(p->texttxt->toPlainText());
    f.notetext = withcrlf(p->notetxt->toPlainText());
    f.selection = currentselection();
    return f;
}

censusentry mainfrm::gatherentry(const entryform& form, const QString& entrydate) const
{
    // The rows as they are now: birth details asked during the save are in them.
    censusentry e = entryfromform(form, entrydate);
    e.selection = currentselection();
    return e;
}

bool mainfrm::checkform(entryform& form, QString& entrydate)
{
    entrypanel* p = panel();
    const entrycheck check = validateentry(form, file_.currentsettings(), &prompts_);
    if (check.datechanged) {
        // The date as written into the file; the title follows it.
        p->fixeddatetxt->setText(check.entrydate);
        if (form.fullentry)
            form.title = p->titletxt->text();
    }
    if (!check.ok) {
        if (!check.message.isEmpty())
            prompts_.tell(check.message);
        switch (check.focus) {
        case entryfield::place:
            p->locationtxt->setFocus();
            break;
        case entryfield::title:
            p->titletxt->setFocus();
            break;
        case entryfield::wherewithinsource:
            p->wherewithinsourcetxt->setFocus();
            break;
        case entryfield::date:
            p->fixeddatetxt->setFocus();
            break;
        case entryfield::sourcetext:
            p->texttxt->setFocus();
            break;
        case entryfield::none:
            break;
        }
        return false;
    }
    entrydate = check.entrydate;
    return true;
}

void mainfrm::previewentry()
{
    if (!file_.index() || saving_ || !checkages())
        return;
    storerows();
    entryform form = currentform();
    QString entrydate;
    if (checkform(form, entrydate) &&
        !showentrypreview(*file_.index(), file_.currentsettings(), gatherentry(form, entrydate), prompts_, this))
        reload();
}

void mainfrm::saveentry()
{
    // Pending clicks are let through below: a second click on Save must not
    // start a second save of the same entry.
    if (!file_.index() || saving_)
        return;
    saving_ = true;
    const struct done {
        bool& flag;
        ~done() { flag = false; }
    } guard{saving_};
    if (!checkages())
        return;
    storerows();
    QApplication::processEvents();

    entryform form = currentform();
    QString entrydate;
    if (!checkform(form, entrydate))
        return;
    if (file_.currentsettings().householdcheck) {
        std::vector<householdfinding> findings;
        {
            busycursor busy(prompts_);
            findings = householdcheck(*file_.index(), file_.currentsettings(), gatherentry(form, entrydate));
        }
        // "Go back": the row of the finding is shown and its age box takes the focus.
        if (const std::optional<int> back = householdcheckfrm::ask(findings, this)) {
            if (*back < rows_.toprow || *back >= rows_.toprow + householdrows::visible) {
                rows_.toprow = std::max(0, *back - householdrows::visible + 1);
                showrows(rows_.toprow);
            }
            QLineEdit* age = household_->rows->agebox(*back - rows_.toprow);
            age->setFocus();
            age->selectAll();
            return;
        }
    }

    repaint();
    // The place typed is offered by the place completion from now on.
    insertplace(*file_.index(), u8(form.place.trimmed()));
    std::optional<pausewatch> paused;
    paused.emplace(file_);

    if (file_.currentsettings().birthdate)
        askbirthdetails(entrydate);

    std::vector<imagechoice> chosenimages;
    if (form.fullentry ? file_.currentsettings().requestimage : file_.currentsettings().requestimages2) {
        if (!chooseentryimages(chosenimages))
            return;
    }

    busycursor busy(prompts_);
    repaint();
    if (file_.changed()) {
        prompts_.tell(changedonsavemessage(file_.index()->gedcomfile, !chosenimages.empty()));
        reload();
        return;
    }
    paused.reset();

    censusentry entry = gatherentry(form, entrydate);
    entry.chosenimages = chosenimages;
    rewriterequest request;
    request.mode = rewritemode::censusentry;
    request.entry = std::move(entry);
    const saveoutcome out = file_.save(request);
    switch (tellsaveoutcome(prompts_, out)) {
    case aftersave::saved:
        break;
    case aftersave::changed:
        prompts_.tell(out.message);
        reload();
        return;
    case aftersave::stay:
        return;
    case aftersave::fatal:
        endprogram();
        return;
    }

    {
        const pausewatch reading = file_.pause();
        file_.reload();
        clearentry();
        household_->allpeoplelst->clearSelection();
    }
    raisecount();
    milestone();
    panel()->yearcom->setFocus();
}

void mainfrm::raisecount()
{
    ++file_.currentsettings().count;
    file_.store().write(QStringLiteral("Count"), QString::number(file_.currentsettings().count));
    file_.store().sync();
}

void mainfrm::endprogram()
{
    ending_ = true;
    idle_.emplace(file_);
    close();
    // Only a running event loop can be left (tests drive the window without one).
    if (QThread::currentThread()->loopLevel() > 0)
        QCoreApplication::exit(1);
}

} // namespace qm

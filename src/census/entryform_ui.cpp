#include "census/entryform_ui.h"

#include "census/autotext.h"
#include "census/birthfrm.h"
#include "census/censustable.h"
#include "census/entrypanel_ui.h"
#include "census/householdcheck.h"
#include "census/householdcheckfrm.h"
#include "census/household_ui.h"
#include "census/placecompleter_ui.h"
#include "census/sourcetextfrm.h"
#include "census/validateentry.h"
#include "model/dates.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/encoding.h"
#include "platform/prompts.h"
#include "platform/settingsstore.h"
#include "writer/maketitle.h"
#include "writer/openfile.h"
#include "writer/previewfrm.h"
#include "writer/saveprompts.h"

#include <QApplication>
#include <QComboBox>
#include <QEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStackedWidget>

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

censusform::censusform(openfile& file, prompts& p, QWidget* parent)
    : QObject(parent), file_(file), prompts_(p), parent_(parent)
{
    stack_ = new QStackedWidget(parent);
    stack_->setObjectName(QStringLiteral("entrypanels"));
    for (int m = 0; m < 2; ++m) {
        entrypanel* panel = new entrypanel(m, stack_);
        panel_[static_cast<size_t>(m)] = panel;
        stack_->addWidget(panel);
        connect(panel->yearcom, &QComboBox::currentIndexChanged, this,
                [this, panel](int item) { yearchosen(panel, item); });
        connect(panel->fixeddatetxt, &QLineEdit::textEdited, this, &censusform::datechanged);
        panel->fixeddatetxt->installEventFilter(this);
        new placecompleter(panel->locationtxt, [this]() -> const std::vector<placerec>* {
            return file_.index() ? &file_.index()->places : nullptr;
        });
        if (m == 0) {
            for (QLineEdit* e : {panel->locationtxt, panel->addresstxt, panel->othertxt, panel->referencetxt})
                connect(e, &QLineEdit::textChanged, this, &censusform::refreshtitle);
        }
    }

    addbut_ = new QPushButton(QStringLiteral("Save Census Entry"), parent);
    addbut_->setObjectName(QStringLiteral("addbut"));
    connect(addbut_, &QPushButton::clicked, this, &censusform::saveentry);
    previewbut_ = new QPushButton(QStringLiteral("Preview..."), parent);
    previewbut_->setObjectName(QStringLiteral("previewbut"));
    previewbut_->setToolTip(QStringLiteral("Show the lines that saving this entry would write, without saving it"));
    connect(previewbut_, &QPushButton::clicked, this, &censusform::previewentry);
    Autosourcebut_ = new QPushButton(QStringLiteral("Auto Text"), parent);
    Autosourcebut_->setObjectName(QStringLiteral("Autosourcebut"));
    Autosourcebut_->setToolTip(QStringLiteral(
        "This will generate source text from the individuals chosen below. You will almost certainly need to edit "
        "this to match the actual census entry."));
    Autosourcebut_->setEnabled(false);

    for (entrypanel* panel : panel_) {
        connect(panel->fulltextbut, &QPushButton::clicked, this, [this] { edittext(sourcetextfrm::sourcetext); });
        connect(panel->notetextbut, &QPushButton::clicked, this, [this] { edittext(sourcetextfrm::sourcenote); });
        connect(panel, &entrypanel::dividermoved, this, [this, panel](double share) { dividermoved(panel, share); });
        if (panel->sourcecom)
            connect(panel->sourcecom, &QComboBox::currentIndexChanged, this, &censusform::sourcechosen);
        // A date normalised on leaving the box is a change of the title too.
        if (panel->mode == 0)
            connect(panel->fixeddatetxt, &QLineEdit::textChanged, this, &censusform::refreshtitle);
    }
    connect(Autosourcebut_, &QPushButton::clicked, this, &censusform::autotextclicked);
    file_.onread([this] { refill(); });
}

void censusform::usesettings()
{
    sourcemode_ = file_.currentsettings().fullentry ? 0 : 1;
    stack_->setCurrentIndex(sourcemode_);
    fillyears();
}

void censusform::refill()
{
    const gedcomindex& x = *file_.index();
    // Existing census sources, by title.
    const std::vector<sourceitem> sources = censussourcelist(x);
    QComboBox* sourcecom = panel_[1]->sourcecom;
    const QSignalBlocker block(sourcecom);
    sourcecom->clear();
    for (const sourceitem& s : sources)
        sourcecom->addItem(s.title, s.source);
    sourcecom->setCurrentIndex(-1);
    if (sourcemode_ == 0)
        panel_[0]->sourceidlab->setText(QString::number(x.nextsourceid));
}

void censusform::forgetsource()
{
    if (sourcemode_ == 1)
        panel_[1]->sourceidlab->clear();
}

double censusform::divider() const
{
    return panel()->divider();
}

void censusform::setdivider(double share)
{
    for (entrypanel* p : panel_)
        p->setdivider(share);
}

QString censusform::censusdate() const
{
    return panel()->fixeddatetxt->text();
}

QString censusform::censusyear() const
{
    return panel()->yearcom->currentText().trimmed();
}

void censusform::setautotext(bool enabled)
{
    Autosourcebut_->setEnabled(enabled);
}

void censusform::focusyear()
{
    panel()->yearcom->setFocus();
}

void censusform::focustext()
{
    panel()->texttxt->setFocus();
}

void censusform::clearentry()
{
    household_->clear();
    for (entrypanel* p : panel_)
        p->clearfields(p->mode == 0 && file_.currentsettings().fullentry);
}

void censusform::fillyears()
{
    entrypanel* p = panel();
    p->fixeddatetxt->clear();
    p->fixeddatetxt->setEnabled(false);
    const QSignalBlocker block(p->yearcom);
    p->yearcom->clear();
    p->CensusYearLab->setText(censusyearcaption(file_.currentsettings().country));
    p->yearcom->addItems(qm::fillyears(file_.currentsettings().country));
    p->yearcom->setCurrentIndex(-1);
}

void censusform::yearchosen(entrypanel* p, int item)
{
    if (item < 0 || p != panel())
        return;
    const settings& s = file_.currentsettings();
    censuschoice c;
    c.yeartext = p->yearcom->currentText().trimmed();
    c.country = s.country;
    c.autoreference = s.autoreference;
    c.fullentry = s.fullentry;
    QLineEdit* ref = s.fullentry ? p->referencetxt : p->wherewithinsourcetxt;
    c.referencetext = ref ? ref->text() : QString();
    c.lastrefprefix = lastrefprefix_;
    const censusfound f = findcensus(c);
    if (!f.error.isEmpty())
        prompts_.tell(f.error);
    if (f.setreference && ref) {
        ref->setText(f.referencetext);
        ref->setCursorPosition(f.cursor);
    }
    lastrefprefix_ = f.lastrefprefix;
    p->fixeddatetxt->setText(f.date);
    p->fixeddatetxt->setEnabled(true);
    datechanged();
    household_->yearchosen();
    p->locationtxt->setFocus();
}

void censusform::refreshtitle()
{
    entrypanel* p = panel_[0];
    if (sourcemode_ != 0)
        return;
    const settings& s = file_.currentsettings();
    p->titletxt->setText(maketitle(s.title, p->yearcom->currentText().trimmed(), p->fixeddatetxt->text(),
                                   p->locationtxt->text(), p->addresstxt->text(), p->othertxt->text(),
                                   p->referencetxt->text().trimmed(), s.country));
    p->titletxt->setCursorPosition(0);
}

void censusform::datechanged()
{
    if (sourcemode_ == 0)
        refreshtitle();
    household_->datechanged();
}

bool censusform::censusdateok(bool normalise)
{
    entrypanel* p = panel();
    const censusdef* def = lookupcensus(file_.currentsettings().country,
                                        p->yearcom->currentIndex() >= 0 ? p->yearcom->currentText().toInt() : -1);
    const datecheck d = validdate(p->fixeddatetxt->text(), def ? def->date : QString());
    if (d.isdate && normalise && d.newtext)
        p->fixeddatetxt->setText(*d.newtext);
    return d.isdate;
}

bool censusform::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::FocusOut && watched == panel()->fixeddatetxt)
        censusdateok(true);
    return QObject::eventFilter(watched, event);
}

void censusform::sourcechosen(int item)
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

void censusform::edittext(int mode)
{
    entrypanel* p = panel();
    QPlainTextEdit* box = mode == sourcetextfrm::sourcetext ? p->texttxt : p->notetxt;
    if (const std::optional<QString> text = sourcetextfrm::edit(mode, box->toPlainText(), parent_->window()))
        box->setPlainText(withlf(*text));
}

void censusform::dividermoved(entrypanel* from, double share)
{
    for (entrypanel* p : panel_)
        if (p != from)
            p->setdivider(share);
}

void censusform::askbirthdetails(const QString& entrydate)
{
    if (!file_.index())
        return;
    gedcomindex& x = *file_.index();
    const std::vector<selectionrec> current = household_->currentselection();
    for (size_t i = 0; i < current.size(); ++i) {
        selectionrec& row = household_->rows().selection[i];
        row = current[i];
        switch (checkbirth(row, x)) {
        case birthcheck::none:
            break;
        case birthcheck::idmismatch:
            prompts_.tell(idmismatchmessage());
            break;
        case birthcheck::ask: {
            const std::optional<birthdetails> d =
                birthfrm::ask(row, entrydate, x.places, prompts_, parent_->window(), [this] { prompts_.showhelp(30); });
            if (!d)
                break;
            d->applyto(row);
            // Kept with the individual until the file is read again, so that
            // the individual is not asked twice.
            personrec& person = x.people[static_cast<size_t>(row.personindex)];
            person.birthedited = true;
            person.birthdate = x.arena.store(u8(d->birthdate));
            person.birthplace = x.arena.store(u8(d->birthplace));
            if (!d->birthplace.isEmpty())
                insertplace(x, u8(d->birthplace));
            break;
        }
        }
    }
}

void censusform::autotextclicked()
{
    if (!file_.index() || !household_->checkages())
        return;
    entrypanel* p = panel();
    const QString censusdate = p->fixeddatetxt->text();
    if (const std::optional<autotextproblem> problem = checkautotextdate(censusdate)) {
        prompts_.tell(problem->message);
        if (problem->focusdate)
            p->fixeddatetxt->setFocus();
        return;
    }
    if (household_->rows().selectioncount < 1)
        return;
    household_->storerows();
    askbirthdetails(censusdate);
    p->texttxt->setPlainText(withlf(autotext(household_->currentselection(), *file_.index(), censusdate,
                                             file_.currentsettings().country, file_.currentsettings())));
}

entryform censusform::currentform() const
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
    f.selection = household_->currentselection();
    return f;
}

censusentry censusform::gatherentry(const entryform& form, const QString& entrydate) const
{
    // The rows as they are now: birth details asked during the save are in them.
    censusentry e = entryfromform(form, entrydate);
    e.selection = household_->currentselection();
    return e;
}

bool censusform::checkform(entryform& form, QString& entrydate)
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

// The source as typed in the panel of the current mode.
entrysource censusform::imagesource() const
{
    const entrypanel* p = panel();
    entrysource e;
    e.fullentry = sourcemode_ == 0;
    e.date = p->fixeddatetxt->text();
    if (e.fullentry) {
        e.title = p->titletxt->text();
        e.reference = p->referencetxt->text();
    } else {
        e.sourcetitle = p->sourcecom->currentText();
        e.where = p->wherewithinsourcetxt->text();
    }
    return e;
}

void censusform::previewentry()
{
    if (!file_.index() || saving_ || !household_->checkages())
        return;
    household_->storerows();
    entryform form = currentform();
    QString entrydate;
    if (checkform(form, entrydate) && !showentrypreview(*file_.index(), file_.currentsettings(),
                                                        gatherentry(form, entrydate), prompts_, parent_->window()))
        household_->reload();
}

void censusform::saveentry()
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
    if (!household_->checkages())
        return;
    household_->storerows();
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
        if (const std::optional<int> back = householdcheckfrm::ask(findings, parent_->window())) {
            household_->focusage(*back);
            return;
        }
    }

    parent_->window()->repaint();
    // The place typed is offered by the place completion from now on.
    insertplace(*file_.index(), u8(form.place.trimmed()));
    std::optional<pausewatch> paused;
    paused.emplace(file_);

    if (file_.currentsettings().birthdate)
        askbirthdetails(entrydate);

    std::vector<imagechoice> chosenimages;
    if (form.fullentry ? file_.currentsettings().requestimage : file_.currentsettings().requestimages2) {
        if (chooseimages && !chooseimages(imagesource(), chosenimages))
            return;
    }

    busycursor busy(prompts_);
    parent_->window()->repaint();
    if (file_.changed()) {
        prompts_.tell(changedonsavemessage(file_.index()->gedcomfile, !chosenimages.empty()));
        household_->reload();
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
        household_->reload();
        return;
    case aftersave::stay:
        return;
    case aftersave::fatal:
        emit fatal();
        return;
    }

    {
        const pausewatch reading = file_.pause();
        file_.reload();
        clearentry();
        household_->clearchoices();
    }
    raisecount();
    emit saved();
    panel()->yearcom->setFocus();
}

void censusform::raisecount()
{
    settings& s = file_.currentsettings();
    ++s.count;
    file_.store().write(QStringLiteral("Count"), QString::number(s.count));
    file_.store().sync();
}

} // namespace qm

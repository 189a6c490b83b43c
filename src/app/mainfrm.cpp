#include "app/mainfrm.h"

#include "app/startup.h"
#include "census/entrypanel_ui.h"
#include "census/householdpanel_ui.h"
#include "flags/flagsmenu_ui.h"
#include "flags/flagtable.h"
#include "images/imagesmenu_ui.h"
#include "log/clearlog.h"
#include "log/logfrm.h"
#include "model/dates.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"
#include "platform/settingsstore.h"
#include "settings/optionsmenu_ui.h"
#include "tools/coveragefrm.h"
#include "tools/toolsmenu_ui.h"
#include "writer/backups.h"
#include "writer/maketitle.h"
#include "writer/undoprompts.h"

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QCloseEvent>
#include <QComboBox>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QStackedWidget>
#include <QThread>
#include <QTimer>
#include <QVBoxLayout>

namespace qm {

namespace {
const QString defaultfilename = QStringLiteral("Default File");
const QString gedcomfoldername = QStringLiteral("Gedcom Folder");

QString doesnotexist()
{
    return QStringLiteral("The file selected does not exist. Please try again.");
}
} // namespace

mainfrm::mainfrm(prompts& p, settingsstore& store, QWidget* parent)
    : QMainWindow(parent), prompts_(p), file_(store, &p)
{
    idle_.emplace(file_);
    file_.onread([this] { afterload(); });
    setObjectName(QStringLiteral("mainfrm"));
    setWindowTitle(versiontitle());
    buildform();
    buildmenus();
    helpkeys();
}

mainfrm::~mainfrm() = default;

void mainfrm::buildmenus()
{
    const auto item = [this](QMenu* menu, const char* name, const QString& caption) {
        QAction* a = menu->addAction(caption);
        a->setObjectName(QString::fromLatin1(name));
        return a;
    };
    QMenu* file = menuBar()->addMenu(QStringLiteral("&File"));
    file->setObjectName(QStringLiteral("filemen"));
    connect(item(file, "openmen", QStringLiteral("&Open another GEDCOM family history file")), &QAction::triggered,
            this, [this] { openfamilyfile(QStringLiteral("-1")); });
    connect(item(file, "savemen", QStringLiteral("&Save Census Entry")), &QAction::triggered, this,
            &mainfrm::saveentry);
    recentseparator_ = file->addSeparator();
    for (int i = 0; i < recentfiles::slotcount; ++i) {
        QAction* a = item(file, "RecentFilesmen", QString());
        a->setObjectName(QStringLiteral("RecentFilesmen%1").arg(i + 1));
        a->setVisible(false);
        connect(a, &QAction::triggered, this,
                [this, i] { openfamilyfile(recent_.paths[static_cast<size_t>(i)]); });
        RecentFilesmen_[static_cast<size_t>(i)] = a;
    }
    file->addSeparator();
    connect(item(file, "exitmen", QStringLiteral("E&xit")), &QAction::triggered, this, &QWidget::close);

    QMenu* edit = menuBar()->addMenu(QStringLiteral("&Edit"));
    edit->setObjectName(QStringLiteral("editmen"));
    connect(item(edit, "undomen", QStringLiteral("&Undo Last Census Entry")), &QAction::triggered, this, [this] {
        if (!file_.index() || form_->saving())
            return;
        bool undone = false;
        {
            const pausewatch paused = file_.pause();
            undone = askundolast(file_.path(), file_.currentsettings(), prompts_);
        }
        endtool(undone ? toolend::reload : toolend::unchanged);
    });
    edit->addSeparator();
    copymen_ = item(edit, "copymen", QStringLiteral("Copy"));
    cutmen_ = item(edit, "cutmen", QStringLiteral("Cut"));
    pastemen_ = item(edit, "pastemen", QStringLiteral("Paste"));
    edit->addSeparator();
    connect(item(edit, "clearallmen", QStringLiteral("Clear all textboxes and selections")), &QAction::triggered,
            this, &mainfrm::clearall);
    connect(edit, &QMenu::aboutToShow, this, &mainfrm::editmenuopening);
    const auto focused = [] { return QApplication::focusWidget(); };
    connect(copymen_, &QAction::triggered, this, [focused] {
        if (auto* l = qobject_cast<QLineEdit*>(focused()))
            l->copy();
        else if (auto* t = qobject_cast<QPlainTextEdit*>(focused()))
            t->copy();
    });
    connect(cutmen_, &QAction::triggered, this, [focused] {
        if (auto* l = qobject_cast<QLineEdit*>(focused()))
            l->cut();
        else if (auto* t = qobject_cast<QPlainTextEdit*>(focused()))
            t->cut();
    });
    connect(pastemen_, &QAction::triggered, this, [focused] {
        if (auto* l = qobject_cast<QLineEdit*>(focused()))
            l->paste();
        else if (auto* t = qobject_cast<QPlainTextEdit*>(focused()))
            t->paste();
    });

    QMenu* view = menuBar()->addMenu(QStringLiteral("&View"));
    view->setObjectName(QStringLiteral("viewmen"));
    viewlogmen_ = item(view, "viewlogmen", QStringLiteral("&View Log..."));
    item(view, "clearlogmen", QStringLiteral("&Clear Log File"));

    QMenu* tools = menuBar()->addMenu(QStringLiteral("&Tools"));
    tools->setObjectName(QStringLiteral("toolsmen"));
    item(tools, "removemen", QStringLiteral("&Remove Old Backup Files..."));
    attachbut_ = item(tools, "attachbut", QStringLiteral("&Attach Images to Existing Sources..."));
    item(tools, "datecheckmen", QStringLiteral("Census Date Check..."));
    item(tools, "flagsmen", QStringLiteral("Census Flags..."));
    item(tools, "coveragemen", QStringLiteral("Census C&overage..."));
    tools->addSeparator();
    item(tools, "optionsmen", QStringLiteral("&Options..."));

    QMenu* help = menuBar()->addMenu(QStringLiteral("&Help"));
    help->setObjectName(QStringLiteral("helpmen"));
    item(help, "helpcreatingentrymen", QStringLiteral("Creating a Census Entry..."));
    item(help, "HelpIndexmen", QStringLiteral("Index..."));
    item(help, "HelpSearchmen", QStringLiteral("Search..."));
    help->addSeparator();
    item(help, "donatemen", QStringLiteral("Make a Donation..."));
    item(help, "aboutmen", QStringLiteral("&About Quillmark..."));

    const auto on = [this](const char* name, const std::function<void()>& run) {
        if (QAction* a = menuBar()->findChild<QAction*>(QString::fromLatin1(name)))
            connect(a, &QAction::triggered, this, run);
    };
    on("viewlogmen", [this] { logfrm::view(file_.currentsettings().logpath, prompts_, this); });
    on("clearlogmen", [this] { clearlog(prompts_, file_.currentsettings().logpath); });
    on("removemen", [this] { removebackups(); });
    on("attachbut", [this] { endtool(attachimages(file_, prompts_, this)); });
    on("datecheckmen", [this] { endtool(censusdatecheck(file_, prompts_, this)); });
    on("flagsmen", [this] { endtool(censusflags(file_, prompts_, this)); });
    on("coveragemen", [this] { opencoverage(); });
    on("optionsmen", [this] { showoptions(); });
    on("donatemen", [this] { donate(); });
    on("aboutmen", [this] { about(); });
    const auto helpitem = [this](const char* name, int topic, const QString& command) {
        if (QAction* a = menuBar()->findChild<QAction*>(QString::fromLatin1(name)))
            connect(a, &QAction::triggered, this, [this, topic, command] { prompts_.showhelp(topic, command); });
    };
    helpitem("helpcreatingentrymen", 12, QString());
    helpitem("HelpIndexmen", 0, QStringLiteral("Index"));
    helpitem("HelpSearchmen", 0, QStringLiteral("Search"));
}

void mainfrm::buildform()
{
    auto* central = new QWidget(this);
    central->setObjectName(QStringLiteral("centralwidget"));
    auto* v = new QVBoxLayout(central);
    v->setContentsMargins(8, 6, 8, 8);
    v->setSpacing(6);

    form_ = new censusform(file_, prompts_, central);
    household_ = new householdform(file_, prompts_, *form_, central);
    form_->sethousehold(household_);
    household_->find = [this](int32_t start, bool& refocus) { return runfind(start, refocus); };
    form_->chooseimages = [this](std::vector<imagechoice>& chosen) { return chooseentryimages(chosen); };
    connect(household_, &householdform::filecheck, this, &mainfrm::checkonactivate);
    connect(form_, &censusform::saved, this, &mainfrm::milestone);
    connect(form_, &censusform::fatal, this, &mainfrm::endprogram);
    v->addWidget(form_->stack(), 1);

    reloadbut_ = new QPushButton(QStringLiteral("Reload"), central);
    reloadbut_->setObjectName(QStringLiteral("reloadbut"));
    reloadbut_->setToolTip(QStringLiteral("Read the family file again"));
    connect(reloadbut_, &QPushButton::clicked, this, &mainfrm::reload);
    // Tab goes from Find to Reload, then on to the household.
    QWidget::setTabOrder(household_->findbutton(), reloadbut_);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(form_->savebutton());
    buttons->addWidget(form_->previewbutton());
    buttons->addWidget(form_->autotextbutton());
    buttons->addStretch(1);
    buttons->addWidget(household_->findbutton());
    buttons->addWidget(reloadbut_);
    v->addLayout(buttons);
    v->addWidget(household_->infolabel());
    v->addWidget(household_->panel(), 3);
    setCentralWidget(central);
}

void mainfrm::placewindow()
{
    const double dpi = logicalDpiX() > 0 ? logicalDpiX() : 96;
    const QScreen* screen = QGuiApplication::primaryScreen();
    const QRect avail = screen ? screen->availableGeometry() : QRect(0, 0, 1366, 728);
    // Room for the frame and title bar of the window manager.
    const QSize room(avail.width() - 16, avail.height() - 40);
    // The classic 12000 x 8950 twips, grown to what the rows and lists need
    // and to a comfortable 1280 x 760 where the screen allows.
    QSize size(twipstopixels(12000, dpi), twipstopixels(8950, dpi));
    size = size.expandedTo(sizeHint()).expandedTo(QSize(1280, 760));
    resize(size.boundedTo(room));

    const placement p = readplacement(file_.store());
    QPoint at = pos();
    QSize s = this->size();
    if (p.top)
        at.setY(twipstopixels(*p.top, dpi));
    if (p.left)
        at.setX(twipstopixels(*p.left, dpi));
    if (p.width)
        s.setWidth(twipstopixels(*p.width, dpi));
    if (p.height)
        s.setHeight(twipstopixels(*p.height, dpi));
    // A window restored onto a screen that is no longer there could not be
    // reached: keep it within the screen.
    s = s.boundedTo(room).expandedTo(minimumSizeHint());
    at.setX(std::clamp(at.x(), avail.left(), std::max(avail.left(), avail.right() - s.width())));
    at.setY(std::clamp(at.y(), avail.top(), std::max(avail.top(), avail.bottom() - s.height())));
    if (p.top || p.left)
        move(at);
    resize(s);
    if (p.complete()) {
        maximise_ = p.maximised;
        if (p.centre)
            move(avail.center() - QPoint(s.width() / 2, s.height() / 2));
    }
    form_->setdivider(p.divider);
}

void mainfrm::showplaced()
{
    if (maximise_)
        showMaximized();
    else
        show();
}

std::optional<QString> mainfrm::askforfile(bool)
{
    return prompts_.openfile(QStringLiteral("Open GEDCOM family history file"), gedcomfolder_, gedcomfilter());
}

bool mainfrm::start(const QStringList& arguments)
{
    placewindow();
    recent_.read(file_.store());
    showrecentfiles();
    defaultfile_ = file_.store().read(defaultfilename).value_or(QString()).trimmed();
    gedcomfolder_ = file_.store().read(gedcomfoldername).value_or(QString()).trimmed();

    std::optional<QString> named = commandlinefile(arguments);
    QString file;
    for (;;) {
        bool fromdefault = false;
        if (named) {
            file = *named;
            named.reset(); // first attempt only
        } else if (defaultfile_.size() < 3) {
            const std::optional<QString> chosen = askforfile(true);
            if (!chosen)
                return false;
            file = *chosen;
        } else {
            file = defaultfile_;
            fromdefault = true;
        }
        if (QFileInfo(file).isFile())
            break;
        // A missing default file is dropped silently; any other missing file
        // is reported. A missing file named on the command line leaves the
        // default file alone.
        if (!fromdefault)
            prompts_.tell(doesnotexist());
        if (fromdefault || defaultfile_.isEmpty()) {
            defaultfile_.clear();
            file_.store().write(defaultfilename, QString());
        }
    }
    rememberfile(file, false);

    file_.readsettings();
    settitleandpanel(file);
    if (qm::startoptions(file_, prompts_, [this] { donate(); }, this))
        settitleandpanel(file);
    file_.load(file);
    if (file_.currentsettings().flagcheck)
        silentflagcheck();
    clearentry();
    idle_.reset();
    return true;
}

void mainfrm::rememberfile(const QString& path, bool fromopen)
{
    if (askdefaultfile(defaultfile_, fromopen, file_.currentsettings().fileopendefault) &&
        prompts_.yes(QStringLiteral("Do you want to open this file by default whenever you use Quillmark?"),
                     icon::question)) {
        defaultfile_ = path;
        file_.store().write(defaultfilename, path);
    }
    const QString folder = folderof(path);
    if (!folder.isEmpty()) {
        gedcomfolder_ = folder;
        file_.store().write(gedcomfoldername, folder);
    }
    recent_.remember(path);
    showrecentfiles();
}

void mainfrm::showrecentfiles()
{
    recent_.write(file_.store());
    bool any = false;
    for (int i = 0; i < recentfiles::slotcount; ++i) {
        QAction* a = RecentFilesmen_[static_cast<size_t>(i)];
        const bool used = recent_.inuse(i);
        a->setVisible(used);
        if (used)
            a->setText(recent_.caption(i));
        any = any || used;
    }
    recentseparator_->setVisible(any);
}

void mainfrm::settitleandpanel(const QString& path)
{
    setWindowTitle(windowtitle(path));
    form_->usesettings();
    householdrows& rows = household_->rows();
    rows.toprow = std::min(rows.toprow, rows.selectioncount);
    viewlogmen_->setEnabled(file_.currentsettings().keeplog);
    attachbut_->setEnabled(file_.currentsettings().fullentry);
}

void mainfrm::afterload()
{
    if (coverage_)
        coverage_->setindex(*file_.index(), file_.currentsettings()); // first: the grid must not read the index it had
    if (file_.index()->people.empty() && QFileInfo::exists(file_.path())) {
        prompts_.tell(nopeoplemessage());
        if (file_.path() == defaultfile_) {
            defaultfile_.clear();
            file_.store().write(defaultfilename, QString());
        }
    }
}

void mainfrm::openfamilyfile(const QString& path)
{
    if (household_->rows().selectioncount >= 1 &&
        !prompts_.yes(QStringLiteral("Loading another family history file will cause you to lose the census record "
                                     "you are currently entering. Are you sure you want to do this?"),
                      icon::exclamation, answer::no))
        return;
    const pausewatch paused = file_.pause();
    QString chosen;
    if (path != QLatin1String("-1")) {
        if (!QFileInfo(path).isFile()) {
            if (prompts_.yes(QStringLiteral("The recent file selected does not exist or can not be accessed. Do you "
                                            "want to remove it from the recent files list?"),
                             icon::exclamation, answer::no, QStringLiteral("Open Recent File")))
                recent_.remove(path);
            showrecentfiles();
            return;
        }
        chosen = path;
    } else {
        for (;;) {
            const std::optional<QString> f = askforfile(false);
            if (!f)
                return;
            if (QFileInfo(*f).isFile()) {
                chosen = *f;
                break;
            }
            prompts_.tell(doesnotexist());
        }
    }
    const QString previous = file_.path();
    rememberfile(chosen, true);
    household_->rows().clear();
    settitleandpanel(chosen);
    if (!file_.load(chosen).ok && !previous.isEmpty() && !file_.index()->gedcomfile.isEmpty()) {
        // The file could not be read: the one read before stays open.
        settitleandpanel(file_.path());
        afterload();
        form_->refill();
        household_->refill();
    } else if (file_.currentsettings().flagcheck) {
        silentflagcheck();
    }
    clearentry();
}

void mainfrm::closeEvent(QCloseEvent* event)
{
    if (household_->rows().selectioncount >= 1 && !ending_ &&
        !prompts_.yes(QStringLiteral("You have a partial or full census entry which has not been saved. Are you sure "
                                     "you want to leave Quillmark without saving it?"),
                      icon::question, answer::no, QStringLiteral("Leaving Quillmark?"))) {
        event->ignore();
        return;
    }
    const double dpi = logicalDpiX() > 0 ? logicalDpiX() : 96;
    const QRect g = normalGeometry().isValid() ? normalGeometry() : geometry();
    const QPoint at = isMaximized() ? g.topLeft() : pos();
    writeplacement(file_.store(), isMaximized(), pixelstotwips(at.y(), dpi), pixelstotwips(at.x(), dpi),
                   pixelstotwips(g.width(), dpi), pixelstotwips(g.height(), dpi), form_->divider());
    file_.store().sync();
    idle_.emplace(file_);
    event->accept();
}

void mainfrm::editmenuopening()
{
    QWidget* w = QApplication::focusWidget();
    auto* line = qobject_cast<QLineEdit*>(w);
    auto* text = qobject_cast<QPlainTextEdit*>(w);
    const bool selected = (line && line->hasSelectedText()) || (text && text->textCursor().hasSelection());
    copymen_->setEnabled(selected);
    cutmen_->setEnabled(selected && !(line && line->isReadOnly()) && !(text && text->isReadOnly()));
    const bool editable = (line && !line->isReadOnly()) || (text && !text->isReadOnly());
    pastemen_->setEnabled(editable && !QApplication::clipboard()->text().isEmpty());
}

void mainfrm::clearall()
{
    if (!prompts_.yes(QStringLiteral("Are you sure you want to clear all of the data currently being entered into "
                                     "the text boxes below?"),
                      icon::exclamation, answer::no))
        return;
    clearentry();
    household_->clearchoices();
    household_->panel()->family->clear();
    form_->focusyear();
}

void mainfrm::clearentry()
{
    form_->clearentry();
}

void mainfrm::endtool(toolend end)
{
    const pausewatch paused = file_.pause();
    repaint();
    if (end == toolend::reload)
        reload();
    else if (end == toolend::fatal)
        endprogram();
}

void mainfrm::removebackups()
{
    const pausewatch paused = file_.pause();
    removeoldbackups(prompts_, file_.currentsettings().backupfolder);
}

// "Options...": after Save the new settings take effect; a change of the
// recording method, the country or "ID Only" clears the entry and reads the
// file again.
void mainfrm::showoptions()
{
    const pausewatch paused = file_.pause();
    const optionsend end = qm::showoptions(file_, prompts_, [this] { donate(); }, this);
    if (end.reloadneeded) {
        clearentry();
        settitleandpanel(file_.path());
    } else if (end.saved) {
        viewlogmen_->setEnabled(file_.currentsettings().keeplog);
        attachbut_->setEnabled(file_.currentsettings().fullentry);
    }
    if (end.saved && file_.currentsettings().fullentry && !form_->panel()->titletxt->text().isEmpty())
        form_->refreshtitle();
    endtool(end.reloadneeded ? toolend::reload : toolend::unchanged);
}

// When the flags are out of step the Flag Check dialog opens; the file is read
// again when it was rewritten (or changed outside the program).
void mainfrm::silentflagcheck()
{
    const toolend end = qm::silentflagcheck(file_, prompts_, this);
    if (end == toolend::reload) {
        file_.reload();
    } else if (end == toolend::fatal) {
        endprogram();
        // At start the event loop is not running yet: leave it as soon as it does.
        if (QThread::currentThread()->loopLevel() == 0)
            QTimer::singleShot(0, qApp, [] { QCoreApplication::exit(1); });
    }
}

// The entry's Census Images dialog offers titles built from the source the
// entry makes or cites.
bool mainfrm::chooseentryimages(std::vector<imagechoice>& chosen)
{
    const entrypanel* p = form_->panel();
    entrysource e;
    e.fullentry = form_->sourcemode() == 0;
    e.date = p->fixeddatetxt->text();
    if (e.fullentry) {
        e.title = p->titletxt->text();
        e.reference = p->referencetxt->text();
    } else {
        e.sourcetitle = p->sourcecom->currentText();
        e.where = p->wherewithinsourcetxt->text();
    }
    return qm::chooseentryimages(e, file_, prompts_, this, chosen);
}

int32_t mainfrm::runfind(int32_t start, bool& refocus)
{
    const findchoice c = findindividual(file_, *household_->panel()->people, start, prompts_, this);
    refocus = c.refocus;
    return c.person;
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
    household_->reload();
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

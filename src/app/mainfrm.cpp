#include "app/mainfrm.h"

#include "app/filechoice_ui.h"
#include "app/startup.h"
#include "census/entrypanel_ui.h"
#include "census/householdpanel_ui.h"
#include "flags/flagsmenu_ui.h"
#include "images/imagesmenu_ui.h"
#include "log/clearlog.h"
#include "log/logfrm.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/editmenu_ui.h"
#include "platform/prompts.h"
#include "platform/settingsstore.h"
#include "settings/optionsmenu_ui.h"
#include "tools/coveragefrm.h"
#include "tools/toolsmenu_ui.h"
#include "writer/backups.h"
#include "writer/undoprompts.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenuBar>
#include <QPushButton>
#include <QScreen>
#include <QStackedWidget>
#include <QThread>
#include <QTimer>
#include <QVBoxLayout>

namespace qm {

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

const recentfiles& mainfrm::recent() const
{
    return files_->recent();
}

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
    files_ = new filechoice(file_.store(), prompts_, file, this);
    connect(files_, &filechoice::recentchosen, this, &mainfrm::openfamilyfile);
    file->addSeparator();
    connect(item(file, "exitmen", QStringLiteral("E&xit")), &QAction::triggered, this, &QWidget::close);

    QMenu* edit = menuBar()->addMenu(QStringLiteral("&Edit"));
    edit->setObjectName(QStringLiteral("editmen"));
    connect(item(edit, "undomen", QStringLiteral("&Undo Last Census Entry")), &QAction::triggered, this, [this] {
        if (file_.index() && !form_->saving())
            endtool(askundolast(file_, prompts_));
    });
    edit->addSeparator();
    addclipboarditems(edit);
    edit->addSeparator();
    connect(item(edit, "clearallmen", QStringLiteral("Clear all textboxes and selections")), &QAction::triggered,
            this, &mainfrm::clearall);

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
    form_->chooseimages = [this](const entrysource& e, std::vector<imagechoice>& chosen) {
        return chooseentryimages(e, file_, prompts_, this, chosen);
    };
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
    const QScreen* screen = QGuiApplication::primaryScreen();
    const placement p = readplacement(file_.store());
    const windowplace w = qm::placewindow(p, pos(), sizeHint(), minimumSizeHint(),
                                          screen ? screen->availableGeometry() : QRect(0, 0, 1366, 728),
                                          logicalDpiX() > 0 ? logicalDpiX() : 96);
    if (w.move)
        move(w.at);
    resize(w.size);
    maximise_ = p.complete() && p.maximised;
    form_->setdivider(p.divider);
}

void mainfrm::showplaced()
{
    if (maximise_)
        showMaximized();
    else
        show();
}

bool mainfrm::start(const QStringList& arguments)
{
    placewindow();
    files_->read();
    const std::optional<QString> chosen = files_->atstart(arguments);
    if (!chosen)
        return false;
    files_->remember(*chosen, false, file_.currentsettings().fileopendefault);

    file_.readsettings();
    settitleandpanel(*chosen);
    if (qm::startoptions(file_, prompts_, [this] { donate(); }, this))
        settitleandpanel(*chosen);
    file_.load(*chosen);
    if (file_.currentsettings().flagcheck)
        silentflagcheck();
    clearentry();
    idle_.reset();
    return true;
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
        files_->dropdefault(file_.path());
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
    const std::optional<QString> chosen = files_->another(path);
    if (!chosen)
        return;
    const QString previous = file_.path();
    files_->remember(*chosen, true, file_.currentsettings().fileopendefault);
    household_->rows().clear();
    settitleandpanel(*chosen);
    if (!file_.load(*chosen).ok && !previous.isEmpty() && !file_.index()->gedcomfile.isEmpty()) {
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

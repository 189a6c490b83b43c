#include "app/helpfrm.h"

#include "platform/formparts_ui.h"

#include <QApplication>
#include <QTextCursor>
#include <QEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QScreen>
#include <QShortcut>
#include <QSplitter>
#include <QTextBrowser>
#include <QTextDocument>
#include <QUrl>
#include <QVBoxLayout>

#include <algorithm>

// The pages are built into the windows library; a static library must register
// its resources by hand.
static void registerhelppages()
{
    Q_INIT_RESOURCE(help);
}

namespace qm {

namespace {

QUrl pageurl(const QString& page)
{
    return QUrl(QStringLiteral("qrc") + helpfolder() + QLatin1Char('/') + page);
}

QPushButton* toolbutton(const QString& text, const char* name, const QString& accessible, const QString& tip,
                        QWidget* parent)
{
    QPushButton* b = plainbutton(parent, name, text, accessible);
    b->setToolTip(tip);
    return b;
}

} // namespace

helpfrm::helpfrm(QWidget* home) : QWidget(home, Qt::Window), home_(home), owner_(home)
{
    registerhelppages();
    setObjectName(QStringLiteral("helpfrm"));
    setWindowTitle(QStringLiteral("Quillmark Help"));
    setAttribute(Qt::WA_DeleteOnClose, false);

    backbut_ = toolbutton(QStringLiteral("< &Back"), "backbut", QStringLiteral("Back"),
                          QStringLiteral("Back to the page shown before (Alt+Left)"), this);
    forwardbut_ = toolbutton(QStringLiteral("&Forward >"), "forwardbut", QStringLiteral("Forward"),
                             QStringLiteral("Forward again (Alt+Right)"), this);
    auto* homebut = toolbutton(QStringLiteral("&Home"), "homebut", QStringLiteral("Home"),
                               QStringLiteral("The main window and where to start"), this);
    auto* indexbut = toolbutton(QStringLiteral("&Index"), "indexbut", QStringLiteral("Index"),
                                QStringLiteral("Every help page and the key terms"), this);
    auto* searchbut = toolbutton(QStringLiteral("&Search"), "searchbut", QStringLiteral("Search"),
                                 QStringLiteral("Search all help pages for words"), this);
    backbut_->setEnabled(false);
    forwardbut_->setEnabled(false);

    helptxt_ = new QTextBrowser(this);
    helptxt_->setObjectName(QStringLiteral("helptxt"));
    helptxt_->setAccessibleName(QStringLiteral("Help page"));
    helptxt_->setOpenExternalLinks(true);
    helptxt_->setSearchPaths({helpfolder()});

    searchpanel_ = new QWidget(this);
    searchpanel_->setObjectName(QStringLiteral("searchpanel"));
    auto* searchlab = new QLabel(QStringLiteral("Search &for:"), searchpanel_);
    searchtxt_ = new QLineEdit(searchpanel_);
    searchtxt_->setObjectName(QStringLiteral("searchtxt"));
    searchtxt_->setAccessibleName(QStringLiteral("Search for"));
    searchtxt_->setPlaceholderText(QStringLiteral("words to find"));
    searchtxt_->setClearButtonEnabled(true);
    searchlab->setBuddy(searchtxt_);
    auto* gobut = toolbutton(QStringLiteral("Find &Pages"), "searchgobut", QStringLiteral("Find pages"),
                             QStringLiteral("List the pages that hold every word typed"), searchpanel_);
    resultlab_ = new QLabel(searchpanel_);
    resultlab_->setObjectName(QStringLiteral("resultlab"));
    resultlab_->setWordWrap(true);
    resultlst_ = new QListWidget(searchpanel_);
    resultlst_->setObjectName(QStringLiteral("resultlst"));
    resultlst_->setAccessibleName(QStringLiteral("Pages found"));
    resultlst_->setWordWrap(true);
    resultlst_->setAlternatingRowColors(true);

    auto* searchrow = new QHBoxLayout;
    searchrow->addWidget(searchtxt_, 1);
    searchrow->addWidget(gobut);
    auto* panel = new QVBoxLayout(searchpanel_);
    panel->setContentsMargins(0, 0, 0, 0);
    panel->addWidget(searchlab);
    panel->addLayout(searchrow);
    panel->addWidget(resultlab_);
    panel->addWidget(resultlst_, 1);
    searchpanel_->hide();

    auto* split = new QSplitter(Qt::Horizontal, this);
    split->addWidget(searchpanel_);
    split->addWidget(helptxt_);
    split->setStretchFactor(0, 1);
    split->setStretchFactor(1, 3);
    split->setChildrenCollapsible(false);

    auto* buttons = new QHBoxLayout;
    for (QPushButton* b : {backbut_, forwardbut_, homebut, indexbut, searchbut})
        buttons->addWidget(b);
    buttons->addStretch(1);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(buttons);
    layout->addWidget(split, 1);

    connect(backbut_, &QPushButton::clicked, helptxt_, &QTextBrowser::backward);
    connect(forwardbut_, &QPushButton::clicked, helptxt_, &QTextBrowser::forward);
    connect(helptxt_, &QTextBrowser::backwardAvailable, backbut_, &QPushButton::setEnabled);
    connect(helptxt_, &QTextBrowser::forwardAvailable, forwardbut_, &QPushButton::setEnabled);
    connect(helptxt_, &QTextBrowser::sourceChanged, this, &helpfrm::pagechanged);
    connect(homebut, &QPushButton::clicked, this, [this] { openpage(pagefor(maintopic)); });
    connect(indexbut, &QPushButton::clicked, this, [this] { openpage(indexpage()); });
    connect(searchbut, &QPushButton::clicked, this, &helpfrm::showsearch);
    connect(searchtxt_, &QLineEdit::returnPressed, this, [this] { search(searchtxt_->text()); });
    connect(gobut, &QPushButton::clicked, this, [this] { search(searchtxt_->text()); });
    connect(resultlst_, &QListWidget::itemActivated, this, &helpfrm::resultchosen);
    connect(resultlst_, &QListWidget::itemClicked, this, &helpfrm::resultchosen);

    // Alt+Left and Alt+Right (the platform's Back and Forward keys) anywhere in
    // the window; Escape closes it.
    connect(new QShortcut(QKeySequence::Back, this), &QShortcut::activated, helptxt_, &QTextBrowser::backward);
    connect(new QShortcut(QKeySequence::Forward, this), &QShortcut::activated, helptxt_, &QTextBrowser::forward);
    connect(new QShortcut(QKeySequence(Qt::Key_Escape), this), &QShortcut::activated, this, &QWidget::close);

    const QSize screen = QApplication::primaryScreen() ? QApplication::primaryScreen()->availableSize() : QSize(1024, 768);
    resize(std::min(screen.width() * 2 / 3, 1000), std::min(screen.height() * 3 / 4, 760));
}

helpfrm* helpfrm::open(QWidget* home, int topic, const QString& command)
{
    static QPointer<helpfrm> window;
    if (!window)
        window = new helpfrm(home);
    window->showtopic(topic, command);
    return window;
}

void helpfrm::showtopic(int topic, const QString& command)
{
    belongto(QApplication::activeModalWidget());
    const QString page = pagefor(topic, command);
    openpage(page);
    if (page == searchpage())
        showsearch();
    if (isMinimized())
        showNormal();
    else
        show();
    raise();
    activateWindow();
}

QString helpfrm::currentpage() const
{
    return helptxt_->source().fileName();
}

void helpfrm::openpage(const QString& page)
{
    helptxt_->setSource(pageurl(page));
}

void helpfrm::pagechanged()
{
    const QString title = helptxt_->documentTitle();
    setWindowTitle(title.isEmpty() ? QStringLiteral("Quillmark Help") : QStringLiteral("Quillmark Help - ") + title);
    // A page opened from the search results shows the first word found.
    if (!lastquery_.isEmpty() && searchpanel_->isVisible()) {
        for (const QString& word : lastquery_) {
            QString w = word;
            const bool prefix = w.endsWith(u'*');
            if (prefix)
                w.chop(1);
            helptxt_->moveCursor(QTextCursor::Start);
            if (helptxt_->find(w, prefix ? QTextDocument::FindFlags() : QTextDocument::FindWholeWords))
                break;
        }
    }
}

void helpfrm::showsearch()
{
    searchpanel_->show();
    if (currentpage() != searchpage() && resultlst_->count() == 0)
        openpage(searchpage());
    searchtxt_->setFocus();
    searchtxt_->selectAll();
}

void helpfrm::search(const QString& query)
{
    searchpanel_->show();
    if (searchtxt_->text() != query)
        searchtxt_->setText(query);
    if (!docsread_) {
        docs_ = readhelp(helpfolder());
        docsread_ = true;
    }
    lastquery_ = helpwords(query);
    resultlst_->clear();
    const std::vector<helphit> hits = searchhelp(docs_, query);
    for (const helphit& h : hits) {
        auto* item = new QListWidgetItem(h.title + QLatin1Char('\n') + h.excerpt, resultlst_);
        item->setData(Qt::UserRole, h.page);
        item->setToolTip(h.excerpt);
    }
    if (lastquery_.isEmpty())
        resultlab_->setText(QStringLiteral("Type one or more words to find."));
    else if (hits.empty())
        resultlab_->setText(QStringLiteral("No page holds all of these words. Try fewer words, or end a word with * "
                                           "to find every word that begins with it."));
    else
        resultlab_->setText(hits.size() == 1 ? QStringLiteral("1 page found:")
                                             : QStringLiteral("%1 pages found, best first:").arg(hits.size()));
    if (!hits.empty())
        resultlst_->setCurrentRow(0);
}

void helpfrm::resultchosen()
{
    if (QListWidgetItem* item = resultlst_->currentItem())
        openpage(item->data(Qt::UserRole).toString());
}

void helpfrm::belongto(QWidget* owner)
{
    if (!owner || owner == this)
        owner = home_;
    if (owner == owner_ && parentWidget() == owner)
        return;
    if (owner_ && owner_ != home_)
        owner_->removeEventFilter(this);
    const bool shown = isVisible();
    const QRect place = geometry();
    // A window is usable while a modal dialog is open only when it belongs to
    // that dialog.
    setParent(owner, Qt::Window);
    owner_ = owner;
    if (owner && owner != home_)
        owner->installEventFilter(this);
    if (shown) {
        setGeometry(place);
        show();
    }
}

bool helpfrm::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == owner_ && event->type() == QEvent::Hide) {
        // The dialog is closing: the help goes back to the modal window under
        // it, or to the main window, and stays open.
        QWidget* next = home_;
        for (QWidget* w = owner_->parentWidget(); w; w = w->parentWidget()) {
            QWidget* top = w->window();
            if (top->isModal() && top->isVisible() && top != this) {
                next = top;
                break;
            }
            w = top;
        }
        belongto(next);
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace qm

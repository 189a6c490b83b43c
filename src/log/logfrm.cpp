#include "log/logfrm.h"

#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScreen>
#include <QVBoxLayout>
#include <QWidget>

namespace qm {

logfrm::logfrm(const QString& logpath, prompts& asker, QWidget* parent)
    : QDialog(parent), logpath_(logpath), asker_(asker)
{
    setObjectName(QStringLiteral("logfrm"));
    setWindowTitle(QStringLiteral("Quillmark Log"));
    setModal(true);
    setSizeGripEnabled(true);

    logtxt_ = new QPlainTextEdit(this);
    logtxt_->setObjectName(QStringLiteral("logtxt"));
    logtxt_->setAccessibleName(QStringLiteral("Census log"));
    logtxt_->setReadOnly(true);
    logtxt_->setLineWrapMode(QPlainTextEdit::NoWrap);
    logtxt_->setFont(fixedfont());
    logtxt_->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);

    auto* buttonspic = new QWidget(this);
    buttonspic->setObjectName(QStringLiteral("buttonspic"));
    startbut_ = plainbutton(buttonspic, "startbut", QStringLiteral("&Start"), QStringLiteral("Back to the first page"));
    nextpagebut_ = named(new QPushButton(QStringLiteral("&Next Page"), buttonspic), "nextpagebut",
                         QStringLiteral("Next page"));
    nextpagebut_->setDefault(true);
    auto* pagecaption = new QLabel(QStringLiteral("Page"), buttonspic);
    pagelab_ = showsvalue(new QLabel(buttonspic), QStringLiteral("pagelab"), QStringLiteral("Page number"));
    auto* closebut = plainbutton(buttonspic, "closebut", QStringLiteral("Close"), QStringLiteral("Close"));

    auto* strip = new QHBoxLayout(buttonspic);
    strip->setContentsMargins(0, 0, 0, 0);
    strip->addWidget(startbut_);
    strip->addWidget(nextpagebut_);
    strip->addSpacing(12);
    strip->addWidget(pagecaption);
    strip->addWidget(pagelab_);
    strip->addStretch(1);
    strip->addWidget(closebut);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(logtxt_, 1);
    layout->addWidget(buttonspic);

    setTabOrder(logtxt_, startbut_);
    setTabOrder(startbut_, nextpagebut_);
    setTabOrder(nextpagebut_, closebut);

    // Three quarters of the screen's width and height, centred on it.
    if (const QScreen* screen = parent ? parent->screen() : this->screen()) {
        const QRect area = screen->availableGeometry();
        resize(area.width() * 3 / 4, area.height() * 3 / 4);
        move(area.center() - rect().center());
    }

    connect(startbut_, &QPushButton::clicked, this, &logfrm::startpage);
    connect(nextpagebut_, &QPushButton::clicked, this, [this] {
        pages_.nextpage();
        showpage();
    });
    connect(closebut, &QPushButton::clicked, this, &QDialog::accept);
}

bool logfrm::openlog()
{
    if (!pages_.open(logpath_)) {
        asker_.tell(QStringLiteral("Error opening the log file"));
        return false;
    }
    showpage();
    return true;
}

void logfrm::showpage()
{
    logtxt_->setPlainText(pages_.text());
    pagelab_->setText(QString::number(pages_.page()));
    nextpagebut_->setEnabled(pages_.more());
    (pages_.more() ? static_cast<QWidget*>(nextpagebut_) : logtxt_)->setFocus();
}

void logfrm::startpage()
{
    if (!openlog())
        reject();
}

void logfrm::view(const QString& logpath, prompts& asker, QWidget* parent)
{
    logfrm viewer(logpath, asker, parent);
    if (viewer.openlog())
        viewer.exec();
}

} // namespace qm

#include "images/imagepreview_ui.h"

#include "images/imagechoices.h"
#include "images/imageviewfrm.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QApplication>
#include <QFileInfo>
#include <QImageReader>
#include <QKeyEvent>
#include <QLabel>
#include <QMouseEvent>
#include <QPainter>
#include <QStackedLayout>

#include <algorithm>
#include <cmath>

namespace qm {

picturebox::picturebox(QWidget* parent) : QWidget(parent)
{
    setFocusPolicy(Qt::StrongFocus);
    setCursor(Qt::PointingHandCursor);
}

void picturebox::setpicture(const QImage& picture)
{
    picture_ = picture;
    update();
}

QRect picturebox::fitted(QSize picture, QSize box)
{
    if (picture.isEmpty() || box.isEmpty())
        return {};
    // One factor for both sides: the picture fills the box in one direction.
    const double factor = std::max(double(picture.width()) / box.width(), double(picture.height()) / box.height());
    const int w = std::max(1, static_cast<int>(std::lround(picture.width() / factor)));
    const int h = std::max(1, static_cast<int>(std::lround(picture.height() / factor)));
    return QRect(0, 0, std::min(w, box.width()), std::min(h, box.height()));
}

void picturebox::paintEvent(QPaintEvent*)
{
    if (picture_.isNull())
        return;
    QPainter painter(this);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.drawImage(fitted(picture_.size(), size()), picture_);
}

void picturebox::mouseReleaseEvent(QMouseEvent* event)
{
    if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint()) && !picture_.isNull())
        emit clicked();
}

void picturebox::keyPressEvent(QKeyEvent* event)
{
    if ((event->key() == Qt::Key_Space || event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        && !picture_.isNull()) {
        emit clicked();
        return;
    }
    QWidget::keyPressEvent(event);
}

imagepreview::imagepreview(prompts& p, QSize boxsize, QWidget* parent) : QWidget(parent), prompts_(p)
{
    setObjectName(QStringLiteral("imagepreview"));
    stack_ = new QStackedLayout(this);
    stack_->setContentsMargins(0, 0, 0, 0);
    imagepic_ = new picturebox(this);
    imagepic_->setObjectName(QStringLiteral("imagepic"));
    imagepic_->setAccessibleName(QStringLiteral("Image preview"));
    imagepic_->setToolTip(QStringLiteral("Click on image to see full-size version"));
    imagepic_->setFixedSize(boxsize);
    previewmessagelab_ =
        showsvalue(new QLabel(this), QStringLiteral("previewmessagelab"), QStringLiteral("Preview message"));
    previewmessagelab_->setWordWrap(true);
    previewmessagelab_->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    previewmessagelab_->setFixedSize(boxsize);
    previewmessagelab_->installEventFilter(this);
    stack_->addWidget(imagepic_);
    stack_->addWidget(previewmessagelab_);
    setFixedSize(boxsize);
    connect(imagepic_, &picturebox::clicked, this, &imagepreview::showfullsize);
    clear();
}

QString imagepreview::openingtext()
{
    return QStringLiteral("Opening preview image...");
}

QString imagepreview::unsupportedtext()
{
    return QStringLiteral("Sorry but this type of image format can not be previewed in Quillmark. Click here to open "
                          "this in the default viewer for this file type.");
}

QString imagepreview::notfoundtext()
{
    return QStringLiteral("Problem: the file path is not valid - check the location of this image in Family Historian.");
}

QString imagepreview::failedtext()
{
    return previewfailedtext();
}

void imagepreview::clear()
{
    path_.clear();
    last_ = outcome::none;
    imagepic_->setpicture(QImage());
    previewmessagelab_->clear();
    imagepic_->hide();
    previewmessagelab_->hide();
}

void imagepreview::setmessage(const QString& text, bool clickable)
{
    imagepic_->setpicture(QImage());
    previewmessagelab_->setText(text);
    previewmessagelab_->setCursor(clickable ? Qt::PointingHandCursor : Qt::ArrowCursor);
    previewmessagelab_->setFocusPolicy(clickable ? Qt::StrongFocus : Qt::NoFocus);
    stack_->setCurrentWidget(previewmessagelab_);
    previewmessagelab_->show();
}

imagepreview::outcome imagepreview::showfile(const QString& path)
{
    clear();
    path_ = path;
    setmessage(openingtext(), false);
    previewmessagelab_->repaint();

    const QFileInfo info(path);
    if (path.isEmpty() || !info.exists()) {
        last_ = outcome::notfound;
        setmessage(notfoundtext(), false);
        return last_;
    }
    // Devices and pipes named by a family file are never read.
    if (!info.isFile()) {
        last_ = outcome::failed;
        setmessage(failedtext(), false);
        return last_;
    }
    // Large scans take a moment to decode.
    busycursor busy(prompts_);
    QImageReader reader(path);
    reader.setAutoTransform(true);
    QImage picture;
    if (!reader.canRead()) {
        last_ = reader.error() == QImageReader::UnsupportedFormatError ? outcome::unsupported : outcome::failed;
    } else if (!reader.read(&picture) || picture.isNull()) {
        last_ = outcome::failed;
    } else {
        last_ = outcome::shown;
    }
    switch (last_) {
    case outcome::shown:
        previewmessagelab_->clear();
        previewmessagelab_->hide();
        imagepic_->setpicture(picture);
        stack_->setCurrentWidget(imagepic_);
        imagepic_->show();
        break;
    case outcome::unsupported:
        setmessage(unsupportedtext(), true);
        break;
    default:
        setmessage(failedtext(), false);
        break;
    }
    return last_;
}

QString imagepreview::message() const
{
    return previewmessagelab_->isVisibleTo(this) ? previewmessagelab_->text() : QString();
}

const QImage& imagepreview::picture() const
{
    return imagepic_->picture();
}

bool imagepreview::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == previewmessagelab_ && last_ == outcome::unsupported) {
        const bool click = event->type() == QEvent::MouseButtonRelease
            && static_cast<QMouseEvent*>(event)->button() == Qt::LeftButton;
        const bool key = event->type() == QEvent::KeyPress
            && (static_cast<QKeyEvent*>(event)->key() == Qt::Key_Space
                || static_cast<QKeyEvent*>(event)->key() == Qt::Key_Return
                || static_cast<QKeyEvent*>(event)->key() == Qt::Key_Enter);
        if (click || key) {
            openinviewer();
            return true;
        }
    }
    return QWidget::eventFilter(watched, event);
}

void imagepreview::openinviewer()
{
    const QString problem = prompts_.openexternal(path_);
    if (!problem.isEmpty())
        prompts_.tell(QStringLiteral("There was a problem previewing this file: ") + problem);
}

void imagepreview::showfullsize()
{
    if (!picture().isNull())
        imageviewfrm::view(picture(), window());
}

} // namespace qm

#include "images/imageviewfrm.h"

#include "images/imagepreview_ui.h"

#include <QGuiApplication>
#include <QScreen>
#include <QVBoxLayout>

namespace qm {

imageviewfrm::imageviewfrm(const QImage& picture, QWidget* parent) : QDialog(parent)
{
    setObjectName(QStringLiteral("imageviewfrm"));
    setWindowTitle(QStringLiteral("Image View"));
    setWindowFlag(Qt::WindowMaximizeButtonHint);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    mainpic_ = new picturebox(this);
    mainpic_->setObjectName(QStringLiteral("mainpic"));
    mainpic_->setAccessibleName(QStringLiteral("Full-size image"));
    mainpic_->setCursor(Qt::ArrowCursor);
    mainpic_->setFocusPolicy(Qt::NoFocus);
    mainpic_->setpicture(picture);
    layout->addWidget(mainpic_);
    // As large as the picture, within most of the screen.
    const QScreen* screen = parent ? parent->screen() : QGuiApplication::primaryScreen();
    const QSize room = screen ? screen->availableGeometry().size() * 0.85 : QSize(1024, 768);
    resize(picture.isNull() ? QSize(640, 480) : picture.size().boundedTo(room).expandedTo(QSize(320, 240)));
}

void imageviewfrm::view(const QImage& picture, QWidget* parent)
{
    imageviewfrm f(picture, parent);
    f.exec();
}

} // namespace qm

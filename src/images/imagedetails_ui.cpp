#include "images/imagedetails_ui.h"

#include "images/imagepreview_ui.h"

#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QVBoxLayout>

namespace qm {

imagepreview* addimagedetails(QWidget* frame, QVBoxLayout* layout, const std::array<const char*, 5>& captions,
                              std::span<QLineEdit*, 5> fields, prompts& p)
{
    auto* form = new QFormLayout;
    for (size_t i = 0; i < 5; ++i) {
        auto* t = new QLineEdit(frame);
        t->setObjectName(QStringLiteral("Imageinfotxt%1").arg(i));
        QString name = QString::fromLatin1(captions[i]);
        name.chop(1);
        t->setAccessibleName(name);
        t->setReadOnly(true);
        t->setMinimumWidth(260);
        fields[i] = t;
        form->addRow(QString::fromLatin1(captions[i]), t);
    }
    layout->addLayout(form);
    layout->addWidget(new QLabel(QStringLiteral("Image preview:"), frame));
    auto* preview = new imagepreview(p, QSize(240, 200), frame);
    layout->addWidget(preview);
    layout->addWidget(new QLabel(QStringLiteral("(Click on image to see full-size version)"), frame));
    return preview;
}

} // namespace qm

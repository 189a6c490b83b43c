#include "census/censusrows_ui.h"

#include "platform/formparts_ui.h"

#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QRegularExpressionValidator>
#include <QStyle>
#include <QToolButton>

namespace qm {

namespace {
void keepspace(QWidget* w)
{
    QSizePolicy p = w->sizePolicy();
    p.setRetainSizeWhenHidden(true);
    w->setSizePolicy(p);
}

QString nextunit(const QString& unit)
{
    if (unit == QLatin1String("Y"))
        return QStringLiteral("M");
    if (unit == QLatin1String("M"))
        return QStringLiteral("D");
    return QStringLiteral("Y");
}
} // namespace

censusrowsview::censusrowsview(QWidget* parent) : QWidget(parent)
{
    setObjectName(QStringLiteral("censusrows"));
    auto* grid = new QGridLayout(this);
    grid->setContentsMargins(0, 0, 0, 0);
    grid->setHorizontalSpacing(4);
    grid->setVerticalSpacing(2);

    const QStringList captions{QStringLiteral("Name:"), QStringLiteral("Age"), QStringLiteral("Y/M/D"),
                               QStringLiteral("Occupation:"), QStringLiteral("Rec ID")};
    for (int c = 0; c < captions.size(); ++c) {
        auto* l = new QLabel(captions[c], this);
        l->setObjectName(QStringLiteral("rowcaption%1").arg(c));
        grid->addWidget(l, 0, c);
    }
    upbut_ = new QToolButton(this);
    upbut_->setObjectName(QStringLiteral("upbut"));
    upbut_->setArrowType(Qt::UpArrow);
    upbut_->setToolTip(QStringLiteral("Scroll up to see more individuals selected for this census entry."));
    upbut_->setAccessibleName(QStringLiteral("Scroll up"));
    keepspace(upbut_);
    upbut_->hide();
    grid->addWidget(upbut_, 0, 5, 1, 2, Qt::AlignRight);
    connect(upbut_, &QToolButton::clicked, this, &censusrowsview::uprequested);

    const auto info = style()->standardIcon(QStyle::SP_MessageBoxInformation);
    const auto remove = style()->standardIcon(QStyle::SP_DialogDiscardButton);
    for (int r = 0; r < householdrows::visible; ++r) {
        rowcontrols& c = rows_[static_cast<size_t>(r)];
        const QString n = QString::number(r + 1);
        const int gr = r + 1;
        c.namelab = showsvalue(new QLabel(this), QStringLiteral("namelab"), QStringLiteral("Name, row ") + n);
        c.namelab->setMinimumWidth(120);
        c.namelab->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
        grid->addWidget(c.namelab, gr, 0);

        c.agetxt = new QLineEdit(this);
        c.agetxt->setObjectName(QStringLiteral("agetxt"));
        c.agetxt->setAccessibleName(QStringLiteral("Age, row ") + n);
        c.agetxt->setMaxLength(3);
        c.agetxt->setValidator(new QRegularExpressionValidator(QRegularExpression(QStringLiteral("[0-9]{0,3}")),
                                                               c.agetxt));
        c.agetxt->setFixedWidth(c.agetxt->fontMetrics().horizontalAdvance(QStringLiteral("0000")) + 12);
        c.agetxt->installEventFilter(this);
        grid->addWidget(c.agetxt, gr, 1);

        c.agetypetxt = new QLineEdit(QStringLiteral("Y"), this);
        c.agetypetxt->setObjectName(QStringLiteral("agetypetxt"));
        c.agetypetxt->setAccessibleName(QStringLiteral("Age unit, row ") + n);
        c.agetypetxt->setToolTip(QStringLiteral("Click on this to specify whether the age is in Years, Months or Days"));
        c.agetypetxt->setMaxLength(1);
        c.agetypetxt->setAlignment(Qt::AlignCenter);
        c.agetypetxt->setFixedWidth(c.agetypetxt->fontMetrics().horizontalAdvance(QStringLiteral("MM")) + 12);
        c.agetypetxt->installEventFilter(this);
        grid->addWidget(c.agetypetxt, gr, 2, Qt::AlignHCenter);

        c.occtxt = new QLineEdit(this);
        c.occtxt->setObjectName(QStringLiteral("occtxt"));
        c.occtxt->setAccessibleName(QStringLiteral("Occupation, row ") + n);
        c.occtxt->setMinimumWidth(100);
        c.occtxt->installEventFilter(this);
        grid->addWidget(c.occtxt, gr, 3);

        c.idlab = showsvalue(new QLabel(this), QStringLiteral("idlab"), QStringLiteral("Record ID, row ") + n);
        c.idlab->setMinimumWidth(c.idlab->fontMetrics().horizontalAdvance(QStringLiteral("0000000")));
        grid->addWidget(c.idlab, gr, 4);

        c.chosenlab = new QLabel(this);
        c.chosenlab->setObjectName(QStringLiteral("chosenlab"));
        c.chosenlab->hide();

        c.PicInfo = new QToolButton(this);
        c.PicInfo->setObjectName(QStringLiteral("PicInfo"));
        c.PicInfo->setIcon(info);
        c.PicInfo->setToolTip(QStringLiteral("Click to show information about this individual"));
        c.PicInfo->setAccessibleName(QStringLiteral("Information, row ") + n);
        c.PicInfo->setAutoRaise(true);
        keepspace(c.PicInfo);
        c.PicInfo->hide();
        grid->addWidget(c.PicInfo, gr, 5);
        connect(c.PicInfo, &QToolButton::clicked, this, [this, r] { emit inforequested(r); });

        c.deleterowbut = new QToolButton(this);
        c.deleterowbut->setObjectName(QStringLiteral("deleterowbut"));
        c.deleterowbut->setIcon(remove);
        c.deleterowbut->setToolTip(
            QStringLiteral("If you make a mistake click this to delete the corresponding row"));
        c.deleterowbut->setAccessibleName(QStringLiteral("Delete row ") + n);
        c.deleterowbut->setAutoRaise(true);
        keepspace(c.deleterowbut);
        c.deleterowbut->hide();
        grid->addWidget(c.deleterowbut, gr, 6);
        connect(c.deleterowbut, &QToolButton::clicked, this, [this, r] { emit deleterequested(r); });
    }
    downbut_ = new QToolButton(this);
    downbut_->setObjectName(QStringLiteral("downbut"));
    downbut_->setArrowType(Qt::DownArrow);
    downbut_->setToolTip(QStringLiteral("Scroll down to see more individuals selected for this census entry."));
    downbut_->setAccessibleName(QStringLiteral("Scroll down"));
    keepspace(downbut_);
    downbut_->hide();
    grid->addWidget(downbut_, householdrows::visible + 1, 5, 1, 2, Qt::AlignRight);
    connect(downbut_, &QToolButton::clicked, this, &censusrowsview::downrequested);

    grid->setColumnStretch(0, 3);
    grid->setColumnStretch(3, 2);
    grid->setRowStretch(householdrows::visible + 2, 1);
}

std::array<rowvalues, householdrows::visible> censusrowsview::values() const
{
    std::array<rowvalues, householdrows::visible> out;
    for (size_t r = 0; r < out.size(); ++r) {
        const rowcontrols& c = rows_[r];
        out[r].name = c.namelab->text();
        out[r].id = c.idlab->text();
        out[r].age = c.agetxt->text();
        out[r].agetype = c.agetypetxt->text();
        out[r].occupation = c.occtxt->text();
        out[r].chosen = c.chosenlab->text();
    }
    return out;
}

void censusrowsview::show(const householdrows& h)
{
    selectioncount_ = h.selectioncount;
    for (size_t r = 0; r < rows_.size(); ++r) {
        const rowcontrols& c = rows_[r];
        const rowvalues& v = h.rows[r];
        c.namelab->setText(v.name);
        c.idlab->setText(v.id);
        c.agetxt->setText(v.age);
        c.agetypetxt->setText(v.agetype);
        c.occtxt->setText(v.occupation);
        c.chosenlab->setText(v.chosen);
        // Empty rows take no typing, pasted text included.
        const bool inuse = h.selectioncount > static_cast<int>(r);
        c.agetxt->setReadOnly(!inuse);
        c.agetypetxt->setReadOnly(!inuse);
        c.occtxt->setReadOnly(!inuse);
        c.PicInfo->setVisible(v.shown());
        c.deleterowbut->setVisible(v.shown());
    }
    upbut_->setVisible(h.upshown());
    downbut_->setVisible(h.downshown());
}

int censusrowsview::rowof(QObject* o) const
{
    for (size_t r = 0; r < rows_.size(); ++r) {
        const rowcontrols& c = rows_[r];
        if (o == c.agetxt || o == c.agetypetxt || o == c.occtxt)
            return static_cast<int>(r);
    }
    return -1;
}

bool censusrowsview::eventFilter(QObject* watched, QEvent* event)
{
    const int r = rowof(watched);
    if (r < 0)
        return QWidget::eventFilter(watched, event);
    const rowcontrols& c = rows_[static_cast<size_t>(r)];
    const bool inuse = selectioncount_ > r;
    if (event->type() == QEvent::KeyPress) {
        auto* k = static_cast<QKeyEvent*>(event);
        // Keys that type nothing (moving, shortcuts) pass; typed characters
        // are filtered per box.
        const QString t = k->text();
        const bool typing = !t.isEmpty() && (t.at(0).isPrint() || k->key() == Qt::Key_Backspace) &&
                            !(k->modifiers() & (Qt::ControlModifier | Qt::AltModifier));
        if (!typing)
            return false;
        const bool backspace = k->key() == Qt::Key_Backspace;
        if (!inuse)
            return true;
        if (watched == c.agetxt)
            return !(backspace || (t.size() == 1 && t.at(0) >= u'0' && t.at(0) <= u'9'));
        if (watched == c.agetypetxt) {
            if (backspace)
                return false;
            const QString u = t.toUpper();
            if (u == QLatin1String("D") || u == QLatin1String("M") || u == QLatin1String("Y"))
                c.agetypetxt->setText(u);
            return true;
        }
        return false;
    }
    if (event->type() == QEvent::MouseButtonRelease && watched == c.agetypetxt && inuse) {
        if (static_cast<QMouseEvent*>(event)->button() == Qt::LeftButton) {
            c.agetypetxt->setText(nextunit(c.agetypetxt->text()));
            c.occtxt->setFocus(Qt::MouseFocusReason);
            return true;
        }
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace qm

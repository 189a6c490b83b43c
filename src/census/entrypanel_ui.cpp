#include "census/entrypanel_ui.h"

#include "census/backtab_ui.h"
#include "platform/formparts_ui.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSplitter>
#include <QVBoxLayout>

namespace qm {

namespace {
// The divider's limits, as shares of the height of the two boxes: the source
// text keeps at least a fifth; within 3 % of the bottom the note box closes.
constexpr double minshare = 0.2;
constexpr double closeshare = 0.97;

// A caption label for a field: its buddy is the field, and the field's
// accessible name is the caption without its colon; a label showing a value
// keeps the value as its name and takes the caption as its description.
QLabel* caption(QWidget* parent, const QString& text, QWidget* field)
{
    auto* l = new QLabel(text, parent);
    l->setBuddy(field);
    QString name = text;
    name.remove(QLatin1Char('&'));
    if (name.endsWith(QLatin1Char(':')))
        name.chop(1);
    if (auto* value = qobject_cast<QLabel*>(field))
        showsvalue(value, value->objectName(), name);
    else
        field->setAccessibleName(name);
    return l;
}

QLineEdit* linebox(QWidget* parent, const char* name)
{
    auto* e = new QLineEdit(parent);
    e->setObjectName(QString::fromLatin1(name));
    return e;
}

QPlainTextEdit* textbox(QWidget* parent, const char* name, bool tabs)
{
    auto* e = new QPlainTextEdit(parent);
    e->setObjectName(QString::fromLatin1(name));
    // The source text takes tab characters (its columns); Shift+Tab leaves it.
    e->setTabChangesFocus(!tabs);
    e->setMinimumHeight(40);
    return e;
}
} // namespace

entrypanel::entrypanel(int m, QWidget* parent) : QWidget(parent), mode(m)
{
    setObjectName(QStringLiteral("entrypanel%1").arg(m));
    auto* outer = new QHBoxLayout(this);
    outer->setContentsMargins(0, 0, 0, 0);
    auto* grid = new QGridLayout;
    grid->setVerticalSpacing(4);
    outer->addLayout(grid, 5);

    // Created in tab order.
    yearcom = new QComboBox(this);
    yearcom->setObjectName(QStringLiteral("yearcom"));
    yearcom->setMinimumContentsLength(5);
    fixeddatetxt = linebox(this, "fixeddatetxt");
    fixeddatetxt->setEnabled(false);
    fixeddatetxt->setMaximumWidth(fixeddatetxt->fontMetrics().horizontalAdvance(QStringLiteral("00 MMM 00000")) + 16);
    CensusYearLab = caption(this, QStringLiteral("UK Census Year:"), yearcom);
    CensusYearLab->setObjectName(QStringLiteral("CensusYearLab"));
    grid->addWidget(CensusYearLab, 0, 0);
    grid->addWidget(yearcom, 0, 1);
    grid->addWidget(caption(this, QStringLiteral("Census Date:"), fixeddatetxt), 0, 2, Qt::AlignRight);
    grid->addWidget(fixeddatetxt, 0, 3);

    sourceidlab = new QLabel(this);
    sourceidlab->setObjectName(QStringLiteral("sourceidlab"));
    sourceidlab->setMinimumWidth(sourceidlab->fontMetrics().horizontalAdvance(QStringLiteral("000000")));
    int row = 1;
    if (mode == 1) {
        sourcecom = new QComboBox(this);
        sourcecom->setObjectName(QStringLiteral("sourcecom"));
        sourcecom->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
        sourcecom->setMinimumContentsLength(20);
        grid->addWidget(caption(this, QStringLiteral("Existing Source:"), sourcecom), row, 0);
        grid->addWidget(sourcecom, row, 1, 1, 2);
        auto* id = new QHBoxLayout;
        id->setSpacing(6);
        id->addWidget(caption(this, QStringLiteral("Source ID:"), sourceidlab));
        id->addWidget(sourceidlab, 1);
        grid->addLayout(id, row, 3);
    } else {
        auto* id = new QHBoxLayout;
        id->setSpacing(6);
        id->addStretch(1);
        id->addWidget(caption(this, QStringLiteral("New Source ID:"), sourceidlab));
        id->addWidget(sourceidlab, 1);
        grid->addLayout(id, row, 2, 1, 2);
    }
    ++row;

    locationtxt = linebox(this, "locationtxt");
    locationtxt->setToolTip(QStringLiteral("The town or village for this census entry (e.g. Warrington, Lancashire)"));
    grid->addWidget(caption(this, QStringLiteral("Place:"), locationtxt), row, 0);
    grid->addWidget(locationtxt, row++, 1, 1, 3);
    addresstxt = linebox(this, "addresstxt");
    addresstxt->setToolTip(QStringLiteral("House number and road"));
    grid->addWidget(caption(this, QStringLiteral("Address:"), addresstxt), row, 0);
    grid->addWidget(addresstxt, row++, 1, 1, 3);
    if (mode == 0) {
        referencetxt = linebox(this, "referencetxt");
        othertxt = linebox(this, "othertxt");
        othertxt->setToolTip(QStringLiteral(
            "Other information identifying the source record (e.g. name of head of household)"));
        grid->addWidget(caption(this, QStringLiteral("Ref Code:"), referencetxt), row, 0);
        grid->addWidget(referencetxt, row, 1);
        grid->addWidget(caption(this, QStringLiteral("Other Info:"), othertxt), row, 2, Qt::AlignRight);
        grid->addWidget(othertxt, row++, 3);
        titletxt = linebox(this, "titletxt");
        grid->addWidget(caption(this, QStringLiteral("Full Title:"), titletxt), row, 0);
        grid->addWidget(titletxt, row++, 1, 1, 3);
    } else {
        wherewithinsourcetxt = linebox(this, "wherewithinsourcetxt");
        grid->addWidget(caption(this, QStringLiteral("Where within Source:"), wherewithinsourcetxt), row, 0);
        grid->addWidget(wherewithinsourcetxt, row++, 1, 1, 3);
    }
    grid->setRowStretch(row, 1);
    grid->setColumnStretch(1, 1);
    grid->setColumnStretch(3, 1);

    dividerpic = new QSplitter(Qt::Vertical, this);
    dividerpic->setObjectName(QStringLiteral("dividerpic"));
    // The fields on the left decide the panel's height; the two boxes share it.
    dividerpic->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Ignored);
    const auto half = [this](const QString& text, QPlainTextEdit* box, QPushButton*& editbut, const char* name,
                             const QString& tip) {
        auto* w = new QWidget(dividerpic);
        auto* v = new QVBoxLayout(w);
        v->setContentsMargins(0, 0, 0, 0);
        v->setSpacing(1);
        auto* top = new QHBoxLayout;
        top->setContentsMargins(0, 0, 0, 0);
        top->addWidget(caption(w, text, box));
        top->addStretch(1);
        editbut = new QPushButton(QStringLiteral("Expand..."), w);
        editbut->setObjectName(QString::fromLatin1(name));
        editbut->setToolTip(tip);
        editbut->setAutoDefault(false);
        editbut->setFocusPolicy(Qt::TabFocus);
        editbut->setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
        editbut->setMaximumHeight(editbut->fontMetrics().height() + 6);
        top->addWidget(editbut);
        v->addLayout(top);
        v->addWidget(box);
        return w;
    };
    texttxt = textbox(this, "texttxt", true);
    texttxt->installEventFilter(this);
    notetxt = textbox(this, "notetxt", false);
    dividerpic->addWidget(half(QStringLiteral("Source Text:"), texttxt, fulltextbut, "fulltextbut",
                               QStringLiteral("Show the source text in a large window")));
    dividerpic->addWidget(half(QStringLiteral("Source Note:"), notetxt, notetextbut, "notetextbut",
                               QStringLiteral("Show the source note in a large window")));
    // The source text always stays; the note box can be closed by dragging
    // the divider down.
    dividerpic->setCollapsible(0, false);
    dividerpic->setCollapsible(1, true);
    dividerpic->setHandleWidth(7);
    const QString dividertip = QStringLiteral("Drag up or down to reveal/resize the Source Note box");
    dividerpic->setAccessibleName(QStringLiteral("Source Text and Source Note"));
    dividerpic->handle(1)->setToolTip(dividertip);
    dividerpic->handle(1)->setAccessibleName(QStringLiteral("Divider between Source Text and Source Note"));
    dividerpic->handle(1)->setAccessibleDescription(dividertip);
    dividerpic->handle(1)->installEventFilter(this);
    connect(dividerpic, &QSplitter::splitterMoved, this, [this] { settle(false); });
    outer->addWidget(dividerpic, 6);
    setdivider(1);
}

double entrypanel::divider() const
{
    const QList<int> s = dividerpic->sizes();
    if (s.size() != 2 || s[0] + s[1] <= 0)
        return share_; // not laid out yet
    if (s[1] <= 0)
        return 1;
    return static_cast<double>(s[0]) / (s[0] + s[1]);
}

void entrypanel::setdivider(double share)
{
    if (!(share >= minshare && share <= 1))
        share = 1;
    if (share > closeshare)
        share = 1;
    share_ = share;
    const int total = std::max(1000, dividerpic->height());
    const int top = static_cast<int>(total * share);
    dividerpic->setSizes({top, total - top});
}

void entrypanel::settle(bool released)
{
    const QList<int> s = dividerpic->sizes();
    if (s.size() != 2 || s[0] + s[1] <= 0)
        return;
    const double share = divider();
    if (share < minshare) {
        setdivider(minshare);
    } else if (released) {
        setdivider(share);
        emit dividermoved(share_);
    }
}

bool entrypanel::eventFilter(QObject* watched, QEvent* event)
{
    // Tab types a tab (the columns of a transcription); Shift+Tab leaves the
    // box as in any other field.
    if (watched == texttxt && isbacktab(event)) {
        focusNextPrevChild(false);
        return true;
    }
    if (watched == dividerpic->handle(1) && event->type() == QEvent::MouseButtonRelease) {
        settle(true);
    }
    return QWidget::eventFilter(watched, event);
}

void entrypanel::clearfields(bool keepsourceid)
{
    for (QLineEdit* e : {fixeddatetxt, locationtxt, addresstxt, referencetxt, othertxt, titletxt,
                         wherewithinsourcetxt}) {
        if (e)
            e->clear();
    }
    texttxt->clear();
    notetxt->clear();
    yearcom->setCurrentIndex(-1);
    if (sourcecom)
        sourcecom->setCurrentIndex(-1);
    if (!keepsourceid)
        sourceidlab->clear();
    fixeddatetxt->setEnabled(false);
}

} // namespace qm

#include "census/householdpanel_ui.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QListView>
#include <QStackedWidget>
#include <QVBoxLayout>

namespace qm {

namespace {
QListView* listview(QWidget* parent, const char* name, peoplelistmodel* model)
{
    auto* v = new QListView(parent);
    v->setObjectName(QString::fromLatin1(name));
    v->setModel(model);
    // Every row has the same height: the view need not measure tens of
    // thousands of rows.
    v->setUniformItemSizes(true);
    v->setSelectionMode(QAbstractItemView::SingleSelection);
    v->setEditTriggers(QAbstractItemView::NoEditTriggers);
    v->setMinimumWidth(160);
    return v;
}

// A list is named after its caption, without the caption's colon.
void setcaption(QLabel* label, QListView* list, const QString& caption)
{
    label->setText(caption);
    QString name = caption;
    if (name.endsWith(QLatin1Char(':')))
        name.chop(1);
    list->setAccessibleName(name);
}
} // namespace

householdpanel::householdpanel(QWidget* parent) : QWidget(parent)
{
    setObjectName(QStringLiteral("householdpanel"));
    people = new peoplelistmodel(this);
    family = new peoplelistmodel(this);

    auto* outer = new QHBoxLayout(this);
    outer->setContentsMargins(0, 0, 0, 0);

    auto* peoplecol = new QVBoxLayout;
    auto* head = new QHBoxLayout;
    alllab = new QLabel(QStringLiteral("All Individuals:"), this);
    alllab->setObjectName(QStringLiteral("alllab"));
    allpeoplechk = new QCheckBox(QStringLiteral("Show All"), this);
    allpeoplechk->setObjectName(QStringLiteral("allpeoplechk"));
    allpeoplechk->setEnabled(false);
    head->addWidget(alllab, 1);
    head->addWidget(allpeoplechk);
    peoplecol->addLayout(head);

    stack_ = new QStackedWidget(this);
    allpeoplelst = listview(stack_, "allpeoplelst", people);
    NopeopleLab = new QLabel(
        QStringLiteral("As there are more than 32,000 people in this family history file this list will not be "
                       "displayed until a census year has been selected. Many individuals who could not appear in "
                       "the census will not be displayed."),
        stack_);
    NopeopleLab->setObjectName(QStringLiteral("NopeopleLab"));
    NopeopleLab->setWordWrap(true);
    NopeopleLab->setAlignment(Qt::AlignTop | Qt::AlignLeft);
    NopeopleLab->setMinimumWidth(160);
    stack_->addWidget(allpeoplelst);
    stack_->addWidget(NopeopleLab);
    alllab->setBuddy(allpeoplelst);
    peoplecol->addWidget(stack_, 1);
    outer->addLayout(peoplecol, 3);

    auto* familycol = new QVBoxLayout;
    immediatefamilylab = new QLabel(QStringLiteral("Immediate Family:"), this);
    immediatefamilylab->setObjectName(QStringLiteral("immediatefamilylab"));
    familylst = listview(this, "familylst", family);
    immediatefamilylab->setBuddy(familylst);
    familycol->addWidget(immediatefamilylab);
    familycol->addWidget(familylst, 1);
    outer->addLayout(familycol, 3);

    rows = new censusrowsview(this);
    outer->addWidget(rows, 5);

    setpeoplecaption(alllab->text());
    setfamilycaption(immediatefamilylab->text());

    connect(allpeoplelst, &QListView::clicked, this, [this](const QModelIndex& i) { emit personchosen(i.row()); });
    connect(familylst, &QListView::clicked, this, [this](const QModelIndex& i) { emit familychosen(i.row()); });
    allpeoplelst->installEventFilter(this);
    familylst->installEventFilter(this);
}

void householdpanel::showpeoplelist(bool shown)
{
    stack_->setCurrentWidget(shown ? static_cast<QWidget*>(allpeoplelst) : NopeopleLab);
}

bool householdpanel::peoplelistshown() const
{
    return stack_->currentWidget() == allpeoplelst;
}

void householdpanel::setpeoplecaption(const QString& caption)
{
    setcaption(alllab, allpeoplelst, caption);
}

void householdpanel::setfamilycaption(const QString& caption)
{
    setcaption(immediatefamilylab, familylst, caption);
}

bool householdpanel::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) {
            auto* view = static_cast<QListView*>(watched);
            const QModelIndex i = view->currentIndex();
            if (i.isValid()) {
                view->selectionModel()->select(i, QItemSelectionModel::ClearAndSelect);
                if (view == allpeoplelst)
                    emit personchosen(i.row());
                else
                    emit familychosen(i.row());
            }
            return true;
        }
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace qm

#include "flags/flagnamefrm.h"

#include "flags/flagalloc.h"
#include "platform/encoding.h"
#include "platform/formparts_ui.h"
#include "platform/prompts.h"

#include <QButtonGroup>
#include <QEvent>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace qm {

flagnamefrm::flagnamefrm(const flagtable& table, prompts& p, QWidget* parent)
    : QDialog(parent), table_(table), prompts_(p)
{
    setObjectName(QStringLiteral("flagnamefrm"));
    setWindowTitle(QStringLiteral("Census Flag Names"));
    setModal(true);

    auto* group = new QButtonGroup(this);
    const QString texts[] = {QStringLiteral("C&hoose existing flag name:"), QStringLiteral("&Create a new flag name:")};
    for (int i = 0; i < 2; ++i) {
        auto* o = new QRadioButton(texts[i], this);
        // Both options carry the control's one name, in index order.
        o->setObjectName(QStringLiteral("optflag"));
        o->setAccessibleName(QString(texts[i]).remove(QLatin1Char('&')).chopped(1));
        group->addButton(o, i);
        optflag_[static_cast<size_t>(i)] = o;
    }

    flagslst_ = new QListWidget(this);
    flagslst_->setObjectName(QStringLiteral("flagslst"));
    flagslst_->setAccessibleName(QStringLiteral("Existing flag names"));
    for (const size_t i : unallocatedflags(table_)) {
        auto* item = new QListWidgetItem(qs(table_[i].name), flagslst_);
        item->setData(Qt::UserRole, static_cast<qulonglong>(i));
    }
    flagslst_->setMinimumHeight(flagslst_->fontMetrics().height() * 8);
    flagnametxt_ = new QLineEdit(this);
    flagnametxt_->setObjectName(QStringLiteral("flagnametxt"));
    flagnametxt_->setAccessibleName(QStringLiteral("New flag name"));
    flagnametxt_->installEventFilter(this);

    const okcancel buttons = okcancelrow(this);
    okbut_ = buttons.ok;
    QPushButton* cancelbut = buttons.cancel;
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(optflag_[0]);
    layout->addWidget(flagslst_, 1);
    layout->addWidget(optflag_[1]);
    layout->addWidget(flagnametxt_);
    layout->addLayout(buttons.row);
    setMinimumWidth(flagnametxt_->fontMetrics().horizontalAdvance(QString(40, QLatin1Char('M'))));

    setTabOrder(optflag_[0], flagslst_);
    setTabOrder(flagslst_, optflag_[1]);
    setTabOrder(optflag_[1], flagnametxt_);
    setTabOrder(flagnametxt_, okbut_);
    setTabOrder(okbut_, cancelbut);

    connect(group, &QButtonGroup::idClicked, this, &flagnamefrm::optionchosen);
    connect(flagslst_, &QListWidget::itemSelectionChanged, this, [this] {
        if (!flagslst_->selectedItems().isEmpty())
            optflag_[0]->setChecked(true);
        updateok();
    });
    connect(flagslst_, &QListWidget::itemActivated, this, &flagnamefrm::ok);
    connect(flagnametxt_, &QLineEdit::textEdited, this, [this] {
        optflag_[1]->setChecked(true);
        updateok();
    });
    connect(okbut_, &QPushButton::clicked, this, &flagnamefrm::ok);
    connect(cancelbut, &QPushButton::clicked, this, &QDialog::reject);

    // With no existing flag to offer, only a new name can be given.
    const bool existing = flagslst_->count() > 0;
    optflag_[0]->setEnabled(existing);
    flagslst_->setEnabled(existing);
    optflag_[existing ? 0 : 1]->setChecked(true);
    (existing ? static_cast<QWidget*>(flagslst_) : flagnametxt_)->setFocus();
    updateok();
}

bool flagnamefrm::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == flagnametxt_ && event->type() == QEvent::MouseButtonPress) {
        optflag_[1]->setChecked(true);
        updateok();
    }
    return QDialog::eventFilter(watched, event);
}

void flagnamefrm::optionchosen(int which)
{
    updateok();
    if (which == 0)
        flagslst_->setFocus();
    else
        flagnametxt_->setFocus();
}

void flagnamefrm::updateok()
{
    if (optflag_[0]->isChecked())
        okbut_->setEnabled(!flagslst_->selectedItems().isEmpty());
    else
        okbut_->setEnabled(!flagnametxt_->text().trimmed().isEmpty());
}

void flagnamefrm::ok()
{
    if (optflag_[0]->isChecked()) {
        const QList<QListWidgetItem*> selected = flagslst_->selectedItems();
        if (selected.isEmpty())
            return;
        chosen_ = flagname{selected.front()->text(), static_cast<size_t>(selected.front()->data(Qt::UserRole).toULongLong())};
        accept();
        return;
    }
    const QString name = flagnametxt_->text().trimmed();
    if (const auto refused = refuseflagname(table_, name)) {
        prompts_.tell(refused->text, refused->invalid ? icon::none : icon::critical);
        flagnametxt_->setFocus();
        return;
    }
    chosen_ = flagname{name, std::nullopt};
    accept();
}

} // namespace qm

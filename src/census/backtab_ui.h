#pragma once
// Text boxes where Tab types a tab still let Shift+Tab leave them: their
// event filters ask this of each event.

#include <QEvent>
#include <QKeyEvent>

namespace qm {

inline bool isbacktab(const QEvent* event)
{
    if (event->type() != QEvent::KeyPress)
        return false;
    const auto* key = static_cast<const QKeyEvent*>(event);
    return key->key() == Qt::Key_Backtab
           || (key->key() == Qt::Key_Tab && key->modifiers().testFlag(Qt::ShiftModifier));
}

} // namespace qm

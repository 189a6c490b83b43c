#pragma once
// What a screen reader is told about a control.

#include <QAccessible>
#include <QWidget>

namespace qmtest {

// The name read for the control (Qt's accessibility interface of the widget).
inline QString accessiblename(QWidget* w)
{
    QAccessibleInterface* i = QAccessible::queryAccessibleInterface(w);
    return i ? i->text(QAccessible::Name) : QString();
}

} // namespace qmtest

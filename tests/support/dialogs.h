#pragma once
// The controls of a window found by the names the program gives them, the
// rows of its lists read and clicked, and whether every prompt and dialog was
// answered: for the window tests.
// Header only: the logic tests do not link the windows.

#include "platform/scriptedprompts.h"
#include "support/mainfrmfixture.h"

#include <QAbstractButton>
#include <QListWidget>
#include <QTest>

namespace qmtest {

// Every message box was expected, and every answer queued was used.
inline bool answered(const qm::scriptedprompts& p)
{
    return p.unexpected() == 0 && p.pending() == 0;
}

// Every dialog was expected and answered.
inline bool answered(const dialoganswers& a)
{
    return a.unexpected == 0 && a.pending() == 0;
}

// The control of that name; a missing one is reported by name.
template <class T = QAbstractButton>
T* child(const QWidget* w, const QString& name)
{
    T* c = w->findChild<T*>(name);
    if (!c)
        qWarning("no control %s", qPrintable(name));
    return c;
}
template <class T = QAbstractButton>
T* child(const QWidget* w, const char* name)
{
    return child<T>(w, QString::fromLatin1(name));
}

inline void press(const QWidget* w, const char* button)
{
    child(w, button)->click();
}

inline QStringList rows(const QListWidget* l)
{
    QStringList out;
    for (int i = 0; l && i < l->count(); ++i)
        out << l->item(i)->text();
    return out;
}
inline QStringList rows(const QWidget* w, const char* list)
{
    return rows(child<QListWidget>(w, list));
}

// The first row whose text begins with `start`, or -1.
inline int rowstarting(const QListWidget* l, const QString& start)
{
    for (int i = 0; i < l->count(); ++i)
        if (l->item(i)->text().startsWith(start))
            return i;
    return -1;
}

// Selects that row as a keyboard user would reach it; false when there is none.
inline bool pick(QListWidget* l, const QString& start)
{
    const int i = rowstarting(l, start);
    if (i >= 0)
        l->setCurrentRow(i);
    return i >= 0;
}

// Clicks that row with the mouse.
inline void clickitem(QListWidget* l, const QString& start)
{
    const int i = rowstarting(l, start);
    QVERIFY2(i >= 0, qPrintable(start));
    QTest::mouseClick(l->viewport(), Qt::LeftButton, {}, l->visualItemRect(l->item(i)).center());
}

// Clicks row `row` of a list, scrolled into view first.
inline void clickitem(const QWidget* w, const char* list, int row)
{
    auto* l = child<QListWidget>(w, list);
    l->scrollToItem(l->item(row));
    QTest::mouseClick(l->viewport(), Qt::LeftButton, {}, l->visualItemRect(l->item(row)).center());
}

} // namespace qmtest

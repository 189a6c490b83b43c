#pragma once
// The controls of a window found by their object names, and its lists read
// and clicked, for the window tests of the census, tools and settings folders.

#include <QAbstractButton>
#include <QListWidget>
#include <QTest>

namespace qmtest {

// The control of that name and type in w, or null.
template <class T = QAbstractButton>
T* child(const QWidget* w, const char* name)
{
    return w->findChild<T*>(QString::fromLatin1(name));
}

// The texts of the items of a list.
inline QStringList itemtexts(const QWidget* w, const char* list)
{
    QStringList out;
    if (auto* l = child<QListWidget>(w, list))
        for (int i = 0; i < l->count(); ++i)
            out << l->item(i)->text();
    return out;
}

// Clicks an item of a list, scrolled into view first.
inline void clickitem(const QWidget* w, const char* list, int row)
{
    auto* l = child<QListWidget>(w, list);
    l->scrollToItem(l->item(row));
    QTest::mouseClick(l->viewport(), Qt::LeftButton, {}, l->visualItemRect(l->item(row)).center());
}

} // namespace qmtest

#include "app/recentfiles.h"

#include "platform/settingsstore.h"

namespace qm {

QString recentvaluename(int slot)
{
    return QStringLiteral("Recent Files  ") + QString::number(slot + 1);
}

void recentfiles::read(const settingsstore& store)
{
    for (int i = 0; i < slotcount; ++i) {
        const QString v = store.read(recentvaluename(i)).value_or(QString()).trimmed();
        paths[static_cast<size_t>(i)] = v.size() < 2 ? QString() : v;
    }
}

void recentfiles::write(settingsstore& store) const
{
    for (int i = 0; i < slotcount; ++i)
        store.write(recentvaluename(i), paths[static_cast<size_t>(i)]);
}

void recentfiles::remember(const QString& path)
{
    int at = slotcount - 1; // not present: the last slot's path is dropped
    for (int i = 0; i < slotcount; ++i) {
        if (paths[static_cast<size_t>(i)] == path) {
            at = i;
            break;
        }
    }
    for (int i = at; i > 0; --i)
        paths[static_cast<size_t>(i)] = paths[static_cast<size_t>(i - 1)];
    paths[0] = path;
}

void recentfiles::remove(const QString& path)
{
    for (int i = 0; i < slotcount; ++i) {
        if (paths[static_cast<size_t>(i)] != path)
            continue;
        for (int j = i; j < slotcount - 1; ++j)
            paths[static_cast<size_t>(j)] = paths[static_cast<size_t>(j + 1)];
        paths[slotcount - 1].clear();
        return;
    }
}

QString recentfiles::caption(int slot) const
{
    const QString& p = paths[static_cast<size_t>(slot)];
    const QString n = QStringLiteral("&") + QString::number(slot + 1);
    if (p.size() > 40)
        return n + QStringLiteral("..") + p.right(40);
    return n + QLatin1Char(' ') + p;
}

} // namespace qm

#include "platform/paths.h"

#include <algorithm>

namespace qm {

namespace {
qsizetype lastseparator(const QString& path)
{
    return std::max(path.lastIndexOf(QLatin1Char('/')), path.lastIndexOf(QLatin1Char('\\')));
}
} // namespace

QString folderof(const QString& path)
{
    const qsizetype at = lastseparator(path);
    return at < 0 ? QString() : path.left(at + 1);
}

QString filenameof(const QString& path)
{
    return path.mid(lastseparator(path) + 1);
}

bool samefilepath(const QString& a, const QString& b)
{
#ifdef Q_OS_WIN
    return a.compare(b, Qt::CaseInsensitive) == 0;
#else
    return a == b;
#endif
}

} // namespace qm

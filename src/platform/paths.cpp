#include "platform/paths.h"

#include <QDir>
#include <QFileInfo>

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

QString canonicalpath(const QString& path)
{
    const QFileInfo info(path);
    const QString file = info.canonicalFilePath();
    if (!file.isEmpty())
        return file;
    const QString folder = QFileInfo(info.absolutePath()).canonicalFilePath();
    return folder.isEmpty() ? info.absoluteFilePath() : QDir(folder).filePath(info.fileName());
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

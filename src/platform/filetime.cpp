#include "platform/filetime.h"

#include <QDateTime>
#include <QFile>
#include <QFileInfo>

namespace qm {

filestamp stampof(const QString& path)
{
    QFileInfo info(path);
    filestamp s;
    if (!info.exists() || info.isDir())
        return s;
    s.exists = true;
    s.modified = info.lastModified().toMSecsSinceEpoch();
    s.size = info.size();
    return s;
}

bool setmodified(const QString& path, int64_t modified)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadWrite))
        return false;
    return f.setFileTime(QDateTime::fromMSecsSinceEpoch(modified), QFileDevice::FileModificationTime);
}

} // namespace qm

#include "log/clearlog.h"

#include "platform/prompts.h"

#include <QFile>
#include <QFileInfo>

namespace qm {

bool clearlog(prompts& asker, const QString& logpath)
{
    const QFileInfo info(logpath);
    if (logpath.isEmpty() || !info.isFile()) {
        asker.tell(QStringLiteral("The file specified does not exist or does not have a valid file path"));
        return false;
    }
    if (!asker.yes(QStringLiteral("Are you sure you want to clear the log file?"), icon::exclamation, answer::no,
                   QStringLiteral("Clear Log")))
        return false;
    // A read-only log is not forced.
    if (!info.isWritable() || !QFile::remove(logpath)) {
        asker.tell(QStringLiteral("There was an error deleting the file. The file may currently be open or you may "
                                  "not have permission to delete it"));
        return false;
    }
    asker.tell(QStringLiteral("The log file has been cleared"));
    QFile fresh(logpath);
    if (!fresh.open(QIODevice::WriteOnly | QIODevice::NewOnly)) {
        asker.tell(QStringLiteral("Error recreating the log file specified, please check the file name and path and "
                                  "that you have access to it and that the disk is not full."));
        return false;
    }
    fresh.close();
    return true;
}

} // namespace qm

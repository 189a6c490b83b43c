#include "support/heldfile.h"

#include <QDir>

namespace qmtest {

heldfile::heldfile(const QString& path, const char* sharing)
{
#ifdef QM_HOLDFILE_PATH
    holder_.start(QStringLiteral(QM_HOLDFILE_PATH), {QDir::toNativeSeparators(path), QString::fromLatin1(sharing)});
    holding_ = holder_.waitForReadyRead(30000) && holder_.readLine().trimmed() == "holding";
#else
    Q_UNUSED(sharing);
    file_.setFileName(path);
    holding_ = file_.open(QIODevice::ReadWrite);
#endif
}

heldfile::~heldfile()
{
    if (holder_.state() != QProcess::NotRunning) {
        holder_.closeWriteChannel();
        holder_.waitForFinished(30000);
    }
}

} // namespace qmtest

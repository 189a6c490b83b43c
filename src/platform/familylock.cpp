#include "platform/familylock.h"

#include "platform/replacefile.h"

#include <QDir>
#include <QFileInfo>
#include <QLockFile>

namespace qm {

namespace {

// Longer than any save takes; only a lock whose owner cannot be asked (it ran
// on another computer) waits for it.
constexpr int stalemsecs = 10 * 60 * 1000;

} // namespace

QString familylock::lockpath(const QString& familyfile)
{
    // Every name of the file (through symbolic links) shares one lock.
    const QString canonical = QFileInfo(familyfile).canonicalFilePath();
    return (canonical.isEmpty() ? familyfile : canonical) + QStringLiteral(".quillmark-lock");
}

familylock::familylock(const QString& familyfile)
    : family_(familyfile), lock_(std::make_unique<QLockFile>(lockpath(familyfile)))
{
    lock_->setStaleLockTime(stalemsecs);
}

familylock::~familylock() = default; // QLockFile unlocks when destroyed

QString familylock::acquire()
{
    if (lock_->tryLock(0))
        return QString();
    const QString family = QDir::toNativeSeparators(family_);
    const QString lock = QDir::toNativeSeparators(lockpath(family_));
    if (lock_->error() == QLockFile::LockFailedError) {
        qint64 pid = 0;
        QString host, app;
        QString who = QStringLiteral("Another Quillmark");
        if (lock_->getLockInfo(&pid, &host, &app))
            who += QStringLiteral(" (process %1 on %2)").arg(pid).arg(host);
        return who + QStringLiteral(" is saving a change to the family file ") + family
            + QStringLiteral(" at this moment, so nothing has been changed. Wait until it has finished, then save "
                             "again. If no other Quillmark is running, delete the file ")
            + lock + QStringLiteral(" and save again.");
    }
    return QStringLiteral("Quillmark cannot save a change to the family file ") + family
        + QStringLiteral(" because it cannot create the lock file ") + lock + QStringLiteral(" beside it (")
        + lastsystemerror()
        + QStringLiteral("). Check that you may write to the folder of the family file. Nothing has been changed.");
}

} // namespace qm

#include "writer/backups.h"

#include "log/censuslog.h"
#include "platform/clock.h"
#include "platform/filetime.h"
#include "platform/prompts.h"
#include "platform/replacefile.h"
#include "settings/settings.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>

#include <algorithm>
#include <vector>

namespace qm {

namespace {

// The time part of a backup's name.
QString backupstamp(const QDateTime& t)
{
    return t.toString(QStringLiteral("yyyy_MM_dd_HH_mm_ss"));
}

QString infolder(const QString& folder, const QString& name)
{
    return QDir(folder).filePath(name);
}

// The name after `name` among backups made in one second: "1", " 2", " 3" ...
QString nextsuffix(int n)
{
    return n == 0 ? QString() : n == 1 ? QStringLiteral("1") : QStringLiteral(" ") + QString::number(n);
}

} // namespace

QString backupfailedmessage()
{
    return QStringLiteral("There was an error when attempting to back up your family historian file. Check that you ")
        + QStringLiteral("this file is not currently open in another application, that you have sufficient disk space and that ")
        + QStringLiteral("you have sufficient file permissions to write data into the Quillmark install folder.");
}

QString freebackuppath(const QString& folder, const QString& stamp)
{
    const QString base = QStringLiteral("QM Backup ") + stamp;
    for (int n = 0;; ++n) {
        const QString path = infolder(folder, base + nextsuffix(n) + QStringLiteral(".ged"));
        if (!QFileInfo::exists(path))
            return path;
    }
}

bool isbackupname(const QString& name)
{
    return name.startsWith(QStringLiteral("qm backup "), Qt::CaseInsensitive)
        && name.endsWith(QStringLiteral(".ged"), Qt::CaseInsensitive);
}

backupresult makebackup(const QString& familyfile, const QString& folder)
{
    backupresult r;
    const auto failed = [&r](const QString& why) {
        r.error = backupfailedmessage() + QStringLiteral(" (") + why + QStringLiteral(")");
        return r;
    };
    // No folder must never mean the current folder, wherever that is.
    if (folder.trimmed().isEmpty())
        return failed(QStringLiteral("no backup folder is set"));
    QFile from(familyfile);
    if (!from.open(QIODevice::ReadOnly))
        return failed(from.errorString());
    const filestamp original = stampof(familyfile);

    // The name is taken by creating the file, never by looking first: another
    // Quillmark saving in the same second into the same folder takes the next
    // suffix instead of this process writing over (or removing) its backup.
    const QString base = QStringLiteral("QM Backup ") + backupstamp(now());
    QFile to;
    for (int n = 0;; ++n) {
        to.setFileName(infolder(folder, base + nextsuffix(n) + QStringLiteral(".ged")));
        if (to.open(QIODevice::WriteOnly | QIODevice::NewOnly))
            break;
        const QFileInfo taken(to.fileName());
        if (n >= 9999 || !(taken.exists() || taken.isSymLink()))
            return failed(to.errorString());
    }
    // A copy, not a move: the family file stays whole until its replacement is
    // complete on disk. The copy keeps the file's last-modified time and permissions.
    QString why;
    const bool copied = copydata(from, to, &why)
        && to.setFileTime(QDateTime::fromMSecsSinceEpoch(original.modified), QFileDevice::FileModificationTime)
        && to.setPermissions(from.permissions());
    if (!copied && why.isEmpty())
        why = to.errorString();
    to.close();
    if (!copied || to.error() != QFileDevice::NoError) {
        if (why.isEmpty())
            why = to.errorString();
        to.remove(); // made by this process a moment ago
        return failed(why);
    }
    r.path = to.fileName();
    return r;
}

bool checkbackupfolder(prompts& p, const QString& folder)
{
    if (!QFileInfo(folder).isDir()) {
        p.tell(QStringLiteral("The folder currently selected to hold backups of your GEDCOM files before Quillmark makes changes, does not exist. ")
               + folder + QStringLiteral(" . Please select another folder to store the backups in."));
        return true;
    }
    const QString probe = infolder(folder, now().toString(QStringLiteral("yyyyMMddHHmmss")) + QStringLiteral(".tmp"));
    QFile f(probe);
    if (!f.open(QIODevice::WriteOnly | QIODevice::Truncate)) {
        p.tell(QStringLiteral("The folder currently selected to hold backups of your GEDCOM files before Quillmark makes changes, can not be written to. ")
                   + folder
                   + QStringLiteral(" . Please check that you have necessary permissions to write to the folder or select another folder to store the backups in."),
               icon::critical);
        return true;
    }
    f.close();
    f.remove();
    return false;
}

bool checkpaths(prompts& p, const settings& s)
{
    if (s.keeplog) {
        QString error = refuselogpath(s.logpath, QString(), s.backupfolder);
        if (error.isEmpty())
            error = checklogfile(s.logpath);
        if (!error.isEmpty()) {
            p.tell(error, icon::critical);
            return true;
        }
    }
    return checkbackupfolder(p, s.backupfolder);
}

void removeoldbackups(prompts& p, const QString& folder)
{
    struct backupfile {
        QString path;
        qint64 modified;
    };
    std::vector<backupfile> backups;

    const QDir dir(folder);
    const QFileInfoList files = dir.entryInfoList(QDir::Files | QDir::Hidden | QDir::System, QDir::Name);
    for (const QFileInfo& info : files) {
        QString name = info.fileName();
        QString path = info.filePath();
        const qint64 modified = info.lastModified().toMSecsSinceEpoch();
        // Backups of the old form "Backup  <n>.ged" take the current form.
        if (name.size() >= 13 && name.startsWith(QStringLiteral("backup  "), Qt::CaseInsensitive)
            && name.endsWith(QStringLiteral(".ged"), Qt::CaseInsensitive)) {
            const QString number = name.mid(8, name.size() - 12);
            const bool numeric = !number.isEmpty()
                && std::all_of(number.begin(), number.end(), [](QChar c) { return c >= u'0' && c <= u'9'; });
            if (numeric) {
                const QString renamed = freebackuppath(folder, backupstamp(info.lastModified()));
                if (QFile::rename(path, renamed)) {
                    path = renamed;
                    name = QFileInfo(renamed).fileName();
                }
            }
        }
        if (isbackupname(name))
            backups.push_back({path, modified});
    }

    const int count = static_cast<int>(backups.size());
    if (count == 0) {
        p.tell(QStringLiteral("You have no Quillmark backup files to delete."));
        return;
    }
    if (count <= 5) {
        p.tell(QStringLiteral("You only have ") + QString::number(count)
               + QStringLiteral(" Quillmark backup files and so none will be deleted just in case a problem occurs with your data."));
        return;
    }
    if (!p.yes(QString::number(count - 5)
                   + QStringLiteral(" Quillmark backup files will be deleted leaving you with the 5 most recent backups. Are you sure you want to do this?"),
               icon::exclamation, answer::no))
        return;

    // Newest first; among equal times the later name (a later suffix) stays.
    std::sort(backups.begin(), backups.end(), [](const backupfile& a, const backupfile& b) {
        return a.modified != b.modified ? a.modified > b.modified : a.path > b.path;
    });
    int deleted = 0;
    for (size_t i = 5; i < backups.size(); ++i) {
        QFile f(backups[i].path);
        f.setPermissions(f.permissions() | QFileDevice::WriteOwner | QFileDevice::WriteUser);
        if (f.remove())
            ++deleted;
        else
            p.tell(f.errorString() + QStringLiteral(": ") + QDir::toNativeSeparators(backups[i].path), icon::exclamation);
    }
    p.tell(QStringLiteral("Deleted ") + QString::number(deleted) + QStringLiteral(" backup files."));
}

} // namespace qm

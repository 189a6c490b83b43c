#pragma once
// Backups of the family file: the copy made before every rewrite, the check of
// the backup folder and the pruning command "Remove Old Backup Files...".
//
// A backup is "QM Backup " + the local time as YYYY_MM_DD_hh_nn_ss + an optional
// uniqueness suffix + ".ged" in the backup folder. It is a copy of the family
// file with the family file's last-modified time; the family file itself stays
// where it is until the rewrite replaces it in one step.

#include <QString>

namespace qm {

class prompts;
struct settings;

struct backupresult {
    QString path;  // the new backup; empty when the backup failed
    QString error; // the message for the user when it failed

    bool ok() const { return !path.isEmpty(); }
};

// Copies familyfile into folder under a new backup name.
backupresult makebackup(const QString& familyfile, const QString& folder);

// The message shown when a backup cannot be made.
QString backupfailedmessage();

// A free backup path in folder for the time stamp (YYYY_MM_DD_hh_nn_ss): the
// stamp alone, then the stamp followed by "1", " 2", " 3" ...
QString freebackuppath(const QString& folder, const QString& stamp);

// Whether a file name is that of a backup (case-insensitive "qm backup *.ged").
bool isbackupname(const QString& name);

// The log check (when "Keep Log" is on) and then, if the log is fine, the check
// of the backup folder. Shows what it finds; returns true when there was a problem.
bool checkpaths(prompts& p, const settings& s);
// The backup folder half of checkpaths.
bool checkbackupfolder(prompts& p, const QString& folder);

// Renames backups of the old "Backup  <n>.ged" form, then offers to delete all
// but the five most recent backups.
void removeoldbackups(prompts& p, const QString& folder);

} // namespace qm

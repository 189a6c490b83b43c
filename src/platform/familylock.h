#pragma once
// One save of a family file at a time, across every Quillmark process: a lock
// file beside the family file, held from the first check of a save to its
// last step. A lock left behind by a Quillmark that ended without removing it
// (a crash, a power cut) is taken over: at once when that Quillmark ran on
// this computer, after ten minutes when it ran on another.
//
// The lock's name is the family file's name + ".quillmark-lock", which no
// check of the program takes for a family file or a backup.

#include <QString>

#include <memory>

class QLockFile;

namespace qm {

class familylock {
public:
    explicit familylock(const QString& familyfile);
    ~familylock(); // releases the lock
    familylock(const familylock&) = delete;
    familylock& operator=(const familylock&) = delete;

    // Takes the lock without waiting. "" when taken, else the message for the user.
    QString acquire();

    // The lock file of a family file.
    static QString lockpath(const QString& familyfile);

private:
    QString family_;
    std::unique_ptr<QLockFile> lock_;
};

} // namespace qm

#pragma once
// A folder for the tests of saving: the family file, a backup folder and the
// census log's path beside it, the clock fixed; the clock and every fault
// hook of the save are put back when the test ends.

#include "platform/clock.h"
#include "platform/filetime.h"
#include "settings/settings.h"
#include "support/testfiles.h"
#include "writer/linewriter.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace qmtest {

// The clock fixed for the life of the object, as change stamps and backup names read it.
class fixedclock {
public:
    explicit fixedclock(const QDateTime& at) { qm::setclockfortests(at); }
    ~fixedclock() { qm::setclockfortests(QDateTime()); }
    fixedclock(const fixedclock&) = delete;
    fixedclock& operator=(const fixedclock&) = delete;
};

class savefolder : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        qm::setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(23, 50, 7)));
        QDir(dir.path()).mkpath(QStringLiteral("backups"));
        family = dir.filePath(QStringLiteral("family.ged"));
        s.backupfolder = dir.filePath(QStringLiteral("backups"));
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        s.keeplog = true;
    }
    void TearDown() override
    {
        qm::setclockfortests(QDateTime());
        qm::setwritefaultfortests(qm::writefault());
        qm::setinputfaultfortests(false);
        qm::setsavehookfortests({});
    }

    // Writes the family file, dated a second long past so that any later write is seen.
    void putfamily(const std::string& bytes)
    {
        writefile(family, bytes);
        qm::setmodified(family, QDateTime(QDate(2024, 5, 6), QTime(7, 8, 9)).toMSecsSinceEpoch());
    }
    QStringList backups() const { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }
    // The files beside the family file, hidden ones too (temporary files, locks, notes).
    QStringList besidefamily() const { return QDir(dir.path()).entryList(QDir::Files | QDir::Hidden, QDir::Name); }

    QTemporaryDir dir;
    QString family;
    qm::settings s;
};

} // namespace qmtest

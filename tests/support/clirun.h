#pragma once
// Running quillmark-cli as a user would, for the tests of its commands.

#include "settings/settings.h"

#include <QByteArray>
#include <QDir>
#include <QJsonObject>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <string>

namespace qmtest {

// What one run gave: the exit status (-1 when the program did not end
// normally within the time allowed) and its two outputs.
struct clirun {
    int status = -1;
    QByteArray out, err;
};

// The same with the outputs as text; json() reads standard output as one object.
struct clitextrun {
    int status = -1;
    std::string out, err;
    QJsonObject json() const;
};
clitextrun astext(const clirun& r);

// Runs `program` with args. With `home`, the user's folders (HOME, data and
// configuration) lie inside it, so that nothing falls back on the real ones.
// With `workdir`, the program runs in that folder.
clirun runprogram(const QString& program, const QStringList& args, const QString& home = QString(),
                  const QString& workdir = QString());

#ifdef QM_CLI_PATH
inline clirun runcli(const QStringList& args, const QString& home = QString(), const QString& workdir = QString())
{
    return runprogram(QStringLiteral(QM_CLI_PATH), args, home, workdir);
}
#endif

// Default settings that keep a test's backups in folder/backups (made here)
// and its census log in folder/censuslog.txt.
qm::settings clitestsettings(const QString& folder);

// Writes every value of s that the tool reads into an INI file, so that none
// of them falls back to its default.
void writeclisettings(const QString& ini, const qm::settings& s);

#ifdef QM_CLI_PATH
// The tests of one command: a folder holding a complete settings file (the
// backups and the census log inside the folder) and the path family.ged in it.
class clitest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        ini = dir.filePath(QStringLiteral("settings.ini"));
        file = dir.filePath(QStringLiteral("family.ged"));
        writeclisettings(ini, clitestsettings(dir.path()));
    }

    // `quillmark-cli command args --settings ini`, with the folder as its home.
    clitextrun cli(const QString& command, const QStringList& args) const
    {
        return astext(runcli(QStringList{command} + args + QStringList{QStringLiteral("--settings"), ini}, dir.path()));
    }
    // The backups made (the notes kept beside them left out).
    QStringList backups() const
    {
        return QDir(dir.filePath(QStringLiteral("backups"))).entryList({QStringLiteral("QM Backup*")}, QDir::Files);
    }
    // Nothing at all in the backup folder: no backup, no note.
    bool backupfolderempty() const { return QDir(dir.filePath(QStringLiteral("backups"))).isEmpty(); }

    QTemporaryDir dir;
    QString ini, file;
};
#endif

} // namespace qmtest

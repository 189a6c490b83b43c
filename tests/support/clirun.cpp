#include "support/clirun.h"

#include "platform/settingsstore.h"

#include <QDir>
#include <QJsonDocument>
#include <QProcess>
#include <QProcessEnvironment>

namespace qmtest {

clirun runprogram(const QString& program, const QStringList& args, const QString& home, const QString& workdir)
{
    QProcess p;
    if (!workdir.isEmpty())
        p.setWorkingDirectory(workdir);
    if (!home.isEmpty()) {
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert(QStringLiteral("HOME"), home);
        env.insert(QStringLiteral("XDG_DATA_HOME"), QDir(home).filePath(QStringLiteral("data")));
        env.insert(QStringLiteral("XDG_CONFIG_HOME"), QDir(home).filePath(QStringLiteral("config")));
        p.setProcessEnvironment(env);
    }
    p.start(program, args);
    clirun r;
    if (!p.waitForFinished(120000) || p.exitStatus() != QProcess::NormalExit)
        return r;
    r.status = p.exitCode();
    r.out = p.readAllStandardOutput();
    r.err = p.readAllStandardError();
    return r;
}

QJsonObject clitextrun::json() const
{
    return QJsonDocument::fromJson(QByteArray::fromStdString(out)).object();
}

clitextrun astext(const clirun& r)
{
    return {r.status, r.out.toStdString(), r.err.toStdString()};
}

qm::settings clitestsettings(const QString& folder)
{
    const QDir dir(folder);
    dir.mkdir(QStringLiteral("backups"));
    qm::settings s = qm::defaultsettings();
    s.backupfolder = dir.filePath(QStringLiteral("backups"));
    s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
    return s;
}

} // namespace qmtest

namespace qmtest {

void writeclisettings(const QString& ini, const qm::settings& s)
{
    const auto store = qm::settingsstore::onfile(ini);
    qm::savesettings(*store, s);
    qm::saveflagsettings(*store, s);
}

} // namespace qmtest

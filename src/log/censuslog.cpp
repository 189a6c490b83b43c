#include "log/censuslog.h"

#include "platform/clock.h"
#include "platform/paths.h"
#include "settings/settings.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace qm {

namespace {

QString timestamp()
{
    // Local time, written the same way in every locale so that it cannot be misread.
    return now().toString(QStringLiteral("yyyy-MM-dd HH:mm:ss"));
}

QString native(const QString& path)
{
    return QDir::toNativeSeparators(path);
}

QString appendlines(const settings& s, const QStringList& lines)
{
    const auto unable = [&s](const QString& why) {
        return QStringLiteral("Quillmark was unable to add a log entry for this record to the log file ")
            + native(s.logpath) + QStringLiteral(" (") + why + QStringLiteral(")");
    };
    if (s.logpath.isEmpty())
        return unable(QStringLiteral("no log file is set"));
    QFile f(s.logpath);
    if (!f.open(QIODevice::WriteOnly | QIODevice::Append))
        return unable(f.errorString());
    QByteArray bytes;
    for (const QString& line : lines) {
        bytes += line.toUtf8();
        bytes += "\r\n";
    }
    // A full disk or a file that takes no writing shows only here, or at the
    // flush or the close.
    if (f.write(bytes) != bytes.size() || !f.flush())
        return unable(f.errorString());
    f.close();
    if (f.error() != QFileDevice::NoError)
        return unable(f.errorString());
    return QString();
}

void modeonelines(const settings& s, const logentry& e, QStringList& out)
{
    out << QStringLiteral("Census entry added: ") + timestamp();
    out << QStringLiteral("To Gedcom File: ") + native(e.gedcomfile);
    const QString source = e.title.trimmed() + QStringLiteral(" (ID: ") + e.sourceid.trimmed() + QStringLiteral(")");
    if (s.fullentry) {
        out << QStringLiteral("Source created: ") + source;
    } else {
        out << QStringLiteral("Source referred to: ") + source;
        out << QStringLiteral("Where within source: ") + e.reference.trimmed();
        if (s.sharednote)
            out << QStringLiteral("Note created containing census text and linked to each source citation");
    }
    out << QString();
    out << QStringLiteral("Individual records changed (linked to source above): ");
    for (const selectionrec& r : e.selection) {
        QString line = QStringLiteral("Name: ") + r.name + QStringLiteral(" (") + QString::number(r.id)
            + QStringLiteral(") : created ")
            + (s.residence ? QStringLiteral("residence attribute") : QStringLiteral("census event"));
        if (r.occupation.trimmed().size() >= 2)
            line += QStringLiteral(" and occupation attribute (") + r.occupation.trimmed() + QStringLiteral(")");
        // Birth events are written only with "Birthdate" on; the log says what was written.
        if (r.birthedited && s.birthdate)
            line += QStringLiteral(" and birth event (") + r.birthdate.trimmed() + QStringLiteral(" (cal) ")
                + r.birthplace + QStringLiteral(")");
        out << line;
    }
    if (!e.flagname.isEmpty())
        out << QStringLiteral("Each individual was given flag '") + e.flagname
                + QStringLiteral("' unless they already had it.");
}

} // namespace

QString logtimestamp()
{
    return timestamp();
}

QString logseparator()
{
    return QString(78, u'=');
}

QStringList loglines(const settings& s, const logentry& e)
{
    QStringList out;
    out << logseparator();
    switch (e.mode) {
    case 1:
        modeonelines(s, e, out);
        break;
    case 2:
        out << QStringLiteral("Image(s) attached: ") + timestamp();
        out << QStringLiteral("To GEDCOM File: ") + native(e.gedcomfile);
        out << QStringLiteral("Source image(s) attached to: ") + e.title.trimmed() + QStringLiteral(" (ID: ")
                + e.sourceid.trimmed() + QStringLiteral(")");
        break;
    case 3:
        out << QStringLiteral("Census dates changed: ") + timestamp();
        out << QStringLiteral("In GEDCOM File: ") + native(e.gedcomfile);
        for (const datechange& d : e.datechanges)
            if (d.applies())
                out << QStringLiteral("Changed ") + QString::number(d.count) + QStringLiteral(" census events dated ")
                        + d.founddate + QStringLiteral(" to ") + d.newdate;
        out << QStringLiteral("and changed ") + QString::number(e.occdateschanged)
                + QStringLiteral(" associated occupation dates");
        break;
    case 4:
        out << QStringLiteral("Flag Check changes made: ") + timestamp();
        out << QStringLiteral("In GEDCOM File: ") + native(e.gedcomfile);
        out << QStringLiteral("Made ") + QString::number(e.flagchangecount) + QStringLiteral(" changes.");
        break;
    default:
        break;
    }
    for (const imagechoice& im : e.chosenimages) {
        if (im.isnew)
            out << QStringLiteral("Multimedia image record created and linked to the census source: ") + im.title
                    + QStringLiteral(" (") + im.file + QStringLiteral(")");
        else
            out << QStringLiteral("Existing image record linked to the census source: ") + im.title;
    }
    return out;
}

QString writerenameentry(const settings& s, const QString& from, const QString& to)
{
    return appendlines(s, {logseparator(), QStringLiteral("Image renamed on: ") + timestamp(),
                           QStringLiteral("From: ") + native(from), QStringLiteral("To: ") + native(to)});
}

QString writeundoentry(const settings& s, const QString& gedcomfile, const QString& summary, const QString& made,
                       const QString& restoredfrom, const QString& backup)
{
    return appendlines(s, {logseparator(), QStringLiteral("Change undone: ") + timestamp(),
                           QStringLiteral("In GEDCOM File: ") + native(gedcomfile),
                           QStringLiteral("Undone: ") + summary + QStringLiteral(" (made ") + made + u')',
                           QStringLiteral("Put back from backup: ") + native(restoredfrom),
                           QStringLiteral("The file as it was before the undo is in backup: ") + native(backup)});
}

QString writelogentry(const settings& s, const logentry& e)
{
    return appendlines(s, loglines(s, e));
}

QString refuselogpath(const QString& logpath, const QString& familyfile, const QString& backupfolder)
{
    const QString log = canonicalpath(logpath.trimmed());
    const QString shown = native(logpath.trimmed());
    if (!familyfile.isEmpty() && samefilepath(log, canonicalpath(familyfile)))
        return QStringLiteral("The census log file %1 is the family file itself: Quillmark never writes its log into "
                              "a family file. Please choose another log file in the options.")
            .arg(shown);
    if (logpath.trimmed().endsWith(QLatin1String(".ged"), Qt::CaseInsensitive))
        return QStringLiteral("The census log file %1 is a GEDCOM file: Quillmark never writes its log into a family "
                              "file. Please choose another log file (a .txt file) in the options.")
            .arg(shown);
    if (!backupfolder.trimmed().isEmpty()
        && samefilepath(QFileInfo(log).absolutePath(), canonicalpath(backupfolder.trimmed())))
        return QStringLiteral("The census log file %1 is in the backup folder, which holds only backups of family "
                              "files. Please choose a log file in another folder in the options.")
            .arg(shown);
    return QString();
}

QString checklogfile(const QString& logpath)
{
    QFile f(logpath);
    if (!logpath.isEmpty() && f.open(QIODevice::WriteOnly | QIODevice::Append)) {
        f.close();
        return QString();
    }
    const QString why = logpath.isEmpty() ? QStringLiteral("no file name") : f.errorString();
    return QStringLiteral("The current log file can not be written to (") + native(logpath)
        + QStringLiteral("). Error: ") + why
        + QStringLiteral(" occurred. Correct the error or if necessary change the log file path.");
}

} // namespace qm

#include "settings/options.h"

#include "census/censustable.h"
#include "log/censuslog.h"
#include "platform/prompts.h"
#include "writer/backups.h"
#include "writer/maketitle.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace qm {

settings dialogdefaults(const settings& form)
{
    settings out = form;
    takeoptions(out, defaultsettings());
    out.marriagecondition = form.marriagecondition;
    return out;
}

void takeoptions(settings& to, const settings& form)
{
    to.fullentry = form.fullentry;
    to.sourceinnote = form.sourceinnote;
    to.keeplog = form.keeplog;
    to.logpath = form.logpath;
    to.country = form.country;
    to.birthdate = form.birthdate;
    to.householdcheck = form.householdcheck;
    to.certainty = form.certainty;
    to.residence = form.residence;
    to.sourcetype = form.sourcetype;
    to.requestimage = form.requestimage;
    to.idonly = form.idonly;
    to.autoreference = form.autoreference;
    to.backupfolder = form.backupfolder;
    to.opt1entrydate = form.opt1entrydate;
    to.opt1whereinsource = form.opt1whereinsource;
    to.opt1publicationinfo = form.opt1publicationinfo;
    to.requestimages2 = form.requestimages2;
    to.image2event = form.image2event;
    to.entrydatetoday = form.entrydatetoday;
    to.occplace = form.occplace;
    to.occage = form.occage;
    to.sharednote = form.sharednote;
    to.title = form.title;
    to.asid = form.asid;
    to.fileopendefault = form.fileopendefault;
    to.sourcenote = form.sourcenote;
    to.occscholar = form.occscholar;
    to.alternateseparator = form.alternateseparator;
    to.alternateseparatorcharacter = form.alternateseparatorcharacter;
    to.marriagecondition = form.marriagecondition;
    to.nosourcetextwarning = form.nosourcetextwarning;
}

optionsenabling enablingof(const settings& form)
{
    optionsenabling e;
    e.logpath = form.keeplog;
    e.entrydatetoday = form.fullentry ? form.opt1entrydate : true;
    e.image2event = form.fullentry ? true : form.requestimages2;
    e.separator = form.alternateseparator;
    e.autoreference = form.country == QLatin1String("UK");
    return e;
}

int certaintyofchoice(int choice)
{
    return choice >= 0 && choice <= 3 ? 3 - choice : -1;
}

int choiceofcertainty(int certainty)
{
    return certainty >= 0 && certainty <= 3 ? 3 - certainty : -1;
}

QString gedcomlogmessage()
{
    return QStringLiteral("You should not (and can not) use a gedcom file to log these changes!");
}

logname chooselogname(const QString& chosen)
{
    if (chosen.endsWith(QLatin1String("ged"), Qt::CaseInsensitive))
        return {QString(), gedcomlogmessage()};
    if (chosen.isEmpty())
        return {QString(), QStringLiteral("You must select a path and file name for the log file")};
    QString path = QDir::toNativeSeparators(chosen);
    if (!path.endsWith(QLatin1String(".txt"), Qt::CaseInsensitive))
        path += QStringLiteral(".txt");
    return {path, QString()};
}

QString trimbackupfolder(const QString& folder)
{
    QString f = folder.trimmed();
#ifdef Q_OS_WIN
    const bool trailing = f.endsWith(u'\\');
#else
    const bool trailing = f.endsWith(u'\\') || f.endsWith(u'/');
#endif
    if (f.size() > 1 && trailing)
        f.chop(1);
    return f;
}

QStringList titleplaceholders()
{
    return {QStringLiteral("{YEAR}"),  QStringLiteral("{DATE}"), QStringLiteral("{PLACE}"),
            QStringLiteral("{ADDR}"),  QStringLiteral("{OTHER}"), QStringLiteral("{REF}"),
            QStringLiteral("{COUNTRY}")};
}

QString titleexample(const QString& templ)
{
    const censusdef& c = censustable().at(1);
    return maketitle(templ, QString::number(c.year), c.date, QStringLiteral("Warrington, Lancashire"),
                     QStringLiteral("43 Knutsford Road"), QStringLiteral("John Smith"),
                     QStringLiteral("HO107/2204/151"), c.country);
}

QString noseparatormessage()
{
    return QStringLiteral("You must enter a character to act as a separator");
}

QString methodchangequestion()
{
    return QStringLiteral("Changing the census recording method will cause any partially entered census entry on "
                          "the main screen to be lost. Are you sure you want to make this change to the options?");
}

QString countrychangequestion()
{
    return QStringLiteral("Changing the country will cause any partially entered census entry on the main screen "
                          "to be lost. Are you sure you want to make this change to the options?");
}

QString idonlychangequestion()
{
    return QStringLiteral("Changing how individuals are shown in the All Individuals and Immediate Family lists "
                          "will cause any partially entered census entry on the main screen to be lost. Are you "
                          "sure you want to make this change to the options?");
}

namespace {

bool confirmed(prompts& p, const QString& question)
{
    return p.yes(question, icon::exclamation, answer::no, QStringLiteral("Save Options"));
}

// Creates the log file when there is none yet; false when it cannot be made.
bool makelogfile(const QString& path)
{
    if (QFileInfo::exists(path))
        return true;
    QFile f(path);
    if (path.isEmpty() || !f.open(QIODevice::WriteOnly | QIODevice::NewOnly))
        return false;
    f.close();
    return true;
}

} // namespace

optionssave saveoptions(prompts& p, settingsstore& store, const settings& current, const settings& form,
                        const optionsopening& opening)
{
    optionssave out;
    const auto stop = [&out](optionsstop why) {
        out.stop = why;
        return out;
    };

    const QString logpath = form.logpath.trimmed();
    if (form.keeplog) {
        // A path typed by hand could name the family file itself.
        if (logpath.endsWith(QLatin1String("ged"), Qt::CaseInsensitive)) {
            p.tell(gedcomlogmessage());
            return stop(optionsstop::logfile);
        }
        // Nor into the backup folder, before the log file is made there.
        if (const QString refused = refuselogpath(logpath, QString(), trimbackupfolder(form.backupfolder));
            !refused.isEmpty()) {
            p.tell(refused, icon::exclamation);
            return stop(optionsstop::logfile);
        }
        if (!makelogfile(logpath)) {
            p.tell(QStringLiteral("Error creating the log file specified, please check the file name and path and "
                                  "that you have access to it and that the disk is not full."));
            return stop(optionsstop::logfile);
        }
    }

    bool reload = false;
    if (form.fullentry != opening.fullentry) {
        if (!confirmed(p, methodchangequestion()))
            return stop(optionsstop::declined);
        reload = true;
    } else if (form.country != opening.country) {
        if (!confirmed(p, countrychangequestion()))
            return stop(optionsstop::declined);
        reload = true;
    }

    if (form.alternateseparator && form.alternateseparatorcharacter.isEmpty())
        return stop(optionsstop::noseparator);

    settings next = current;
    takeoptions(next, form);
    next.logpath = logpath;
    next.sourcetype = form.sourcetype.trimmed();
    // As the store gives them back at the next start.
    next.title = form.title.trimmed().isEmpty() ? defaulttitletemplate() : form.title.trimmed();
    next.alternateseparatorcharacter = form.alternateseparatorcharacter.left(1);

    if (next.idonly != opening.idonly && !reload) {
        if (!confirmed(p, idonlychangequestion()))
            return stop(optionsstop::declined);
        reload = true;
    }

    next.backupfolder = trimbackupfolder(form.backupfolder);

    if (checkpaths(p, next))
        return stop(optionsstop::paths);
    savesettings(store, next);
    next.firststart = false;
    out.values = next;
    out.reloadneeded = reload;
    return out;
}

} // namespace qm

#include "settings/settings.h"

#include "platform/settingsstore.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

#include <array>

namespace qm {

namespace {

enum class form {
    flag,       // exactly one character; on when "1"
    fullentry,  // exactly one character; on unless "0"
    logpath,    // at least one character, trimmed
    country,    // at least one character; one of the four names, else "UK"
    certainty,  // at least one character; 0..3, else not recorded
    anytext,    // any length, kept as stored
    title,      // any length; empty means the default template
    folder,     // at least two characters, trimmed
    separator,  // at most one character
};

struct entry {
    int group;
    const char* name;
    form kind;
    bool settings::*flag = nullptr;
    QString settings::*text = nullptr;
    int settings::*number = nullptr;
};

constexpr entry B(int g, const char* n, bool settings::*m, form k = form::flag)
{
    return entry{g, n, k, m, nullptr, nullptr};
}
constexpr entry T(int g, const char* n, QString settings::*m, form k)
{
    return entry{g, n, k, nullptr, m, nullptr};
}

// In the order the values are read.
constexpr std::array entries{
    B(1, "Full Entry", &settings::fullentry, form::fullentry),
    B(1, "Source in Note", &settings::sourceinnote),
    B(1, "Keep Log", &settings::keeplog),
    T(1, "Log Path", &settings::logpath, form::logpath),
    T(2, "Country", &settings::country, form::country),
    B(2, "Birthdate", &settings::birthdate),
    entry{2, "Certainty", form::certainty, nullptr, nullptr, &settings::certainty},
    B(2, "Residence", &settings::residence),
    T(3, "Source Type", &settings::sourcetype, form::anytext),
    B(4, "Request Image", &settings::requestimage),
    B(5, "ID Only", &settings::idonly),
    B(5, "Auto Reference", &settings::autoreference),
    T(6, "Backup Folder", &settings::backupfolder, form::folder),
    B(7, "Flag Use", &settings::flaguse),
    B(7, "Flag Check", &settings::flagcheck),
    B(7, "Opt1 Entry Date", &settings::opt1entrydate),
    B(7, "Opt1 Where in Source", &settings::opt1whereinsource),
    B(7, "Opt1 Publication Info", &settings::opt1publicationinfo),
    B(7, "Request Images 2", &settings::requestimages2),
    B(7, "Image 2 Event", &settings::image2event),
    B(7, "Entry Date Today", &settings::entrydatetoday),
    B(7, "Occ Place", &settings::occplace),
    B(7, "Occ Age", &settings::occage),
    B(7, "Shared Note", &settings::sharednote),
    T(7, "Title", &settings::title, form::title),
    B(8, "ASID", &settings::asid),
    B(8, "File Open Default", &settings::fileopendefault),
    B(8, "Source Note", &settings::sourcenote),
    B(9, "Occ Scholar", &settings::occscholar),
    B(10, "Birth Secondary Evidence", &settings::birthsecondaryevidence),
    B(11, "Alternate Separator", &settings::alternateseparator),
    T(11, "Alternate Separator Character", &settings::alternateseparatorcharacter, form::separator),
    B(11, "Marriage Condition", &settings::marriagecondition),
    B(11, "No Source Text Warning", &settings::nosourcetextwarning),
};

constexpr int lastgroup = 11;

// The order in which the options dialog's values are written.
constexpr std::array saveorder{
    "Full Entry", "Source in Note", "Country", "Birthdate", "Certainty", "Keep Log", "Log Path",
    "Residence", "Source Type", "Request Image", "Auto Reference", "ID Only", "Opt1 Entry Date",
    "Opt1 Where in Source", "Opt1 Publication Info", "Request Images 2", "Image 2 Event",
    "Entry Date Today", "Occ Place", "Occ Age", "Shared Note", "Title", "Backup Folder", "ASID",
    "File Open Default", "Source Note", "Occ Scholar", "Birth Secondary Evidence",
    "No Source Text Warning", "Marriage Condition", "Alternate Separator",
    "Alternate Separator Character",
};

bool accepted(form kind, const QString& text)
{
    switch (kind) {
    case form::flag:
    case form::fullentry:
        return text.size() == 1;
    case form::logpath:
    case form::country:
    case form::certainty:
        return !text.isEmpty();
    case form::folder:
        return text.size() >= 2;
    case form::separator:
        return text.size() <= 1;
    case form::anytext:
    case form::title:
        return true;
    }
    return false;
}

// A QUAY value is 0 to 3; anything else would write an assessment GEDCOM does
// not know, so it reads as not recorded.
int certaintyof(const QString& text)
{
    bool ok = false;
    const int v = text.trimmed().toInt(&ok);
    return ok && v >= 0 && v <= 3 ? v : -1;
}

void take(settings& s, const entry& e, const QString& text)
{
    switch (e.kind) {
    case form::flag:
        s.*e.flag = text == QLatin1String("1");
        break;
    case form::fullentry:
        s.*e.flag = text != QLatin1String("0");
        break;
    case form::logpath:
    case form::folder:
        s.*e.text = text.trimmed();
        break;
    case form::country:
        for (const char* c : {"UK", "USA", "Ireland", "Canada"})
            if (text == QLatin1String(c)) {
                s.*e.text = text;
                return;
            }
        s.*e.text = QStringLiteral("UK");
        break;
    case form::certainty:
        s.*e.number = certaintyof(text);
        break;
    case form::anytext:
    case form::separator:
        s.*e.text = text;
        break;
    case form::title:
        s.*e.text = text.isEmpty() ? defaulttitletemplate() : text;
        break;
    }
}

void takedefault(settings& s, const entry& e, const settings& d)
{
    if (e.flag)
        s.*e.flag = d.*e.flag;
    else if (e.text)
        s.*e.text = d.*e.text;
    else
        s.*e.number = d.*e.number;
}

QString textof(const settings& s, const entry& e)
{
    if (e.flag)
        return s.*e.flag ? QStringLiteral("1") : QStringLiteral("0");
    if (e.number)
        return QString::number(s.*e.number);
    if (e.kind == form::anytext || e.kind == form::title)
        return (s.*e.text).trimmed();
    return s.*e.text;
}

const entry& entrynamed(const char* name)
{
    for (const entry& e : entries)
        if (qstrcmp(e.name, name) == 0)
            return e;
    Q_UNREACHABLE();
}

} // namespace

QString defaulttitletemplate()
{
    return QStringLiteral("Census {YEAR} {PLACE} {REF} ({OTHER})");
}

QString programfolder()
{
    // Not AppDataLocation itself: that depends on the application name having
    // been set, which the command-line tool and the tests do not do.
    const QString folder =
        QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + QStringLiteral("/Quillmark");
    // The census log and the backups are written here, so it must exist.
    QDir().mkpath(folder);
    return QDir::toNativeSeparators(folder);
}

QString defaultlogpath()
{
    return QDir::toNativeSeparators(QDir::fromNativeSeparators(programfolder()) + QStringLiteral("/censuslog.txt"));
}

QString defaultbackupfolder()
{
    const QString folder = QDir::fromNativeSeparators(programfolder()) + QStringLiteral("/Backups");
    QDir().mkpath(folder);
    return QDir::toNativeSeparators(folder);
}

settings defaultsettings()
{
    settings d;
    d.logpath = defaultlogpath();
    d.backupfolder = defaultbackupfolder();
    d.title = defaulttitletemplate();
    return d;
}

QStringList settingnames()
{
    QStringList names;
    for (const entry& e : entries)
        names << QLatin1String(e.name);
    return names;
}

settingsload loadsettings(settingsstore& store)
{
    const settings d = defaultsettings();
    settingsload out;
    settings& s = out.values;
    s = d;

    int failedgroup = lastgroup + 1; // none
    for (const entry& e : entries) {
        const std::optional<QString> text = store.read(QLatin1String(e.name));
        if (!text || !accepted(e.kind, *text)) {
            failedgroup = e.group;
            break;
        }
        take(s, e, *text);
    }
    for (const entry& e : entries)
        if (e.group >= failedgroup) {
            takedefault(s, e, d);
            out.defaulted << QLatin1String(e.name);
        }
    // "Request Image" defaults to the recording method in use.
    if (failedgroup <= 4)
        s.requestimage = s.fullentry;

    if (const auto count = store.read(QStringLiteral("Count")); count && !count->isEmpty()) {
        bool ok = false;
        const qint64 n = count->trimmed().toLongLong(&ok);
        s.count = ok && n > 0 ? n : 0;
    }
    if (const auto folder = store.read(QStringLiteral("Image Folder"))) {
        const QString f = folder->trimmed();
        s.imagefolder = !f.isEmpty() && QFileInfo(f).isDir() ? f : QString();
    }
    if (const auto option = store.read(QStringLiteral("Image Option"));
        option && option->size() == 1 && option->at(0).isDigit() && option->at(0).unicode() < 128)
        s.imageoption = *option;
    if (const auto rename = store.read(QStringLiteral("Rename File")); rename && rename->size() == 1)
        s.renamefile = *rename == QLatin1String("1");
    if (const auto check = store.read(QStringLiteral("Household Check")); check && check->size() == 1)
        s.householdcheck = *check != QLatin1String("0");

    if (failedgroup <= 7)
        saveflagsettings(store, s);

    s.firststart = failedgroup <= lastgroup;
    out.pathchecksdue = !s.firststart;
    return out;
}

void savesettings(settingsstore& store, const settings& s)
{
    for (const char* name : saveorder) {
        const entry& e = entrynamed(name);
        store.write(QLatin1String(e.name), textof(s, e));
    }
    // Not one of the groups: older versions neither write nor read it.
    store.write(QStringLiteral("Household Check"), s.householdcheck ? QStringLiteral("1") : QStringLiteral("0"));
    store.sync();
}

void saveflagsettings(settingsstore& store, const settings& s)
{
    for (const char* name : {"Flag Use", "Flag Check"})
        store.write(QLatin1String(name), textof(s, entrynamed(name)));
    store.sync();
}

} // namespace qm

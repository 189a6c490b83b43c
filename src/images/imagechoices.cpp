#include "images/imagechoices.h"


#include "log/censuslog.h"
#include "model/gedcomindex.h"
#include "platform/encoding.h"
#include "platform/paths.h"
#include "platform/settingsstore.h"
#include "settings/settings.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include <algorithm>
#include <limits>

namespace qm {

namespace {

// The extension of the file name with its ".", or "".
QString extensionof(const QString& path)
{
    const QString name = filenameof(path);
    const qsizetype dot = name.lastIndexOf(u'.');
    return dot < 0 ? QString() : name.mid(dot);
}

// Paths compared as the user sees them: ignoring letter case, "/" and "\" alike.
bool samepath(const QString& a, const QString& b)
{
    QString x = a, y = b;
    x.replace(u'\\', u'/');
    y.replace(u'\\', u'/');
    return x.compare(y, Qt::CaseInsensitive) == 0;
}

// A record's file as written, and resolved against the family file's folder
// when it is relative (as Family Historian writes files kept beside it).
bool samerecordfile(const QString& recordfile, const QString& path, const gedcomindex& index)
{
    if (samepath(recordfile, path))
        return true;
    QString f = recordfile.trimmed();
    f.replace(u'\\', u'/');
    if (f.isEmpty() || index.gedcomfile.isEmpty() || !QFileInfo(f).isRelative())
        return false;
    return samepath(QDir::cleanPath(QFileInfo(index.gedcomfile).absoluteDir().absoluteFilePath(f)), path);
}

// The first bytes of the picture formats whose files name themselves by
// their extension.
bool startsasimage(const QString& type, const QByteArray& head)
{
    if (type == QLatin1String("bmp"))
        return head.startsWith("BM");
    if (type == QLatin1String("gif"))
        return head.startsWith("GIF87a") || head.startsWith("GIF89a");
    if (type == QLatin1String("jpeg"))
        return head.startsWith("\xFF\xD8\xFF");
    if (type == QLatin1String("png"))
        return head.startsWith("\x89PNG\r\n\x1A\n");
    if (type == QLatin1String("tif") || type == QLatin1String("tiff"))
        return head.startsWith(QByteArrayLiteral("II*\0")) || head.startsWith(QByteArrayLiteral("MM\0*"));
    return true; // no signature to look for: the preview says it cannot show it
}

} // namespace

QString previewfailedtext()
{
    return QStringLiteral("A problem occurred when trying to preview this file.");
}

QString imagefileproblem(const QString& path)
{
    QFile f(path);
    if (!QFileInfo(path).isFile() || !f.open(QIODevice::ReadOnly))
        return previewfailedtext() + QStringLiteral(" (") + (f.error() ? f.errorString() : QStringLiteral("not a file"))
            + QStringLiteral(")");
    const QByteArray head = f.read(16);
    if (head.isEmpty())
        return previewfailedtext() + QStringLiteral(" (the file is empty)");
    if (!startsasimage(imagefiletype(path), head))
        return previewfailedtext() + QStringLiteral(" (the file does not hold a picture of its type)");
    return QString();
}

QString cleanfilename(QString text)
{
    for (const char16_t c : {u':', u'\\', u'/', u'?', u'*', u'<', u'>', u'|', u'\'', u'"'})
        text.replace(QChar(c), u'_');
    return text;
}

QString imagefiletype(const QString& path)
{
    const QString ext = extensionof(path).toLower();
    if (ext == QLatin1String(".jpg"))
        return QStringLiteral("jpeg");
    return ext.mid(1).trimmed();
}

QString titlefromfilename(const QString& path)
{
    const QString name = filenameof(path);
    const qsizetype dot = name.lastIndexOf(u'.');
    return dot <= 0 ? name : name.left(dot);
}

int nexttitlenumber(const std::vector<imagechoice>& chosen, const QString& base)
{
    int highest = 0;
    for (const imagechoice& c : chosen)
        if (c.isnew && c.title == base)
            highest = std::max(highest, c.titlenumber);
    return highest + 1;
}

QString fulltitle(const QString& title, int number)
{
    return number >= 2 ? title + u' ' + QString::number(number) : title;
}

QString fulltitle(const imagechoice& image)
{
    return fulltitle(image.title, image.titlenumber);
}

QString refusenewimage(const QString& path, const std::vector<imagechoice>& chosen, const gedcomindex& index)
{
    const QString last = path.right(4).toLower();
    if (last == QLatin1String(".exe"))
        return QStringLiteral("You have selected an application program rather than an image file.");
    if (last == QLatin1String(".ged"))
        return QStringLiteral("You have selected a GEDCOM family history file rather than an image file.");
    for (const imagechoice& c : chosen)
        if (samepath(c.file, path))
            return QStringLiteral("This image has already been selected to be part of this census entry");
    for (const objectrec& o : index.objects)
        if (samerecordfile(qs(o.file), path, index))
            return QStringLiteral("This image is already loaded into Family Historian and has the title ")
                + qs(o.title) + QStringLiteral(". Go back to the previous screen and select the 'Link current image' button");
    return QString();
}

QString refuseexistingimage(int32_t objectid, const std::vector<imagechoice>& chosen)
{
    for (const imagechoice& c : chosen)
        if (c.objectid == objectid)
            return QStringLiteral("This image has already been selected to be linked to the new census source being "
                                  "created and therefore can not be selected again.");
    return QString();
}

int32_t firstobjectbase(const gedcomindex& index)
{
    // The loader and recordattached() keep it at the highest O number.
    return index.maxobjectid;
}

const imagechoice& addnewimage(std::vector<imagechoice>& chosen, int32_t& nextobjectid, const QString& file,
                               const QString& title, int titlenumber, const QString& date)
{
    imagechoice c;
    // No number left: 0, which the save refuses.
    c.objectid = nextobjectid < std::numeric_limits<int32_t>::max() ? ++nextobjectid : 0;
    c.date = date;
    c.file = file;
    c.form = imagefiletype(file);
    c.isnew = true;
    c.title = title;
    c.titlenumber = titlenumber;
    chosen.push_back(std::move(c));
    return chosen.back();
}

const imagechoice& addexistingimage(std::vector<imagechoice>& chosen, const objectrec& object)
{
    imagechoice c;
    c.objectid = object.id;
    c.form = qs(object.form);
    c.title = qs(object.title);
    c.file = qs(object.file);
    c.date = qs(object.date);
    c.xref = qs(object.xref);
    c.isnew = false;
    c.titlenumber = 0;
    chosen.push_back(std::move(c));
    return chosen.back();
}

QString imagerow(int position, const imagechoice& image)
{
    return (QString::number(position) + QStringLiteral(": ") + fulltitle(image)).trimmed();
}

QString pathrow(const QString& file)
{
    return QStringLiteral("...") + file.right(80);
}

bool mentionscensus(const objectrec& object)
{
    return qs(object.title).toUpper().contains(QLatin1String("CENSUS"))
        || qs(object.file).toUpper().contains(QLatin1String("CENSUS"));
}

imagedialogvalues readimagevalues(const settingsstore& store, const settings& s)
{
    imagedialogvalues v;
    v.folder = store.read(QStringLiteral("Image Folder")).value_or(s.imagefolder).trimmed();
    if (!v.folder.isEmpty() && !QFileInfo(v.folder).isDir())
        v.folder.clear();
    const QString option = store.read(QStringLiteral("Image Option")).value_or(s.imageoption);
    v.option = option.size() == 1 && option[0] >= u'0' && option[0] <= u'3' ? option[0].unicode() - u'0' : 0;
    const std::optional<QString> rename = store.read(QStringLiteral("Rename File"));
    v.rename = rename && rename->size() == 1 ? *rename == QLatin1String("1") : s.renamefile;
    return v;
}

void saveimagefolder(settingsstore& store, const QString& chosenfile)
{
    store.write(QStringLiteral("Image Folder"), QDir::toNativeSeparators(folderof(chosenfile)));
    store.sync();
}

void saveimagechoice(settingsstore& store, int option, bool rename)
{
    store.write(QStringLiteral("Image Option"), QString::number(option >= 0 && option <= 3 ? option : 0));
    store.write(QStringLiteral("Rename File"), rename ? QStringLiteral("1") : QStringLiteral("0"));
    store.sync();
}

QString renamedpath(const QString& path, const QString& title)
{
    return (folderof(path) + cleanfilename(title).trimmed() + extensionof(path)).trimmed();
}

renameresult renametotitle(const QString& path, const QString& title, const settings& s)
{
    renameresult r;
    r.path = path;
    const QString to = renamedpath(path, title);
    if (to.compare(path, Qt::CaseInsensitive) == 0)
        return r;
    if (QFileInfo::exists(to)) {
        r.message = QStringLiteral("A file with the name '") + to
            + QStringLiteral("' already exists and therefore this file can not be renamed to match the current title. "
                             "Change the title or deselect the rename option and try again.");
        return r;
    }
    QFile f(path);
    if (!f.rename(to)) {
        r.message = QStringLiteral("An error (") + f.errorString()
            + QStringLiteral(") occurred when attempting to rename the file. Check that the file is not currently being "
                             "edited in another application and that you have permission to rename the file or "
                             "deselect the rename option and try again.");
        return r;
    }
    r.path = to;
    r.renamed = true;
    if (s.keeplog)
        r.logerror = writerenameentry(s, path, to);
    return r;
}

} // namespace qm

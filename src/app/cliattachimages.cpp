// quillmark-cli attach-images: links new image files and multimedia records
// already in the family file to an existing source, with the checks of the
// Census Images dialog and through the same save road as Attach Images to
// Existing Sources.
#include "app/cli.h"

#include "images/imagechoices.h"
#include "images/sourcedates.h"
#include "model/loadgedcom.h"
#include "writer/saveroad.h"

#include <QDir>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonObject>

#include <algorithm>

namespace qm {

namespace {

// "12", "S12" or "@S12@" (letter given by `kind`); 0 when none of these.
int32_t recordnumber(QString text, QChar kind)
{
    text = text.trimmed();
    if (text.startsWith(u'@') && text.endsWith(u'@') && text.size() > 2)
        text = text.mid(1, text.size() - 2);
    if (text.startsWith(kind, Qt::CaseInsensitive))
        text.remove(0, 1);
    bool ok = false;
    const int n = text.toInt(&ok);
    return ok && n > 0 && !text.startsWith(u'+') ? n : 0;
}

// One image asked for, in the order given.
struct wanted {
    bool isnew = false;
    QString path, title; // new image file, and its own title ("" = derived from the source)
    int32_t objectid = 0;
};

} // namespace

int cliattachimages(QStringList args)
{
    QString inipath, error, sourcetext;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    std::vector<wanted> asked;
    for (qsizetype i = 0; i < args.size();) {
        QString value;
        if (takeoptionvalue(args, i, QStringLiteral("--source"), value, error)) {
            sourcetext = value;
        } else if (takeoptionvalue(args, i, QStringLiteral("--image"), value, error)) {
            wanted w;
            w.isnew = true;
            w.path = value;
            // PATH=TITLE, unless the whole text names a file.
            const qsizetype eq = value.indexOf(u'=');
            if (eq > 0 && !QFileInfo::exists(value)) {
                w.path = value.left(eq);
                w.title = value.mid(eq + 1).trimmed();
            }
            asked.push_back(w);
        } else if (takeoptionvalue(args, i, QStringLiteral("--object"), value, error)) {
            wanted w;
            w.objectid = recordnumber(value, u'O');
            if (w.objectid == 0)
                return clifail(QStringLiteral("--object needs a multimedia record number such as 7 or O7, not %1").arg(value));
            asked.push_back(w);
        } else {
            ++i;
        }
        if (!error.isEmpty())
            return clifail(error);
    }
    if (!endargs(args, operands, error))
        return clifail(error);
    const QString usage = QStringLiteral("attach-images needs a family file, a source and at least one image: "
                                         "quillmark-cli attach-images FILE --source S_NUMBER --image PATH[=TITLE]... "
                                         "--object O_NUMBER...");
    if (args.size() != 1 || sourcetext.isEmpty() || asked.empty())
        return clifail(usage);
    const int32_t sourceid = recordnumber(sourcetext, u'S');
    if (sourceid == 0)
        return clifail(QStringLiteral("--source needs a source record number such as 12 or S12, not %1").arg(sourcetext));
    const QString path = args.front();
    const auto f = openfamily(args, usage, inipath);
    if (!f)
        return clifailure;
    gedcomindex& ix = *f->file.index();

    int32_t sourcepos = -1;
    for (size_t i = 0; i < ix.sources.size() && sourcepos < 0; ++i)
        if (ix.sources[i].id == sourceid)
            sourcepos = static_cast<int32_t>(i);
    if (sourcepos < 0)
        return clifail(QStringLiteral("there is no source @S%1@ in %2").arg(sourceid).arg(QDir::toNativeSeparators(path)));
    // New images are dated with the source's census date, as in the dialog.
    error = findcensusdates(ix);
    if (!error.isEmpty())
        return clifail(error);
    const sourcerec& source = ix.sources[static_cast<size_t>(sourcepos)];
    const QString title = qs(source.title);
    const QString date = sourcedatetext(source);

    std::vector<imagechoice> chosen;
    int32_t nextobjectid = firstobjectbase(ix);
    for (const wanted& w : asked) {
        if (!w.isnew) {
            const auto it = std::find_if(ix.objects.begin(), ix.objects.end(),
                                         [&w](const objectrec& o) { return o.id == w.objectid; });
            if (it == ix.objects.end())
                return clifail(QStringLiteral("there is no multimedia record @O%1@ in %2")
                                   .arg(w.objectid)
                                   .arg(QDir::toNativeSeparators(path)));
            if (std::find(source.objectids.begin(), source.objectids.end(), w.objectid) != source.objectids.end())
                return clifail(QStringLiteral("@O%1@ is already attached to the source @S%2@").arg(w.objectid).arg(sourceid));
            error = refuseexistingimage(w.objectid, chosen);
            if (!error.isEmpty())
                return clifail(QStringLiteral("@O%1@: %2").arg(w.objectid).arg(error));
            addexistingimage(chosen, *it);
            continue;
        }
        const QFileInfo image(w.path);
        if (!image.isFile())
            return clifail(QStringLiteral("%1: no such image file").arg(QDir::toNativeSeparators(w.path)));
        const QString file = QDir::toNativeSeparators(image.absoluteFilePath());
        error = refusenewimage(file, chosen, ix);
        if (error.isEmpty())
            error = imagefileproblem(file);
        if (!error.isEmpty())
            return clifail(QStringLiteral("%1: %2").arg(file, error));
        // Without a title of its own an image takes the source's, numbered
        // after the images of that title already chosen.
        const QString base = w.title.isEmpty() ? title.trimmed() : w.title;
        const int number = w.title.isEmpty() ? nexttitlenumber(chosen, base) : 1;
        addnewimage(chosen, nextobjectid, file, base, number, date);
    }

    rewriterequest rq;
    rq.mode = rewritemode::attachimages;
    rq.entry.sourceid = QString::number(sourceid);
    rq.entry.title = title;
    rq.entry.chosenimages = chosen;
    const saveoutcome out = f->file.save(rq);
    if (!clisaved(out))
        return clifailure;

    QJsonArray objects, added;
    for (const imagechoice& c : chosen)
        (c.isnew ? added : objects).append(c.objectid);
    QJsonObject result;
    result.insert(QStringLiteral("backup"), QDir::toNativeSeparators(out.backuppath));
    result.insert(QStringLiteral("source"), sourceid);
    result.insert(QStringLiteral("new_objects"), added);
    result.insert(QStringLiteral("linked_objects"), objects);
    result.insert(QStringLiteral("log"), out.logwritten);
    printjson(result);
    f->file.abandonindex();
    return 0;
}

} // namespace qm

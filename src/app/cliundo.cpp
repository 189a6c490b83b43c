// quillmark-cli undo: puts a family file back as it was before the last change
// any Quillmark command or window made to it, when the file has not changed
// since, through the same safe road as a save.
#include "app/cli.h"

#include "writer/undolast.h"

#include <QDir>
#include <QJsonObject>

namespace qm {

int cliundo(QStringList args)
{
    QString inipath, error;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    if (!endargs(args, operands, error))
        return clifail(error);
    if (args.size() != 1)
        return clifail(QStringLiteral("undo needs one family file: quillmark-cli undo FILE [--settings S.ini]"));
    const QString path = args.front();
    error = checkfamilypath(path);
    if (!error.isEmpty())
        return clifail(error);
    const auto cs = opensettings(inipath, &error);
    if (!cs)
        return clifail(error);

    const undooutcome out = undolast(path, cs->values());
    if (!out.undone())
        return clifail(out.message);
    for (const QString& warning : {out.logerror, out.noteerror})
        if (!warning.isEmpty())
            cliwarn(warning);
    QJsonObject result;
    result.insert(QStringLiteral("undone"), out.summary);
    result.insert(QStringLiteral("restored_from"), QDir::toNativeSeparators(out.restoredfrom));
    result.insert(QStringLiteral("backup"), QDir::toNativeSeparators(out.backuppath));
    result.insert(QStringLiteral("log"), out.logwritten);
    printjson(result);
    return 0;
}

} // namespace qm

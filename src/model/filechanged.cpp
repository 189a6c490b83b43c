#include "model/filechanged.h"

#include "model/gedcomindex.h"

#include <QDir>

namespace qm {

bool filechanged(const QString& path, const filestamp& noted)
{
    return !(stampof(path) == noted);
}

bool filechanged(const gedcomindex& index)
{
    return filechanged(index.gedcomfile, index.gedcomdate);
}

QString changedmessage(const QString& path)
{
    return QDir::toNativeSeparators(path) + QStringLiteral(" has been modified by another application and will be reloaded.");
}

QString filegonequestion(const QString& path)
{
    return QDir::toNativeSeparators(path)
        + QStringLiteral(" can no longer be found: it has been deleted, renamed or moved by another application. "
                         "Do you want to open another family history file?");
}

QString changedonsavemessage(const QString& path, bool imageschosen)
{
    if (!imageschosen)
        return changedmessage(path);
    return changedmessage(path)
        + QStringLiteral(" As a precaution against data corruption any images you have chosen will need to be reselected when you click 'Save Changes' again. Please wait for the details to be reloaded...");
}

} // namespace qm

#include "platform/opencheck.h"

#include <QDir>
#include <QFileInfo>
#include <QSet>

namespace qm {

namespace {

const QSet<QString>& runnable()
{
    static const QSet<QString> set = [] {
        QSet<QString> s;
        // Windows programs, scripts, installers, shortcuts and control files.
        for (const char* e : {"exe", "com", "bat", "cmd", "msi", "msp", "mst", "scr", "pif", "lnk", "url", "cpl",
                              "hta", "vb", "vbs", "vbe", "js", "jse", "wsf", "wsh", "ws", "wsc", "ps1", "ps1xml",
                              "ps2", "psc1", "psm1", "psd1", "msc", "msh", "reg", "inf", "scf", "gadget", "dll", "sys",
                              "ocx", "application", "appref-ms", "settingcontent-ms", "library-ms", "search-ms",
                              "xbap", "xll", "chm", "hlp", "jnlp", "iso", "img", "vhd", "vhdx",
                              // Windows: Office macros and databases, installers, packages and other
                              // types Windows itself treats as unsafe to open from a mail
                              "ade", "adp", "mad", "maf", "mag", "mam", "maq", "mar", "mas", "mat", "mau", "mav",
                              "maw", "mda", "mdb", "mde", "mdt", "mdw", "mdz", "appx", "appxbundle", "msix",
                              "msixbundle", "msu", "cab", "diagcab", "appcontent-ms", "searchconnector-ms", "bas",
                              "grp", "hpj", "htc", "ins", "isp", "its", "mcf", "msh1", "msh2", "mshxml", "msh1xml",
                              "msh2xml", "ops", "osd", "plg", "prf", "prg", "printerexport", "ps2xml", "psc2",
                              "psdm1", "sct", "shb", "shs", "theme", "udl", "vbp", "vsmacros", "vsw", "webpnp",
                              "website", "wsb", "xnk", "cer", "crt", "der",
                              // Unix and macOS
                              "sh", "bash", "zsh", "csh", "tcsh", "ksh", "fish", "command", "tool", "desktop", "app",
                              "action", "workflow", "scpt", "applescript", "pkg", "mpkg", "dmg", "so", "dylib", "run",
                              "bin", "appimage", "deb", "rpm", "snap", "flatpakref", "apk", "out", "elf",
                              // interpreters found on every system
                              "jar", "class", "py", "pyw", "pyc", "pyz", "pl", "pm", "rb", "php", "lua", "tcl", "r",
                              "awk", "cgi"})
            s.insert(QString::fromLatin1(e));
        return s;
    }();
    return set;
}

} // namespace

bool runnablename(const QString& name)
{
    // "name:stream" and "name::$DATA" name a stream of an NTFS file, and
    // Windows opens "tool.exe::$DATA" as tool.exe: every part counts.
    for (QString n : name.split(u':')) {
        while (!n.isEmpty() && (n.back() == u'.' || n.back() == u' '))
            n.chop(1);
        const qsizetype dot = n.lastIndexOf(u'.');
        if (dot >= 0 && runnable().contains(n.mid(dot + 1).toLower()))
            return true;
    }
    return false;
}

QString refuseopen(const QString& path)
{
    if (path.trimmed().isEmpty())
        return QStringLiteral("No file was named.");
    const QFileInfo info(path);
    // The name given and, for a link, the name of what it points to.
    if (runnablename(info.fileName()) || (info.isSymLink() && runnablename(QFileInfo(info.canonicalFilePath()).fileName())))
        return QStringLiteral("Quillmark does not open programs, scripts or shortcuts (") + QDir::toNativeSeparators(path)
            + QStringLiteral("): only image and document files can be opened in their default viewer.");
    if (!info.exists())
        return QStringLiteral("The specified file was not found.");
    if (!info.isFile())
        return QStringLiteral("The specified path is not a file (") + QDir::toNativeSeparators(path)
            + QStringLiteral(").");
#ifndef Q_OS_WIN
    if (info.isExecutable())
        return QStringLiteral("Quillmark does not open files marked as programs (") + QDir::toNativeSeparators(path)
            + QStringLiteral("): only image and document files can be opened in their default viewer.");
#endif
    return QString();
}

} // namespace qm

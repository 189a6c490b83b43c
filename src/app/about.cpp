#include "app/about.h"

#include <QFileInfo>
#include <QSettings>
#include <QStandardPaths>

namespace qm {

QString versionnumber()
{
    return QStringLiteral("%1.%2.%3").arg(QM_VERSION_MAJOR).arg(QM_VERSION_MINOR).arg(QM_VERSION_PATCH);
}

QString systeminfounavailable()
{
    return QStringLiteral("System Information Is Unavailable At This Time");
}

systemlookup systemlookup::here()
{
    systemlookup l;
#if defined(Q_OS_WIN)
    l.os = osfamily::windows;
#elif defined(Q_OS_MACOS)
    l.os = osfamily::macos;
#endif
    l.machinevalue = [](const QString& key, const QString& name) -> std::optional<QString> {
#if defined(Q_OS_WIN)
        const QSettings registry(QStringLiteral("HKEY_LOCAL_MACHINE\\") + key, QSettings::NativeFormat);
        const QVariant v = registry.value(name);
        if (v.isValid())
            return v.toString();
#else
        Q_UNUSED(key)
        Q_UNUSED(name)
#endif
        return std::nullopt;
    };
    l.exists = [](const QString& path) { return QFileInfo::exists(path); };
    l.findprogram = [](const QString& name) { return QStandardPaths::findExecutable(name); };
    return l;
}

std::optional<systemtool> findsysteminfo(const systemlookup& machine)
{
    const auto onpath = [&](const QString& name) -> std::optional<systemtool> {
        if (!machine.findprogram)
            return std::nullopt;
        const QString found = machine.findprogram(name);
        if (found.isEmpty())
            return std::nullopt;
        return systemtool{found, {}};
    };
    const auto value = [&](const char* key, const char* name) -> QString {
        if (!machine.machinevalue)
            return QString();
        return machine.machinevalue(QString::fromLatin1(key), QString::fromLatin1(name)).value_or(QString()).trimmed();
    };

    switch (machine.os) {
    case osfamily::windows: {
        if (const QString path = value("SOFTWARE\\Microsoft\\Shared Tools\\MSINFO", "PATH"); !path.isEmpty())
            return systemtool{path, {}};
        if (const QString folder = value("SOFTWARE\\Microsoft\\Shared Tools Location", "MSINFO"); !folder.isEmpty()) {
            const QString program = folder + QStringLiteral("\\MSINFO32.EXE");
            if (machine.exists && machine.exists(program))
                return systemtool{program, {}};
        }
        return onpath(QStringLiteral("msinfo32"));
    }
    case osfamily::macos:
        for (const char* app : {"/System/Applications/Utilities/System Information.app",
                                "/Applications/Utilities/System Information.app"}) {
            const QString path = QString::fromLatin1(app);
            if (machine.exists && machine.exists(path))
                return systemtool{QStringLiteral("open"), {path}};
        }
        return std::nullopt;
    case osfamily::other:
        for (const char* name : {"hardinfo2", "hardinfo", "kinfocenter", "gnome-system-monitor"})
            if (auto tool = onpath(QString::fromLatin1(name)))
                return tool;
        return std::nullopt;
    }
    return std::nullopt;
}

} // namespace qm

#pragma once
// The About box's facts that need no window: the version and where the
// platform's system information tool is.

#include <QString>
#include <QStringList>

#include <functional>
#include <optional>

namespace qm {

// "major.minor.revision" of this build, e.g. "1.0.0".
QString versionnumber();

enum class osfamily { windows, macos, other };

// What the lookup of the system information tool may ask of the machine; tests
// hand in their own answers.
struct systemlookup {
    osfamily os = osfamily::other;
    // A string value under HKEY_LOCAL_MACHINE (key, value name); nothing when absent.
    std::function<std::optional<QString>(const QString& key, const QString& name)> machinevalue;
    std::function<bool(const QString& path)> exists;
    // The full path of a program found on PATH, or "".
    std::function<QString(const QString& name)> findprogram;

    // The machine this program runs on.
    static systemlookup here();
};

struct systemtool {
    QString program;
    QStringList arguments;
};

// The system information tool to start, or nothing when there is none:
// - Windows: the "PATH" value of SOFTWARE\Microsoft\Shared Tools\MSINFO; else
//   the folder in the "MSINFO" value of SOFTWARE\Microsoft\Shared Tools Location
//   when MSINFO32.EXE exists there; else msinfo32 found on PATH.
// - macOS: System Information.app, opened with "open".
// - Linux and others: the first of hardinfo2, hardinfo, kinfocenter and
//   gnome-system-monitor found on PATH.
std::optional<systemtool> findsysteminfo(const systemlookup& machine);

// The message shown when there is no tool or it does not start.
QString systeminfounavailable();

} // namespace qm

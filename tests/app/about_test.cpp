// Finding the platform's system information tool, with the machine's answers
// handed in.
#include "app/about.h"

#include <QMap>

#include <gtest/gtest.h>

using namespace qm;

namespace {

struct machine {
    QMap<QString, QString> registry; // "key|name" -> value
    QStringList files;
    QMap<QString, QString> path;     // program name -> full path

    systemlookup lookup(osfamily os) const
    {
        systemlookup l;
        l.os = os;
        l.machinevalue = [this](const QString& key, const QString& name) -> std::optional<QString> {
            const auto it = registry.find(key + QLatin1Char('|') + name);
            return it == registry.end() ? std::nullopt : std::optional<QString>(*it);
        };
        l.exists = [this](const QString& p) { return files.contains(p); };
        l.findprogram = [this](const QString& name) { return path.value(name); };
        return l;
    }
};

const QString msinfokey = QStringLiteral("SOFTWARE\\Microsoft\\Shared Tools\\MSINFO|PATH");
const QString locationkey = QStringLiteral("SOFTWARE\\Microsoft\\Shared Tools Location|MSINFO");

} // namespace

TEST(SystemInfo, WindowsReadsTheRegistryInOrder)
{
    machine m;
    m.registry[msinfokey] = QStringLiteral("C:\\Tools\\msinfo32.exe");
    m.registry[locationkey] = QStringLiteral("C:\\Shared\\MSINFO");
    m.files << QStringLiteral("C:\\Shared\\MSINFO\\MSINFO32.EXE");
    auto tool = findsysteminfo(m.lookup(osfamily::windows));
    ASSERT_TRUE(tool);
    EXPECT_EQ(tool->program, QStringLiteral("C:\\Tools\\msinfo32.exe"));

    m.registry.remove(msinfokey);
    EXPECT_EQ(findsysteminfo(m.lookup(osfamily::windows)).value().program, QStringLiteral("C:\\Shared\\MSINFO\\MSINFO32.EXE"));

    // The folder named but the program missing there: msinfo32 on PATH, else none.
    m.files.clear();
    EXPECT_FALSE(findsysteminfo(m.lookup(osfamily::windows)));
    m.path[QStringLiteral("msinfo32")] = QStringLiteral("C:\\Windows\\System32\\msinfo32.exe");
    EXPECT_EQ(findsysteminfo(m.lookup(osfamily::windows)).value().program, QStringLiteral("C:\\Windows\\System32\\msinfo32.exe"));
}

TEST(SystemInfo, LinuxTakesTheFirstKnownToolOnPath)
{
    machine m;
    EXPECT_FALSE(findsysteminfo(m.lookup(osfamily::other)));
    m.path[QStringLiteral("gnome-system-monitor")] = QStringLiteral("/usr/bin/gnome-system-monitor");
    m.path[QStringLiteral("hardinfo")] = QStringLiteral("/usr/bin/hardinfo");
    auto tool = findsysteminfo(m.lookup(osfamily::other));
    ASSERT_TRUE(tool);
    EXPECT_EQ(tool->program, QStringLiteral("/usr/bin/hardinfo"));
    EXPECT_TRUE(tool->arguments.isEmpty());
    // The registry means nothing here.
    m.path.clear();
    m.registry[msinfokey] = QStringLiteral("C:\\Tools\\msinfo32.exe");
    EXPECT_FALSE(findsysteminfo(m.lookup(osfamily::other)));
}

TEST(SystemInfo, MacOpensSystemInformation)
{
    machine m;
    EXPECT_FALSE(findsysteminfo(m.lookup(osfamily::macos)));
    m.files << QStringLiteral("/Applications/Utilities/System Information.app");
    const auto tool = findsysteminfo(m.lookup(osfamily::macos));
    ASSERT_TRUE(tool);
    EXPECT_EQ(tool->program, QStringLiteral("open"));
    EXPECT_EQ(tool->arguments, QStringList{QStringLiteral("/Applications/Utilities/System Information.app")});
}

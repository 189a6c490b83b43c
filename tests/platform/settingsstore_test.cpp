// The user's own settings store on Windows: the registry key
// HKEY_CURRENT_USER\Software\Quillmark itself, with string values, as read
// back by the system's own reg tool. (Elsewhere it is a per-user file that the
// tests leave alone; every other test uses a store on a temporary file.)
#include "platform/settingsstore.h"

#include <gtest/gtest.h>

#ifdef Q_OS_WIN

#include <QProcess>

using namespace qm;

namespace {

// What `reg query KEY /v NAME` prints, "" when the value is not there.
QString regquery(const QString& key, const QString& name)
{
    QProcess reg;
    reg.start(QStringLiteral("reg"), {QStringLiteral("query"), key, QStringLiteral("/v"), name});
    if (!reg.waitForFinished(60000) || reg.exitCode() != 0)
        return QString();
    return QString::fromLocal8Bit(reg.readAllStandardOutput());
}

void regdelete(const QString& key, const QStringList& what)
{
    QProcess reg;
    reg.start(QStringLiteral("reg"), QStringList{QStringLiteral("delete"), key} + what + QStringList{QStringLiteral("/f")});
    reg.waitForFinished(60000);
}

} // namespace

TEST(NativeSettingsStore, IsTheKeySoftwareQuillmarkItselfWithStringValues)
{
    const QString key = QStringLiteral("HKCU\\Software\\Quillmark");
    const QString probe = QStringLiteral("Quillmark Test Probe");
    {
        auto store = settingsstore::native();
        EXPECT_EQ(store->location(), QStringLiteral("\\HKEY_CURRENT_USER\\Software\\Quillmark"));
        store->write(probe, QStringLiteral("Hebden Bridge"));
        store->write(probe, QStringLiteral("Name"), QStringLiteral("1881 Census"));
    }
    const QString value = regquery(key, probe);
    const QString grouped = regquery(key + QLatin1Char('\\') + probe, QStringLiteral("Name"));
    const QString onelevel = regquery(key + QStringLiteral("\\OrganizationDefaults"), probe);
    regdelete(key, {QStringLiteral("/v"), probe});
    regdelete(key + QLatin1Char('\\') + probe, {});

    EXPECT_TRUE(value.contains(QLatin1String("REG_SZ"))) << value.toStdString();
    EXPECT_TRUE(value.contains(QLatin1String("Hebden Bridge"))) << value.toStdString();
    // Groups such as Flags/1 are subkeys of the same key.
    EXPECT_TRUE(grouped.contains(QLatin1String("1881 Census"))) << grouped.toStdString();
    EXPECT_EQ(onelevel, QString()) << "nothing under OrganizationDefaults";
    EXPECT_EQ(settingsstore::native()->read(probe), std::nullopt) << "the probe is gone";
}

#endif

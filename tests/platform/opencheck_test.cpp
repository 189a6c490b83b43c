#include "platform/opencheck.h"

#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

class OpenCheck : public ::testing::Test {
protected:
    void SetUp() override { ASSERT_TRUE(dir.isValid()); }

    QString make(const QString& name, QFileDevice::Permissions extra = {})
    {
        const QString path = dir.filePath(name);
        qmtest::writefile(path, "data");
        QFile(path).setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner | extra);
        return path;
    }

    QTemporaryDir dir;
};

TEST_F(OpenCheck, ImagesAndDocumentsMayBeOpened)
{
    for (const char* name : {"page.png", "page.TIF", "page.pcx", "scan.jpeg", "no extension", "notes.txt"})
        EXPECT_EQ(refuseopen(make(QString::fromLatin1(name))), QString()) << name;
}

TEST_F(OpenCheck, ProgramsScriptsAndShortcutsAreRefusedByTypeEvenWhenAbsent)
{
    for (const char* name : {"run.exe", "RUN.EXE", "x.com", "x.bat", "x.cmd", "x.msi", "x.scr", "x.pif", "x.lnk",
                             "x.vbs", "x.js", "x.jse", "x.wsf", "x.ps1", "x.sh", "x.desktop", "x.app", "x.jar",
                             "x.py", "x.pl", "census.png.exe", "trick.exe.", "trick.bat .", "x.url"}) {
        const QString present = make(QString::fromLatin1(name));
        EXPECT_NE(refuseopen(present), QString()) << name;
        EXPECT_TRUE(refuseopen(present).contains(QLatin1String("does not open programs"))) << name;
        EXPECT_NE(refuseopen(dir.filePath(QStringLiteral("absent-") + QString::fromLatin1(name))), QString()) << name;
    }
    EXPECT_FALSE(runnablename(QStringLiteral("exe")));
    EXPECT_FALSE(runnablename(QStringLiteral("photo.exe.png")));
    // More that Windows runs or installs; names of NTFS streams, which the
    // file system cannot hold as files, checked by name only.
    for (const char* name : {"x.msu", "x.appx", "x.msix", "x.sct", "x.shs", "x.mde", "x.diagcab", "x.theme",
                             "tool.exe::$DATA", "tool.EXE:", "photo.jpg:hidden.exe", "photo.jpg:x.ps1:$DATA"}) {
        EXPECT_TRUE(runnablename(QString::fromLatin1(name))) << name;
        EXPECT_NE(refuseopen(dir.filePath(QString::fromLatin1(name))), QString()) << name;
    }
    EXPECT_FALSE(runnablename(QStringLiteral("C:\\scans:1881.png")));
}

TEST_F(OpenCheck, OnlyExistingRegularFiles)
{
    EXPECT_EQ(refuseopen(dir.filePath(QStringLiteral("missing.png"))), QStringLiteral("The specified file was not found."));
    EXPECT_NE(refuseopen(QString()), QString());
    EXPECT_NE(refuseopen(QStringLiteral("  ")), QString());
    ASSERT_TRUE(QDir(dir.path()).mkdir(QStringLiteral("folder.png")));
    EXPECT_TRUE(refuseopen(dir.filePath(QStringLiteral("folder.png"))).contains(QLatin1String("not a file")));
}

#ifndef Q_OS_WIN
TEST_F(OpenCheck, ExecutablePermissionOrALinkToAProgramIsRefused)
{
    const QString marked = make(QStringLiteral("page.png"), QFileDevice::ExeOwner);
    EXPECT_TRUE(refuseopen(marked).contains(QLatin1String("marked as programs")));

    const QString program = make(QStringLiteral("tool.sh"));
    const QString link = dir.filePath(QStringLiteral("innocent.png"));
    ASSERT_TRUE(QFile::link(program, link));
    EXPECT_NE(refuseopen(link), QString());
}
#endif

} // namespace

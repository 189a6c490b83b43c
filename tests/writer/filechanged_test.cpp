#include "model/filechanged.h"

#include "support/testfiles.h"

#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

TEST(FileChanged, TimeOrSizeOrAbsence)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("f.ged"));
    qmtest::writefile(path, "0 HEAD\r\n");
    const int64_t t = 1'600'000'000'000;
    setmodified(path, t);
    const filestamp noted = stampof(path);
    EXPECT_FALSE(filechanged(path, noted));

    setmodified(path, t + 2000);
    EXPECT_TRUE(filechanged(path, noted));

    // Same time, other size: an editor that restores the time is still caught.
    qmtest::writefile(path, "0 HEAD\r\n0 TRLR\r\n");
    setmodified(path, t);
    EXPECT_TRUE(filechanged(path, noted));

    QFile::remove(path);
    EXPECT_TRUE(filechanged(path, noted));
}

TEST(FileChanged, MessageOfAChangeFoundOnReturn)
{
    EXPECT_TRUE(changedonsavemessage(QStringLiteral("f.ged"), true)
                    .endsWith(QStringLiteral("when you click 'Save Changes' again. Please wait for the details to be reloaded...")));
}

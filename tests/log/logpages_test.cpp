#include "log/clearlog.h"
#include "log/logpages.h"

#include "platform/scriptedprompts.h"
#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;
using namespace qmtest;

namespace {

// Lines of 98 characters and CR LF: 100 characters each on a page.
std::string lines(int count, char fill = 'x')
{
    std::string out;
    for (int i = 0; i < count; ++i)
        out += std::string(98, fill) + "\r\n";
    return out;
}

class LogPages : public ::testing::Test {
protected:
    QTemporaryDir dir;
    QString log = dir.filePath(QStringLiteral("censuslog.txt"));
};

} // namespace

// 650 lines make 65,000 characters: one line more reaches 65,001 and ends
// the page; a page under 65,001 characters takes the next line too, however
// long.
TEST_F(LogPages, APageEndsAtTheLineReaching65001)
{
    const struct {
        std::string text;
        qsizetype firstpage;
        const char* next; // null: one page
    } cases[] = {
        {lines(650) + "y\r\n", 65003, nullptr},
        {lines(650) + "y\r\nlast line\r\n", 65003, "last line\r\n"},
        {lines(649) + std::string(5000, 'z') + "\r\nnext\r\n", 64900 + 5002, "next\r\n"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.firstpage);
        writefile(log, c.text);
        logpages pages;
        ASSERT_TRUE(pages.open(log));
        EXPECT_EQ(pages.text().size(), c.firstpage);
        EXPECT_EQ(pages.more(), c.next != nullptr);
        if (!c.next)
            continue;
        pages.nextpage();
        EXPECT_EQ(pages.page(), 2);
        EXPECT_EQ(pages.text(), QString::fromLatin1(c.next));
        EXPECT_FALSE(pages.more());
    }
}

TEST_F(LogPages, LineEndsEncodingsAndStart)
{
    logpages pages;
    EXPECT_FALSE(pages.open(dir.filePath(QStringLiteral("none.txt"))));
    EXPECT_FALSE(pages.more());
    writefile(log, "");
    ASSERT_TRUE(pages.open(log));
    EXPECT_TRUE(pages.page() == 1 && pages.text().isEmpty() && !pages.more());

    // Spaces at the end go, tabs and inner spaces stay; any line end reads as one.
    writefile(log, "a b   \r\n\tc \nlast   ");
    ASSERT_TRUE(pages.open(log));
    EXPECT_EQ(pages.text(), QStringLiteral("a b\r\n\tc\r\nlast\r\n"));
    // UTF-8 as written by the log, and an older log's Windows-1252 bytes.
    writefile(log, "Name: Brontë, Anne\r\nPlace: Ch\xe2teau\r\n");
    ASSERT_TRUE(pages.open(log));
    EXPECT_EQ(pages.text(), QStringLiteral("Name: Brontë, Anne\r\nPlace: Château\r\n"));

    writefile(log, lines(700));
    ASSERT_TRUE(pages.open(log));
    pages.nextpage();
    EXPECT_EQ(pages.page(), 2);
    EXPECT_EQ(pages.text().size(), 49 * 100);
    EXPECT_TRUE(pages.restart());
    EXPECT_EQ(pages.page(), 1);
    EXPECT_EQ(pages.text().size(), 651 * 100);
}

// The viewer shows page 1 of 3 and keeps nothing open: the log can be
// cleared or removed meanwhile (Windows refuses both for a file held open).
TEST_F(LogPages, TheLogIsNotHeldOpenWhileShown)
{
    writefile(log, lines(1500));
    logpages pages;
    ASSERT_TRUE(pages.open(log));
    ASSERT_TRUE(pages.more());
#ifdef Q_OS_LINUX
    const QString target = QFileInfo(log).canonicalFilePath();
    const QDir fds(QStringLiteral("/proc/self/fd"));
    for (const QFileInfo& fd : fds.entryInfoList(QDir::Files | QDir::System | QDir::NoDotAndDotDot))
        EXPECT_TRUE(fd.symLinkTarget() != target) << "the log is held open as descriptor " << qPrintable(fd.fileName());
#endif
    EXPECT_TRUE(QFile::remove(log));
    pages.nextpage();
    EXPECT_EQ(pages.page(), 2);
    EXPECT_EQ(pages.text().size(), 651 * 100);
    EXPECT_TRUE(pages.more());
    EXPECT_FALSE(pages.restart()); // gone now
}

TEST_F(LogPages, ClearLog)
{
    scriptedprompts asker;
    // Missing: told, nothing created.
    asker.expect(answer::ok, QStringLiteral("does not exist"));
    EXPECT_FALSE(clearlog(asker, log));
    EXPECT_FALSE(QFile::exists(log));
    asker.expect(answer::ok, QStringLiteral("does not exist"));
    EXPECT_FALSE(clearlog(asker, dir.path())); // a folder is no log

    // No keeps it.
    writefile(log, "entry\r\n");
    asker.expect(answer::no, QStringLiteral("Are you sure you want to clear the log file?"));
    EXPECT_FALSE(clearlog(asker, log));
    EXPECT_EQ(readfile(log), "entry\r\n");
    EXPECT_EQ(asker.history().back().m.defaultanswer, answer::no);

    // Yes empties it.
    asker.expect(answer::yes, QStringLiteral("Are you sure"));
    asker.expect(answer::ok, QStringLiteral("The log file has been cleared"));
    EXPECT_TRUE(clearlog(asker, log));
    EXPECT_TRUE(QFile::exists(log) && QFileInfo(log).size() == 0);
    EXPECT_EQ(asker.unexpected(), 0);
}

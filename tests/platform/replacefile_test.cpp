// A family file written anew keeps what the user set on it: owner and group,
// mode, ACLs, extended attributes. (Its other names, hard links: SaveRoad.LinkedFileIsWrittenInPlace.)
#include <QtGlobal>

#ifdef Q_OS_LINUX

#include "writer/linewriter.h"

#include "support/testfiles.h"

#include <QDir>
#include <QProcess>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <cstring>
#include <functional>
#include <map>
#include <string>

#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

using namespace qm;
using qmtest::readfile;

namespace {

// What identifies a file beside its content.
struct identity {
    uid_t uid = 0;
    gid_t gid = 0;
    mode_t mode = 0;
    nlink_t links = 0;
    std::map<std::string, std::string> xattrs;

    bool operator==(const identity& o) const
    {
        return uid == o.uid && gid == o.gid && mode == o.mode && links == o.links && xattrs == o.xattrs;
    }
};

identity identityof(const QString& path)
{
    identity id;
    const QByteArray p = QFile::encodeName(path);
    struct stat st;
    if (::stat(p.constData(), &st) != 0)
        return id;
    id.uid = st.st_uid;
    id.gid = st.st_gid;
    id.mode = st.st_mode;
    id.links = st.st_nlink;
    char names[4096];
    const ssize_t n = ::listxattr(p.constData(), names, sizeof names);
    for (ssize_t at = 0; at < n; at += static_cast<ssize_t>(std::strlen(names + at)) + 1) {
        char value[4096];
        const ssize_t len = ::getxattr(p.constData(), names + at, value, sizeof value);
        id.xattrs[names + at] = len >= 0 ? std::string(value, static_cast<size_t>(len)) : "?";
    }
    return id;
}

// A group this process may give its files other than its own: any, as root;
// otherwise one of its supplementary groups. 0 when there is none.
gid_t othergroup()
{
    if (::geteuid() == 0)
        return ::getegid() == 4242 ? 4243 : 4242;
    gid_t groups[256];
    const int n = ::getgroups(256, groups);
    for (int i = 0; i < n; ++i)
        if (groups[i] != ::getegid())
            return groups[i];
    return 0;
}

// Sets one thing on the file; "" or why this system cannot (the case is skipped).
using setup = std::function<std::string(const QString& path)>;

struct identitycase {
    const char* name;
    setup set;
};

std::string mode640(const QString& path)
{
    return ::chmod(QFile::encodeName(path).constData(), 0640) == 0 ? "" : "chmod failed";
}

std::string othergroupset(const QString& path)
{
    const gid_t g = othergroup();
    if (g == 0)
        return "this user has no second group to give the file";
    return ::chown(QFile::encodeName(path).constData(), static_cast<uid_t>(-1), g) == 0 ? "" : "chown failed";
}

std::string acl(const QString& path)
{
    const QString setfacl = QStandardPaths::findExecutable(QStringLiteral("setfacl"));
    if (setfacl.isEmpty())
        return "setfacl is not installed (package acl)";
    QProcess p;
    p.start(setfacl, {QStringLiteral("-m"), QStringLiteral("u:65534:rw"), path});
    return p.waitForFinished() && p.exitCode() == 0 ? "" : "this file system holds no ACLs";
}

std::string userxattr(const QString& path)
{
    const char value[] = "kept";
    return ::setxattr(QFile::encodeName(path).constData(), "user.quillmark.test", value, 4, 0) == 0
        ? ""
        : "this file system holds no user extended attributes";
}

class ReplaceKeeps : public ::testing::TestWithParam<identitycase> {};

} // namespace

TEST_P(ReplaceKeeps, WhatTheUserSetOnTheFile)
{
    QTemporaryDir dir;
    ASSERT_TRUE(dir.isValid());
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, "0 HEAD\r\n0 TRLR\r\n");
    if (const std::string why = GetParam().set(path); !why.empty())
        GTEST_SKIP() << why;
    const identity before = identityof(path);

    linewriter w(textencoding::windows1252, false);
    ASSERT_TRUE(w.open(path));
    w.writeline("0 HEAD");
    w.writeline("1 NOTE new");
    w.writeline("0 TRLR");
    ASSERT_TRUE(w.commit()) << w.errorstring().toStdString();

    EXPECT_EQ(readfile(path), "0 HEAD\r\n1 NOTE new\r\n0 TRLR\r\n");
    const identity after = identityof(path);
    EXPECT_TRUE(after == before) << "owner " << after.uid << ":" << after.gid << " mode " << std::oct << after.mode
                                 << std::dec << " links " << after.links << " xattrs " << after.xattrs.size();
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).filter(QStringLiteral("quillmark")).size(), 0)
        << "no temporary file left";
}

INSTANTIATE_TEST_SUITE_P(Identity, ReplaceKeeps,
                         ::testing::Values(identitycase{"ModeBits", mode640}, identitycase{"Group", othergroupset},
                                           identitycase{"Acl", acl}, identitycase{"UserXattr", userxattr}),
                         [](const ::testing::TestParamInfo<identitycase>& i) { return std::string(i.param.name); });

#endif

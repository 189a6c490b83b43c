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
#include <sstream>
#include <string>

#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

using namespace qm;
using qmtest::readfile;

namespace {

// What identifies a file beside its content: owner, group, mode, number of
// names and extended attributes (ACLs among them), in one line.
std::string identityof(const QString& path)
{
    const QByteArray p = QFile::encodeName(path);
    struct stat st;
    if (::stat(p.constData(), &st) != 0)
        return "missing";
    std::ostringstream id;
    id << st.st_uid << ":" << st.st_gid << " mode " << std::oct << st.st_mode << std::dec << " links " << st.st_nlink;
    char names[4096], value[4096];
    const ssize_t n = ::listxattr(p.constData(), names, sizeof names);
    for (ssize_t at = 0; at < n; at += static_cast<ssize_t>(std::strlen(names + at)) + 1) {
        const ssize_t len = ::getxattr(p.constData(), names + at, value, sizeof value);
        id << " " << names + at << "=" << (len >= 0 ? std::string(value, static_cast<size_t>(len)) : "?");
    }
    return id.str();
}

// Each sets one thing on the file, and returns "" or why this system cannot (the case is skipped).
struct identitycase {
    const char* name;
    std::string (*set)(const char* path);
};

const identitycase identitycases[] = {
    {"ModeBits", [](const char* path) { return std::string(::chmod(path, 0640) == 0 ? "" : "chmod failed"); }},
    {"Group",
     [](const char* path) {
         // Any group, as root; otherwise one of this user's other groups.
         gid_t g = ::geteuid() == 0 ? (::getegid() == 4242 ? 4243 : 4242) : 0;
         gid_t groups[256];
         for (int i = 0, n = ::geteuid() == 0 ? 0 : ::getgroups(256, groups); i < n && g == 0; ++i)
             g = groups[i] != ::getegid() ? groups[i] : 0;
         if (g == 0)
             return std::string("this user has no second group to give the file");
         return std::string(::chown(path, static_cast<uid_t>(-1), g) == 0 ? "" : "chown failed");
     }},
    {"Acl",
     [](const char* path) {
         const QString setfacl = QStandardPaths::findExecutable(QStringLiteral("setfacl"));
         if (setfacl.isEmpty())
             return std::string("setfacl is not installed (package acl)");
         QProcess p;
         p.start(setfacl, {QStringLiteral("-m"), QStringLiteral("u:65534:rw"), QFile::decodeName(path)});
         return std::string(p.waitForFinished() && p.exitCode() == 0 ? "" : "this file system holds no ACLs");
     }},
    {"UserXattr",
     [](const char* path) {
         return std::string(::setxattr(path, "user.quillmark.test", "kept", 4, 0) == 0
                                ? ""
                                : "this file system holds no user extended attributes");
     }},
};

class ReplaceKeeps : public ::testing::TestWithParam<identitycase> {};

} // namespace

TEST_P(ReplaceKeeps, WhatTheUserSetOnTheFile)
{
    QTemporaryDir dir;
    ASSERT_TRUE(dir.isValid());
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, "0 HEAD\r\n0 TRLR\r\n");
    if (const std::string why = GetParam().set(QFile::encodeName(path).constData()); !why.empty())
        GTEST_SKIP() << why;
    const std::string before = identityof(path);

    linewriter w(textencoding::windows1252, false);
    ASSERT_TRUE(w.open(path));
    w.writeline("0 HEAD");
    w.writeline("1 NOTE new");
    w.writeline("0 TRLR");
    ASSERT_TRUE(w.commit()) << w.errorstring().toStdString();

    EXPECT_EQ(readfile(path), "0 HEAD\r\n1 NOTE new\r\n0 TRLR\r\n");
    EXPECT_EQ(identityof(path), before);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).filter(QStringLiteral("quillmark")).size(), 0)
        << "no temporary file left";
}

INSTANTIATE_TEST_SUITE_P(Identity, ReplaceKeeps, ::testing::ValuesIn(identitycases),
                         [](const auto& i) { return std::string(i.param.name); });

#endif

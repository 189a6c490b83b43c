#include "platform/replacefile.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <vector>

#ifdef Q_OS_WIN
#include <io.h>
#include <windows.h>
#else
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#endif
#ifdef Q_OS_LINUX
#include <sys/xattr.h>
#endif

namespace qm {

namespace {

constexpr qint64 chunk = 1 << 20;

#ifdef Q_OS_LINUX
// The kernel copies without the bytes passing through here (and shares the
// blocks where the file system can). False when it cannot be used at all.
bool kernelcopy(int from, int to, qint64& total, bool* written, QString* error)
{
    loff_t in = 0, out = 0;
    total = 0;
    for (;;) {
        const ssize_t n = ::copy_file_range(from, &in, to, &out, static_cast<size_t>(chunk) * 64, 0);
        if (n < 0) {
            if (total == 0 && (errno == ENOSYS || errno == EXDEV || errno == EINVAL || errno == EOPNOTSUPP))
                return false;
            *error = lastsystemerror();
            total = -1;
            return true;
        }
        if (n == 0)
            return true;
        *written = true;
        total += n;
    }
}
#endif

} // namespace

bool copydata(QFile& from, QFile& to, QString* error, bool* written)
{
    bool changed = false;
    if (!written)
        written = &changed;
    *written = false;
    qint64 total = -2;
#ifdef Q_OS_LINUX
    if (!from.isSequential() && !to.isSequential() && to.flush()) {
        if (!kernelcopy(from.handle(), to.handle(), total, written, error))
            total = -2;
        else if (total < 0)
            return false;
    }
#endif
    if (total == -2) {
        if (!from.seek(0) || !to.seek(0)) {
            *error = from.error() != QFileDevice::NoError ? from.errorString() : to.errorString();
            return false;
        }
        std::vector<char> buf(chunk);
        total = 0;
        for (;;) {
            const qint64 n = from.read(buf.data(), chunk);
            if (n < 0) {
                *error = from.errorString();
                return false;
            }
            if (n == 0)
                break;
            *written = true;
            if (to.write(buf.data(), n) != n) {
                *error = to.errorString();
                return false;
            }
            total += n;
        }
    }
    *written = true;
    if (!to.resize(total) || !to.flush()) {
        *error = to.errorString();
        return false;
    }
    return true;
}

namespace {

#ifndef Q_OS_WIN
// The folder's entry of a renamed file reaches the disk too.
void syncfolder(const QString& file)
{
    const int fd = ::open(QFile::encodeName(QFileInfo(file).absolutePath()).constData(), O_RDONLY | O_CLOEXEC);
    if (fd >= 0) {
        (void)::fsync(fd);
        ::close(fd);
    }
}
#endif

#ifdef Q_OS_LINUX
// The names of a file's extended attributes (ACLs among them, as
// system.posix_acl_access). False when they cannot be listed.
bool xattrnames(int fd, std::vector<std::string>& names)
{
    names.clear();
    for (;;) {
        const ssize_t size = ::flistxattr(fd, nullptr, 0);
        if (size < 0)
            return errno == ENOTSUP;
        std::string buf(static_cast<size_t>(size), '\0');
        const ssize_t got = ::flistxattr(fd, buf.data(), buf.size());
        if (got < 0 && errno == ERANGE)
            continue; // grew meanwhile
        if (got < 0)
            return false;
        for (size_t at = 0; at < static_cast<size_t>(got);) {
            const size_t len = std::strlen(buf.data() + at);
            if (len)
                names.emplace_back(buf.data() + at, len);
            at += len + 1;
        }
        return true;
    }
}

bool xattrvalue(int fd, const std::string& name, std::string& value)
{
    for (;;) {
        const ssize_t size = ::fgetxattr(fd, name.c_str(), nullptr, 0);
        if (size < 0)
            return false;
        value.assign(static_cast<size_t>(size), '\0');
        const ssize_t got = ::fgetxattr(fd, name.c_str(), value.data(), value.size());
        if (got < 0 && errno == ERANGE)
            continue;
        if (got < 0)
            return false;
        value.resize(static_cast<size_t>(got));
        return true;
    }
}

// Gives `to` exactly the extended attributes of `from`.
bool copyxattrs(int from, int to)
{
    std::vector<std::string> want, have;
    if (!xattrnames(from, want) || !xattrnames(to, have))
        return false;
    std::string value;
    for (const std::string& name : want)
        if (!xattrvalue(from, name, value) || ::fsetxattr(to, name.c_str(), value.data(), value.size(), 0) != 0)
            return false;
    // What the new file took from its folder (a default ACL) and the old one lacks.
    for (const std::string& name : have)
        if (std::find(want.begin(), want.end(), name) == want.end() && ::fremovexattr(to, name.c_str()) != 0)
            return false;
    return true;
}
#endif

} // namespace

QString lastsystemerror()
{
    return qt_error_string(-1);
}

bool syncfile(QFile& file)
{
#ifdef Q_OS_WIN
    const auto h = reinterpret_cast<HANDLE>(_get_osfhandle(file.handle()));
    return h != INVALID_HANDLE_VALUE && FlushFileBuffers(h);
#else
    return ::fsync(file.handle()) == 0;
#endif
}

replacefile::replacefile(const QString& path) : path_(path)
{
    const QFileInfo info(path);
    // A symbolic link stays a link: the file it points to is the one replaced.
    if (info.isSymLink()) {
        const QString target = info.canonicalFilePath();
        path_ = target.isEmpty() ? info.symLinkTarget() : target;
    }
}

replacefile::~replacefile()
{
    cancel();
}

bool replacefile::fail(const QString& error)
{
    if (error_.isEmpty())
        error_ = error.isEmpty() ? lastsystemerror() : error;
    return false;
}

bool replacefile::open()
{
    const QFileInfo info(path_);
    const QDir folder(info.absolutePath());
    for (int tries = 0; tries < 100; ++tries) {
        // Hidden, and named so that nothing takes it for a family file or a backup.
        const QString name = QStringLiteral(".") + info.fileName() + QStringLiteral(".quillmark-")
            + QString::number(QRandomGenerator::global()->generate64(), 36);
        temp_ = std::make_unique<QFile>(folder.filePath(name));
        // Writes go straight to the system, which names what failed (a full disk ...).
        if (temp_->open(QIODevice::ReadWrite | QIODevice::NewOnly | QIODevice::Unbuffered))
            return true;
        if (!QFileInfo::exists(temp_->fileName()))
            break;
    }
    fail(temp_->errorString());
    temp_.reset();
    return false;
}

bool replacefile::write(const char* data, int64_t size)
{
    if (!temp_)
        return fail(QStringLiteral("The file was not opened"));
    while (size > 0) {
        const qint64 n = temp_->write(data, size);
        if (n <= 0)
            return fail(temp_->errorString());
        data += n;
        size -= n;
    }
    return true;
}

int replacefile::handle() const
{
    return temp_ ? temp_->handle() : -1;
}

void replacefile::cancel()
{
    // The temporary file is this process's own: made with NewOnly above.
    if (temp_) {
        temp_->close();
        temp_->remove();
        temp_.reset();
    }
}

#ifdef Q_OS_WIN

bool replacefile::keepidentity()
{
    // ReplaceFileW keeps the file's ACLs and attributes; only linked files
    // must be written in place.
    const QString native = QDir::toNativeSeparators(path_);
    const HANDLE h = CreateFileW(reinterpret_cast<const wchar_t*>(native.utf16()),
                                 FILE_READ_ATTRIBUTES, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE,
                                 nullptr, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr);
    if (h == INVALID_HANDLE_VALUE)
        return true; // no file yet: nothing to keep
    BY_HANDLE_FILE_INFORMATION info;
    const bool linked = GetFileInformationByHandle(h, &info) && info.nNumberOfLinks > 1;
    CloseHandle(h);
    return !linked;
}

#else

bool replacefile::keepidentity()
{
    struct stat old;
    if (::stat(QFile::encodeName(path_).constData(), &old) != 0) {
        if (errno != ENOENT)
            return false;
        // A new file: readable by all, as files are made by default.
        (void)::fchmod(temp_->handle(), 0644);
        return true;
    }
    if (old.st_nlink > 1)
        return false;
    const int fd = temp_->handle();
    struct stat now;
    if (::fstat(fd, &now) != 0)
        return false;
    if (now.st_uid != old.st_uid || now.st_gid != old.st_gid) {
        const uid_t uid = now.st_uid == old.st_uid ? static_cast<uid_t>(-1) : old.st_uid;
        const gid_t gid = now.st_gid == old.st_gid ? static_cast<gid_t>(-1) : old.st_gid;
        if (::fchown(fd, uid, gid) != 0)
            return false;
    }
    // After the owner: a change of owner clears the set-id bits.
    if (::fchmod(fd, old.st_mode & 07777) != 0)
        return false;
#ifdef Q_OS_LINUX
    const int from = ::open(QFile::encodeName(path_).constData(), O_RDONLY | O_CLOEXEC);
    if (from < 0)
        return false;
    const bool copied = copyxattrs(from, fd);
    ::close(from);
    return copied;
#else
    return true;
#endif
}

#endif

bool replacefile::copyinplace()
{
    QFile target(path_);
    if (!target.open(QIODevice::ReadWrite))
        return fail(target.errorString());
    bool written = false;
    QString error;
    if (!copydata(*temp_, target, &error, &written) || !syncfile(target)) {
        damaged_ = written;
        return fail(error);
    }
    return true;
}

replacefile::outcome replacefile::commit(const lastcheck& check)
{
    if (!temp_) {
        fail(QStringLiteral("The file was not opened"));
        return outcome::failed;
    }
    inplace_ = !keepidentity();
    if (!syncfile(*temp_)) {
        fail(lastsystemerror());
        cancel();
        return outcome::failed;
    }
    if (check && !check(inplace_)) {
        cancel();
        return outcome::withdrawn;
    }
    if (inplace_) {
        const bool ok = copyinplace();
        cancel();
        return ok ? outcome::replaced : outcome::failed;
    }
    const QString temp = temp_->fileName();
#ifdef Q_OS_WIN
    temp_->close();
    const QString target = QDir::toNativeSeparators(path_), from = QDir::toNativeSeparators(temp);
    const auto* to = reinterpret_cast<const wchar_t*>(target.utf16());
    const auto* replacement = reinterpret_cast<const wchar_t*>(from.utf16());
    const bool moved = QFileInfo::exists(path_)
        ? ReplaceFileW(to, replacement, nullptr, REPLACEFILE_IGNORE_MERGE_ERRORS, nullptr, nullptr)
        : MoveFileExW(replacement, to, MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH);
    if (!moved) {
        fail(lastsystemerror());
        cancel();
        return outcome::failed;
    }
#else
    if (::rename(QFile::encodeName(temp).constData(), QFile::encodeName(path_).constData()) != 0) {
        fail(lastsystemerror());
        cancel();
        return outcome::failed;
    }
    syncfolder(path_);
#endif
    temp_.reset(); // now the file itself
    return outcome::replaced;
}

QString copyintofile(const QString& source, const QString& target)
{
    QFile from(source), to(target);
    if (!from.open(QIODevice::ReadOnly))
        return from.errorString();
    if (!to.open(QIODevice::ReadWrite))
        return to.errorString();
    QString error;
    if (!copydata(from, to, &error))
        return error;
    return syncfile(to) ? QString() : lastsystemerror();
}

QString syncexisting(const QString& path)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadWrite) && !f.open(QIODevice::ReadOnly))
        return f.errorString();
    if (!syncfile(f))
        return lastsystemerror();
#ifndef Q_OS_WIN
    syncfolder(path);
#endif
    return QString();
}

} // namespace qm

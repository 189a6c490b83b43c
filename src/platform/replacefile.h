#pragma once
// Writing a new version of a file over the old one without losing what the
// user set on the file.
//
// The new content goes to a temporary file beside the file. At commit it is
// given the file's owner, group, mode, ACLs and extended attributes, made
// durable, and - after one last look by the caller - moved over the file in
// one atomic step, so that a crash at any moment leaves either the old file or
// the new one. A replace cannot keep a file's identity when the file has more
// than one name (hard links) or its owner or group cannot be given to the new
// file: the new content is then copied into the existing file instead, as
// careful editors do. The caller holds a synced backup for that case, since a
// crash in the middle of the copy leaves a file that only the backup mends.
//
// On Windows the replace is ReplaceFileW, which keeps the file's ACLs and
// attributes; linked files are written in place the same way.

#include <QString>

#include <cstdint>
#include <functional>
#include <memory>

class QFile;

namespace qm {

class replacefile {
public:
    explicit replacefile(const QString& path);
    ~replacefile(); // removes an uncommitted temporary file
    replacefile(const replacefile&) = delete;
    replacefile& operator=(const replacefile&) = delete;

    // Creates the temporary file beside the file (beside the file a symbolic
    // link points to). False with errorstring() on failure.
    bool open();
    // False with errorstring() on failure.
    bool write(const char* data, int64_t size);
    // The temporary file's descriptor (for write-back hints), -1 when none.
    int handle() const;

    // Asked when the new content is on the disk and nothing of the file has
    // been touched yet, with whether the content will be copied into the file
    // in place; false withdraws the change and leaves the file as it was.
    using lastcheck = std::function<bool(bool inplace)>;
    enum class outcome { replaced, withdrawn, failed };
    outcome commit(const lastcheck& check = {});
    // Drops the temporary file; the file stays as it was.
    void cancel();

    QString errorstring() const { return error_; }
    // After commit: the content was copied into the existing file.
    bool inplace() const { return inplace_; }
    // A copy in place failed part way: the file holds neither version.
    bool damaged() const { return damaged_; }

private:
    bool fail(const QString& error);
    bool keepidentity(); // gives the temporary file the file's owner, group, mode and attributes
    bool copyinplace();

    QString path_;   // the file to replace (symbolic links resolved)
    QString error_;
    std::unique_ptr<QFile> temp_; // the temporary file, made by this process
    bool inplace_ = false;
    bool damaged_ = false;
};

// Copies the bytes of `source` into the existing file `target`, keeping the
// target's identity (owner, links, attributes), and syncs it. Used to put a
// backup back after a copy in place failed. "" or the system's reason.
QString copyintofile(const QString& source, const QString& target);

// Copies all of `from` into `to` from their starts and cuts `to` to that
// length (on Linux in the kernel). `written`: whether `to` was changed at all.
// False with the system's reason in `error`.
bool copydata(QFile& from, QFile& to, QString* error, bool* written = nullptr);

// Makes an existing file and its folder entry durable. "" or the reason.
QString syncexisting(const QString& path);

// Makes a written file durable (fsync, FlushFileBuffers). False on failure.
bool syncfile(QFile& file);

// The system's description of the last error of a failed system call.
QString lastsystemerror();

} // namespace qm

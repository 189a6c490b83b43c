#pragma once
// Reads the census log a page at a time for the log viewer. A page holds whole
// lines, each without its trailing spaces and ended by CR LF; it ends after the
// line that brings its length to 65,001 characters or more, or at the end of
// the log.
//
// The log is read whole when it is opened and closed at once: a viewer left
// open must not hold the file, which on Windows would stop Clear Log, a second
// Quillmark or any other program from clearing, renaming or removing it.

#include "platform/linereader.h"

#include <QByteArray>
#include <QString>

#include <memory>
#include <string>

namespace qm {

class logpages {
public:
    static constexpr qsizetype pagesize = 65001;

    // Opens the log and reads page 1. False when it cannot be read.
    bool open(const QString& path);
    // Reads the page after the current one (empty at the end of the log).
    void nextpage();
    // Reads page 1 again from the start of the file. False when it cannot be read.
    bool restart() { return open(path_); }

    const QString& text() const { return text_; }
    int page() const { return page_; }
    // Lines remain after the current page.
    bool more() const { return pending_; }

private:
    bool readline(QString& line);

    QString path_;
    QByteArray bytes_; // the log as read at open(); reader_ reads from it
    std::unique_ptr<linereader> reader_;
    std::string held_; // the line read ahead to learn whether more remain
    bool pending_ = false;
    QString text_;
    int page_ = 0;
};

} // namespace qm

#pragma once
// Keeps a family file open as another program would while a test saves into
// it: on Windows the test suite's holdfile program, in another process and
// with the sharing it is given ("share-delete" or "no-share-delete");
// elsewhere an open file of this process (nothing there stops a file from
// being replaced while it is open). Released when the object goes.

#include <QFile>
#include <QProcess>
#include <QString>

namespace qmtest {

class heldfile {
public:
    heldfile(const QString& path, const char* sharing);
    ~heldfile();
    heldfile(const heldfile&) = delete;
    heldfile& operator=(const heldfile&) = delete;

    bool holding() const { return holding_; }

private:
    QProcess holder_;
    QFile file_;
    bool holding_ = false;
};

} // namespace qmtest

#pragma once
// A folder that the user running the tests may read but not write into, for
// the tests of what happens when a file cannot be created or renamed there;
// writable again when the object goes.
//
// Elsewhere the folder's permission bits are taken away. Windows pays no heed
// to a folder's read-only attribute: there an entry of its access control list
// denies everyone adding, renaming and removing files in it.

#include <QString>

namespace qmtest {

class readonlyfolder {
public:
    explicit readonlyfolder(const QString& path);
    ~readonlyfolder();
    readonlyfolder(const readonlyfolder&) = delete;
    readonlyfolder& operator=(const readonlyfolder&) = delete;

    // Why a file can be written into the folder all the same ("" when it
    // cannot): the superuser passes over permission bits, and Wine keeps no
    // access control lists of its own.
    QString ineffective() const { return ineffective_; }

private:
    QString path_;
    QString ineffective_;
};

} // namespace qmtest

#pragma once
// File paths: their parts written with either separator ("/" or "\\"; the
// settings keep Windows paths, and a family file moved between systems may
// carry either), and the one full path that every name of a file shares.

#include <QString>

namespace qm {

// The folder part of a path, up to and including its last separator; empty
// when it has none.
QString folderof(const QString& path);
// The file name of a path: the part after its last separator.
QString filenameof(const QString& path);

// The full path of a file through any symbolic links, also when the file
// does not exist yet (its folder's canonical path and its name): two names of
// one file give one path.
QString canonicalpath(const QString& path);
// Two full paths (already made canonical) name the same file: letter case
// counts except on Windows, whose file names ignore it.
bool samefilepath(const QString& a, const QString& b);

} // namespace qm

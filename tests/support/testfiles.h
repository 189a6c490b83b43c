#pragma once
// Helpers for tests that work on files: a temporary folder, whole-file reads
// and writes, and the paths of the bundled sample and the shared corpus.

#include <QString>
#include <QTemporaryDir>

#include <string>

namespace qmtest {

// Bytes of a file ("" when it cannot be read).
std::string readfile(const QString& path);
void writefile(const QString& path, const std::string& bytes);

// The sample family file bundled with the program.
QString samplefile();

// The shared corpus folder, or "" when it is absent.
QString corpusdir();

} // namespace qmtest

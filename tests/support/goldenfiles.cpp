#include "support/goldenfiles.h"

#include "support/testfiles.h"

#include <QDir>
#include <QFileInfo>

#include <cstdlib>
#include <vector>

namespace qmtest {

namespace {

// Lines with their ends, so that a difference in line ends is shown as one.
std::vector<std::string> splitkeepends(const std::string& s)
{
    std::vector<std::string> lines;
    size_t start = 0;
    for (size_t i = 0; i < s.size(); ++i) {
        if (s[i] == '\n') {
            lines.push_back(s.substr(start, i + 1 - start));
            start = i + 1;
        }
    }
    if (start < s.size())
        lines.push_back(s.substr(start));
    return lines;
}

std::string shown(const std::string& line)
{
    std::string out;
    for (unsigned char c : line) {
        if (c == '\r')
            out += "\\r";
        else if (c == '\n')
            out += "\\n";
        else if (c < 0x20 || c >= 0x7F) {
            char buf[8];
            std::snprintf(buf, sizeof buf, "\\x%02X", c);
            out += buf;
        } else
            out.push_back(static_cast<char>(c));
    }
    return out;
}

} // namespace

::testing::AssertionResult samebytes(const std::string& expected, const std::string& actual)
{
    if (expected == actual)
        return ::testing::AssertionSuccess();
    const auto e = splitkeepends(expected);
    const auto a = splitkeepends(actual);
    size_t i = 0;
    while (i < e.size() && i < a.size() && e[i] == a[i])
        ++i;
    auto r = ::testing::AssertionFailure();
    r << "files differ: expected " << expected.size() << " bytes in " << e.size() << " lines, got " << actual.size()
      << " bytes in " << a.size() << " lines; first difference at line " << (i + 1) << "\n";
    r << "  expected: " << (i < e.size() ? shown(e[i]) : std::string("(end of file)")) << "\n";
    r << "  actual:   " << (i < a.size() ? shown(a[i]) : std::string("(end of file)"));
    return r;
}

::testing::AssertionResult matchesgolden(const QString& relpath, const std::string& actual)
{
    const QString path = QStringLiteral(QM_TESTDATA_DIR "/") + relpath;
    if (std::getenv("QM_UPDATE_GOLDENS")) {
        QDir().mkpath(QFileInfo(path).absolutePath());
        writefile(path, actual);
        return ::testing::AssertionSuccess();
    }
    if (!QFileInfo::exists(path))
        return ::testing::AssertionFailure() << "no golden file " << path.toStdString()
                                             << " (run with QM_UPDATE_GOLDENS=1 to make it)";
    return samebytes(readfile(path), actual) << " [" << relpath.toStdString() << "]";
}

} // namespace qmtest

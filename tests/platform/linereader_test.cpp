#include "platform/linereader.h"

#include <gtest/gtest.h>

#include <string>
#include <tuple>
#include <vector>

using namespace qm;

namespace {

struct readlines {
    std::vector<std::string> lines;
    std::vector<std::string> ends;
    textencoding enc;
    bool bom;
};

readlines readall(const std::string& bytes, size_t maxline = 0)
{
    linereader r;
    r.setmaxline(maxline);
    r.openbytes(bytes);
    readlines out;
    std::string_view line;
    while (r.next(line)) {
        out.lines.emplace_back(line);
        out.ends.emplace_back(r.lineend());
    }
    out.enc = r.encoding();
    out.bom = r.hasbom();
    return out;
}

} // namespace

TEST(LineReader, LinesAndTheirEnds)
{
    using v = std::vector<std::string>;
    const std::vector<std::tuple<std::string, v, v>> cases{
        {"0 HEAD\r\n1 A\n1 B\r1 C\n\r1 D", {"0 HEAD", "1 A", "1 B", "1 C", "1 D"}, {"\r\n", "\n", "\r", "\n\r", ""}},
        {"A\n\r\nB\r\n", {"A", "", "B"}, {"\n", "\r\n", "\r\n"}}, // LF, then an empty line ended by CR LF
        {"", {}, {}},
        {"\r\n\r\n", {"", ""}, {"\r\n", "\r\n"}},
        {"x", {"x"}, {""}},
        {std::string("1 NAME A\0B /\xe9/\r\n", 16), {std::string("1 NAME A\0B /\xe9/", 14)}, {"\r\n"}},
    };
    for (const auto& [bytes, lines, ends] : cases) {
        const auto r = readall(bytes);
        EXPECT_EQ(r.lines, lines);
        EXPECT_EQ(r.ends, ends);
    }
}

TEST(LineReader, CutsOverlongLinesWhenAsked)
{
    std::string bytes = "0 HEAD\r\n1 NOTE " + std::string(3u * 1024 * 1024, 'x') + "\r\n0 TRLR\r\n";
    const auto r = readall(bytes, 1000);
    ASSERT_EQ(r.lines.size(), 3u);
    EXPECT_EQ(r.lines[1].size(), 1000u);
    EXPECT_EQ(r.lines[2], "0 TRLR");
    // Without a limit the whole line comes through.
    EXPECT_EQ(readall(bytes).lines[1].size(), 3u * 1024 * 1024 + 7);
}

TEST(LineReader, FindsTheCharacterSet)
{
    EXPECT_EQ(readall("0 HEAD\r\n1 CHAR UTF-8\r\n0 TRLR\r\n").enc, textencoding::utf8);
    EXPECT_EQ(readall("0 HEAD\r\n1 CHAR ANSI\r\n").enc, textencoding::windows1252);
    EXPECT_EQ(readall("0 HEAD\r\n0 TRLR\r\n").enc, textencoding::windows1252);
    EXPECT_EQ(readall("0 HEAD\n  1 CHAR ANSEL\n").enc, textencoding::other8bit);
    // A CHAR line of a later record is not the header's.
    EXPECT_EQ(readall("0 HEAD\r\n0 @I1@ INDI\r\n1 CHAR UTF-8\r\n").enc, textencoding::windows1252);
    const auto bom = readall("\xEF\xBB\xBF" "0 HEAD\r\n1 CHAR ANSI\r\n");
    EXPECT_EQ(bom.enc, textencoding::utf8);
    EXPECT_TRUE(bom.bom);
    EXPECT_EQ(bom.lines[0], "0 HEAD");
}

// Lines of many lengths, mostly CR LF, with lines that stop a run (a "0" or a
// blank first, other line ends, empty lines, lines over the limit), over
// several of the reader's 1 MiB buffers: line by line they read as written,
// and runs of CR LF lines give the same lines.
TEST(LineReader, LinesAndRunsAcrossBufferBoundaries)
{
    std::string bytes;
    std::vector<std::string> written, ends;
    for (int i = 0; bytes.size() < 3u * 1024 * 1024; ++i) {
        const char* end = i % 41 == 9 ? "\n" : (i % 43 == 8 ? "\r" : "\r\n");
        std::string line = (i % 11 == 0 ? "0 @I" : "2 DATE ") + std::to_string(i) + std::string(i % 97, 'x');
        if (i % 53 == 7)
            line = "  " + line;
        if (i % 67 == 5 && end[0] == '\r' && end[1] == '\n') // an empty line only before CR LF: "\n" "\r" is one end
            line.clear();
        if (i % 89 == 3)
            line += std::string(300, 'x');
        written.push_back(line);
        ends.push_back(end);
        bytes += line + ends.back();
    }
    const auto whole = readall(bytes);
    EXPECT_EQ(whole.lines, written);
    EXPECT_EQ(whole.ends, ends);
    for (const size_t maxline : {size_t(0), size_t(200)}) {
        SCOPED_TRACE(maxline);
        const auto cut = readall(bytes, maxline);
        linereader r;
        r.setmaxline(maxline);
        r.openbytes(bytes);
        std::vector<std::string> lines, lineends;
        size_t runs = 0;
        for (std::string_view line; r.next(line);) {
            lines.emplace_back(line);
            lineends.emplace_back(r.lineend());
            int64_t count = 0;
            std::string_view run = r.nextcrlflines("0 \t", count);
            runs += count > 0;
            for (int64_t k = 0; k < count; ++k) {
                const size_t end = run.find("\r\n");
                ASSERT_NE(end, std::string_view::npos);
                lines.emplace_back(run.substr(0, end));
                lineends.emplace_back("\r\n");
                ASSERT_TRUE(lines.back().empty() || (lines.back()[0] != '0' && lines.back()[0] != ' '));
                run.remove_prefix(end + 2);
            }
            EXPECT_TRUE(run.empty());
        }
        EXPECT_GT(runs, 1000u);
        EXPECT_EQ(lines, cut.lines);
        EXPECT_EQ(lineends, cut.ends);
        EXPECT_EQ(r.linenumber(), static_cast<int64_t>(cut.lines.size()));
    }
}

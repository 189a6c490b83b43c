// Files written by many programs (the shared corpus) and generated ones: each
// loads with one individual for each line beginning "0 @I", and a census
// entry for two individuals changes only their two records and adds the new
// source, every other record coming out line for line as it was. Lines kept as
// they are go through the rewrite in runs when they end in CR LF: the result
// is what the line-by-line path gives for the same lines.

#include "writer/rewritefile.h"

#include "model/loadgedcom.h"
#include "platform/linereader.h"
#include "support/savefolder.h"
#include "support/censusentries.h"

#include <QDirIterator>
#include <QProcess>
#include <QStandardPaths>
#include <QStringDecoder>

#include <algorithm>
#include <charconv>
#include <map>

using namespace qm;

namespace {

using record = std::vector<std::string>;

std::string_view lefttrim(std::string_view s)
{
    return s.substr(std::min(s.find_first_not_of(" \t"), s.size()));
}

// Lines beginning "0 @I", counted apart from the loader: the file is decoded
// whole (UTF-16 by its byte-order mark or its "0" followed by a zero byte),
// split at every CR and LF, and a line counts when it begins "0 @I" after any
// spaces and tabs (a level-0 line indented as the deeper ones is still a record).
int64_t individuallines(const std::string& bytes)
{
    const auto b = [&](size_t i) { return i < bytes.size() ? static_cast<unsigned char>(bytes[i]) : 0x100u; };
    std::string text = bytes;
    std::optional<QStringConverter::Encoding> utf16;
    if ((b(0) == 0xFF && b(1) == 0xFE) || (b(0) == '0' && b(1) == 0))
        utf16 = QStringConverter::Utf16LE;
    else if ((b(0) == 0xFE && b(1) == 0xFF) || (b(0) == 0 && b(1) == '0'))
        utf16 = QStringConverter::Utf16BE;
    if (utf16) {
        QStringDecoder d(*utf16);
        text = QString(d.decode(QByteArrayView(bytes.data(), static_cast<qsizetype>(bytes.size())))).toStdString();
    }
    int64_t count = 0;
    for (size_t start = 0; start <= text.size();) {
        const size_t end = std::min(text.find_first_of("\r\n", start), text.size());
        const std::string_view line = lefttrim(std::string_view(text).substr(start, end - start));
        count += line.starts_with("0 @I");
        start = end + 1;
    }
    return count;
}

// The file's lines (UTF-8 for UTF-16 files) cut into records at level-0 lines.
std::vector<record> records(const std::string& bytes)
{
    linereader r;
    r.openbytes(bytes);
    std::vector<record> out(1);
    for (std::string_view line; r.next(line);) {
        if (lefttrim(line).starts_with("0"))
            out.emplace_back();
        out.back().emplace_back(line);
    }
    return out;
}

int64_t indinumber(const record& rec)
{
    int64_t n = -1;
    const std::string_view t = rec.empty() ? std::string_view() : lefttrim(rec.front());
    if (t.starts_with("0 @I"))
        std::from_chars(t.data() + 4, t.data() + t.size(), n);
    return n;
}

// The old record without its change stamp is kept, in order, inside the new one.
::testing::AssertionResult keptinside(const record& before, const record& after)
{
    const auto upper = [](std::string_view l) {
        std::string up(lefttrim(l).substr(0, 6));
        std::transform(up.begin(), up.end(), up.begin(), [](unsigned char c) { return std::toupper(c); });
        return up;
    };
    size_t j = 0;
    for (size_t i = 0; i < before.size(); ++i) {
        if (upper(before[i]) == "1 CHAN") {
            while (i + 1 < before.size() && (upper(before[i + 1]) == "2 DATE" || upper(before[i + 1]) == "3 TIME"))
                ++i;
            continue;
        }
        while (j < after.size() && after[j] != before[i])
            ++j;
        if (j++ == after.size())
            return ::testing::AssertionFailure() << "line lost: " << before[i];
    }
    if (std::count(after.begin(), after.end(), "1 CENS") < 1 || std::count(after.begin(), after.end(), "1 CHAN") != 1)
        return ::testing::AssertionFailure() << "no census event or not one change stamp in " << after.front();
    return ::testing::AssertionSuccess();
}

// Loads the file, then runs an entry for two individuals of it and checks every record.
void checkfile(const std::string& input, const std::string& name)
{
    SCOPED_TRACE(name);
    auto ix = loadgedcombytes(input, {});
    ASSERT_TRUE(ix);
    EXPECT_EQ(static_cast<int64_t>(ix->people.size()), individuallines(input));
    EXPECT_TRUE(ix->hashead);
    for (size_t i = 1; i < ix->places.size(); ++i)
        EXPECT_LT(placekey(ix->places[i - 1].name), placekey(ix->places[i].name));

    std::map<int32_t, int> ids;
    for (const personrec& p : ix->people)
        ++ids[p.id];
    rewriterequest r;
    r.entry = qmtest::censusof(QString::number(ix->nextsourceid), "Census 1881 Leeds RG11/1 (Test)", "Leeds");
    r.entry.reference = QStringLiteral("RG11/1");
    r.entry.sourcetext = QStringLiteral("Line one\r\nLine two");
    for (size_t i : {size_t(0), ix->people.size() - 1})
        if (i < ix->people.size() && ix->people[i].id > 0 && ids[ix->people[i].id] == 1
            && (r.entry.selection.empty() || r.entry.selection[0].id != ix->people[i].id))
            r.entry.selection.push_back(qmtest::chosen(ix->people[i].id, static_cast<int32_t>(i), "Someone", "30", "Weaver"));
    if (r.entry.selection.size() < 2)
        return; // fewer than two individuals with plain, unique identifiers
    std::string output;
    const rewriteresult res = rewritebytes(input, output, *ix, settings{}, r);
    ASSERT_TRUE(res.ok) << res.message.toStdString();
    EXPECT_EQ(res.censusblocks, 2);

    const auto before = records(input), after = records(output);
    ASSERT_EQ(after.size(), before.size() + 1);
    const std::string newsource = "0 @S" + std::to_string(ix->nextsourceid) + "@ SOUR";
    size_t j = 0, added = 0;
    for (size_t i = 0; i < before.size(); ++i, ++j) {
        if (j < after.size() && !after[j].empty() && after[j].front() == newsource) {
            ++added;
            ++j;
        }
        ASSERT_LT(j, after.size());
        const int64_t id = indinumber(before[i]);
        if (id == r.entry.selection[0].id || id == r.entry.selection[1].id)
            EXPECT_TRUE(keptinside(before[i], after[j]));
        else
            ASSERT_EQ(before[i], after[j]) << "record " << i << " changed";
    }
    added += j < after.size() && after[j].front() == newsource;
    EXPECT_EQ(added, 1u);

    // Read back, each of the two has one census event more.
    auto again = loadgedcombytes(output, {});
    ASSERT_EQ(again->people.size(), ix->people.size());
    for (const selectionrec& s : r.entry.selection) {
        const auto k = static_cast<size_t>(s.personindex);
        EXPECT_EQ(again->people[k].census.size(), ix->people[k].census.size() + 1) << s.id;
    }
}

} // namespace

TEST(CorpusRewrite, EveryFileLoadsAndAnEntryChangesOnlyItsIndividualsAndAddsItsSource)
{
    const QString dir = qmtest::corpusdir();
    if (dir.isEmpty())
        GTEST_SKIP() << "no corpus at " << QM_CORPUS_DIR;
    const qmtest::fixedclock clock(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    int files = 0;
    QDirIterator it(dir, {QStringLiteral("*.ged"), QStringLiteral("*.GED")}, QDir::Files, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        const std::string bytes = qmtest::readfile(path);
        const loadresult fromfile = loadgedcom(path, {});
        ASSERT_TRUE(fromfile.index) << fromfile.error.toStdString();
        EXPECT_EQ(fromfile.index->people.size(), loadgedcombytes(bytes, {})->people.size());
        checkfile(bytes, path.mid(dir.size() + 1).toStdString());
        ++files;
    }
    EXPECT_GT(files, 50);
}

TEST(RewriteGenerated, AnEntryChangesOnlyItsIndividualsAndAddsItsSource)
{
    const QString python = QStandardPaths::findExecutable(QStringLiteral("python3"));
    if (python.isEmpty())
        GTEST_SKIP() << "python3 is needed to generate family files";
    QTemporaryDir dir;
    const QString out = dir.filePath(QStringLiteral("gen.ged"));
    for (const auto& [enc, ends] : {std::pair{"ansi", "crlf"}, std::pair{"utf8-bom", "lf"}}) {
        QProcess gen;
        gen.start(python, {QStringLiteral(QM_GENERATOR), QStringLiteral("--individuals"), QStringLiteral("400"),
                           QStringLiteral("--encoding"), QString::fromLatin1(enc), QStringLiteral("--line-ends"),
                           QString::fromLatin1(ends), QStringLiteral("-o"), out});
        ASSERT_TRUE(gen.waitForFinished(60000));
        ASSERT_EQ(gen.exitCode(), 0) << gen.readAllStandardError().toStdString();
        checkfile(qmtest::readfile(out), std::string(enc) + "/" + ends);
    }
}

TEST(RewriteRuns, CrLfFileGivesTheSameBytesAsItsLfForm)
{
    const qmtest::fixedclock clock(QDateTime(QDate(2026, 5, 4), QTime(7, 8, 9)));
    // Indented lines, empty lines, a lone CR, change stamps and record starts
    // among the runs, over more than one buffer of the reader.
    std::string crlf = "0 HEAD\r\n1 CHAR ANSI\r\n", lf;
    for (int i = 1; i <= 20000; ++i) {
        const std::string id = std::to_string(i);
        crlf += "0 @I" + id + "@ INDI\r\n1 NAME Ann /Lee" + id + "/\r\n1 SEX F\r\n";
        crlf += i % 7 == 0 ? "  1 CENS\r\n" : "1 CENS\r\n";
        crlf += "2 DATE 1881\r\n2 PLAC Leeds\r\n\r\n2 SOUR @S1@\r\n1 FAMS @F" + id + "@\r\n";
        crlf += i % 5 == 0 ? "1 CHAN\r\n2 DATE 1 JAN 2000\r\n" : "1 NOTE x\rcut\r\n";
    }
    crlf += "0 @S1@ SOUR\r\n1 TITL Census 1881\r\n0 TRLR\r\n";
    ASSERT_GT(crlf.size(), 2u << 20);
    linereader reader;
    reader.openbytes(crlf);
    for (std::string_view line; reader.next(line);)
        (lf += line) += '\n';

    rewriterequest r;
    r.entry = qmtest::censusof(QStringLiteral("2"), "Census 1891", "Leeds", "5 APR 1891");
    r.entry.selection = {qmtest::chosen(5, 4, "Someone", "40", "Weaver"), qmtest::chosen(19999, 19998)};
    std::string a, b;
    const rewriteresult ra = rewritebytes(crlf, a, *loadgedcombytes(crlf, {}), settings{}, r);
    const rewriteresult rb = rewritebytes(lf, b, *loadgedcombytes(lf, {}), settings{}, r);
    ASSERT_TRUE(ra.ok);
    EXPECT_EQ(ra.censusblocks, 2);
    EXPECT_EQ(ra.lines, rb.lines);
    EXPECT_TRUE(a == b);
    EXPECT_NE(a.find("2 SOUR @S1@\r\n1 CENS\r\n2 DATE 5 APR 1891\r\n"), std::string::npos);
}

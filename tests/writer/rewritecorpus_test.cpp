// A census entry for two individuals changes only their two records and adds
// the new source: every other record comes out line for line as it was, in
// files written by many programs (the shared corpus) and in generated ones.

#include "writer/rewritefile.h"

#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "platform/linereader.h"
#include "support/testfiles.h"

#include <QDirIterator>
#include <QProcess>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <algorithm>
#include <map>

using namespace qm;

namespace {

using record = std::vector<std::string>;

std::string_view lefttrim(std::string_view s)
{
    while (!s.empty() && (s.front() == ' ' || s.front() == '\t'))
        s.remove_prefix(1);
    return s;
}

// The file's lines (UTF-8 for UTF-16 files) cut into records at level-0 lines.
std::vector<record> records(const std::string& bytes)
{
    linereader r;
    r.openbytes(bytes);
    std::vector<record> out(1);
    std::string_view line;
    while (r.next(line)) {
        if (lefttrim(line).starts_with("0"))
            out.emplace_back();
        out.back().emplace_back(line);
    }
    return out;
}

int64_t indinumber(const record& rec)
{
    if (rec.empty())
        return -1;
    const std::string_view t = lefttrim(rec.front());
    if (!t.starts_with("0 @I"))
        return -1;
    int64_t n = 0;
    size_t i = 4;
    for (; i < t.size() && t[i] >= '0' && t[i] <= '9'; ++i)
        n = n * 10 + (t[i] - '0');
    return i > 4 ? n : -1;
}

bool ischangeline(std::string_view l)
{
    std::string up(lefttrim(l).substr(0, 6));
    for (char& c : up)
        c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    return up == "1 CHAN" || up == "2 DATE" || up == "3 TIME";
}

// The old record without its change stamp is kept, in order, inside the new one.
::testing::AssertionResult keptinside(const record& before, const record& after)
{
    size_t j = 0;
    for (size_t i = 0; i < before.size(); ++i) {
        if (lefttrim(before[i]).starts_with("1 CHAN") || lefttrim(before[i]).starts_with("1 chan")) {
            while (i + 1 < before.size() && ischangeline(before[i + 1]) && !lefttrim(before[i + 1]).starts_with("1"))
                ++i;
            continue;
        }
        while (j < after.size() && after[j] != before[i])
            ++j;
        if (j == after.size())
            return ::testing::AssertionFailure() << "line lost: " << before[i];
        ++j;
    }
    if (std::count(after.begin(), after.end(), "1 CENS") < 1 || std::count(after.begin(), after.end(), "1 CHAN") != 1)
        return ::testing::AssertionFailure() << "no census event or not one change stamp in " << after.front();
    return ::testing::AssertionSuccess();
}

// Runs an entry for two individuals of the file and checks every record.
void checkentry(const std::string& input, const std::string& name)
{
    SCOPED_TRACE(name);
    auto ix = loadgedcombytes(input, {});
    ASSERT_TRUE(ix);
    std::map<int32_t, int> ids;
    for (const personrec& p : ix->people)
        ++ids[p.id];
    std::vector<int32_t> chosen;
    for (size_t i : {size_t(0), ix->people.size() - 1})
        if (i < ix->people.size() && ix->people[i].id > 0 && ids[ix->people[i].id] == 1
            && std::find(chosen.begin(), chosen.end(), ix->people[i].id) == chosen.end())
            chosen.push_back(ix->people[i].id);
    if (chosen.size() < 2)
        return; // fewer than two individuals with plain, unique identifiers

    rewriterequest r;
    r.entry.sourceid = QString::number(ix->nextsourceid);
    r.entry.title = QStringLiteral("Census 1881 Leeds RG11/1 (Test)");
    r.entry.place = QStringLiteral("Leeds");
    r.entry.reference = QStringLiteral("RG11/1");
    r.entry.sourcetext = QStringLiteral("Line one\r\nLine two");
    r.entry.entrydate = QStringLiteral("3 APR 1881");
    for (int32_t id : chosen) {
        selectionrec s;
        s.id = id;
        s.age = QStringLiteral("30");
        s.occupation = QStringLiteral("Weaver");
        for (size_t i = 0; i < ix->people.size(); ++i)
            if (ix->people[i].id == id)
                s.personindex = static_cast<int32_t>(i);
        r.entry.selection.push_back(s);
    }
    std::string output;
    const rewriteresult res = rewritebytes(input, output, *ix, settings{}, r);
    ASSERT_TRUE(res.ok) << res.message.toStdString();
    EXPECT_EQ(res.censusblocks, 2);

    const auto before = records(input);
    const auto after = records(output);
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
        if (id > 0 && std::find(chosen.begin(), chosen.end(), id) != chosen.end())
            EXPECT_TRUE(keptinside(before[i], after[j]));
        else
            ASSERT_EQ(before[i], after[j]) << "record " << i << " changed";
    }
    if (j < after.size() && after[j].front() == newsource)
        ++added;
    EXPECT_EQ(added, 1u);

    // Read back, each of the two has one census event more.
    auto again = loadgedcombytes(output, {});
    ASSERT_TRUE(again);
    ASSERT_EQ(again->people.size(), ix->people.size());
    for (const selectionrec& s : r.entry.selection) {
        const auto k = static_cast<size_t>(s.personindex);
        EXPECT_EQ(again->people[k].census.size(), ix->people[k].census.size() + 1) << s.id;
    }
}

} // namespace

TEST(CorpusRewrite, AnEntryChangesOnlyItsIndividualsAndAddsItsSource)
{
    const QString dir = qmtest::corpusdir();
    if (dir.isEmpty())
        GTEST_SKIP() << "no corpus at " << QM_CORPUS_DIR;
    setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    int files = 0;
    QDirIterator it(dir, {QStringLiteral("*.ged"), QStringLiteral("*.GED")}, QDir::Files, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        checkentry(qmtest::readfile(path), path.mid(dir.size() + 1).toStdString());
        ++files;
    }
    setclockfortests(QDateTime());
    EXPECT_GT(files, 50);
}

TEST(RewriteGenerated, AnEntryChangesOnlyItsIndividualsAndAddsItsSource)
{
    const QString python = QStandardPaths::findExecutable(QStringLiteral("python3"));
    if (python.isEmpty())
        GTEST_SKIP() << "python3 is needed to generate family files";
    QTemporaryDir dir;
    for (const auto& [enc, ends] : {std::pair{"ansi", "crlf"}, std::pair{"utf8-bom", "lf"}}) {
        {
            const QString out = dir.filePath(QStringLiteral("gen.ged"));
            QProcess gen;
            gen.start(python, {QStringLiteral(QM_GENERATOR), QStringLiteral("--individuals"), QStringLiteral("400"),
                               QStringLiteral("--encoding"), QString::fromLatin1(enc), QStringLiteral("--line-ends"),
                               QString::fromLatin1(ends), QStringLiteral("-o"), out});
            ASSERT_TRUE(gen.waitForFinished(60000));
            ASSERT_EQ(gen.exitCode(), 0) << gen.readAllStandardError().toStdString();
            checkentry(qmtest::readfile(out), std::string(enc) + "/" + ends);
        }
    }
}

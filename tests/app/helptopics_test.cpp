// The help pages in the source folder (built into the program's resources):
// every topic has its page, every page is in the resource file, every link and
// anchor resolves; and the full-text search.
#include "app/helptopics.h"

#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QSet>

#include <gtest/gtest.h>

using namespace qm;

namespace {

QString helpdir()
{
    return QStringLiteral(QM_SOURCE_DIR "/src/app/help");
}

QString readtext(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? QString::fromUtf8(f.readAll()) : QString();
}

QStringList pages()
{
    return QDir(helpdir()).entryList({QStringLiteral("*.html")}, QDir::Files, QDir::Name);
}

QStringList qrcfiles()
{
    static const QRegularExpression file(QStringLiteral("<file>([^<]+)</file>"));
    QStringList out;
    for (auto it = file.globalMatch(readtext(helpdir() + QStringLiteral("/help.qrc"))); it.hasNext();)
        out << it.next().captured(1);
    return out;
}

// "page:score" of each hit, best first.
QStringList ranked(const std::vector<helpdoc>& docs, const char* query)
{
    QStringList out;
    for (const helphit& h : searchhelp(docs, QString::fromUtf8(query)))
        out << h.page + QLatin1Char(':') + QString::number(h.score);
    return out;
}

} // namespace

// The resource file lists exactly the pages of the folder, and every topic has its own.
TEST(HelpTopics, EveryTopicHasItsOwnPageInTheResourcesOthersTheIndex)
{
    QStringList listed = qrcfiles();
    QStringList folder = QDir(helpdir()).entryList({QStringLiteral("*.html"), QStringLiteral("*.css")}, QDir::Files);
    listed.sort();
    folder.sort();
    EXPECT_EQ(listed, folder);
    EXPECT_TRUE(folder.contains(indexpage()) && folder.contains(searchpage()));
    QSet<QString> seen;
    std::vector<int> numbers;
    for (const helptopic& t : helptopics()) {
        numbers.push_back(t.topic);
        EXPECT_TRUE(listed.contains(t.page)) << t.page.toStdString();
        EXPECT_TRUE(!seen.contains(t.page) && pagefor(t.topic) == t.page) << t.page.toStdString();
        seen.insert(t.page);
    }
    EXPECT_EQ(numbers, (std::vector<int>{12, 14, 17, 18, 19, 20, 23, 24, 30, 35, 45, 55, 60}));

    // The commands, and topics that have no page.
    EXPECT_EQ(pagefor(0, QStringLiteral("Index")), QStringLiteral("index.html"));
    EXPECT_EQ(pagefor(0, QStringLiteral("Search")), QStringLiteral("search.html"));
    EXPECT_EQ(pagefor(45, QStringLiteral("Search")), QStringLiteral("search.html")); // the command wins
    EXPECT_EQ(pagefor(45), QStringLiteral("census-flags.html"));
    EXPECT_EQ(pagefor(99), QStringLiteral("index.html"));
    EXPECT_EQ(pagefor(maintopic), QStringLiteral("main-window.html"));
}

// Every link and anchor resolves, and the index links every page.
TEST(HelpTopics, EveryLinkAndAnchorResolves)
{
    ASSERT_GE(pages().size(), 14);
    QSet<QString> fromindex;
    for (const QString& link : helplinks(readtext(helpdir() + QStringLiteral("/index.html"))))
        fromindex.insert(link.section(u'#', 0, 0));
    for (const QString& page : pages()) {
        EXPECT_TRUE(page == indexpage() || fromindex.contains(page)) << page.toStdString();
        const QString html = readtext(helpdir() + QLatin1Char('/') + page);
        EXPECT_FALSE(parsehelp(page, html).title.isEmpty()) << page.toStdString();
        EXPECT_TRUE(html.contains(QLatin1String("<h1>"))) << page.toStdString();
        for (const QString& link : helplinks(html)) {
            if (link.startsWith(QLatin1String("https://")))
                continue;
            const QString file = link.section(u'#', 0, 0).isEmpty() ? page : link.section(u'#', 0, 0);
            const QString anchor = link.section(u'#', 1);
            const std::string where = (page + QStringLiteral(" -> ") + link).toStdString();
            ASSERT_TRUE(QFile::exists(helpdir() + QLatin1Char('/') + file)) << where;
            if (!anchor.isEmpty()) {
                EXPECT_TRUE(helpanchors(readtext(helpdir() + QLatin1Char('/') + file)).contains(anchor)) << where;
            }
        }
    }
}

TEST(HelpTopics, PageTextDropsMarkupAndDecodesEntities)
{
    const helpdoc d = parsehelp(QStringLiteral("p.html"),
                                QStringLiteral("<html><head><title>Options &amp; more</title><style>b{}</style></head>"
                                               "<body><p>Choose from &quot;&lt;&lt;Add Reference&quot;&#33;</p>"
                                               "<a href=\"x.html#top\">link</a></body></html>"));
    EXPECT_EQ(d.title, QStringLiteral("Options & more"));
    EXPECT_EQ(d.text, QStringLiteral("Choose from \"<<Add Reference\"! link"));
    EXPECT_EQ(helplinks(QStringLiteral("<a HREF = \"a.html\">a</a> <a href=\"b.html#c\">")),
              (QStringList{QStringLiteral("a.html"), QStringLiteral("b.html#c")}));
    EXPECT_EQ(helpanchors(QStringLiteral("<a name=\"top\"></a><h2 id=\"x\">")),
              (QStringList{QStringLiteral("top"), QStringLiteral("x")}));
}

TEST(HelpSearch, WholeWordsAnyCaseRankedByMatches)
{
    const std::vector<helpdoc> docs = {
        {QStringLiteral("a.html"), QStringLiteral("Alpha"), QStringLiteral("Flag flag and flags")},
        {QStringLiteral("b.html"), QStringLiteral("Flag page"), QStringLiteral("one flag here")},
        {QStringLiteral("c.html"), QStringLiteral("Gamma"), QStringLiteral("flagged, flagpole, flags")},
        {QStringLiteral("index.html"), QStringLiteral("Index"), QStringLiteral("flag flag flag flag flag flag")},
    };
    // c.html has no whole word "flag"; the index is left out; b.html: 1 in
    // the text + 5 for the title.
    EXPECT_EQ(ranked(docs, "FLAG"), (QStringList{"b.html:6", "a.html:2"}));
    EXPECT_EQ(searchhelp(docs, QStringLiteral("FLAG")).at(1).excerpt, QStringLiteral("Flag flag and flags"));
    EXPECT_EQ(ranked(docs, "flag*").value(2), QStringLiteral("c.html:3"));

    // The words of the query side by side count ten more.
    const std::vector<helpdoc> phrase = {
        {QStringLiteral("p.html"), QStringLiteral("P"), QStringLiteral("source source source where within it")},
        {QStringLiteral("q.html"), QStringLiteral("Q"), QStringLiteral("Where within source")},
    };
    EXPECT_EQ(ranked(phrase, "where within source"), (QStringList{"q.html:13", "p.html:5"}));

    // The rarest word of the query decides first: one page with both words
    // twice beats one with a single word many times.
    const std::vector<helpdoc> mixed = {
        {QStringLiteral("m.html"), QStringLiteral("M"), QStringLiteral("census census census census census census flag")},
        {QStringLiteral("n.html"), QStringLiteral("N"), QStringLiteral("census flag census flag")},
    };
    // m.html: 6 + 1 + 10 for the words side by side.
    EXPECT_EQ(ranked(mixed, "census flag").value(1), QStringLiteral("m.html:17"));
    EXPECT_EQ(searchhelp(mixed, QStringLiteral("census flag")).at(0).least, 2);

    // Every word must occur; nothing typed finds nothing.
    EXPECT_EQ(searchhelp(docs, QStringLiteral("flag here")).size(), 1u);
    EXPECT_TRUE(searchhelp(docs, QStringLiteral("flag absent")).empty());
    EXPECT_TRUE(searchhelp(docs, QStringLiteral("  ,. ")).empty());
}

TEST(HelpSearch, ExcerptShowsTheFirstMatchInWholeWords)
{
    QString text = QString(QStringLiteral("word ")).repeated(40) + QStringLiteral("target ") +
                   QString(QStringLiteral("more ")).repeated(60);
    const std::vector<helphit> hits =
        searchhelp({{QStringLiteral("p.html"), QStringLiteral("P"), text.trimmed()}}, QStringLiteral("target"));
    ASSERT_EQ(hits.size(), 1u);
    const QString e = hits[0].excerpt;
    EXPECT_TRUE(e.startsWith(QLatin1String("...word ")) && e.endsWith(QLatin1String(" more...")) &&
                e.contains(QLatin1String(" target "))) << e.toStdString();
}

TEST(HelpSearch, RecordingMethodsFoundWhereAReaderLooks)
{
    const std::vector<helpdoc> docs = readhelp(helpdir());
    ASSERT_EQ(docs.size(), static_cast<size_t>(pages().size()));
    // The recording methods are explained where a reader looks for them.
    const std::vector<helphit> methods = searchhelp(docs, QStringLiteral("where within source"));
    ASSERT_FALSE(methods.empty());
    EXPECT_EQ(methods[0].page, QStringLiteral("recording-methods.html"));
}

#include "app/helptopics.h"

#include <QDir>
#include <QFile>
#include <QHash>
#include <QRegularExpression>

#include <algorithm>
#include <limits>

namespace qm {

const std::vector<helptopic>& helptopics()
{
    static const std::vector<helptopic> topics = {
        {12, QStringLiteral("creating-a-census-entry.html"), QStringLiteral("Help menu \"Creating a Census Entry...\"")},
        {14, QStringLiteral("find.html"), QStringLiteral("Find Individual")},
        {17, QStringLiteral("main-window.html"), QStringLiteral("the main window")},
        {18, QStringLiteral("census-images.html"), QStringLiteral("Census Images")},
        {19, QStringLiteral("attach-images.html"), QStringLiteral("Attach Images to Existing Sources")},
        {20, QStringLiteral("options.html"), QStringLiteral("Quillmark Options")},
        {23, QStringLiteral("add-new-image.html"), QStringLiteral("Add a new image...")},
        {24, QStringLiteral("choose-current-image.html"), QStringLiteral("Choose current image to link")},
        {30, QStringLiteral("birth-details.html"), QStringLiteral("Birth Details")},
        {35, QStringLiteral("census-date-check.html"), QStringLiteral("Census Date Check")},
        {45, QStringLiteral("census-flags.html"), QStringLiteral("Census Flags and Census Flag Date")},
        {55, QStringLiteral("flag-check.html"), QStringLiteral("Flag Check")},
        {60, QStringLiteral("census-coverage.html"), QStringLiteral("Census Coverage")},
    };
    return topics;
}

QString helpfolder()
{
    return QStringLiteral(":/help");
}

QString indexpage()
{
    return QStringLiteral("index.html");
}

QString searchpage()
{
    return QStringLiteral("search.html");
}

QString pagefor(int topic, const QString& command)
{
    if (command.compare(QLatin1String("Index"), Qt::CaseInsensitive) == 0)
        return indexpage();
    if (command.compare(QLatin1String("Search"), Qt::CaseInsensitive) == 0)
        return searchpage();
    for (const helptopic& t : helptopics())
        if (t.topic == topic)
            return t.page;
    return indexpage();
}

namespace {

QString decodeentities(const QString& text)
{
    static const QHash<QString, QString> named = {
        {QStringLiteral("amp"), QStringLiteral("&")},     {QStringLiteral("lt"), QStringLiteral("<")},
        {QStringLiteral("gt"), QStringLiteral(">")},      {QStringLiteral("quot"), QStringLiteral("\"")},
        {QStringLiteral("apos"), QStringLiteral("'")},    {QStringLiteral("nbsp"), QStringLiteral(" ")},
        {QStringLiteral("mdash"), QStringLiteral("-")},   {QStringLiteral("ndash"), QStringLiteral("-")},
        {QStringLiteral("hellip"), QStringLiteral("...")}, {QStringLiteral("rarr"), QStringLiteral("->")},
    };
    static const QRegularExpression entity(QStringLiteral("&(#x?[0-9a-fA-F]+|[a-zA-Z]+);"));
    QString out;
    out.reserve(text.size());
    qsizetype from = 0;
    for (auto it = entity.globalMatch(text); it.hasNext();) {
        const QRegularExpressionMatch m = it.next();
        out += QStringView(text).mid(from, m.capturedStart() - from);
        const QString name = m.captured(1);
        if (name.startsWith(u'#')) {
            bool ok = false;
            const uint code = name.startsWith(QLatin1String("#x"), Qt::CaseInsensitive) ? name.mid(2).toUInt(&ok, 16)
                                                                                           : name.mid(1).toUInt(&ok);
            const char32_t c = code;
            out += ok ? QString::fromUcs4(&c, 1) : m.captured(0);
        } else {
            out += named.value(name, m.captured(0));
        }
        from = m.capturedEnd();
    }
    out += QStringView(text).mid(from);
    return out;
}

QStringList attributevalues(const QString& html, const QString& attributes)
{
    const QRegularExpression re(QStringLiteral("\\b(?:%1)\\s*=\\s*\"([^\"]*)\"").arg(attributes),
                                QRegularExpression::CaseInsensitiveOption);
    QStringList out;
    for (auto it = re.globalMatch(html); it.hasNext();)
        out << decodeentities(it.next().captured(1));
    return out;
}

bool iswordchar(QChar c)
{
    return c.isLetterOrNumber();
}

// Whether the lower-cased word w matches the query word q.
bool matches(const QString& q, const QString& w)
{
    if (q.endsWith(u'*'))
        return w.startsWith(QStringView(q).chopped(1));
    return w == q;
}

int count(const QString& q, const QStringList& words)
{
    return static_cast<int>(std::count_if(words.begin(), words.end(), [&](const QString& w) { return matches(q, w); }));
}

// How often the query words stand next to each other, in their order.
int phrases(const QStringList& query, const QStringList& words)
{
    int n = 0;
    for (qsizetype i = 0; i + query.size() <= words.size(); ++i) {
        qsizetype k = 0;
        while (k < query.size() && matches(query[k], words[i + k]))
            ++k;
        n += k == query.size();
    }
    return n;
}

// Where the first whole-word match of any query word starts in text, or -1.
qsizetype firstmatch(const QString& text, const QStringList& query)
{
    const qsizetype n = text.size();
    for (qsizetype i = 0; i < n;) {
        if (!iswordchar(text[i])) {
            ++i;
            continue;
        }
        qsizetype j = i;
        while (j < n && iswordchar(text[j]))
            ++j;
        const QString w = text.mid(i, j - i).toLower();
        for (const QString& q : query)
            if (matches(q, w))
                return i;
        i = j;
    }
    return -1;
}

QString excerptat(const QString& text, qsizetype at)
{
    constexpr qsizetype before = 60, after = 140;
    qsizetype from = std::max<qsizetype>(0, at - before);
    qsizetype to = std::min(text.size(), at + after);
    // Whole words at both ends.
    while (from > 0 && from < at && iswordchar(text[from - 1]))
        ++from;
    while (to < text.size() && to > at && iswordchar(text[to]))
        --to;
    QString out = text.mid(from, to - from).trimmed();
    if (from > 0)
        out.prepend(QStringLiteral("..."));
    if (to < text.size())
        out += QStringLiteral("...");
    return out;
}

} // namespace

QStringList helpwords(const QString& text)
{
    QStringList out;
    const qsizetype n = text.size();
    for (qsizetype i = 0; i < n;) {
        if (!iswordchar(text[i])) {
            // "*" is kept at the end of a query word (prefix search).
            if (text[i] == u'*' && !out.isEmpty() && i > 0 && iswordchar(text[i - 1]))
                out.back() += u'*';
            ++i;
            continue;
        }
        qsizetype j = i;
        while (j < n && iswordchar(text[j]))
            ++j;
        out << text.mid(i, j - i).toLower();
        i = j;
    }
    return out;
}

helpdoc parsehelp(const QString& page, const QString& html)
{
    helpdoc d;
    d.page = page;
    static const QRegularExpression title(QStringLiteral("<title>(.*?)</title>"),
                                          QRegularExpression::CaseInsensitiveOption |
                                              QRegularExpression::DotMatchesEverythingOption);
    if (const auto m = title.match(html); m.hasMatch())
        d.title = decodeentities(m.captured(1)).simplified();
    static const QRegularExpression hidden(QStringLiteral("<(head|script|style)\\b.*?</\\1>"),
                                           QRegularExpression::CaseInsensitiveOption |
                                               QRegularExpression::DotMatchesEverythingOption);
    static const QRegularExpression tag(QStringLiteral("<[^>]*>"));
    QString body = html;
    body.remove(hidden);
    body.replace(tag, QStringLiteral(" "));
    d.text = decodeentities(body).simplified();
    return d;
}

std::vector<helpdoc> readhelp(const QString& folder)
{
    std::vector<helpdoc> docs;
    const QDir dir(folder);
    for (const QString& name : dir.entryList({QStringLiteral("*.html")}, QDir::Files, QDir::Name)) {
        QFile f(dir.filePath(name));
        if (f.open(QIODevice::ReadOnly))
            docs.push_back(parsehelp(name, QString::fromUtf8(f.readAll())));
    }
    return docs;
}

QStringList helplinks(const QString& html)
{
    return attributevalues(html, QStringLiteral("href"));
}

QStringList helpanchors(const QString& html)
{
    return attributevalues(html, QStringLiteral("id|name"));
}

std::vector<helphit> searchhelp(const std::vector<helpdoc>& docs, const QString& query)
{
    const QStringList phrase = helpwords(query);
    QStringList words = phrase;
    words.removeDuplicates();
    std::vector<helphit> hits;
    if (words.isEmpty())
        return hits;
    for (const helpdoc& d : docs) {
        if (d.page == indexpage() || d.page == searchpage())
            continue;
        const QStringList textwords = helpwords(d.text);
        const QStringList titlewords = helpwords(d.title);
        int score = 0;
        int least = std::numeric_limits<int>::max();
        for (const QString& q : words) {
            const int n = count(q, textwords);
            if (n == 0) {
                least = 0;
                break;
            }
            const int weighed = n + 5 * count(q, titlewords);
            score += weighed;
            least = std::min(least, weighed);
        }
        if (least == 0)
            continue;
        if (phrase.size() > 1)
            score += 10 * phrases(phrase, textwords);
        hits.push_back({d.page, d.title, score, least, excerptat(d.text, firstmatch(d.text, words))});
    }
    // A page that has every word often beats one that has one common word
    // very often ("census flag": the flag pages before the pages about censuses).
    std::stable_sort(hits.begin(), hits.end(), [](const helphit& a, const helphit& b) {
        return a.least != b.least ? a.least > b.least : a.score > b.score;
    });
    return hits;
}

} // namespace qm

#include "writer/preview.h"

#include "model/filechanged.h"
#include "platform/linereader.h"
#include "writer/rewritechecks.h"

#include <QFile>
#include <QFileInfo>

#include <algorithm>
#include <deque>

namespace qm {

namespace {

// Beyond this many differing lines in one record, the record is shown as all
// its old lines taken away and all its new ones added (no change made by
// Quillmark comes near it).
constexpr int maxdifference = 4000;

bool startsrecord(std::string_view line)
{
    size_t i = 0;
    while (i < line.size() && (line[i] == ' ' || line[i] == '\t'))
        ++i;
    return i < line.size() && line[i] == '0';
}

// One record's lines, held in one buffer that keeps its room from record to record.
struct record {
    std::string text;
    std::vector<size_t> ends;

    void clear()
    {
        text.clear();
        ends.clear();
    }
    void add(std::string_view line)
    {
        text.append(line);
        ends.push_back(text.size());
    }
    size_t size() const { return ends.size(); }
    bool empty() const { return ends.empty(); }
    std::string_view line(size_t i) const
    {
        const size_t from = i == 0 ? 0 : ends[i - 1];
        return std::string_view(text).substr(from, ends[i] - from);
    }
    bool operator==(const record& o) const { return ends == o.ends && text == o.text; }
};

// The records of a file's bytes, one after the other.
class recordreader {
public:
    explicit recordreader(std::string_view bytes) { in_.openbytes(bytes); }

    bool next(record& r)
    {
        r.clear();
        if (pending_) {
            r.add(held_);
            pending_ = false;
        }
        std::string_view line;
        while (in_.next(line)) {
            ++read_;
            otherends_ = otherends_ || in_.lineend() != "\r\n";
            if (!r.empty() && startsrecord(line)) {
                held_.assign(line);
                pending_ = true;
                return true;
            }
            r.add(line);
        }
        return !r.empty();
    }
    textencoding encoding() const { return in_.encoding(); }
    bool otherends() const { return otherends_; }

private:
    linereader in_;
    std::string held_;
    bool pending_ = false;
    bool otherends_ = false;
    int64_t read_ = 0;
};

struct op {
    difftag tag;
    size_t index; // into the old record for same and removed, the new one for added
};

// The shortest edit script between two records' lines (Myers' O(ND) algorithm),
// after their common first and last lines are set aside.
std::vector<op> linediff(const record& a, const record& b)
{
    const size_t n = a.size(), m = b.size();
    size_t pre = 0;
    while (pre < n && pre < m && a.line(pre) == b.line(pre))
        ++pre;
    size_t post = 0;
    while (post < n - pre && post < m - pre && a.line(n - 1 - post) == b.line(m - 1 - post))
        ++post;
    const int an = static_cast<int>(n - pre - post), bn = static_cast<int>(m - pre - post);
    const auto same = [&](int x, int y) {
        return a.line(pre + static_cast<size_t>(x)) == b.line(pre + static_cast<size_t>(y));
    };

    std::vector<op> middle; // built backwards
    const int max = an + bn;
    std::vector<int> v(static_cast<size_t>(2 * max + 3), 0);
    const auto at = [&](int k) -> int& { return v[static_cast<size_t>(k + max + 1)]; };
    std::vector<std::vector<int>> trace; // before each step d: v over k = -d-1 .. d+1
    int found = -1;
    for (int d = 0; d <= std::min(max, maxdifference) && found < 0; ++d) {
        trace.emplace_back(v.begin() + (max - d), v.begin() + (max + d + 3));
        for (int k = -d; k <= d; k += 2) {
            int x = k == -d || (k != d && at(k - 1) < at(k + 1)) ? at(k + 1) : at(k - 1) + 1;
            int y = x - k;
            while (x < an && y < bn && same(x, y)) {
                ++x;
                ++y;
            }
            at(k) = x;
            if (x >= an && y >= bn) {
                found = d;
                break;
            }
        }
    }
    if (found < 0) {
        for (int y = bn - 1; y >= 0; --y)
            middle.push_back({difftag::added, pre + static_cast<size_t>(y)});
        for (int x = an - 1; x >= 0; --x)
            middle.push_back({difftag::removed, pre + static_cast<size_t>(x)});
    } else {
        int x = an, y = bn;
        for (int d = found; d >= 0; --d) {
            const std::vector<int>& t = trace[static_cast<size_t>(d)];
            const auto tv = [&](int k) { return t[static_cast<size_t>(k + d + 1)]; };
            const int k = x - y;
            const int prevk = k == -d || (k != d && tv(k - 1) < tv(k + 1)) ? k + 1 : k - 1;
            const int prevx = tv(prevk), prevy = prevx - prevk;
            while (x > prevx && y > prevy) {
                --x;
                --y;
                middle.push_back({difftag::same, pre + static_cast<size_t>(x)});
            }
            if (d > 0)
                middle.push_back(x == prevx ? op{difftag::added, pre + static_cast<size_t>(prevy)}
                                            : op{difftag::removed, pre + static_cast<size_t>(prevx)});
            x = prevx;
            y = prevy;
        }
    }

    std::vector<op> out;
    out.reserve(pre + middle.size() + post);
    for (size_t i = 0; i < pre; ++i)
        out.push_back({difftag::same, i});
    out.insert(out.end(), middle.rbegin(), middle.rend());
    for (size_t i = 0; i < post; ++i)
        out.push_back({difftag::same, n - post + i});
    return out;
}

QString decoded(std::string_view line, textencoding enc)
{
    return qs(toutf8(line, enc));
}

// The lines the same in both files between two changed records.
class gapcollector {
public:
    void add(const record& r, textencoding enc)
    {
        for (size_t i = 0; i < r.size() && head_.size() < 2 * previewcontext; ++i)
            head_.push_back(decoded(r.line(i), enc));
        const size_t last = std::min<size_t>(r.size(), previewcontext);
        for (size_t i = r.size() - last; i < r.size(); ++i) {
            tail_.emplace_back(r.line(i));
            if (tail_.size() > previewcontext)
                tail_.pop_front();
        }
        count_ += static_cast<int64_t>(r.size());
    }
    previewgap take(textencoding enc)
    {
        previewgap g;
        g.count = count_;
        g.head = std::move(head_);
        if (count_ > 2 * previewcontext) {
            g.head.resize(previewcontext);
            for (const std::string& t : tail_)
                g.tail.push_back(decoded(t, enc));
        }
        *this = gapcollector();
        return g;
    }

private:
    int64_t count_ = 0;
    std::vector<QString> head_;
    std::deque<std::string> tail_;
};

void comparefiles(std::string_view oldbytes, std::string_view newbytes, savepreview& p)
{
    recordreader before(oldbytes), after(newbytes);
    const textencoding enc = before.encoding();
    record a, b;
    bool hasa = before.next(a), hasb = after.next(b);
    int64_t oldline = 1, newline = 1;
    gapcollector gap;
    const auto changed = [&](previewrecord&& r) {
        p.gaps.push_back(gap.take(enc));
        p.records.push_back(std::move(r));
    };
    while (hasa || hasb) {
        if (hasa && hasb && a.line(0) == b.line(0)) {
            if (a == b) {
                gap.add(a, enc);
            } else {
                previewrecord r;
                r.header = decoded(b.line(0), enc);
                r.oldline = oldline;
                r.newline = newline;
                for (const op& o : linediff(a, b))
                    r.lines.push_back({o.tag, decoded(o.tag == difftag::added ? b.line(o.index) : a.line(o.index), enc)});
                changed(std::move(r));
            }
            oldline += static_cast<int64_t>(a.size());
            newline += static_cast<int64_t>(b.size());
            hasa = before.next(a);
            hasb = after.next(b);
            continue;
        }
        // A change only adds records: a record of the new file that is not the
        // next one of the old file is new. Old records left over (which no
        // change makes) are shown as taken away.
        previewrecord r;
        const bool added = hasb;
        const record& whole = added ? b : a;
        r.header = decoded(whole.line(0), enc);
        r.added = added;
        r.oldline = added ? 0 : oldline;
        r.newline = added ? newline : 0;
        for (size_t i = 0; i < whole.size(); ++i)
            r.lines.push_back({added ? difftag::added : difftag::removed, decoded(whole.line(i), enc)});
        changed(std::move(r));
        if (added) {
            newline += static_cast<int64_t>(b.size());
            hasb = after.next(b);
        } else {
            oldline += static_cast<int64_t>(a.size());
            hasa = before.next(a);
        }
    }
    p.gaps.push_back(gap.take(enc));
    p.lineends = before.otherends();
}

bool anyimages(const rewriterequest& rq)
{
    return (rq.mode == rewritemode::censusentry || rq.mode == rewritemode::attachimages)
        && !rq.entry.chosenimages.empty();
}

} // namespace

savepreview previewchange(const gedcomindex& index, const settings& s, const rewriterequest& request)
{
    savepreview p;
    p.gedcomfile = index.gedcomfile;
    const auto changed = [&] {
        p.changed = true;
        p.message = changedonsavemessage(index.gedcomfile, anyimages(request));
        return p;
    };
    // The refusals the save makes before it touches the file.
    p.message = checkencodable(request, s, index.encoding);
    if (p.message.isEmpty())
        p.message = checkidentifiers(index, s, request);
    if (!p.message.isEmpty())
        return p;
    if (filechanged(index))
        return changed();

    QFile f(index.gedcomfile);
    if (!f.open(QIODevice::ReadOnly)) {
        p.message = QStringLiteral("The family file %1 could not be read (%2).")
                        .arg(QFileInfo(index.gedcomfile).filePath(), f.errorString());
        return p;
    }
    QByteArray copy;
    std::string_view bytes;
    if (f.size() > 0) {
        if (const uchar* mapped = f.map(0, f.size()))
            bytes = std::string_view(reinterpret_cast<const char*>(mapped), static_cast<size_t>(f.size()));
    }
    if (bytes.empty() && f.size() > 0) {
        copy = f.readAll();
        bytes = std::string_view(copy.constData(), static_cast<size_t>(copy.size()));
    }
    p.rewrite = rewritebytes(bytes, p.newcontent, index, s, request);
    if (!p.rewrite.ok) {
        p.message = p.rewrite.message;
        return p;
    }
    // What was read must be the file as loaded, as the save requires.
    if (filechanged(index)) {
        p.newcontent.clear();
        return changed();
    }
    comparefiles(bytes, p.newcontent, p);
    p.ok = true;
    return p;
}

savepreview previewentry(const gedcomindex& index, const settings& s, const censusentry& entry)
{
    rewriterequest rq;
    rq.mode = rewritemode::censusentry;
    rq.entry = entry;
    return previewchange(index, s, rq);
}

namespace {

// One line of the unified diff being built: a line of either file, or a run
// of lines left out.
struct difflinepos {
    char mark;               // ' ', '-', '+'; 0 for lines left out
    const QString* text = nullptr;
    int64_t skipped = 0;     // lines left out
    const QString* section = nullptr; // the record it belongs to (changed lines)
};

QString range(int64_t start, int64_t count)
{
    // A range of one line is written without its count; an empty one names the line before it.
    if (count == 1)
        return QString::number(start);
    return QStringLiteral("%1,%2").arg(count == 0 ? start - 1 : start).arg(count);
}

} // namespace

QString unifieddiff(const savepreview& p)
{
    if (p.records.empty())
        return QString();
    std::vector<difflinepos> lines;
    const auto context = [&](const QString& t) { lines.push_back({' ', &t, 0, nullptr}); };
    const auto leftout = [&](int64_t count) {
        if (count > 0)
            lines.push_back({0, nullptr, count, nullptr});
    };
    // A gap before the first record shows its last lines, one after the last
    // record its first lines, one between records all of its lines when they
    // are few, else its first and last lines.
    const auto gaplines = [&](const previewgap& g, bool first, bool last) {
        const size_t c = previewcontext;
        if (first) {
            const size_t shown = std::min(c, g.tail.empty() ? g.head.size() : g.tail.size());
            leftout(g.count - static_cast<int64_t>(shown));
            const std::vector<QString>& from = g.tail.empty() ? g.head : g.tail;
            for (size_t k = from.size() - shown; k < from.size(); ++k)
                context(from[k]);
            return;
        }
        for (size_t k = 0; k < g.head.size() && (!last || k < c); ++k)
            context(g.head[k]);
        if (last || g.tail.empty())
            return;
        leftout(g.count - static_cast<int64_t>(g.head.size() + g.tail.size()));
        for (const QString& t : g.tail)
            context(t);
    };
    for (size_t i = 0; i < p.records.size(); ++i) {
        gaplines(p.gaps[i], i == 0, false);
        for (const diffline& l : p.records[i].lines)
            lines.push_back({l.tag == difftag::same ? ' ' : l.tag == difftag::removed ? '-' : '+', &l.text, 0,
                             &p.records[i].header});
    }
    gaplines(p.gaps.back(), false, true);

    const QString name = QFileInfo(p.gedcomfile).fileName();
    QString out;
    if (p.lineends)
        out += QStringLiteral("Every line end of %1 is written as CR LF: lines whose ends change only are not shown.\n")
                   .arg(name);
    out += QStringLiteral("--- a/%1\n+++ b/%1\n").arg(name);

    // Hunks: each change with three lines of context on either side, changes
    // closer than twice that joined into one hunk; a run of lines left out
    // always ends a hunk.
    int64_t oldno = 1, newno = 1; // numbers of the next old and new lines
    const size_t n = lines.size();
    const auto ischange = [&](size_t i) { return lines[i].mark == '-' || lines[i].mark == '+'; };
    size_t i = 0;
    while (i < n) {
        if (!ischange(i)) {
            if (lines[i].mark == 0) {
                oldno += lines[i].skipped;
                newno += lines[i].skipped;
            } else {
                ++oldno;
                ++newno;
            }
            ++i;
            continue;
        }
        // Back up over the context before the change.
        size_t start = i;
        while (start > 0 && i - start < previewcontext && lines[start - 1].mark == ' ')
            --start;
        int64_t oldstart = oldno - static_cast<int64_t>(i - start), newstart = newno - static_cast<int64_t>(i - start);
        size_t last = i, end = i;
        while (end < n && lines[end].mark != 0 && end - last <= 2 * previewcontext + 1) {
            if (ischange(end))
                last = end;
            ++end;
        }
        end = std::min(end, last + previewcontext + 1);
        int64_t oldcount = 0, newcount = 0;
        QString body;
        for (size_t k = start; k < end; ++k) {
            const char mark = lines[k].mark;
            oldcount += mark != '+';
            newcount += mark != '-';
            body += QLatin1Char(mark) + *lines[k].text + QLatin1Char('\n');
        }
        out += QStringLiteral("@@ -%1 +%2 @@ %3\n")
                   .arg(range(oldstart, oldcount), range(newstart, newcount), *lines[i].section);
        out += body;
        oldno = oldstart + oldcount;
        newno = newstart + newcount;
        i = end;
    }
    return out;
}

} // namespace qm

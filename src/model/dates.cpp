#include "model/dates.h"

#include "model/gedcomindex.h"
#include "platform/encoding.h"

#include <array>

namespace qm {

namespace {

constexpr std::array<const char*, 12> monthnames = {"JANUARY", "FEBRUARY", "MARCH",     "APRIL",
                                                    "MAY",     "JUNE",     "JULY",      "AUGUST",
                                                    "SEPTEMBER", "OCTOBER", "NOVEMBER", "DECEMBER"};

bool isasciidigit(QChar c)
{
    return c >= u'0' && c <= u'9';
}

bool alldigits(QStringView s)
{
    if (s.isEmpty())
        return false;
    for (QChar c : s)
        if (!isasciidigit(c))
            return false;
    return true;
}

bool allletters(QStringView s)
{
    if (s.isEmpty())
        return false;
    for (QChar c : s)
        if (!c.isLetter())
            return false;
    return true;
}

// 1..12 for an English month name or a beginning of one of at least three
// letters ("Sep", "Sept", "September"); 0 otherwise.
int monthnumber(QStringView word)
{
    if (word.size() < 3)
        return 0;
    for (int m = 0; m < 12; ++m) {
        QLatin1StringView full(monthnames[m]);
        if (word.size() <= full.size() && word.compare(full.first(word.size()), Qt::CaseInsensitive) == 0)
            return m + 1;
    }
    return 0;
}

std::optional<QDate> makedate(int year, int month, int day)
{
    if (year < 1 || !QDate::isValid(year, month, day))
        return std::nullopt;
    return QDate(year, month, day);
}

bool isseparator(QChar c)
{
    return c == u' ' || c == u'\t' || c == u'/' || c == u'-' || c == u'.' || c == u',';
}

struct token {
    QStringView text;
    bool digits = false;
    int value() const { return text.toInt(); }
    bool isyear() const { return digits && text.size() == 4; }
    bool isdayormonth() const { return digits && text.size() <= 2; }
};

// Splits a date text into at most three runs of digits or of letters. False
// for any other character or a fourth run.
bool tokenize(QStringView s, std::array<token, 3>& tokens, int& count)
{
    count = 0;
    qsizetype i = 0;
    while (i < s.size()) {
        QChar c = s[i];
        if (isseparator(c)) {
            ++i;
            continue;
        }
        bool digit = isasciidigit(c);
        if (!digit && !c.isLetter())
            return false;
        qsizetype start = i;
        while (i < s.size() && (digit ? isasciidigit(s[i]) : s[i].isLetter()))
            ++i;
        if (count == 3)
            return false;
        tokens[count++] = {s.sliced(start, i - start), digit};
    }
    return true;
}

} // namespace

dateorder localedateorder(const QLocale& locale)
{
    const QString format = locale.dateFormat(QLocale::ShortFormat);
    qsizetype d = -1, m = -1, y = -1;
    bool quoted = false;
    for (qsizetype i = 0; i < format.size(); ++i) {
        QChar c = format[i];
        if (c == u'\'')
            quoted = !quoted;
        else if (quoted)
            continue;
        else if (c == u'd' && d < 0)
            d = i;
        else if (c == u'M' && m < 0)
            m = i;
        else if (c == u'y' && y < 0)
            y = i;
    }
    if (d < 0 || m < 0 || y < 0)
        return dateorder::dmy;
    if (y < m && y < d)
        return dateorder::ymd;
    return m < d ? dateorder::mdy : dateorder::dmy;
}

std::optional<QDate> recognisedate(QStringView text, dateorder order)
{
    std::array<token, 3> t;
    int n = 0;
    if (!tokenize(text.trimmed(), t, n))
        return std::nullopt;
    if (n == 2) {
        // month year
        if (!t[0].digits && t[1].isyear())
            if (int m = monthnumber(t[0].text))
                return makedate(t[1].value(), m, 1);
        return std::nullopt;
    }
    if (n != 3)
        return std::nullopt;
    if (t[0].isdayormonth() && !t[1].digits && t[2].isyear()) {
        if (int m = monthnumber(t[1].text))
            return makedate(t[2].value(), m, t[0].value());
        return std::nullopt;
    }
    if (!t[0].digits && t[1].isdayormonth() && t[2].isyear()) {
        if (int m = monthnumber(t[0].text))
            return makedate(t[2].value(), m, t[1].value());
        return std::nullopt;
    }
    if (t[0].isyear() && t[1].isdayormonth() && t[2].isdayormonth())
        return makedate(t[0].value(), t[1].value(), t[2].value());
    if (t[0].isdayormonth() && t[1].isdayormonth() && t[2].isyear()) {
        switch (order) {
        case dateorder::dmy:
            return makedate(t[2].value(), t[1].value(), t[0].value());
        case dateorder::mdy:
            return makedate(t[2].value(), t[0].value(), t[1].value());
        case dateorder::ymd:
            break;
        }
    }
    return std::nullopt;
}

std::optional<QDate> recognisedate(QStringView text)
{
    return recognisedate(text, localedateorder());
}

QString englishmonth(int month)
{
    if (month < 1 || month > 12)
        return {};
    return QLatin1StringView(monthnames[month - 1]).first(3).toString();
}

QString formatgedcomdate(const QDate& date)
{
    if (!date.isValid())
        return {};
    return QStringLiteral("%1 %2 %3")
        .arg(date.day(), 2, 10, QLatin1Char('0'))
        .arg(englishmonth(date.month()))
        .arg(date.year(), 4, 10, QLatin1Char('0'));
}

QString formatgedcommonth(const QDate& date)
{
    if (!date.isValid())
        return {};
    return QStringLiteral("%1 %2").arg(englishmonth(date.month())).arg(date.year(), 4, 10, QLatin1Char('0'));
}

QString formatgedcomtime(const QTime& time)
{
    return time.toString(QStringLiteral("hh:mm:ss"));
}

int completedyears(const QDate& birth, const QDate& census)
{
    int years = census.year() - birth.year();
    if (years > 0
        && (census.month() < birth.month() || (census.month() == birth.month() && census.day() < birth.day())))
        --years;
    return years;
}

namespace {

struct qualifier {
    const char* word;
    const char* prefix; // nullptr: "in " or "on " by the first date word
    const char* suffix;
};

constexpr std::array<qualifier, 8> qualifiers = {{
    {"ABT", nullptr, "(approx.)"},
    {"EST", nullptr, "(estimated)"},
    {"CAL", nullptr, "(calculated)"},
    {"BET", "between ", nullptr},
    {"AFT", "after ", nullptr},
    {"BEF", "before ", nullptr},
    {"FROM", "during a period from ", nullptr},
    {"TO", "during a period to ", nullptr},
}};

// Splits at every single space, into at most 12 words; the twelfth holds the
// rest of the text.
QList<QStringView> splitwords(QStringView s)
{
    QList<QStringView> words;
    qsizetype start = 0;
    while (words.size() < 11) {
        qsizetype space = s.indexOf(u' ', start);
        if (space < 0)
            break;
        words.append(s.sliced(start, space - start));
        start = space + 1;
    }
    words.append(s.sliced(start));
    return words;
}

QString styleword(QStringView word)
{
    if (word.size() >= 2 && !isasciidigit(word[0])) {
        if (word == u"AND")
            return QStringLiteral("and");
        return word.first(1).toString() + word.sliced(1).toString().toLower();
    }
    return word.toString().toLower();
}

// The earliest and latest birth dates a plain date's words allow.
bool birthrange(const QList<QStringView>& used, dateorder order, QDate& earliest, QDate& latest)
{
    if (used.isEmpty())
        return false;
    QStringView last = used.back();
    if (last.size() < 4 || !alldigits(last.first(4)))
        return false;
    const QStringView yeartext = last.first(4);
    const int year = yeartext.toInt();
    std::optional<QDate> first, final;
    if (used.size() == 1) {
        first = makedate(year, 1, 1);
        final = makedate(year, 12, 31);
    } else if (used.size() == 2) {
        QStringView month = used[0];
        if (month.size() != 3 || !allletters(month))
            return false;
        int m = monthnumber(month);
        first = m ? makedate(year, m, 1) : std::nullopt;
        if (first)
            final = makedate(year, m, first->daysInMonth());
    } else if (used.size() == 3) {
        QStringView day = used[0];
        if (!alldigits(day) || day.size() > 2 || day.toInt() < 1 || day.toInt() > 31)
            return false;
        QString whole = day.toString();
        whole += u' ';
        whole += used[1];
        whole += u' ';
        whole += yeartext;
        first = recognisedate(whole, order);
        final = first;
    }
    if (!first || !final)
        return false;
    earliest = *first;
    latest = *final;
    return true;
}

} // namespace

namespace {

// A date upper-cased and split into words, its qualifier recognised.
struct datewords {
    QString upper;
    QList<QStringView> words; // views into upper
    const qualifier* q = nullptr;
    QList<QStringView> used;  // the words after the qualifier
    bool canage = false;      // plain, ABT, EST or CAL
};

void splitdate(QStringView date, datewords& w)
{
    w.upper = date.trimmed().toString().toUpper();
    w.words = splitwords(w.upper);
    for (const qualifier& candidate : qualifiers)
        if (w.words[0] == QLatin1StringView(candidate.word))
            w.q = &candidate;
    w.used = w.q ? w.words.sliced(1) : w.words;
    w.canage = !w.q || !w.q->prefix;
}

} // namespace

datephraseyears dateyears(QStringView date, const std::optional<QDate>& census, dateorder order)
{
    datephraseyears r;
    datewords w;
    splitdate(date, w);
    QDate earliest, latest;
    if (w.canage && census && census->isValid() && birthrange(w.used, order, earliest, latest)) {
        r.agecomputed = true;
        r.earliestyear = earliest.year();
        r.latestyear = latest.year();
    }
    return r;
}

std::optional<dayspan> datespan(QStringView date, dateorder order)
{
    datewords w;
    splitdate(date, w);
    dayspan r;
    QDate earliest, latest;
    if (w.canage) {
        if (!birthrange(w.used, order, earliest, latest))
            return std::nullopt;
        r.earliest = earliest;
        r.latest = latest;
        r.approximate = w.q != nullptr;
        return r;
    }
    r.bounded = true;
    const QLatin1StringView q(w.q->word);
    if (q == QLatin1StringView("BET") || q == QLatin1StringView("FROM")) {
        const qsizetype to = w.used.indexOf(QStringView(q == QLatin1StringView("BET") ? u"AND" : u"TO"));
        const QList<QStringView> first = to < 0 ? w.used : w.used.first(to);
        if (!birthrange(first, order, earliest, latest))
            return std::nullopt;
        r.earliest = earliest;
        if (to < 0)
            return q == QLatin1StringView("BET") ? std::nullopt : std::optional<dayspan>(r);
        if (!birthrange(w.used.sliced(to + 1), order, earliest, latest))
            return std::nullopt;
        r.latest = latest;
        return r;
    }
    if (!birthrange(w.used, order, earliest, latest))
        return std::nullopt;
    if (q == QLatin1StringView("AFT"))
        r.earliest = latest.addDays(1);
    else if (q == QLatin1StringView("BEF"))
        r.latest = earliest.addDays(-1);
    else // TO
        r.latest = latest;
    return r;
}

datephraseresult datephrase(QStringView date, const std::optional<QDate>& census, dateorder order)
{
    datephraseresult r;
    datewords w;
    splitdate(date, w);
    const qualifier* q = w.q;
    const QList<QStringView>& used = w.used;
    const bool canage = w.canage;

    QString prefix;
    if (canage) {
        QStringView first = used.isEmpty() ? QStringView() : used[0];
        prefix = first.size() > 2 || !alldigits(first) ? QStringLiteral("in ") : QStringLiteral("on ");
    } else {
        prefix = QLatin1StringView(q->prefix);
    }
    r.phrase = prefix;
    for (QStringView w : used) {
        r.phrase += styleword(w);
        r.phrase += u' ';
    }

    QDate earliest, latest;
    if (canage && census && census->isValid() && birthrange(used, order, earliest, latest)) {
        r.agecomputed = true;
        r.earliestyear = earliest.year();
        r.latestyear = latest.year();
        const int a = completedyears(latest, *census);
        const int b = completedyears(earliest, *census);
        r.agephrase = QStringLiteral(" and in this census would be aged ") + QString::number(a);
        if (b != a)
            r.agephrase += QStringLiteral(" or ") + QString::number(b);
    }

    if (q && q->suffix) {
        const QLatin1StringView suffix(q->suffix);
        if (!r.agephrase.isEmpty())
            r.agephrase += u' ' + suffix;
        r.phrase = r.phrase.trimmed() + u' ' + suffix;
    }
    r.phrase = r.phrase.trimmed();
    return r;
}

datephraseresult datephrase(QStringView date, const QString& censusdatetext)
{
    const dateorder order = localedateorder();
    return datephrase(date, recognisedate(censusdatetext, order), order);
}

QString personinfo(const personrec& person, const std::optional<QDate>& census, dateorder order)
{
    if (!person.hasbirthdate && !person.hasbirthplace)
        return {};
    const QString name = qs(person.name);
    QString line;
    const qsizetype comma = name.indexOf(u',');
    if (comma >= 0) {
        const QString given = name.sliced(comma + 1).trimmed();
        const QString surname = name.first(comma).trimmed();
        line = given.isEmpty() ? surname : given + u' ' + surname;
    } else {
        line = name.isEmpty() ? QStringLiteral("[No Name]") : name;
    }
    datephraseresult born;
    if (person.hasbirthdate) {
        born = datephrase(qs(person.birthdate), census, order);
        line += QStringLiteral(" was born ") + born.phrase;
    }
    if (person.hasbirthplace)
        line += (person.hasbirthdate ? QStringLiteral(" in ") : QStringLiteral(" was born in "))
              + qs(person.birthplace).trimmed();
    if (born.agecomputed)
        line += born.agephrase;
    return line + u'.';
}

QString personinfo(const personrec& person, const QString& censusdatetext)
{
    const dateorder order = localedateorder();
    return personinfo(person, recognisedate(censusdatetext, order), order);
}

datecheck validdate(const QString& text, const QString& officialdate, dateorder order)
{
    datecheck r;
    const std::optional<QDate> typed = recognisedate(text, order);
    if (!typed)
        return r;
    r.isdate = true;
    if (text == officialdate)
        return r;
    // The official day keeps the official spelling, so that the entry's events
    // match the census table wherever dates are compared as texts.
    const std::optional<QDate> official = recognisedate(officialdate, order);
    const QString normal = official && *official == *typed ? officialdate : formatgedcomdate(*typed);
    if (normal != text)
        r.newtext = normal;
    return r;
}

datecheck validdate(const QString& text, const QString& officialdate)
{
    return validdate(text, officialdate, localedateorder());
}

} // namespace qm

#include "model/dayrange.h"

#include <algorithm>
#include <array>

namespace qm {

namespace {

// Two years, the margin of an approximate date.
constexpr daynumber aboutdays = 731;

char upper(char c)
{
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c;
}

bool sameword(std::string_view w, std::string_view upperword)
{
    if (w.size() != upperword.size())
        return false;
    for (size_t i = 0; i < w.size(); ++i)
        if (upper(w[i]) != upperword[i])
            return false;
    return true;
}

bool isdigits(std::string_view w)
{
    return !w.empty() && std::all_of(w.begin(), w.end(), [](char c) { return c >= '0' && c <= '9'; });
}

int number(std::string_view w)
{
    int v = 0;
    for (char c : w)
        v = v * 10 + (c - '0');
    return v;
}

// 1..12 for an English month name or its first three letters, else 0.
int monthof(std::string_view w)
{
    static constexpr std::array<std::string_view, 12> names = {"JANUARY", "FEBRUARY", "MARCH",     "APRIL",
                                                               "MAY",     "JUNE",     "JULY",      "AUGUST",
                                                               "SEPTEMBER", "OCTOBER", "NOVEMBER", "DECEMBER"};
    if (w.size() < 3)
        return 0;
    for (size_t m = 0; m < names.size(); ++m)
        if (sameword(w, names[m].substr(0, 3)) || sameword(w, names[m]))
            return static_cast<int>(m) + 1;
    return 0;
}

int daysinmonth(int year, int month)
{
    static constexpr std::array<int, 12> days = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    const bool leap = (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
    return month == 2 && leap ? 29 : days[static_cast<size_t>(month - 1)];
}

// The words of a date, split at spaces and tabs.
class words {
public:
    explicit words(std::string_view s) : s_(s) { advance(); }
    bool atend() const { return word_.empty(); }
    std::string_view word() const { return word_; }
    void next() { advance(); }

private:
    void advance()
    {
        while (at_ < s_.size() && (s_[at_] == ' ' || s_[at_] == '\t'))
            ++at_;
        const size_t start = at_;
        while (at_ < s_.size() && s_[at_] != ' ' && s_[at_] != '\t')
            ++at_;
        word_ = s_.substr(start, at_ - start);
    }
    std::string_view s_;
    size_t at_ = 0;
    std::string_view word_;
};

// A year: "1881", or "1750/51" (the later year).
bool yearof(std::string_view w, int& year)
{
    const size_t slash = w.find('/');
    const std::string_view main = w.substr(0, slash);
    if (!isdigits(main) || main.size() > 4)
        return false;
    year = number(main);
    if (slash != std::string_view::npos) {
        const std::string_view dual = w.substr(slash + 1);
        if (!isdigits(dual) || dual.size() != 2)
            return false;
        ++year;
    }
    return year >= 1;
}

struct onedate {
    daynumber first = 0, last = 0;
    int year = 0;
};

// One date of the words, from the current word on; false when they hold none.
bool readdate(words& w, onedate& d)
{
    // A calendar escape ("@#DJULIAN@", "@#DFRENCH R@") goes up to its closing "@".
    if (w.word().substr(0, 2) == "@#") {
        while (!w.atend() && (w.word().size() < 3 || w.word().back() != '@'))
            w.next();
        w.next();
    }
    int day = -1, month = 0, lastmonth = 0, year = 0; // day -1: none written
    const std::string_view a = w.word();
    if (yearof(a, year)) {
        w.next();
        month = 1;
        lastmonth = 12;
        if (const int m = isdigits(a) && a.size() <= 2 ? monthof(w.word()) : 0; m != 0) {
            // "3 APR 1881": what was read as a year is the day.
            day = number(a);
            month = lastmonth = m;
            w.next();
            if (!yearof(w.word(), year))
                return false;
            w.next();
        }
    } else if ((month = monthof(a)) != 0) {
        lastmonth = month;
        w.next();
        if (!yearof(w.word(), year))
            return false;
        w.next();
    } else if (a.size() == 2 && upper(a[0]) == 'Q' && a[1] >= '1' && a[1] <= '4') {
        month = (a[1] - '1') * 3 + 1;
        lastmonth = month + 2;
        w.next();
        if (!yearof(w.word(), year))
            return false;
        w.next();
    } else {
        return false;
    }
    if (sameword(w.word(), "B.C.") || sameword(w.word(), "BC") || sameword(w.word(), "BCE"))
        return false;
    if (day != -1 && (day < 1 || day > daysinmonth(year, month)))
        return false;
    d.year = year;
    d.first = daynumberof(year, month, day != -1 ? day : 1);
    d.last = daynumberof(year, lastmonth, day != -1 ? day : daysinmonth(year, lastmonth));
    return true;
}

} // namespace

daynumber daynumberof(int year, int month, int day)
{
    year -= month <= 2;
    const int era = (year >= 0 ? year : year - 399) / 400;
    const int yoe = year - era * 400;
    const int doy = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
    const int doe = yoe * 365 + yoe / 4 - yoe / 100 + doy;
    return era * 146097 + doe;
}

dayrange readdayrange(std::string_view date)
{
    dayrange r;
    words w(date);
    enum class qual { none, about, before, after, between, from, to } q = qual::none;
    const std::string_view first = w.word();
    if (sameword(first, "ABT") || sameword(first, "EST") || sameword(first, "CAL"))
        q = qual::about;
    else if (sameword(first, "BEF"))
        q = qual::before;
    else if (sameword(first, "AFT"))
        q = qual::after;
    else if (sameword(first, "BET"))
        q = qual::between;
    else if (sameword(first, "FROM"))
        q = qual::from;
    else if (sameword(first, "TO") || sameword(first, "INT"))
        q = qual::to;
    if (q != qual::none)
        w.next();

    onedate x, y;
    if (!readdate(w, x))
        return r;
    r.year = x.year;
    r.first = x.first;
    r.last = x.last;
    switch (q) {
    case qual::none:
    case qual::to:
        break;
    case qual::about:
        r.first = x.first - aboutdays;
        r.last = x.last + aboutdays;
        break;
    case qual::before:
        r.first = nodaybefore;
        r.last = x.first - 1;
        break;
    case qual::after:
        r.first = x.last + 1;
        r.last = nodayafter;
        break;
    case qual::between:
        if (!sameword(w.word(), "AND"))
            return r;
        w.next();
        if (!readdate(w, y))
            return r;
        r.first = std::min(x.first, y.first);
        r.last = std::max(x.last, y.last);
        break;
    case qual::from:
        if (sameword(w.word(), "TO")) {
            w.next();
            if (!readdate(w, y))
                return r;
            r.period = true;
            r.first = std::min(x.first, y.first);
            r.last = std::max(x.last, y.last);
            r.fromlast = x.last;
            r.tofirst = y.first;
        }
        break;
    }
    // What follows may only be a phrase in brackets.
    if (!w.atend() && w.word().front() != '(')
        return r;
    r.valid = true;
    return r;
}

} // namespace qm

// The loader: one pass over the family file's lines, recognising each by exact
// prefixes after its indentation, filling a new index. It stays one file above
// the usual size on purpose: it is one state machine (`loader`) whose record
// handlers share the record being read, the place and text tables and the
// citations waiting for their event; split, that state would have to be
// published in a header and the pass read across files.
#include "model/loadgedcom.h"

#include "platform/linereader.h"
#include "platform/memoryhint.h"
#include "platform/prefaulter.h"

#include <QElapsedTimer>
#include <QFileInfo>

#include <algorithm>
#include <cstring>
#include <deque>
#include <memory>
#include <limits>

namespace qm {

namespace {

// A line longer than this is cut: no value the index keeps comes near it, and
// a damaged file cannot make the reader hold a huge line.
constexpr size_t maxlinebytes = 1 << 20;

constexpr std::string_view noname = "<no name>";

// Prefix tests against literals, of a length known when compiling so that the
// comparison becomes a few plain loads.
template <size_t N>
bool startswith(std::string_view s, const char (&prefix)[N])
{
    return s.size() >= N - 1 && std::memcmp(s.data(), prefix, N - 1) == 0;
}

std::string_view trim(std::string_view s)
{
    while (!s.empty() && (s.front() == ' ' || s.front() == '\t'))
        s.remove_prefix(1);
    while (!s.empty() && (s.back() == ' ' || s.back() == '\t'))
        s.remove_suffix(1);
    return s;
}

// The digits that start at pos, up to the first non-digit (the closing "@",
// or anything else when it is missing). No digits, or a number too large for
// a record number, count as 0.
int32_t numberat(std::string_view line, size_t pos)
{
    int64_t v = 0;
    for (size_t i = pos; i < line.size(); ++i) {
        const char c = line[i];
        if (c < '0' || c > '9')
            break;
        v = v * 10 + (c - '0');
        if (v > std::numeric_limits<int32_t>::max())
            return 0;
    }
    return static_cast<int32_t>(v);
}

bool containscensus(std::string_view line)
{
    static constexpr char word[] = "census";
    for (size_t i = 0; i + 6 <= line.size(); ++i) {
        size_t k = 0;
        while (k < 6 && (line[i + k] | 0x20) == word[k])
            ++k;
        if (k == 6)
            return true;
    }
    return false;
}

uint64_t hashbytes(std::string_view s)
{
    constexpr uint64_t mul = 0x9E3779B97F4A7C15ULL;
    uint64_t h = s.size() * mul;
    const char* p = s.data();
    size_t n = s.size();
    while (n >= 8) {
        uint64_t w;
        std::memcpy(&w, p, 8);
        h = (h ^ w) * mul;
        h ^= h >> 32;
        p += 8;
        n -= 8;
    }
    uint64_t w = 0;
    std::memcpy(&w, p, n);
    h = (h ^ w) * mul;
    return h ^ (h >> 29);
}

// Open-addressing map from byte strings (views the caller keeps alive) to values.
template <typename V>
class viewmap {
public:
    V* find(uint64_t hash, std::string_view key)
    {
        if (entries_.empty())
            return nullptr;
        for (size_t s = hash & mask_;; s = (s + 1) & mask_) {
            const int32_t e = slots_[s];
            if (e < 0)
                return nullptr;
            const entry& en = entries_[static_cast<size_t>(e)];
            if (en.hash == hash && en.key == key)
                return &entries_[static_cast<size_t>(e)].value;
        }
    }

    void insert(uint64_t hash, std::string_view key, V value)
    {
        if ((entries_.size() + 1) * 2 > slots_.size())
            grow();
        entries_.push_back({hash, key, value});
        place(hash, static_cast<int32_t>(entries_.size() - 1));
    }

private:
    struct entry {
        uint64_t hash;
        std::string_view key;
        V value;
    };

    void place(uint64_t hash, int32_t e)
    {
        size_t s = hash & mask_;
        while (slots_[s] >= 0)
            s = (s + 1) & mask_;
        slots_[s] = e;
    }

    void grow()
    {
        const size_t size = slots_.empty() ? 1024 : slots_.size() * 2;
        slots_.assign(size, -1);
        mask_ = size - 1;
        for (size_t i = 0; i < entries_.size(); ++i)
            place(entries_[i].hash, static_cast<int32_t>(i));
    }

    std::vector<entry> entries_;
    std::vector<int32_t> slots_;
    size_t mask_ = 0;
};

class loader {
public:
    loader(gedcomindex& ix, textencoding enc, bool prefault) : ix_(ix), enc_(enc)
    {
        if (prefault) {
            pf_ = std::make_unique<prefaulter>();
            ix_.arena.prefaultwith(pf_.get());
        }
    }
    ~loader()
    {
        if (pf_)
            ix_.arena.prefaultwith(nullptr);
    }

    void line(std::string_view s);
    void finish();

private:
    enum class kind { none, source, person, object, family };

    std::string_view text(std::string_view raw);
    std::string_view place(std::string_view raw);
    // The text of the current "2 PLAC " value: the place's stored text when
    // the value is that text as it stands (ASCII, nothing trimmed), else a copy.
    std::string_view placetext(std::string_view v)
    {
        return !lastplace_.empty() && lastplace_.size() == v.size() && allascii(v) ? lastplace_ : text(v);
    }
    std::string_view lookupplace(std::string_view raw, int32_t& groupout);
    void startrecord(std::string_view s);
    void endrecord();
    void sourceline(std::string_view s);
    void objectline(std::string_view s);
    void personline(std::string_view s);
    void familyline(std::string_view s);
    void setname(std::string_view s);
    void flagline(std::string_view s);
    template <typename T>
    void putlist(indexlist<T>& list, std::vector<T>& items);
    // Gives each event its citations, cites[start[i]] up to the next event's
    // start, copied into the arena.
    template <class T>
    void adoptcites(std::vector<T>& events, const std::vector<int32_t>& cites, std::vector<size_t>& start);

    personrec& person() { return ix_.people.back(); }
    censusrec& lastcensus() { return census_.back(); }

    void newperson();

    gedcomindex& ix_;
    const textencoding enc_;
    // For a big file: the people table and the arena are brought in ahead of
    // the load on another thread. The table is asked for in steps.
    std::unique_ptr<prefaulter> pf_;
    size_t peopleasked_ = 0; // records of the table asked for so far
    std::string conv_, flagcode_, flagname_; // conversion scratch

    kind kind_ = kind::none;
    int32_t familyid_ = 0; // of the current family record
    int32_t highestsource = 0;
    bool namepending = false, birthpending = false, deathpending = false;
    bool inbirthdate = false, inbirthplace = false, indeath = false;
    bool inflags = false, incensus = false, inresidence = false, titlepending = false;

    // The current individual's lists, gathered here and moved into the arena
    // at the end of the record, each as one piece of its exact size.
    std::vector<int32_t> fams_, sourceids_, flagids_;
    std::vector<int32_t> objectids_; // of the current source
    std::vector<censusrec> census_;
    std::vector<residencerec> residences_;
    std::vector<int32_t> censuscites_;      // citations of all its census events, in order
    std::vector<size_t> censuscitestart_;   // where each event's citations start
    std::vector<int32_t> residencecites_;    // the same for its residence facts
    std::vector<size_t> residencecitestart_;

    // The place value of the current "2 PLAC " line (UTF-8, trimmed).
    std::string_view lastplace_;

    // Places: groups in the order first met, found by their key, and every
    // spelling met found by its bytes as they stand in the file.
    struct spelling {
        int32_t group;
        std::string_view utf8;
    };
    std::deque<std::string> keys_; // keys and raw spellings, dropped with the loader
    viewmap<int32_t> groupbykey_;
    viewmap<spelling> spellings_;
    std::vector<placerec> groups_;
    std::vector<std::string_view> groupkeys_;
    std::string lastraw_; // the place met last, as in the file, with its text and group
    std::string_view lastutf8_;
    int32_t lastgroup_ = -1;
};

std::string_view loader::text(std::string_view raw)
{
    if (allascii(raw))
        return ix_.arena.store(raw);
    conv_.clear();
    appendutf8(raw, enc_, conv_);
    return ix_.arena.store(conv_);
}

// Counts one occurrence of a place (raw bytes, trimmed, not empty) and returns its UTF-8 text.
std::string_view loader::place(std::string_view raw)
{
    // Places often come twice in a row (an event and the occupation of the
    // same census): the last one is kept at hand.
    if (lastgroup_ >= 0 && raw == lastraw_) {
        ++groups_[static_cast<size_t>(lastgroup_)].count;
        return lastutf8_;
    }
    const std::string_view utf8 = lookupplace(raw, lastgroup_);
    lastraw_.assign(raw);
    lastutf8_ = utf8;
    return utf8;
}

// Counts one occurrence of a place and gives its UTF-8 text and group.
std::string_view loader::lookupplace(std::string_view raw, int32_t& groupout)
{
    const uint64_t h = hashbytes(raw);
    if (spelling* sp = spellings_.find(h, raw)) {
        ++groups_[static_cast<size_t>(sp->group)].count;
        groupout = sp->group;
        return sp->utf8;
    }
    const std::string_view utf8 = text(raw);
    const std::string key = placekey(utf8);
    const uint64_t kh = hashbytes(key);
    int32_t group;
    if (int32_t* g = groupbykey_.find(kh, key)) {
        group = *g;
    } else {
        group = static_cast<int32_t>(groups_.size());
        groups_.push_back({utf8, 0});
        const std::string_view storedkey = keys_.emplace_back(key);
        groupkeys_.push_back(storedkey);
        groupbykey_.insert(kh, storedkey, group);
    }
    ++groups_[static_cast<size_t>(group)].count;
    spellings_.insert(h, keys_.emplace_back(raw), {group, utf8});
    groupout = group;
    return utf8;
}

void loader::line(std::string_view s)
{
    while (!s.empty() && (s.front() == ' ' || s.front() == '\t'))
        s.remove_prefix(1);
    if (s.size() < 2 || s[1] != ' ')
        return;
    switch (s[0]) {
    case '0':
        startrecord(s);
        return;
    case '1':
        break;
    case '2':
        lastplace_ = {};
        if (s.size() > 7 && startswith(s, "2 PLAC ")) {
            const std::string_view v = trim(s.substr(7));
            if (!v.empty())
                lastplace_ = place(v);
        }
        break;
    default:
        return;
    }
    switch (kind_) {
    case kind::person:
        personline(s);
        break;
    case kind::source:
        sourceline(s);
        break;
    case kind::object:
        objectline(s);
        break;
    case kind::family:
        familyline(s);
        break;
    case kind::none:
        break;
    }
}

void loader::startrecord(std::string_view s)
{
    endrecord();
    namepending = birthpending = deathpending = false;
    inbirthdate = inbirthplace = indeath = inflags = incensus = inresidence = titlepending = false;
    kind_ = kind::none;
    if (s.size() < 4 || !startswith(s, "0 @")) {
        if (startswith(s, "0 HEAD"))
            ix_.hashead = true;
        return;
    }
    const int32_t id = numberat(s, 4);
    // Records are cited by the identifier as written: other programs write "@S0012@".
    const auto xref = [&] {
        const size_t end = s.find('@', 3);
        return text(s.substr(2 + 1, end == std::string_view::npos ? 0 : end - 3));
    };
    switch (s[3]) {
    case 'S': {
        kind_ = kind::source;
        sourcerec& r = ix_.sources.emplace_back();
        r.id = id;
        r.xref = xref();
        highestsource = std::max(highestsource, id);
        titlepending = true;
        break;
    }
    case 'I': {
        kind_ = kind::person;
        newperson();
        personrec& p = ix_.people.back();
        p.id = id;
        p.name = noname;
        namepending = birthpending = deathpending = true;
        break;
    }
    case 'O': {
        kind_ = kind::object;
        objectrec& o = ix_.objects.emplace_back();
        o.id = id;
        o.xref = xref();
        ix_.maxobjectid = std::max(ix_.maxobjectid, id);
        break;
    }
    case 'N':
        ix_.maxnoteid = std::max(ix_.maxnoteid, id);
        break;
    case 'F':
        kind_ = kind::family;
        familyid_ = id;
        break;
    default:
        break;
    }
}

// Moves the gathered items into one piece of the arena, owned by list.
template <typename T>
void loader::putlist(indexlist<T>& list, std::vector<T>& items)
{
    if (items.empty())
        return;
    T* at = static_cast<T*>(ix_.arena.allocate(items.size() * sizeof(T), alignof(T)));
    std::uninitialized_move(items.begin(), items.end(), at);
    list.adopt(at, items.size());
    items.clear();
}

void loader::newperson()
{
    std::vector<personrec>& people = ix_.people;
    if (pf_ && people.size() == people.capacity()) {
        // The table is about to move: nothing more is asked for it.
        pf_->finish();
        pf_.reset();
        ix_.arena.prefaultwith(nullptr);
    }
    people.emplace_back();
    constexpr size_t step = 16384;
    if (pf_ && people.size() + step / 2 >= peopleasked_ && peopleasked_ < people.capacity()) {
        const size_t to = std::min(people.capacity(), std::max(peopleasked_, people.size()) + step);
        pf_->request(people.data() + peopleasked_, (to - peopleasked_) * sizeof(personrec));
        peopleasked_ = to;
    }
}

void loader::endrecord()
{
    if (kind_ == kind::source)
        putlist(ix_.sources.back().objectids, objectids_);
    if (kind_ != kind::person)
        return;
    personrec& p = person();
    putlist(p.fams, fams_);
    putlist(p.sourceids, sourceids_);
    putlist(p.flagids, flagids_);
    if (!residences_.empty()) {
        adoptcites(residences_, residencecites_, residencecitestart_);
        putlist(p.residences, residences_);
    }
    if (!census_.empty()) {
        adoptcites(census_, censuscites_, censuscitestart_);
        putlist(p.census, census_);
    }
    censuscites_.clear();
    censuscitestart_.clear();
    residencecites_.clear();
    residencecitestart_.clear();
}

void loader::sourceline(std::string_view s)
{
    sourcerec& r = ix_.sources.back();
    if (titlepending && (startswith(s, "1 TITL ") || startswith(s, "1 ABBR "))) {
        titlepending = false;
        r.title = text(trim(s.substr(7)));
        if (containscensus(s)) {
            r.iscensus = true;
            ix_.censussources.push_back(static_cast<int32_t>(ix_.sources.size() - 1));
        }
    } else if (startswith(s, "1 OBJE @O")) {
        objectids_.push_back(numberat(s, 9));
    }
}

void loader::objectline(std::string_view s)
{
    objectrec& o = ix_.objects.back();
    if (startswith(s, "1 FORM "))
        o.form = text(s.substr(7));
    else if (startswith(s, "1 TITL "))
        o.title = text(s.substr(7));
    else if (startswith(s, "1 _FILE "))
        o.file = text(s.substr(8));
    else if (startswith(s, "1 _DATE "))
        o.date = text(s.substr(8));
    else if (startswith(s, "2 _ASID ")) {
        const std::string_view v = trim(s.substr(8));
        o.maxasid = std::max(o.maxasid, numberat(v, 0));
    }
}

// Rule for the first NAME line: "Surname, Given names" from "Given names /Surname/".
// The surname is the text between the first slash and the next one (or the
// end of the line); text after the closing slash (a suffix such as "Jr")
// follows the given names. A value without a slash, or whose only slash ends
// it, is given names without a surname and stands as it is.
void loader::setname(std::string_view s)
{
    const std::string_view value = s.substr(7);
    const size_t slash = value.find('/');
    std::string_view given, surname, suffix;
    bool hassurname = false;
    if (slash == std::string_view::npos) {
        given = trim(value);
    } else {
        given = trim(value.substr(0, slash));
        const std::string_view rest = value.substr(slash + 1);
        const size_t close = rest.find('/');
        if (close == std::string_view::npos) {
            // "Given /Surname" without its closing slash; "Given /" has no surname.
            surname = trim(rest);
            hassurname = !surname.empty();
        } else {
            surname = trim(rest.substr(0, close));
            suffix = trim(rest.substr(close + 1));
            hassurname = true;
        }
    }
    std::string& n = conv_;
    n.clear();
    const bool ascii = allascii(value);
    const auto append = [&](std::string_view part) {
        if (ascii)
            n.append(part);
        else
            appendutf8(part, enc_, n);
    };
    if (hassurname) {
        append(surname);
        if (!given.empty() || !suffix.empty()) {
            n += ", ";
            append(given);
            if (!given.empty() && !suffix.empty())
                n += ' ';
            append(suffix);
        }
    } else {
        append(given);
    }
    if (!n.empty())
        person().name = ix_.arena.store(n);
}

void loader::flagline(std::string_view s)
{
    const size_t space = s.find(' ', 2);
    if (space == std::string_view::npos)
        return;
    const auto convert = [this](std::string_view raw, std::string& out) {
        if (allascii(raw)) {
            out.assign(raw);
        } else {
            out.clear();
            appendutf8(raw, enc_, out);
        }
    };
    convert(s.substr(2, space - 2), flagcode_);
    convert(trim(s.substr(space + 1)), flagname_);
    flagids_.push_back(static_cast<int32_t>(noteflag(ix_.flags, flagcode_, flagname_)));
}

// Families: only their census events are kept (date and place).
void loader::familyline(std::string_view s)
{
    if (s[0] == '1') {
        incensus = startswith(s, "1 CENS");
        if (incensus)
            ix_.familycensus.push_back({familyid_, {}, {}});
        return;
    }
    if (!incensus)
        return;
    if (startswith(s, "2 DATE") && s.size() > 7)
        ix_.familycensus.back().date = text(s.substr(7));
    else if (startswith(s, "2 PLAC") && s.size() > 7)
        ix_.familycensus.back().place = placetext(s.substr(7));
}

void loader::personline(std::string_view s)
{
    personrec& p = person();
    if (s[0] == '1') {
        inresidence = false;
        if (namepending && startswith(s, "1 NAME")) {
            if (s.size() > 7)
                setname(s);
            namepending = inflags = incensus = false;
            // A NAME line ends an event above it like any other level-1 line.
            inbirthdate = inbirthplace = indeath = false;
        } else if (birthpending && startswith(s, "1 BIRT")) {
            birthpending = indeath = inflags = incensus = false;
            inbirthdate = inbirthplace = true;
        } else if (deathpending && startswith(s, "1 DEAT")) {
            deathpending = inbirthdate = inbirthplace = inflags = incensus = false;
            indeath = true;
        } else {
            inbirthdate = inbirthplace = indeath = inflags = incensus = false;
            if (startswith(s, "1 SEX")) {
                if (s.size() >= 7)
                    p.sex = text(s.substr(6));
            } else if (startswith(s, "1 FAMC @")) {
                p.famc = numberat(s, 9);
            } else if (startswith(s, "1 FAMS @")) {
                fams_.push_back(numberat(s, 9));
            } else if (startswith(s, "1 _FLGS")) {
                inflags = true;
            } else if (startswith(s, "1 CENS")) {
                incensus = true;
                census_.emplace_back();
                censuscitestart_.push_back(censuscites_.size());
                ++ix_.censusevents;
            } else if (startswith(s, "1 RESI")) {
                inresidence = true;
                residences_.emplace_back();
                residencecitestart_.push_back(residencecites_.size());
            }
        }
        return;
    }

    // Level 2.
    if (incensus) {
        if (startswith(s, "2 DATE")) {
            if (s.size() > 7)
                lastcensus().date = text(s.substr(7));
            return;
        }
        if (startswith(s, "2 ADDR")) {
            if (s.size() > 7)
                lastcensus().address = text(s.substr(7));
            return;
        }
        if (startswith(s, "2 PLAC")) {
            if (s.size() > 7)
                lastcensus().place = placetext(s.substr(7));
            return;
        }
        if (startswith(s, "2 AGE")) {
            if (s.size() > 6)
                lastcensus().age = text(s.substr(6));
            return;
        }
    }
    if (inresidence) {
        if (startswith(s, "2 DATE")) {
            if (s.size() > 7)
                residences_.back().date = text(s.substr(7));
            return;
        }
        if (startswith(s, "2 PLAC")) {
            if (s.size() > 7)
                residences_.back().place = placetext(s.substr(7));
            return;
        }
    }
    if (inbirthdate && startswith(s, "2 DATE")) {
        if (s.size() >= 8) {
            p.birthdate = text(s.substr(7));
            p.hasbirthdate = true;
        }
        inbirthdate = inflags = incensus = false;
        return;
    }
    if (indeath && startswith(s, "2 DATE")) {
        if (s.size() >= 8) {
            p.deathdate = text(s.substr(7));
            p.hasdeathdate = true;
        }
        indeath = inflags = incensus = false;
        return;
    }
    if (inbirthplace && startswith(s, "2 PLAC")) {
        if (s.size() >= 8) {
            p.birthplace = placetext(s.substr(7));
            p.hasbirthplace = true;
        }
        inbirthplace = inflags = incensus = false;
        return;
    }
    if (inflags && startswith(s, "2 __")) {
        flagline(s);
        incensus = false;
        return;
    }
    if (startswith(s, "2 SOUR @")) {
        const int32_t id = numberat(s, 9);
        sourceids_.push_back(id);
        if (incensus)
            censuscites_.push_back(id);
        else if (inresidence)
            residencecites_.push_back(id);
    }
}

template <class T>
void loader::adoptcites(std::vector<T>& events, const std::vector<int32_t>& cites, std::vector<size_t>& start)
{
    start.push_back(cites.size());
    for (size_t i = 0; i < events.size(); ++i) {
        const size_t from = start[i], to = start[i + 1];
        if (from == to)
            continue;
        auto* at = static_cast<int32_t*>(ix_.arena.allocate((to - from) * sizeof(int32_t), alignof(int32_t)));
        std::memcpy(at, cites.data() + from, (to - from) * sizeof(int32_t));
        events[i].sourceids.adopt(at, to - from);
    }
}

void loader::finish()
{
    endrecord();
    kind_ = kind::none;
    ix_.nextsourceid = highestsource < std::numeric_limits<int32_t>::max() ? highestsource + 1 : highestsource;

    // Groups sorted by key; keys are distinct, so the order is total.
    std::vector<int32_t> order(groups_.size());
    for (size_t i = 0; i < order.size(); ++i)
        order[i] = static_cast<int32_t>(i);
    std::sort(order.begin(), order.end(), [&](int32_t a, int32_t b) {
        return groupkeys_[static_cast<size_t>(a)] < groupkeys_[static_cast<size_t>(b)];
    });
    ix_.places.clear();
    ix_.places.reserve(order.size());
    for (int32_t g : order)
        ix_.places.push_back(groups_[static_cast<size_t>(g)]);
}

// Reserves room for the records a file of this size may hold. Growing the
// tables by copying would touch their memory twice over; room reserved beyond
// what is used is never touched, so it costs address space, not memory.
void reservetables(gedcomindex& index, int64_t bytes)
{
    const auto room = [&](int64_t bytesper) { return static_cast<size_t>(std::max<int64_t>(bytes / bytesper, 64)); };
    index.people.reserve(room(256));
    hintlargememory(index.people.data(), index.people.capacity() * sizeof(personrec));
    index.sources.reserve(room(2048));
    index.objects.reserve(room(2048));
}

// Files smaller than this load too quickly for a second thread to help.
constexpr int64_t prefaultfrom = 64 << 20;

void loadlines(linereader& reader, gedcomindex& index, int64_t bytes)
{
    index.encoding = reader.encoding();
    index.bom = reader.hasbom();
    loader l(index, reader.encoding(), bytes >= prefaultfrom);
    std::string_view s;
    while (reader.next(s))
        l.line(s);
    l.finish();
}

} // namespace

loadresult loadgedcom(const QString& path, const flagtable& flagdefs)
{
    QElapsedTimer timer;
    timer.start();
    loadresult result;
    linereader reader;
    reader.setmaxline(maxlinebytes);
    QString error;
    if (!reader.open(path, &error)) {
        result.error = error;
        return result;
    }
    auto index = std::make_unique<gedcomindex>();
    index->gedcomfile = QFileInfo(path).absoluteFilePath();
    index->gedcomdate = stampof(path);
    index->flags = flagdefs;
    reservetables(*index, index->gedcomdate.size);
    loadlines(reader, *index, index->gedcomdate.size);
    if (reader.failed()) {
        result.error = QStringLiteral("The file %1 could not be read: %2").arg(path, reader.errorstring());
        return result;
    }
    result.index = std::move(index);
    result.ms = static_cast<double>(timer.nsecsElapsed()) / 1e6;
    return result;
}

std::unique_ptr<gedcomindex> loadgedcombytes(std::string_view bytes, const flagtable& flagdefs)
{
    linereader reader;
    reader.setmaxline(maxlinebytes);
    reader.openbytes(bytes);
    auto index = std::make_unique<gedcomindex>();
    index->flags = flagdefs;
    reservetables(*index, static_cast<int64_t>(bytes.size()));
    loadlines(reader, *index, static_cast<int64_t>(bytes.size()));
    return index;
}

QString nopeoplemessage()
{
    return QStringLiteral("There are no individuals recorded in the selected file. This is probably because the file "
                          "selected was not a GEDCOM file. Please select 'Open another GEDCOM family history file' "
                          "from the File menu to try again.");
}

} // namespace qm

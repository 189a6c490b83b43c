// The rewrite's one pass over the family file (see rewritefile.h). It stays one
// file above the usual size on purpose: the four modes are not separate
// routines but branches of the same line loop (rewriterun::iteration), sharing
// its reader and writer, the read-ahead of a record's tail, the anchors where
// new records go, the change stamps and the flag blocks. Split by mode, each
// part would need that whole state and the loop would be read across files.
#include "writer/rewritefile.h"

#include "writer/rewritechecks.h"
#include "platform/linereader.h"
#include "writer/linewriter.h"
#include "writer/recordwriters.h"

#include <QStringList>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <deque>
#include <memory>
#include <unordered_map>

namespace qm {

namespace {

// Prefix tests against literals, of a length known when compiling so that the
// comparison becomes a few plain loads.
template <size_t N>
bool startswith(std::string_view s, const char (&p)[N])
{
    return s.size() >= N - 1 && std::memcmp(s.data(), p, N - 1) == 0;
}

bool startswithnocase(std::string_view s, std::string_view p)
{
    if (s.size() < p.size())
        return false;
    for (size_t i = 0; i < p.size(); ++i) {
        char c = s[i];
        if (c >= 'a' && c <= 'z')
            c = static_cast<char>(c - 32);
        if (c != p[i])
            return false;
    }
    return true;
}

// Some programs indent their lines: spaces and tabs before the level number
// are passed over wherever a line is recognised.
std::string_view lefttrim(std::string_view s)
{
    size_t i = 0;
    while (i < s.size() && (s[i] == ' ' || s[i] == '\t'))
        ++i;
    return s.substr(i);
}

std::string_view trim(std::string_view s)
{
    s = lefttrim(s);
    while (!s.empty() && (s.back() == ' ' || s.back() == '\t'))
        s.remove_suffix(1);
    return s;
}

// The number of an identifier: the digits after `from` up to the "@"
// ("0 @I12@ INDI" from 4 gives 12); -1 when there are none.
int64_t refnumber(std::string_view line, size_t from)
{
    if (line.size() <= from)
        return -1;
    std::string_view rest = line.substr(from);
    rest = rest.substr(0, rest.find('@'));
    while (!rest.empty() && rest.front() == ' ')
        rest.remove_prefix(1);
    int64_t n = 0;
    size_t digits = 0;
    while (digits < rest.size() && digits < 12 && rest[digits] >= '0' && rest[digits] <= '9')
        n = n * 10 + (rest[digits++] - '0');
    return digits ? n : -1;
}

int64_t numbervalue(const QString& s)
{
    return refnumber(u8(s.trimmed()), 0);
}

bool flagheader(std::string_view t)
{
    return startswith(t, "1 _FLGS");
}

// A line that ends a flag block: the next line of level 1 or 0.
bool endsflags(std::string_view t)
{
    return startswith(t, "1") || startswith(t, "0");
}

// The flag code of a line under "1 _FLGS" ("2 " + code + " " + name), as UTF-8
// to compare with the flag table; "" for any other line.
std::string flagcodeof(std::string_view t, textencoding enc)
{
    if (!startswith(t, "2 "))
        return {};
    std::string_view code = t.substr(2);
    return toutf8(code.substr(0, code.find(' ')), enc);
}

// The lines of a record from its first "1 _FLGS" or "1 CHAN" line, the line
// that ends the record last (when one came). All its flag lines are brought
// under one "1 _FLGS" header, which stands where the first header stood or,
// when that came after the change stamp, just before "1 CHAN": hand-edited
// files and other programs put the block anywhere, and the header written by
// an earlier fault may stand twice.
void gatherflags(std::vector<std::string>& record)
{
    const size_t body = !record.empty() && !lefttrim(record.back()).empty() && lefttrim(record.back())[0] == '0'
        ? record.size() - 1
        : record.size();
    std::vector<std::string> kept, flags;
    std::string header;
    size_t at = std::string::npos; // where the block goes among the kept lines
    bool inflags = false;
    for (size_t i = 0; i < body; ++i) {
        const std::string_view t = lefttrim(record[i]);
        if (inflags && !endsflags(t)) {
            flags.push_back(std::move(record[i]));
            continue;
        }
        inflags = flagheader(t);
        if (inflags) {
            if (header.empty())
                header = std::move(record[i]);
            at = std::min(at, kept.size());
            continue;
        }
        if (startswithnocase(t, "1 CHAN"))
            at = std::min(at, kept.size());
        kept.push_back(std::move(record[i]));
    }
    if (header.empty()) {
        // No block: the lines go back as they were.
        for (size_t i = 0; i < kept.size(); ++i)
            record[i] = std::move(kept[i]);
        return;
    }
    std::vector<std::string> out;
    out.reserve(record.size());
    for (size_t i = 0; i <= kept.size(); ++i) {
        if (i == at) {
            out.push_back(std::move(header));
            for (std::string& f : flags)
                out.push_back(std::move(f));
        }
        if (i < kept.size())
            out.push_back(std::move(kept[i]));
    }
    if (body < record.size())
        out.push_back(std::move(record.back()));
    record = std::move(out);
}

// The identifier of the source numbered `digits` as its record writes it
// ("S0012"), "S" + digits when the index does not know it.
std::string sourcexref(const gedcomindex& ix, const std::string& digits)
{
    const int64_t n = refnumber(digits, 0);
    for (const sourcerec& r : ix.sources)
        if (r.id == n && !r.xref.empty())
            return std::string(r.xref);
    return "S" + digits;
}

enum class citekind { birth, census, occupation };

// One run of the rewrite.
class rewriterun {
public:
    rewriterun(linereader& in, linewriter& out, const gedcomindex& ix, const settings& s, const rewriterequest& rq)
        : in_(in), out_(out), ix_(ix), s_(s), rq_(rq), e_(rq.entry), mode_(rq.mode)
    {
    }

    rewriteresult run();
    // Names of the entry's individuals whose records were not met, or "".
    QString missing() const;

private:
    bool fetch();
    // Reads the rest of the record from the current line ahead, its flag
    // lines gathered under one header; the loop then takes its lines from there.
    void readtailahead();
    bool holdsentryflag(const selectionrec& who) const;
    // Mode 4: whether the changes of the current individual alter these lines of its record.
    bool flagsalter(const std::vector<size_t>& changes, const std::vector<std::string>& lines) const;
    void iteration();
    void writecensusblock(const selectionrec& who);
    void writecitation(citekind kind);
    void dateline(std::string_view t);
    void occupationdate(std::string_view t);
    void flagblock(std::string_view t);
    const personrec* personwithid(int32_t id, int32_t hint) const;
    bool placeatend(std::string_view t) const { return startswith(t, "0 TRLR"); }
    // Nothing is due before the next record starts: every line up to it is
    // written as read. (Census dates look at lines inside records.)
    bool quiet() const
    {
        return entryperson_ < 0 && !sourcefound_ && !recordchanged_ && !flagperson_ && !flagtail_
            && mode_ != rewritemode::censusdates && ahead_.empty();
    }
    static bool startsrecord(std::string_view line)
    {
        const std::string_view t = lefttrim(line);
        return !t.empty() && t[0] == '0';
    }

    linereader& in_;
    linewriter& out_;
    const gedcomindex& ix_;
    const settings& s_;
    const rewriterequest& rq_;
    const censusentry& e_;
    rewritemode mode_;
    rewriteresult res_;

    // The current line as read, and what the loop does with it.
    std::string_view line_;
    bool reuse_ = false;
    bool drop_ = false;      // the current line is replaced: not written
    bool atend_ = false;     // the stand-in end line has been handed out
    bool endline_ = false;   // the current line is that stand-in: never written
    bool exhausted_ = false; // nothing more to read
    std::deque<std::string> ahead_; // lines read ahead, handed out before the reader's
    std::string current_;           // the current line when it is no longer in the reader
    bool flagtail_ = false;         // the flags of the current record change: its tail is still to be read ahead

    // Mode 1.
    std::string sourcexref_; // the cited source's identifier as the file writes it
    std::string sid_, place_, address_, reference_, entrydate_, sourcetext_, notetext_;
    bool hassourcetext_ = false, hasnotetext_ = false;
    int entryperson_ = -1;
    std::vector<bool> seen_;
    bool flagpending_ = false;
    int flagwho_ = -1; // the entry's individual whose record is being passed
    int32_t notenumber_ = 0;
    bool notemarked_ = false, noteplaced_ = false;
    bool sourcemarked_ = false, sourceplaced_ = false;
    std::string sourceanchor_;
    // Mode 2.
    bool sourcefound_ = false, sourcemet_ = false;
    // New multimedia records.
    bool newimages_ = false;
    bool objectsmarked_ = false, objectsplaced_ = false;
    std::string objectanchor_;
    // Any mode.
    bool recordchanged_ = false;
    // Mode 3.
    std::unordered_map<int32_t, int32_t> peoplebyid_;
    int32_t person_ = -1;
    bool incensus_ = false, inoccupation_ = false;
    std::vector<std::pair<std::string, std::string>> dates_; // applying entries: found date, new date (UTF-8)
    std::vector<std::string> held_;
    // Mode 4.
    std::unordered_map<int32_t, std::vector<size_t>> changesbyid_; // record number -> entries of flagchanges
    const std::vector<size_t>* flagperson_ = nullptr;
};

bool rewriterun::fetch()
{
    endline_ = false;
    if (!ahead_.empty()) {
        current_ = std::move(ahead_.front());
        ahead_.pop_front();
        line_ = current_;
        return true;
    }
    if (exhausted_)
        return false;
    if (in_.next(line_))
        return true;
    if (!atend_) {
        // The end of the file stands in for a closing "0 TRLR" line: whatever
        // is still due (the census block of a last record, its change stamp,
        // new records) is written there even when the file has no trailer.
        atend_ = true;
        endline_ = true;
        line_ = "0 TRLR";
        return true;
    }
    exhausted_ = true;
    line_ = {};
    return false;
}

void rewriterun::readtailahead()
{
    std::vector<std::string> tail{std::string(line_)};
    tail.insert(tail.end(), std::make_move_iterator(ahead_.begin()), std::make_move_iterator(ahead_.end()));
    ahead_.clear();
    if (!startsrecord(tail.back())) {
        std::string_view l;
        while (!exhausted_ && !atend_ && in_.next(l)) {
            tail.emplace_back(l);
            if (startsrecord(l))
                break;
        }
    }
    // Only removals of flags the record does not hold: it is left as it is.
    if (mode_ == rewritemode::flagchanges && !flagsalter(*flagperson_, tail))
        flagperson_ = nullptr;
    else
        gatherflags(tail);
    ahead_.assign(std::make_move_iterator(tail.begin()), std::make_move_iterator(tail.end()));
    fetch();
}

bool rewriterun::holdsentryflag(const selectionrec& who) const
{
    const personrec* p = personwithid(who.id, who.personindex);
    const auto flag = static_cast<int32_t>(*res_.entryflag);
    return p && std::find(p->flagids.begin(), p->flagids.end(), flag) != p->flagids.end();
}

bool rewriterun::flagsalter(const std::vector<size_t>& changes, const std::vector<std::string>& lines) const
{
    std::vector<std::string_view> removing;
    for (size_t k : changes) {
        const flagchange& c = rq_.flagchanges[k];
        if (c.add)
            return true;
        removing.push_back(ix_.flags[static_cast<size_t>(c.flag)].code);
    }
    bool inflags = false;
    for (const std::string& line : lines) {
        const std::string_view t = lefttrim(line);
        if (inflags && !endsflags(t)) {
            const std::string code = flagcodeof(t, ix_.encoding);
            if (std::find(removing.begin(), removing.end(), code) != removing.end())
                return true;
            continue;
        }
        inflags = flagheader(t);
    }
    return false;
}

const personrec* rewriterun::personwithid(int32_t id, int32_t hint) const
{
    if (hint >= 0 && hint < static_cast<int32_t>(ix_.people.size()) && ix_.people[static_cast<size_t>(hint)].id == id)
        return &ix_.people[static_cast<size_t>(hint)];
    for (const personrec& p : ix_.people)
        if (p.id == id)
            return &p;
    return nullptr;
}

rewriteresult rewriterun::run()
{
    res_.maxnoteid = ix_.maxnoteid;
    res_.maxobjectid = ix_.maxobjectid;

    for (const imagechoice& img : e_.chosenimages)
        newimages_ = newimages_ || img.isnew;
    if (mode_ != rewritemode::censusentry && mode_ != rewritemode::attachimages)
        newimages_ = false;
    if (newimages_ && ix_.maxobjectid > 0)
        objectanchor_ = "0 @O" + std::to_string(ix_.maxobjectid) + "@ OBJE";

    if (mode_ == rewritemode::censusentry) {
        if (s_.flaguse && !ix_.flags.empty())
            res_.entryflag = findentryflag(ix_.flags, u8(e_.entrydate.trimmed()), u8(s_.country));
        if (!s_.fullentry && s_.sharednote) {
            notenumber_ = newnotenumber(ix_.maxnoteid);
            res_.maxnoteid = notenumber_;
        }
        sid_ = oneline(e_.sourceid);
        place_ = oneline(e_.place);
        address_ = oneline(e_.address);
        reference_ = oneline(e_.reference);
        entrydate_ = oneline(e_.entrydate);
        sourcetext_ = u8(e_.sourcetext);
        notetext_ = u8(e_.notetext);
        hassourcetext_ = !e_.sourcetext.trimmed().isEmpty();
        hasnotetext_ = !e_.notetext.trimmed().isEmpty();
        seen_.assign(e_.selection.size(), false);
        if (s_.fullentry && numbervalue(e_.sourceid) > 1)
            sourceanchor_ = "0 @S" + std::to_string(numbervalue(e_.sourceid) - 1) + "@ SOUR";
        sourcexref_ = s_.fullentry ? "S" + sid_ : sourcexref(ix_, sid_);
    } else if (mode_ == rewritemode::attachimages) {
        sid_ = oneline(e_.sourceid);
        sourcexref_ = sourcexref(ix_, sid_);
        sourceanchor_ = "0 @" + sourcexref_ + "@ SOUR";
    } else if (mode_ == rewritemode::censusdates) {
        for (size_t i = 0; i < ix_.people.size(); ++i)
            peoplebyid_.emplace(ix_.people[i].id, static_cast<int32_t>(i));
        for (const datechange& d : rq_.datechanges)
            if (d.applies())
                dates_.emplace_back(u8(d.founddate), oneline(d.newdate));
    } else {
        for (size_t k = 0; k < rq_.flagchanges.size(); ++k) {
            const flagchange& c = rq_.flagchanges[k];
            if (c.person >= 0 && c.person < static_cast<int32_t>(ix_.people.size()) && c.flag >= 0
                && c.flag < static_cast<int32_t>(ix_.flags.size()))
                changesbyid_[ix_.people[static_cast<size_t>(c.person)].id].push_back(k);
        }
    }

    while (reuse_ || fetch()) {
        reuse_ = false;
        drop_ = false;
        // Most lines are kept as they are: a line inside a record when nothing
        // is due within the record needs none of the checks below.
        if (quiet() && !startsrecord(line_)) {
            out_.writeline(line_);
            // And so are the lines after it, up to a line that may start a record.
            int64_t count = 0;
            const std::string_view kept = in_.nextcrlflines("0 \t", count);
            out_.writelines(kept, count);
            continue;
        }
        iteration();
    }
    // A byte that is no character is still the file's: it stays at its end.
    out_.writeraw(in_.strayend());
    if (in_.failed())
        res_.error = in_.errorstring();
    res_.lines = out_.lines();
    return std::move(res_);
}

QString rewriterun::missing() const
{
    QStringList names;
    for (size_t k = 0; k < seen_.size(); ++k)
        if (!seen_[k])
            names << QStringLiteral("%1 (%2)").arg(e_.selection[k].name).arg(e_.selection[k].id);
    return names.join(QStringLiteral(", "));
}

void rewriterun::iteration()
{
    std::string_view t = lefttrim(line_);
    const bool census = mode_ == rewritemode::censusentry;

    // The individual's flags change: its flag block is found wherever it
    // stands and brought to where it belongs before anything is written there.
    if (flagtail_ && (flagheader(t) || startswithnocase(t, "1 CHAN"))) {
        flagtail_ = false;
        readtailahead();
        t = lefttrim(line_);
    }

    // A: the census block closes the events of an individual of the entry.
    if (census && entryperson_ >= 0
        && (startswith(t, "0") || startswith(t, "1 FAMS") || startswith(t, "1 FAMC") || startswith(t, "1 CHAN")
            || startswith(t, "1 _FLGS"))) {
        writecensusblock(e_.selection[static_cast<size_t>(entryperson_)]);
        ++res_.censusblocks;
        entryperson_ = -1;
        recordchanged_ = true;
    }

    // B: image links at the end of the source being extended.
    if (mode_ == rewritemode::attachimages && sourcefound_ && (startswith(t, "1 CHAN") || startswith(t, "0"))) {
        writeimagelinks(out_, e_.chosenimages, s_);
        res_.linksadded += static_cast<int32_t>(e_.chosenimages.size());
        sourcefound_ = false;
        recordchanged_ = true;
    }

    // C: a changed record gets its flag and a new change stamp before it closes.
    if (recordchanged_ && (startswithnocase(t, "1 CHAN") || startswith(t, "0") || startswith(t, "1 _FLGS"))) {
        bool again = false;
        if (census && flagpending_) {
            flagpending_ = false;
            if (!holdsentryflag(e_.selection[static_cast<size_t>(flagwho_)])) {
                const flagrec& f = ix_.flags[*res_.entryflag];
                out_.writetext("1 _FLGS");
                out_.writefiletext("2 " + f.code + " " + f.name);
                ++res_.flaggiven;
                if (startswith(t, "1 _FLGS")) {
                    // The individual's own flag lines follow the new header; the old header goes.
                    if (!fetch())
                        return;
                    t = lefttrim(line_);
                    again = true;
                }
            }
        }
        if (startswithnocase(t, "1 CHAN") || startswith(t, "0")) {
            recordchanged_ = false;
            writechangestamp(out_);
            if (t.size() >= 6) {
                while (startswithnocase(t, "1 CHAN") || startswithnocase(t, "2 DATE") || startswithnocase(t, "3 TIME")) {
                    if (!fetch())
                        return;
                    t = lefttrim(line_);
                }
            }
            if (startswith(t, "0"))
                again = true;
        }
        if (again) {
            reuse_ = true;
            return;
        }
    }

    // D: new multimedia records, after the last one of the file.
    if (newimages_ && !objectsplaced_) {
        bool place = false;
        if (objectsmarked_)
            place = startswith(t, "0");
        else if (!objectanchor_.empty() && trim(line_) == objectanchor_)
            objectsmarked_ = true;
        else if (objectanchor_.empty())
            place = t.size() >= 6
                    && (startswith(t, "0 TRLR") || startswith(t, "0 @U") || startswith(t, "0 @N")
                        || startswith(t, "0 @R") || startswith(t, "0 @S"));
        else
            place = placeatend(t); // the anchor never came
        if (place) {
            res_.maxobjectid = writeobjectrecords(out_, e_.chosenimages, s_, res_.maxobjectid);
            objectsplaced_ = true;
        }
    }

    // E: the new shared note, after the note numbered one less.
    if (notenumber_ > 0 && !noteplaced_) {
        bool place = false;
        if (notemarked_)
            place = startswith(t, "0");
        else if (notenumber_ > 1 && startswith(t, "0 @N") && refnumber(t, 4) == notenumber_ - 1)
            notemarked_ = true;
        else if (notenumber_ == 1)
            place = startswith(t, "0 TRLR") || startswith(t, "0 @U") || startswith(t, "0 @S") || startswith(t, "0 @R");
        else
            place = placeatend(t);
        if (place) {
            writenoterecord(out_, notenumber_, e_);
            noteplaced_ = true;
        }
    }

    // F: the new source record of a full entry, after the source numbered one less;
    // or, when images are attached, the source to extend.
    if (census && s_.fullentry && !sourceplaced_) {
        bool place = false;
        if (sourcemarked_)
            place = startswith(t, "0");
        else if (sourceanchor_.empty())
            place = startswith(t, "0 TRLR") || startswith(t, "0 @U");
        else if (trim(line_) == sourceanchor_)
            sourcemarked_ = true;
        else
            place = placeatend(t);
        if (place) {
            writesourcerecord(out_, e_, s_);
            sourceplaced_ = true;
        }
    } else if (mode_ == rewritemode::attachimages && !sourcemet_ && trim(line_) == sourceanchor_) {
        sourcemet_ = true;
        sourcefound_ = true;
    }

    // G: census dates.
    if (mode_ == rewritemode::censusdates) {
        if (startswith(t, "1") || startswith(t, "0"))
            incensus_ = inoccupation_ = false;
        if (startswith(t, "1 CENS"))
            incensus_ = true;
        else if (startswith(t, "1 OCCU"))
            inoccupation_ = true;
        else if (incensus_ && startswith(t, "2 DATE "))
            dateline(t);
        else if (inoccupation_ && startswith(t, "2 DATE ")) {
            occupationdate(t);
            if (reuse_)
                return;
            t = lefttrim(line_);
        }
    }

    // H: flag changes of the current individual.
    if (mode_ == rewritemode::flagchanges && flagperson_
        && (startswithnocase(t, "1 CHAN") || startswith(t, "0") || startswith(t, "1 _FLGS"))) {
        flagblock(t);
        return;
    }

    // I: the start of a record.
    if (startswith(t, "0")) {
        const bool indi = startswith(t, "0 @I");
        const int64_t id = indi ? refnumber(t, 4) : -1;
        flagtail_ = false;
        if (census && indi) {
            for (size_t k = 0; k < e_.selection.size(); ++k) {
                if (e_.selection[k].id == id) {
                    entryperson_ = flagwho_ = static_cast<int>(k);
                    seen_[k] = true;
                    flagpending_ = res_.entryflag.has_value();
                    // The flag goes into the individual's own block, wherever that stands.
                    flagtail_ = flagpending_ && !holdsentryflag(e_.selection[k]);
                    break;
                }
            }
        } else if (mode_ == rewritemode::censusdates) {
            // An occupation outside an individual's record is not matched with anyone's census events.
            const auto it = indi ? peoplebyid_.find(static_cast<int32_t>(id)) : peoplebyid_.end();
            person_ = it == peoplebyid_.end() ? -1 : it->second;
        } else if (mode_ == rewritemode::flagchanges) {
            const auto it = indi ? changesbyid_.find(static_cast<int32_t>(id)) : changesbyid_.end();
            flagperson_ = it == changesbyid_.end() ? nullptr : &it->second;
            flagtail_ = flagperson_ != nullptr;
        }
    }

    // J: the line itself.
    if (!drop_ && !endline_)
        out_.writeline(line_);
}

void rewriterun::writecensusblock(const selectionrec& who)
{
    if (who.birthedited && s_.birthdate) {
        out_.writetext("1 BIRT");
        out_.writetext("2 DATE CAL " + oneline(who.birthdate));
        const std::string birthplace = oneline(who.birthplace);
        if (!birthplace.empty())
            out_.writetext("2 PLAC " + birthplace);
        writecitation(citekind::birth);
    }
    out_.writetext(s_.residence ? "1 RESI" : "1 CENS");
    out_.writetext("2 DATE " + entrydate_);
    out_.writetext("2 PLAC " + place_);
    if (!address_.empty())
        out_.writetext("2 ADDR " + address_);
    const std::string age = oneline(who.age) + u8(QString(who.agetype).toLower());
    out_.writetext("2 AGE " + age);
    writecitation(citekind::census);
    if (who.occupation.size() >= 2) {
        out_.writetext("1 OCCU " + oneline(who.occupation));
        out_.writetext("2 DATE " + entrydate_);
        if (s_.occplace)
            out_.writetext("2 PLAC " + place_);
        if (s_.occage)
            out_.writetext("2 AGE " + age);
        writecitation(citekind::occupation);
    }
}

void rewriterun::writecitation(citekind kind)
{
    out_.writefiletext("2 SOUR @" + sourcexref_ + "@");
    if (!reference_.empty() && (!s_.fullentry || s_.opt1whereinsource))
        out_.writetext("3 PAGE " + reference_);
    if (!s_.fullentry || s_.opt1entrydate) {
        out_.writetext("3 DATA");
        out_.writetext("4 DATE " + (s_.entrydatetoday ? gedcomtoday() : entrydate_));
    }
    if (kind == citekind::census && !s_.fullentry && !s_.sharednote) {
        if (hassourcetext_)
            writemultiline(out_, sourcetext_, "4 TEXT ", "5 CONT ");
        if (hasnotetext_)
            writemultiline(out_, notetext_, "3 NOTE ", "4 CONT ");
    }
    if (!s_.fullentry && s_.sharednote)
        out_.writetext("3 NOTE @N" + std::to_string(notenumber_) + "@");
    if (s_.certainty >= 0 && s_.certainty <= 3) {
        if (kind == citekind::birth && s_.birthsecondaryevidence)
            out_.writetext("3 QUAY 2");
        else
            out_.writetext("3 QUAY " + std::to_string(s_.certainty));
    }
    if (kind == citekind::census && !s_.fullentry) {
        for (const imagechoice& img : e_.chosenimages)
            out_.writefiletext((s_.image2event ? "2 OBJE " : "3 OBJE ") + objectpointer(img));
    }
    if (kind == citekind::census && s_.sourceinnote && (hassourcetext_ || hasnotetext_)) {
        std::string text = sourcetext_;
        if (hasnotetext_)
            text += "\r\n" + notetext_;
        writemultiline(out_, text, "2 NOTE ", "3 CONT ");
    }
}

// The first date of a census event: replaced when the date check gave a new one.
void rewriterun::dateline(std::string_view t)
{
    incensus_ = false;
    const std::string found = toutf8(trim(t).substr(7), ix_.encoding);
    for (const auto& [from, to] : dates_) {
        if (from == found) {
            out_.writetext("2 DATE " + to);
            drop_ = true;
            recordchanged_ = true;
            ++res_.censusdateschanged;
            return;
        }
    }
}

// The first date of an occupation: replaced when it is the old date of one of
// the individual's census events and the occupation cites that event's source.
void rewriterun::occupationdate(std::string_view t)
{
    inoccupation_ = false;
    if (person_ < 0)
        return;
    const personrec& p = ix_.people[static_cast<size_t>(person_)];
    if (p.census.empty())
        return;
    const std::string found = toutf8(trim(t).substr(7), ix_.encoding);
    const std::string* to = nullptr;
    for (const auto& d : dates_)
        if (d.first == found) {
            to = &d.second;
            break;
        }
    if (!to)
        return;

    held_.clear();
    held_.emplace_back(line_);
    for (;;) {
        if (!fetch()) {
            for (const std::string& h : held_)
                out_.writeline(h);
            drop_ = true;
            return;
        }
        const std::string_view u = lefttrim(line_);
        if (endline_ || startswith(u, "1 ") || startswith(u, "0 ")) {
            for (const std::string& h : held_)
                out_.writeline(h);
            reuse_ = true;
            return;
        }
        if (startswith(u, "2 SOUR @")) {
            const int64_t source = refnumber(u, 9);
            bool match = false;
            for (const censusrec& c : p.census) {
                if (c.citecount() > 0 && c.date == found
                    && std::find(c.sourceids.begin(), c.sourceids.end(), source) != c.sourceids.end()) {
                    match = true;
                    break;
                }
            }
            if (match) {
                out_.writetext("2 DATE " + *to);
                for (size_t k = 1; k < held_.size(); ++k)
                    out_.writeline(held_[k]);
                ++res_.occdateschanged;
                recordchanged_ = true;
                return; // the citation line goes on as read
            }
        }
        held_.emplace_back(line_);
    }
}

// The flags of an individual of the flag check: new ones first under one
// header, then the kept ones; a header only when a flag line remains.
void rewriterun::flagblock(std::string_view t)
{
    const int32_t madebefore = res_.flagchangesmade;
    std::vector<std::string_view> removing;
    bool header = false;
    for (size_t k : *flagperson_) {
        const flagchange& c = rq_.flagchanges[k];
        const flagrec& f = ix_.flags[static_cast<size_t>(c.flag)];
        if (!c.add) {
            removing.push_back(f.code);
            continue;
        }
        if (!header)
            out_.writetext("1 _FLGS");
        header = true;
        out_.writefiletext("2 " + f.code + " " + f.name);
        ++res_.flagchangesmade;
    }
    if (flagheader(t)) {
        for (;;) {
            if (!fetch())
                break;
            const std::string_view u = lefttrim(line_);
            if (endsflags(u))
                break;
            // A flag line is "2 " + code + " " + name: its code is compared whole.
            const std::string code = flagcodeof(u, ix_.encoding);
            if (!code.empty() && std::find(removing.begin(), removing.end(), code) != removing.end()) {
                ++res_.flagchangesmade;
                continue;
            }
            if (!header)
                out_.writetext("1 _FLGS");
            header = true;
            out_.writeline(line_);
        }
    }
    reuse_ = !exhausted_;
    flagperson_ = nullptr;
    recordchanged_ = recordchanged_ || res_.flagchangesmade > madebefore;
}

rewriteresult refuse(const QString& message)
{
    rewriteresult r;
    r.refused = true;
    r.message = message;
    return r;
}

// Runs over an opened reader and writer. The writer is left to be committed
// when the run went well, and cancelled otherwise.
rewriteresult runrewrite(linereader& in, linewriter& out, const gedcomindex& ix, const settings& s,
                         const rewriterequest& rq)
{
    if (const QString bad = checkflagnames(ix, s, rq, in.encoding()); !bad.isEmpty()) {
        out.cancel();
        return refuse(bad);
    }
    rewriterun run(in, out, ix, s, rq);
    rewriteresult r = run.run();
    if (r.error.isEmpty() && out.failed())
        r.error = out.errorstring();
    if (!r.error.isEmpty()) {
        out.cancel();
        r.message = rewritefailuremessage(rq.mode, r.error);
        return r;
    }
    // Everything asked for must have found its place, or the file is left as it was.
    if (!run.missing().isEmpty()) {
        out.cancel();
        return refuse(QStringLiteral("These individuals were not found in the family file: %1. The census entry was "
                                     "not added; please reload the file and try again.")
                          .arg(run.missing()));
    }
    if (rq.mode == rewritemode::attachimages && r.linksadded == 0 && !rq.entry.chosenimages.empty()) {
        out.cancel();
        return refuse(QStringLiteral("The source %1 (ID: %2) was not found in the family file, so the images were "
                                     "not attached. Please reload the file and try again.")
                          .arg(rq.entry.title.trimmed(), rq.entry.sourceid.trimmed()));
    }
    r.ok = true;
    return r;
}

void commit(linewriter& out, rewritemode mode, rewriteresult& r, const replacefile::lastcheck& check = {})
{
    if (!r.ok)
        return;
    const bool done = out.commit(check);
    r.inplace = out.inplace();
    r.writtenhash = out.writtenhash();
    if (done)
        return;
    r.ok = false;
    if (out.withdrawn()) {
        r.withdrawn = true;
        return;
    }
    r.damaged = out.damaged();
    r.error = out.errorstring();
    r.message = rewritefailuremessage(mode, r.error);
}

} // namespace

int32_t newnotenumber(int32_t maxnoteid)
{
    return maxnoteid >= 1 ? maxnoteid + 1 : 1;
}

rewriteresult rewritefile(const QString& inputpath, const QString& outputpath, const gedcomindex& index,
                          const settings& s, const rewriterequest& request,
                          const replacefile::lastcheck& beforereplace)
{
    rewriteresult r;
    {
        auto in = std::make_unique<linereader>();
        QString error;
        if (!in->open(inputpath, &error)) {
            r.error = error;
            r.message = rewritefailuremessage(request.mode, error);
            return r;
        }
        const QString bad = checkencodable(request, s, in->encoding());
        if (!bad.isEmpty())
            return refuse(bad);
        linewriter out(in->encoding(), in->hasbom());
        if (!out.open(outputpath)) {
            r.error = out.errorstring();
            r.message = rewritefailuremessage(request.mode, r.error);
            return r;
        }
        r = runrewrite(*in, out, index, s, request);
        // The input is closed before the output replaces the family file,
        // which may be the input itself.
        in.reset();
        commit(out, request.mode, r, beforereplace);
    }
    return r;
}

rewriteresult rewritebytes(std::string_view input, std::string& output, const gedcomindex& index, const settings& s,
                           const rewriterequest& request)
{
    linereader in;
    in.openbytes(input);
    const QString bad = checkencodable(request, s, in.encoding());
    if (!bad.isEmpty())
        return refuse(bad);
    linewriter out(in.encoding(), in.hasbom());
    // The new content is the old one and a little more: room for it at once.
    out.openmemory(input.size() + input.size() / 32 + 65536);
    rewriteresult r = runrewrite(in, out, index, s, request);
    commit(out, request.mode, r);
    output = r.ok ? out.takememory() : std::string();
    return r;
}

} // namespace qm

#include "writer/rewritechecks.h"

#include "model/dates.h"
#include "platform/clock.h"

#include <algorithm>
#include <limits>
#include <optional>

namespace qm {

namespace {

const char* modetext(rewritemode mode)
{
    switch (mode) {
    case rewritemode::censusentry:
        return "): Census entry not added and program will close when you press OK";
    case rewritemode::censusdates:
        return "): Dates were not changed and program will close when you press OK";
    case rewritemode::flagchanges:
        return "): Flags were not changed and program will close when you press OK";
    case rewritemode::attachimages:
        break;
    }
    return "): Images not attached and program will close when you press OK";
}


QString encodingtitle(textencoding enc)
{
    switch (enc) {
    case textencoding::windows1252:
        return QStringLiteral("Windows-1252 (ANSI)");
    case textencoding::other8bit:
        return QStringLiteral("a character set of which Quillmark writes only plain ASCII letters");
    default:
        return QString::fromLatin1(encodingname(enc)).toUpper();
    }
}


} // namespace

// The flag lines a run will write come from the flag table, whose names the
// user may have typed: they too must fit the file's encoding.
QString checkflagnames(const gedcomindex& ix, const settings& s, const rewriterequest& rq, textencoding enc)
{
    if (enc == textencoding::other8bit)
        enc = textencoding::windows1252; // names met in such a file come back to its own bytes
    std::vector<size_t> flags;
    if (rq.mode == rewritemode::censusentry && s.flaguse && !ix.flags.empty()) {
        if (const auto f = findentryflag(ix.flags, u8(rq.entry.entrydate.trimmed()), u8(s.country)))
            flags.push_back(*f);
    } else if (rq.mode == rewritemode::flagchanges) {
        for (const flagchange& c : rq.flagchanges)
            if (c.add && c.flag >= 0 && c.flag < static_cast<int32_t>(ix.flags.size()))
                flags.push_back(static_cast<size_t>(c.flag));
    }
    for (size_t f : flags) {
        const QString name = qs(ix.flags[f].code) + QLatin1Char(' ') + qs(ix.flags[f].name);
        if (const char32_t bad = unencodable(name, enc)) {
            return QStringLiteral("The flag %1 holds the character \"%2\", which this family file cannot hold: it is "
                                  "written in %3. Please rename the flag and try again. Nothing has been changed.")
                .arg(qs(ix.flags[f].name), QString::fromUcs4(&bad, 1), encodingtitle(enc));
        }
    }
    return {};
}


QString checkidentifiers(const gedcomindex& ix, const settings& s, const rewriterequest& rq)
{
    constexpr int32_t last = std::numeric_limits<int32_t>::max();
    const auto records = [](const auto& table, int64_t id) {
        return std::count_if(table.begin(), table.end(), [id](const auto& r) { return r.id == id; });
    };
    const auto twice = [](const QString& what) {
        return QStringLiteral("%1 belongs to two records of the family file, so Quillmark cannot tell which one is "
                              "meant. Please give one of them another number in Family Historian, then try again. "
                              "Nothing has been changed.")
            .arg(what);
    };
    const auto nonumber = [](const QString& what) {
        return QStringLiteral("The family file has no record number left for a new %1: its highest is %2, the "
                              "largest a GEDCOM identifier can take here. Nothing has been changed.")
            .arg(what)
            .arg(last);
    };
    const censusentry& e = rq.entry;
    const bool census = rq.mode == rewritemode::censusentry;
    if (census)
        for (const selectionrec& who : e.selection)
            if (records(ix.people, who.id) > 1)
                return twice(QStringLiteral("The record number %1 of %2").arg(who.id).arg(who.name));
    const int64_t source = e.sourceid.trimmed().toLongLong();
    if (census && s.fullentry) {
        if (source <= 0 || source > last || records(ix.sources, source) > 0)
            return nonumber(QStringLiteral("source"));
    } else if (census || rq.mode == rewritemode::attachimages) {
        if (records(ix.sources, source) > 1)
            return twice(QStringLiteral("The source number %1").arg(source));
    }
    if (census && !s.fullentry && s.sharednote && ix.maxnoteid >= last)
        return nonumber(QStringLiteral("note"));
    if (census || rq.mode == rewritemode::attachimages)
        for (const imagechoice& img : e.chosenimages)
            if (img.isnew && (img.objectid <= 0 || records(ix.objects, img.objectid) > 0))
                return nonumber(QStringLiteral("multimedia record"));
    return {};
}

std::string gedcomtoday()
{
    return u8(formatgedcomdate(now().date()));
}

std::string gedcomtimenow()
{
    return u8(formatgedcomtime(now().time()));
}

QString rewritefailuremessage(rewritemode mode, const QString& description)
{
    return QStringLiteral("An error occurred (") + description + QString::fromLatin1(modetext(mode));
}

namespace {

// A character typed text must not carry into the family file: a control
// character (C0, DEL, C1). Line breaks are taken (a one-line value turns them
// into spaces), and tabs only in the source text and the note.
std::optional<char32_t> controlcharacter(const QString& text, bool multiline)
{
    for (const QChar c : text) {
        const char16_t u = c.unicode();
        if (u == u'\r' || u == u'\n' || (multiline && u == u'\t'))
            continue;
        if (u < 0x20 || (u >= 0x7F && u <= 0x9F))
            return u;
    }
    return std::nullopt;
}

QString codeof(char32_t c)
{
    return QString::number(static_cast<uint>(c), 16).toUpper().rightJustified(4, QLatin1Char('0'));
}

} // namespace

QString checkencodable(const rewriterequest& rq, const settings& s, textencoding enc)
{
    struct typed {
        QString what; // what the user calls it
        QString text;
        bool multiline = false;
    };
    std::vector<typed> texts;
    const censusentry& e = rq.entry;
    const auto add = [&](const QString& what, const QString& text, bool multiline = false) {
        texts.push_back({what, text, multiline});
    };
    if (rq.mode == rewritemode::censusentry) {
        add(QStringLiteral("source number"), e.sourceid);
        add(QStringLiteral("title"), e.title);
        add(QStringLiteral("place"), e.place);
        add(QStringLiteral("address"), e.address);
        add(QStringLiteral("reference"), e.reference);
        add(QStringLiteral("other information"), e.other);
        add(QStringLiteral("census date"), e.entrydate);
        add(QStringLiteral("source text"), e.sourcetext, true);
        add(QStringLiteral("note"), e.notetext, true);
        if (s.fullentry)
            add(QStringLiteral("source type (Options)"), s.sourcetype);
        for (const selectionrec& who : e.selection) {
            add(QStringLiteral("age of ") + who.name, who.age + QString(who.agetype));
            add(QStringLiteral("occupation of ") + who.name, who.occupation);
            if (who.birthedited && s.birthdate) {
                add(QStringLiteral("birth date of ") + who.name, who.birthdate);
                add(QStringLiteral("birth place of ") + who.name, who.birthplace);
            }
        }
    }
    if (rq.mode == rewritemode::attachimages)
        add(QStringLiteral("source number"), e.sourceid);
    if (rq.mode == rewritemode::censusentry || rq.mode == rewritemode::attachimages) {
        for (const imagechoice& img : e.chosenimages) {
            if (!img.isnew)
                continue;
            add(QStringLiteral("image type"), img.form);
            add(QStringLiteral("image title"), img.title);
            add(QStringLiteral("image file name"), img.file);
            add(QStringLiteral("image date"), img.date);
        }
    }
    if (rq.mode == rewritemode::censusdates)
        for (const datechange& d : rq.datechanges)
            if (d.applies())
                add(QStringLiteral("new census date"), d.newdate);

    for (const typed& t : texts) {
        if (const std::optional<char32_t> bad = controlcharacter(t.text, t.multiline))
            return QStringLiteral("The %1 holds a control character (U+%2), which must not be written into a family "
                                  "file. Please remove it and save again. Nothing has been changed.")
                .arg(t.what, codeof(*bad));
        const char32_t bad = unencodable(t.text, enc);
        if (!bad)
            continue;
        const QString ch = QString::fromUcs4(&bad, 1);
        return QStringLiteral("The %1 holds the character \"%2\" (U+%3), which this family file cannot hold: it is "
                              "written in %4. Please replace the character and save again. Nothing has been changed.")
            .arg(t.what, ch, codeof(bad), encodingtitle(enc));
    }
    return {};
}


} // namespace qm

#include "writer/rewritechecks.h"

#include "model/dates.h"
#include "platform/clock.h"

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

QString checkencodable(const rewriterequest& rq, const settings& s, textencoding enc)
{
    std::vector<std::pair<QString, QString>> texts; // what the user calls it, the text
    const censusentry& e = rq.entry;
    const auto add = [&](const QString& what, const QString& text) { texts.emplace_back(what, text); };
    if (rq.mode == rewritemode::censusentry) {
        add(QStringLiteral("source number"), e.sourceid);
        add(QStringLiteral("title"), e.title);
        add(QStringLiteral("place"), e.place);
        add(QStringLiteral("address"), e.address);
        add(QStringLiteral("reference"), e.reference);
        add(QStringLiteral("census date"), e.entrydate);
        add(QStringLiteral("source text"), e.sourcetext);
        add(QStringLiteral("note"), e.notetext);
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

    for (const auto& [what, text] : texts) {
        const char32_t bad = unencodable(text, enc);
        if (!bad)
            continue;
        const QString ch = QString::fromUcs4(&bad, 1);
        const QString code = QString::number(static_cast<uint>(bad), 16).toUpper().rightJustified(4, QLatin1Char('0'));
        return QStringLiteral("The %1 holds the character \"%2\" (U+%3), which this family file cannot hold: it is "
                              "written in %4. Please replace the character and save again. Nothing has been changed.")
            .arg(what, ch, code, encodingtitle(enc));
    }
    return {};
}


} // namespace qm

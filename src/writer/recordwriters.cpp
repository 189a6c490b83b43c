#include "writer/recordwriters.h"

#include "writer/rewritefile.h"

namespace qm {

std::string oneline(const QString& text)
{
    QString t = text.trimmed();
    t.replace(QStringLiteral("\r\n"), QStringLiteral(" "));
    t.replace(QLatin1Char('\r'), QLatin1Char(' '));
    t.replace(QLatin1Char('\n'), QLatin1Char(' '));
    return typedvalue(u8(t));
}

std::string typedvalue(std::string value)
{
    // "@N1@" as a value is a pointer to note 1; "@@N1@" is the text "@N1@".
    if (!value.empty() && value.front() == '@')
        value.insert(value.begin(), '@');
    return value;
}

void writemultiline(linewriter& out, std::string_view text, std::string_view first, std::string_view cont)
{
    std::string buf(first);
    for (size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (c == '\r' || c == '\n') {
            out.writetext(buf);
            buf.assign(cont);
            if (c == '\r' && i + 1 < text.size() && text[i + 1] == '\n')
                ++i;
        } else {
            // Every line's value is typed text: a leading "@" is written "@@" (typedvalue).
            if (c == '@' && (buf == first || buf == cont))
                buf.push_back('@');
            buf.push_back(c);
        }
    }
    if (buf != cont)
        out.writetext(buf);
}

std::string objectpointer(const imagechoice& image)
{
    return "@" + (image.xref.isEmpty() ? "O" + std::to_string(image.objectid) : u8(image.xref)) + "@";
}

void writechangestamp(linewriter& out)
{
    out.writetext("1 CHAN");
    out.writetext("2 DATE " + gedcomtoday());
    out.writetext("3 TIME " + gedcomtimenow());
}

int32_t writeobjectrecords(linewriter& out, const std::vector<imagechoice>& images, const settings& s,
                           int32_t maxobjectid)
{
    for (const imagechoice& img : images) {
        if (!img.isnew)
            continue;
        out.writetext("0 @O" + std::to_string(img.objectid) + "@ OBJE");
        maxobjectid = img.objectid;
        const std::string form = oneline(img.form.toLower());
        if (!form.empty())
            out.writetext("1 FORM " + form);
        out.writetext("1 TITL " + oneline(img.title));
        out.writetext("1 _FILE " + oneline(img.file));
        out.writetext("1 _DATE " + oneline(img.date));
        if (s.fullentry && s.asid) {
            out.writetext("1 NOTE ");
            out.writetext("2 _ASID 1");
        }
        writechangestamp(out);
    }
    return maxobjectid;
}

void writeimagelinks(linewriter& out, const std::vector<imagechoice>& images, const settings& s)
{
    for (const imagechoice& img : images) {
        out.writefiletext("1 OBJE " + objectpointer(img));
        if (img.isnew && s.asid)
            out.writetext("2 _ASID 1");
    }
}

void writesourcerecord(linewriter& out, const censusentry& entry, const settings& s)
{
    out.writetext("0 @S" + oneline(entry.sourceid) + "@ SOUR");
    const std::string reference = oneline(entry.reference);
    if (!reference.empty() && s.opt1publicationinfo)
        out.writetext("1 PUBL " + reference);
    out.writetext("1 TITL " + oneline(entry.title));
    if (!s.sourcetype.isEmpty()) {
        // The source type is written as stored, only kept to one line.
        QString type = s.sourcetype;
        type.replace(QLatin1Char('\r'), QLatin1Char(' ')).replace(QLatin1Char('\n'), QLatin1Char(' '));
        out.writetext("1 _TYPE " + typedvalue(u8(type)));
    }
    const bool hasnote = !entry.notetext.trimmed().isEmpty();
    writemultiline(out, u8(entry.sourcetext), s.sourcenote && !hasnote ? "1 NOTE " : "1 TEXT ", "2 CONT ");
    if (hasnote)
        writemultiline(out, u8(entry.notetext), "1 NOTE ", "2 CONT ");
    if (s.fullentry)
        writeimagelinks(out, entry.chosenimages, s);
    writechangestamp(out);
}

std::string censusyear(const QString& entrydate, int fallback)
{
    const QString t = entrydate.trimmed();
    if (t.size() >= 4) {
        const QString tail = t.right(4);
        bool digits = true;
        for (QChar c : tail)
            digits = digits && c >= u'0' && c <= u'9';
        if (digits && (t.size() == 4 || t.at(t.size() - 5) == u' '))
            return u8(tail);
    }
    return fallback > 0 ? std::to_string(fallback) : u8(t);
}

void writenoterecord(linewriter& out, int32_t notenumber, const censusentry& entry)
{
    out.writetext("0 @N" + std::to_string(notenumber) + "@ NOTE Census " + censusyear(entry.entrydate, entry.year) + " "
                  + oneline(entry.place));
    out.writetext("1 CONT " + oneline(entry.reference));
    const std::string address = oneline(entry.address);
    if (!address.empty())
        out.writetext("1 CONT " + address);
    out.writetext("1 CONT ");
    std::string body = u8(entry.sourcetext);
    if (!entry.notetext.trimmed().isEmpty())
        body += "\r\nNote:\r\n" + u8(entry.notetext);
    writemultiline(out, body, "1 CONT ", "1 CONT ");
    writechangestamp(out);
}

} // namespace qm

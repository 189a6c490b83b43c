// Safe writing of the family file: encodings kept, and unencodable text
// refused before anything is written. (A failure at any step leaving the
// file byte for byte as it was: saveroad_test.cpp.)

#include "writer/rewritefile.h"

#include "model/loadgedcom.h"
#include "support/savefolder.h"
#include "support/censusentries.h"
#include "support/goldenfiles.h"

#include <QStringEncoder>

using namespace qm;
using qmtest::readfile;
using qmtest::writefile;

namespace {

std::string familytext(const char* charset)
{
    return std::string("0 HEAD\r\n1 CHAR ") + charset
           + "\r\n0 @I1@ INDI\r\n1 NAME Zo\xC3\xAB /Bront\xC3\xAB/\r\n1 CHAN\r\n2 DATE 1 JAN 2020\r\n"
             "0 @S1@ SOUR\r\n1 TITL Census\r\n0 TRLR\r\n";
}

std::string expectedtext(const char* charset)
{
    return std::string("0 HEAD\r\n1 CHAR ") + charset
           + "\r\n0 @I1@ INDI\r\n1 NAME Zo\xC3\xAB /Bront\xC3\xAB/\r\n"
             "1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC Haworth\r\n2 AGE 30y\r\n2 SOUR @S2@\r\n"
             "1 OCCU Cur\xC3\xA9\r\n2 DATE 3 APR 1881\r\n2 PLAC Haworth\r\n2 SOUR @S2@\r\n"
             "1 CHAN\r\n2 DATE 04 DEC 2026\r\n3 TIME 13:05:09\r\n"
             "0 @S1@ SOUR\r\n1 TITL Census\r\n"
             "0 @S2@ SOUR\r\n1 TITL Census 1881 Haworth\r\n1 _TYPE Census\r\n1 TEXT Zo\xC3\xAB Bront\xC3\xAB\tHead\r\n"
             "1 CHAN\r\n2 DATE 04 DEC 2026\r\n3 TIME 13:05:09\r\n0 TRLR\r\n";
}

// UTF-8 text in a file's encoding.
std::string encoded(const std::string& utf8, textencoding enc, bool bom)
{
    std::string out;
    if (enc == textencoding::windows1252) {
        fromutf8(utf8, textencoding::windows1252, out);
        return out;
    }
    QStringEncoder encoder(enc == textencoding::utf16le   ? QStringConverter::Utf16LE
                           : enc == textencoding::utf16be ? QStringConverter::Utf16BE
                                                          : QStringConverter::Utf8,
                           bom ? QStringConverter::Flag::WriteBom : QStringConverter::Flag::Default);
    const QByteArray bytes = encoder.encode(QString::fromStdString(utf8));
    return std::string(bytes.constData(), static_cast<size_t>(bytes.size()));
}

rewriterequest entry(const gedcomindex& ix)
{
    rewriterequest r;
    r.entry = qmtest::censusof(QString::number(ix.nextsourceid), "Census 1881 Haworth", "Haworth");
    r.entry.sourcetext = QString::fromUtf8("Zo\xC3\xAB Bront\xC3\xAB\tHead");
    r.entry.selection.push_back(qmtest::chosen(1, 0, "Bronte, Zoe", "30", "Cur\xC3\xA9"));
    return r;
}

struct encodingcase {
    const char* name;
    textencoding enc;
    bool bom;
    const char* charset;
};

class RewriteEncoding : public ::testing::TestWithParam<encodingcase> {
protected:
    qmtest::fixedclock clock{QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9))};
};

} // namespace

TEST_P(RewriteEncoding, WritesTheFileBackInItsOwnEncoding)
{
    const encodingcase& c = GetParam();
    const std::string input = encoded(familytext(c.charset), c.enc, c.bom);
    auto ix = loadgedcombytes(input, {});
    ASSERT_TRUE(ix);
    std::string out;
    const rewriteresult r = rewritebytes(input, out, *ix, settings{}, entry(*ix));
    ASSERT_TRUE(r.ok) << r.message.toStdString();
    EXPECT_TRUE(qmtest::samebytes(encoded(expectedtext(c.charset), c.enc, c.bom), out));

    // Line ends of any kind come back as CR LF.
    std::string lf = familytext(c.charset);
    for (size_t at; (at = lf.find("\r\n")) != std::string::npos;)
        lf.erase(at, 1);
    std::string outlf;
    ASSERT_TRUE(rewritebytes(encoded(lf, c.enc, c.bom), outlf, *ix, settings{}, entry(*ix)).ok);
    EXPECT_TRUE(qmtest::samebytes(out, outlf));

    // A UTF-16 file of an odd length keeps its stray last byte.
    if (isutf16(c.enc)) {
        std::string odd;
        ASSERT_TRUE(rewritebytes(input + '\x5A', odd, *ix, settings{}, entry(*ix)).ok);
        EXPECT_TRUE(qmtest::samebytes(out + '\x5A', odd));
    }
}

INSTANTIATE_TEST_SUITE_P(Encodings, RewriteEncoding,
                         ::testing::Values(encodingcase{"utf8", textencoding::utf8, false, "UTF-8"},
                                           encodingcase{"utf8bom", textencoding::utf8, true, "UTF-8"},
                                           encodingcase{"utf16lebom", textencoding::utf16le, true, "UNICODE"},
                                           encodingcase{"utf16le", textencoding::utf16le, false, "UNICODE"},
                                           encodingcase{"utf16bebom", textencoding::utf16be, true, "UNICODE"},
                                           encodingcase{"utf16be", textencoding::utf16be, false, "UNICODE"},
                                           encodingcase{"windows1252", textencoding::windows1252, false, "ANSI"}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST(RewriteRefusal, TextTheEncodingCannotHoldIsRefusedBeforeAnythingIsWritten)
{
    QTemporaryDir dir;
    const QString family = dir.filePath(QStringLiteral("family.ged"));
    const std::string input = encoded(familytext("ANSI"), textencoding::windows1252, false);
    writefile(family, input);
    auto ix = loadgedcombytes(input, {});
    rewriterequest r = entry(*ix);
    r.entry.place = QString::fromUtf8("\xC5\x81\xC3\xB3""d\xC5\xBA"); // Łódź: Ł is not in Windows-1252

    const rewriteresult res = rewritefile(family, family, *ix, settings{}, r);
    EXPECT_FALSE(res.ok);
    EXPECT_TRUE(res.refused);
    EXPECT_TRUE(res.message.contains(QStringLiteral("place"))) << res.message.toStdString();
    EXPECT_TRUE(res.message.contains(QStringLiteral("U+0141"))) << res.message.toStdString();
    EXPECT_EQ(checkencodable(r, settings{}, textencoding::windows1252), res.message);
    EXPECT_EQ(readfile(family), input);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).size(), 1);

    // The same text is fine in UTF-8 and UTF-16; for other character sets only ASCII is typed.
    EXPECT_TRUE(checkencodable(r, settings{}, textencoding::utf8).isEmpty());
    EXPECT_TRUE(checkencodable(r, settings{}, textencoding::utf16be).isEmpty());
    r.entry.place = QStringLiteral("Haworth");
    EXPECT_FALSE(checkencodable(r, settings{}, textencoding::other8bit).isEmpty()); // the occupation Curé
    EXPECT_TRUE(checkencodable(r, settings{}, textencoding::windows1252).isEmpty());
}

// Control characters never reach the family file; the message names the field.
TEST(RewriteRefusal, ControlCharactersAreRefusedNamingTheField)
{
    const struct {
        void (*put)(censusentry& e);
        const char* field; // "" when the text is taken
    } rows[] = {
        {[](censusentry& e) { e.place = QStringLiteral("Leeds\x1b[31m"); }, "place"},
        {[](censusentry& e) { e.other = QStringLiteral("a") + QChar(0) + u'b'; }, "other information"},
        {[](censusentry& e) { e.title = QStringLiteral("Census\x7f"); }, "title"},
        {[](censusentry& e) { e.sourcetext = QStringLiteral("a\vb"); }, "source text"},
        {[](censusentry& e) { e.notetext = QStringLiteral("a\fb"); }, "note"},
        {[](censusentry& e) { e.selection[0].occupation = QStringLiteral("Cur\u0085"); }, "occupation of Bronte, Zoe"},
        {[](censusentry& e) { e.place = QStringLiteral("a\tb"); }, "place"},
        {[](censusentry& e) {
             e.sourcetext = QStringLiteral("a\tb\r\nc\nd"); // tabs and line breaks of texts are taken
             e.notetext = QStringLiteral("x\ty\r\n");
         },
         ""},
    };
    const auto ix = loadgedcombytes(familytext("UTF-8"), {});
    for (const auto& row : rows) {
        SCOPED_TRACE(row.field);
        rewriterequest r = entry(*ix);
        row.put(r.entry);
        const QString message = checkencodable(r, settings{}, textencoding::utf8);
        if (*row.field == 0) {
            EXPECT_TRUE(message.isEmpty()) << message.toStdString();
            continue;
        }
        EXPECT_TRUE(message.startsWith(QStringLiteral("The ") + QString::fromUtf8(row.field)
                                       + QStringLiteral(" holds a control character (U+")))
            << message.toStdString();
        EXPECT_TRUE(message.endsWith(QStringLiteral("Nothing has been changed.")));
    }
}

// A typed text that begins with "@" is written "@@", so that no reader takes
// it for a pointer to a record.
TEST(RewriteTypedText, LeadingAtSignIsDoubled)
{
    const std::string input = familytext("UTF-8");
    const auto ix = loadgedcombytes(input, {});
    rewriterequest r = entry(*ix);
    r.entry.place = QStringLiteral("@home");
    r.entry.reference = QStringLiteral("@R1@");
    r.entry.sourcetext = QStringLiteral("@N1@\r\nx @ y\r\n@S1@");
    r.entry.notetext = QStringLiteral("@N2@");
    r.entry.selection[0].occupation = QStringLiteral("@I1@");
    settings s;
    s.fullentry = false;
    s.sourceinnote = true;
    const auto expectlines = [&](std::initializer_list<const char*> lines) {
        std::string out;
        ASSERT_TRUE(rewritebytes(input, out, *ix, s, r).ok);
        for (const char* line : lines)
            EXPECT_NE(out.find(line), std::string::npos) << line << "\n" << out;
    };
    expectlines({"2 PLAC @@home\r\n", "3 PAGE @@R1@\r\n", "4 TEXT @@N1@\r\n5 CONT x @ y\r\n5 CONT @@S1@\r\n",
                 "3 NOTE @@N2@\r\n", "1 OCCU @@I1@\r\n", "2 NOTE @@N1@\r\n"});
    s.fullentry = true;
    r.entry.title = QStringLiteral("@T1@");
    expectlines({"1 TITL @@T1@\r\n", "1 TEXT @@N1@\r\n2 CONT x @ y\r\n2 CONT @@S1@\r\n", "1 NOTE @@N2@\r\n"});
}

TEST(RewriteRefusal, OtherCharacterSetsKeepTheirBytesAndTakeAsciiText)
{
    // An ANSEL file: its bytes are kept, whatever they mean.
    const std::string input = "0 HEAD\r\n1 CHAR ANSEL\r\n0 @I1@ INDI\r\n1 NAME Ren\xE2""e /Doe/\r\n0 TRLR\r\n";
    auto ix = loadgedcombytes(input, {});
    rewriterequest r = entry(*ix);
    r.entry.selection[0].occupation = QStringLiteral("Cure");
    r.entry.sourcetext = QStringLiteral("Renee Doe");
    std::string out;
    ASSERT_TRUE(rewritebytes(input, out, *ix, settings{}, r).ok);
    EXPECT_NE(out.find("1 NAME Ren\xE2""e /Doe/\r\n1 CENS\r\n"), std::string::npos);
}

TEST(RewriteMessages, EachModeHasItsOwnFailureText)
{
    for (const auto& [mode, says] : {std::pair{rewritemode::censusdates, "Dates were not changed"},
                                     std::pair{rewritemode::flagchanges, "Flags were not changed"},
                                     std::pair{rewritemode::attachimages, "Images not attached"}})
        EXPECT_EQ(rewritefailuremessage(mode, QStringLiteral("Disk full")),
                  QStringLiteral("An error occurred (Disk full): %1 and program will close when you press OK").arg(QLatin1String(says)));
}

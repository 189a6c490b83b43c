// Census dates of existing sources, the source list of Attach Images to
// Existing Sources, and the index after an attach.
#include "images/sourcedates.h"

#include "model/loadgedcom.h"
#include "platform/linereader.h"
#include "support/testfiles.h"

#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

// Sources 1 and 2 are census sources, 3 is a parish register.
const std::string sources = "0 @S1@ SOUR\r\n1 TITL Census 1881 Leeds\r\n"
                            "0 @S2@ SOUR\r\n1 TITL 1881 CENSUS York\r\n1 OBJE @O1@\r\n"
                            "0 @S3@ SOUR\r\n1 TITL Parish register of Leeds\r\n"
                            "0 @O1@ OBJE\r\n1 TITL York page\r\n1 _FILE york.jpg\r\n0 TRLR\r\n";

struct indexed {
    std::string bytes;
    std::unique_ptr<gedcomindex> index;

    const sourcerec& source(int32_t id) const
    {
        for (const sourcerec& s : index->sources)
            if (s.id == id)
                return s;
        throw std::runtime_error("no such source");
    }
};

// The index of a file holding these individuals and the sources above, with
// the census dates worked out.
indexed withdates(const std::string& individuals)
{
    indexed r;
    r.bytes = "0 HEAD\r\n1 CHAR ANSI\r\n" + individuals + sources;
    r.index = loadgedcombytes(r.bytes, {});
    linereader reader;
    reader.openbytes(r.bytes);
    findcensusdates(*r.index, reader);
    return r;
}

std::string person(int id, const std::string& events)
{
    return "0 @I" + std::to_string(id) + "@ INDI\r\n1 NAME John /Smith/\r\n" + events;
}

std::string event(const char* tag, const char* date, int source)
{
    return std::string("1 ") + tag + "\r\n2 DATE " + date + "\r\n2 SOUR @S" + std::to_string(source) + "@\r\n";
}

} // namespace

// A source's census date is the one date every census event citing it shares.
TEST(SourceDates, OneDateSharedByEveryCitationIsTheCensusDate)
{
    const std::string census = event("CENS", "3 APR 1881", 1), birth = event("BIRT", "12 MAY 1850", 1);
    const struct {
        std::string individuals;
        int32_t source;
        const char* date;
    } cases[] = {
        {person(1, census) + person(2, event("CENS", "3 apr 1881 ", 1)), 1, "3 APR 1881"},
        {person(1, census), 2, "Unknown"}, // never cited
        {person(1, census) + person(2, event("CENS", "4 APR 1881", 1)), 1, "Unknown"},
        // A qualified date first: a later plain one does not settle it.
        {person(1, event("CENS", "ABT 1881", 1)) + person(2, census), 1, "Unknown"},
        {person(1, event("CENS", "1881", 1)), 1, "Unknown"},
        // Birth events citing a census source are passed over; other sources
        // take a birth's date like any other.
        {person(1, birth + census), 1, "3 APR 1881"},
        {person(1, census + birth), 1, "3 APR 1881"},
        {person(1, event("BIRT", "12 MAY 1850", 3)), 3, "12 MAY 1850"},
        // A citation before its event's date, or in a change stamp, or in a
        // record of its own, counts for nothing; indented lines are read.
        {person(1, "1 CENS\r\n2 SOUR @S1@\r\n2 DATE 4 APR 1881\r\n1 CHAN\r\n2 DATE 9 MAY 2022\r\n2 SOUR @S1@\r\n"
                   "1 RESI\r\n2 DATE 3 APR 1881\r\n")
             + "0 @I2@ INDI\r\n2 SOUR @S1@\r\n" + person(3, "  1 CENS\r\n\t2 DATE 3 APR 1881\r\n  2 SOUR @S1@\r\n"),
         1, "3 APR 1881"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(sourcedatetext(withdates(c.individuals).source(c.source)), QString::fromLatin1(c.date)) << c.individuals;
}

TEST(SourceDates, SettledSourcesKeepTheirDates)
{
    indexed x = withdates(person(1, event("CENS", "3 APR 1881", 1)));
    // Worked out again at the next opening: the same date changes nothing.
    linereader again;
    again.openbytes(x.bytes);
    findcensusdates(*x.index, again);
    EXPECT_EQ(sourcedatetext(x.source(1)), "3 APR 1881");

    QTemporaryDir dir;
    x.index->gedcomfile = dir.filePath(QStringLiteral("missing.ged"));
    EXPECT_FALSE(findcensusdates(*x.index).isEmpty());
}

TEST(SourceDates, SourceListFilters)
{
    indexed x = withdates(person(1, event("CENS", "3 APR 1881", 1)));
    const gedcomindex& ix = *x.index;
    EXPECT_EQ(filtersources(ix, sourcefilter::all, {}, false), (std::vector<int32_t>{0, 1, 2}));
    EXPECT_EQ(filtersources(ix, sourcefilter::census, {}, false), (std::vector<int32_t>{0, 1}));
    EXPECT_EQ(filtersources(ix, sourcefilter::census, {}, true), (std::vector<int32_t>{0}));
    // Search text: trimmed, letter case ignored.
    EXPECT_EQ(filtersources(ix, sourcefilter::text, QStringLiteral("  LEEDS "), false), (std::vector<int32_t>{0, 2}));
    EXPECT_EQ(filtersources(ix, sourcefilter::text, QStringLiteral("census 1881"), false), (std::vector<int32_t>{0}));
    EXPECT_EQ(filtersources(ix, sourcefilter::text, QStringLiteral("Hull"), false), (std::vector<int32_t>{}));

    EXPECT_EQ(sourcecounttext(1), "1 source");
    EXPECT_EQ(sourcecounttext(2), "2 sources");
}

TEST(SourceDates, SelectedSourceDetails)
{
    const indexed x = withdates(person(1, event("CENS", "3 APR 1881", 2) + event("OCCU", "3 APR 1881", 2))
                                + person(2, event("CENS", "3 APR 1881", 1))
                                + person(3, event("CENS", "3 APR 1881", 2)));
    EXPECT_EQ(citingpeople(*x.index, 2), (std::vector<int32_t>{0, 2}));
    EXPECT_EQ(citingpeople(*x.index, 3), (std::vector<int32_t>{}));
    EXPECT_EQ(attachedimagetitles(*x.index, x.source(2)), QStringList{QStringLiteral("York page")});
}

TEST(SourceDates, AttachingBringsTheIndexUpToDate)
{
    indexed x = withdates(person(1, event("CENS", "3 APR 1881", 1)));
    gedcomindex& ix = *x.index;
    ASSERT_EQ(ix.maxobjectid, 1);
    imagechoice fresh{2, QStringLiteral("png"), QStringLiteral("Census 1881 Leeds"), QStringLiteral("/p/leeds é.png"),
                      QStringLiteral("3 APR 1881"), true, 1, {}};
    imagechoice existing{1, QStringLiteral("jpg"), QStringLiteral("York page"), QStringLiteral("york.jpg"), {}, false, 0, {}};
    filestamp stamp{true, 1234, 99};
    recordattached(ix, 0, {fresh, existing}, stamp);

    ASSERT_EQ(ix.objects.size(), 2u);
    const objectrec& o = ix.objects.back();
    EXPECT_EQ(o.id, 2);
    EXPECT_EQ(qs(o.file), QStringLiteral("/p/leeds é.png"));
    EXPECT_EQ(ix.sources[0].objectids, (std::vector<int32_t>{2, 1}));
    EXPECT_EQ(ix.maxobjectid, 2);
    EXPECT_EQ(ix.gedcomdate, stamp);
    EXPECT_EQ(attachedimagetitles(ix, ix.sources[0]),
              (QStringList{QStringLiteral("Census 1881 Leeds"), QStringLiteral("York page")}));

    // The source now has images: the list of sources without any drops it.
    EXPECT_EQ(filtersources(ix, sourcefilter::census, {}, true), (std::vector<int32_t>{}));
}

TEST(SourceDates, ImagesAlreadyLinkedAreLeftOut)
{
    const indexed x = withdates(person(1, event("CENS", "3 APR 1881", 2)));
    const sourcerec& york = x.source(2); // linked to O1
    imagechoice fresh{1, QStringLiteral("png"), QStringLiteral("New"), QStringLiteral("new.png"), {}, true, 1, {}};
    imagechoice page{1, QStringLiteral("jpg"), QStringLiteral("York page"), QStringLiteral("york.jpg"), {}, false, 0, {}};
    std::vector<imagechoice> chosen{fresh, page};
    const std::vector<imagechoice> dropped = dropalreadylinked(york, chosen);
    ASSERT_EQ(chosen.size(), 1u);
    EXPECT_TRUE(chosen[0].isnew);
    ASSERT_EQ(dropped.size(), 1u);
    EXPECT_EQ(alreadylinkedmessage(dropped),
              "The image 'York page' (ID: 1) is already attached to this source, so it is not attached again.");
    // Another source takes it.
    std::vector<imagechoice> other{page};
    EXPECT_TRUE(dropalreadylinked(x.source(1), other).empty());
    EXPECT_EQ(other.size(), 1u);
}

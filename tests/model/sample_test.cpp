// The bundled sample file must load as a Family Historian file with the
// households its README promises, since users try the program on it first.

#include "model/loadgedcom.h"

#include "support/testfiles.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

using namespace qm;

namespace {

const personrec* findperson(const gedcomindex& index, int32_t id)
{
    for (const personrec& p : index.people)
        if (p.id == id)
            return &p;
    return nullptr;
}

bool hascensus(const personrec& p, std::string_view date)
{
    return std::any_of(p.census.begin(), p.census.end(), [&](const censusrec& c) { return c.date == date; });
}

TEST(SampleFile, IsCrLfUtf8FamilyHistorianFile)
{
    const std::string bytes = qmtest::readfile(qmtest::samplefile());
    ASSERT_FALSE(bytes.empty());
    EXPECT_EQ(bytes.rfind("0 HEAD\r\n1 SOUR FAMILY_HISTORIAN\r\n", 0), 0u);
    EXPECT_NE(bytes.find("\r\n1 CHAR UTF-8\r\n"), std::string::npos);
    EXPECT_TRUE(bytes.ends_with("\r\n0 TRLR\r\n"));
    size_t lf = 0;
    for (size_t i = 0; i < bytes.size(); ++i)
        if (bytes[i] == '\n') {
            ++lf;
            EXPECT_TRUE(i > 0 && bytes[i - 1] == '\r') << "bare LF at byte " << i;
        }
    EXPECT_GT(lf, 1000u);
}

TEST(SampleFile, LoadsTheFamiliesItDescribes)
{
    const loadresult r = loadgedcom(qmtest::samplefile(), flagtable{});
    ASSERT_TRUE(r.index) << r.error.toStdString();
    const gedcomindex& ix = *r.index;
    EXPECT_EQ(ix.encoding, textencoding::utf8);
    EXPECT_EQ(ix.people.size(), 40u);
    EXPECT_EQ(ix.sources.size(), 11u);
    EXPECT_EQ(ix.censussources.size(), 9u);
    EXPECT_EQ(ix.objects.size(), 2u);
    EXPECT_EQ(ix.maxobjectid, 2);
    EXPECT_EQ(ix.maxnoteid, 1);
    EXPECT_EQ(ix.nextsourceid, 12);

    const personrec* emile = findperson(ix, 21);
    ASSERT_NE(emile, nullptr);
    EXPECT_EQ(emile->name, "Durand, \xc3\x89mile");
    EXPECT_EQ(emile->birthdate, "ABT 1835");
    EXPECT_EQ(emile->deathdate, "11 DEC 1895");

    // The 1881 household left for the user to enter.
    for (int32_t id : {11, 27, 28, 29}) {
        const personrec* p = findperson(ix, id);
        ASSERT_NE(p, nullptr) << id;
        EXPECT_FALSE(hascensus(*p, "3 APR 1881")) << id;
    }
    const personrec* frederick = findperson(ix, 29);
    EXPECT_EQ(frederick->birthdate, "14 FEB 1881");
    EXPECT_EQ(frederick->famc, 7);

    const personrec* john = findperson(ix, 3);
    ASSERT_NE(john, nullptr);
    EXPECT_EQ(john->census.size(), 5u);
    EXPECT_EQ(john->famc, 1);
    EXPECT_EQ(john->fams, std::vector<int32_t>{3});
    ASSERT_EQ(john->flagids.size(), 1u);
    EXPECT_EQ(ix.flags[static_cast<size_t>(john->flagids[0])].code, "__CENSUS_1881");

    const auto sourcewithid = [&](int32_t id) {
        return std::find_if(ix.sources.begin(), ix.sources.end(), [&](const sourcerec& s) { return s.id == id; });
    };
    EXPECT_TRUE(sourcewithid(8)->iscensus);
    EXPECT_EQ(sourcewithid(8)->objectids, std::vector<int32_t>{1});
    EXPECT_FALSE(sourcewithid(9)->iscensus);
    EXPECT_FALSE(sourcewithid(10)->iscensus);
    EXPECT_EQ(ix.objects[0].maxasid, 1);
    EXPECT_EQ(ix.objects[0].date, "5 APR 1891");
}

} // namespace

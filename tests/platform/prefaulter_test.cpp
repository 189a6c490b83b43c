#include "platform/prefaulter.h"
#include "model/textarena.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

using namespace qm;

TEST(Prefaulter, MemoryBroughtInAheadKeepsWhatIsWritten)
{
    std::vector<char> table(32u << 20, 'a');
    {
        prefaulter pf;
        for (size_t at = 0; at < table.size(); at += 1u << 20)
            pf.request(table.data() + at, 1u << 20);
        table[5] = 'b';
        pf.finish();
        pf.request(table.data(), table.size()); // dropped or done when it ends
    }
    EXPECT_EQ(table[5], 'b');
    EXPECT_EQ(table[table.size() - 1], 'a');
}

TEST(Prefaulter, ArenaFilledWithBlocksMadeAheadKeepsItsTexts)
{
    textarena arena;
    std::vector<std::string_view> stored;
    auto pf = std::make_unique<prefaulter>();
    arena.prefaultwith(pf.get());
    const auto fill = [&](int from, int to) {
        for (int i = from; i < to; ++i)
            stored.push_back(arena.store("text number " + std::to_string(i)));
    };
    fill(0, 1000000); // some 20 MB: several blocks made ahead
    arena.prefaultwith(nullptr);
    pf.reset();
    fill(1000000, 1400000);
    for (int i = 0; i < 1400000; i += 997)
        ASSERT_EQ(stored[static_cast<size_t>(i)], "text number " + std::to_string(i));
    EXPECT_EQ(stored.back(), "text number 1399999");
}

// The lists of the index: in the loader's arena or on the heap, they copy,
// move and destroy their elements as vectors do; an index keeps its texts and
// lists when moved or replaced.
#include "model/indexlist.h"
#include "model/loadgedcom.h"
#include "model/textarena.h"

#include <gtest/gtest.h>

#include <string>

using namespace qm;

namespace {

// Counts live instances, to see that every element is destroyed exactly once.
struct counted {
    static int alive;
    int value = 0;
    explicit counted(int v) : value(v) { ++alive; }
    counted(const counted& o) : value(o.value) { ++alive; }
    counted(counted&& o) noexcept : value(o.value) { ++alive; }
    counted& operator=(const counted&) = default;
    ~counted() { --alive; }
    bool operator==(const counted& o) const { return value == o.value; }
};
int counted::alive = 0;

// Places items in the arena the way the loader does.
template <typename T>
void adoptinto(textarena& arena, indexlist<T>& list, std::initializer_list<T> items)
{
    T* at = static_cast<T*>(arena.allocate(items.size() * sizeof(T), alignof(T)));
    std::uninitialized_copy(items.begin(), items.end(), at);
    list.adopt(at, items.size());
}

} // namespace

TEST(IndexList, ArenaListsGrowCopyAndMoveLikeVectors)
{
    textarena arena;
    indexlist<int32_t> a;
    adoptinto(arena, a, {3, 1, 4});
    EXPECT_EQ(a, (std::vector<int32_t>{3, 1, 4}));
    const int32_t* inarena = a.data();

    indexlist<int32_t> copy = a;
    EXPECT_NE(copy.data(), inarena);
    a.push_back(a[0]); // an element of the list itself, as the storage moves to the heap
    EXPECT_EQ(a, (std::vector<int32_t>{3, 1, 4, 3}));
    EXPECT_EQ(copy, (std::vector<int32_t>{3, 1, 4}));
    EXPECT_EQ(inarena[0], 3); // the arena piece is left as it was

    indexlist<int32_t> moved = std::move(a);
    EXPECT_TRUE(a.empty());
    EXPECT_EQ(moved.size(), 4u);
    moved = std::vector<int32_t>{7};
    EXPECT_EQ(moved.at(0), 7);
    EXPECT_THROW((void)moved.at(1), std::out_of_range);
    EXPECT_EQ(std::span<const int32_t>(moved).size(), 1u);
}

TEST(IndexList, ElementsAreDestroyedOnceWhereverTheyLive)
{
    {
        textarena arena;
        indexlist<counted> inarena;
        adoptinto(arena, inarena, {counted(1), counted(2)});
        EXPECT_EQ(counted::alive, 2);
        indexlist<counted> other = inarena;
        other.emplace_back(3);
        EXPECT_EQ(counted::alive, 5);
        inarena.push_back(counted(4)); // moves to the heap
        EXPECT_EQ(counted::alive, 6);
        inarena = other;
        EXPECT_EQ(counted::alive, 6);
        other.clear();
        EXPECT_EQ(counted::alive, 3);
    }
    EXPECT_EQ(counted::alive, 0);
}

TEST(IndexList, IndexKeepsTextsAndListsWhenMovedOrReplaced)
{
    const std::string text = "0 HEAD\n0 @I1@ INDI\n1 NAME Ann /Lee/\n1 FAMS @F4@\n1 CENS\n2 DATE 1881\n2 SOUR @S2@\n"
                             "0 @I2@ INDI\n1 NAME Bob /Lee/\n0 TRLR\n";
    auto loaded = loadgedcombytes(text, {});
    gedcomindex ix = std::move(*loaded);
    loaded.reset();
    ASSERT_EQ(ix.people.size(), 2u);
    ASSERT_EQ(ix.people[0].census.size(), 1u);
    EXPECT_EQ(std::make_tuple(std::string(ix.people[0].name), ix.people[0].fams.at(0), std::string(ix.people[0].census[0].date)),
              std::make_tuple(std::string("Lee, Ann"), 4, std::string("1881")));
    EXPECT_EQ(ix.people[0].census[0].sourceids, (std::vector<int32_t>{2}));

    // A new load taking the place of the old one, as when a file is reloaded.
    ix.people[0].census[0].sourceids.push_back(5);
    ix = std::move(*loadgedcombytes(text, {}));
    EXPECT_EQ(ix.people[1].name, "Lee, Bob");
    EXPECT_EQ(ix.people[0].census[0].sourceids, (std::vector<int32_t>{2}));
}

TEST(IndexList, MovedFromArenaStartsAfresh)
{
    textarena a;
    const std::string_view kept = a.store("kept text");
    textarena b = std::move(a);
    const std::string_view fresh = a.store("new text"); // must not land in b's block
    const std::string_view more = b.store("more");
    EXPECT_EQ((std::vector<std::string_view>{kept, fresh, more}), (std::vector<std::string_view>{"kept text", "new text", "more"}));
}

#include "census/selection.h"

#include "model/loadgedcom.h"
#include "tools/datecheck.h"
#include "tools/findindividual.h"

#include <QRegularExpression>

#include <gtest/gtest.h>

#include <clocale>

using namespace qm;

namespace {

struct family {
    gedcomindex index;
    int32_t add(const char* name, int32_t famc = 0, std::vector<int32_t> fams = {}, const char* birth = nullptr,
                const char* death = nullptr)
    {
        personrec p;
        p.id = static_cast<int32_t>(index.people.size()) + 1;
        p.name = index.arena.store(name);
        p.famc = famc;
        p.fams = std::move(fams);
        if (birth) {
            p.hasbirthdate = true;
            p.birthdate = index.arena.store(birth);
        }
        if (death) {
            p.hasdeathdate = true;
            p.deathdate = index.arena.store(death);
        }
        index.people.push_back(std::move(p));
        return static_cast<int32_t>(index.people.size()) - 1;
    }
};

// n individuals chosen, each with age "1" typed in its row as it was added.
householdrows chosen(family& f, int n)
{
    householdrows h;
    for (int i = 0; i < n; ++i) {
        const int32_t k = f.add(("P" + std::to_string(i)).c_str());
        const int r = h.add(f.index.people[static_cast<size_t>(k)], k);
        h.rows[static_cast<size_t>(r)].age = QString::number(i + 1);
        h.storerows();
    }
    return h;
}

// The rows as the window shows them: the up arrow, the position of the top
// row and the count chosen, the down arrow, then the ages in the visible
// rows ("_" for a row in use without one, "." for a row not in use).
std::string state(const householdrows& h)
{
    std::string out = (h.upshown() ? "^ " : "") + std::to_string(h.toprow) + "/"
        + std::to_string(h.selectioncount) + (h.downshown() ? " v" : "") + ":";
    for (const rowvalues& r : h.rows)
        out += " " + (!r.shown() ? std::string(".") : r.age.isEmpty() ? std::string("_") : r.age.toStdString());
    return out;
}

// The visible rows hold what is stored for their individuals.
void expectconsistent(const householdrows& h)
{
    for (int r = 0; r < 10 && h.toprow + r < h.selectioncount; ++r)
        EXPECT_EQ(h.rows[static_cast<size_t>(r)].age, h.selection[static_cast<size_t>(h.toprow + r)].age) << r;
}

} // namespace

TEST(HouseholdRows, AddStoreAndAgeCheck)
{
    family f;
    householdrows h;
    const int32_t k = f.add("Smith, John");
    EXPECT_EQ(h.checkages(), -1); // nothing to check
    EXPECT_EQ(h.add(f.index.people[0], k), 0);
    EXPECT_EQ(h.rows[0].name, "Smith, John");
    EXPECT_EQ(h.rows[0].agetype, "Y");
    EXPECT_EQ(h.checkages(), 0);
    h.rows[0].age = QStringLiteral(" 32 ");
    h.rows[0].agetype = QString();
    h.rows[0].occupation = QStringLiteral(" Weaver ");
    EXPECT_EQ(h.checkages(), -1);
    h.storerows();
    ASSERT_EQ(h.selection.size(), 1u);
    EXPECT_EQ(h.selection[0].age, "32");
    EXPECT_EQ(h.selection[0].agetype, u'Y');
    EXPECT_EQ(h.selection[0].occupation, "Weaver");
    EXPECT_EQ(h.selection[0].id, 1);
    EXPECT_TRUE(h.has(1));
    EXPECT_FALSE(h.has(2));
}

TEST(HouseholdRows, EleventhScrollsAndScrollingKeepsTypedValues)
{
    family f;
    householdrows h = chosen(f, 10);
    EXPECT_EQ(state(h), "0/10: 1 2 3 4 5 6 7 8 9 10");
    const int32_t k = f.add("Eleventh");
    EXPECT_EQ(h.add(f.index.people[static_cast<size_t>(k)], k), 9);
    EXPECT_EQ(state(h), "^ 1/11: 2 3 4 5 6 7 8 9 10 _");
    h.rows[9].age = QStringLiteral("11");
    h.storerows();
    h.scrollup();
    EXPECT_EQ(state(h), "0/11 v: 1 2 3 4 5 6 7 8 9 10");
    h.rows[0].age = QStringLiteral("99"); // typed while scrolled up
    h.storerows();
    h.scrolldown();
    EXPECT_EQ(state(h), "^ 1/11: 2 3 4 5 6 7 8 9 10 11");
    h.scrollup();
    EXPECT_EQ(state(h), "0/11 v: 99 2 3 4 5 6 7 8 9 10");
    expectconsistent(h);
}

TEST(HouseholdRows, Delete)
{
    family o;
    householdrows only = chosen(o, 1);
    EXPECT_EQ(only.deleterow(0), -1);
    EXPECT_EQ(state(only), "0/0: . . . . . . . . . .");

    family f;
    householdrows h = chosen(f, 4);
    h.rows[3].age = QStringLiteral("44"); // typed but not stored: rows move as they are
    EXPECT_EQ(h.deleterow(1), 3);
    EXPECT_EQ(state(h), "0/3: 1 3 44 . . . . . . .");
    h.storerows();
    expectconsistent(h);

    // Rows hidden below: the first hidden one moves into row 9.
    family g;
    householdrows s = chosen(g, 12);
    s.scrollup();
    s.scrollup();
    ASSERT_EQ(state(s), "0/12 v: 1 2 3 4 5 6 7 8 9 10");
    s.deleterow(0);
    EXPECT_EQ(state(s), "0/11 v: 2 3 4 5 6 7 8 9 10 11");
    s.storerows();
    expectconsistent(s);
    s.scrolldown();
    EXPECT_EQ(state(s), "^ 1/11: 3 4 5 6 7 8 9 10 11 12");
    expectconsistent(s);

    // Rows hidden above: the window is pulled down.
    family d;
    householdrows t = chosen(d, 12);
    ASSERT_EQ(state(t), "^ 2/12: 3 4 5 6 7 8 9 10 11 12");
    EXPECT_EQ(t.deleterow(4), 11); // the individual shown last
    EXPECT_EQ(state(t), "^ 1/11: 2 3 4 5 6 8 9 10 11 12");
    t.storerows();
    expectconsistent(t);
    t.deleterow(0);
    EXPECT_EQ(state(t), "0/10: 1 3 4 5 6 8 9 10 11 12");
    t.storerows();
    expectconsistent(t);
    EXPECT_EQ(t.selection.size(), 10u);
}

TEST(ImmediateFamily, KindsAndOrder)
{
    family f;
    // Family 1: John and Mary with children Ann and Tom; John also married Mary
    // twice (family 3); John's parents are family 2 (Old John).
    const int32_t john = f.add("Smith, John", 2, {1, 3});
    f.add("Brown, Mary", 0, {1, 3});
    f.add("Smith, Ann", 1);
    f.add("Smith, Tom", 1);
    f.add("Smith, Old John", 0, {2});
    f.add("Smith, Jane", 2); // sister
    f.add("Jones, Stranger", 5, {4});
    const auto fam = immediatefamily(f.index, john, true);
    std::vector<QString> texts;
    for (const auto& e : fam)
        texts.push_back(e.text);
    EXPECT_EQ(texts, (std::vector<QString>{"CHI Smith, Ann (ID: 3)", "CHI Smith, Tom (ID: 4)",
                                           "PAR Smith, Old John (ID: 5)", "SIB Smith, Jane (ID: 6)",
                                           "WED Brown, Mary (ID: 2)", "WED Brown, Mary (ID: 2)"}));
    EXPECT_EQ(fam[0].person, 2);
}

TEST(CouldBeAlive, YearsAroundTheCensus)
{
    family f;
    f.add("No dates");
    f.add("Born 1700", 0, {}, "1700");
    f.add("Born 1707", 0, {}, "1707");
    f.add("Born 1847", 0, {}, "ABT 1847");
    f.add("Born 1846", 0, {}, "1846");
    f.add("Died 1835", 0, {}, nullptr, "1835");
    f.add("Died 1836", 0, {}, nullptr, "1836");
    f.add("Died before 1800", 0, {}, nullptr, "BEF 1800"); // gives no age: kept
    f.add("Born between", 0, {}, "BET 1700 AND 1702");     // likewise
    const alivelist a = couldbealive(f.index, QDate(1841, 6, 6), dateorder::dmy);
    EXPECT_EQ(a.people, (std::vector<int32_t>{0, 2, 4, 6, 7, 8}));
    EXPECT_FALSE(a.toomany);

    const alivelist capped = couldbealive(f.index, QDate(1841, 6, 6), dateorder::dmy, 3);
    EXPECT_EQ(capped.people.size(), 4u);
    EXPECT_TRUE(capped.toomany);

    // Listed in label order: names first, then the bracketed dates.
    EXPECT_EQ(sortbylabel(f.index, a.people, false), (std::vector<int32_t>{2, 4, 8, 6, 7, 0}));
}

TEST(PeopleLists, OneOrderWhateverTheLocale)
{
    // Five children of Zed Zimmer, each with a census event in 1881.
    std::string file = "0 HEAD\r\n1 CHAR UTF-8\r\n0 @I1@ INDI\r\n1 NAME Zed /Zimmer/\r\n1 FAMS @F1@\r\n";
    const char* names[] = {"Yves /Young/", "Piet /van Dyke/", "Anne /\xC3\x89\x62\x65rt/", "Ann /Smith-Jones/",
                           "John /Smith/"};
    for (int i = 0; i < 5; ++i)
        file += "0 @I" + std::to_string(i + 2) + "@ INDI\r\n1 NAME " + names[i]
            + "\r\n1 FAMC @F1@\r\n1 CENS\r\n2 DATE 1881\r\n2 PLAC Leeds\r\n2 AGE 30\r\n";
    const auto ix = loadgedcombytes(file + "0 TRLR\r\n", flagtable{});
    const std::string expected =
        "\xC3\x89\x62\x65rt, Anne | Smith, John | Smith-Jones, Ann | van Dyke, Piet | Young, Yves";
    // The names of a list in its order, the father left out.
    const auto shown = [](const std::vector<QString>& texts) {
        static const QRegularExpression extra(QStringLiteral("^CHI | \\(ID: \\d+\\)$| 30 Leeds$"));
        QStringList out;
        for (QString t : texts)
            if (!t.startsWith(QLatin1String("Zimmer")))
                out << t.remove(extra);
        return out.join(QStringLiteral(" | ")).toStdString();
    };
    const auto labels = [&](const std::vector<int32_t>& positions) {
        std::vector<QString> out;
        for (int32_t k : positions)
            out.push_back(personlabel(ix->people[static_cast<size_t>(k)], false));
        return shown(out);
    };
    const auto texts = [&](const auto& entries) {
        std::vector<QString> out;
        for (const auto& e : entries)
            out.push_back(e.text);
        return shown(out);
    };
    const QLocale before;
    for (const char* locale : {"C", "en_GB", "sv_SE"}) {
        std::setlocale(LC_ALL, (std::string(locale) + ".UTF-8").c_str());
        QLocale::setDefault(QLocale(QLatin1String(locale)));
        EXPECT_EQ(labels(sortedpeople(*ix, false)), expected) << locale;
        EXPECT_EQ(labels(sortbylabel(*ix, couldbealive(*ix, QDate(1881, 4, 3), dateorder::dmy).people, false)),
                  expected)
            << locale;
        EXPECT_EQ(texts(immediatefamily(*ix, 0, false)), expected) << locale;
        EXPECT_EQ(texts(findlist(*ix, false, {})), expected) << locale;
        EXPECT_EQ(texts(datedetails(*ix, QStringLiteral("1881"), false)), expected) << locale;
    }
    std::setlocale(LC_ALL, "C");
    QLocale::setDefault(before);
}

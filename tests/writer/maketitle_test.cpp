#include "writer/maketitle.h"

#include <gtest/gtest.h>

using qm::maketitle;

namespace {
const QString deftemplate = QStringLiteral("Census {YEAR} {PLACE} {REF} ({OTHER})");

QString title(const QString& templ, const QString& other = QStringLiteral("John Smith"))
{
    return maketitle(templ, QStringLiteral("1851"), QStringLiteral("30 MAR 1851"),
                     QStringLiteral("Warrington, Lancashire"), QStringLiteral("43 Knutsford Road"), other,
                     QStringLiteral("HO107/2204/151"), QStringLiteral("UK"));
}
} // namespace

TEST(MakeTitle, DefaultTemplateFillsEveryPlaceholder)
{
    EXPECT_EQ(title(deftemplate), QStringLiteral("Census 1851 Warrington, Lancashire HO107/2204/151 (John Smith)"));
    EXPECT_EQ(title(QStringLiteral("{COUNTRY} {DATE} {ADDR}")), QStringLiteral("UK 30 MAR 1851 43 Knutsford Road"));
}

TEST(MakeTitle, EmptyOtherLeavesNoBracketsButKeepsTrailingSpace)
{
    EXPECT_EQ(title(deftemplate, QString()), QStringLiteral("Census 1851 Warrington, Lancashire HO107/2204/151 "));
}

TEST(MakeTitle, AllEmptyGivesNoTitle)
{
    EXPECT_EQ(maketitle(QStringLiteral("{YEAR}({OTHER})"), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
    EXPECT_EQ(maketitle(QString(), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
}

TEST(MakeTitle, PlaceholdersAreCaseSensitive)
{
    EXPECT_EQ(title(QStringLiteral("{year} {YEAR}")), QStringLiteral("{year} 1851"));
}

TEST(MakeTitle, NestedEmptyBracketsAndSpacesCollapse)
{
    EXPECT_EQ(title(QStringLiteral("A (({OTHER}))    B"), QString()), QStringLiteral("A B"));
    // Removing brackets can bring spaces together again.
    EXPECT_EQ(title(QStringLiteral("A ( ) B"), QString()), QStringLiteral("A ( ) B"));
    EXPECT_EQ(title(QStringLiteral("A () () B"), QString()), QStringLiteral("A B"));
}

TEST(MakeTitle, ValueHoldingLaterPlaceholderIsReplacedToo)
{
    EXPECT_EQ(maketitle(QStringLiteral("{PLACE}"), {}, {}, QStringLiteral("at {REF}"), {}, {},
                        QStringLiteral("RG9/1"), {}),
              QStringLiteral("at RG9/1"));
    // An earlier placeholder in a later value stays as typed.
    EXPECT_EQ(maketitle(QStringLiteral("{REF}"), QStringLiteral("1851"), {}, {}, {}, {},
                        QStringLiteral("{YEAR}"), {}),
              QStringLiteral("{YEAR}"));
}

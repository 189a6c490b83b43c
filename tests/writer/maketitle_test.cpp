#include "writer/maketitle.h"

#include <gtest/gtest.h>

using qm::maketitle;

TEST(MakeTitle, PlaceholdersBracketsAndSpaces)
{
    const QString deftemplate = QStringLiteral("Census {YEAR} {PLACE} {REF} ({OTHER})");
    const auto title = [](const QString& templ, const QString& other) {
        return maketitle(templ, QStringLiteral("1851"), QStringLiteral("30 MAR 1851"),
                         QStringLiteral("Warrington, Lancashire"), QStringLiteral("43 Knutsford Road"), other,
                         QStringLiteral("HO107/2204/151"), QStringLiteral("UK"));
    };
    const struct {
        QString templ;
        const char* other;
        const char* title;
    } cases[] = {
        {deftemplate, "John Smith", "Census 1851 Warrington, Lancashire HO107/2204/151 (John Smith)"},
        {QStringLiteral("{COUNTRY} {DATE} {ADDR}"), "", "UK 30 MAR 1851 43 Knutsford Road"},
        // An empty {OTHER} leaves no brackets but keeps the space before them.
        {deftemplate, "", "Census 1851 Warrington, Lancashire HO107/2204/151 "},
        {QStringLiteral("{year} {YEAR}"), "", "{year} 1851"}, // case counts
        // Nested empty brackets go and spaces collapse; removing brackets can
        // bring spaces together again.
        {QStringLiteral("A (({OTHER}))    B"), "", "A B"},
        {QStringLiteral("A ( ) B"), "", "A ( ) B"},
        {QStringLiteral("A () () B"), "", "A B"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(title(c.templ, QString::fromLatin1(c.other)), QString::fromLatin1(c.title)) << c.templ.toStdString();

    EXPECT_EQ(maketitle(QStringLiteral("{YEAR}({OTHER})"), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
    EXPECT_EQ(maketitle(QString(), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
    // A value holding a later placeholder is replaced too; an earlier one stays as typed.
    EXPECT_EQ(maketitle(QStringLiteral("{PLACE}"), {}, {}, QStringLiteral("at {REF}"), {}, {}, QStringLiteral("RG9/1"), {}),
              QStringLiteral("at RG9/1"));
    EXPECT_EQ(maketitle(QStringLiteral("{REF}"), QStringLiteral("1851"), {}, {}, {}, {}, QStringLiteral("{YEAR}"), {}),
              QStringLiteral("{YEAR}"));
}

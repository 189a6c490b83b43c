// quillmark-cli add-entry, run as a process on copies of family files.
#include "platform/settingsstore.h"
#include "support/clirun.h"
#include "support/heldfile.h"
#include "support/testfiles.h"

#include <QFile>
#include <QFileInfo>
#include <QLockFile>

#include <iostream>

using qmtest::readfile;
using qmtest::writefile;

namespace {

// A small family: John has no birth details, Mary has; S1 is a census source,
// S2 a parish register.
const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 FAMS @F1@\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n1 BIRT\r\n2 DATE 1812\r\n1 FAMS @F1@\r\n"
                           "0 @I3@ INDI\r\n1 NAME Ann /Smith/\r\n1 FAMC @F1@\r\n"
                           "0 @F1@ FAM\r\n1 HUSB @I1@\r\n1 WIFE @I2@\r\n1 CHIL @I3@\r\n"
                           "0 @S1@ SOUR\r\n1 TITL Census 1851 Leeds HO107/2319\r\n"
                           "0 @S2@ SOUR\r\n1 TITL Leeds Parish Register\r\n"
                           "0 TRLR\r\n";

using run = qmtest::clitextrun;

class CliAddEntry : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        writefile(file, family);
    }

    void setting(const QString& name, const QString& value) const
    {
        qm::settingsstore::onfile(ini)->write(name, value);
    }

    run addentry(const std::string& json, const QString& target = QString(), const QStringList& options = {}) const
    {
        const QString entry = dir.filePath(QStringLiteral("entry.json"));
        writefile(entry, json);
        return cli(QStringLiteral("add-entry"), QStringList{target.isEmpty() ? file : target, QStringLiteral("--entry"), entry}
                                                    + options);
    }

    // A refused entry: status 2, the message on standard error, nothing written.
    void expectrefused(const std::string& json, const std::string& message)
    {
        const run r = addentry(json);
        EXPECT_EQ(r.status, 2) << json;
        EXPECT_EQ(r.err, "quillmark-cli: " + message + "\n") << json;
        EXPECT_EQ(r.out, "");
        EXPECT_EQ(readfile(file), family);
        EXPECT_TRUE(backupfolderempty());
    }

    // Each part is in the family file as it is now.
    void expectwritten(std::initializer_list<const char*> parts) const
    {
        const std::string now = readfile(file);
        for (const char* part : parts)
            EXPECT_NE(now.find(part), std::string::npos) << part << "\nin:\n" << now;
    }
};

const std::string household = R"("individuals": [{"id": 1, "age": "39", "agetype": "Y", "occupation": "Weaver"},
                                                 {"id": 2, "age": 38, "occupation": "-"}])";

} // namespace

TEST_F(CliAddEntry, NewSourceFromTemplate)
{
    const run r = addentry(R"({"year": 1851, "place": "Leeds, Yorkshire", "reference": "HO107/2320",
                               "other": "John Smith", "source_text": "John Smith 39\nMary Smith 38\n", )"
                           + household + "}");
    ASSERT_EQ(r.status, 0) << r.err;
    const QJsonObject j = r.json();
    EXPECT_EQ(readfile(j.value(QStringLiteral("backup")).toString()), family);
    EXPECT_EQ(j, QJsonObject({{"source", 3}, {"individuals", 2}, {"images", 0}, {"log", true},
                              {"backup", j.value(QStringLiteral("backup"))}}))
        << r.out;
    // A one-character occupation is none.
    expectwritten({"0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 30 MAR 1851\r\n2 PLAC Leeds, Yorkshire\r\n"
                   "2 AGE 39y\r\n2 SOUR @S3@\r\n1 OCCU Weaver\r\n",
                   "2 AGE 38y\r\n2 SOUR @S3@\r\n1 FAMS",
                   "0 @S3@ SOUR\r\n1 TITL Census 1851 Leeds, Yorkshire HO107/2320 (John Smith)\r\n",
                   "1 TEXT John Smith 39\r\n2 CONT Mary Smith 38\r\n1 "});
    EXPECT_NE(readfile(dir.filePath(QStringLiteral("censuslog.txt"))).find("Name: Smith, Mary (2) : created census event\r\n"),
              std::string::npos);
}

TEST_F(CliAddEntry, CitesExistingSourceWithBirthDetails)
{
    setting(QStringLiteral("Full Entry"), QStringLiteral("0"));
    setting(QStringLiteral("Keep Log"), QStringLiteral("0"));
    // The typed date wins over the year and is written the GEDCOM way.
    const run r = addentry(R"({"year": 1851, "date": "1 apr 1851", "source": 1, "place": "Leeds",
        "reference": "folio 12", "individuals": [
            {"id": 1, "age": "6", "agetype": "M", "birthplace": " Leeds "},
            {"id": 2, "age": "38", "birthplace": "York"},
            {"id": 3, "age": "10", "agetype": "d", "birthplace": ""}]})");
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.json().value(QStringLiteral("source")).toInt(), 1);
    EXPECT_FALSE(r.json().value(QStringLiteral("log")).toBool());
    EXPECT_FALSE(QFileInfo::exists(dir.filePath(QStringLiteral("censuslog.txt"))));
    // Mary has a birth event already: she gets no second one; an empty birth
    // place gives no PLAC line; citing a source makes none.
    expectwritten({"1 NAME John /Smith/\r\n1 BIRT\r\n2 DATE CAL OCT 1850\r\n2 PLAC Leeds\r\n",
                   "2 DATE 01 APR 1851\r\n2 PLAC Leeds\r\n2 AGE 6m\r\n2 SOUR @S1@\r\n3 PAGE folio 12\r\n",
                   "1 NAME Ann /Smith/\r\n1 BIRT\r\n2 DATE CAL 22 MAR 1851\r\n2 SOUR"});
    for (const char* absent : {"2 PLAC York", "0 @S3@"})
        EXPECT_EQ(readfile(file).find(absent), std::string::npos) << absent;
}

// Family Historian keeps its family file open while it runs, sharing it with
// or without leave to delete or rename it. A save then either replaces the
// file whole or fails with the message after which the program closes and
// leaves the file byte for byte as it was; never anything in between.
TEST_F(CliAddEntry, FileHeldOpenByAnotherProgramIsReplacedWholeOrNotAtAll)
{
    const std::string entry = R"({"year": 1851, "place": "Leeds, Yorkshire", "reference": "HO107/2320", )" + household
        + "}";
    for (const char* sharing : {"no-share-delete", "share-delete"}) {
        SCOPED_TRACE(sharing);
        writefile(file, family);
        run r;
        {
            const qmtest::heldfile held(file, sharing);
            ASSERT_TRUE(held.holding());
            r = addentry(entry);
            EXPECT_EQ(readfile(file).size() == family.size(), r.status != 0) << "seen while still held";
        }
        const std::string now = readfile(file);
        if (r.status == 0) {
            EXPECT_NE(now.find("1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 30 MAR 1851\r\n"), std::string::npos) << now;
            EXPECT_NE(now.find("0 @S3@ SOUR\r\n"), std::string::npos);
            EXPECT_TRUE(now.ends_with("0 TRLR\r\n")) << "the whole new file";
        } else {
            EXPECT_EQ(r.status, 2);
            EXPECT_EQ(now, family);
            EXPECT_TRUE(r.err.starts_with("quillmark-cli: An error occurred (")) << r.err;
            EXPECT_NE(r.err.find("): Census entry not added"), std::string::npos) << r.err;
        }
        std::cout << "[          ] held with " << sharing << ": " << (r.status == 0 ? "saved" : r.err) << "\n";
        const QStringList left = QDir(dir.path()).entryList(QDir::Files | QDir::Hidden);
        EXPECT_EQ(left.filter(QStringLiteral("family")), QStringList{QStringLiteral("family.ged")})
            << "no temporary file left beside the family file: " << left.join(u' ').toStdString();
    }
}

// The form's own checks are tested on the form; here, that the entry's fields reach them.
TEST_F(CliAddEntry, RefusesWithTheFormsMessages)
{
    const std::string base = R"("year": 1851, "place": "Leeds", "reference": "HO107/1", )";
    expectrefused(R"({"year": 1851, "place": ""})", "The census entry must refer to at least 1 person!");
    expectrefused(R"({"year": 1852, "place": "Leeds", )" + household + "}", "You must select a census year from the list");
    expectrefused("{" + base + R"("individuals": [{"id": 1, "age": "4"}, {"id": 9, "age": "4"}]})",
                  "There is no individual with the record number 9 in the family file");
    expectrefused("{" + base + R"("individuals": [{"id": 1, "age": "1234"}]})",
                  "The age of Smith, John (1) must be a number of at most 3 digits, not \"1234\"");
    expectrefused("{" + base + R"("individuals": [{"id": 1, "age": "4", "agetype": "W"}]})",
                  "The age type of Smith, John (1) must be Y (years), M (months) or D (days)");
    expectrefused("{" + base + R"("individuals": [{"id": 1, "age": ""}]})",
                  "You must first enter an age for this individual: Smith, John (1)");
    const run bad = addentry(R"({"year": 1851, "place": "Leeds", "individuals": [{"id": 1, "age": "4", "occupation": "Weaver ∧"}]})");
    EXPECT_EQ(bad.status, 2);
    EXPECT_NE(bad.err.find("The occupation of Smith, John holds the character \"∧\""), std::string::npos) << bad.err;
    EXPECT_EQ(readfile(file), family);
    EXPECT_TRUE(backupfolderempty()) << "refused before the backup";

    setting(QStringLiteral("Full Entry"), QStringLiteral("0"));
    expectrefused("{" + base + R"("source": 2, )" + household + "}",
                  "The source number 2 is not a census source of the family file");
    expectrefused("{" + base + R"("source": 7, )" + household + "}",
                  "The source number 7 is not a census source of the family file");
}

TEST_F(CliAddEntry, RefusesBadFilesAndArguments)
{
    EXPECT_EQ(addentry("[1, 2]").status, 2);
    EXPECT_EQ(addentry("{\"year\": ").status, 2);
    EXPECT_EQ(addentry(R"({"year": "soon"})").err, "quillmark-cli: \"year\" must be a whole number\n");
    EXPECT_EQ(addentry(R"({"year": 1851, "individuals": {"id": 1}})").err, "quillmark-cli: \"individuals\" must be a list\n");
    EXPECT_EQ(addentry("{}", dir.filePath(QStringLiteral("none.ged"))).status, 2);
    EXPECT_EQ(readfile(file), family);

    const qmtest::clirun r = qmtest::runcli({QStringLiteral("add-entry"), file}, dir.path());
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.indexOf("--entry ENTRY.json"), -1);
}

TEST_F(CliAddEntry, ExampleEntryWorksOnSample)
{
    const QString sample = dir.filePath(QStringLiteral("sample.ged"));
    ASSERT_TRUE(QFile::copy(qmtest::samplefile(), sample));
    const std::string entry = readfile(QStringLiteral(QM_EXAMPLES_DIR "/entry.json"));
    ASSERT_FALSE(entry.empty());
    const run r = addentry(entry, sample);
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.json().value(QStringLiteral("individuals")).toInt(), 4);
    EXPECT_NE(readfile(sample).find("2 DATE 3 APR 1881\r\n2 PLAC Hebden Bridge, Yorkshire, England\r\n2 ADDR 27 Hangingroyd Lane\r\n2 AGE 1m\r\n"),
              std::string::npos);
}

// Another Quillmark process saving the same family file holds its lock.
TEST_F(CliAddEntry, WaitsForNoOtherQuillmarkSavingTheFile)
{
    QLockFile other(file + QStringLiteral(".quillmark-lock"));
    ASSERT_TRUE(other.tryLock(0));
    const std::string entry = R"({"year": 1851, "place": "Leeds", )" + household + "}";
    const run r = addentry(entry);
    EXPECT_EQ(r.status, 2);
    EXPECT_EQ(r.err.rfind("quillmark-cli: Another Quillmark (process ", 0), 0u) << r.err;
    EXPECT_NE(r.err.find("delete the file " + QDir::toNativeSeparators(file).toStdString() + ".quillmark-lock"),
              std::string::npos)
        << r.err;
    EXPECT_EQ(readfile(file), family);
    EXPECT_TRUE(backupfolderempty()) << "the backup made ahead is removed";
    other.unlock();
    EXPECT_EQ(addentry(entry).status, 0);
}

// A settings file is read as settings or refused; values it lacks are named.
TEST_F(CliAddEntry, SettingsFileThatIsNotOneIsRefusedAndDefaultsAreNamed)
{
    const std::string entry = R"({"year": 1851, "place": "Leeds", )" + household + "}";
    writefile(ini, family); // a GEDCOM file given by mistake
    run r = addentry(entry);
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.find("cannot be read as Quillmark settings"), std::string::npos) << r.err;
    EXPECT_EQ(readfile(file), family);

    writefile(ini, "[General]\nFull%20Entry=1\nSource%20in%20Note=0\nKeep%20Log=0\nLog%20Path=x.txt\n"
                   "Backup%20Folder=" + QDir::toNativeSeparators(dir.filePath(QStringLiteral("backups"))).toStdString()
                   + "\n");
    r = addentry(entry);
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_NE(r.err.find("quillmark-cli: warning: the settings file"), std::string::npos) << r.err;
    EXPECT_NE(r.err.find("take their defaults: Country, Birthdate, Certainty"), std::string::npos) << r.err;
    EXPECT_NE(r.err.find("No Source Text Warning\n"), std::string::npos) << r.err;
}

TEST_F(CliAddEntry, DoubleDashEndsTheOptions)
{
    const QString odd = dir.filePath(QStringLiteral("-family.ged"));
    writefile(odd, family);
    const QString entry = dir.filePath(QStringLiteral("entry.json"));
    writefile(entry, R"({"year": 1851, "place": "Leeds", )" + household + "}");
    const qmtest::clirun r = qmtest::runcli({QStringLiteral("add-entry"), QStringLiteral("--entry"), entry,
                                            QStringLiteral("--settings"), ini, QStringLiteral("--"),
                                            QStringLiteral("-family.ged")},
                                           dir.path(), dir.path());
    EXPECT_EQ(r.status, 0) << r.err.toStdString();
    EXPECT_NE(readfile(odd), family);
}

// The household check's findings are warnings; --strict refuses on them;
// --dry-run prints the lines the save would write and writes nothing.
TEST_F(CliAddEntry, HouseholdCheckAndDryRun)
{
    // Mary, born 1812, typed as 58 in 1851.
    const std::string entry = R"({"year": 1851, "place": "Leeds", "reference": "HO107/2320", "individuals": [
        {"id": 1, "age": "39"}, {"id": 2, "age": "58"}]})";
    const std::string warning = "quillmark-cli: warning: Row 2: Smith, Mary (ID: 2) is entered as aged 58, but by the "
                                "tree was born in 1812 and in this census would be aged 38 or 39.\n";

    run r = addentry(entry, QString(), {QStringLiteral("--strict")});
    EXPECT_EQ(r.status, 2);
    EXPECT_EQ(r.err, warning + "quillmark-cli: the household check found problems (above), so the entry was not "
                               "saved (--strict)\n");
    EXPECT_EQ(readfile(file), family);
    EXPECT_TRUE(backupfolderempty());

    r = addentry(entry, QString(), {QStringLiteral("--dry-run")});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.err, warning);
    EXPECT_EQ(r.out.rfind("--- a/family.ged\n+++ b/family.ged\n@@ -2,", 0), 0u) << r.out;
    EXPECT_NE(r.out.find("\n+1 CENS\n+2 DATE 30 MAR 1851\n+2 PLAC Leeds\n+2 AGE 58y\n+2 SOUR @S3@\n"), std::string::npos)
        << r.out;
    EXPECT_NE(r.out.find("\n+0 @S3@ SOUR\n"), std::string::npos) << r.out;
    EXPECT_EQ(readfile(file), family) << "a dry run writes nothing";
    EXPECT_TRUE(backupfolderempty());
    EXPECT_FALSE(QFileInfo::exists(dir.filePath(QStringLiteral("censuslog.txt"))));

    // The dry run's lines are what the save writes (byte for byte in the preview's own test).
    const std::string diff = r.out;
    r = addentry(entry);
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.err, warning);
    const std::string written = readfile(file);
    for (size_t at = diff.find("\n+"); at != std::string::npos; at = diff.find("\n+", at + 1)) {
        const std::string line = diff.substr(at + 2, diff.find('\n', at + 1) - at - 2);
        // The change stamp's time is the moment of each run.
        if (line != "++ b/family.ged" && !line.starts_with("3 TIME ")) {
            EXPECT_NE(written.find(line + "\r\n"), std::string::npos) << line;
        }
    }

    // With the setting off, no check; --strict asks for it all the same.
    writefile(file, family);
    setting(QStringLiteral("Household Check"), QStringLiteral("0"));
    r = addentry(entry, QString(), {QStringLiteral("--dry-run")});
    EXPECT_EQ(r.status, 0);
    EXPECT_EQ(r.err, "");
    EXPECT_EQ(addentry(entry, QString(), {QStringLiteral("--strict")}).status, 2);
}

TEST_F(CliAddEntry, UndoTakesBackTheLastChange)
{
    const auto undo = [&] { return cli(QStringLiteral("undo"), {file}); };
    run r = undo();
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.find("has no change to"), std::string::npos) << r.err;

    const std::string entry = R"({"year": 1851, "place": "Leeds", "reference": "HO107/2320", )" + household + "}";
    ASSERT_EQ(addentry(entry).status, 0);
    const std::string saved = readfile(file);
    r = undo();
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(readfile(file), family);
    const QJsonObject j = r.json();
    EXPECT_EQ(j.value(QStringLiteral("undone")).toString(),
              QStringLiteral("Census entry added: Census 1851 Leeds HO107/2320 (ID: 3), 2 individuals"));
    EXPECT_EQ(readfile(j.value(QStringLiteral("backup")).toString()), saved);
    EXPECT_TRUE(j.value(QStringLiteral("log")).toBool());
    EXPECT_NE(readfile(dir.filePath(QStringLiteral("censuslog.txt"))).find("Change undone: "), std::string::npos);
    r = undo();
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.find("was undone at"), std::string::npos) << r.err;

    // A change made by another program after the save is never undone over.
    ASSERT_EQ(addentry(entry).status, 0);
    writefile(file, readfile(file) + "0 @N1@ NOTE later\r\n");
    const std::string later = readfile(file);
    r = undo();
    EXPECT_EQ(r.status, 2);
    EXPECT_NE(r.err.find("has been changed since"), std::string::npos) << r.err;
    EXPECT_EQ(readfile(file), later);
}

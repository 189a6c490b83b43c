#include "settings/settings.h"

#include "platform/settingsstore.h"

#include <QDir>
#include <QFileInfo>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <utility>
#include <vector>

using namespace qm;

namespace {

// Every value of a complete store as a current version writes it, in reading
// order, with values that differ from the defaults wherever a value can.
std::vector<std::pair<QString, QString>> fullstore()
{
    return {
        {"Full Entry", "0"}, {"Source in Note", "1"}, {"Keep Log", "0"}, {"Log Path", "  /tmp/my log.txt "},
        {"Country", "Canada"}, {"Birthdate", "0"}, {"Certainty", "2"}, {"Residence", "1"},
        {"Source Type", "Census Return"}, {"Request Image", "1"}, {"ID Only", "1"}, {"Auto Reference", "1"},
        {"Backup Folder", " /tmp/backups "}, {"Flag Use", "1"}, {"Flag Check", "1"}, {"Opt1 Entry Date", "1"},
        {"Opt1 Where in Source", "1"}, {"Opt1 Publication Info", "1"}, {"Request Images 2", "1"},
        {"Image 2 Event", "1"}, {"Entry Date Today", "1"}, {"Occ Place", "0"}, {"Occ Age", "1"},
        {"Shared Note", "1"}, {"Title", "{YEAR} {PLACE}"}, {"ASID", "0"}, {"File Open Default", "0"},
        {"Source Note", "1"}, {"Occ Scholar", "0"}, {"Birth Secondary Evidence", "1"},
        {"Alternate Separator", "1"}, {"Alternate Separator Character", "|"}, {"Marriage Condition", "1"},
        {"No Source Text Warning", "0"},
    };
}

class SettingsTest : public ::testing::Test {
protected:
    static void SetUpTestSuite() { QStandardPaths::setTestModeEnabled(true); }

    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        path = dir.filePath("settings.ini");
        store = settingsstore::onfile(path);
    }

    void fill(const std::vector<std::pair<QString, QString>>& values)
    {
        for (const auto& [name, text] : values)
            store->write(name, text);
    }
    void fillexcept(const QString& left, const QString& replacement = {}, bool drop = true)
    {
        for (const auto& [name, text] : fullstore()) {
            if (name != left)
                store->write(name, text);
            else if (!drop)
                store->write(name, replacement);
        }
    }

    QTemporaryDir dir;
    QString path;
    std::unique_ptr<settingsstore> store;
};

void expectgroupsfrom7default(const settings& s)
{
    const settings d = defaultsettings();
    EXPECT_EQ(s.flaguse, d.flaguse);
    EXPECT_EQ(s.occplace, d.occplace);
    EXPECT_EQ(s.title, defaulttitletemplate());
    EXPECT_EQ(s.asid, d.asid);
    EXPECT_EQ(s.occscholar, d.occscholar);
    EXPECT_EQ(s.birthsecondaryevidence, d.birthsecondaryevidence);
    EXPECT_EQ(s.alternateseparatorcharacter, QStringLiteral("-"));
    EXPECT_EQ(s.nosourcetextwarning, d.nosourcetextwarning);
}

TEST_F(SettingsTest, NoStoreGivesDefaultsWritesFlagValuesAndAsksForOptions)
{
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    EXPECT_TRUE(s.fullentry);
    EXPECT_FALSE(s.sourceinnote);
    EXPECT_TRUE(s.keeplog);
    EXPECT_EQ(s.logpath, defaultlogpath());
    EXPECT_TRUE(s.logpath.endsWith(QDir::toNativeSeparators("Quillmark/censuslog.txt")));
    EXPECT_EQ(s.country, "UK");
    EXPECT_TRUE(s.birthdate);
    EXPECT_EQ(s.certainty, -1);
    EXPECT_EQ(s.sourcetype, "Census");
    EXPECT_TRUE(s.requestimage);
    EXPECT_EQ(s.backupfolder, defaultbackupfolder());
    EXPECT_TRUE(QDir(programfolder()).exists());
    expectgroupsfrom7default(s);
    EXPECT_EQ(s.count, 0);
    EXPECT_EQ(s.imagefolder, "");
    EXPECT_EQ(s.imageoption, "0");
    EXPECT_FALSE(s.renamefile);
    EXPECT_TRUE(s.firststart);
    EXPECT_FALSE(l.pathchecksdue);
    EXPECT_EQ(store->read("Flag Use"), QString("0"));
    EXPECT_EQ(store->read("Flag Check"), QString("0"));
    EXPECT_FALSE(store->read("Full Entry").has_value());
}

#ifdef Q_OS_WIN
// The census log and the backups go to the user's own local application data
// folder, named the Windows way (drive letter, backslashes), which the user
// can write to, unlike the program's folder.
TEST(ProgramFolder, IsQuillmarkInTheUsersLocalApplicationData)
{
    // (The tests run in QStandardPaths' test mode, which adds a "qttest" folder.)
    const QString local = qEnvironmentVariable("LOCALAPPDATA")
        + (QStandardPaths::isTestModeEnabled() ? QStringLiteral("\\qttest") : QString());
    ASSERT_FALSE(local.isEmpty());
    EXPECT_EQ(programfolder().compare(local + QStringLiteral("\\Quillmark"), Qt::CaseInsensitive), 0) << programfolder().toStdString();
    EXPECT_EQ(programfolder().at(1), u':');
    EXPECT_FALSE(programfolder().contains(u'/'));
    EXPECT_EQ(defaultlogpath(), programfolder() + QStringLiteral("\\censuslog.txt"));
    EXPECT_TRUE(QFileInfo(programfolder()).isWritable());
}
#endif

// The values a save writes back as they were read are checked by the round
// trip of SaveWritesEveryDialogValueTrimmedAndReadsBack; here the others.
TEST_F(SettingsTest, CompleteStoreIsReadWithConversions)
{
    fill(fullstore());
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    EXPECT_EQ(s.logpath, "/tmp/my log.txt");
    EXPECT_EQ(s.backupfolder, "/tmp/backups");
    EXPECT_EQ(s.certainty, 2);
    EXPECT_EQ(s.sourcetype, "Census Return");
    EXPECT_EQ(s.title, "{YEAR} {PLACE}");
    EXPECT_TRUE(s.flaguse && s.flagcheck);
    EXPECT_FALSE(s.firststart);
    EXPECT_TRUE(l.pathchecksdue);
}

TEST_F(SettingsTest, BooleanTextsOtherThanZeroOrOne)
{
    fillexcept("Full Entry", "x", false);
    store->write("Birthdate", "x");
    store->write("Occ Scholar", " ");
    const settings s = loadsettings(*store).values;
    EXPECT_TRUE(s.fullentry);
    EXPECT_FALSE(s.birthdate);
    EXPECT_FALSE(s.occscholar);
    EXPECT_FALSE(s.firststart);
}

TEST_F(SettingsTest, RejectedValueResetsItsGroupAndAllLaterGroups)
{
    fill(fullstore());
    store->write("Birthdate", "10");
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    // group 1 keeps what was read
    EXPECT_FALSE(s.fullentry);
    EXPECT_TRUE(s.sourceinnote);
    EXPECT_EQ(s.logpath, "/tmp/my log.txt");
    // group 2, read before the failing value, is reset as a whole
    EXPECT_EQ(s.country, "UK");
    EXPECT_TRUE(s.birthdate);
    EXPECT_EQ(s.certainty, -1);
    EXPECT_FALSE(s.residence);
    EXPECT_EQ(s.sourcetype, "Census");
    // "Request Image" follows the method read in group 1
    EXPECT_FALSE(s.requestimage);
    EXPECT_FALSE(s.idonly);
    EXPECT_EQ(s.backupfolder, defaultbackupfolder());
    expectgroupsfrom7default(s);
    EXPECT_TRUE(s.firststart);
    EXPECT_FALSE(l.pathchecksdue);
    // group 7 took defaults, so the flag values are written back
    EXPECT_EQ(store->read("Flag Use"), QString("0"));
    EXPECT_EQ(store->read("Flag Check"), QString("0"));
}

TEST_F(SettingsTest, TextValueLengthRules)
{
    {
        fillexcept("Backup Folder", "C", false);
        const settings s = loadsettings(*store).values;
        EXPECT_TRUE(s.idonly);                     // group 5 read
        EXPECT_EQ(s.backupfolder, defaultbackupfolder()); // group 6 reset
        EXPECT_FALSE(s.flaguse);
        EXPECT_TRUE(s.firststart);
    }
    {
        fillexcept("Alternate Separator Character", "", false);
        store->write("Source Type", "");
        const settings s = loadsettings(*store).values;
        EXPECT_EQ(s.alternateseparatorcharacter, "");
        EXPECT_EQ(s.sourcetype, "");
        EXPECT_FALSE(s.firststart);
        store->write("Alternate Separator Character", "ab");
        EXPECT_EQ(loadsettings(*store).values.alternateseparatorcharacter, "-");
    }
    {
        fillexcept("Title", "", false);
        const settings s = loadsettings(*store).values;
        EXPECT_EQ(s.title, defaulttitletemplate());
        EXPECT_FALSE(s.asid); // later groups still read
    }
    {
        fillexcept("Log Path", "", false);
        const settings s = loadsettings(*store).values;
        EXPECT_EQ(s.logpath, defaultlogpath());
        EXPECT_TRUE(s.fullentry); // read as "0", reset with its group
        EXPECT_TRUE(s.keeplog);
        EXPECT_TRUE(s.requestimage);
        EXPECT_EQ(s.country, "UK");
    }
}

TEST_F(SettingsTest, CountryAndCertaintyConversions)
{
    fill(fullstore());
    for (const char* c : {"UK", "USA", "Ireland", "Canada"}) {
        store->write("Country", c);
        EXPECT_EQ(loadsettings(*store).values.country, c);
    }
    for (const char* c : {"France", "usa", " UK"}) {
        store->write("Country", c);
        EXPECT_EQ(loadsettings(*store).values.country, "UK") << c;
    }
    const std::vector<std::pair<const char*, int>> certainties{
        {"0", 0}, {" 3 ", 3}, {"abc", -1}, {"-1", -1}, {"7", -1}, {" ", -1}};
    for (const auto& [text, value] : certainties) {
        store->write("Certainty", text);
        const settings s = loadsettings(*store).values;
        EXPECT_EQ(s.certainty, value) << text;
        EXPECT_TRUE(s.residence) << "values after Certainty still read";
        EXPECT_FALSE(s.nosourcetextwarning);
    }
}

TEST_F(SettingsTest, OlderVersionWithoutLastValueGetsGroupElevenDefaults)
{
    fillexcept("No Source Text Warning");
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    EXPECT_TRUE(s.birthsecondaryevidence); // group 10 kept
    EXPECT_FALSE(s.occscholar);
    EXPECT_FALSE(s.alternateseparator);      // group 11 reset, though read
    EXPECT_EQ(s.alternateseparatorcharacter, "-");
    EXPECT_FALSE(s.marriagecondition);
    EXPECT_TRUE(s.nosourcetextwarning);
    EXPECT_TRUE(s.firststart);
    EXPECT_FALSE(l.pathchecksdue);
    EXPECT_EQ(store->read("Flag Use"), QString("1")) << "group 7 was read: nothing written";
}

TEST_F(SettingsTest, ValuesOutsideTheGroupsAreReadAfterAFailure)
{
    store->write("Full Entry", "10");
    store->write("Count", "123456789012");
    QTemporaryDir images;
    store->write("Image Folder", " " + images.path() + " ");
    store->write("Image Option", "2");
    store->write("Rename File", "1");
    settings s = loadsettings(*store).values;
    EXPECT_EQ(s.count, 123456789012LL);
    EXPECT_EQ(s.imagefolder, images.path());
    EXPECT_EQ(s.imageoption, "2");
    EXPECT_TRUE(s.renamefile);

    store->write("Count", "lots");
    store->write("Image Folder", images.path() + "/gone");
    store->write("Image Option", "12");
    store->write("Rename File", "11");
    s = loadsettings(*store).values;
    EXPECT_EQ(s.count, 0);
    EXPECT_EQ(s.imagefolder, "");
    EXPECT_EQ(s.imageoption, "0");
    EXPECT_FALSE(s.renamefile);
}

TEST_F(SettingsTest, SaveWritesEveryDialogValueTrimmedAndReadsBack)
{
    fill(fullstore());
    settings s = loadsettings(*store).values;
    s.sourcetype = "  Census Return ";
    s.title = " {YEAR} ";
    s.certainty = -1;

    QTemporaryDir other;
    const QString otherpath = other.filePath("saved.ini");
    savesettings(*settingsstore::onfile(otherpath), s);
    QSettings raw(otherpath, QSettings::IniFormat);
    EXPECT_EQ(raw.allKeys().size(), 33) << "the dialog's values and Household Check";
    EXPECT_EQ(raw.value("Household Check").toString(), "1");
    for (const auto& [name, text] : fullstore()) {
        const QString expected = name.startsWith("Flag ") ? QString()
                                 : name == "Certainty"    ? QStringLiteral("-1")
                                 : name == "Title"        ? QStringLiteral("{YEAR}")
                                                          : text.trimmed();
        EXPECT_EQ(raw.value(name).toString(), expected) << name.toStdString();
    }

    // Read back, with the flag values the dialogs write.
    auto saved = settingsstore::onfile(otherpath);
    saveflagsettings(*saved, s);
    const settingsload back = loadsettings(*saved);
    EXPECT_FALSE(back.values.firststart);
    EXPECT_EQ(back.values.sourcetype, "Census Return");
    EXPECT_EQ(back.values.title, "{YEAR}");
    EXPECT_EQ(back.values.certainty, -1);
    EXPECT_EQ(back.values.flaguse, s.flaguse);
    EXPECT_EQ(back.values.alternateseparatorcharacter, s.alternateseparatorcharacter);
}

TEST_F(SettingsTest, SaveFlagSettingsWritesOnlyTheTwoFlagValues)
{
    settings s;
    s.flaguse = true;
    saveflagsettings(*store, s);
    QSettings raw(path, QSettings::IniFormat);
    EXPECT_EQ(raw.allKeys(), QStringList({"Flag Check", "Flag Use"}));
    EXPECT_EQ(raw.value("Flag Use").toString(), "1");
    EXPECT_EQ(raw.value("Flag Check").toString(), "0");
}

} // namespace

TEST_F(SettingsTest, HouseholdCheckIsOnUnlessTurnedOff)
{
    fill(fullstore());
    EXPECT_TRUE(loadsettings(*store).values.householdcheck) << "a store of an older version keeps the check on";
    store->write("Household Check", "0");
    settings s = loadsettings(*store).values;
    EXPECT_FALSE(s.householdcheck);
    s.householdcheck = true;
    savesettings(*store, s);
    EXPECT_TRUE(loadsettings(*store).values.householdcheck);
}

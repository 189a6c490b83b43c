// The settings store: each value read by its rules (a value not accepted
// resets its group and every later group), the values outside the groups,
// and the values a save writes.
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

// Shows texts readably in failure messages.
[[maybe_unused]] static void PrintTo(const QString& s, std::ostream* os)
{
    *os << '"' << s.toStdString() << '"';
}

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

// Every value of s as "Name=text" (the text a save writes) in reading order,
// then those a save does not write: whole settings in one comparison.
QStringList values(const settings& s)
{
    QTemporaryDir dir;
    auto store = settingsstore::onfile(dir.filePath("values.ini"));
    savesettings(*store, s);
    saveflagsettings(*store, s);
    QStringList out = settingnames() << QStringLiteral("Household Check");
    for (QString& name : out)
        name += u'=' + store->read(name).value_or(QStringLiteral("(none)"));
    return out << QStringLiteral("Count=%1").arg(s.count) << QStringLiteral("Image Folder=") + s.imagefolder
               << QStringLiteral("Image Option=") + s.imageoption
               << QStringLiteral("Rename File=%1").arg(int(s.renamefile))
               << QStringLiteral("first start=%1").arg(int(s.firststart));
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

    // The full store, with one value replaced, or left out when `text` is null.
    void fill(const QString& name = {}, const char* text = nullptr)
    {
        for (const auto& [n, t] : fullstore())
            if (n != name)
                store->write(n, t);
            else if (text)
                store->write(n, QString::fromUtf8(text));
    }

    // The values of the full store read, with every value from `first` on
    // reset to its default and the options due at start.
    static QStringList resetfrom(const QString& first)
    {
        QTemporaryDir other;
        auto full = settingsstore::onfile(other.filePath("full.ini"));
        for (const auto& [n, t] : fullstore())
            full->write(n, t);
        QStringList out = values(loadsettings(*full).values);
        const QStringList defaults = values(defaultsettings());
        for (qsizetype i = settingnames().indexOf(first); i < settingnames().size(); ++i)
            out[i] = defaults[i];
        out.last() = QStringLiteral("first start=1");
        return out;
    }

    QTemporaryDir dir;
    QString path;
    std::unique_ptr<settingsstore> store;
};

TEST_F(SettingsTest, NoStoreGivesDefaultsWritesFlagValuesAndAsksForOptions)
{
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    settings declared; // the defaults as declared, with the program folder's paths
    declared.logpath = defaultlogpath();
    declared.backupfolder = defaultbackupfolder();
    declared.firststart = true;
    EXPECT_EQ(values(s), values(declared));
    EXPECT_TRUE(s.fullentry && s.keeplog && s.birthdate && s.requestimage && !s.sourceinnote && !s.renamefile);
    EXPECT_EQ(QStringList({s.country, s.sourcetype, s.title, s.alternateseparatorcharacter, s.imageoption}),
              QStringList({"UK", "Census", defaulttitletemplate(), "-", "0"}));
    EXPECT_EQ(s.certainty, -1);
    EXPECT_TRUE(s.logpath.endsWith(QDir::toNativeSeparators("Quillmark/censuslog.txt")));
    EXPECT_TRUE(QDir(programfolder()).exists());
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
    fill();
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

// A value not accepted (or absent) takes its default with every later value
// of its group and of the later groups; the earlier groups keep what was read.
TEST_F(SettingsTest, RejectedValueResetsItsGroupAndAllLaterGroups)
{
    const struct {
        const char* name;
        const char* text; // null: absent
        const char* reset; // the first value reset
        bool flagswritten; // group 7 reset: its flag values written back
    } cases[] = {
        {"Birthdate", "10", "Country", true},               // one character only
        {"Log Path", "", "Full Entry", true},               // one at least
        {"Backup Folder", "C", "Backup Folder", true},      // two at least
        {"Alternate Separator Character", "ab", "Alternate Separator", false}, // at most one
        {"No Source Text Warning", nullptr, "Alternate Separator", false}, // an older version's store
    };
    int n = 0;
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        store = settingsstore::onfile(dir.filePath(QStringLiteral("case%1.ini").arg(++n)));
        fill(c.name, c.text);
        const settingsload l = loadsettings(*store);
        QStringList expected = resetfrom(c.reset);
        if (QLatin1String(c.reset) == "Country") // "Request Image" follows the method read in group 1
            expected[settingnames().indexOf("Request Image")] = QStringLiteral("Request Image=0");
        EXPECT_EQ(values(l.values), expected);
        EXPECT_EQ(l.defaulted, settingnames().mid(settingnames().indexOf(c.reset)));
        EXPECT_FALSE(l.pathchecksdue);
        EXPECT_EQ(store->read("Flag Use"), QString(c.flagswritten ? "0" : "1"));
    }
}

// Texts that are accepted without being the usual ones.
TEST_F(SettingsTest, BooleanAndEmptyTextsAccepted)
{
    fill("Full Entry", "x");
    store->write("Birthdate", "x");
    store->write("Occ Scholar", " ");
    store->write("Alternate Separator Character", "");
    store->write("Source Type", "");
    store->write("Title", "");
    const settingsload l = loadsettings(*store);
    const settings& s = l.values;
    EXPECT_TRUE(s.fullentry);
    EXPECT_FALSE(s.birthdate || s.occscholar || s.firststart);
    EXPECT_EQ(QStringList({s.alternateseparatorcharacter, s.sourcetype, s.title}),
              QStringList({"", "", defaulttitletemplate()}));
    EXPECT_TRUE(l.defaulted.isEmpty());
}

TEST_F(SettingsTest, CountryAndCertaintyConversions)
{
    fill();
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
        EXPECT_TRUE(s.residence && !s.nosourcetextwarning) << "values after Certainty still read";
    }
}

TEST_F(SettingsTest, ValuesOutsideTheGroupsAreReadAfterAFailure)
{
    QTemporaryDir images;
    const auto read = [&](const char* count, const QString& folder, const char* option, const char* rename) {
        store->write("Full Entry", "10");
        store->write("Count", count);
        store->write("Image Folder", folder);
        store->write("Image Option", option);
        store->write("Rename File", rename);
        return values(loadsettings(*store).values).mid(settingnames().size() + 1, 4);
    };
    EXPECT_EQ(read("123456789012", " " + images.path() + " ", "2", "1"),
              QStringList({"Count=123456789012", "Image Folder=" + images.path(), "Image Option=2", "Rename File=1"}));
    EXPECT_EQ(read("lots", images.path() + "/gone", "12", "11"),
              QStringList({"Count=0", "Image Folder=", "Image Option=0", "Rename File=0"}));
}

TEST_F(SettingsTest, SaveWritesEveryDialogValueTrimmedAndReadsBack)
{
    fill();
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
    s.sourcetype = "Census Return";
    s.title = "{YEAR}";
    EXPECT_EQ(values(back.values), values(s));
    EXPECT_FALSE(back.values.firststart);
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

TEST_F(SettingsTest, HouseholdCheckIsOnUnlessTurnedOff)
{
    fill();
    EXPECT_TRUE(loadsettings(*store).values.householdcheck) << "a store of an older version keeps the check on";
    store->write("Household Check", "0");
    settings s = loadsettings(*store).values;
    EXPECT_FALSE(s.householdcheck);
    s.householdcheck = true;
    savesettings(*store, s);
    EXPECT_TRUE(loadsettings(*store).values.householdcheck);
}

} // namespace

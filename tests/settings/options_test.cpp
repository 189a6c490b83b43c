#include "settings/options.h"

#include "platform/scriptedprompts.h"
#include "platform/settingsstore.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <functional>

#include <gtest/gtest.h>

using namespace qm;

TEST(OptionsLogName, GedcomAndEmptyNamesRefusedTxtAppendedWhenMissing)
{
    for (const char* name : {"/tmp/family.GED", "/tmp/family.ged", "/tmp/family.Ged", "/tmp/logged"}) {
        const logname n = chooselogname(QString::fromLatin1(name));
        EXPECT_EQ(n.error, gedcomlogmessage()) << name;
        EXPECT_TRUE(n.path.isEmpty()) << name;
    }
    EXPECT_EQ(chooselogname(QString()).error, "You must select a path and file name for the log file");
    for (const auto& [in, out] : {std::pair{"/tmp/census", "/tmp/census.txt"}, {"/tmp/census.log", "/tmp/census.log.txt"},
                                  {"/tmp/census.txt", "/tmp/census.txt"}, {"/tmp/CENSUS.TXT", "/tmp/CENSUS.TXT"}}) {
        const logname n = chooselogname(QDir::toNativeSeparators(in));
        EXPECT_EQ(n.path, QDir::toNativeSeparators(out)) << in;
        EXPECT_TRUE(n.error.isEmpty()) << in;
    }
}

TEST(OptionsBackupFolder, OneTrailingSeparatorIsDropped)
{
    EXPECT_EQ(trimbackupfolder("  C:\\Backups\\ "), "C:\\Backups");
    EXPECT_EQ(trimbackupfolder("C:\\Backups"), "C:\\Backups");
    EXPECT_EQ(trimbackupfolder("\\"), "\\"); // one character: kept
#ifndef Q_OS_WIN
    EXPECT_EQ(trimbackupfolder("/home/me/backups/"), "/home/me/backups");
    EXPECT_EQ(trimbackupfolder("/"), "/");
#endif
}

TEST(OptionsCertainty, AssessmentButtonsRecordPrimaryToUnreliable)
{
    for (int choice = -1; choice <= 3; ++choice) {
        EXPECT_EQ(certaintyofchoice(choice), choice < 0 ? -1 : 3 - choice) << choice; // primary 3 ... unreliable 0
        EXPECT_EQ(choiceofcertainty(certaintyofchoice(choice)), choice) << choice;
    }
    EXPECT_EQ(choiceofcertainty(7), -1);
}

TEST(OptionsEnabling, DependentControlsFollowTheirBoxes)
{
    // Enabled or not: log path, entry date today, image 2 event, separator, auto reference.
    const auto enabled = [](const settings& s) {
        const optionsenabling e = enablingof(s);
        return std::string{char('0' + e.logpath), char('0' + e.entrydatetoday), char('0' + e.image2event),
                           char('0' + e.separator), char('0' + e.autoreference)};
    };
    settings s = defaultsettings();
    s.keeplog = s.opt1entrydate = s.requestimages2 = s.alternateseparator = false;
    s.country = "USA";
    EXPECT_EQ(enabled(s), "00100"); // method 1 without the entry date; auto reference is the UK's only
    s.fullentry = false; // method 2
    EXPECT_EQ(enabled(s), "01000");
    s.requestimages2 = s.keeplog = s.alternateseparator = true;
    s.country = "UK";
    EXPECT_EQ(enabled(s), "11111");
}

TEST(OptionsDefaults, DefaultSettingsButtonKeepsWhatItDoesNotSet)
{
    settings form;
    form.fullentry = form.keeplog = form.requestimage = form.occplace = false;
    form.country = "Canada";
    form.certainty = 2;
    form.logpath = "/elsewhere/log.txt";
    form.backupfolder = "/elsewhere";
    form.alternateseparator = true;
    form.alternateseparatorcharacter = "|";
    form.title = "{YEAR}";
    form.marriagecondition = form.flaguse = form.flagcheck = form.birthsecondaryevidence = true;
    form.count = 12;
    const settings d = dialogdefaults(form);
    EXPECT_TRUE(d.fullentry && d.keeplog && d.requestimage && d.occplace);
    EXPECT_EQ(d.country, "UK");
    EXPECT_EQ(d.certainty, -1);
    EXPECT_EQ(d.logpath, defaultlogpath());
    EXPECT_EQ(d.backupfolder, defaultbackupfolder());
    EXPECT_FALSE(d.alternateseparator);
    EXPECT_EQ(d.alternateseparatorcharacter, "-");
    EXPECT_EQ(d.title, defaulttitletemplate());
    // Not set by the button, or not on the dialog at all.
    EXPECT_TRUE(d.marriagecondition && d.flaguse && d.flagcheck && d.birthsecondaryevidence);
    EXPECT_EQ(d.count, 12);
}

TEST(OptionsTitle, ExampleUsesTheSecondCensusAndFixedValues)
{
    EXPECT_EQ(titleexample(defaulttitletemplate()), "Census 1851 Warrington, Lancashire HO107/2204/151 (John Smith)");
    EXPECT_EQ(titleexample("{DATE} {ADDR} {COUNTRY}"), "30 MAR 1851 43 Knutsford Road UK");
    EXPECT_EQ(titleexample(""), "{No Title}");
    EXPECT_EQ(titleplaceholders(), (QStringList{"{YEAR}", "{DATE}", "{PLACE}", "{ADDR}", "{OTHER}", "{REF}", "{COUNTRY}"}));
}

class OptionsSave : public ::testing::Test {
protected:
    static void SetUpTestSuite() { QStandardPaths::setTestModeEnabled(true); }

    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        store = settingsstore::onfile(dir.filePath("settings.ini"));
        current = defaultsettings();
        current.logpath = dir.filePath("censuslog.txt");
        QDir(dir.path()).mkdir(QStringLiteral("backups"));
        current.backupfolder = QDir::toNativeSeparators(dir.filePath("backups"));
        form = current;
    }

    optionssave save() { return saveoptions(prompts, *store, current, form, optionsopening::of(current)); }
    bool written() const { return store->read("No Source Text Warning").has_value(); }

    QTemporaryDir dir;
    std::unique_ptr<settingsstore> store;
    scriptedprompts prompts;
    settings current;
    settings form;
};

TEST_F(OptionsSave, UnchangedFormSavesWithoutQuestionsAndClearsFirstStart)
{
    current.firststart = true;
    form.sourcetype = "  Census Return ";
    form.title = " {YEAR} {PLACE} ";
    form.logpath = "  " + current.logpath + " ";
    form.backupfolder = "  " + QDir::toNativeSeparators(dir.filePath("backups") + "/") + " ";
    const optionssave r = save();
    ASSERT_TRUE(r.saved());
    EXPECT_FALSE(r.reloadneeded);
    EXPECT_FALSE(r.values.firststart);
    EXPECT_EQ(r.values.sourcetype, "Census Return");
    EXPECT_EQ(r.values.title, "{YEAR} {PLACE}");
    EXPECT_EQ(r.values.logpath, current.logpath);
    EXPECT_TRUE(QFileInfo::exists(current.logpath)); // created
    EXPECT_TRUE(prompts.history().empty());
    EXPECT_EQ(store->read("Source Type"), "Census Return");
    EXPECT_EQ(store->read("Log Path"), current.logpath);
    EXPECT_EQ(r.values.backupfolder, current.backupfolder) << "without its trailing separator";
    EXPECT_EQ(store->read("Backup Folder"), current.backupfolder);
    EXPECT_TRUE(written());
}

// Without "Keep Log" the log file is neither created nor checked; an unticked
// separator keeps an empty character.
TEST_F(OptionsSave, UntickedBoxesLeaveTheirValuesUnchecked)
{
    form.keeplog = false;
    form.logpath = dir.filePath("no such folder/log.txt");
    form.alternateseparator = false;
    form.alternateseparatorcharacter.clear();
    const optionssave r = save();
    ASSERT_TRUE(r.saved());
    EXPECT_FALSE(r.values.keeplog);
    EXPECT_FALSE(QFileInfo::exists(dir.filePath("no such folder")));
    EXPECT_EQ(store->read("Keep Log"), "0");
    EXPECT_EQ(store->read("Alternate Separator Character"), "");
}

// Each change that needs the file read again is asked about, No stops the save;
// with the method changed too, only the method question is asked.
TEST_F(OptionsSave, MethodCountryAndIdOnlyChangesAreAskedAndNoStops)
{
    const struct {
        std::function<void(settings&)> change;
        QString question;
    } cases[] = {
        {[](settings& f) { f.fullentry = false; }, methodchangequestion()},
        {[](settings& f) { f.country = "USA"; }, countrychangequestion()},
        {[](settings& f) { f.idonly = true; }, idonlychangequestion()},
        {[](settings& f) { f.fullentry = false; f.country = "Ireland"; f.idonly = true; }, methodchangequestion()},
    };
    int n = 0;
    for (const auto& c : cases) {
        SCOPED_TRACE(c.question.toStdString());
        store = settingsstore::onfile(dir.filePath(QStringLiteral("case%1.ini").arg(++n)));
        form = current;
        c.change(form);
        prompts.expect(answer::no, c.question);
        EXPECT_EQ(save().stop, optionsstop::declined);
        EXPECT_FALSE(written());
        const message& m = prompts.history().back().m;
        EXPECT_EQ(m.title, "Save Options");
        EXPECT_EQ(m.choice, buttons::yesno);
        EXPECT_EQ(m.kind, icon::exclamation);
        EXPECT_EQ(m.defaultanswer, answer::no);

        prompts.expect(answer::yes, c.question);
        const optionssave r = save();
        ASSERT_TRUE(r.saved());
        EXPECT_TRUE(r.reloadneeded);
        EXPECT_EQ(r.values.fullentry, form.fullentry);
        EXPECT_EQ(r.values.country, form.country);
        EXPECT_EQ(r.values.idonly, form.idonly);
        EXPECT_EQ(store->read("Country"), form.country);
        EXPECT_EQ(prompts.unexpected(), 0);
    }
    EXPECT_EQ(prompts.history().size(), 8u); // two questions a case, nothing more
}

// Each stop of Save: its message or question, in that order, and nothing written.
TEST_F(OptionsSave, EachStopShowsItsMessageAndWritesNothing)
{
    const struct {
        std::function<void(settings&)> change;
        std::vector<std::pair<answer, QString>> shown;
        optionsstop stop;
    } cases[] = {
        {[&](settings& f) { f.logpath = dir.filePath("no such folder/log.txt"), f.fullentry = false; },
         {{answer::ok, "Error creating the log file specified, please check the file name and path and that you have "
                       "access to it and that the disk is not full."}},
         optionsstop::logfile}, // before the method question
        {[&](settings& f) { f.logpath = dir.filePath("family.GED"); }, {{answer::ok, gedcomlogmessage()}},
         optionsstop::logfile}, // typed by hand: refused as the chooser refuses it
        {[&](settings& f) { f.logpath = dir.filePath("backups/log.txt"); },
         {{answer::ok, "is in the backup folder, which holds only backups of family files."}},
         optionsstop::logfile}, // never among the backups
        {[](settings& f) { f.alternateseparator = true, f.alternateseparatorcharacter.clear(), f.country = "Canada"; },
         {{answer::yes, countrychangequestion()}}, optionsstop::noseparator}, // the window shows its message
        {[&](settings& f) { f.backupfolder = dir.filePath("gone"), f.occage = true; },
         {{answer::ok, "does not exist."}}, optionsstop::paths},
    };
    for (const auto& c : cases) {
        form = current;
        c.change(form);
        const size_t before = prompts.history().size();
        for (const auto& [a, text] : c.shown)
            prompts.expect(a, text);
        EXPECT_EQ(save().stop, c.stop) << c.shown.back().second.toStdString();
        EXPECT_EQ(prompts.history().size() - before, c.shown.size());
        EXPECT_EQ(prompts.unexpected(), 0);
        EXPECT_FALSE(written());
    }
    EXPECT_FALSE(QFileInfo::exists(dir.filePath("family.GED")));
    EXPECT_FALSE(QFileInfo::exists(dir.filePath("backups/log.txt")));
}

TEST_F(OptionsSave, EverySettingOfTheFormIsStored)
{
    form.sourceinnote = form.residence = form.opt1entrydate = form.opt1whereinsource = form.opt1publicationinfo = true;
    form.requestimages2 = form.image2event = form.entrydatetoday = form.occage = form.sharednote = true;
    form.sourcenote = form.marriagecondition = form.autoreference = true;
    form.birthdate = form.requestimage = form.occplace = form.asid = form.fileopendefault = false;
    form.occscholar = form.nosourcetextwarning = false;
    form.certainty = 1;
    form.alternateseparator = true;
    form.alternateseparatorcharacter = "|";
    form.flaguse = true; // not the dialog's: stays as in use
    const optionssave r = save();
    ASSERT_TRUE(r.saved());
    EXPECT_FALSE(r.values.flaguse);
    for (const char* on : {"Source in Note", "Residence", "Opt1 Entry Date", "Opt1 Where in Source",
                           "Opt1 Publication Info", "Request Images 2", "Image 2 Event", "Entry Date Today", "Occ Age",
                           "Shared Note", "Source Note", "Marriage Condition", "Auto Reference", "Alternate Separator"})
        EXPECT_EQ(store->read(QString::fromLatin1(on)), "1") << on;
    for (const char* off : {"Birthdate", "Request Image", "Occ Place", "ASID", "File Open Default", "Occ Scholar",
                            "No Source Text Warning"})
        EXPECT_EQ(store->read(QString::fromLatin1(off)), "0") << off;
    EXPECT_EQ(store->read("Certainty"), "1");
    EXPECT_EQ(store->read("Alternate Separator Character"), "|");
}

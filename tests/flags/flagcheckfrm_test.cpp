// The Flag Check dialogs on the offscreen platform: the check after a family
// file is opened with "Flag Check" on, end to end through the main window; the
// check over the open file alone (the country question cancelled, no changes
// made, a family file changed by another program before the changes are
// made); and the dialog's own controls. What the check finds: flagcheck_test.
#include "flags/flagcheckfrm.h"

#include "flags/flagcheck.h"
#include "flags/flagsmenu_ui.h"
#include "model/loadgedcom.h"
#include "support/dialogs.h"
#include "support/mainfrmfixture.h"
#include "support/openfixture.h"
#include "support/testflags.h"

#include <QCheckBox>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

// John lacks the 1881 flag; Mary holds it with no census event; Ann and Pat
// were counted on the 1901 census day in Dublin (UK or Ireland?).
const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n"
                           "0 @I3@ INDI\r\n1 NAME Ann /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC Dublin\r\n"
                           "0 @I4@ INDI\r\n1 NAME Pat /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC dublin\r\n"
                           "0 TRLR\r\n";

void tick(QDialog* d, const char* box, bool on)
{
    child<QCheckBox>(d, box)->setChecked(on);
}

} // namespace

class flagcheckfrmtest : public QObject {
    Q_OBJECT

    windowfiles files;
    QString backups;

    settings checking() const
    {
        settings s = defaultsettings();
        s.flagcheck = true;
        s.backupfolder = backups;
        s.logpath = files.filepath(QStringLiteral("censuslog.txt"));
        return s;
    }

    QString familyfile(const std::string& bytes = family)
    {
        static int n = 0;
        const QString path = files.filepath(QStringLiteral("family%1.ged").arg(++n));
        writefile(path, bytes);
        return path;
    }

    int backupcount() const { return static_cast<int>(QDir(backups).entryList({QStringLiteral("QM Backup*")}, QDir::Files).size()); }

private slots:
    void initTestCase()
    {
        QVERIFY(files.valid());
        backups = files.filepath(QStringLiteral("backups"));
        QVERIFY(QDir().mkpath(backups));
    }

    // A file in step opens without a word; opening one out of step from the
    // menu: the message, the question for Ann (Ireland, for all of Dublin: Pat
    // is not asked), the dialog's rows, the changes made and the file read again.
    void checkafteropening()
    {
        auto r = std::make_unique<session>(files.ini());
        savesettings(*r->store, checking());
        saveflagsettings(*r->store, checking());
        saveflagdefs(*r->store, testflagdefs());
        r->make();
        r->prompts.expect(answer::no, QStringLiteral("by default"));
        dialoganswers dialogs;
        QVERIFY(r->w->start({QLatin1Char('"')
                             + familyfile("0 HEAD\r\n0 @I1@ INDI\r\n1 NAME Tom /Smith/\r\n1 CENS\r\n2 DATE 1881\r\n"
                                          "1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n0 TRLR\r\n")
                             + QLatin1Char('"')}));
        r->w->show();
        QTest::qWait(30);
        QVERIFY(dialogs.seen.isEmpty() && answered(r->prompts));

        const QString file = familyfile();
        const int before = backupcount();
        QStringList countries;
        QString shown;
        dialogs.expect(QStringLiteral("flagcheckcountryfrm"), [&](QDialog* d) {
            for (int i = 0; i < 4; ++i) {
                auto* o = child<QRadioButton>(d, QStringLiteral("countryopt%1").arg(i));
                if (!o->isHidden())
                    countries << o->text() + (o->isChecked() ? QStringLiteral("*") : QString());
            }
            for (const char* name : {"namelab", "idlab", "datelab", "placelab"})
                shown += child<QLabel>(d, name)->text() + QLatin1Char('|');
            press(d, "countryopt1");
            tick(d, "alwayschk", true);
            press(d, "okbut");
        });
        QStringList added, removed;
        dialogs.expect(QStringLiteral("flagcheckfrm"), [&](QDialog* d) {
            added = rows(d, "addlst");
            removed = rows(d, "removelst");
            press(d, "Changebut");
        });
        r->prompts.expect(answer::no, QStringLiteral("by default"));
        r->prompts.expect(answer::ok, QStringLiteral("out of sync with the census entries"));
        r->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to set/unset flags as suggested?"));
        r->w->openfamilyfile(file);
        QVERIFY(answered(dialogs) && answered(r->prompts));
        QCOMPARE(countries, QStringList({QStringLiteral("UK*"), QStringLiteral("Ireland")}));
        QCOMPARE(shown, QStringLiteral("Byrne, Ann|3|31 MAR 1901|Dublin|"));
        QCOMPARE(added, QStringList({QStringLiteral("'Census 1881' flag to individual Smith, John (ID: 1)"),
                                     QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Ann (ID: 3)"),
                                     QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Pat (ID: 4)")}));
        QCOMPARE(removed, QStringList({QStringLiteral("'Census 1881' flag from individual Smith, Mary (ID: 2)")}));
        // Written (the lines: flagcheck_test), backed up, and read again.
        QVERIFY(readfile(file).find("2 PLAC Dublin\r\n1 _FLGS\r\n2 __CENSUS_IRELAN Census Ireland 1901\r\n")
                != std::string::npos);
        QCOMPARE(backupcount(), before + 1);
        QVERIFY(r->w->gedcomfile() == file && !flagsoutofstep(*r->w->index()) && r->w->watching());
    }

    // The check over the open file without the main window: a cancelled
    // country question (the message, no Flag Check dialog) or "Don't make
    // changes" write nothing; a change made by another program while the
    // dialog is open is not written over, and the file is to be read again.
    void checkoverthefile()
    {
        for (const int run : {0, 1, 2}) {
            const bool cancel = run == 0, outside = run == 2;
            const QString file = familyfile();
            const int before = backupcount();
            const flagtable defs = testflagdefs();
            const openrun open = openon(files.ini(), file, checking(), &defs);
            QVERIFY(open.read);
            scriptedprompts p;
            dialoganswers dialogs;
            dialogs.expect(QStringLiteral("flagcheckcountryfrm"), [cancel, outside](QDialog* d) {
                tick(d, "alwayschk", !outside); // else asked for Pat too
                press(d, cancel ? "cancelbut" : "okbut");
            });
            if (outside)
                dialogs.expect(QStringLiteral("flagcheckcountryfrm"), [](QDialog* d) { press(d, "okbut"); });
            if (!cancel)
                dialogs.expect(QStringLiteral("flagcheckfrm"), [&](QDialog* d) {
                    if (outside)
                        QVERIFY(replaceinfile(file, "1 NAME Pat /Byrne/", "1 NAME Patrick /Byrne/"));
                    press(d, outside ? "Changebut" : "closebut");
                });
            p.expect(answer::ok, QStringLiteral("out of sync"));
            if (cancel)
                p.expect(answer::ok, QStringLiteral("Flag check was cancelled. The flags in the file have not been changed."));
            if (outside) {
                p.expect(answer::yes, QStringLiteral("set/unset"));
                p.expect(answer::ok, QDir::toNativeSeparators(file) +
                                         QStringLiteral(" has been modified by another application. Flags will not be "
                                                        "changed as a precaution to ensure there is no data loss. This "
                                                        "form will now close and the file will be reloaded."));
            }
            QCOMPARE(silentflagcheck(*open.file, p, nullptr), outside ? toolend::reload : toolend::unchanged);
            QVERIFY(open.file->watching());
            QVERIFY(answered(dialogs) && answered(p));
            std::string now = family;
            if (outside)
                now.replace(now.find("1 NAME Pat"), 10, "1 NAME Patrick");
            QCOMPARE(readfile(file), now);
            QCOMPARE(backupcount(), before);
        }
    }

    // The dialog alone: "Flag Check" stored when ticked by the user only, the
    // help topic, nothing to change, a failed backup keeping it open.
    void dialogcontrols()
    {
        auto store = settingsstore::onfile(files.ini());
        scriptedprompts prompts;
        settings s = checking();
        std::unique_ptr<gedcomindex> empty = loadgedcombytes("0 HEAD\r\n0 TRLR\r\n", testflagdefs());
        {
            flagcheckfrm d(*empty, s, *store, prompts);
            QCOMPARE(rows(&d, "addlst").size(), 1); // the nothing row
            QVERIFY(!child(&d, "Changebut")->isEnabled());
            QVERIFY(child(&d, "flagschk")->isChecked() && !store->read(QStringLiteral("Flag Check")));
            press(&d, "flagschk");
            QCOMPARE(store->read(QStringLiteral("Flag Check")).value_or(QString()), QStringLiteral("0"));
            press(&d, "helpbut");
            QCOMPARE(prompts.helpshown, QStringList({QStringLiteral("55")}));
        }

        // A backup that cannot be made: the message, the dialog stays, nothing written.
        const std::string john = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n0 TRLR\r\n";
        const QString file = familyfile(john);
        const loadresult loaded = loadgedcom(file, testflagdefs());
        QVERIFY(loaded.index);
        s.backupfolder = file + QStringLiteral("/backups"); // under a file: cannot be made
        flagcheckfrm d(*loaded.index, s, *store, prompts, nullptr);
        QVERIFY(!d.cancelled());
        d.show();
        QVERIFY(child(&d, "Changebut")->isEnabled());
        prompts.expect(answer::no, QStringLiteral("set/unset"));
        press(&d, "Changebut");
        prompts.expect(answer::yes, QStringLiteral("set/unset"));
        prompts.expect(answer::ok);
        press(&d, "Changebut");
        QVERIFY(answered(prompts));
        QVERIFY(d.isVisible() && d.outcome() == toolend::unchanged);
        QCOMPARE(readfile(file), john);
    }
};

QTEST_MAIN(flagcheckfrmtest)
#include "flagcheckfrm_test.moc"

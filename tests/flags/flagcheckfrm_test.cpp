// The Flag Check dialogs on the offscreen platform: the silent check after a
// family file is opened with "Flag Check" on, end to end through the main
// window; the check over the open file alone (the country question cancelled,
// no changes made, a family file changed by another program before the
// changes are made); and the dialog's own controls.
#include "flags/flagcheckfrm.h"

#include "flags/flagcheck.h"
#include "flags/flagsmenu_ui.h"
#include "flags/flagtable.h"
#include "model/loadgedcom.h"
#include "support/mainfrmfixture.h"
#include "support/openfixture.h"
#include "support/testflags.h"
#include "writer/saveroad.h"

#include <QCheckBox>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

// John lacks the 1881 flag; Mary holds it with no census event; Ann and Pat
// were counted on the 1901 census day in Dublin (UK or Ireland?).
const QByteArray family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                          "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds\r\n"
                          "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n"
                          "0 @I3@ INDI\r\n1 NAME Ann /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC Dublin\r\n"
                          "0 @I4@ INDI\r\n1 NAME Pat /Byrne/\r\n1 CENS\r\n2 DATE 31 MAR 1901\r\n2 PLAC dublin\r\n"
                          "0 TRLR\r\n";

QStringList rows(QDialog* d, const char* list)
{
    QStringList out;
    auto* l = d->findChild<QListWidget*>(QString::fromLatin1(list));
    for (int i = 0; l && i < l->count(); ++i)
        out << l->item(i)->text();
    return out;
}

void click(QDialog* d, const char* name)
{
    d->findChild<QAbstractButton*>(QString::fromLatin1(name))->click();
}

QByteArray bytesof(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

} // namespace

class flagcheckfrmtest : public QObject {
    Q_OBJECT

    windowfiles files;
    QString backups;

    settings checking()
    {
        settings s = defaultsettings();
        s.flagcheck = true;
        s.backupfolder = backups;
        s.logpath = files.filepath(QStringLiteral("censuslog.txt"));
        return s;
    }

    QString familyfile()
    {
        static int n = 0;
        const QString path = files.filepath(QStringLiteral("family%1.ged").arg(++n));
        QFile f(path);
        if (!f.open(QIODevice::WriteOnly) || f.write(family) != family.size())
            return QString();
        return path;
    }

    // `bytes` written to `file` and loaded with the flag definitions.
    static loadresult loadedfile(const QString& file, const QByteArray& bytes)
    {
        writefile(file, bytes.toStdString());
        return loadgedcom(file, testflagdefs());
    }

    int backupcount() const { return static_cast<int>(QDir(backups).entryList({QStringLiteral("QM Backup*")}, QDir::Files).size()); }

    // Starts the main window on `file` with the flag definitions in its store;
    // `queue` queues the prompts' answers after the default-file question.
    std::unique_ptr<session> start(const QString& file, const settings& s,
                                   const std::function<void(scriptedprompts&)>& queue)
    {
        auto r = std::make_unique<session>(files.ini());
        savesettings(*r->store, s);
        saveflagsettings(*r->store, s);
        saveflagdefs(*r->store, testflagdefs());
        r->store->sync();
        r->make();
        r->prompts.expect(answer::no, QStringLiteral("by default"));
        queue(r->prompts);
        if (!r->w->start({QLatin1Char('"') + file + QLatin1Char('"')}))
            return nullptr;
        r->w->show();
        return r;
    }

private slots:
    void initTestCase()
    {
        QVERIFY(files.valid());
        backups = files.filepath(QStringLiteral("backups"));
        QVERIFY(QDir().mkpath(backups));
    }

    // Opening a file with "Flag Check" on: the message, the question for Ann
    // (Ireland, for all of Dublin: Pat is not asked), the dialog's rows, the
    // changes made and the file read again.
    void silentcheckopensthedialogandmakesthechanges()
    {
        const QString file = familyfile();
        const int before = backupcount();
        dialoganswers dialogs;
        QStringList countries;
        QString shown;
        dialogs.expect(QStringLiteral("flagcheckcountryfrm"), [&](QDialog* d) {
            for (int i = 0; i < 4; ++i) {
                auto* o = d->findChild<QRadioButton*>(QStringLiteral("countryopt%1").arg(i));
                if (o && !o->isHidden())
                    countries << o->text() + (o->isChecked() ? QStringLiteral("*") : QString());
            }
            for (const char* name : {"namelab", "idlab", "datelab", "placelab"})
                shown += d->findChild<QLabel*>(QString::fromLatin1(name))->text() + QLatin1Char('|');
            click(d, "countryopt1");
            d->findChild<QCheckBox*>(QStringLiteral("alwayschk"))->setChecked(true);
            click(d, "okbut");
        });
        QStringList added, removed;
        dialogs.expect(QStringLiteral("flagcheckfrm"), [&](QDialog* d) {
            added = rows(d, "addlst");
            removed = rows(d, "removelst");
            click(d, "Changebut");
        });
        auto r = start(file, checking(), [](scriptedprompts& p) {
            p.expect(answer::ok, QStringLiteral("out of sync with the census entries"));
            p.expect(answer::yes, QStringLiteral("Are you sure you want to set/unset flags as suggested?"));
        });
        QVERIFY(r);
        QVERIFY(dialogs.unexpected == 0 && dialogs.pending() == 0 && r->prompts.unexpected() == 0);
        QCOMPARE(countries, QStringList({QStringLiteral("UK*"), QStringLiteral("Ireland")}));
        QCOMPARE(shown, QStringLiteral("Byrne, Ann|3|31 MAR 1901|Dublin|"));
        QCOMPARE(added, QStringList({QStringLiteral("'Census 1881' flag to individual Smith, John (ID: 1)"),
                                     QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Ann (ID: 3)"),
                                     QStringLiteral("'Census Ireland 1901' flag to individual Byrne, Pat (ID: 4)")}));
        QCOMPARE(removed, QStringList({QStringLiteral("'Census 1881' flag from individual Smith, Mary (ID: 2)")}));

        // The file holds the changes, its backup the file as it was, and the
        // window has read it again.
        const QByteArray now = bytesof(file);
        QVERIFY(now.contains("2 PLAC Leeds\r\n1 _FLGS\r\n2 __CENSUS_1881 Census 1881\r\n1 CHAN"));
        QVERIFY(now.contains("1 NAME Mary /Smith/\r\n1 CHAN"));
        QVERIFY(now.contains("2 PLAC Dublin\r\n1 _FLGS\r\n2 __CENSUS_IRELAN Census Ireland 1901\r\n1 CHAN"));
        QVERIFY(now.contains("2 PLAC dublin\r\n1 _FLGS\r\n2 __CENSUS_IRELAN Census Ireland 1901\r\n1 CHAN"));
        QCOMPARE(backupcount(), before + 1);
        const gedcomindex* ix = r->w->index();
        QVERIFY(ix && !flagsoutofstep(*ix));
        QVERIFY(r->w->watching());
    }

    // The check itself, over the open file without the main window: a
    // cancelled country question (the message, no Flag Check dialog) or "Don't
    // make changes" write nothing; a change made by another program while the
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
                d->findChild<QCheckBox*>(QStringLiteral("alwayschk"))->setChecked(!outside); // else asked for Pat too
                click(d, cancel ? "cancelbut" : "okbut");
            });
            if (outside)
                dialogs.expect(QStringLiteral("flagcheckcountryfrm"), [](QDialog* d) { click(d, "okbut"); });
            if (!cancel)
                dialogs.expect(QStringLiteral("flagcheckfrm"), [&](QDialog* d) {
                    if (outside)
                        QVERIFY(replaceinfile(file, "1 NAME Pat /Byrne/", "1 NAME Patrick /Byrne/"));
                    click(d, outside ? "Changebut" : "closebut");
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
            QVERIFY(dialogs.unexpected == 0 && dialogs.pending() == 0 && p.unexpected() == 0);
            QByteArray now = family;
            if (outside)
                now.replace("1 NAME Pat /Byrne/", "1 NAME Patrick /Byrne/");
            QCOMPARE(bytesof(file), now);
            QCOMPARE(backupcount(), before);
        }
    }

    // With the flags in step nothing is shown; opening a file from the menu checks it too.
    void instepfilesandopeningfromthemenu()
    {
        const QString instep = files.filepath(QStringLiteral("instep.ged"));
        QFile f(instep);
        QVERIFY(f.open(QIODevice::WriteOnly));
        f.write("0 HEAD\r\n0 @I1@ INDI\r\n1 NAME Tom /Smith/\r\n1 CENS\r\n2 DATE 1881\r\n1 _FLGS\r\n"
                "2 __CENSUS_1881 Census 1881\r\n0 TRLR\r\n");
        f.close();
        dialoganswers none;
        auto quiet = start(instep, checking(), [](scriptedprompts&) {});
        QVERIFY(quiet);
        QTest::qWait(30);
        QVERIFY(none.seen.isEmpty() && quiet->prompts.unexpected() == 0);

        // Opening another file from the menu checks it too.
        none.expect(QStringLiteral("flagcheckcountryfrm"), [](QDialog* d) {
            click(d, "cancelbut");
        });
        quiet->prompts.expect(answer::no, QStringLiteral("by default"));
        quiet->prompts.expect(answer::ok, QStringLiteral("out of sync"));
        quiet->prompts.expect(answer::ok, QStringLiteral("Flag check was cancelled."));
        const QString file = familyfile();
        quiet->w->openfamilyfile(file);
        QCOMPARE(none.seen, QStringList({QStringLiteral("flagcheckcountryfrm")}));
        QVERIFY(quiet->prompts.unexpected() == 0 && quiet->w->gedcomfile() == file && quiet->w->watching());
    }

    // The dialog alone: "Flag Check" stored when ticked by the user only, the
    // help topic, nothing to change, a failed backup keeping it open.
    void dialogcontrols()
    {
        auto store = settingsstore::onfile(files.ini());
        scriptedprompts prompts;
        settings s = checking();
        std::unique_ptr<gedcomindex> ix = loadgedcombytes("0 HEAD\r\n0 TRLR\r\n", testflagdefs());
        {
            flagcheckfrm d(*ix, s, *store, prompts);
            QCOMPARE(rows(&d, "addlst").size(), 1); // the nothing row
            QVERIFY(!d.findChild<QPushButton*>(QStringLiteral("Changebut"))->isEnabled());
            auto* chk = d.findChild<QCheckBox*>(QStringLiteral("flagschk"));
            QVERIFY(chk->isChecked() && !store->read(QStringLiteral("Flag Check")));
            chk->click();
            QCOMPARE(store->read(QStringLiteral("Flag Check")).value_or(QString()), QStringLiteral("0"));
            d.findChild<QPushButton*>(QStringLiteral("helpbut"))->click();
            QCOMPARE(prompts.helpshown, QStringList({QStringLiteral("55")}));
        }

        // A backup that cannot be made: the message, the dialog stays, nothing written.
        const QString file = files.filepath(QStringLiteral("john.ged"));
        const QByteArray john = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n0 TRLR\r\n";
        loadresult loaded = loadedfile(file, john);
        QVERIFY(loaded.index);
        s.backupfolder = file + QStringLiteral("/backups"); // under a file: cannot be made
        flagcheckfrm d(*loaded.index, s, *store, prompts, nullptr);
        QVERIFY(!d.cancelled());
        d.show();
        auto* change = d.findChild<QPushButton*>(QStringLiteral("Changebut"));
        QVERIFY(change->isEnabled());
        prompts.expect(answer::no, QStringLiteral("set/unset"));
        change->click();
        prompts.expect(answer::yes, QStringLiteral("set/unset"));
        prompts.expect(answer::ok);
        change->click();
        QCOMPARE(prompts.unexpected(), 0);
        QVERIFY(d.isVisible());
        QCOMPARE(d.outcome(), toolend::unchanged);
        QCOMPARE(bytesof(file), john);
    }
};

QTEST_MAIN(flagcheckfrmtest)
#include "flagcheckfrm_test.moc"

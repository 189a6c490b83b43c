// End-to-end tests of the options dialog on the offscreen platform: opened at
// first start and when the paths fail their checks, and from "Options..." of
// the main window, answered through its own controls. What Save checks and
// writes is the options' own tests' (options_test); here what the controls
// pass to it and what the windows do with the result.
#include "settings/optionsfrm.h"

#include "app/mainfrm.h"
#include "census/censustable.h"
#include "census/entrypanel_ui.h"
#include "support/mainfrmfixture.h"

#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QStandardPaths>
#include <QTabWidget>
#include <QTest>
#include <QToolButton>

using namespace qm;
using namespace qmtest;

namespace {

QString native(const QString& path)
{
    return QDir::toNativeSeparators(path);
}

// Runs `open` and `body` in the options dialog it opens; a dialog left open
// is cancelled. False when the dialog did not open, or another did.
bool inoptions(const std::function<bool()>& open, const std::function<void(optionsfrm&)>& body)
{
    dialoganswers answers;
    bool shown = false;
    answers.expect(QStringLiteral("optionsfrm"), [&](QDialog* d) {
        shown = true;
        body(*static_cast<optionsfrm*>(d));
        if (d->isVisible())
            d->reject();
    });
    return open() && shown && answers.unexpected == 0;
}

bool inoptions(mainfrm& w, const std::function<void(optionsfrm&)>& body)
{
    return inoptions(
        [&] {
            w.findChild<QAction*>(QStringLiteral("optionsmen"))->trigger();
            return true;
        },
        body);
}

} // namespace

class optionsfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

    // A start of the program on a copy of the sample, with `s` written to the
    // store first (or an empty store), the default-file question answered No,
    // a message at start when `atstart` is given, and `body` run in the
    // options dialog that opens at start.
    std::unique_ptr<session> started(const settings* s, const std::function<void(optionsfrm&, session&)>& body,
                                     const QString& atstart = {})
    {
        auto r = std::make_unique<session>(files_.ini(), false);
        if (s) {
            savesettings(*r->store, *s);
            saveflagsettings(*r->store, *s);
        }
        r->make();
        r->prompts.expect(answer::no, QStringLiteral("by default"));
        if (!atstart.isEmpty())
            r->prompts.expect(answer::ok, atstart);
        const bool ok = inoptions([&] { return r->w->start({QLatin1Char('"') + files_.sample() + QLatin1Char('"')}); },
                                  [&](optionsfrm& f) { body(f, *r); });
        return ok ? std::move(r) : nullptr;
    }

    settings withpaths()
    {
        settings s = defaultsettings();
        s.logpath = native(files_.filepath(QStringLiteral("censuslog.txt")));
        // The census log is never kept among the backups.
        QDir().mkpath(files_.filepath(QStringLiteral("start")));
        s.backupfolder = native(files_.filepath(QStringLiteral("start")));
        return s;
    }

private slots:
    void initTestCase()
    {
        QStandardPaths::setTestModeEnabled(true);
        QVERIFY(files_.valid());
    }

    // Incomplete settings: the dialog opens before the file is loaded and
    // cannot be left without saving; Save writes the store.
    void firststart()
    {
        auto s = started(nullptr, [&](optionsfrm& f, session& run) {
            QVERIFY(!f.Cancelbut->isEnabled());
            QCOMPARE(f.SSTab1->currentIndex(), 0);
            QCOMPARE(f.findChild<QGroupBox*>(QStringLiteral("idonlyfra"))->title(),
                     QStringLiteral("Individual Record ID"));
            QTest::keyClick(&f, Qt::Key_Escape);
            QVERIFY(f.isVisible());
            f.close();
            QVERIFY(f.isVisible());
            QVERIFY(!run.w->index()); // the file is not read yet
            f.occagechk->click();
            f.methodopt[1]->click();
            run.prompts.expect(answer::no, methodchangequestion());
            f.savebut->click();
            QVERIFY(f.isVisible());
            f.methodopt[0]->click();
            f.savebut->click();
            QVERIFY(!f.isVisible());
        });
        QVERIFY(s);
        QCOMPARE(s->prompts.unexpected(), 0);
        QVERIFY(!s->w->firststart());
        QVERIFY(s->w->currentsettings().occage);
        QCOMPARE(s->read("Occ Age"), QStringLiteral("1"));
        QCOMPARE(s->w->index()->people.size(), size_t(40));
    }

    // A backup folder that is gone: the message at start, then the dialog,
    // which stays open until the folder is put right (through the chooser,
    // which refuses a folder that is not there); nothing is written before.
    void pathsfailatstart()
    {
        settings bad = withpaths();
        bad.backupfolder = files_.filepath(QStringLiteral("gone"));
        const QString start = files_.filepath(QStringLiteral("start"));
        auto s = started(&bad, [&](optionsfrm& f, session& run) {
            f.occagechk->click();
            run.prompts.expect(answer::ok, QStringLiteral("does not exist. "));
            f.savebut->click();
            QVERIFY(f.isVisible());
            // The folder is chosen, never typed; one that is not there is refused.
            QVERIFY(f.folderpathtxt->isReadOnly());
            run.prompts.expectfile(files_.filepath(QStringLiteral("nothere")));
            run.prompts.expect(answer::ok,
                               QStringLiteral("You are not able to select that location for the backup folder."));
            f.folderpathbut->click();
            run.prompts.expectfile(start + QLatin1Char('/'));
            f.folderpathbut->click();
            QCOMPARE(f.folderpathtxt->text(), native(start + QLatin1Char('/')));
            f.savebut->click();
            QVERIFY(!f.isVisible());
        }, QStringLiteral("does not exist. "));
        QVERIFY(s);
        QCOMPARE(s->prompts.unexpected(), 0);
        QVERIFY(!s->w->firststart());
        QCOMPARE(s->read("Backup Folder"), native(start));
        QCOMPARE(s->read("Occ Age"), QStringLiteral("1"));
    }

    // From "Options...": a declined method change keeps the dialog and the
    // entry; a change that needs no reload keeps the entry; method and
    // country changed read the file again for them.
    void methodchange()
    {
        const settings paths = withpaths();
        auto s = files_.opened(files_.sample(), &paths);
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1881"));
        clickid(w, peoplelist(w), 11);

        QVERIFY(inoptions(w, [&](optionsfrm& f) {
            f.SSTab1->setCurrentIndex(1);
            f.methodopt[1]->click();
            QVERIFY(f.entrydatetodaychk->isEnabled());
            QVERIFY(!f.image2eventchk->isEnabled());
            f.images2chk->click();
            QVERIFY(f.image2eventchk->isEnabled());
            s->prompts.expect(answer::no, methodchangequestion());
            f.savebut->click();
            QVERIFY(f.isVisible());
            f.Cancelbut->click();
        }));
        QVERIFY(w.currentsettings().fullentry);
        QCOMPARE(w.household().selectioncount, 1);

        QVERIFY(inoptions(w, [&](optionsfrm& f) {
            f.occagechk->click();
            QVERIFY(f.householdcheckchk->isChecked());
            f.householdcheckchk->click();
            f.savebut->click();
            QVERIFY(!f.isVisible());
        }));
        QVERIFY(w.currentsettings().occage && !w.currentsettings().householdcheck);
        QCOMPARE(s->read("Household Check"), QStringLiteral("0"));
        QCOMPARE(w.household().selectioncount, 1);

        QVERIFY(inoptions(w, [&](optionsfrm& f) {
            QVERIFY(f.methodopt[0]->isChecked());
            f.methodopt[1]->click();
            f.usaopt->click();
            QVERIFY(!f.autorefchk->isEnabled());
            s->prompts.expect(answer::yes, methodchangequestion());
            f.savebut->click();
            QVERIFY(!f.isVisible());
        }));
        QCOMPARE(s->prompts.unexpected(), 0);
        QVERIFY(!w.currentsettings().fullentry);
        QCOMPARE(w.currentsettings().country, QStringLiteral("USA"));
        QCOMPARE(w.household().selectioncount, 0);
        QCOMPARE(w.panel()->mode, 1);
        QVERIFY(!w.findChild<QAction*>(QStringLiteral("attachbut"))->isEnabled());
        QCOMPARE(w.panel()->yearcom->itemText(0), fillyears(QStringLiteral("USA")).front());
    }

    // An empty separator: the tab and the box are shown with the message; the
    // log: its box follows "Keep Log", the chooser's refusal and Cancel keep
    // the path, the log file is made and "View Log" follows.
    void separatorandlog()
    {
        const settings paths = withpaths();
        auto s = files_.opened(files_.sample(), &paths);
        QVERIFY(s);
        mainfrm& w = *s->w;
        QVERIFY(inoptions(w, [&](optionsfrm& f) {
            QVERIFY(!f.separatortxt->isEnabled());
            f.SSTab1->setCurrentIndex(1);
            f.separatorchk->click();
            QVERIFY(f.separatortxt->isEnabled());
            QCOMPARE(f.focusWidget(), f.separatortxt);
            QCOMPARE(f.separatortxt->selectedText(), QStringLiteral("-"));
            f.separatortxt->clear();
            f.SSTab1->setCurrentIndex(4);
            f.savebut->setFocus();
            s->prompts.expect(answer::ok, QStringLiteral("You must enter a character to act as a separator"));
            f.savebut->click();
            QVERIFY(f.isVisible());
            QVERIFY(f.SSTab1->currentWidget()->isAncestorOf(f.separatortxt));
            QCOMPARE(f.focusWidget(), f.separatortxt);
            QTest::keyClicks(f.separatortxt, QStringLiteral("|"));

            QVERIFY(f.pathtxt->isEnabled() && f.pathbut->isEnabled());
            f.keeplogchk->click();
            QVERIFY(!f.pathtxt->isEnabled() && !f.pathbut->isEnabled());
            f.savebut->click();
            QVERIFY(!f.isVisible());
        }));
        QCOMPARE(s->w->currentsettings().alternateseparatorcharacter, QStringLiteral("|"));
        QVERIFY(!w.findChild<QAction*>(QStringLiteral("viewlogmen"))->isEnabled());

        const QString mylog = native(files_.filepath(QStringLiteral("mylog.txt")));
        QVERIFY(inoptions(w, [&](optionsfrm& f) {
            const QString before = f.pathtxt->text();
            f.keeplogchk->click();
            QVERIFY(f.pathtxt->isEnabled() && f.pathbut->isEnabled());
            s->prompts.expectfile(files_.filepath(QStringLiteral("family.GED")));
            s->prompts.expect(answer::ok, gedcomlogmessage());
            f.pathbut->click();
            s->prompts.expectfile(std::nullopt);
            f.pathbut->click();
            QCOMPARE(f.pathtxt->text(), before);
            s->prompts.expectfile(files_.filepath(QStringLiteral("mylog")));
            f.pathbut->click();
            QCOMPARE(f.pathtxt->text(), mylog);
            f.savebut->click();
            QVERIFY(!f.isVisible());
        }));
        QCOMPARE(s->prompts.unexpected(), 0);
        QVERIFY(QFileInfo::exists(mylog));
        QCOMPARE(s->read("Log Path"), mylog);
        QVERIFY(w.findChild<QAction*>(QStringLiteral("viewlogmen"))->isEnabled());
    }

    // "Default Settings" puts the defaults on the form only; Cancel keeps the
    // settings in use. The title template's example and placeholders; Help.
    void defaultsandtitle()
    {
        settings custom = withpaths();
        custom.certainty = 2;
        custom.title = QStringLiteral("{YEAR}");
        custom.opt1entrydate = false;
        auto s = files_.opened(files_.sample(), &custom);
        QVERIFY(s);
        QVERIFY(inoptions(*s->w, [&](optionsfrm& f) {
            QVERIFY(f.Cancelbut->isEnabled());
            QVERIFY(f.assessmentopt[1]->isChecked());
            QVERIFY(!f.entrydatetodaychk->isEnabled()); // method 1 without the entry date
            f.opt1entrydatechk->click();
            QVERIFY(f.entrydatetodaychk->isEnabled());
            QCOMPARE(f.titleoutputlab->text(), QStringLiteral("1851"));
            f.defaultbut->click();
            QVERIFY(f.Norecordopt->isChecked());
            QCOMPARE(f.titletxt->text(), defaulttitletemplate());

            // A placeholder goes in at the cursor, in place of the selection.
            f.SSTab1->setCurrentIndex(2);
            f.titletxt->setText(QStringLiteral("Census  at"));
            f.titletxt->setCursorPosition(7);
            f.titlerefcom->setFocus();
            QTest::keyClick(f.titlerefcom, Qt::Key_Down); // {YEAR}
            QCOMPARE(f.titletxt->text(), QStringLiteral("Census {YEAR} at"));
            QCOMPARE(f.titlerefcom->currentIndex(), -1);
            QCOMPARE(f.focusWidget(), f.titletxt);
            QCOMPARE(f.titleoutputlab->text(), QStringLiteral("Census 1851 at"));
            f.titletxt->setSelection(14, 2);
            QTest::keyClick(f.titlerefcom, Qt::Key_Down);
            QCOMPARE(f.titletxt->text(), QStringLiteral("Census {YEAR} {YEAR}"));
            f.defaulttitlebut->click();
            QCOMPARE(f.titletxt->text(), defaulttitletemplate());

            f.Command1->click();
            QTest::keyClick(&f, Qt::Key_F1);
            QCOMPARE(s->prompts.helpshown, (QStringList{QStringLiteral("20"), QStringLiteral("20")}));
            f.Cancelbut->click();
            QVERIFY(!f.isVisible());
        }));
        QCOMPARE(s->w->currentsettings().certainty, 2);
        QCOMPARE(s->w->currentsettings().title, QStringLiteral("{YEAR}"));
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    // The dialog on its own: Donate, wrapped captions, every control named,
    // and a size that fits a 1366 x 768 screen.
    void controlsandsize()
    {
        scriptedprompts prompts;
        auto store = settingsstore::onfile(files_.ini());
        int donations = 0;
        optionsfrm f(prompts, *store, withpaths(), [&] { ++donations; });
        f.show();
        QVERIFY(QTest::qWaitForWindowExposed(&f));
        f.donatebut->click();
        QCOMPARE(donations, 1);
        // Clicking a wrapped caption clicks its box.
        QTest::mouseClick(f.findChild<QLabel*>(QStringLiteral("IDonlychklab")), Qt::LeftButton);
        QVERIFY(f.IDonlychk->isChecked());

        for (QWidget* c : f.findChildren<QWidget*>()) {
            if (!qobject_cast<QLineEdit*>(c) && !qobject_cast<QComboBox*>(c) && !qobject_cast<QAbstractButton*>(c))
                continue;
            bool inner = false;
            for (QObject* o = c->parent(); o; o = o->parent())
                inner = inner || qobject_cast<QComboBox*>(o) || o->objectName().startsWith(QLatin1String("qt_"));
            if (inner || c->objectName().startsWith(QLatin1String("qt_")))
                continue;
            QVERIFY2(!c->objectName().isEmpty(), c->metaObject()->className());
            if (!qobject_cast<QAbstractButton*>(c) || static_cast<QAbstractButton*>(c)->text().isEmpty())
                QVERIFY2(!c->accessibleName().isEmpty(), qPrintable(c->objectName()));
        }
        QSize need = f.minimumSizeHint();
        for (int i = 0; i < f.SSTab1->count(); ++i) {
            f.SSTab1->setCurrentIndex(i);
            need = need.expandedTo(f.minimumSizeHint());
        }
        QVERIFY2(need.width() <= 1366 - 16 && need.height() <= 768 - 60,
                 qPrintable(QStringLiteral("%1 x %2").arg(need.width()).arg(need.height())));
        f.reject();
    }
};

QTEST_MAIN(optionsfrm_test)
#include "optionsfrm_test.moc"

// The Census Flags dialog and its two choosers on the offscreen platform: the
// controls, the "Flag Use" question and setting, deletion, the choosers'
// refusals, and one allocation made from the main window's menu. Which dates,
// names and deletions the rules allow: flagalloc_test.
#include "flags/flagdatefrm.h"
#include "flags/flagfrm.h"
#include "flags/flagnamefrm.h"

#include "flags/flagalloc.h"
#include "model/gedcomindex.h"
#include "support/dialogs.h"
#include "support/fixedpitch.h"
#include "support/mainfrmfixture.h"

#include <QAction>
#include <QCheckBox>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

personrec holding(std::initializer_list<int32_t> flags)
{
    personrec p;
    p.flagids = flags;
    return p;
}

// One dialog's surroundings: a family of three, the settings and their store.
struct bench {
    QTemporaryDir dir;
    std::unique_ptr<settingsstore> store = settingsstore::onfile(dir.filePath(QStringLiteral("s.ini")));
    scriptedprompts prompts;
    settings s = defaultsettings();
    gedcomindex ix;

    bench()
    {
        ix.flags = {{"__C1881", "Census 1881", "1881", 2, "UK"},
                    {"__UNUSED", "Unused", "5 APR 1891", 0, "UK"},
                    {"__C1901", "Census 1901", "31 MAR 1901", 1, "Ireland"},
                    {"__OLD", "Old flag", "", 1, ""}};
        ix.people = {holding({0, 2}), holding({0}), holding({3})};
    }
    QString stored(int n, const char* value) const
    {
        return store->read(QStringLiteral("Flags/%1").arg(n), QString::fromLatin1(value)).value_or(QString());
    }
    QString flaguse() const { return store->read(QStringLiteral("Flag Use")).value_or(QStringLiteral("(none)")); }
};

} // namespace

class flagfrmtest : public QObject {
    Q_OBJECT

    windowfiles files_;

private slots:
    // The list in a fixed-pitch font (also run with a proportional "monospace"),
    // the setting stored on a click only, deleting a row, and the definitions
    // written on Escape.
    void controlsandsetting()
    {
        bench b;
        b.s.flaguse = true;
        flagfrm d(b.ix, b.s, *b.store, b.prompts, {});
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        QCOMPARE(rows(&d, "flagslst"), (QStringList{"1881           UK             Census 1881",
                                                    "5 APR 1891     UK             Unused",
                                                    "31 MAR 1901    Ireland        Census 1901"}));
        QVERIFY(linesupcolumns(child<QListWidget>(&d, "flagslst")->font()));
        QVERIFY(!child(&d, "delbut")->isEnabled() && child(&d, "flagcheckbut")->isEnabled());

        auto* flagschk = child<QCheckBox>(&d, "flagschk");
        QVERIFY(flagschk->isChecked() && b.flaguse() == QStringLiteral("(none)"));
        QTest::mouseClick(flagschk, Qt::LeftButton);
        QCOMPARE(b.flaguse(), QStringLiteral("0"));
        QTest::mouseClick(child(&d, "helpbut"), Qt::LeftButton);
        QCOMPARE(b.prompts.helpshown, QStringList{"45"});

        // A flag held by two individuals leaves the list (it keeps its place
        // in the table without a census: flagalloc_test).
        clickitem(child<QListWidget>(&d, "flagslst"), QStringLiteral("1881"));
        QVERIFY(child(&d, "delbut")->isEnabled());
        QTest::mouseClick(child(&d, "delbut"), Qt::LeftButton);
        QCOMPARE(rows(&d, "flagslst").size(), 2);
        QCOMPARE(b.ix.flags.size(), size_t(4));

        QTest::keyClick(&d, Qt::Key_Escape);
        QVERIFY(!d.isVisible());
        QCOMPARE(b.stored(1, "Code") + b.stored(2, "Country"), QStringLiteral("__UNUSEDIreland"));
        QVERIFY(!b.store->groupexists(QStringLiteral("Flags/3")));

        // No individuals: nothing for the flag check to do.
        b.ix.people.clear();
        flagfrm e(b.ix, b.s, *b.store, b.prompts, {});
        QVERIFY(!child(&e, "flagcheckbut")->isEnabled());
        QVERIFY(answered(b.prompts));
    }

    // Allocating with "Flag Use" off asks whether to record flags: No leaves
    // the setting, Yes ticks and stores it; with it on, nothing is asked.
    void allocateasksforflaguse()
    {
        bench b;
        flagfrm d(b.ix, b.s, *b.store, b.prompts, {});
        d.setcensus(QStringLiteral("Canada"), QStringLiteral("4 APR 1881"));
        QCOMPARE(rows(&d, "flagslst").size(), 3); // no name yet: nothing allocated
        b.prompts.expect(answer::no, flaguseprompt());
        d.setflagname(QStringLiteral("Canada 1881"));
        QCOMPARE(rows(&d, "flagslst").back(), QStringLiteral("4 APR 1881     Canada         Canada 1881"));
        QVERIFY(child<QLineEdit>(&d, "datelab")->text().isEmpty());
        QVERIFY(!child<QCheckBox>(&d, "flagschk")->isChecked() && b.flaguse() == QStringLiteral("(none)"));

        // An existing name first, the census second.
        b.prompts.expect(answer::yes, flaguseprompt());
        d.setflagname(QStringLiteral("Old flag"), 3);
        d.setcensus(QStringLiteral("UK"), QStringLiteral("30 MAR 1851"));
        QCOMPARE(b.ix.flags[3].date, "30 MAR 1851");
        QCOMPARE(b.flaguse(), QStringLiteral("1"));

        d.setflagname(QStringLiteral("USA 1900"));
        d.setcensus(QStringLiteral("USA"), QStringLiteral("1900"));
        QCOMPARE(b.prompts.history().size(), size_t(2));
        QVERIFY(answered(b.prompts));
        d.accept();
        QCOMPARE(b.stored(6, "Name"), QStringLiteral("USA 1900"));
    }

    // The country option from the setting, the rows offered, a refused date
    // or year told with the dialog left open, a date or a year chosen.
    void datechooser()
    {
        bench b;
        flagdatefrm d(b.ix.flags, QStringLiteral("Ireland"), b.prompts);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        QVERIFY(child<QRadioButton>(&d, "IrelandOpt")->isChecked());
        QCOMPARE(rows(&d, "datelst"), flagdates(b.ix.flags, QStringLiteral("Ireland")));
        QVERIFY(!child(&d, "datebut")->isEnabled() && !child(&d, "Yearbut")->isEnabled());

        QTest::mouseClick(child(&d, "ukopt"), Qt::LeftButton);
        QCOMPARE(rows(&d, "datelst"), flagdates(b.ix.flags, QStringLiteral("UK")));
        clickitem(child<QListWidget>(&d, "datelst"), QStringLiteral("3 APR 1881"));
        b.prompts.expect(answer::ok, QStringLiteral("with UK 3 APR 1881."));
        QTest::mouseClick(child(&d, "datebut"), Qt::LeftButton);
        b.prompts.expect(answer::ok, QStringLiteral("with UK 1881."));
        QTest::mouseClick(child(&d, "Yearbut"), Qt::LeftButton);
        QVERIFY(d.isVisible() && !d.chosen());

        QTest::mouseClick(child(&d, "CanadaOpt"), Qt::LeftButton);
        clickitem(child<QListWidget>(&d, "datelst"), QStringLiteral("4 APR 1881"));
        QTest::mouseClick(child(&d, "datebut"), Qt::LeftButton);
        QVERIFY(!d.isVisible() && d.chosen());
        QCOMPARE(d.chosen()->country + QLatin1Char(' ') + d.chosen()->date, QStringLiteral("Canada 4 APR 1881"));

        // A year: the year of the census day; any other country setting opens on UK.
        flagdatefrm y(b.ix.flags, QStringLiteral("France"), b.prompts);
        y.show();
        QVERIFY(child<QRadioButton>(&y, "ukopt")->isChecked());
        clickitem(child<QListWidget>(&y, "datelst"), QStringLiteral("7 APR 1861"));
        QTest::mouseClick(child(&y, "Yearbut"), Qt::LeftButton);
        QCOMPARE(y.chosen().value().date, QStringLiteral("1861"));
        QTest::mouseClick(child(&y, "helpbut"), Qt::LeftButton);
        QCOMPARE(b.prompts.helpshown, QStringList{"45"});
        QCOMPARE(b.prompts.history().size(), size_t(2));
        QVERIFY(answered(b.prompts));
    }

    // The two options follow the list and the text box, by mouse and by
    // keyboard; a refused name keeps the dialog open on the text box.
    void namechooser()
    {
        bench b;
        flagnamefrm d(b.ix.flags, b.prompts);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        const QList<QRadioButton*> opt = d.findChildren<QRadioButton*>(QStringLiteral("optflag"));
        QVERIFY(opt.size() == 2 && opt[0]->isChecked());
        QCOMPARE(rows(&d, "flagslst"), QStringList{"Old flag"});
        auto* ok = child(&d, "okbut");
        QVERIFY(!ok->isEnabled());

        // Typing chooses a new name; OK only for a name that is not blank.
        auto* text = child<QLineEdit>(&d, "flagnametxt");
        QTest::keyClicks(text, QStringLiteral("  "));
        QVERIFY(opt[1]->isChecked() && !ok->isEnabled());
        QTest::keyClicks(text, QStringLiteral("o.l.d"));
        QVERIFY(ok->isEnabled());
        b.prompts.expect(answer::ok, QStringLiteral("Name is too similar to an existing flag name."));
        QTest::mouseClick(ok, Qt::LeftButton);
        QVERIFY(d.isVisible() && text->hasFocus());

        clickitem(child<QListWidget>(&d, "flagslst"), QStringLiteral("Old flag"));
        QVERIFY(opt[0]->isChecked() && ok->isEnabled());
        QTest::mouseClick(text, Qt::LeftButton);
        QVERIFY(opt[1]->isChecked());
        // (on the button's indicator: the stretched button reacts only there and on its text)
        QTest::mouseClick(opt[0], Qt::LeftButton, {}, QPoint(6, opt[0]->height() / 2));
        QVERIFY(opt[0]->isChecked() && ok->isEnabled() && child<QListWidget>(&d, "flagslst")->hasFocus());
        QTest::mouseClick(ok, Qt::LeftButton);
        QVERIFY(d.chosen() && d.chosen()->name == QStringLiteral("Old flag"));
        QCOMPARE(d.chosen()->existing, std::optional<size_t>(3));
        QVERIFY(answered(b.prompts));

        // No unallocated flag: only a new name, given back trimmed on Return.
        b.ix.flags.pop_back();
        flagnamefrm n(b.ix.flags, b.prompts);
        n.show();
        QVERIFY(!n.findChildren<QRadioButton*>(QStringLiteral("optflag"))[0]->isEnabled());
        QTest::keyClicks(child<QLineEdit>(&n, "flagnametxt"), QStringLiteral(" Census 1891 "));
        QTest::keyClick(child<QLineEdit>(&n, "flagnametxt"), Qt::Key_Return);
        QVERIFY(n.result() == QDialog::Accepted && n.chosen() && !n.chosen()->existing);
        QCOMPARE(n.chosen()->name, QStringLiteral("Census 1891"));
    }

    // From the main window: a census and a new name chosen through both
    // choosers; the flag check that rewrites the file closes Census Flags, and
    // the main window reads the file again, with the new definition stored.
    void fromthemenu()
    {
        const QString file = files_.sample();
        auto run = files_.opened(file);
        QVERIFY(run);
        const QString name = QStringLiteral("Census 1871");
        bool listed = false, closed = false;
        dialoganswers answers;
        answers.expect(QStringLiteral("flagfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [&, d] {
                QTest::mouseClick(child(d, "Datebut"), Qt::LeftButton);
                QTest::mouseClick(child(d, "flagbut"), Qt::LeftButton);
                listed = rows(d, "flagslst").contains(QStringLiteral("2 APR 1871     UK             ") + name);
                QTest::mouseClick(child(d, "flagcheckbut"), Qt::LeftButton);
                closed = !d->isVisible() && qobject_cast<flagfrm*>(d)->reloadneeded();
            });
        });
        answers.expect(QStringLiteral("flagdatefrm"), [](QDialog* d) {
            QTest::mouseClick(child(d, "ukopt"), Qt::LeftButton);
            clickitem(child<QListWidget>(d, "datelst"), QStringLiteral("2 APR 1871"));
            QTest::mouseClick(child(d, "datebut"), Qt::LeftButton);
        });
        answers.expect(QStringLiteral("flagnamefrm"), [&](QDialog* d) {
            QTest::keyClicks(child<QLineEdit>(d, "flagnametxt"), name);
            QTest::mouseClick(child(d, "okbut"), Qt::LeftButton);
        });
        answers.expect(QStringLiteral("flagcheckfrm"), [](QDialog* d) {
            QVERIFY(child<QListWidget>(d, "addlst")->count() > 0);
            QTest::mouseClick(child(d, "Changebut"), Qt::LeftButton);
        });
        run->prompts.expect(answer::no, flaguseprompt());
        run->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to set/unset flags as suggested?"));
        run->w->findChild<QAction*>(QStringLiteral("flagsmen"))->trigger();
        QVERIFY(answered(answers) && answered(run->prompts));
        QVERIFY(listed && closed && run->w->watching());
        QStringList stored;
        for (const char* key : {"Code", "Name", "Date", "Country"})
            stored << run->store->read(QStringLiteral("Flags/1"), QString::fromLatin1(key)).value_or(QString());
        QCOMPARE(stored, (QStringList{"__CENSUS_1871", name, "2 APR 1871", "UK"}));

        // Written, and read again: the index counts the individuals given it.
        const auto given = static_cast<int>(QByteArray::fromStdString(readfile(file)).count("\r\n2 __CENSUS_1871 Census 1871\r\n"));
        QVERIFY(given > 0);
        const gedcomindex* ix = run->w->index();
        const auto held = std::find_if(ix->flags.begin(), ix->flags.end(),
                                       [](const flagrec& r) { return r.code == "__CENSUS_1871"; });
        QVERIFY(held != ix->flags.end() && held->date == "2 APR 1871" && held->count == given);
    }
};

QTEST_MAIN(flagfrmtest)
#include "flagfrm_test.moc"

// The Census Flags dialog and its two choosers on the offscreen platform: the
// allocation rules as the user meets them, deletion, the "Flag Use" setting,
// the flag check hand-off, and one allocation made from the main window's menu.
#include "flags/flagdatefrm.h"
#include "flags/flagfrm.h"
#include "flags/flagnamefrm.h"

#include "flags/flagalloc.h"
#include "model/gedcomindex.h"
#include "support/fixedpitch.h"
#include "support/mainfrmfixture.h"

#include <QAction>
#include <QCheckBox>
#include <QDir>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

template <class T = QPushButton>
T* child(const QWidget* w, const char* name)
{
    T* c = w->findChild<T*>(QString::fromLatin1(name));
    if (!c)
        qWarning("no control %s", name);
    return c;
}

QStringList rows(const QWidget* w, const char* list = "flagslst")
{
    QStringList out;
    const auto* l = child<QListWidget>(w, list);
    for (int i = 0; i < l->count(); ++i)
        out << l->item(i)->text();
    return out;
}

void clickrow(QListWidget* l, const QString& text)
{
    const QList<QListWidgetItem*> found = l->findItems(text, Qt::MatchExactly);
    QVERIFY2(!found.isEmpty(), qPrintable(text));
    QTest::mouseClick(l->viewport(), Qt::LeftButton, {}, l->visualItemRect(found.front()).center());
}

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
        ix.people.push_back(holding({0, 2}));
        ix.people.push_back(holding({0}));
        ix.people.push_back(holding({3}));
    }
    QString stored(int n, const char* value) const
    {
        return store->read(QStringLiteral("Flags/%1").arg(n), QString::fromLatin1(value)).value_or(QString());
    }
};

} // namespace

class flagfrmtest : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void controlsandsetting()
    {
        bench b;
        b.s.flaguse = true;
        flagfrm d(b.ix, b.s, *b.store, b.prompts, {});
        d.show();
        QCOMPARE(rows(&d), (QStringList{"1881           UK             Census 1881",
                                        "5 APR 1891     UK             Unused",
                                        "31 MAR 1901    Ireland        Census 1901"}));
        QVERIFY(linesupcolumns(child<QListWidget>(&d, "flagslst")->font()));
        QVERIFY(!child(&d, "delbut")->isEnabled());
        QVERIFY(child(&d, "flagcheckbut")->isEnabled());

        // Shown from the setting without storing it; a click stores it at once.
        auto* flagschk = child<QCheckBox>(&d, "flagschk");
        QVERIFY(flagschk->isChecked() && !b.store->read(QStringLiteral("Flag Use")));
        QTest::mouseClick(flagschk, Qt::LeftButton);
        QCOMPARE(b.store->read(QStringLiteral("Flag Use")), QStringLiteral("0"));

        QTest::mouseClick(child(&d, "helpbut"), Qt::LeftButton);
        QCOMPARE(b.prompts.helpshown, QStringList{"45"});

        // Escape closes, and the definitions are written.
        QTest::keyClick(&d, Qt::Key_Escape);
        QVERIFY(!d.isVisible());
        QCOMPARE(b.stored(3, "Country"), QStringLiteral("Ireland"));

        // No individuals: nothing for the flag check to do.
        b.ix.people.clear();
        flagfrm e(b.ix, b.s, *b.store, b.prompts, {});
        QVERIFY(!child(&e, "flagcheckbut")->isEnabled());
        QCOMPARE(b.prompts.unexpected(), 0);
    }

    // Allocating with "Flag Use" off asks whether to record flags: No leaves
    // the setting, Yes ticks and stores it.
    void allocateasksforflaguse()
    {
        bench b;
        flagfrm d(b.ix, b.s, *b.store, b.prompts, {});
        d.setcensus(QStringLiteral("Canada"), QStringLiteral("4 APR 1881"));
        QCOMPARE(rows(&d).size(), 3); // no name yet: nothing allocated

        b.prompts.expect(answer::no, flaguseprompt());
        d.setflagname(QStringLiteral("Canada 1881"));
        QCOMPARE(b.prompts.unexpected(), 0);
        QCOMPARE(rows(&d).back(), QStringLiteral("4 APR 1881     Canada         Canada 1881"));
        QVERIFY(child<QLineEdit>(&d, "datelab")->text().isEmpty());
        QVERIFY(!child<QCheckBox>(&d, "flagschk")->isChecked() && !b.store->read(QStringLiteral("Flag Use")));

        // An existing name first, the census second; Yes this time.
        b.prompts.expect(answer::yes, flaguseprompt());
        d.setflagname(QStringLiteral("Old flag"), 3);
        d.setcensus(QStringLiteral("UK"), QStringLiteral("30 MAR 1851"));
        QCOMPARE(b.ix.flags[3].date, "30 MAR 1851");
        QCOMPARE(b.store->read(QStringLiteral("Flag Use")), QStringLiteral("1"));

        // With "Flag Use" on, no question.
        d.setflagname(QStringLiteral("USA 1900"));
        d.setcensus(QStringLiteral("USA"), QStringLiteral("1900"));
        QCOMPARE(b.prompts.unexpected(), 0);
        QCOMPARE(b.prompts.history().size(), size_t(2));
        d.accept();
        QCOMPARE(b.stored(6, "Name"), QStringLiteral("USA 1900"));
    }

    // A flag held by two individuals loses its census only: it leaves the
    // list, is offered by Census Flag Names, and is not stored on close.
    void deleteheldflag()
    {
        bench b;
        flagfrm d(b.ix, b.s, *b.store, b.prompts, {});
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        auto* list = child<QListWidget>(&d, "flagslst");
        clickrow(list, rows(&d)[0]);
        QVERIFY(child(&d, "delbut")->isEnabled());
        QTest::mouseClick(child(&d, "delbut"), Qt::LeftButton);
        QCOMPARE(rows(&d), (QStringList{"5 APR 1891     UK             Unused",
                                        "31 MAR 1901    Ireland        Census 1901"}));
        QCOMPARE(b.ix.flags.size(), size_t(4));

        flagnamefrm names(b.ix.flags, b.prompts);
        QCOMPARE(rows(&names), (QStringList{"Census 1881", "Old flag"}));

        QTest::mouseClick(child(&d, "okbut"), Qt::LeftButton);
        QCOMPARE(b.stored(1, "Code"), QStringLiteral("__UNUSED"));
        QVERIFY(!b.store->groupexists(QStringLiteral("Flags/3")));
        QCOMPARE(b.prompts.unexpected(), 0);
    }

    // A UK flag for the year 1881 refuses the UK census of 3 APR 1881 but not
    // the Canadian one of 4 APR 1881.
    void datechooser()
    {
        bench b;
        b.s.country = QStringLiteral("Ireland");
        flagdatefrm d(b.ix.flags, b.s.country, b.prompts);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        QVERIFY(child<QRadioButton>(&d, "IrelandOpt")->isChecked());
        QCOMPARE(rows(&d, "datelst"), QStringList{"2 APR 1911"});
        QVERIFY(!child(&d, "datebut")->isEnabled() && !child(&d, "Yearbut")->isEnabled());

        QTest::mouseClick(child<QRadioButton>(&d, "ukopt"), Qt::LeftButton);
        QCOMPARE(rows(&d, "datelst"), flagdates(b.ix.flags, QStringLiteral("UK")));
        clickrow(child<QListWidget>(&d, "datelst"), QStringLiteral("3 APR 1881"));
        b.prompts.expect(answer::ok, QStringLiteral("with UK 3 APR 1881."));
        QTest::mouseClick(child(&d, "datebut"), Qt::LeftButton);
        b.prompts.expect(answer::ok, QStringLiteral("with UK 1881."));
        QTest::mouseClick(child(&d, "Yearbut"), Qt::LeftButton);
        QCOMPARE(b.prompts.unexpected(), 0);
        QVERIFY(d.isVisible() && !d.chosen());

        QTest::mouseClick(child<QRadioButton>(&d, "CanadaOpt"), Qt::LeftButton);
        clickrow(child<QListWidget>(&d, "datelst"), QStringLiteral("4 APR 1881"));
        QTest::mouseClick(child(&d, "datebut"), Qt::LeftButton);
        QVERIFY(!d.isVisible() && d.chosen());
        QCOMPARE(d.chosen()->country + QLatin1Char(' ') + d.chosen()->date, QStringLiteral("Canada 4 APR 1881"));

        // A year: the year of the census day; any other country setting opens on UK.
        flagdatefrm y(b.ix.flags, QStringLiteral("France"), b.prompts);
        y.show();
        QVERIFY(child<QRadioButton>(&y, "ukopt")->isChecked());
        clickrow(child<QListWidget>(&y, "datelst"), QStringLiteral("7 APR 1861"));
        QTest::mouseClick(child(&y, "Yearbut"), Qt::LeftButton);
        QCOMPARE(y.chosen().value().date, QStringLiteral("1861"));
        QCOMPARE(b.prompts.history().size(), size_t(2));
        QTest::mouseClick(child(&y, "helpbut"), Qt::LeftButton);
        QCOMPARE(b.prompts.helpshown, QStringList{"45"});
    }

    void namechooser()
    {
        bench b;
        flagnamefrm d(b.ix.flags, b.prompts);
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));
        const QList<QRadioButton*> opt = d.findChildren<QRadioButton*>(QStringLiteral("optflag"));
        QVERIFY(opt.size() == 2 && opt[0]->isChecked());
        QCOMPARE(rows(&d), QStringList{"Old flag"});
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

        // A row clicked chooses the existing flag again.
        clickrow(child<QListWidget>(&d, "flagslst"), QStringLiteral("Old flag"));
        QVERIFY(opt[0]->isChecked() && ok->isEnabled());
        QTest::mouseClick(text, Qt::LeftButton);
        QVERIFY(opt[1]->isChecked());
        // (on the button's indicator: the stretched button reacts only there and on its text)
        QTest::mouseClick(opt[0], Qt::LeftButton, {}, QPoint(6, opt[0]->height() / 2));
        QVERIFY(opt[0]->isChecked() && ok->isEnabled());
        QVERIFY(child<QListWidget>(&d, "flagslst")->hasFocus());
        QTest::mouseClick(ok, Qt::LeftButton);
        QVERIFY(d.chosen());
        QCOMPARE(d.chosen()->name, QStringLiteral("Old flag"));
        QCOMPARE(d.chosen()->existing, std::optional<size_t>(3));
        QCOMPARE(b.prompts.unexpected(), 0);

        // No unallocated flag: only a new name, given back trimmed.
        b.ix.flags.pop_back();
        flagnamefrm n(b.ix.flags, b.prompts);
        n.show();
        const QList<QRadioButton*> nopt = n.findChildren<QRadioButton*>(QStringLiteral("optflag"));
        QVERIFY(!nopt[0]->isEnabled() && nopt[1]->isChecked());
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
        settings s = defaultsettings();
        QDir().mkpath(files_.filepath(QStringLiteral("backups")));
        s.backupfolder = files_.filepath(QStringLiteral("backups"));
        s.logpath = files_.filepath(QStringLiteral("censuslog.txt"));
        const QString file = files_.sample();
        auto run = files_.opened(file, &s);
        QVERIFY(run);
        const QString name = QStringLiteral("Census 1871");
        bool checked = false, closed = false;
        dialoganswers answers;
        answers.expect(QStringLiteral("flagfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [&, d] {
                QTest::mouseClick(child(d, "Datebut"), Qt::LeftButton);
                QTest::mouseClick(child(d, "flagbut"), Qt::LeftButton);
                checked = rows(d).contains(QStringLiteral("2 APR 1871     UK             ") + name);
                QTest::mouseClick(child(d, "flagcheckbut"), Qt::LeftButton);
                closed = !d->isVisible() && qobject_cast<flagfrm*>(d)->reloadneeded();
            });
        });
        answers.expect(QStringLiteral("flagdatefrm"), [](QDialog* d) {
            QTest::mouseClick(child<QRadioButton>(d, "ukopt"), Qt::LeftButton);
            clickrow(child<QListWidget>(d, "datelst"), QStringLiteral("2 APR 1871"));
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
        QVERIFY(answers.unexpected == 0 && answers.pending() == 0 && run->prompts.unexpected() == 0);
        QVERIFY(checked && closed && run->w->watching());
        QStringList stored;
        for (const char* key : {"Code", "Name", "Date", "Country"})
            stored << run->store->read(QStringLiteral("Flags/1"), QString::fromLatin1(key)).value_or(QString());
        QCOMPARE(stored, (QStringList{"__CENSUS_1871", name, "2 APR 1871", "UK"}));

        QFile f(file);
        QVERIFY(f.open(QIODevice::ReadOnly));
        const int given = static_cast<int>(f.readAll().count("\r\n2 __CENSUS_1871 Census 1871\r\n"));
        QVERIFY(given > 0);
        const gedcomindex* ix = run->w->index();
        const auto held = std::find_if(ix->flags.begin(), ix->flags.end(),
                                       [](const flagrec& r) { return r.code == "__CENSUS_1871"; });
        QVERIFY(held != ix->flags.end() && held->date == "2 APR 1871" && held->country == "UK");
        QCOMPARE(held->count, given);
    }
};

QTEST_MAIN(flagfrmtest)
#include "flagfrm_test.moc"

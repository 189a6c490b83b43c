// End-to-end tests of the main window on the offscreen platform: start-up,
// file opening, recent files, choosing the household and reloading.
#include "app/mainfrm.h"
#include "census/entrypanel_ui.h"
#include "census/householdpanel_ui.h"
#include "model/dates.h"
#include "platform/encoding.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QAbstractButton>
#include <QAction>
#include <QCheckBox>
#include <QDir>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSplitter>
#include <QTest>
#include <QToolButton>

using namespace qm;
using namespace qmtest;

class mainfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    void startfromcommandline()
    {
        const QString file = files_.sample();
        auto s = files_.opened(file);
        QVERIFY(s);
        QCOMPARE(s->w->index()->people.size(), size_t(40));
        QVERIFY(s->w->windowTitle().endsWith(QStringLiteral(" - ") + QFileInfo(file).fileName()));
        QVERIFY(s->w->windowTitle().startsWith(QStringLiteral("Quillmark v")));
        QCOMPARE(s->read("Recent Files  1"), file);
        QCOMPARE(s->read("Gedcom Folder"), files_.path() + QLatin1Char('/'));
        QCOMPARE(s->read("Default File"), QString());
        QCOMPARE(peoplelist(*s->w)->model()->rowCount(), 40);
        QVERIFY(s->w->findChild<QCheckBox*>(QStringLiteral("allpeoplechk"))->isChecked());
        QVERIFY(!s->w->findChild<QCheckBox*>(QStringLiteral("allpeoplechk"))->isEnabled());
        QVERIFY(s->w->watching());
        QVERIFY(!s->w->firststart()); // the fixture writes complete settings
        QCOMPARE(s->prompts.unexpected(), 0);

        // The divider under the source text is named for screen readers.
        QVERIFY(!accessiblename(s->w->panel()->dividerpic->handle(1)).isEmpty());
        // Every control carries its name, and every box and list an accessible name.
        for (QWidget* c : s->w->findChildren<QWidget*>()) {
            if (!qobject_cast<QLineEdit*>(c) && !qobject_cast<QPlainTextEdit*>(c) && !qobject_cast<QComboBox*>(c) &&
                !qobject_cast<QListView*>(c) && !qobject_cast<QAbstractButton*>(c))
                continue;
            bool inner = false; // parts of a combo box
            for (QObject* o = c->parent(); o; o = o->parent())
                inner = inner || qobject_cast<QComboBox*>(o);
            if (inner || c->objectName().startsWith(QLatin1String("qt_")))
                continue; // Qt's own parts
            QVERIFY2(!c->objectName().isEmpty(), c->metaObject()->className());
            if (!qobject_cast<QAbstractButton*>(c) || static_cast<QAbstractButton*>(c)->text().isEmpty())
                QVERIFY2(!c->accessibleName().isEmpty(), qPrintable(c->objectName()));
        }
    }

    void clearallandopenanother()
    {
        auto s = files_.opened(files_.sample());
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1881"));
        w.panel()->locationtxt->setText(QStringLiteral("Hebden Bridge"));
        clickid(w, peoplelist(w), 11);
        QAction* clear = w.findChild<QAction*>(QStringLiteral("clearallmen"));
        s->prompts.expect(answer::no, QStringLiteral("Are you sure you want to clear all of the data"));
        clear->trigger();
        QCOMPARE(w.household().selectioncount, 1);
        QCOMPARE(s->prompts.history().back().m.defaultanswer, answer::no);
        s->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to clear all of the data"));
        clear->trigger();
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(w.panel()->locationtxt->text().isEmpty());
        QVERIFY(w.panel()->fixeddatetxt->text().isEmpty());
        QCOMPARE(w.panel()->yearcom->currentIndex(), -1);
        QCOMPARE(familylist(w)->model()->rowCount(), 0);

        // Opening another file with rows in use asks first.
        chooseyear(w, QStringLiteral("1881"));
        clickid(w, peoplelist(w), 11);
        s->prompts.expect(answer::no, QStringLiteral("Loading another family history file will cause you to lose"));
        w.findChild<QAction*>(QStringLiteral("openmen"))->trigger();
        QCOMPARE(w.household().selectioncount, 1);
        QCOMPARE(s->prompts.unexpected(), 0);
        rowcontrols<QToolButton>(w, "deleterowbut")[0]->click();
    }

    void startfromdefaultfileandfromdialog()
    {
        const QString file = files_.sample();
        const QString settingsfile = files_.ini();
        // One start of the program with the prompts scripted by `script`.
        const auto start = [&](const QStringList& args, const std::function<void(scriptedprompts&)>& script) {
            session s(settingsfile);
            s.make();
            script(s.prompts);
            const bool started = s.w->start(args);
            return QStringList{started ? s.w->gedcomfile() : QString(), s.read("Default File"),
                               QString::number(s.prompts.unexpected())};
        };
        // The file opened, the default file after, and the unexpected prompts.
        const auto opened = [](const QString& f = {}, const QString& d = {}) { return QStringList{f, d, QStringLiteral("0")}; };
        // No default: the Open dialog; Yes makes the file the default.
        QCOMPARE(start({}, [&](scriptedprompts& p) {
                     p.expectfile(file);
                     p.expect(answer::yes, QStringLiteral("Do you want to open this file by default"));
                 }),
                 opened(file, file));
        // The default file opens without a question or dialog (two quotes: no file named).
        QCOMPARE(start({QStringLiteral("\"\"")}, [](scriptedprompts&) {}), opened(file, file));
        // A missing file named on the command line is reported; the default
        // file still opens and stays the default.
        QCOMPARE(start({files_.filepath(QStringLiteral("gone.ged"))},
                       [](scriptedprompts& p) {
                           p.expect(answer::ok, QStringLiteral("The file selected does not exist. Please try again."));
                       }),
                 opened(file, file));
        // A missing default file is dropped silently; cancelling the dialog
        // ends the program.
        QVERIFY(QFile::remove(file));
        QCOMPARE(start({}, [](scriptedprompts& p) { p.expectfile(std::nullopt); }), opened());
    }

    void recentfilesmenu()
    {
        // Paths longer than 40 characters.
        const QString folder = files_.filepath(QStringLiteral("a folder with a rather long name"));
        QVERIFY(QDir().mkpath(folder));
        QStringList files;
        for (const char* n : {"a.ged", "b.ged", "c.ged"}) {
            files << QDir(folder).filePath(QString::fromLatin1(n));
            QVERIFY(QFile::copy(files_.sample(), files.back()));
        }
        const QString a = files[0], b = files[1], c = files[2];
        auto s = files_.opened(a);
        QVERIFY(s);
        QAction* open = s->w->findChild<QAction*>(QStringLiteral("openmen"));
        // "File Open Default" is on: every file opened asks about the default.
        for (const QString& f : {b, c}) {
            s->prompts.expectfile(f);
            s->prompts.expect(answer::no, QStringLiteral("by default"));
            open->trigger();
        }
        QCOMPARE(s->w->recent().paths, (std::array<QString, 4>{c, b, a, QString()}));
        // Re-opening the third moves it to the first slot.
        QAction* third = s->w->findChild<QAction*>(QStringLiteral("RecentFilesmen3"));
        QVERIFY(third->isVisible());
        s->prompts.expect(answer::no, QStringLiteral("by default"));
        third->trigger();
        QCOMPARE(s->w->gedcomfile(), a);
        QCOMPARE(s->w->recent().paths, (std::array<QString, 4>{a, c, b, QString()}));
        QVERIFY(!s->w->findChild<QAction*>(QStringLiteral("RecentFilesmen4"))->isVisible());
        QCOMPARE(s->w->findChild<QAction*>(QStringLiteral("RecentFilesmen1"))->text(), recentfiles{{a}}.caption(0));
        QCOMPARE(s->read("Recent Files  2"), c);

        // A missing recent file can be removed from the list.
        QVERIFY(QFile::remove(c));
        s->prompts.expect(answer::yes, QStringLiteral("Do you want to remove it from the recent files list?"));
        s->w->findChild<QAction*>(QStringLiteral("RecentFilesmen2"))->trigger();
        QCOMPARE(s->prompts.history().back().m.title, QStringLiteral("Open Recent File"));
        QCOMPARE(s->w->recent().paths, (std::array<QString, 4>{a, b, QString(), QString()}));
        QCOMPARE(s->w->gedcomfile(), a);
        QVERIFY(s->w->watching());
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    void chooseyearandindividuals()
    {
        auto s = files_.opened(files_.sample());
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1881"));
        QCOMPARE(w.panel()->fixeddatetxt->text(), QStringLiteral("3 APR 1881"));
        QVERIFY(w.panel()->fixeddatetxt->isEnabled());
        QVERIFY(w.findChild<QCheckBox*>(QStringLiteral("allpeoplechk"))->isEnabled());
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("alllab"))->text(), QStringLiteral("All Individuals:"));

        clickid(w, peoplelist(w), 11); // William Ashworth junior
        QCOMPARE(w.household().selectioncount, 1);
        // A screen reader reads the values shown: name, record ID, information, new source number.
        for (QLabel* value : {rowcontrols<QLabel>(w, "namelab")[0], rowcontrols<QLabel>(w, "idlab")[0],
                              w.findChild<QLabel*>(QStringLiteral("infolab")), w.panel()->sourceidlab}) {
            QVERIFY(!value->text().isEmpty());
            QCOMPARE(accessiblename(value), value->text());
        }
        QVERIFY(w.findChild<QLabel*>(QStringLiteral("immediatefamilylab"))->text().startsWith("Immediate Family of "));
        QVERIFY(w.findChild<QPushButton*>(QStringLiteral("Autosourcebut"))->isEnabled());
        QVERIFY(w.findChild<QLabel*>(QStringLiteral("infolab"))->text().contains(QStringLiteral("in this census would be aged")));
        // Age box: digits only, three at most.
        QLineEdit* age0 = rowcontrols<QLineEdit>(w, "agetxt")[0];
        QCOMPARE(QApplication::focusWidget(), age0);
        QTest::keyClicks(age0, QStringLiteral("3x45 6"));
        QCOMPARE(age0->text(), QStringLiteral("345"));
        age0->setText(QStringLiteral("28"));
        // Unit box: D, M and Y only, upper-cased; a click cycles Y, M, D.
        QLineEdit* unit0 = rowcontrols<QLineEdit>(w, "agetypetxt")[0];
        for (const auto& [key, shown] : {std::pair{"q", "Y"}, {"m", "M"}, {"", "D"}, {"", "Y"}}) {
            if (*key)
                QTest::keyClicks(unit0, QString::fromLatin1(key));
            else
                QTest::mouseClick(unit0, Qt::LeftButton);
            QCOMPARE(unit0->text(), QString::fromLatin1(shown));
        }
        // Empty rows take no typing.
        QLineEdit* age5 = rowcontrols<QLineEdit>(w, "agetxt")[5];
        QTest::keyClicks(age5, QStringLiteral("12"));
        QCOMPARE(age5->text(), QString());

        // The wife, from the immediate family list.
        const int wife = rowofid(w, familylist(w), 27);
        QVERIFY(wife >= 0);
        QVERIFY(static_cast<peoplelistmodel*>(familylist(w)->model())->textat(wife).startsWith(QStringLiteral("WED ")));
        clickrow(familylist(w), wife);
        QCOMPARE(shownnames(w).size(), 2);
        QCOMPARE(w.household().selectioncount, 2);

        // A third choice before the second row has an age is refused.
        s->prompts.expect(answer::ok, QStringLiteral("You must first enter an age for this individual"));
        clickid(w, peoplelist(w), 28);
        QCOMPARE(w.household().selectioncount, 2);
        QCOMPARE(QApplication::focusWidget(), rowcontrols<QLineEdit>(w, "agetxt")[1]);
        QTest::keyClicks(rowcontrols<QLineEdit>(w, "agetxt")[1], QStringLiteral("26"));

        // Choosing the same individual again.
        s->prompts.expect(answer::ok, QStringLiteral("This individual has already been selected"));
        clickid(w, peoplelist(w), 11);
        QCOMPARE(w.household().selectioncount, 2);

        // John Ashworth (I3) already has a census event on 3 APR 1881.
        s->prompts.expect(answer::no, QStringLiteral("This individual already has a census record for 3 APR 1881 at "
                                                     "Hebden Bridge, Yorkshire, England. Are you sure"));
        clickid(w, peoplelist(w), 3);
        QCOMPARE(w.household().selectioncount, 2);
        QCOMPARE(s->prompts.history().back().m.kind, icon::exclamation);
        s->prompts.expect(answer::yes, QStringLiteral("already has a census record"));
        clickid(w, peoplelist(w), 3);
        QCOMPARE(w.household().selectioncount, 3);
        QCOMPARE(rowcontrols<QLabel>(w, "idlab")[2]->text(), QStringLiteral("3"));
        QCOMPARE(s->prompts.unexpected(), 0);

        // Closing with rows in use asks first.
        s->prompts.expect(answer::no, QStringLiteral("You have a partial or full census entry"));
        QVERIFY(!w.close());
        QVERIFY(w.isVisible());
        QCOMPARE(s->prompts.history().back().m.title, QStringLiteral("Leaving Quillmark?"));
        s->prompts.expect(answer::yes, QStringLiteral("You have a partial or full census entry"));
        QVERIFY(w.close());
        QVERIFY(!s->read("Main Width").isEmpty());
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    void elevenrowsscrollinganddeleting()
    {
        // Ireland 1911: nobody in the sample has a census event then.
        settings ireland = defaultsettings();
        ireland.country = QStringLiteral("Ireland");
        auto s = files_.opened(files_.sample(), &ireland);
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1911"));
        QToolButton* up = w.findChild<QToolButton*>(QStringLiteral("upbut"));
        QToolButton* down = w.findChild<QToolButton*>(QStringLiteral("downbut"));
        const auto ages = [&] {
            QStringList out;
            for (QLineEdit* e : rowcontrols<QLineEdit>(w, "agetxt"))
                out << e->text();
            return out.join(QLatin1Char(','));
        };
        for (int i = 0; i < 11; ++i) {
            clickrow(peoplelist(w), i);
            QCOMPARE(w.household().selectioncount, i + 1);
            QTest::keyClicks(qobject_cast<QLineEdit*>(QApplication::focusWidget()), QString::number(i + 1));
        }
        QCOMPARE(s->prompts.unexpected(), 0);
        QCOMPARE(w.household().toprow, 1);
        QVERIFY(up->isVisible());
        QVERIFY(!down->isVisible());
        QCOMPARE(ages(), QStringLiteral("2,3,4,5,6,7,8,9,10,11"));

        up->click();
        QCOMPARE(ages(), QStringLiteral("1,2,3,4,5,6,7,8,9,10"));
        QVERIFY(!up->isVisible());
        QVERIFY(down->isVisible());
        // A census date typed shows the age of the individual chosen last, hidden below.
        const auto info = [&](int i) {
            const int32_t k = w.household().selection[static_cast<size_t>(i)].personindex;
            return personinfo(w.index()->people[static_cast<size_t>(k)], QStringLiteral("2 APR 1911"));
        };
        QVERIFY(info(10) != info(9));
        w.panel()->fixeddatetxt->selectAll();
        QTest::keyClicks(w.panel()->fixeddatetxt, QStringLiteral("2 APR 1911"));
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("infolab"))->text(), info(10));
        // Deleting with a row hidden below pulls it into the last row.
        rowcontrols<QToolButton>(w, "deleterowbut")[0]->click();
        QCOMPARE(ages(), QStringLiteral("2,3,4,5,6,7,8,9,10,11"));
        QCOMPARE(w.household().selectioncount, 10);
        QVERIFY(!down->isVisible());

        // Deleting in the middle with nothing hidden (rows hidden above: the
        // household rows' own tests).
        rowcontrols<QToolButton>(w, "deleterowbut")[1]->click();
        QCOMPARE(ages(), QStringLiteral("2,4,5,6,7,8,9,10,11,"));
        QVERIFY(!rowcontrols<QToolButton>(w, "deleterowbut")[9]->isVisible());

        // Deleting the last row left empties the family list and disables Auto Text.
        while (w.household().selectioncount > 1)
            rowcontrols<QToolButton>(w, "deleterowbut")[0]->click();
        QVERIFY(familylist(w)->model()->rowCount() > 0);
        rowcontrols<QToolButton>(w, "deleterowbut")[0]->click();
        QCOMPARE(w.household().selectioncount, 0);
        QCOMPARE(familylist(w)->model()->rowCount(), 0);
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("immediatefamilylab"))->text(), QStringLiteral("Immediate Family:"));
        QVERIFY(!w.findChild<QPushButton*>(QStringLiteral("Autosourcebut"))->isEnabled());
        QVERIFY(w.findChild<QLabel*>(QStringLiteral("infolab"))->text().isEmpty());
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    void couldbealivelist()
    {
        auto s = files_.opened(files_.sample());
        QVERIFY(s);
        mainfrm& w = *s->w;
        QCheckBox* all = w.findChild<QCheckBox*>(QStringLiteral("allpeoplechk"));
        chooseyear(w, QStringLiteral("1841"));
        all->click(); // unticked: who could be alive in 1841
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("alllab"))->text(), QStringLiteral("Individuals in 1841:"));
        QVERIFY(rowofid(w, peoplelist(w), 1) >= 0);  // born ABT 1808
        QCOMPARE(rowofid(w, peoplelist(w), 28), -1); // born 1879
        const int alive = peoplelist(w)->model()->rowCount();
        QVERIFY(alive > 0 && alive < 40);
        all->click();
        QCOMPARE(peoplelist(w)->model()->rowCount(), 40);

        // Not with a census date that is no date.
        w.panel()->fixeddatetxt->setText(QStringLiteral("someday"));
        s->prompts.expect(answer::ok, QStringLiteral("The current census date is not valid. This must be corrected first."));
        all->click();
        QVERIFY(all->isChecked());
        QCOMPARE(peoplelist(w)->model()->rowCount(), 40);
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    void peoplelistlimit()
    {
        const QString full = files_.generated(32000);
        const QString over = files_.generated(32001);
        if (full.isEmpty() || over.isEmpty())
            QSKIP("the family file generator did not run");
        auto s = files_.opened(full);
        QVERIFY(s);
        QCOMPARE(peoplelist(*s->w)->model()->rowCount(), 32000);
        QVERIFY(s->w->findChild<QPushButton*>(QStringLiteral("findbut"))->isEnabled());

        auto t = files_.opened(over);
        QVERIFY(t);
        mainfrm& w = *t->w;
        QCheckBox* all = w.findChild<QCheckBox*>(QStringLiteral("allpeoplechk"));
        QVERIFY(!peoplelist(w)->isVisible());
        QVERIFY(w.findChild<QLabel*>(QStringLiteral("NopeopleLab"))->isVisible());
        QVERIFY(!w.findChild<QPushButton*>(QStringLiteral("findbut"))->isEnabled());
        QVERIFY(!all->isChecked());
        QVERIFY(!all->isEnabled());

        chooseyear(w, QStringLiteral("1881"));
        QVERIFY(peoplelist(w)->isVisible());
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("alllab"))->text(), QStringLiteral("Individuals in 1881:"));
        const int listed = peoplelist(w)->model()->rowCount();
        QVERIFY(listed > 0 && listed <= 32001);
        const bool toomany = t->prompts.texts().contains(
            QStringLiteral("There are too many people to display them all in the list."));
        QCOMPARE(toomany, listed == 32001);
        QCOMPARE(w.findChild<QPushButton*>(QStringLiteral("findbut"))->isEnabled(), !toomany);
        QVERIFY(!all->isEnabled());
    }

    void reloadafteroutsidechange()
    {
        const QString file = files_.sample();
        auto s = files_.opened(file);
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1881"));
        w.panel()->locationtxt->setText(QStringLiteral("Hebden Bridge"));
        clickid(w, peoplelist(w), 27);
        typerow(w, 0, QStringLiteral("26"));
        clickid(w, peoplelist(w), 29);
        typerow(w, 1, QStringLiteral("1"), QStringLiteral("M"));

        // Coming back without a change does nothing.
        w.checkonactivate();
        QCOMPARE(s->prompts.history().size(), size_t(1)); // the default-file question at start

        // The name changed in the other program: reloaded, rows kept.
        QVERIFY(replaceinfile(file, QStringLiteral("1 NAME Agnes /Schröder/").toUtf8(), "1 NAME Agnes /Schroeder/"));
        s->prompts.expect(answer::ok, QDir::toNativeSeparators(file)
                                          + QStringLiteral(" has been modified by another application and will be reloaded."));
        w.checkonactivate();
        QCOMPARE(shownnames(w), (QStringList{QStringLiteral("Schroeder, Agnes"), QStringLiteral("Ashworth, Frederick")}));
        QCOMPARE(rowcontrols<QLineEdit>(w, "agetxt")[0]->text(), QStringLiteral("26"));
        QCOMPARE(rowcontrols<QLineEdit>(w, "agetypetxt")[1]->text(), QStringLiteral("M"));
        QCOMPARE(w.panel()->locationtxt->text(), QStringLiteral("Hebden Bridge"));
        QCOMPARE(w.panel()->fixeddatetxt->text(), QStringLiteral("3 APR 1881"));
        QVERIFY(w.findChild<QCheckBox*>(QStringLiteral("allpeoplechk"))->isEnabled());
        QVERIFY(familylist(w)->model()->rowCount() > 0);
        QCOMPARE(s->prompts.unexpected(), 0);

        // A chosen individual deleted in the other program: the rows are cleared.
        QVERIFY(editfile(file, [](QByteArray& b) {
            const qsizetype from = b.indexOf("0 @I29@ INDI"), to = b.indexOf("\n0 @", from) + 1;
            return from > 0 && to > from && !b.remove(from, to - from).isEmpty();
        }));
        s->prompts.expect(answer::ok, QStringLiteral("has been modified by another application"));
        s->prompts.expect(answer::ok, QStringLiteral("At least one of the individuals already selected appears to no "
                                                     "longer be in your file following changes made in another "
                                                     "application. Therefore, the selections will be cleared"));
        w.checkonactivate();
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(shownnames(w).isEmpty());
        QCOMPARE(w.index()->people.size(), size_t(39));
        QCOMPARE(s->prompts.unexpected(), 0);

        // The file renamed in the other program: said once, not reloaded.
        QVERIFY(QFile::rename(file, file + QStringLiteral(".old")));
        s->prompts.expect(answer::no, QDir::toNativeSeparators(file) + QStringLiteral(" can no longer be found"));
        w.checkonactivate();
        w.checkonactivate();
        QCOMPARE(w.index()->people.size(), size_t(39));
        QCOMPARE(s->prompts.unexpected(), 0);
        // Back and gone again: another file may be opened instead.
        QVERIFY(QFile::rename(file + QStringLiteral(".old"), file));
        w.checkonactivate();
        QVERIFY(QFile::rename(file, file + QStringLiteral(".old")));
        const QString other = files_.sample();
        s->prompts.expect(answer::yes, QStringLiteral("Do you want to open another family history file?"));
        s->prompts.expectfile(other);
        s->prompts.expect(answer::no, QStringLiteral("by default"));
        w.checkonactivate();
        QCOMPARE(w.gedcomfile(), other);
        QCOMPARE(w.index()->people.size(), size_t(40));
        QCOMPARE(s->prompts.unexpected(), 0);
    }

    // Not a test: scripts/screenshot.sh runs it to picture the main window
    // with a household half entered, at the size it opens on a 1366x768 screen.
    void screenshot()
    {
        const QString out = qEnvironmentVariable("QM_SCREENSHOT");
        if (out.isEmpty())
            QSKIP("QM_SCREENSHOT names no file");
        auto s = files_.opened(files_.sample());
        QVERIFY(s);
        mainfrm& w = *s->w;
        chooseyear(w, QStringLiteral("1881"));
        w.panel()->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        QTest::keyClicks(w.panel()->addresstxt, QStringLiteral("27 Hangingroyd Lane"));
        QTest::keyClicks(w.panel()->referencetxt, QStringLiteral("RG11/4426/52"));
        QTest::keyClicks(w.panel()->othertxt, QStringLiteral("William Ashworth"));
        typehousehold(w, {{11, "28", "Fustian Cutter"}, {27, "26"}, {28, "2"}});
        QTest::keyClicks(w.panel()->texttxt, QStringLiteral("William Ashworth\tHead\tMar\t28\tFustian Cutter"));
        w.panel()->texttxt->setPlainText(w.panel()->texttxt->toPlainText());
        QApplication::processEvents();
        QVERIFY(w.grab().save(out));
        s->prompts.expect(answer::yes);
        w.close();
    }
};

QTEST_MAIN(mainfrm_test)
#include "mainfrm_test.moc"

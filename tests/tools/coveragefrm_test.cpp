// The Census Coverage window: on its own over a hand-made family (cells,
// totals, filters, order, keys, export, a new index), and from the main
// window's Tools menu, from a missing cell to a saved entry that the grid then
// shows recorded.
#include "tools/coveragefrm.h"

#include "model/loadgedcom.h"
#include "support/dialogs.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QAction>
#include <QCheckBox>
#include <QHeaderView>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTableView>

using namespace qm;
using namespace qmtest;

namespace {

QTableView* grid(QWidget* w)
{
    return child<QTableView>(w, "coveragegrid");
}

// The individual shown in each row: its record number.
QList<int32_t> shownids(coveragefrm& d, const gedcomindex& x)
{
    QList<int32_t> out;
    for (const int32_t k : d.model().rows())
        out << x.people[static_cast<size_t>(k)].id;
    return out;
}

int censuscolumn(coveragefrm& d, const QString& year)
{
    for (size_t c = 0; c < d.coverage().columns(); ++c)
        if (d.coverage().year(c) == year)
            return coveragemodel::firstcensuscolumn + static_cast<int>(c);
    return -1;
}

// Makes the cell of record id and census year the current one; its index.
QModelIndex gotocell(coveragefrm& d, const gedcomindex& x, int32_t id, const QString& year)
{
    int32_t k = -1;
    for (size_t j = 0; j < x.people.size(); ++j)
        if (x.people[j].id == id)
            k = static_cast<int32_t>(j);
    const QModelIndex i = d.model().index(d.model().rowof(k), censuscolumn(d, year));
    grid(&d)->setCurrentIndex(i);
    return i;
}

QString celltext(coveragefrm& d, const gedcomindex& x, int32_t id, const QString& year)
{
    return gotocell(d, x, id, year).data().toString();
}

const char* const family = "0 HEAD\r\n1 CHAR UTF-8\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 BIRT\r\n2 DATE 1800\r\n1 DEAT\r\n2 DATE 1866\r\n"
                           "1 FAMS @F1@\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Brown/\r\n1 BIRT\r\n2 DATE 1802\r\n1 DEAT\r\n2 DATE 1858\r\n"
                           "1 CENS\r\n2 DATE 30 MAR 1851\r\n2 PLAC Leeds, Yorkshire, England\r\n1 FAMS @F1@\r\n"
                           "0 @I3@ INDI\r\n1 NAME Tom /Smith/\r\n1 BIRT\r\n2 DATE 1835\r\n1 DEAT\r\n2 DATE 1875\r\n"
                           "1 CENS\r\n2 DATE 2 APR 1871\r\n2 PLAC Toronto, Ontario\r\n1 FAMC @F1@\r\n"
                           "0 @I4@ INDI\r\n1 NAME Zoe /Alone/\r\n"
                           "0 @F1@ FAM\r\n1 HUSB @I1@\r\n1 WIFE @I2@\r\n1 CHIL @I3@\r\n0 TRLR\r\n";

} // namespace

class coveragefrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    // The grid of a small family: its cells and what a screen reader hears,
    // the totals, the filters, the order, Enter on a gap, another country,
    // the export and the family read again.
    void gridfiltersandkeys()
    {
        const auto x = loadgedcombytes(family, flagtable{});
        QVERIFY(x);
        scriptedprompts asker;
        settings s = defaultsettings();
        std::vector<std::pair<int32_t, int>> asked;
        coveragefrm d(*x, s, asker, [&](int32_t k, int year) { asked.emplace_back(k, year); });
        d.show();
        QVERIFY(QTest::qWaitForWindowExposed(&d));

        // In name order: Alone, Brown, Smith John, Smith Tom.
        QCOMPARE(shownids(d, *x), (QList<int32_t>{4, 2, 1, 3}));
        QCOMPARE(child<QLabel>(&d, "countlab")->text(), QStringLiteral("4 of 4 individuals shown"));
        QCOMPARE((QStringList{celltext(d, *x, 1, "1841"), celltext(d, *x, 1, "1871"), celltext(d, *x, 2, "1851"),
                              celltext(d, *x, 3, "1871"), celltext(d, *x, 4, "1881")}),
                 (QStringList{"\u2718 missing", "\u2013 not alive", "\u2714 recorded", "\u2192 elsewhere", "? uncertain"}));
        // Readable without colour, and by a screen reader: the census and the word.
        const QModelIndex gap = gotocell(d, *x, 1, "1841");
        QCOMPARE(gap.data(Qt::AccessibleTextRole).toString(), QStringLiteral("1841: missing"));
        QVERIFY(gap.data(Qt::BackgroundRole).value<QColor>() != gotocell(d, *x, 2, "1851").data(Qt::BackgroundRole).value<QColor>());
        QCOMPARE(d.model().headerData(censuscolumn(d, "1851"), Qt::Horizontal).toString(),
                 QStringLiteral("1851\n1 recorded\n2 missing"));
        QCOMPARE(accessiblename(child<QLabel>(&d, "countlab")), QStringLiteral("4 of 4 individuals shown"));

        // The line under the grid tells the cell; Transcribe only for a gap.
        gotocell(d, *x, 1, "1841");
        QVERIFY(child<QLabel>(&d, "celllab")->text().startsWith(
            QStringLiteral("Smith, John (ID: 1), census of 1841: missing: alive on the census day")));
        QVERIFY(child<QPushButton>(&d, "transcribebut")->isEnabled());
        grid(&d)->setFocus();
        QTest::keyClick(grid(&d), Qt::Key_Return);
        QCOMPARE(asked, (std::vector<std::pair<int32_t, int>>{{0, 1841}}));
        gotocell(d, *x, 2, "1851");
        QVERIFY(!child<QPushButton>(&d, "transcribebut")->isEnabled());
        QTest::keyClick(grid(&d), Qt::Key_Enter);
        const QModelIndex tom = gotocell(d, *x, 3, "1861");
        // A double-click comes after the press of its first click.
        QTest::mouseClick(grid(&d)->viewport(), Qt::LeftButton, {}, grid(&d)->visualRect(tom).center());
        QTest::mouseDClick(grid(&d)->viewport(), Qt::LeftButton, {}, grid(&d)->visualRect(tom).center());
        QCOMPARE(asked, (std::vector<std::pair<int32_t, int>>{{0, 1841}, {2, 1861}}));

        // Gaps only: Zoe, uncertain everywhere, goes.
        QTest::mouseClick(child<QCheckBox>(&d, "gapschk"), Qt::LeftButton);
        QCOMPARE(shownids(d, *x), (QList<int32_t>{2, 1, 3}));
        child<QCheckBox>(&d, "gapschk")->click();
        // A name, as typed: letter case does not matter.
        QTest::keyClicks(child<QLineEdit>(&d, "nametxt"), QStringLiteral("SMITH"));
        QTRY_COMPARE(shownids(d, *x), (QList<int32_t>{1, 3}));
        QCOMPARE(child<QLabel>(&d, "countlab")->text(), QStringLiteral("2 of 4 individuals shown"));
        child<QLineEdit>(&d, "nametxt")->clear();
        QTRY_COMPARE(shownids(d, *x).size(), 4);

        // Relatives of the individual chosen: Tom's ancestors.
        gotocell(d, *x, 3, "1841");
        auto* relatives = child<QComboBox>(&d, "relativescom");
        relatives->setCurrentIndex(relatives->findText(QStringLiteral("Ancestors of")));
        QCOMPARE(shownids(d, *x), (QList<int32_t>{2, 1, 3}));
        QCOMPARE(child<QLabel>(&d, "relativelab")->text(), QStringLiteral("Smith, Tom (ID: 3)"));
        relatives->setCurrentIndex(0);
        QCOMPARE(shownids(d, *x).size(), 4);

        // By birth year, those without one last.
        auto* order = child<QComboBox>(&d, "sortcom");
        order->setCurrentIndex(order->findText(QStringLiteral("Birth year")));
        QCOMPARE(shownids(d, *x), (QList<int32_t>{1, 2, 3, 4}));
        QCOMPARE(d.model().index(0, coveragemodel::borncolumn).data().toString(), QStringLiteral("1800"));

        // Another country: its censuses; a gap there is not for the entry form
        // while the census country in Options is the UK.
        auto* country = child<QComboBox>(&d, "countrycom");
        QCOMPARE(country->currentText(), QStringLiteral("UK"));
        country->setCurrentIndex(country->findText(QStringLiteral("USA")));
        QCOMPARE(d.coverage().country, QStringLiteral("USA"));
        QCOMPARE(d.coverage().year(0), QStringLiteral("1790"));
        asker.expect(answer::ok, QStringLiteral("Census entries are made for the census country chosen in Options (UK)"));
        gotocell(d, *x, 1, "1850");
        QTest::keyClick(grid(&d), Qt::Key_Return);
        QCOMPARE(asked.size(), size_t(2));
        country->setCurrentIndex(0);

        // Export: the rows shown, every census; a folder that is not there is told.
        QTest::keyClicks(child<QLineEdit>(&d, "nametxt"), QStringLiteral("smith"));
        QTRY_COMPARE(shownids(d, *x).size(), 2);
        const QString csv = files_.filepath(QStringLiteral("coverage.csv"));
        asker.expectfile(csv);
        child<QPushButton>(&d, "exportbut")->click();
        QFile written(csv);
        QVERIFY(written.open(QIODevice::ReadOnly));
        QCOMPARE(QString::fromUtf8(written.readAll()).split(u'\n', Qt::SkipEmptyParts), (QStringList{"id,name,1841,1851,1861,1871,1881,1891,1901",
                                              "1,\"Smith, John\",missing,missing,missing,not alive,not alive,not alive,not alive",
                                              "3,\"Smith, Tom\",missing,missing,missing,elsewhere,not alive,not alive,not alive"}));
        asker.expectfile(files_.filepath(QStringLiteral("no such folder/coverage.csv")));
        asker.expect(answer::ok, QStringLiteral("The census coverage could not be written to"));
        child<QPushButton>(&d, "exportbut")->click();

        // The family read again after John's 1841 census was entered: the
        // grid follows, and the cell chosen stays chosen.
        gotocell(d, *x, 1, "1841");
        std::string changed = family;
        const std::string at = "1 FAMS @F1@\r\n0 @I2@";
        changed.replace(changed.find(at), at.size(),
                        "1 FAMS @F1@\r\n1 CENS\r\n2 DATE 6 JUN 1841\r\n2 PLAC Leeds\r\n0 @I2@");
        const auto y = loadgedcombytes(changed, flagtable{});
        d.setindex(*y, s);
        QCOMPARE(grid(&d)->currentIndex().data().toString(), QStringLiteral("\u2714 recorded"));
        QCOMPARE(shownids(d, *y), (QList<int32_t>{1, 3}));
        QCOMPARE(d.model().headerData(censuscolumn(d, "1841"), Qt::Horizontal).toString(),
                 QStringLiteral("1841\n1 recorded\n1 missing"));

        child<QPushButton>(&d, "helpbut")->click();
        QCOMPARE(asker.helpshown, QStringList{QStringLiteral("60")});
        QCOMPARE(asker.unexpected(), 0);
    }

    // The settings are read as they stand: "Residence" turned on in the
    // options makes a residence fact the census entry once the window is
    // active again; the census country decides what can be transcribed.
    void settingsastheystand()
    {
        const auto x = loadgedcombytes("0 HEAD\r\n0 @I1@ INDI\r\n1 NAME Ann /Lee/\r\n1 BIRT\r\n2 DATE 1850\r\n"
                                       "1 RESI\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds, England\r\n0 TRLR\r\n",
                                       flagtable{});
        scriptedprompts asker;
        settings s = defaultsettings();
        int asked = 0;
        coveragefrm d(*x, s, asker, [&](int32_t, int) { ++asked; });
        d.show();
        QCOMPARE(celltext(d, *x, 1, "1881"), QStringLiteral("\u2718 missing"));
        s.residence = true;
        QEvent activated(QEvent::ActivationChange);
        QApplication::sendEvent(&d, &activated);
        QCOMPARE(celltext(d, *x, 1, "1881"), QStringLiteral("\u2714 recorded"));
        s.country = QStringLiteral("Ireland");
        asker.expect(answer::ok, QStringLiteral("census country chosen in Options (Ireland)"));
        gotocell(d, *x, 1, "1891");
        QTest::keyClick(grid(&d), Qt::Key_Return);
        QCOMPARE(asked, 0);
        QCOMPARE(asker.unexpected(), 0);
    }

    // From the Tools menu to a saved entry: Enter on William Ashworth's
    // missing 1881 census gives up the unsaved 1871 household (asked), puts
    // 1881 and William in the form with his family; the entry saved, the grid
    // shows the census recorded.
    void fromagaptoasavedentry()
    {
        settings s = defaultsettings();
        s.requestimage = false;
        auto run = files_.opened(files_.sample(), &s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        chooseyear(w, QStringLiteral("1871"));
        clickid(w, peoplelist(w), 27);
        QCOMPARE(shownnames(w).size(), 1);

        w.menuBar()->findChild<QAction*>(QStringLiteral("coveragemen"))->trigger();
        auto* d = w.findChild<coveragefrm*>();
        QVERIFY(d && d->isVisible());
        const gedcomindex& x = *w.index();
        QCOMPARE(celltext(*d, x, 11, "1881"), QStringLiteral("\u2718 missing"));
        const QString recorded1881 = d->model().headerData(censuscolumn(*d, "1881"), Qt::Horizontal).toString();
        run->prompts.expect(answer::yes, QStringLiteral("The census entry you are making has not been saved"));
        QTest::keyClick(grid(d), Qt::Key_Return);
        QCOMPARE(run->prompts.unexpected(), 0);

        entrypanel* p = w.panel();
        QCOMPARE(p->yearcom->currentText(), QStringLiteral("1881"));
        QCOMPARE(p->fixeddatetxt->text(), QStringLiteral("3 APR 1881"));
        QCOMPARE(shownnames(w), QStringList{QStringLiteral("Ashworth, William")});
        QCOMPARE(w.findChild<QLabel*>(QStringLiteral("immediatefamilylab"))->text(),
                 QStringLiteral("Immediate Family of Ashworth, William:"));
        typerow(w, 0, QStringLiteral("25"));
        p->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        p->referencetxt->setText(QStringLiteral("RG11/4426/52"));
        p->texttxt->setPlainText(QStringLiteral("William Ashworth\tHead"));
        w.findChild<QPushButton*>(QStringLiteral("addbut"))->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(w.household().selectioncount, 0);

        // The grid was given the file read after the save.
        QVERIFY(w.findChild<coveragefrm*>() == d);
        QCOMPARE(celltext(*d, *w.index(), 11, "1881"), QStringLiteral("\u2714 recorded"));
        QVERIFY(d->model().headerData(censuscolumn(*d, "1881"), Qt::Horizontal).toString() != recorded1881);
        // The menu item brings the one window back rather than a second.
        w.menuBar()->findChild<QAction*>(QStringLiteral("coveragemen"))->trigger();
        QCOMPARE(w.findChildren<coveragefrm*>().size(), 1);
        d->close();
        QTRY_VERIFY(!w.findChild<coveragefrm*>());
    }

    // Not a test: scripts/screenshot.sh runs it to picture the grid over the
    // sample file.
    void screenshot()
    {
        const QString out = qEnvironmentVariable("QM_SCREENSHOT_COVERAGE");
        if (out.isEmpty())
            QSKIP("QM_SCREENSHOT_COVERAGE names no file");
        auto run = files_.opened(files_.sample());
        QVERIFY(run);
        mainfrm& w = *run->w;
        w.menuBar()->findChild<QAction*>(QStringLiteral("coveragemen"))->trigger();
        auto* d = w.findChild<coveragefrm*>();
        QVERIFY(d && QTest::qWaitForWindowExposed(d));
        d->resize(1200, 640);
        gotocell(*d, *w.index(), 11, "1881");
        QApplication::processEvents();
        QVERIFY(d->grab().save(out));
        d->close();
    }
};

QTEST_MAIN(coveragefrm_test)
#include "coveragefrm_test.moc"

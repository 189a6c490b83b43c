// The Find Individual dialog: on its own over a small index (what it shows of
// an individual and its relatives, browsing, the searches), and from the main
// window's Find button (OK adds the individual; the immediate family is built
// around it or kept). What is found and listed is findindividual_test's.
#include "tools/findfrm.h"

#include "model/loadgedcom.h"
#include "support/dialogs.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"
#include "tools/findindividual.h"

#include <QCheckBox>
#include <QListWidget>
#include <QPushButton>

using namespace qm;
using namespace qmtest;

namespace {

QString text(QWidget* d, const char* name)
{
    return child<QLineEdit>(d, name)->text();
}

QStringList familytexts(mainfrm& w)
{
    QStringList out;
    auto* m = static_cast<peoplelistmodel*>(familylist(w)->model());
    for (int r = 0; r < m->rowCount(); ++r)
        out << m->textat(r);
    return out;
}

QString familycaption(mainfrm& w)
{
    return w.findChild<QLabel*>(QStringLiteral("immediatefamilylab"))->text();
}

// Ann has a birth and a census; Bob is her parent and her spouse; Cy a child
// of their family.
const char* const family =
    "0 HEAD\r\n1 CHAR UTF-8\r\n"
    "0 @I1@ INDI\r\n1 NAME Ann /Lee/\r\n1 BIRT\r\n2 DATE ABT 1850\r\n2 PLAC Leeds\r\n"
    "1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC York\r\n2 ADDR 4 High St\r\n2 AGE 30y\r\n"
    "1 FAMC @F1@\r\n1 FAMS @F1@\r\n"
    "0 @I2@ INDI\r\n1 NAME Bob /Lee/\r\n1 FAMS @F1@\r\n"
    "0 @I3@ INDI\r\n1 NAME Cy /Lee/\r\n1 FAMC @F1@\r\n0 TRLR\r\n";

} // namespace

class findfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    // The panel of the individual shown, browsing to relatives by mouse and
    // keyboard, the search by record number, Help and Cancel.
    void showsindividual()
    {
        const auto x = loadgedcombytes(family, flagtable{});
        QVERIFY(x);
        scriptedprompts asker;
        findfrm d(*x, findlist(*x, false, {}), -1, asker);
        d.show();
        QCOMPARE(child<QLabel>(&d, "countlab")->text(), QStringLiteral("3 individuals."));
        QCOMPARE(accessiblename(child<QLabel>(&d, "countlab")), QStringLiteral("3 individuals."));
        QVERIFY(!child(&d, "okbut")->isEnabled());
        QVERIFY(!child(&d, "IDfindbut")->isEnabled());

        QTest::keyClicks(child<QLineEdit>(&d, "searchnametxt"), QStringLiteral("lee, a"));
        QCOMPARE((QStringList{text(&d, "nametxt"), text(&d, "idtxt"), text(&d, "dobtxt"), text(&d, "placetxt")}),
                 (QStringList{"Lee, Ann", "1", "ABT 1850", "Leeds"}));
        QCOMPARE(rows(&d, "censuslst"), QStringList{"1881: aged 30 at York (4 High St)"});
        QCOMPARE((QStringList{rows(&d, "parentlst") + rows(&d, "spouselst") + rows(&d, "childrenlst")}),
                 (QStringList{"Lee, Bob", "Lee, Bob", "Lee, Cy"}));
        QVERIFY(child(&d, "okbut")->isEnabled());

        // Browsing to Bob; a search text that matches nothing leaves him shown.
        clickitem(&d, "spouselst", 0);
        QCOMPARE(text(&d, "nametxt"), QStringLiteral("Lee, Bob"));
        QCOMPARE(text(&d, "dobtxt"), QString());
        QCOMPARE(rows(&d, "spouselst"), QStringList{"Lee, Ann"});
        QCOMPARE(rows(&d, "childrenlst"), QStringList{"Lee, Cy"}); // Ann, also a child of F1, is not
        QTest::keyClicks(child<QLineEdit>(&d, "searchnametxt"), QStringLiteral("x"));
        QCOMPARE(text(&d, "nametxt"), QStringLiteral("Lee, Bob"));

        // By keyboard: Enter on a relative browses to it and does not close.
        auto* children = child<QListWidget>(&d, "childrenlst");
        children->setFocus();
        children->setCurrentRow(0);
        QTest::keyClick(children, Qt::Key_Return);
        QCOMPARE(text(&d, "nametxt"), QStringLiteral("Lee, Cy"));
        QVERIFY(d.isVisible());

        // Record numbers: digits only; not found -> message and the button off
        // until the number changes; found -> shown and the box emptied; Enter
        // finds and does not press OK.
        auto* box = child<QLineEdit>(&d, "IDfindtxt");
        auto* but = child(&d, "IDfindbut");
        QTest::keyClicks(box, QStringLiteral("9x9-"));
        QCOMPARE(box->text(), QStringLiteral("99"));
        QVERIFY(but->isEnabled());
        asker.expect(answer::ok, QStringLiteral("No individuals have this ID"));
        QTest::mouseClick(but, Qt::LeftButton);
        QVERIFY(!but->isEnabled());
        QCOMPARE(text(&d, "idtxt"), QStringLiteral("3"));
        box->clear();
        QTest::keyClicks(box, QStringLiteral("2"));
        QVERIFY(but->isEnabled());
        QTest::mouseClick(but, Qt::LeftButton);
        QCOMPARE(text(&d, "nametxt"), QStringLiteral("Lee, Bob"));
        QVERIFY(box->text().isEmpty() && !but->isEnabled());
        QTest::keyClicks(box, QStringLiteral("1"));
        QTest::keyClick(box, Qt::Key_Return);
        QVERIFY(d.isVisible());
        QCOMPARE(text(&d, "nametxt"), QStringLiteral("Lee, Ann"));

        QTest::mouseClick(child(&d, "helpbut"), Qt::LeftButton);
        QCOMPARE(asker.helpshown, QStringList{QStringLiteral("14")});
        QTest::mouseClick(child(&d, "Cancelbut"), Qt::LeftButton);
        QCOMPARE(d.result(), -1);
        QCOMPARE(asker.unexpected(), 0);
    }

    // Name search from the main window with no row yet: OK adds the individual
    // and the family list is built around it. A change made in another
    // program meanwhile is found as Find closes.
    void findbyname()
    {
        const QString file = files_.sample();
        auto run = files_.opened(file);
        QVERIFY(run);
        mainfrm& w = *run->w;
        dialoganswers dialogs;
        dialogs.expect(QStringLiteral("findfrm"), [&](QDialog* d) {
            QVERIFY(!child(d, "okbut")->isEnabled());
            QTest::keyClicks(child<QLineEdit>(d, "searchnametxt"), QStringLiteral("ASHWORTH, JOHN (3"));
            QCOMPARE(text(d, "idtxt"), QStringLiteral("3"));
            QCOMPARE(rows(d, "spouselst"), QStringList{"Kershaw, Ellen"});
            QVERIFY(replaceinfile(file, "1 NAME John /Ashworth/", "1 NAME Johnny /Ashworth/"));
            QTest::mouseClick(child(d, "okbut"), Qt::LeftButton);
        });
        run->prompts.expect(answer::ok,
                            QDir::toNativeSeparators(file) + QStringLiteral(" has been modified by another application"));
        QTest::mouseClick(child(&w, "findbut"), Qt::LeftButton);
        QCOMPARE(dialogs.seen, QStringList{QStringLiteral("findfrm")});
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(shownnames(w), QStringList{QStringLiteral("Ashworth, Johnny")});
        QCOMPARE(familycaption(w), QStringLiteral("Immediate Family of Ashworth, Johnny:"));
        QVERIFY(w.watching());
        QCOMPARE(run->prompts.unexpected(), 0);
    }

    // Opening on the last row's individual keeps OK off until the user shows
    // one; browsing to a parent and OK with "Refocus Immediate Family" rebuilds
    // the family list around the parent.
    void browseandrefocus()
    {
        auto run = files_.opened(files_.sample());
        QVERIFY(run);
        mainfrm& w = *run->w;
        clickid(w, peoplelist(w), 3);
        typerow(w, 0, QStringLiteral("20"));
        const QStringList johns = familytexts(w);

        dialoganswers dialogs;
        dialogs.expect(QStringLiteral("findfrm"), [](QDialog* d) {
            QCOMPARE(text(d, "idtxt"), QStringLiteral("3"));
            QVERIFY(!child(d, "okbut")->isEnabled());
            clickitem(d, "parentlst", 0);
            QCOMPARE(text(d, "idtxt"), QStringLiteral("1"));
            QVERIFY(child(d, "okbut")->isEnabled());
            QCOMPARE(child<QListView>(d, "peoplelst")->currentIndex().data().toString(),
                     QStringLiteral("Ashworth, William (ABT 1808)"));
            child<QCheckBox>(d, "refocuschk")->setChecked(true);
            QTest::mouseClick(child(d, "okbut"), Qt::LeftButton);
        });
        QTest::mouseClick(child(&w, "findbut"), Qt::LeftButton);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(shownnames(w), (QStringList{"Ashworth, John", "Ashworth, William"}));
        QCOMPARE(familycaption(w), QStringLiteral("Immediate Family of Ashworth, William:"));
        QVERIFY(familytexts(w).contains(QStringLiteral("CHI Ashworth, John (3 JAN 1831)")));
        QVERIFY(familytexts(w) != johns);

        // Without the tick the family list stays William's; a click on the
        // pre-selected entry itself is the user's own choice.
        typerow(w, 1, QStringLiteral("53"));
        dialogs.expect(QStringLiteral("findfrm"), [](QDialog* d) {
            auto* list = child<QListView>(d, "peoplelst");
            QCOMPARE(text(d, "idtxt"), QStringLiteral("1"));
            QVERIFY(!child(d, "okbut")->isEnabled());
            clickrow(list, list->currentIndex().row());
            QCOMPARE(text(d, "idtxt"), QStringLiteral("1"));
            QVERIFY(child(d, "okbut")->isEnabled());
            auto* search = child<QLineEdit>(d, "searchnametxt");
            QTest::keyClicks(search, QStringLiteral("greenwood"));
            QTest::keyClick(search, Qt::Key_Return);
        });
        QTest::mouseClick(child(&w, "findbut"), Qt::LeftButton);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(shownnames(w).last(), QStringLiteral("Greenwood, Hannah"));
        QCOMPARE(familycaption(w), QStringLiteral("Immediate Family of Ashworth, William:"));
        QCOMPARE(run->prompts.unexpected(), 0);
    }
};

QTEST_MAIN(findfrm_test)
#include "findfrm_test.moc"

// The household check's dialog: on its own with findings, and end to end
// through the main window, where "Go back" returns to the row and "Save
// anyway" saves.
#include "census/householdcheckfrm.h"

#include "support/dialogs.h"
#include "support/mainfrmfixture.h"

#include <QPlainTextEdit>
#include <QPushButton>
#include <QTreeWidget>

using namespace qm;
using namespace qmtest;

namespace {

householdfinding finding(int row, findingkind kind, const char* message)
{
    return {row, kind, kind == findingkind::unrelated ? findingseverity::information : findingseverity::warning,
            QString::fromUtf8(message)};
}

} // namespace

class householdcheckfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    void findingsandbuttons()
    {
        const std::vector<householdfinding> found = {
            finding(0, findingkind::age, "Smith, John (ID: 1) is entered as aged 54, but ..."),
            finding(3, findingkind::unrelated, "Pratt, Lodger (ID: 6) is not related ..."),
        };
        {
            householdcheckfrm d(found);
            auto* list = d.findChild<QTreeWidget*>(QStringLiteral("findingslst"));
            QVERIFY(list);
            QCOMPARE(list->accessibleName(), QStringLiteral("Findings"));
            QCOMPARE(list->topLevelItemCount(), 2);
            QCOMPARE(list->topLevelItem(1)->text(0), QStringLiteral("4"));
            QCOMPARE(list->topLevelItem(1)->text(1), QStringLiteral("Note"));
            QCOMPARE(list->topLevelItem(0)->text(1), QStringLiteral("Warning"));
            QCOMPARE(list->topLevelItem(0)->text(2), found[0].message);
            QVERIFY(child<QPushButton>(&d, "backbut")->isDefault());
            QCOMPARE(d.chosenrow(), 0);
            list->setCurrentItem(list->topLevelItem(1));
            QCOMPARE(d.chosenrow(), 3);
        }
        // Save anyway, Go back on the second finding, Escape.
        const auto run = [&](const std::function<void(QDialog*)>& act) {
            dialoganswers answers;
            answers.expect(QStringLiteral("householdcheckfrm"), act);
            const std::optional<int> back = householdcheckfrm::ask(found, nullptr);
            if (answers.unexpected != 0 || answers.pending() != 0)
                return std::optional<int>(-99);
            return back;
        };
        QCOMPARE(run([](QDialog* d) { child(d, "savebut")->click(); }), std::optional<int>());
        QCOMPARE(run([](QDialog* d) {
                     auto* list = d->findChild<QTreeWidget*>();
                     QTest::keyClick(list, Qt::Key_Down);
                     child(d, "backbut")->click();
                 }),
                 std::optional<int>(3));
        QCOMPARE(run([](QDialog* d) { QTest::keyClick(d, Qt::Key_Escape); }), std::optional<int>(0));
        QCOMPARE(householdcheckfrm::ask({}, nullptr), std::optional<int>());
    }

    // William Ashworth (born MAR 1856) typed as 52 in the 1881 census.
    void endtoend()
    {
        const QString file = files_.sample();
        const std::string before = readfile(file);
        settings s = defaultsettings();
        s.requestimage = false;
        s.birthdate = false;
        auto run = files_.opened(file, &s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        chooseyear(w, QStringLiteral("1881"));
        w.panel()->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        w.panel()->referencetxt->setText(QStringLiteral("RG11/4426/52"));
        typehousehold(w, {{11, "52"}, {27, "23"}, {28, "2"}});
        w.panel()->texttxt->setPlainText(QStringLiteral("William Ashworth Head"));
        w.panel()->texttxt->setFocus();

        {
            dialoganswers answers;
            QString shown;
            answers.expect(QStringLiteral("householdcheckfrm"), [&](QDialog* d) {
                auto* list = d->findChild<QTreeWidget*>(QStringLiteral("findingslst"));
                shown = list->topLevelItem(0)->text(0) + u' ' + list->topLevelItem(0)->text(2);
                child(d, "backbut")->click();
            });
            QPushButton* save = w.findChild<QPushButton*>(QStringLiteral("addbut"));
            save->click();
            QCOMPARE(answers.unexpected, 0);
            QCOMPARE(answers.pending(), 0);
            QVERIFY2(shown.startsWith(QStringLiteral("1 Ashworth, William (ID: 11) is entered as aged 52")),
                     qPrintable(shown));
            QCOMPARE(readfile(file), before);
            QCOMPARE(w.focusWidget(), rowcontrols<QLineEdit>(w, "agetxt")[0]);
            QCOMPARE(w.household().selectioncount, 3);
        }
        {
            dialoganswers answers;
            answers.expect(QStringLiteral("householdcheckfrm"), [](QDialog* d) { child(d, "savebut")->click(); });
            w.findChild<QPushButton*>(QStringLiteral("addbut"))->click();
            QCOMPARE(answers.unexpected, 0);
            QVERIFY(readfile(file) != before);
            QVERIFY(readfile(file).find("2 AGE 52y\r\n") != std::string::npos);
            QCOMPARE(w.household().selectioncount, 0);
        }
        QCOMPARE(run->prompts.unexpected(), 0);
    }
};

QTEST_MAIN(householdcheckfrm_test)
#include "householdcheckfrm_test.moc"

// End-to-end tests of saving a census entry from the main window on the
// offscreen platform: the whole form typed and saved with each recording
// method and checked in the rewritten file and the census log, a file changed
// by another program while the entry was typed, the save's checks in their
// order, birth details, the milestone, Auto Text, the source text editor and
// the divider. What the rewrite writes line by line is the golden files'
// business (tests/writer); here, that the form hands it what was typed.
#include "app/mainfrm.h"
#include "census/entrypanel_ui.h"
#include "platform/clock.h"
#include "support/mainfrmfixture.h"
#include "writer/saveroad.h"

#include <QAction>
#include <QDir>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSplitter>
#include <QSplitterHandle>
#include <QToolButton>

#include <algorithm>
#include <cmath>
#include <vector>

using namespace qm;
using namespace qmtest;

namespace {

QStringList filelines(const QString& path)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return {};
    QString text = QString::fromUtf8(f.readAll());
    if (text.endsWith(QLatin1String("\r\n")))
        text.chop(2);
    return text.split(QStringLiteral("\r\n"));
}

// A copy of the file as it is now, to compare the rewrite with.
QString snapshot(const QString& path)
{
    QFile::remove(path + QStringLiteral(".before"));
    QFile::copy(path, path + QStringLiteral(".before"));
    return path + QStringLiteral(".before");
}

// The records the rewrite changed or added, in file order: "@ " and the
// record's level-0 line, then its lines removed ("-") and added ("+"), as the
// longest common run of the record's old and new lines leaves them.
QStringList changes(const QString& before, const QString& after)
{
    const auto records = [](const QString& path) {
        std::vector<QStringList> out;
        for (const QString& line : filelines(path)) {
            if (out.empty() || line.startsWith(QLatin1String("0 ")))
                out.emplace_back();
            out.back() << line;
        }
        return out;
    };
    const std::vector<QStringList> old = records(before);
    QStringList out;
    for (const QStringList& now : records(after)) {
        const auto was = std::find_if(old.begin(), old.end(), [&](const QStringList& r) { return r[0] == now[0]; });
        const QStringList a = was == old.end() ? QStringList() : *was;
        if (a == now)
            continue;
        const auto n = size_t(a.size()), m = size_t(now.size());
        std::vector<std::vector<int>> common(n + 1, std::vector<int>(m + 1));
        for (size_t i = n; i-- > 0;)
            for (size_t j = m; j-- > 0;)
                common[i][j] = a[i] == now[j] ? common[i + 1][j + 1] + 1 : std::max(common[i + 1][j], common[i][j + 1]);
        out << QStringLiteral("@ ") + now[0];
        for (size_t i = 0, j = 0; i < n || j < m;) {
            if (i < n && j < m && a[i] == now[j])
                ++i, ++j;
            else if (j == m || (i < n && common[i + 1][j] >= common[i][j + 1]))
                out << QLatin1Char('-') + a[i++];
            else
                out << QLatin1Char('+') + now[j++];
        }
    }
    return out;
}

// The sample's John Ashworth (I28) made to have no birth event.
bool withoutjohnsbirth(const QString& file)
{
    return replaceinfile(file, "1 NAME John /Ashworth/\r\n1 SEX M\r\n1 BIRT\r\n2 DATE 1879\r\n2 PLAC Hebden Bridge, "
                               "Yorkshire, England\r\n",
                         "1 NAME John /Ashworth/\r\n1 SEX M\r\n");
}

QPushButton* button(mainfrm& w, const char* name)
{
    return w.findChild<QPushButton*>(QString::fromLatin1(name));
}

// Clicks Save expecting exactly this message, answered with a.
void savewith(session& run, answer a, const QString& message)
{
    run.prompts.expect(a, message);
    button(*run.w, "addbut")->click();
    QCOMPARE(run.prompts.unexpected(), 0);
    QCOMPARE(run.prompts.history().back().m.text, message);
}

const QString hebdenbridge = QStringLiteral("Hebden Bridge, Yorkshire, England");

} // namespace

class saveentryfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;
    int runs_ = 0;

    // Settings of one run: backups and the log in a folder of their own. The
    // Census Images dialog and the household check are tested on their own
    // (imagesfrm_test, householdcheckfrm_test).
    settings testsettings()
    {
        settings s = defaultsettings();
        const QString folder = files_.filepath(QStringLiteral("run%1").arg(++runs_));
        QDir().mkpath(folder + QStringLiteral("/backups"));
        s.backupfolder = folder + QStringLiteral("/backups");
        s.logpath = folder + QStringLiteral("/censuslog.txt");
        s.requestimage = false;
        s.householdcheck = false;
        return s;
    }

    std::unique_ptr<session> opened(const QString& file, const settings& s) { return files_.opened(file, &s); }

    static QStringList backups(const settings& s) { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }

private slots:
    void initTestCase()
    {
        QVERIFY(files_.valid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    }
    void cleanupTestCase() { setclockfortests(QDateTime()); }

    // Method 1: the 1881 household of William and Agnes Ashworth with a new
    // census source, typed as a user would. Agnes renamed by another program
    // before Save: nothing is written, the file is read again and the entry
    // stays to be saved at the second try. Count was 9: the milestone follows.
    void fullentry()
    {
        const QString file = files_.sample();
        settings s = testsettings();
        s.count = 9;
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        QCOMPARE(p->objectName(), QStringLiteral("entrypanel0"));
        QCOMPARE(p->sourceidlab->text(), QStringLiteral("12"));

        chooseyear(w, QStringLiteral("1881"));
        QCOMPARE(QApplication::focusWidget(), p->locationtxt);
        // Place completion offers the known place; typing its letters walks
        // through the offer.
        QTest::keyClicks(p->locationtxt, QStringLiteral("Hebden Bridge"));
        QCOMPARE(p->locationtxt->text(), hebdenbridge);
        QCOMPARE(p->locationtxt->selectedText(), QStringLiteral(", Yorkshire, England"));
        QTest::keyClick(p->locationtxt, Qt::Key_End);
        QTest::keyClicks(p->addresstxt, QStringLiteral("27 Hangingroyd Lane"));
        QTest::keyClicks(p->referencetxt, QStringLiteral("RG11/4426/52"));
        QTest::keyClicks(p->othertxt, QStringLiteral("William Ashworth"));
        const QString title = QStringLiteral("Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52 (William Ashworth)");
        QCOMPARE(p->titletxt->text(), title);

        clickid(w, peoplelist(w), 11);
        typerow(w, 0, QStringLiteral("28"), QString(), QStringLiteral("Fustian Cutter"));
        for (const auto& [row, id, age, unit] : {std::tuple{1, 27, "26", ""}, {2, 28, "2", ""}, {3, 29, "1", "M"}}) {
            clickid(w, familylist(w), id);
            typerow(w, row, QString::fromLatin1(age), QString::fromLatin1(unit));
        }
        p->texttxt->setFocus();
        typetext(p->texttxt, QStringLiteral("William Ashworth\tHead\nAgnes Ashworth\tWife"));
        QCOMPARE(QApplication::focusWidget(), p->texttxt);
        p->notetxt->setPlainText(QStringLiteral("Enumerator's district 5"));

        QVERIFY(replaceinfile(file, QStringLiteral("1 NAME Agnes /Schröder/").toUtf8(), "1 NAME Agnes /Schroeder/"));
        const QString before = snapshot(file);
        savewith(*run, answer::ok, QDir::toNativeSeparators(file)
                                       + QStringLiteral(" has been modified by another application and will be reloaded."));
        QVERIFY(changes(before, file).isEmpty());
        QVERIFY(backups(s).isEmpty());
        QCOMPARE(run->read("Count"), QStringLiteral("9"));
        QCOMPARE(shownnames(w), (QStringList{QStringLiteral("Ashworth, William"), QStringLiteral("Schroeder, Agnes"),
                                             QStringLiteral("Ashworth, John"), QStringLiteral("Ashworth, Frederick")}));
        QCOMPARE(p->titletxt->text(), title);
        QCOMPARE(p->texttxt->toPlainText(), QStringLiteral("William Ashworth\tHead\nAgnes Ashworth\tWife"));
        QVERIFY(w.watching());

        dialoganswers dialogs;
        QString milestone;
        dialogs.expect(QStringLiteral("donatefrm"), [&](QDialog* d) {
            milestone = d->windowTitle() + QLatin1Char('|') + d->findChild<QLabel*>(QStringLiteral("mainlab"))->text();
            d->findChild<QPushButton*>(QStringLiteral("closebut"))->click();
        });
        button(w, "addbut")->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().size(), size_t(2)); // the default-file question, the outside change
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(milestone, QStringLiteral("Milestone|For your information you have now used Quillmark to create at "
                                           "least 10 census entries."));

        const auto person = [](int id, const char* age, const char* time, const QStringList& occupation = {}) {
            return QStringList{QStringLiteral("@ 0 @I%1@ INDI").arg(id), QStringLiteral("+1 CENS"),
                               QStringLiteral("+2 DATE 3 APR 1881"), QStringLiteral("+2 PLAC ") + hebdenbridge,
                               QStringLiteral("+2 ADDR 27 Hangingroyd Lane"), QStringLiteral("+2 AGE %1").arg(age),
                               QStringLiteral("+2 SOUR @S12@")}
                + occupation
                + QStringList{QStringLiteral("-2 DATE 11 NOV 2023"), QStringLiteral("-3 TIME %1").arg(time),
                              QStringLiteral("+2 DATE 04 DEC 2026"), QStringLiteral("+3 TIME 13:05:09")};
        };
        QCOMPARE(changes(before, file),
                 (person(11, "28y", "20:31:58",
                        {QStringLiteral("+1 OCCU Fustian Cutter"), QStringLiteral("+2 DATE 3 APR 1881"),
                         QStringLiteral("+2 PLAC ") + hebdenbridge, QStringLiteral("+2 SOUR @S12@")})
                     + person(27, "26y", "20:33:12") + person(28, "2y", "20:34:01") + person(29, "1m", "20:35:26")
                     + QStringList{QStringLiteral("@ 0 @S12@ SOUR"), QStringLiteral("+0 @S12@ SOUR"),
                                   QStringLiteral("+1 TITL ") + title, QStringLiteral("+1 _TYPE Census"),
                                   QStringLiteral("+1 TEXT William Ashworth\tHead"),
                                   QStringLiteral("+2 CONT Agnes Ashworth\tWife"),
                                   QStringLiteral("+1 NOTE Enumerator's district 5"), QStringLiteral("+1 CHAN"),
                                   QStringLiteral("+2 DATE 04 DEC 2026"), QStringLiteral("+3 TIME 13:05:09")}));
        QCOMPARE(filelines(s.logpath).join(QLatin1Char('\n')), QString(78, u'=') + QString::fromUtf8(R"x(
Census entry added: 2026-12-04 13:05:09
To Gedcom File: %1
Source created: %2 (ID: 12)

Individual records changed (linked to source above): 
Name: Ashworth, William (11) : created census event and occupation attribute (Fustian Cutter)
Name: Schroeder, Agnes (27) : created census event
Name: Ashworth, John (28) : created census event
Name: Ashworth, Frederick (29) : created census event)x").arg(QDir::toNativeSeparators(file), title));

        // The form is cleared for the next entry and the file read again.
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(p->locationtxt->text().isEmpty());
        QVERIFY(p->texttxt->toPlainText().isEmpty());
        QCOMPARE(p->yearcom->currentIndex(), -1);
        QCOMPARE(p->sourceidlab->text(), QStringLiteral("13"));
        QCOMPARE(w.focusWidget(), p->yearcom); // the window's, once the milestone has closed
        QCOMPARE(run->read("Count"), QStringLiteral("10"));
        QCOMPARE(backups(s).size(), 1);
        QVERIFY(w.watching());
    }

    // Method 2: the entry cites an existing census source. Where within it
    // and the source are asked for first; choosing the source names its
    // number and chooses the year of its title. Count 1 is no milestone.
    void existingsource()
    {
        const QString file = files_.sample();
        settings s = testsettings();
        s.fullentry = false;
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        QCOMPARE(p->objectName(), QStringLiteral("entrypanel1"));
        QVERIFY(p->sourceidlab->text().isEmpty());
        chooseyear(w, QStringLiteral("1901"));
        typehousehold(w, {{11, "28"}, {27, "26", "Weaver"}});
        p->texttxt->setPlainText(QStringLiteral("William Ashworth\tHead\nAgnes Ashworth\tWife"));
        p->locationtxt->setText(QStringLiteral("Leeds"));
        p->wherewithinsourcetxt->setText(QStringLiteral("ab  "));
        savewith(*run, answer::ok, QStringLiteral("You must enter the text for the 'Where within Source' entry"));
        QCOMPARE(QApplication::focusWidget(), p->wherewithinsourcetxt);
        p->wherewithinsourcetxt->setText(QStringLiteral(" RG11/4426/88 p 23 "));
        savewith(*run, answer::ok, QStringLiteral("You must select a source from the drop-down list"));
        QVERIFY(backups(s).isEmpty());

        const int item = p->sourcecom->findText(QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth)"));
        QVERIFY(item >= 0);
        p->sourcecom->setCurrentIndex(item);
        QCOMPARE(p->sourceidlab->text(), QStringLiteral("7"));
        QCOMPARE(p->yearcom->currentText(), QStringLiteral("1881"));
        QCOMPARE(p->fixeddatetxt->text(), QStringLiteral("3 APR 1881"));
        QCOMPARE(QApplication::focusWidget(), p->locationtxt);
        p->locationtxt->setText(hebdenbridge);
        p->addresstxt->setText(QStringLiteral("27 Hangingroyd Lane"));
        const QString before = snapshot(file);
        dialoganswers dialogs;
        w.findChild<QAction*>(QStringLiteral("savemen"))->trigger();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(dialogs.seen, QStringList());

        // The census events cite source 7 where the entry is within it, with
        // the census day and the source text; the source itself is unchanged.
        const auto person = [](int id, const char* age, const char* time, const QStringList& occupation) {
            const QStringList cited{QStringLiteral("+2 SOUR @S7@"), QStringLiteral("+3 PAGE RG11/4426/88 p 23"),
                                    QStringLiteral("+3 DATA"), QStringLiteral("+4 DATE 3 APR 1881")};
            return QStringList{QStringLiteral("@ 0 @I%1@ INDI").arg(id), QStringLiteral("+1 CENS"),
                               QStringLiteral("+2 DATE 3 APR 1881"), QStringLiteral("+2 PLAC ") + hebdenbridge,
                               QStringLiteral("+2 ADDR 27 Hangingroyd Lane"), QStringLiteral("+2 AGE %1").arg(age)}
                + cited
                + QStringList{QStringLiteral("+4 TEXT William Ashworth\tHead"), QStringLiteral("+5 CONT Agnes Ashworth\tWife")}
                + occupation + (occupation.isEmpty() ? QStringList() : cited)
                + QStringList{QStringLiteral("-2 DATE 11 NOV 2023"), QStringLiteral("-3 TIME %1").arg(time),
                              QStringLiteral("+2 DATE 04 DEC 2026"), QStringLiteral("+3 TIME 13:05:09")};
        };
        QCOMPARE(changes(before, file),
                 (person(11, "28y", "20:31:58", {})
                     + person(27, "26y", "20:33:12",
                              {QStringLiteral("+1 OCCU Weaver"), QStringLiteral("+2 DATE 3 APR 1881"),
                               QStringLiteral("+2 PLAC ") + hebdenbridge})));
        const QStringList log = filelines(s.logpath);
        QVERIFY(log.contains(QStringLiteral("Source referred to: Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth) (ID: 7)")));
        QVERIFY(log.contains(QStringLiteral("Where within source: RG11/4426/88 p 23")));
        QCOMPARE(run->read("Count"), QStringLiteral("1"));
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(p->sourceidlab->text().isEmpty());
        QCOMPARE(p->sourcecom->currentIndex(), -1);
    }

    // The save's checks, each in its turn, with nothing written: what is left
    // out, the message, and where the focus goes. Then a rewrite that fails:
    // the message, the family file as it was, and the program ends. John
    // (I28) has no birth event, but with "Birthdate" off he is not asked about.
    void checksintheirorderthenafailedrewrite()
    {
        const QString file = files_.sample();
        QVERIFY(withoutjohnsbirth(file));
        const std::string bytes = readfile(file);
        settings s = testsettings();
        s.birthdate = false;
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        const QString invaliddate = QStringLiteral("Invalid date - reselect the year from the list box above to reset to "
                                                   "original value");
        const struct {
            std::function<void()> before;
            QString message;
            QWidget* focus;
            answer reply = answer::ok;
        } steps[] = {
            {[] {}, QStringLiteral("The census entry must refer to at least 1 person!"), nullptr},
            {[&] { chooseyear(w, QStringLiteral("1881")), clickid(w, peoplelist(w), 28); },
             QStringLiteral("You must first enter an age for this individual"), nullptr},
            {[&] { typerow(w, 0, QStringLiteral("2")); }, QStringLiteral("Location must be specified"), p->locationtxt},
            {[&] {
                 p->locationtxt->setText(QStringLiteral("  Leeds "));
                 p->titletxt->setText(QStringLiteral(" Census 1881 ")); // 11 characters once trimmed
             },
             QStringLiteral("You must provide a full title for the entry"), p->titletxt},
            {[&] { p->titletxt->setText(QStringLiteral("Census 1881L")), p->yearcom->setCurrentIndex(-1); },
             QStringLiteral("You must select a census year from the list"), nullptr},
            {[&] { chooseyear(w, QStringLiteral("1881")), p->fixeddatetxt->setText(QStringLiteral("31 FEB 1881")); },
             invaliddate, p->fixeddatetxt},
            {[&] { p->fixeddatetxt->setText(QString()); }, invaliddate, p->fixeddatetxt}, // no date is no date either
            {[&] {
                 // A date typed is checked and written the GEDCOM way on leaving the box.
                 p->fixeddatetxt->setFocus();
                 QTest::keyClicks(p->fixeddatetxt, QStringLiteral("4 apr 1881"));
                 p->addresstxt->setFocus();
                 QCOMPARE(p->fixeddatetxt->text(), QStringLiteral("04 APR 1881"));
                 p->texttxt->setPlainText(QStringLiteral(" ab "));
             },
             QStringLiteral("The Source Text hasn't been filled in. Are you sure you want to save this census record "
                            "without entering this information?"),
             nullptr, answer::no},
        };
        for (const auto& step : steps) {
            step.before();
            savewith(*run, step.reply, step.message);
            if (step.focus)
                QCOMPARE(QApplication::focusWidget(), step.focus);
        }
        const message& last = run->prompts.history().back().m;
        QVERIFY(last.title == QStringLiteral("Save census") && last.defaultanswer == answer::no && last.kind == icon::question);
        QCOMPARE(readfile(file), bytes);
        QVERIFY(backups(s).isEmpty());
        QCOMPARE(run->read("Count"), QString());
        QCOMPARE(w.household().selectioncount, 1); // the form is as it was typed
        QCOMPARE(p->locationtxt->text(), QStringLiteral("  Leeds "));
        QVERIFY(w.watching());

        dialoganswers dialogs;
        setinputfaultfortests(true);
        run->prompts.expect(answer::yes, QStringLiteral("The Source Text hasn't been filled in."));
        run->prompts.expect(answer::ok, QStringLiteral("program will close"));
        button(w, "addbut")->click();
        setinputfaultfortests(false);
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().back().m.kind, icon::critical);
        QVERIFY(!w.isVisible());
        QCOMPARE(dialogs.seen, QStringList());
        QCOMPARE(readfile(file), bytes);
        QCOMPARE(run->read("Count"), QString());
    }

    // Birth details: asked by Auto Text and by Save for an individual with no
    // birth date or place; "Do Not Create" asks again next time, "Create"
    // writes the calculated birth event.
    void birthdetailsaskedandwritten()
    {
        const QString file = files_.sample();
        QVERIFY(withoutjohnsbirth(file));
        const QString before = snapshot(file);
        const settings s = testsettings();
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        chooseyear(w, QStringLiteral("1881"));
        p->locationtxt->setText(hebdenbridge);
        typehousehold(w, {{11, "28"}, {28, "2"}});

        dialoganswers dialogs;
        QString name, dob;
        dialogs.expect(QStringLiteral("birthfrm"), [&](QDialog* d) {
            name = d->findChild<QLabel*>(QStringLiteral("namelab"))->text();
            dob = d->findChild<QLabel*>(QStringLiteral("doblab"))->text();
            d->findChild<QPushButton*>(QStringLiteral("cancelbut"))->click();
        });
        button(w, "Autosourcebut")->click();
        QCOMPARE(dialogs.seen, QStringList{QStringLiteral("birthfrm")});
        QCOMPARE(name, QStringLiteral("Ashworth, John"));
        QCOMPARE(dob, QStringLiteral("1879"));
        QVERIFY(p->texttxt->toPlainText().contains(QStringLiteral("John Ashworth\tSon\t2\t\t\n")));

        // Asked again; the place typed is completed from the known places.
        dialogs.expect(QStringLiteral("birthfrm"), [&](QDialog* d) {
            QTest::keyClicks(d->findChild<QLineEdit*>(QStringLiteral("birthplacetxt")), QStringLiteral("Hebd"));
            d->findChild<QPushButton*>(QStringLiteral("okbut"))->click();
        });
        button(w, "Autosourcebut")->click();
        QCOMPARE(dialogs.seen.size(), 2);
        QVERIFY(p->texttxt->toPlainText().contains(QStringLiteral("John Ashworth\tSon\t2\t\t") + hebdenbridge + QLatin1Char('\n')));

        // Deleting the row and choosing the individual again keeps the details.
        rowcontrols<QToolButton>(w, "deleterowbut")[1]->click();
        clickid(w, familylist(w), 28);
        typerow(w, 1, QStringLiteral("2"));
        button(w, "addbut")->click();
        QCOMPARE(dialogs.seen.size(), 2); // not asked a third time
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);

        const QStringList diff = changes(before, file);
        const qsizetype at = diff.indexOf(QStringLiteral("@ 0 @I28@ INDI"));
        QVERIFY2(at >= 0, qPrintable(diff.join(QLatin1Char('\n'))));
        QCOMPARE(diff.mid(at + 1, 4), (QStringList{QStringLiteral("+1 BIRT"), QStringLiteral("+2 DATE CAL 1879"),
                                                   QStringLiteral("+2 PLAC ") + hebdenbridge, QStringLiteral("+2 SOUR @S12@")}));
        QVERIFY(filelines(s.logpath).contains(QStringLiteral("Name: Ashworth, John (28) : created census event and birth "
                                                            "event (1879 (cal) Hebden Bridge, Yorkshire, England)")));
        // Read again, the individual has the birth event and is not asked about.
        QVERIFY(!w.index()->people[27].birthedited);
        QVERIFY(w.index()->people[27].hasbirthdate);
    }

    // Auto Text for a head, his wife, two children, his mother and his sister
    // in the 1891 census with the condition column.
    void autotextofahousehold()
    {
        settings s = testsettings();
        s.marriagecondition = true;
        s.occscholar = false;
        auto run = opened(files_.sample(), s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        QPushButton* autotext = button(w, "Autosourcebut");
        QVERIFY(!autotext->isEnabled());
        chooseyear(w, QStringLiteral("1891"));
        typehousehold(w, {{3, "60", "Dyer's Labourer"}, {9, "58"}, {15, "24", "Fustian Cutter"}, {16, "20"}, {2, "79"}, {4, "57"}});
        QVERIFY(autotext->isEnabled());
        p->texttxt->setPlainText(QStringLiteral("replaced"));
        autotext->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(p->texttxt->toPlainText().split(QLatin1Char('\n')),
                 (QStringList{QStringLiteral("Name\tRelated\tCond\tAge\tOccupation\tBirth Place"),
                              QStringLiteral("John Ashworth\tHead\tM\t60\tDyer's Labourer\tHeptonstall, Yorkshire, England"),
                              QStringLiteral("Ellen Ashworth\tWife\tM\t58\t\tRochdale, Lancashire, England"),
                              QStringLiteral("Joseph Ashworth\tSon\tS\t24\tFustian Cutter\t") + hebdenbridge,
                              QStringLiteral("Emma Ashworth\tDau\tS\t20\t\t") + hebdenbridge,
                              QStringLiteral("Hannah Ashworth\tMother\tW\t79\t\tWadsworth, Yorkshire, England"),
                              QStringLiteral("Mary Ashworth\tSis\tS\t57\t\tHeptonstall, Yorkshire, England"), QString()}));

        // The census date is checked first.
        p->fixeddatetxt->setText(QStringLiteral("5 APRIL"));
        run->prompts.expect(answer::ok, QStringLiteral("You have not selected a valid date for the census - reselect "
                                                       "the year from the list box above to reset to original value"));
        autotext->click();
        QCOMPARE(QApplication::focusWidget(), p->fixeddatetxt);
        p->fixeddatetxt->setText(QString());
        run->prompts.expect(answer::ok, QStringLiteral("Before using the Auto-text function, you must first choose a "
                                                       "date for the census"));
        autotext->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        run->prompts.expect(answer::yes, QStringLiteral("partial or full census entry"));
        w.close();
    }

    // The large editor for the source text and note, Tab in the source text,
    // and the divider between the two boxes.
    void texteditoranddivider()
    {
        auto run = opened(files_.sample(), testsettings());
        QVERIFY(run);
        entrypanel* p = run->w->panel();
        p->texttxt->setFocus();
        QTest::keyClicks(p->texttxt, QStringLiteral("Name"));
        QTest::keyClick(p->texttxt, Qt::Key_Tab);
        QCOMPARE(QApplication::focusWidget(), p->texttxt);
        QTest::keyClick(p->texttxt, Qt::Key_Backtab, Qt::ShiftModifier);
        QVERIFY(QApplication::focusWidget() != p->texttxt);
        QCOMPARE(p->texttxt->toPlainText(), QStringLiteral("Name\t"));

        // OK takes the text typed in the editor; Cancel leaves the box as it was.
        dialoganswers dialogs;
        dialogs.expect(QStringLiteral("sourcetextfrm"), [&](QDialog* d) {
            QCOMPARE(d->windowTitle(), QStringLiteral("Source Text"));
            auto* box = d->findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
            QCOMPARE(box->toPlainText(), QStringLiteral("Name\t"));
            box->moveCursor(QTextCursor::End);
            typetext(box, QStringLiteral("Age\nJohn Smith\t45"));
            d->findChild<QPushButton*>(QStringLiteral("okbut"))->click();
        });
        p->fulltextbut->click();
        QCOMPARE(p->texttxt->toPlainText(), QStringLiteral("Name\tAge\nJohn Smith\t45"));
        p->notetxt->setPlainText(QStringLiteral("Page torn"));
        dialogs.expect(QStringLiteral("sourcetextfrm"), [&](QDialog* d) {
            QCOMPARE(d->windowTitle(), QStringLiteral("Source Note"));
            auto* box = d->findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
            QCOMPARE(box->toPlainText(), QStringLiteral("Page torn"));
            box->setPlainText(QStringLiteral("changed"));
            d->findChild<QPushButton*>(QStringLiteral("cancelbut"))->click();
        });
        p->notetextbut->click();
        QCOMPARE(p->notetxt->toPlainText(), QStringLiteral("Page torn"));
        QCOMPARE(dialogs.seen.size(), 2);
        QCOMPARE(dialogs.unexpected, 0);

        // The note box starts closed ("Divider Percent" never stored).
        QSplitter* divider = p->dividerpic;
        QCOMPARE(divider->sizes().value(1), 0);
        QCOMPARE(p->divider(), 1.0);
        QCOMPARE(divider->handle(1)->toolTip(), QStringLiteral("Drag up or down to reveal/resize the Source Note box"));
        // Dragged up it opens; not above a fifth of the height.
        QSplitterHandle* handle = divider->handle(1);
        const auto drag = [&](int dy) {
            const QPoint from = handle->rect().center();
            QTest::mousePress(handle, Qt::LeftButton, {}, from);
            QTest::mouseMove(handle, from + QPoint(0, dy));
            QTest::mouseRelease(handle, Qt::LeftButton, {}, from + QPoint(0, dy));
        };
        const int total = divider->sizes().value(0) + divider->sizes().value(1);
        drag(-total / 2);
        QVERIFY2(p->divider() > 0.4 && p->divider() < 0.6, qPrintable(QString::number(p->divider())));
        QVERIFY(p->notetxt->isVisible());
        drag(-total);
        QVERIFY2(p->divider() >= 0.2 && p->divider() < 0.45, qPrintable(QString::number(p->divider())));
        // Within 3 % of the bottom the note box closes.
        drag(static_cast<int>(total * (0.985 - p->divider())));
        QCOMPARE(p->divider(), 1.0);
        QCOMPARE(divider->sizes().value(1), 0);

        drag(-total / 3);
        const double share = p->divider();
        QVERIFY(share < 0.97);
        run->w->close();
        QCOMPARE(run->read("Divider Percent").toDouble(), std::round(share * 1e4) / 1e4);
    }
};

QTEST_MAIN(saveentryfrm_test)
#include "saveentryfrm_test.moc"

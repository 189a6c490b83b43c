// End-to-end tests of saving a census entry from the main window on the
// offscreen platform: the whole form typed and saved with each recording
// method and checked in the rewritten file and the census log, the save's
// checks in their order, birth details, a file changed by another program
// while the entry was typed, Auto Text, the source text editor and the divider.
#include "app/mainfrm.h"
#include "census/entrypanel_ui.h"
#include "platform/clock.h"
#include "support/mainfrmfixture.h"
#include "writer/saveroad.h"

#include <QAction>
#include <QDir>
#include <QPlainTextEdit>
#include <QProcess>
#include <QRegularExpression>
#include <QPushButton>
#include <QSplitter>
#include <QSplitterHandle>
#include <QToolButton>

#include <algorithm>
#include <cmath>
#include <utility>
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

// The changes from the snapshot to the file, line by line: each run of changed
// lines is headed by "@ " and the record ("0 ..." line) it falls in, then "-"
// removed and "+" added lines, as diff gives them; line ends are ignored.
QStringList linediff(const QString& before, const QString& after)
{
    const auto lines = [](const QString& path) {
        QFile f(path);
        if (!f.open(QIODevice::ReadOnly))
            return QStringList{QStringLiteral("cannot read ") + path};
        QStringList out = QString::fromUtf8(f.readAll()).remove(QLatin1Char('\r')).split(QLatin1Char('\n'));
        if (out.back().isEmpty())
            out.removeLast();
        return out;
    };
    const QStringList a = lines(before);
    const QStringList b = lines(after);
    qsizetype head = 0;
    while (head < a.size() && head < b.size() && a[head] == b[head])
        ++head;
    qsizetype tail = 0;
    while (tail < a.size() - head && tail < b.size() - head && a[a.size() - 1 - tail] == b[b.size() - 1 - tail])
        ++tail;
    // The shortest edit script of the middle parts (Myers' algorithm: each
    // round d reaches as far as d edits can along every diagonal k = x - y,
    // following equal lines as far as they go, so that lines are kept as early
    // as possible). The rounds are kept to walk the script back.
    const auto old = [&](qsizetype x) -> const QString& { return a[head + x]; };
    const auto now = [&](qsizetype y) -> const QString& { return b[head + y]; };
    const qsizetype n = a.size() - head - tail;
    const qsizetype m = b.size() - head - tail;
    std::vector<std::vector<qsizetype>> rounds; // round d: the furthest x of diagonals -d..d
    std::vector<qsizetype> reach{0};             // diagonal k at reach[k + d]
    for (qsizetype d = 0;; ++d) {
        std::vector<qsizetype> next(size_t(2 * d + 1));
        bool done = false;
        for (qsizetype k = -d; k <= d && !done; k += 2) {
            const auto last = [&](qsizetype kk) { return reach[size_t(kk + d - 1)]; };
            qsizetype x = d == 0 ? 0 : (k == -d || (k != d && last(k - 1) < last(k + 1))) ? last(k + 1) : last(k - 1) + 1;
            qsizetype y = x - k;
            while (x < n && y < m && old(x) == now(y)) {
                ++x;
                ++y;
            }
            next[size_t(k + d)] = x;
            done = x >= n && y >= m;
        }
        rounds.push_back(next);
        reach = std::move(next);
        if (done)
            break;
    }
    // Walked back from the end: 0 kept, 1 removed (old line), 2 added (new line).
    std::vector<std::pair<int, qsizetype>> script;
    qsizetype x = n, y = m;
    for (qsizetype d = qsizetype(rounds.size()) - 1; d >= 0; --d) {
        qsizetype px = 0, py = 0;
        bool down = false;
        if (d > 0) {
            const std::vector<qsizetype>& last = rounds[size_t(d - 1)];
            const qsizetype k = x - y;
            down = k == -d || (k != d && last[size_t(k - 1 + d - 1)] < last[size_t(k + 1 + d - 1)]);
            const qsizetype pk = down ? k + 1 : k - 1;
            px = last[size_t(pk + d - 1)];
            py = px - pk;
        }
        while (x > (d > 0 && !down ? px + 1 : px) && y > (d > 0 && down ? py + 1 : py)) {
            --x;
            --y;
            script.emplace_back(0, x);
        }
        if (d > 0) {
            script.emplace_back(down ? 2 : 1, down ? py : px);
            x = px;
            y = py;
        }
    }
    std::reverse(script.begin(), script.end());

    QStringList out;
    QString record; // the last "0 ..." line of the old file passed
    QString heading;
    QStringList removed;
    QStringList added;
    const auto flush = [&] {
        if (!removed.isEmpty() || !added.isEmpty())
            out << heading << removed << added;
        removed.clear();
        added.clear();
    };
    const auto unchanged = [&](const QString& l) {
        flush();
        if (l.startsWith(QLatin1String("0 ")))
            record = l;
    };
    const auto remove = [&](const QString& l) {
        if (removed.isEmpty() && added.isEmpty())
            heading = QStringLiteral("@ ") + record;
        removed << QLatin1Char('-') + l;
        if (l.startsWith(QLatin1String("0 ")))
            record = l;
    };
    const auto add = [&](const QString& l) {
        if (removed.isEmpty() && added.isEmpty())
            heading = QStringLiteral("@ ") + record;
        added << QLatin1Char('+') + l;
    };
    for (qsizetype i = 0; i < head; ++i)
        unchanged(a[i]);
    for (const auto& [what, at] : script) {
        if (what == 0)
            unchanged(old(at));
        else if (what == 1)
            remove(old(at));
        else
            add(now(at));
    }
    for (qsizetype k = a.size() - tail; k < a.size(); ++k)
        unchanged(a[k]);
    flush();
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
void savewith(session& run, answer a, const char* message)
{
    run.prompts.expect(a, QString::fromUtf8(message));
    button(*run.w, "addbut")->click();
    QCOMPARE(run.prompts.unexpected(), 0);
    QCOMPARE(run.prompts.history().back().m.text, QString::fromUtf8(message));
}

} // namespace

class saveentryfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

    // Settings of one run: backups and the log in a folder of their own.
    settings testsettings()
    {
        settings s = defaultsettings();
        const QString folder = files_.filepath(QStringLiteral("run%1").arg(++runs_));
        QDir().mkpath(folder + QStringLiteral("/backups"));
        s.backupfolder = folder + QStringLiteral("/backups");
        s.logpath = folder + QStringLiteral("/censuslog.txt");
        // The Census Images dialog is tested on its own (imagesfrm_test).
        s.requestimage = false;
        // The household check is tested on its own (householdcheckfrm_test).
        s.householdcheck = false;
        return s;
    }
    int runs_ = 0;

    std::unique_ptr<session> opened(const QString& file, const settings& s) { return files_.opened(file, &s); }

    // The sample opened with settings s and an 1881 entry at Hebden Bridge
    // typed: the individual `id` aged `age` in the first row, and the source
    // text when given.
    std::unique_ptr<session> typedentry(const QString& file, const settings& s, int32_t id, const char* age,
                                        const QString& text = QString())
    {
        auto run = opened(file, s);
        if (!run)
            return nullptr;
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        chooseyear(w, QStringLiteral("1881"));
        p->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        p->referencetxt->setText(QStringLiteral("RG11/4426/52"));
        if (!text.isEmpty())
            p->texttxt->setPlainText(text);
        clickid(w, peoplelist(w), id);
        typerow(w, 0, QString::fromLatin1(age));
        return run;
    }

    static QStringList backups(const settings& s) { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }

private slots:
    void initTestCase()
    {
        QVERIFY(files_.valid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    }
    void cleanupTestCase() { setclockfortests(QDateTime()); }

    // Method 1: the 1881 household of William and Agnes Ashworth with a new
    // census source, typed as a user would.
    void fullentry()
    {
        const QString file = files_.sample();
        const QString before = snapshot(file);
        const settings s = testsettings();
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
        QCOMPARE(p->locationtxt->text(), QStringLiteral("Hebden Bridge, Yorkshire, England"));
        QCOMPARE(p->locationtxt->selectedText(), QStringLiteral(", Yorkshire, England"));
        QTest::keyClick(p->locationtxt, Qt::Key_End);
        QTest::keyClicks(p->addresstxt, QStringLiteral("27 Hangingroyd Lane"));
        QTest::keyClicks(p->referencetxt, QStringLiteral("RG11/4426/52"));
        QTest::keyClicks(p->othertxt, QStringLiteral("William Ashworth"));
        QCOMPARE(p->titletxt->text(), QStringLiteral("Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52 "
                                                     "(William Ashworth)"));

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

        button(w, "addbut")->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().size(), size_t(1)); // only the default-file question at start

        const QString stamp = QStringLiteral("+2 DATE 04 DEC 2026\n+3 TIME 13:05:09\n");
        const auto person = [&](int id, const char* age, const char* time, const char* occupation = "") {
            return QStringLiteral("@ 0 @I%1@ INDI\n+1 CENS\n+2 DATE 3 APR 1881\n+2 PLAC Hebden Bridge, Yorkshire, England\n"
                                  "+2 ADDR 27 Hangingroyd Lane\n+2 AGE %2\n+2 SOUR @S12@\n%3@ 0 @I%1@ INDI\n"
                                  "-2 DATE 11 NOV 2023\n-3 TIME %4\n")
                       .arg(id)
                       .arg(QLatin1String(age), QLatin1String(occupation), QLatin1String(time))
                   + stamp;
        };
        QCOMPARE(linediff(before, file).join(QLatin1Char('\n')) + QLatin1Char('\n'),
                 person(11, "28y", "20:31:58",
                        "+1 OCCU Fustian Cutter\n+2 DATE 3 APR 1881\n+2 PLAC Hebden Bridge, Yorkshire, England\n"
                        "+2 SOUR @S12@\n")
                     + person(27, "26y", "20:33:12") + person(28, "2y", "20:34:01") + person(29, "1m", "20:35:26")
                     + QStringLiteral("@ 0 @S11@ SOUR\n+0 @S12@ SOUR\n+1 TITL Census 1881 Hebden Bridge, Yorkshire, "
                                      "England RG11/4426/52 (William Ashworth)\n+1 _TYPE Census\n+1 TEXT William "
                                      "Ashworth\tHead\n+2 CONT Agnes Ashworth\tWife\n+1 NOTE Enumerator's district 5\n"
                                      "+1 CHAN\n")
                     + stamp);
        QCOMPARE(filelines(s.logpath).join(QLatin1Char('\n')), QString(78, u'=') + QString::fromUtf8(R"x(
Census entry added: 2026-12-04 13:05:09
To Gedcom File: %1
Source created: Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52 (William Ashworth) (ID: 12)

Individual records changed (linked to source above): 
Name: Ashworth, William (11) : created census event and occupation attribute (Fustian Cutter)
Name: Schröder, Agnes (27) : created census event
Name: Ashworth, John (28) : created census event
Name: Ashworth, Frederick (29) : created census event)x").arg(QDir::toNativeSeparators(file)));

        // The form is cleared for the next entry and the file read again.
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(p->locationtxt->text().isEmpty());
        QVERIFY(p->texttxt->toPlainText().isEmpty());
        QCOMPARE(p->yearcom->currentIndex(), -1);
        QCOMPARE(p->sourceidlab->text(), QStringLiteral("13"));
        QCOMPARE(QApplication::focusWidget(), p->yearcom);
        QCOMPARE(run->read("Count"), QStringLiteral("1"));
        QCOMPARE(backups(s).size(), 1);
        QVERIFY(w.watching());
    }

    // Method 2: the entry cites an existing census source.
    void existingsource()
    {
        const QString file = files_.sample();
        const QString before = snapshot(file);
        settings s = testsettings();
        s.fullentry = false;
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        QCOMPARE(p->objectName(), QStringLiteral("entrypanel1"));
        QVERIFY(p->sourceidlab->text().isEmpty());

        // Choosing the source names its number and chooses the year of its title.
        const int item = p->sourcecom->findText(QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth)"));
        QVERIFY(item >= 0);
        p->sourcecom->setCurrentIndex(item);
        QCOMPARE(p->sourceidlab->text(), QStringLiteral("7"));
        QCOMPARE(p->yearcom->currentText(), QStringLiteral("1881"));
        QCOMPARE(p->fixeddatetxt->text(), QStringLiteral("3 APR 1881"));
        QCOMPARE(QApplication::focusWidget(), p->locationtxt);

        p->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
        p->addresstxt->setText(QStringLiteral("27 Hangingroyd Lane"));
        QTest::keyClicks(p->wherewithinsourcetxt, QStringLiteral(" RG11/4426/88 p 23 "));
        clickid(w, peoplelist(w), 11);
        typerow(w, 0, QStringLiteral("28"));
        clickid(w, familylist(w), 27);
        typerow(w, 1, QStringLiteral("26"), QString(), QStringLiteral("Weaver"));
        p->texttxt->setPlainText(QStringLiteral("William Ashworth\tHead\nAgnes Ashworth\tWife"));
        w.findChild<QAction*>(QStringLiteral("savemen"))->trigger();
        QCOMPARE(run->prompts.unexpected(), 0);

        // The census events cite source 7 where the entry is within it, with
        // the census day and the source text; the source itself is unchanged.
        const auto person = [](int id, const char* age, const char* time, const char* occupation) {
            const QString cited = QStringLiteral("+2 SOUR @S7@\n+3 PAGE RG11/4426/88 p 23\n+3 DATA\n+4 DATE 3 APR 1881\n");
            return QStringLiteral("@ 0 @I%1@ INDI\n+1 CENS\n+2 DATE 3 APR 1881\n+2 PLAC Hebden Bridge, Yorkshire, England\n"
                                  "+2 ADDR 27 Hangingroyd Lane\n+2 AGE %2\n%5+4 TEXT William Ashworth\tHead\n"
                                  "+5 CONT Agnes Ashworth\tWife\n%3@ 0 @I%1@ INDI\n-2 DATE 11 NOV 2023\n-3 TIME %4\n"
                                  "+2 DATE 04 DEC 2026\n+3 TIME 13:05:09\n")
                .arg(id)
                .arg(QLatin1String(age), *occupation ? QStringLiteral("+1 OCCU %1\n+2 DATE 3 APR 1881\n+2 PLAC Hebden "
                                                                      "Bridge, Yorkshire, England\n").arg(QLatin1String(occupation)) + cited
                                                     : QString(),
                     QLatin1String(time), cited);
        };
        QCOMPARE(linediff(before, file).join(QLatin1Char('\n')) + QLatin1Char('\n'),
                 person(11, "28y", "20:31:58", "") + person(27, "26y", "20:33:12", "Weaver"));
        QCOMPARE(filelines(s.logpath).join(QLatin1Char('\n')), QString(78, u'=') + QString::fromUtf8(R"x(
Census entry added: 2026-12-04 13:05:09
To Gedcom File: %1
Source referred to: Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth) (ID: 7)
Where within source: RG11/4426/88 p 23

Individual records changed (linked to source above): 
Name: Ashworth, William (11) : created census event
Name: Schröder, Agnes (27) : created census event and occupation attribute (Weaver))x").arg(QDir::toNativeSeparators(file)));
        QCOMPARE(run->read("Count"), QStringLiteral("1"));
        QCOMPARE(w.household().selectioncount, 0);
        QVERIFY(p->sourceidlab->text().isEmpty());
        QCOMPARE(p->sourcecom->currentIndex(), -1);
    }

    // The save's checks, each in its turn, with nothing written: what is left
    // out, the message, and where the focus goes.
    void checksintheirorder()
    {
        const QString file = files_.sample();
        const std::string bytes = readfile(file);
        const settings s = testsettings();
        auto run = opened(file, s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        const char* invaliddate = "Invalid date - reselect the year from the list box above to reset to original value";
        const struct {
            std::function<void()> before;
            const char* message;
            QWidget* focus;
            answer reply = answer::ok;
        } steps[] = {
            {[] {}, "The census entry must refer to at least 1 person!", nullptr},
            {[&] { chooseyear(w, QStringLiteral("1881")), clickid(w, peoplelist(w), 11); },
             "You must first enter an age for this individual", nullptr},
            {[&] { typerow(w, 0, QStringLiteral("28")); }, "Location must be specified", p->locationtxt},
            {[&] {
                 p->locationtxt->setText(QStringLiteral("  Leeds "));
                 p->titletxt->setText(QStringLiteral(" Census 1881 ")); // 11 characters once trimmed
             },
             "You must provide a full title for the entry", p->titletxt},
            {[&] { p->titletxt->setText(QStringLiteral("Census 1881L")), p->yearcom->setCurrentIndex(-1); },
             "You must select a census year from the list", nullptr},
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
             "The Source Text hasn't been filled in. Are you sure you want to save this census record without "
             "entering this information?",
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

        // Citing an existing source: the where-within-source text and the source.
        settings cite = testsettings();
        cite.fullentry = false;
        auto other = opened(files_.sample(), cite);
        QVERIFY(other);
        entrypanel* q = other->w->panel();
        chooseyear(*other->w, QStringLiteral("1881"));
        clickid(*other->w, peoplelist(*other->w), 11);
        typerow(*other->w, 0, QStringLiteral("28"));
        q->locationtxt->setText(QStringLiteral("Leeds"));
        q->wherewithinsourcetxt->setText(QStringLiteral("ab  "));
        savewith(*other, answer::ok, "You must enter the text for the 'Where within Source' entry");
        QCOMPARE(QApplication::focusWidget(), q->wherewithinsourcetxt);
        q->wherewithinsourcetxt->setText(QStringLiteral("abc"));
        savewith(*other, answer::ok, "You must select a source from the drop-down list");
        QVERIFY(backups(cite).isEmpty());
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
        auto run = typedentry(file, s, 11, "28");
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        clickid(w, familylist(w), 28);
        typerow(w, 1, QStringLiteral("2"));

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
            auto* place = d->findChild<QLineEdit*>(QStringLiteral("birthplacetxt"));
            QTest::keyClicks(place, QStringLiteral("Hebd"));
            d->findChild<QPushButton*>(QStringLiteral("okbut"))->click();
        });
        button(w, "Autosourcebut")->click();
        QCOMPARE(dialogs.seen.size(), 2);
        QVERIFY(p->texttxt->toPlainText().contains(
            QStringLiteral("John Ashworth\tSon\t2\t\tHebden Bridge, Yorkshire, England\n")));

        // Deleting the row and choosing the individual again keeps the details.
        rowcontrols<QToolButton>(w, "deleterowbut")[1]->click();
        clickid(w, familylist(w), 28);
        typerow(w, 1, QStringLiteral("2"));
        button(w, "addbut")->click();
        QCOMPARE(dialogs.seen.size(), 2); // not asked a third time
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);

        const QStringList diff = linediff(before, file);
        const qsizetype at = diff.indexOf(QStringLiteral("@ 0 @I28@ INDI"));
        QVERIFY2(at >= 0, qPrintable(diff.join(QLatin1Char('\n'))));
        QCOMPARE(diff.mid(at + 1, 4),
                 (QStringList{QStringLiteral("+1 BIRT"), QStringLiteral("+2 DATE CAL 1879"),
                              QStringLiteral("+2 PLAC Hebden Bridge, Yorkshire, England"), QStringLiteral("+2 SOUR @S12@")}));
        QVERIFY(filelines(s.logpath).contains(QStringLiteral("Name: Ashworth, John (28) : created census event and birth "
                                                            "event (1879 (cal) Hebden Bridge, Yorkshire, England)")));

        // Read again, the individual has the birth event and is not asked about.
        QVERIFY(!w.index()->people[27].birthedited);
        QVERIFY(w.index()->people[27].hasbirthdate);
    }

    // The file changed by another program between typing and saving: nothing
    // is written, the file is read again and the entry stays to be saved.
    void outsidechangestopsthesave()
    {
        const QString file = files_.sample();
        const settings s = testsettings();
        auto run = typedentry(file, s, 27, "26", QStringLiteral("Agnes Ashworth\tHead"));
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();

        QVERIFY(replaceinfile(file, QStringLiteral("1 NAME Agnes /Schröder/").toUtf8(), "1 NAME Agnes /Schroeder/"));
        const std::string changed = readfile(file);
        savewith(*run, answer::ok,
                 qPrintable(QDir::toNativeSeparators(file) +
                            QStringLiteral(" has been modified by another application and will be reloaded.")));
        QCOMPARE(readfile(file), changed);
        QVERIFY(backups(s).isEmpty());
        QCOMPARE(run->read("Count"), QString());
        QCOMPARE(shownnames(w), QStringList{QStringLiteral("Schroeder, Agnes")});
        QCOMPARE(p->locationtxt->text(), QStringLiteral("Hebden Bridge, Yorkshire, England"));
        QCOMPARE(p->texttxt->toPlainText(), QStringLiteral("Agnes Ashworth\tHead"));
        QVERIFY(w.watching());

        // Saved at the second try.
        button(w, "addbut")->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(w.household().selectioncount, 0);
        QCOMPARE(backups(s).size(), 1);
        QVERIFY(filelines(file).contains(QStringLiteral("1 TITL Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52")));
        QCOMPARE(run->read("Count"), QStringLiteral("1"));
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
        const QString hb = QStringLiteral("Hebden Bridge, Yorkshire, England");
        QCOMPARE(p->texttxt->toPlainText().split(QLatin1Char('\n')),
                 (QStringList{QStringLiteral("Name\tRelated\tCond\tAge\tOccupation\tBirth Place"),
                              QStringLiteral("John Ashworth\tHead\tM\t60\tDyer's Labourer\tHeptonstall, Yorkshire, England"),
                              QStringLiteral("Ellen Ashworth\tWife\tM\t58\t\tRochdale, Lancashire, England"),
                              QStringLiteral("Joseph Ashworth\tSon\tS\t24\tFustian Cutter\t") + hb,
                              QStringLiteral("Emma Ashworth\tDau\tS\t20\t\t") + hb,
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
        const settings s = testsettings();
        auto run = opened(files_.sample(), s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        entrypanel* p = w.panel();
        p->texttxt->setFocus();
        QTest::keyClicks(p->texttxt, QStringLiteral("Name"));
        QTest::keyClick(p->texttxt, Qt::Key_Tab);
        QCOMPARE(QApplication::focusWidget(), p->texttxt);
        QTest::keyClick(p->texttxt, Qt::Key_Backtab, Qt::ShiftModifier);
        QVERIFY(QApplication::focusWidget() != p->texttxt);
        QCOMPARE(p->texttxt->toPlainText(), QStringLiteral("Name\t"));

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
        const int down = static_cast<int>(total * (0.985 - p->divider()));
        drag(down);
        QCOMPARE(p->divider(), 1.0);
        QCOMPARE(divider->sizes().value(1), 0);

        drag(-total / 3);
        const double share = p->divider();
        QVERIFY(share < 0.97);
        w.close();
        QCOMPARE(run->read("Divider Percent").toDouble(), std::round(share * 1e4) / 1e4);
    }

    // A rewrite that fails: the message, the family file as it was, and the
    // program ends. With "Birthdate" off nobody is asked about a birth first.
    void failedrewriteendstheprogram()
    {
        const QString file = files_.sample();
        QVERIFY(withoutjohnsbirth(file));
        const std::string bytes = readfile(file);
        settings s = testsettings();
        s.birthdate = false;
        auto run = typedentry(file, s, 28, "2", QStringLiteral("John Ashworth"));
        QVERIFY(run);
        dialoganswers dialogs;
        setinputfaultfortests(true);
        run->prompts.expect(answer::ok, QStringLiteral("program will close"));
        button(*run->w, "addbut")->click();
        setinputfaultfortests(false);
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().back().m.kind, icon::critical);
        QVERIFY(!run->w->isVisible());
        QCOMPARE(dialogs.seen, QStringList());
        QCOMPARE(readfile(file), bytes);
        QCOMPARE(run->read("Count"), QString());
    }
};

QTEST_MAIN(saveentryfrm_test)
#include "saveentryfrm_test.moc"

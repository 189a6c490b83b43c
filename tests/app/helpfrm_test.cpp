// The help window offscreen (topics, navigation, search, help under a modal
// dialog) and, through the main window, the Help menu, F1, About and "Make a
// Donation...". The milestone after a save: saveentryfrm_test.
#include "app/helpfrm.h"
#include "support/mainfrmfixture.h"

#include <QAction>
#include <QListWidget>
#include <QMenuBar>
#include <QPushButton>
#include <QTextBrowser>

using namespace qm;
using namespace qmtest;

namespace {

QPushButton* button(QWidget* w, const char* name)
{
    return w->findChild<QPushButton*>(QString::fromLatin1(name));
}

QString pagetext(helpfrm& h)
{
    return h.findChild<QTextBrowser*>(QStringLiteral("helptxt"))->toPlainText();
}

void trigger(mainfrm& w, const char* name)
{
    QAction* a = w.menuBar()->findChild<QAction*>(QString::fromLatin1(name));
    QVERIFY2(a, name);
    a->trigger();
}

} // namespace

class helpfrm_test : public QObject {
    Q_OBJECT

private:
    windowfiles files_;

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    void backforwardhomeindex()
    {
        helpfrm h;
        h.showtopic(17);
        QVERIFY(!button(&h, "backbut")->isEnabled());
        h.showtopic(55);
        QVERIFY(!pagetext(h).isEmpty());
        QVERIFY(button(&h, "backbut")->isEnabled());
        button(&h, "backbut")->click();
        QCOMPARE(h.currentpage(), QStringLiteral("main-window.html"));
        QVERIFY(button(&h, "forwardbut")->isEnabled());
        button(&h, "forwardbut")->click();
        QCOMPARE(h.currentpage(), QStringLiteral("flag-check.html"));
        button(&h, "indexbut")->click();
        QCOMPARE(h.currentpage(), QStringLiteral("index.html"));
        button(&h, "homebut")->click();
        QCOMPARE(h.currentpage(), QStringLiteral("main-window.html"));
        h.show();
        h.activateWindow();
        QTRY_VERIFY(h.isActiveWindow());
        QTest::keyClick(&h, Qt::Key_Left, Qt::AltModifier);
        QCOMPARE(h.currentpage(), QStringLiteral("index.html"));
        QTest::keyClick(&h, Qt::Key_Escape);
        QVERIFY(!h.isVisible());
        // A link followed inside the page.
        auto* browser = h.findChild<QTextBrowser*>(QStringLiteral("helptxt"));
        browser->setSource(QUrl(QStringLiteral("options.html#titletemplate")));
        QCOMPARE(h.currentpage(), QStringLiteral("options.html"));
    }

    void searchlistspagesandopensthechosenone()
    {
        helpfrm h;
        h.show();
        button(&h, "searchbut")->click();
        QCOMPARE(h.currentpage(), QStringLiteral("search.html"));
        auto* box = h.findChild<QLineEdit*>(QStringLiteral("searchtxt"));
        QTest::keyClicks(box, QStringLiteral("Flag"));
        QTest::keyClick(box, Qt::Key_Return);
        auto* results = h.findChild<QListWidget*>(QStringLiteral("resultlst"));
        QVERIFY(results->count() >= 3);
        const QStringList top = {results->item(0)->data(Qt::UserRole).toString(),
                                 results->item(1)->data(Qt::UserRole).toString()};
        QVERIFY(top.contains(QStringLiteral("census-flags.html")) && top.contains(QStringLiteral("flag-check.html")));
        results->setCurrentRow(1);
        QTest::mouseClick(results->viewport(), Qt::LeftButton, {}, results->visualItemRect(results->item(1)).center());
        QCOMPARE(h.currentpage(), results->item(1)->data(Qt::UserRole).toString());
        // The page opens at the first word found.
        auto* browser = h.findChild<QTextBrowser*>(QStringLiteral("helptxt"));
        QCOMPARE(browser->textCursor().selectedText().toLower(), QStringLiteral("flag"));

        h.search(QStringLiteral("zebrafish"));
        QCOMPARE(results->count(), 0);
        QVERIFY(h.findChild<QLabel*>(QStringLiteral("resultlab"))->text().startsWith(QLatin1String("No page")));
    }

    // Opened from a modal dialog, the help belongs to that dialog (so that it
    // can be used while the dialog waits) and goes back to its home when the
    // dialog closes, staying open.
    void staysusableunderamodaldialog()
    {
        QWidget home;
        home.show();
        helpfrm* h = helpfrm::open(&home, 17, QString());
        QCOMPARE(h->parentWidget(), &home);
        QCOMPARE(helpfrm::open(&home, 20, QString()), h); // one window, reused
        QDialog d(&home);
        d.setModal(true);
        d.show();
        QTRY_COMPARE(QApplication::activeModalWidget(), &d);
        helpfrm::open(&home, 20, QString());
        QCOMPARE(h->parentWidget(), &d);
        d.hide();
        QCOMPARE(h->parentWidget(), &home);
        QVERIFY(h->isVisible());
        QCOMPARE(h->currentpage(), QStringLiteral("options.html"));
    }

    // The Help menu and F1 reach the prompts with their topics; About and
    // Donate open their windows.
    void helpmenuthroughthemainwindow()
    {
        auto run = files_.opened(files_.sample());
        QVERIFY(run);
        mainfrm& w = *run->w;
        trigger(w, "helpcreatingentrymen");
        trigger(w, "HelpIndexmen");
        trigger(w, "HelpSearchmen");
        QCOMPARE(run->prompts.helpshown,
                 (QStringList{QStringLiteral("12"), QStringLiteral("Index"), QStringLiteral("Search")}));
        w.activateWindow();
        QTRY_VERIFY(w.isActiveWindow());
        QTest::keyClick(&w, Qt::Key_F1);
        QCOMPARE(run->prompts.helpshown.last(), QStringLiteral("17"));

        // F1 in a dialog presses its Help button.
        QDialog d(&w);
        d.setModal(true);
        auto* help = new QPushButton(QStringLiteral("&Help"), &d);
        auto* box = new QLineEdit(&d);
        int pressed = 0;
        connect(help, &QPushButton::clicked, [&] { ++pressed; });
        d.show();
        QTRY_COMPARE(QApplication::activeModalWidget(), &d);
        QTest::keyClick(box, Qt::Key_F1);
        QCOMPARE(pressed, 1);
        QCOMPARE(run->prompts.helpshown.size(), 4);
        d.close();

        // About and "Make a Donation...".
        dialoganswers answers;
        QString caption;
        answers.expect(QStringLiteral("aboutfrm"), [&](QDialog* d) {
            caption = d->windowTitle();
            button(d, "cmdOK")->click();
        });
        answers.expect(QStringLiteral("donatefrm"), [&](QDialog* d) {
            caption += QLatin1Char('|') + d->windowTitle();
            button(d, "donatebut")->click();
            button(d, "regularbut")->click();
            button(d, "closebut")->click();
        });
        trigger(w, "aboutmen");
        trigger(w, "donatemen");
        QCOMPARE(answers.unexpected, 0);
        QCOMPARE(caption, QStringLiteral("About Quillmark %1.%2.%3|Would you like to make a donation?")
                              .arg(QM_VERSION_MAJOR)
                              .arg(QM_VERSION_MINOR)
                              .arg(QM_VERSION_PATCH));
        QCOMPARE(run->prompts.opened, (QStringList{QStringLiteral("https://quillmark.org/donate"),
                                                   QStringLiteral("https://quillmark.org/donate/regular")}));
    }
};

QTEST_MAIN(helpfrm_test)
#include "helpfrm_test.moc"

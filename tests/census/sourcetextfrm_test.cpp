#include "census/sourcetextfrm.h"
#include "support/fixedpitch.h"

#include <QApplication>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTimer>
#include <QtTest>

using namespace qm;

class sourcetextfrmtest : public QObject {
    Q_OBJECT

private slots:
    void titlesizeandfont()
    {
        QWidget main;
        main.resize(1000, 800);
        sourcetextfrm text(sourcetextfrm::sourcetext, QStringLiteral("x"), &main);
        QCOMPARE(text.windowTitle(), QStringLiteral("Source Text"));
        QCOMPARE(text.size(), QSize(950, 760));
        QVERIFY(qmtest::linesupcolumns(text.findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"))->font()));
        QCOMPARE(text.findChild<QPushButton*>(QStringLiteral("cancelbut"))->text(), QStringLiteral("Cancel"));
        QCOMPARE(sourcetextfrm(sourcetextfrm::sourcenote, QString(), &main).windowTitle(), QStringLiteral("Source Note"));
        QCOMPARE(sourcetextfrm(7, QString(), &main).windowTitle(), QStringLiteral("Source Note"));
        const QString given = QStringLiteral("a\n\n\tb  \n"); // unchanged text comes back exactly
        QCOMPARE(sourcetextfrm(sourcetextfrm::sourcenote, given).text(), given);
    }

    // Tab types a tab, Shift+Tab leaves the box; OK gives the text back with
    // its line ends, Cancel gives nothing.
    void editedthenokorcancel()
    {
        QWidget main;
        main.resize(800, 600);
        const QString given = QStringLiteral("Name\tAge\r\nJohn Smith\t45\r\n");
        for (const char* button : {"okbut", "cancelbut"}) {
            bool typedtab = false, lefttheboxonshifttab = false;
            QTimer::singleShot(0, [&] {
                auto* editor = qobject_cast<sourcetextfrm*>(QApplication::activeModalWidget());
                auto* box = editor->findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
                if (QTest::qWaitForWindowActive(editor)) {
                    box->setFocus();
                    box->moveCursor(QTextCursor::End);
                    QTest::keyClicks(box, QStringLiteral("Mary"));
                    QTest::keyClick(box, Qt::Key_Tab);
                    QTest::keyClicks(box, QStringLiteral("40"));
                    typedtab = box->hasFocus();
                    QTest::keyClick(box, Qt::Key_Backtab, Qt::ShiftModifier);
                    lefttheboxonshifttab = !box->hasFocus();
                }
                QTest::mouseClick(editor->findChild<QPushButton*>(QString::fromLatin1(button)), Qt::LeftButton);
            });
            const auto edited = sourcetextfrm::edit(sourcetextfrm::sourcetext, given, &main);
            QVERIFY(typedtab && lefttheboxonshifttab);
            QCOMPARE(edited, button == std::string_view("okbut") ? std::optional(given + QStringLiteral("Mary\t40"))
                                                                 : std::nullopt);
        }
    }
};

QTEST_MAIN(sourcetextfrmtest)
#include "sourcetextfrm_test.moc"

#include "census/sourcetextfrm.h"

#include <QApplication>
#include <QFontInfo>
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
        auto* box = text.findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
        QVERIFY(box);
        QVERIFY(QFontInfo(box->font()).fixedPitch());
        QVERIFY(text.findChild<QWidget*>(QStringLiteral("buttonpic")));
        QCOMPARE(text.findChild<QPushButton*>(QStringLiteral("cancelbut"))->text(), QStringLiteral("Cancel"));

        sourcetextfrm note(sourcetextfrm::sourcenote, QString(), &main);
        QCOMPARE(note.windowTitle(), QStringLiteral("Source Note"));
        sourcetextfrm other(7, QString(), &main);
        QCOMPARE(other.windowTitle(), QStringLiteral("Source Note"));
    }

    void tabinsertsatabandshifttableaves()
    {
        QWidget main;
        main.resize(800, 600);
        sourcetextfrm editor(sourcetextfrm::sourcetext, QString(), &main);
        editor.show();
        QVERIFY(QTest::qWaitForWindowActive(&editor));
        auto* box = editor.findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
        box->setFocus();
        QTest::keyClicks(box, QStringLiteral("Name"));
        QTest::keyClick(box, Qt::Key_Tab);
        QTest::keyClicks(box, QStringLiteral("Age"));
        QCOMPARE(box->toPlainText(), QStringLiteral("Name\tAge"));
        QVERIFY(box->hasFocus());

        QTest::keyClick(box, Qt::Key_Backtab, Qt::ShiftModifier);
        QVERIFY(!box->hasFocus());
        QCOMPARE(box->toPlainText(), QStringLiteral("Name\tAge"));
    }

    void okgivesthetextbackwithitslineends()
    {
        QWidget main;
        main.resize(800, 600);
        const QString given = QStringLiteral("Name\tAge\r\nJohn Smith\t45\r\n");
        bool done = false;
        QTimer::singleShot(0, [&] {
            auto* editor = qobject_cast<sourcetextfrm*>(QApplication::activeModalWidget());
            QVERIFY(editor);
            auto* box = editor->findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt"));
            box->moveCursor(QTextCursor::End);
            QTest::keyClicks(box, QStringLiteral("Mary"));
            QTest::keyClick(box, Qt::Key_Tab);
            QTest::keyClicks(box, QStringLiteral("40"));
            QTest::mouseClick(editor->findChild<QPushButton*>(QStringLiteral("okbut")), Qt::LeftButton);
            done = true;
        });
        const auto edited = sourcetextfrm::edit(sourcetextfrm::sourcetext, given, &main);
        QVERIFY(done);
        QVERIFY(edited);
        QCOMPARE(*edited, given + QStringLiteral("Mary\t40"));
    }

    void unchangedtextcomesbackexactly()
    {
        const QString given = QStringLiteral("a\n\n\tb  \n");
        sourcetextfrm editor(sourcetextfrm::sourcenote, given);
        QCOMPARE(editor.text(), given);
    }

    void cancelgivesnothing()
    {
        QWidget main;
        main.resize(800, 600);
        bool done = false;
        QTimer::singleShot(0, [&] {
            auto* editor = qobject_cast<sourcetextfrm*>(QApplication::activeModalWidget());
            QVERIFY(editor);
            QTest::keyClicks(editor->findChild<QPlainTextEdit*>(QStringLiteral("sourcetxt")), QStringLiteral("lost"));
            QTest::mouseClick(editor->findChild<QPushButton*>(QStringLiteral("cancelbut")), Qt::LeftButton);
            done = true;
        });
        QVERIFY(!sourcetextfrm::edit(sourcetextfrm::sourcenote, QStringLiteral("kept"), &main));
        QVERIFY(done);
    }
};

QTEST_MAIN(sourcetextfrmtest)
#include "sourcetextfrm_test.moc"

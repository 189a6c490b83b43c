#include "census/sourcetextfrm.h"
#include "support/fixedpitch.h"

#include <QPlainTextEdit>
#include <QPushButton>
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
};

QTEST_MAIN(sourcetextfrmtest)
#include "sourcetextfrm_test.moc"

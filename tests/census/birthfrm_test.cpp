#include "census/birthfrm.h"

#include "platform/scriptedprompts.h"
#include "support/screenreader.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QtTest>

using namespace qm;

namespace {

selectionrec row(const QString& age, QChar unit = u'Y', const QString& occupation = QString())
{
    selectionrec r;
    r.id = 12;
    r.name = QStringLiteral("Smith, John");
    r.age = age;
    r.agetype = unit;
    r.occupation = occupation;
    r.personindex = 3;
    return r;
}

const std::vector<placerec> places = {{"Leeds, Yorkshire", 4}, {"Warrington, Lancashire", 3}, {"Warwick, Warwickshire", 5}};

template <class T = QLabel>
T* child(const QWidget& w, const char* name)
{
    return w.findChild<T*>(QString::fromLatin1(name));
}

} // namespace

class birthfrmtest : public QObject {
    Q_OBJECT

private slots:
    // The captions of the three units; the dates themselves are the
    // calculation's (birthdate_test).
    void calculateddates_data()
    {
        QTest::addColumn<QString>("entrydate");
        QTest::addColumn<QString>("age");
        QTest::addColumn<QChar>("unit");
        QTest::addColumn<QString>("agelab");
        QTest::addColumn<QString>("doblab");
        QTest::newRow("45 years") << "30 MAR 1851" << "45" << QChar(u'Y') << "45" << "1806";
        QTest::newRow("3 months") << "7 APR 1861" << "3" << QChar(u'M') << "3 months" << "JAN 1861";
        QTest::newRow("10 days") << "2 APR 1871" << "10" << QChar(u'D') << "10 days" << "23 MAR 1871";
    }

    void calculateddates()
    {
        QFETCH(QString, entrydate);
        QFETCH(QString, age);
        QFETCH(QChar, unit);
        scriptedprompts asker;
        birthfrm d(row(age, unit), entrydate, places, asker);
        QCOMPARE(d.windowTitle(), QStringLiteral("Birth Details"));
        QCOMPARE(child(d, "namelab")->text(), QStringLiteral("Smith, John"));
        QCOMPARE(child(d, "idlab")->text(), QStringLiteral("12"));
        QTEST(child(d, "agelab")->text(), "agelab");
        QTEST(child(d, "doblab")->text(), "doblab");
        QVERIFY(child<QPushButton>(d, "okbut")->isEnabled());
        // A screen reader reads the values themselves.
        for (const char* name : {"namelab", "idlab", "agelab", "doblab"})
            QCOMPARE(qmtest::accessiblename(child(d, name)), child(d, name)->text());
    }

    void buttonsandoccupation()
    {
        scriptedprompts asker;
        birthfrm d(row(QStringLiteral("40"), u'Y', QStringLiteral("Ag Lab")), QStringLiteral("30 MAR 1851"), places, asker);
        d.show();
        QCOMPARE(child<QPushButton>(d, "okbut")->text(), QStringLiteral("Create Birth Event"));
        QCOMPARE(child<QPushButton>(d, "cancelbut")->text(), QStringLiteral("Do Not Create Birth Event"));
        QCOMPARE(child(d, "occlab")->text(), QStringLiteral("Ag Lab"));
        QCOMPARE(qmtest::accessiblename(child(d, "occlab")), QStringLiteral("Ag Lab"));
        QCOMPARE(child(d, "occtitlelab")->text(), QStringLiteral("Occupation:"));
        QVERIFY(child(d, "occlab")->isVisible());
        QSignalSpy help(&d, &birthfrm::helprequested);
        QTest::mouseClick(child<QPushButton>(d, "helpbut"), Qt::LeftButton);
        QCOMPARE(help.count(), 1);
        QVERIFY(!d.details());

        // An occupation of "X" is not shown; no census date, no birth date.
        birthfrm x(row(QStringLiteral("40"), u'Y', QStringLiteral("X")), QString(), places, asker);
        x.show();
        QVERIFY(!child(x, "occlab")->isVisible());
        QVERIFY(!child(x, "occtitlelab")->isVisible());
        QVERIFY(!child<QPushButton>(x, "okbut")->isEnabled());
    }

    // An empty place is questioned: Cancel goes back to the box, OK creates the
    // event without a place.
    void emptyplace()
    {
        scriptedprompts asker;
        asker.expect(answer::cancel, QStringLiteral("You have not entered a birth place."));
        asker.expect(answer::ok, QStringLiteral("You have not entered a birth place."));
        birthfrm d(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places, asker);
        d.show();
        QVERIFY(QTest::qWaitForWindowActive(&d));
        auto* place = child<QLineEdit>(d, "birthplacetxt");
        QTest::keyClicks(place, QStringLiteral("  "));
        QTest::mouseClick(child<QPushButton>(d, "okbut"), Qt::LeftButton);
        QVERIFY(d.isVisible());
        QVERIFY(!d.details());
        QCOMPARE(place->text(), QString());
        QVERIFY(place->hasFocus());
        const message& m = asker.history().at(0).m;
        QCOMPARE(m.text, QStringLiteral("You have not entered a birth place. Please click OK if you are sure you "
                                        "don't want to record a place of birth."));
        QCOMPARE(m.title, QStringLiteral("Quillmark"));
        QVERIFY(m.choice == buttons::okcancel && m.kind == icon::question && m.defaultanswer == answer::cancel);

        QTest::mouseClick(child<QPushButton>(d, "okbut"), Qt::LeftButton);
        QCOMPARE(asker.unexpected(), 0);
        QCOMPARE(d.result(), int(QDialog::Accepted));
        QCOMPARE(d.details()->birthdate, QStringLiteral("1806"));
        QCOMPARE(d.details()->birthplace, QString());

        // A place typed is given back trimmed, and Enter creates the event.
        birthfrm e(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places, asker);
        e.show();
        QTest::keyClicks(child<QLineEdit>(e, "birthplacetxt"), QStringLiteral("Otley "));
        QTest::keyClick(child<QLineEdit>(e, "birthplacetxt"), Qt::Key_Return);
        QCOMPARE(asker.history().size(), size_t(2));
        selectionrec r = row(QStringLiteral("45"));
        e.details()->applyto(r);
        QVERIFY(r.birthedited);
        QCOMPARE(r.birthdate, QStringLiteral("1806"));
        QCOMPARE(r.birthplace, QStringLiteral("Otley"));
    }

    void typethroughcompletion()
    {
        scriptedprompts asker;
        birthfrm d(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places, asker);
        d.show();
        auto* place = child<QLineEdit>(d, "birthplacetxt");
        const auto typed = [&](const QString& keys, const char* text, const char* selected) {
            QTest::keyClicks(place, keys);
            QCOMPARE(place->text(), QString::fromLatin1(text));
            QCOMPARE(place->selectedText(), QString::fromLatin1(selected));
        };
        typed(QStringLiteral("war"), "Warwick, Warwickshire", "wick, Warwickshire");
        // The next letter of the offer is swallowed: the offer stays.
        QSignalSpy edited(place, &QLineEdit::textEdited);
        typed(QStringLiteral("wi"), "Warwick, Warwickshire", "ck, Warwickshire");
        QCOMPARE(edited.count(), 0);
        // Backspace takes the rest away and offers nothing new.
        QTest::keyClick(place, Qt::Key_Backspace);
        QCOMPARE(place->text(), QStringLiteral("Warwi"));
        QTest::keyClick(place, Qt::Key_Backspace);
        QTest::keyClick(place, Qt::Key_Backspace);
        // A different letter replaces the rest, and a new offer is looked up.
        typed(QStringLiteral("r"), "Warrington, Lancashire", "ington, Lancashire");
        typed(QStringLiteral("x"), "Warrx", "");
        // Delete, like Backspace, leaves only the typed text.
        place->clear();
        QTest::keyClicks(place, QStringLiteral("war"));
        QTest::keyClick(place, Qt::Key_Delete);
        QCOMPARE(place->text(), QStringLiteral("War"));
        // A letter of another case is typed over the offer, which keeps the
        // place's own spelling.
        place->clear();
        typed(QStringLiteral("le"), "Leeds, Yorkshire", "eds, Yorkshire");
        typed(QStringLiteral("E"), "Leeds, Yorkshire", "ds, Yorkshire");
        place->clear();
        typed(QStringLiteral("leeds, yorkshire"), "Leeds, Yorkshire", "");
        QTest::mouseClick(child<QPushButton>(d, "okbut"), Qt::LeftButton);
        QCOMPARE(d.details()->birthplace, QStringLiteral("Leeds, Yorkshire"));
    }
};

QTEST_MAIN(birthfrmtest)
#include "birthfrm_test.moc"

#include "census/birthfrm.h"

#include "platform/scriptedprompts.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTimer>
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

const std::vector<placerec>& places()
{
    static const std::vector<placerec> table = {
        {"Leeds, Yorkshire", 4},
        {"Warrington, Lancashire", 3},
        {"Warwick, Warwickshire", 5},
    };
    return table;
}

QString label(const QWidget& w, const char* name)
{
    return w.findChild<QLabel*>(QString::fromLatin1(name))->text();
}

} // namespace

class birthfrmtest : public QObject {
    Q_OBJECT

private slots:
    void calculateddates_data()
    {
        QTest::addColumn<QString>("entrydate");
        QTest::addColumn<QString>("age");
        QTest::addColumn<QChar>("unit");
        QTest::addColumn<QString>("agelab");
        QTest::addColumn<QString>("doblab");
        QTest::newRow("45 years") << "30 MAR 1851" << "45" << QChar(u'Y') << "45" << "1806";
        QTest::newRow("0 years") << "30 MAR 1851" << "0" << QChar(u'Y') << "0" << "1851";
        QTest::newRow("3 months") << "7 APR 1861" << "3" << QChar(u'M') << "3 months" << "JAN 1861";
        QTest::newRow("15 months") << "7 APR 1861" << "15" << QChar(u'M') << "15 months" << "JAN 1860";
        QTest::newRow("6 months") << "30 MAR 1851" << "6" << QChar(u'M') << "6 months" << "SEP 1850";
        QTest::newRow("10 days") << "2 APR 1871" << "10" << QChar(u'D') << "10 days" << "23 MAR 1871";
        QTest::newRow("45 days") << "30 MAR 1851" << "45" << QChar(u'D') << "45 days" << "13 FEB 1851";
    }

    void calculateddates()
    {
        QFETCH(QString, entrydate);
        QFETCH(QString, age);
        QFETCH(QChar, unit);
        QFETCH(QString, agelab);
        QFETCH(QString, doblab);
        scriptedprompts asker;
        birthfrm d(row(age, unit), entrydate, places(), asker);
        QCOMPARE(d.windowTitle(), QStringLiteral("Birth Details"));
        QCOMPARE(label(d, "namelab"), QStringLiteral("Smith, John"));
        QCOMPARE(label(d, "idlab"), QStringLiteral("12"));
        QCOMPARE(label(d, "agelab"), agelab);
        QCOMPARE(label(d, "doblab"), doblab);
        QVERIFY(d.findChild<QPushButton*>(QStringLiteral("okbut"))->isEnabled());
    }

    void buttonsandnames()
    {
        scriptedprompts asker;
        birthfrm d(row(QStringLiteral("4")), QStringLiteral("30 MAR 1851"), places(), asker);
        QCOMPARE(d.findChild<QPushButton*>(QStringLiteral("okbut"))->text(), QStringLiteral("Create Birth Event"));
        QCOMPARE(d.findChild<QPushButton*>(QStringLiteral("cancelbut"))->text(),
                 QStringLiteral("Do Not Create Birth Event"));
        QCOMPARE(d.findChild<QPushButton*>(QStringLiteral("helpbut"))->text(), QStringLiteral("Help"));
        QVERIFY(!d.findChild<QLineEdit*>(QStringLiteral("birthplacetxt"))->accessibleName().isEmpty());

        QSignalSpy help(&d, &birthfrm::helprequested);
        QTest::mouseClick(d.findChild<QPushButton*>(QStringLiteral("helpbut")), Qt::LeftButton);
        QCOMPARE(help.count(), 1);
        QVERIFY(!d.details());
    }

    void nodatewithoutacensusdate()
    {
        scriptedprompts asker;
        birthfrm d(row(QStringLiteral("4")), QString(), places(), asker);
        QVERIFY(!d.findChild<QPushButton*>(QStringLiteral("okbut"))->isEnabled());
    }

    void occupationlabels()
    {
        scriptedprompts asker;
        birthfrm one(row(QStringLiteral("40"), u'Y', QStringLiteral("X")), QStringLiteral("30 MAR 1851"), places(),
                     asker);
        one.show();
        QVERIFY(!one.findChild<QLabel*>(QStringLiteral("occlab"))->isVisible());
        QVERIFY(!one.findChild<QLabel*>(QStringLiteral("occtitlelab"))->isVisible());

        birthfrm two(row(QStringLiteral("40"), u'Y', QStringLiteral("Ag Lab")), QStringLiteral("30 MAR 1851"),
                     places(), asker);
        two.show();
        QVERIFY(two.findChild<QLabel*>(QStringLiteral("occlab"))->isVisible());
        QCOMPARE(label(two, "occlab"), QStringLiteral("Ag Lab"));
        QCOMPARE(label(two, "occtitlelab"), QStringLiteral("Occupation:"));
    }

    void emptyplaceconfirmed()
    {
        scriptedprompts asker;
        asker.expect(answer::ok, QStringLiteral("You have not entered a birth place."));
        birthfrm d(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places(), asker);
        d.show();
        QTest::keyClicks(d.findChild<QLineEdit*>(QStringLiteral("birthplacetxt")), QStringLiteral("   "));
        QTest::mouseClick(d.findChild<QPushButton*>(QStringLiteral("okbut")), Qt::LeftButton);
        QCOMPARE(asker.unexpected(), 0);
        const message& m = asker.history().at(0).m;
        QCOMPARE(m.text, QStringLiteral("You have not entered a birth place. Please click OK if you are sure you "
                                        "don't want to record a place of birth."));
        QCOMPARE(m.title, QStringLiteral("Quillmark"));
        QVERIFY(m.choice == buttons::okcancel);
        QVERIFY(m.kind == icon::question);
        QVERIFY(m.defaultanswer == answer::cancel);
        QCOMPARE(d.result(), int(QDialog::Accepted));
        QVERIFY(d.details());
        QCOMPARE(d.details()->birthdate, QStringLiteral("1806"));
        QCOMPARE(d.details()->birthplace, QString());
    }

    void emptyplacecancelled()
    {
        scriptedprompts asker;
        asker.expect(answer::cancel, QStringLiteral("You have not entered a birth place."));
        birthfrm d(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places(), asker);
        d.show();
        QVERIFY(QTest::qWaitForWindowActive(&d));
        auto* place = d.findChild<QLineEdit*>(QStringLiteral("birthplacetxt"));
        QTest::keyClicks(place, QStringLiteral("  "));
        QTest::mouseClick(d.findChild<QPushButton*>(QStringLiteral("okbut")), Qt::LeftButton);
        QCOMPARE(asker.unexpected(), 0);
        QVERIFY(d.isVisible());
        QVERIFY(!d.details());
        QCOMPARE(place->text(), QString());
        QVERIFY(place->hasFocus());

        // A place typed then is given back trimmed, and Enter creates the event.
        QTest::keyClicks(place, QStringLiteral("Otley "));
        QTest::keyClick(place, Qt::Key_Return);
        QVERIFY(d.details());
        QCOMPARE(d.details()->birthplace, QStringLiteral("Otley"));
        QCOMPARE(asker.history().size(), size_t(1));

        selectionrec r = row(QStringLiteral("45"));
        d.details()->applyto(r);
        QVERIFY(r.birthedited);
        QCOMPARE(r.birthdate, QStringLiteral("1806"));
        QCOMPARE(r.birthplace, QStringLiteral("Otley"));
    }

    void typethroughcompletion()
    {
        scriptedprompts asker;
        birthfrm d(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places(), asker);
        d.show();
        auto* place = d.findChild<QLineEdit*>(QStringLiteral("birthplacetxt"));
        QTest::keyClicks(place, QStringLiteral("war"));
        QCOMPARE(place->text(), QStringLiteral("Warwick, Warwickshire"));
        QCOMPARE(place->selectedText(), QStringLiteral("wick, Warwickshire"));

        // The next letter of the offer is swallowed: the offer stays, its
        // rest still selected.
        QSignalSpy edited(place, &QLineEdit::textEdited);
        QTest::keyClicks(place, QStringLiteral("wi"));
        QCOMPARE(edited.count(), 0);
        QCOMPARE(place->text(), QStringLiteral("Warwick, Warwickshire"));
        QCOMPARE(place->selectedText(), QStringLiteral("ck, Warwickshire"));
        // Backspace takes the rest away and offers nothing new.
        QTest::keyClick(place, Qt::Key_Backspace);
        QCOMPARE(place->text(), QStringLiteral("Warwi"));
        QTest::keyClick(place, Qt::Key_Backspace);
        QTest::keyClick(place, Qt::Key_Backspace);
        QCOMPARE(place->text(), QStringLiteral("War"));

        // A different letter replaces the rest, and a new offer is looked up.
        QTest::keyClicks(place, QStringLiteral("r"));
        QCOMPARE(place->text(), QStringLiteral("Warrington, Lancashire"));
        QCOMPARE(place->selectedText(), QStringLiteral("ington, Lancashire"));
        QTest::keyClicks(place, QStringLiteral("x"));
        QCOMPARE(place->text(), QStringLiteral("Warrx"));

        // Delete, like Backspace, leaves only the typed text.
        place->clear();
        QTest::keyClicks(place, QStringLiteral("war"));
        QTest::keyClick(place, Qt::Key_Delete);
        QCOMPARE(place->text(), QStringLiteral("War"));

        // A letter of another case is typed over the offer; the new offer
        // then takes the place's own spelling.
        place->clear();
        QTest::keyClicks(place, QStringLiteral("le"));
        QCOMPARE(place->text(), QStringLiteral("Leeds, Yorkshire"));
        QTest::keyClicks(place, QStringLiteral("E"));
        QCOMPARE(place->text(), QStringLiteral("Leeds, Yorkshire"));
        QCOMPARE(place->selectedText(), QStringLiteral("ds, Yorkshire"));

        place->clear();
        QTest::keyClicks(place, QStringLiteral("leeds, yorkshire"));
        QCOMPARE(place->text(), QStringLiteral("Leeds, Yorkshire"));
        QTest::mouseClick(d.findChild<QPushButton*>(QStringLiteral("okbut")), Qt::LeftButton);
        QCOMPARE(d.details()->birthplace, QStringLiteral("Leeds, Yorkshire"));
    }

    void modalaskandcancel()
    {
        scriptedprompts asker;
        bool done = false;
        QTimer::singleShot(0, [&] {
            auto* d = qobject_cast<birthfrm*>(QApplication::activeModalWidget());
            QVERIFY(d);
            QTest::keyClicks(d->findChild<QLineEdit*>(QStringLiteral("birthplacetxt")), QStringLiteral("York"));
            QTest::mouseClick(d->findChild<QPushButton*>(QStringLiteral("cancelbut")), Qt::LeftButton);
            done = true;
        });
        QVERIFY(!birthfrm::ask(row(QStringLiteral("45")), QStringLiteral("30 MAR 1851"), places(), asker, nullptr));
        QVERIFY(done);

        done = false;
        QTimer::singleShot(0, [&] {
            auto* d = qobject_cast<birthfrm*>(QApplication::activeModalWidget());
            QVERIFY(d);
            QTest::keyClicks(d->findChild<QLineEdit*>(QStringLiteral("birthplacetxt")), QStringLiteral("Wigan"));
            QTest::mouseClick(d->findChild<QPushButton*>(QStringLiteral("okbut")), Qt::LeftButton);
            done = true;
        });
        const auto got =
            birthfrm::ask(row(QStringLiteral("6"), u'M'), QStringLiteral("30 MAR 1851"), places(), asker, nullptr);
        QVERIFY(done);
        QVERIFY(got);
        QCOMPARE(got->birthdate, QStringLiteral("SEP 1850"));
        QCOMPARE(got->birthplace, QStringLiteral("Wigan"));
        QCOMPARE(asker.unexpected(), 0);
    }
};

QTEST_MAIN(birthfrmtest)
#include "birthfrm_test.moc"

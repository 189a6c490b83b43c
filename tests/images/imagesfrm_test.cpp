// The image dialogs on the offscreen platform: the preview of a picture made
// here and of a format it cannot show, the chooser of existing records, new
// images with their titles, numbers, refusals and renaming, and saving an
// entry with a new and an existing image in both recording methods. Titles,
// numbers, refusals and renames themselves: imagechoices_test.
#include "images/currentimagesfrm.h"
#include "images/imagechoices.h"
#include "images/imagepreview_ui.h"
#include "images/imagesfrm.h"
#include "images/imageviewfrm.h"
#include "images/newimagefrm.h"
#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "support/dialogs.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QImage>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QRadioButton>

using namespace qm;
using namespace qmtest;

class imagesfrmtest : public QObject {
    Q_OBJECT

    windowfiles files_;
    int made_ = 0;

    QString png(const QString& name, int w, int h)
    {
        QImage picture(w, h, QImage::Format_RGB32);
        picture.fill(Qt::darkGreen);
        const QString path = files_.filepath(name);
        return picture.save(path, "PNG") ? path : QString();
    }

    static std::unique_ptr<gedcomindex> load(const QString& path) { return loadgedcom(path, flagtable()).index; }

    settings runsettings()
    {
        settings s = defaultsettings();
        const QString folder = files_.filepath(QStringLiteral("run%1").arg(++made_));
        s.householdcheck = false; // tested on its own (householdcheckfrm_test)
        QDir().mkpath(folder + QStringLiteral("/backups"));
        s.backupfolder = folder + QStringLiteral("/backups");
        s.logpath = folder + QStringLiteral("/censuslog.txt");
        return s;
    }

    // Answers Add a new image...: chooses `file`, takes title option `option`
    // (typing `own` for option 2) and presses OK.
    static dialoganswers::action addnew(scriptedprompts& p, const QString& file, int option, const QString& own = QString(),
                                        bool rename = false)
    {
        return [&p, file, option, own, rename](QDialog* d) {
            p.expectfile(file);
            press(d, "choosefilebut");
            child(d, QStringLiteral("titleopt%1").arg(option))->click();
            if (option == 2)
                QTest::keyClicks(child<QLineEdit>(d, "titletxt2"), own);
            child<QCheckBox>(d, "renamechk")->setChecked(rename);
            press(d, "addbut");
        };
    }

private slots:
    void initTestCase()
    {
        QVERIFY(files_.valid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9)));
    }
    void cleanupTestCase() { setclockfortests(QDateTime()); }

    // A picture is drawn scaled to fit at the top-left corner and opens full
    // size on a click; other files give the procedure's messages.
    void preview()
    {
        scriptedprompts p;
        imagepreview v(p, QSize(200, 200));
        v.show();
        QCOMPARE(v.showfile(png(QStringLiteral("wide.png"), 40, 20)), imagepreview::outcome::shown);
        QCOMPARE(v.picture().size(), QSize(40, 20));
        QCOMPARE(picturebox::fitted(QSize(40, 20), QSize(200, 200)), QRect(0, 0, 200, 100));
        QCOMPARE(picturebox::fitted(QSize(300, 600), QSize(200, 200)), QRect(0, 0, 100, 200));
        dialoganswers answers;
        QSize viewed;
        answers.expect(QStringLiteral("imageviewfrm"), [&](QDialog* d) {
            viewed = child<picturebox>(d, "mainpic")->picture().size();
            d->accept();
        });
        QTest::mouseClick(v.box(), Qt::LeftButton);
        QTRY_COMPARE(answers.pending(), 0);
        QCOMPARE(viewed, QSize(40, 20));

        // A format the loader does not know: the file opens in its viewer on a click.
        const QString pcx = files_.filepath(QStringLiteral("page.pcx"));
        writefile(pcx, std::string("\x0a\x05\x01\x08not a picture Qt reads", 25));
        QCOMPARE(v.showfile(pcx), imagepreview::outcome::unsupported);
        QVERIFY(v.message() == imagepreview::unsupportedtext() && v.picture().isNull());
        QTest::mouseClick(v.messagelabel(), Qt::LeftButton);
        QCOMPARE(p.opened, QStringList{pcx});
        p.openerror = QStringLiteral("There is no application associated with the given file name extension.");
        p.expect(answer::ok, QStringLiteral("There was a problem previewing this file: There is no application "
                                            "associated with the given file name extension."));
        QTest::mouseClick(v.messagelabel(), Qt::LeftButton);

        QCOMPARE(v.showfile(files_.filepath(QStringLiteral("missing.png"))), imagepreview::outcome::notfound);
        QCOMPARE(v.message(), QStringLiteral("Problem: the file path is not valid - check the location of this image in "
                                             "Family Historian."));
        QVERIFY(answered(p));
    }

    // The chooser's census filter and path rows; a "_FILE" path as Family
    // Historian writes it on Windows (drive letter, backslashes) read back as
    // it stands and previewed from there, a missing file still chosen; the
    // same record twice refused.
    void chooseexisting()
    {
        const QString picture = QDir::toNativeSeparators(png(QStringLiteral("scan 1881.png"), 6, 8));
#ifdef Q_OS_WIN
        QVERIFY(picture.at(1) == u':' && picture.contains(u'\\') && !picture.contains(u'/'));
#endif
        const QString file = files_.filepath(QStringLiteral("three.ged"));
        writefile(file, "0 HEAD\r\n1 CHAR UTF-8\r\n"
                        "0 @O1@ OBJE\r\n1 FORM png\r\n1 TITL Leeds CENSUS 1881\r\n1 _FILE " + picture.toStdString() + "\r\n"
                        "0 @O2@ OBJE\r\n1 FORM jpg\r\n1 TITL Wedding\r\n1 _FILE C:\\census\\wedding.jpg\r\n"
                        "0 @O5@ OBJE\r\n1 FORM png\r\n1 TITL Portrait\r\n1 _FILE C:\\Photos\\pic01.jpg\r\n0 TRLR\r\n");
        const auto ix = load(file);
        QVERIFY(ix);
        scriptedprompts p;
        std::vector<imagechoice> chosen;
        {
            currentimagesfrm f(*ix, p, chosen);
            auto* list = child<QListWidget>(&f, "imageslst");
            QCOMPARE(rows(list), (QStringList{"Leeds CENSUS 1881", "Wedding", "Portrait"}));
            child<QCheckBox>(&f, "censuschk")->setChecked(true);
            QCOMPARE(rows(list), (QStringList{"Leeds CENSUS 1881", "Wedding"}));
            child<QRadioButton>(&f, "showpathsopt")->setChecked(true);
            QCOMPARE(rows(list), (QStringList{pathrow(picture), "...C:\\census\\wedding.jpg"}));
            child<QCheckBox>(&f, "censuschk")->setChecked(false);
            QCOMPARE(list->item(2)->text(), QStringLiteral("...C:\\Photos\\pic01.jpg")); // 20 characters, all shown

            list->setCurrentRow(0);
            QCOMPARE(child<QLineEdit>(&f, "Imageinfotxt2")->text(), picture);
            const auto* preview = child<imagepreview>(&f, "imagepreview");
            QVERIFY(preview->last() == imagepreview::outcome::shown && preview->picture().size() == QSize(6, 8));
            QVERIFY(refusenewimage(QDir::fromNativeSeparators(picture), chosen, *ix).contains(QLatin1String("already loaded")));

            list->setCurrentRow(2);
            QCOMPARE(child<QLineEdit>(&f, "Imageinfotxt0")->text(), QStringLiteral("Portrait"));
            QCOMPARE(preview->last(), imagepreview::outcome::notfound);
            press(&f, "HelpBut");
            QCOMPARE(p.helpshown, QStringList{QStringLiteral("24")});
            press(&f, "okbut");
            QCOMPARE(f.result(), int(QDialog::Accepted));
        }
        QVERIFY(chosen.size() == 1 && chosen[0].objectid == 5);

        currentimagesfrm again(*ix, p, chosen);
        QVERIFY(!child(&again, "okbut")->isEnabled());
        child<QListWidget>(&again, "imageslst")->setCurrentRow(2);
        p.expect(answer::ok, QStringLiteral("can not be selected again"));
        press(&again, "okbut");
        QVERIFY(answered(p));
        QVERIFY(again.result() != QDialog::Accepted && chosen.size() == 1);
    }

    // New images: titles offered, numbers after unlinking, refusals, rename.
    void newimages()
    {
        const auto ix = load(files_.sample());
        QVERIFY(ix);
        scriptedprompts p;
        auto store = settingsstore::onfile(files_.ini());
        const settings s = runsettings();
        imagerequest r;
        r.sourcetitle = QStringLiteral("Census 1881 Leeds RG11/1 (Smith)");
        r.sourcebase = r.sourcetitle;
        r.referencebase = QStringLiteral("RG11/1");
        r.imagedate = QStringLiteral("3 APR 1881");
        imagesfrm f(r, *ix, s, *store, p);
        f.show();
        QCOMPARE(accessiblename(child<QLabel>(&f, "sourcetitlelab")), r.sourcetitle);
        auto* list = child<QListWidget>(&f, "newimageslst");
        QVERIFY(!child(&f, "okbut")->isEnabled());
        press(&f, "helpbut");

        const QString one = png(QStringLiteral("one.png"), 8, 6), two = png(QStringLiteral("two.png"), 6, 8);
        dialoganswers answers;
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            QVERIFY(!child(d, "addbut")->isEnabled());
            p.expectfile(one);
            press(d, "choosefilebut");
            QStringList offered;
            for (const char* box : {"titletxt0", "titletxt1", "titletxt2", "titletxt3"})
                offered << child<QLineEdit>(d, box)->text();
            QCOMPARE(offered, (QStringList{"one", r.sourcebase, "Type your own title here...", "RG11/1"}));
            // The own title left as the prompt: refused, the dialog stays open.
            press(d, "titleopt2");
            p.expect(answer::ok, QStringLiteral("You have selected the option to create your own custom title, but have "
                                                "not typed a title in yet."));
            press(d, "addbut");
            QVERIFY(d->isVisible());
            press(d, "titleopt1");
            press(d, "addbut");
        });
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, two, 1));
        press(&f, "Addnewbut");
        press(&f, "Addnewbut");
        QCOMPARE(rows(list), (QStringList{"1: Census 1881 Leeds RG11/1 (Smith)", "2: Census 1881 Leeds RG11/1 (Smith) 2"}));
        QCOMPARE(list->currentRow(), 1);
        QCOMPARE(child<imagepreview>(&f, "imagepreview")->picture().size(), QSize(6, 8));

        // Unlinking the first: the next new image is numbered 3 and takes O5.
        list->setCurrentRow(0);
        press(&f, "unlinkbut");
        QCOMPARE(rows(list), QStringList{"1: Census 1881 Leeds RG11/1 (Smith) 2"});
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, png(QStringLiteral("three.png"), 5, 5), 1));
        press(&f, "Addnewbut");
        QVERIFY(f.chosen().back().titlenumber == 3 && f.chosen().back().objectid == 5);

        // A refusal keeps the dialog as it was.
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            p.expectfile(QDir::toNativeSeparators(two));
            p.expect(answer::ok, QStringLiteral("already been selected"));
            press(d, "choosefilebut");
            QCOMPARE(child<QLineEdit>(d, "filenametxt")->text(), QString());
            press(d, "helpbut");
            press(d, "cancelbut");
        });
        press(&f, "Addnewbut");
        QCOMPARE(f.chosen().size(), size_t(2));
        QCOMPARE(p.helpshown, (QStringList{"18", "23"}));

        // Renamed to its own title; the choices are remembered for the next dialog.
        const QString scan = png(QStringLiteral("IMG_0042.png"), 4, 4);
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, scan, 2, QStringLiteral("Smith: 1881?"), true));
        press(&f, "Addnewbut");
        const QString renamed = QDir::toNativeSeparators(files_.filepath(QStringLiteral("Smith_ 1881_.png")));
        QCOMPARE(f.chosen().back().file + f.chosen().back().title, renamed + QStringLiteral("Smith: 1881?"));
        QVERIFY(QFile::exists(renamed) && !QFile::exists(scan));
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            QVERIFY(child(d, "titleopt2")->isChecked() && child(d, "renamechk")->isChecked());
            press(d, "cancelbut");
        });
        press(&f, "Addnewbut");
        QVERIFY(answered(answers) && answered(p));
    }

    // The title option remembered, when the reference title is unavailable, in
    // the save (1) and attach (2) contexts; "Do not attach image(s)" gives no
    // images and lets the save go on.
    void titleoptionsandcontexts()
    {
        const auto ix = load(files_.sample());
        QVERIFY(ix);
        scriptedprompts p;
        auto store = settingsstore::onfile(files_.ini());
        store->write(QStringLiteral("Image Option"), QStringLiteral("3"));
        const settings s = runsettings();
        for (const int context : {1, 2}) {
            imagerequest r;
            r.context = context;
            r.sourcebase = QStringLiteral("Census 1881 Leeds");
            imagesfrm f(r, *ix, s, *store, p);
            QCOMPARE(child(&f, "Cancelcensusbut")->isVisibleTo(&f), context == 1);
            // Read while open, compared once it has closed: reference option
            // enabled, the option taken, rename enabled, own title and name read-only.
            QString states, reference;
            dialoganswers answers;
            answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
                const auto* frame = child<QGroupBox>(d, "imageframe");
                for (const bool on : {child(d, "titleopt3")->isEnabledTo(frame), child(d, "titleopt0")->isChecked(),
                                      child(d, "titleopt2")->isChecked(), child(d, "renamechk")->isEnabledTo(frame),
                                      child<QLineEdit>(d, "titletxt2")->isReadOnly(),
                                      child<QLineEdit>(d, "titletxt0")->isReadOnly()})
                    states += on ? u'1' : u'0';
                reference = child<QLineEdit>(d, "titletxt3")->text();
                press(d, "cancelbut");
            });
            press(&f, "Addnewbut");
            QCOMPARE(answers.pending(), 0);
            QCOMPARE(states, context == 1 ? QStringLiteral("010011") : QStringLiteral("001101"));
            QCOMPARE(reference, QStringLiteral("No reference for this census was specified"));
            QVERIFY(f.chosen().empty());
        }

        std::vector<imagechoice> chosen{imagechoice{}};
        dialoganswers answers;
        answers.expect(QStringLiteral("imagesfrm"), [&](QDialog* d) {
            dialoganswers inner;
            inner.expect(QStringLiteral("currentimagesfrm"), [](QDialog* c) {
                child<QListWidget>(c, "imageslst")->setCurrentRow(1);
                press(c, "okbut");
            });
            press(d, "addcurrentimagebut");
            QVERIFY(child(d, "okbut")->isEnabled());
            press(d, "cancelbut");
        });
        QVERIFY(imagesfrm::choose(imagerequest{}, *ix, s, *store, p, chosen, nullptr));
        QVERIFY(answered(answers) && chosen.empty() && answered(p));
    }

    // Saving an entry with a new and an existing image: the new one gets its
    // multimedia record, titled from the form of each method; "Cancel saving
    // census" writes nothing. (Where each method links the images, and the
    // log's lines: the rewrite's golden files and the census log's tests.)
    void savewithimages()
    {
        for (const bool full : {true, false}) {
            const QString file = files_.sample();
            settings s = runsettings();
            s.fullentry = full;
            s.requestimages2 = true;
            auto run = files_.opened(file, &s);
            QVERIFY(run);
            mainfrm& w = *run->w;
            entrypanel* p = w.panel();
            if (!full) {
                p->sourcecom->setCurrentIndex(p->sourcecom->findText(QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth)")));
                p->wherewithinsourcetxt->setText(QStringLiteral("folio 23"));
            }
            chooseyear(w, QStringLiteral("1881"));
            p->locationtxt->setText(QStringLiteral("Hebden Bridge, Yorkshire, England"));
            if (full)
                p->referencetxt->setText(QStringLiteral("RG11/4426/52"));
            p->texttxt->setPlainText(QStringLiteral("William Ashworth, Head"));
            clickid(w, peoplelist(w), 11);
            typerow(w, 0, QStringLiteral("28"));
            const std::string before = readfile(file);

            dialoganswers answers;
            answers.expect(QStringLiteral("imagesfrm"), [](QDialog* d) { press(d, "Cancelcensusbut"); });
            press(&w, "addbut");
            QCOMPARE(answers.seen, QStringList{QStringLiteral("imagesfrm")});
            QCOMPARE(readfile(file), before);
            QCOMPARE(w.household().selectioncount, 1);

            const QString scan = png(QStringLiteral("page%1.png").arg(full), 10, 10);
            int listed = 0;
            bool nested = false;
            answers.expect(QStringLiteral("imagesfrm"), [&](QDialog* d) {
                // Dialogs opened from this one are answered while its answer runs.
                dialoganswers inner;
                inner.expect(QStringLiteral("newimagefrm"), addnew(run->prompts, scan, 1));
                inner.expect(QStringLiteral("currentimagesfrm"), [](QDialog* c) {
                    child<QListWidget>(c, "imageslst")->setCurrentRow(0);
                    press(c, "okbut");
                });
                press(d, "Addnewbut");
                press(d, "addcurrentimagebut");
                listed = static_cast<int>(rows(d, "newimageslst").size());
                nested = answered(inner);
                press(d, "okbut");
            });
            press(&w, "addbut");
            QVERIFY(nested && listed == 2 && answered(answers));
            QVERIFY(answered(run->prompts));

            const std::string text = readfile(file);
            const QString title = full ? QStringLiteral("Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52")
                                       : QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth) (folio 23)");
            const QString record = QStringLiteral("0 @O3@ OBJE\r\n1 FORM png\r\n1 TITL ") + title + QStringLiteral("\r\n1 _FILE ")
                                 + QDir::toNativeSeparators(scan) + QStringLiteral("\r\n1 _DATE 3 APR 1881\r\n");
            QVERIFY2(text.find(record.toStdString()) != std::string::npos, text.substr(text.size() - 900).c_str());
            QCOMPARE(w.household().selectioncount, 0);
        }
    }
};

QTEST_MAIN(imagesfrmtest)
#include "imagesfrm_test.moc"

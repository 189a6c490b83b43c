// The image dialogs on the offscreen platform: the preview of a picture made
// here and of a format it cannot show, the chooser of existing records, new
// images with their titles, numbers, refusals and renaming, and saving an
// entry with a new and an existing image in both recording methods.
#include "images/currentimagesfrm.h"
#include "images/imagechoices.h"
#include "images/imagepreview_ui.h"
#include "images/imagesfrm.h"
#include "images/imageviewfrm.h"
#include "images/newimagefrm.h"
#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "support/mainfrmfixture.h"
#include "support/screenreader.h"

#include <QCheckBox>
#include <QDir>
#include <QGroupBox>
#include <QImage>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QRadioButton>

using namespace qm;
using namespace qmtest;

namespace {

template <class T>
T* child(const QWidget* w, const QString& name)
{
    return w->findChild<T*>(name);
}

QPushButton* button(const QWidget* w, const char* name)
{
    return child<QPushButton>(w, QString::fromLatin1(name));
}

QStringList rows(const QListWidget* l)
{
    QStringList out;
    for (int i = 0; i < l->count(); ++i)
        out << l->item(i)->text();
    return out;
}

QString readtext(const QString& path)
{
    return QString::fromStdString(readfile(path));
}

// A family file with three multimedia records: a census title, a census
// folder, and neither.
const char* const threeimages = "0 HEAD\r\n1 CHAR UTF-8\r\n"
                                "0 @O1@ OBJE\r\n1 FORM jpg\r\n1 TITL Leeds CENSUS 1881\r\n1 _FILE C:\\Scans\\p1.jpg\r\n"
                                "1 _DATE 3 APR 1881\r\n"
                                "0 @O2@ OBJE\r\n1 FORM jpg\r\n1 TITL Wedding\r\n1 _FILE C:\\census\\wedding.jpg\r\n"
                                "0 @O5@ OBJE\r\n1 FORM png\r\n1 TITL Portrait\r\n1 _FILE C:\\Photos\\pic01.jpg\r\n"
                                "0 TRLR\r\n";

} // namespace

class imagesfrmtest : public QObject {
    Q_OBJECT

private:
    windowfiles files_;
    int made_ = 0;

    QString png(const QString& name, int w, int h)
    {
        QImage picture(w, h, QImage::Format_RGB32);
        picture.fill(Qt::darkGreen);
        const QString path = files_.filepath(name);
        return picture.save(path, "PNG") ? path : QString();
    }

    std::unique_ptr<gedcomindex> load(const QString& path)
    {
        loadresult r = loadgedcom(path, flagtable());
        return std::move(r.index);
    }

    settings runsettings()
    {
        settings s = defaultsettings();
        const QString folder = files_.filepath(QStringLiteral("run%1").arg(++made_));
        // The household check is tested on its own (householdcheckfrm_test).
        s.householdcheck = false;
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
            button(d, "choosefilebut")->click();
            child<QRadioButton>(d, QStringLiteral("titleopt%1").arg(option))->click();
            if (option == 2)
                QTest::keyClicks(child<QLineEdit>(d, QStringLiteral("titletxt2")), own);
            child<QCheckBox>(d, QStringLiteral("renamechk"))->setChecked(rename);
            button(d, "addbut")->click();
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
        const QString wide = png(QStringLiteral("wide.png"), 40, 20);
        QCOMPARE(v.showfile(wide), imagepreview::outcome::shown);
        QCOMPARE(v.picture().size(), QSize(40, 20));
        QCOMPARE(picturebox::fitted(QSize(40, 20), QSize(200, 200)), QRect(0, 0, 200, 100));
        QCOMPARE(picturebox::fitted(QSize(300, 600), QSize(200, 200)), QRect(0, 0, 100, 200));

        dialoganswers answers;
        QSize viewed;
        answers.expect(QStringLiteral("imageviewfrm"), [&](QDialog* d) {
            viewed = child<picturebox>(d, QStringLiteral("mainpic"))->picture().size();
            d->accept();
        });
        QTest::mouseClick(v.box(), Qt::LeftButton);
        QTRY_COMPARE(answers.pending(), 0);
        QCOMPARE(viewed, QSize(40, 20));

        // A format the loader does not know: the file opens in its viewer on a click.
        const QString pcx = files_.filepath(QStringLiteral("page.pcx"));
        writefile(pcx, std::string("\x0a\x05\x01\x08not a picture Qt reads", 25));
        QCOMPARE(v.showfile(pcx), imagepreview::outcome::unsupported);
        QCOMPARE(v.message(), imagepreview::unsupportedtext());
        QVERIFY(v.picture().isNull());
        QTest::mouseClick(v.messagelabel(), Qt::LeftButton);
        QCOMPARE(p.opened, QStringList{pcx});
        p.openerror = QStringLiteral("There is no application associated with the given file name extension.");
        p.expect(answer::ok);
        QTest::mouseClick(v.messagelabel(), Qt::LeftButton);
        QCOMPARE(p.texts().back(), QStringLiteral("There was a problem previewing this file: There is no application "
                                                  "associated with the given file name extension."));

        QCOMPARE(v.showfile(files_.filepath(QStringLiteral("missing.png"))), imagepreview::outcome::notfound);
        QCOMPARE(v.message(), QStringLiteral("Problem: the file path is not valid - check the location of this image in "
                                             "Family Historian."));
        QCOMPARE(p.unexpected(), 0);
    }

    // The chooser's census filter and path rows; the same record twice is refused.
    void chooseexisting()
    {
        const QString file = files_.filepath(QStringLiteral("three.ged"));
        writefile(file, threeimages);
        const auto ix = load(file);
        QVERIFY(ix);
        scriptedprompts p;
        std::vector<imagechoice> chosen;
        {
            currentimagesfrm f(*ix, p, chosen);
            auto* list = child<QListWidget>(&f, QStringLiteral("imageslst"));
            QCOMPARE(rows(list), (QStringList{QStringLiteral("Leeds CENSUS 1881"), QStringLiteral("Wedding"),
                                              QStringLiteral("Portrait")}));
            child<QCheckBox>(&f, QStringLiteral("censuschk"))->setChecked(true);
            QCOMPARE(rows(list), (QStringList{QStringLiteral("Leeds CENSUS 1881"), QStringLiteral("Wedding")}));
            child<QRadioButton>(&f, QStringLiteral("showpathsopt"))->setChecked(true);
            QCOMPARE(rows(list), (QStringList{QStringLiteral("...C:\\Scans\\p1.jpg"), QStringLiteral("...C:\\census\\wedding.jpg")}));
            child<QCheckBox>(&f, QStringLiteral("censuschk"))->setChecked(false);
            QCOMPARE(list->item(2)->text(), QStringLiteral("...C:\\Photos\\pic01.jpg")); // 20 characters, all shown

            QVERIFY(!button(&f, "okbut")->isEnabled());
            list->setCurrentRow(2);
            QCOMPARE(child<QLineEdit>(&f, QStringLiteral("Imageinfotxt0"))->text(), QStringLiteral("Portrait"));
            // The file is not there: the record can still be chosen.
            QCOMPARE(child<imagepreview>(&f, QStringLiteral("imagepreview"))->last(), imagepreview::outcome::notfound);
            button(&f, "HelpBut")->click();
            QCOMPARE(p.helpshown, QStringList{QStringLiteral("24")});
            button(&f, "okbut")->click();
            QCOMPARE(f.result(), int(QDialog::Accepted));
        }
        QCOMPARE(chosen.size(), size_t(1));
        QCOMPARE(chosen[0].objectid, 5);

        currentimagesfrm again(*ix, p, chosen);
        child<QListWidget>(&again, QStringLiteral("imageslst"))->setCurrentRow(2);
        p.expect(answer::ok, QStringLiteral("can not be selected again"));
        button(&again, "okbut")->click();
        QCOMPARE(p.unexpected(), 0);
        QVERIFY(again.result() != QDialog::Accepted);
        QCOMPARE(chosen.size(), size_t(1));
    }

    // A "_FILE" path as Family Historian writes it on Windows (drive letter,
    // backslashes) is read back as it stands and previewed from there; the
    // same file chosen again with forward slashes is known as the same image.
    void windowspathreadbackandpreviewed()
    {
        const QString picture = QDir::toNativeSeparators(png(QStringLiteral("scan 1881.png"), 6, 8));
#ifdef Q_OS_WIN
        QVERIFY(picture.at(1) == u':' && picture.contains(u'\\') && !picture.contains(u'/'));
#endif
        const QString file = files_.filepath(QStringLiteral("windowspath.ged"));
        writefile(file, "0 HEAD\r\n1 CHAR UTF-8\r\n0 @O1@ OBJE\r\n1 FORM png\r\n1 TITL Leeds CENSUS 1881\r\n1 _FILE "
                            + picture.toStdString() + "\r\n0 TRLR\r\n");
        const auto ix = load(file);
        QVERIFY(ix);
        QCOMPARE(qs(ix->objects.at(0).file), picture);
        scriptedprompts p;
        std::vector<imagechoice> chosen;
        currentimagesfrm f(*ix, p, chosen);
        child<QListWidget>(&f, QStringLiteral("imageslst"))->setCurrentRow(0);
        QCOMPARE(child<QLineEdit>(&f, QStringLiteral("Imageinfotxt2"))->text(), picture);
        const auto* preview = child<imagepreview>(&f, QStringLiteral("imagepreview"));
        QCOMPARE(preview->last(), imagepreview::outcome::shown);
        QCOMPARE(preview->picture().size(), QSize(6, 8));
        QVERIFY(refusenewimage(QDir::fromNativeSeparators(picture), chosen, *ix).contains(QLatin1String("already loaded")));
    }

    // New images: titles offered, numbers after unlinking, refusals, rename.
    void newimages()
    {
        const QString sample = files_.sample();
        const auto ix = load(sample);
        QVERIFY(ix);
        scriptedprompts p;
        auto store = settingsstore::onfile(files_.ini());
        settings s = runsettings();
        imagerequest r;
        r.sourcetitle = QStringLiteral("Census 1881 Leeds RG11/1 (Smith)");
        r.sourcebase = r.sourcetitle;
        r.referencebase = QStringLiteral("RG11/1");
        r.imagedate = QStringLiteral("3 APR 1881");
        imagesfrm f(r, *ix, s, *store, p);
        f.show();
        QCOMPARE(accessiblename(child<QLabel>(&f, QStringLiteral("sourcetitlelab"))), r.sourcetitle);
        auto* list = child<QListWidget>(&f, QStringLiteral("newimageslst"));
        QVERIFY(!button(&f, "okbut")->isEnabled());
        button(&f, "helpbut")->click();

        const QString one = png(QStringLiteral("one.png"), 8, 6), two = png(QStringLiteral("two.png"), 6, 8),
                      three = png(QStringLiteral("three.png"), 5, 5);
        dialoganswers answers;
        // The titles offered for the first file.
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            QVERIFY(!button(d, "addbut")->isEnabled());
            p.expectfile(one);
            button(d, "choosefilebut")->click();
            QCOMPARE(child<QLineEdit>(d, QStringLiteral("titletxt0"))->text(), QStringLiteral("one"));
            QCOMPARE(child<QLineEdit>(d, QStringLiteral("titletxt1"))->text(), r.sourcebase);
            QCOMPARE(child<QLineEdit>(d, QStringLiteral("titletxt2"))->text(), QStringLiteral("Type your own title here..."));
            QCOMPARE(child<QLineEdit>(d, QStringLiteral("titletxt3"))->text(), QStringLiteral("RG11/1"));
            // The own title stays the prompt: refused, the dialog stays open.
            child<QRadioButton>(d, QStringLiteral("titleopt2"))->click();
            p.expect(answer::ok, QStringLiteral("You have selected the option to create your own custom title, but have "
                                                "not typed a title in yet."));
            button(d, "addbut")->click();
            QVERIFY(d->isVisible());
            child<QRadioButton>(d, QStringLiteral("titleopt1"))->click();
            button(d, "addbut")->click();
        });
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, two, 1));
        button(&f, "Addnewbut")->click();
        button(&f, "Addnewbut")->click();
        QCOMPARE(rows(list), (QStringList{QStringLiteral("1: Census 1881 Leeds RG11/1 (Smith)"),
                                          QStringLiteral("2: Census 1881 Leeds RG11/1 (Smith) 2")}));
        QCOMPARE(list->currentRow(), 1);
        QCOMPARE(child<imagepreview>(&f, QStringLiteral("imagepreview"))->picture().size(), QSize(6, 8));

        // Unlinking the first: the next new image is numbered 3 and takes O5.
        list->setCurrentRow(0);
        button(&f, "unlinkbut")->click();
        QCOMPARE(rows(list), QStringList{QStringLiteral("1: Census 1881 Leeds RG11/1 (Smith) 2")});
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, three, 1));
        button(&f, "Addnewbut")->click();
        QCOMPARE(f.chosen().back().titlenumber, 3);
        QCOMPARE(f.chosen().back().objectid, 5);

        // A refusal keeps the dialog as it was (the refusals themselves: the
        // image choices' own tests).
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            p.expectfile(QDir::toNativeSeparators(two));
            p.expect(answer::ok, QStringLiteral("already been selected"));
            button(d, "choosefilebut")->click();
            QCOMPARE(child<QLineEdit>(d, QStringLiteral("filenametxt"))->text(), QString());
            button(d, "helpbut")->click();
            button(d, "cancelbut")->click();
        });
        button(&f, "Addnewbut")->click();
        QCOMPARE(f.chosen().size(), size_t(2));
        QCOMPARE(p.helpshown, (QStringList{QStringLiteral("18"), QStringLiteral("23")}));

        // Renamed to its own title; the choices are remembered.
        const QString scan = png(QStringLiteral("IMG_0042.png"), 4, 4);
        answers.expect(QStringLiteral("newimagefrm"), addnew(p, scan, 2, QStringLiteral("Smith: 1881?"), true));
        button(&f, "Addnewbut")->click();
        const QString renamed = QDir::toNativeSeparators(files_.filepath(QStringLiteral("Smith_ 1881_.png")));
        QCOMPARE(f.chosen().back().file, renamed);
        QCOMPARE(f.chosen().back().title, QStringLiteral("Smith: 1881?"));
        QVERIFY(QFile::exists(renamed) && !QFile::exists(scan)); // the log's line: the image choices' tests

        // The next dialog opens with the own-title option and rename ticked.
        answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            QVERIFY(child<QRadioButton>(d, QStringLiteral("titleopt2"))->isChecked());
            QVERIFY(child<QCheckBox>(d, QStringLiteral("renamechk"))->isChecked());
            button(d, "cancelbut")->click();
        });
        button(&f, "Addnewbut")->click();
        QCOMPARE(answers.unexpected, 0);
        QCOMPARE(answers.pending(), 0);
        QCOMPARE(p.unexpected(), 0);
    }

    // The title option remembered, when the reference title is unavailable;
    // "Do not attach image(s)" gives no images and lets the save go on.
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
            QCOMPARE(button(&f, "Cancelcensusbut")->isVisibleTo(&f), context == 1);
            dialoganswers answers;
            // Read while open, compared once it has closed.
            bool reference = true, option = false, rename = false, ownreadonly = false, namereadonly = false;
            QString referencetext;
            const int expected = context == 2 ? 2 : 0;
            answers.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
                const auto* frame = child<QGroupBox>(d, QStringLiteral("imageframe"));
                reference = child<QRadioButton>(d, QStringLiteral("titleopt3"))->isEnabledTo(frame);
                referencetext = child<QLineEdit>(d, QStringLiteral("titletxt3"))->text();
                option = child<QRadioButton>(d, QStringLiteral("titleopt%1").arg(expected))->isChecked();
                rename = child<QCheckBox>(d, QStringLiteral("renamechk"))->isEnabledTo(frame);
                ownreadonly = child<QLineEdit>(d, QStringLiteral("titletxt2"))->isReadOnly();
                namereadonly = child<QLineEdit>(d, QStringLiteral("titletxt0"))->isReadOnly();
                button(d, "cancelbut")->click();
            });
            button(&f, "Addnewbut")->click();
            QCOMPARE(answers.pending(), 0);
            QVERIFY(!reference);
            QCOMPARE(referencetext, QStringLiteral("No reference for this census was specified"));
            QVERIFY(option);
            QCOMPARE(rename, expected != 0);
            QCOMPARE(ownreadonly, expected != 2);
            QVERIFY(namereadonly);
            QVERIFY(f.chosen().empty());
        }

        std::vector<imagechoice> chosen{imagechoice{}};
        dialoganswers answers;
        answers.expect(QStringLiteral("imagesfrm"), [&](QDialog* d) {
            dialoganswers inner;
            inner.expect(QStringLiteral("currentimagesfrm"), [](QDialog* c) {
                child<QListWidget>(c, QStringLiteral("imageslst"))->setCurrentRow(1);
                button(c, "okbut")->click();
            });
            button(d, "addcurrentimagebut")->click();
            QVERIFY(button(d, "okbut")->isEnabled());
            button(d, "cancelbut")->click();
        });
        QVERIFY(imagesfrm::choose(imagerequest{}, *ix, s, *store, p, chosen, nullptr));
        QCOMPARE(answers.pending(), 0);
        QVERIFY(chosen.empty());
        QCOMPARE(p.unexpected(), 0);
    }

    // Saving an entry with a new and an existing image: the new one gets its
    // multimedia record, titled from the form of each method; "Cancel saving
    // census" writes nothing.
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
            answers.expect(QStringLiteral("imagesfrm"), [](QDialog* d) { button(d, "Cancelcensusbut")->click(); });
            button(&w, "addbut")->click();
            QCOMPARE(answers.seen, QStringList{QStringLiteral("imagesfrm")});
            QCOMPARE(readfile(file), before);
            QCOMPARE(w.household().selectioncount, 1);

            const QString scan = png(QStringLiteral("page%1.png").arg(full), 10, 10);
            QStringList listed;
            int nested = -1;
            answers.expect(QStringLiteral("imagesfrm"), [&](QDialog* d) {
                // Dialogs opened from this one are answered while its answer runs.
                dialoganswers inner;
                inner.expect(QStringLiteral("newimagefrm"), addnew(run->prompts, scan, 1));
                inner.expect(QStringLiteral("currentimagesfrm"), [](QDialog* c) {
                    child<QListWidget>(c, QStringLiteral("imageslst"))->setCurrentRow(0);
                    button(c, "okbut")->click();
                });
                button(d, "Addnewbut")->click();
                button(d, "addcurrentimagebut")->click();
                listed = rows(child<QListWidget>(d, QStringLiteral("newimageslst")));
                nested = inner.unexpected + inner.pending();
                button(d, "okbut")->click();
            });
            button(&w, "addbut")->click();
            QCOMPARE(nested, 0);
            QCOMPARE(listed.size(), 2);
            QCOMPARE(answers.unexpected, 0);
            QCOMPARE(answers.pending(), 0);
            QCOMPARE(run->prompts.unexpected(), 0);

            const QString text = readtext(file);
            const QString title = full ? QStringLiteral("Census 1881 Hebden Bridge, Yorkshire, England RG11/4426/52")
                                       : QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth) (folio 23)");
            QVERIFY2(text.contains(QStringLiteral("0 @O3@ OBJE\r\n1 FORM png\r\n1 TITL ") + title
                                   + QStringLiteral("\r\n1 _FILE ") + QDir::toNativeSeparators(scan)
                                   + QStringLiteral("\r\n1 _DATE 3 APR 1881\r\n")),
                     qPrintable(text.right(900)));
            // Where each method links the images, and the log's lines: the
            // rewrite's golden files and the census log's tests.
            QCOMPARE(w.household().selectioncount, 0);
        }
    }
};

QTEST_MAIN(imagesfrmtest)
#include "imagesfrm_test.moc"

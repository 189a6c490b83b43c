// Attach Images to Existing Sources: the source list and its filters, the
// selected source's details, attaching (with the Census Images dialog stood in
// for) and its refusals, then the whole road from the main window's Tools menu
// through the real image dialogs. Which sources each filter keeps, and the
// index after an attach: sourcedates_test.
#include "images/attachimagesfrm.h"

#include "images/imagechoices.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "support/dialogs.h"
#include "support/mainfrmfixture.h"

#include <QAction>
#include <QCheckBox>
#include <QImage>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

const QString s5 = QStringLiteral("Census 1871 Hebden Bridge RG10/4387/62 (John Ashworth)");

std::vector<int32_t> linked(const gedcomindex& ix, size_t source)
{
    return {ix.sources[source].objectids.begin(), ix.sources[source].objectids.end()};
}

} // namespace

class attachimagesfrm_test : public QObject {
    Q_OBJECT

    windowfiles files_;
    int runs_ = 0;

    settings testsettings()
    {
        settings s = defaultsettings();
        const QString folder = files_.filepath(QStringLiteral("run%1").arg(++runs_));
        QDir().mkpath(folder + QStringLiteral("/backups"));
        s.backupfolder = folder + QStringLiteral("/backups");
        s.logpath = folder + QStringLiteral("/censuslog.txt");
        return s;
    }
    static int backups(const settings& s)
    {
        return static_cast<int>(QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files).size());
    }

    QString png(const char* name)
    {
        const QString path = files_.filepath(QString::fromLatin1(name));
        QImage image(24, 16, QImage::Format_RGB32);
        image.fill(Qt::darkCyan);
        return image.save(path) ? QDir::toNativeSeparators(path) : QString();
    }

    struct loaded {
        QString file;
        std::unique_ptr<gedcomindex> index;
    };
    loaded sample()
    {
        const QString file = files_.sample();
        return {file, loadgedcom(file, {}).index};
    }

    // Stands in for the Census Images dialog: one new image of the source's
    // title, numbered like the dialog numbers it, and the 1881 page (O2).
    static Attachimagesfrm::imagechooser fakechooser(const gedcomindex& ix, const QString& image, int* calls,
                                                     QString* date = nullptr)
    {
        return [&ix, image, calls, date](const QString& title, const QString& imagedate, QWidget*) {
            ++*calls;
            if (date)
                *date = imagedate;
            std::vector<imagechoice> chosen;
            int32_t next = firstobjectbase(ix);
            addnewimage(chosen, next, image, title.trimmed(), 1, imagedate);
            addexistingimage(chosen, ix.objects[1]);
            return chosen;
        };
    }

private slots:
    void initTestCase() { QVERIFY(files_.valid()); }

    // The source list, its filters and search, and the selected source.
    void sourcelist()
    {
        loaded x = sample();
        QVERIFY(x.index);
        const settings s = testsettings();
        scriptedprompts p;
        Attachimagesfrm d(*x.index, s, p, {});
        d.show();
        auto* list = child<QListWidget>(&d, "sourcelst");
        auto* search = child<QLineEdit>(&d, "searchtxt");
        auto* searchbut = child(&d, "searchbut");

        // Census sources at first; without images; all sources; all with or without.
        QVERIFY(child(&d, "sourceopt1")->isChecked() && !searchbut->isEnabled());
        QList<int> counts{list->count()};
        press(&d, "imagecountchk");
        counts << list->count();
        press(&d, "sourceopt0");
        counts << list->count();
        press(&d, "imagecountchk");
        counts << list->count();
        QCOMPARE(counts, (QList<int>{9, 7, 9, 11}));

        // Typing chooses the text option; the list waits for Search; Return in
        // the box searches, and does not close the dialog.
        QTest::keyClicks(search, QStringLiteral("  HEBDEN bridge  "));
        QVERIFY(child(&d, "sourceopt2")->isChecked() && searchbut->isEnabled() && list->count() == 11);
        searchbut->click();
        QCOMPARE(list->count(), 6);
        search->setText(QStringLiteral("certificate"));
        QTest::keyClick(search, Qt::Key_Return);
        QVERIFY(d.isVisible());
        QCOMPARE(rows(list), QStringList{"Birth certificate, Frederick Ashworth, 1881"});
        QCOMPARE(child<QLabel>(&d, "countlab")->text(), QStringLiteral("1 source"));

        // Another option empties the search text.
        press(&d, "sourceopt1");
        QVERIFY(search->text().isEmpty() && !searchbut->isEnabled() && list->count() == 9);

        // The selected source's details; Attach waits for a selection.
        QVERIFY(!child(&d, "attachbut")->isEnabled());
        QVERIFY(pick(list, QStringLiteral("Census 1881 Hebden Bridge")));
        QStringList details;
        for (const char* box : {"titletxt", "indextxt", "Datetxt"})
            details << child<QLineEdit>(&d, box)->text();
        QCOMPARE(details, (QStringList{"Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth)", "7", "3 APR 1881"}));
        QCOMPARE(rows(&d, "imagelst"), QStringList{"Census 1881 Hebden Bridge"});
        QCOMPARE(rows(&d, "individualslst").filter(QStringLiteral("Ashworth, John")).size(), 1);
        QVERIFY(child(&d, "attachbut")->isEnabled());
        QVERIFY(pick(list, s5));
        QCOMPARE(rows(&d, "imagelst").size(), 0);

        press(&d, "helpbut");
        QCOMPARE(p.helpshown, QStringList{"19"});
        QVERIFY(answered(p));
    }

    // Two attaches in one opening: the file is rewritten each time, the index
    // follows, and the second new image gets the next number.
    void attachtwice()
    {
        loaded x = sample();
        settings s = testsettings();
        s.asid = true;
        scriptedprompts p;
        int calls = 0;
        QString date;
        const QString page = png("page62.png");
        Attachimagesfrm d(*x.index, s, p, fakechooser(*x.index, page, &calls, &date));
        d.show();
        auto* list = child<QListWidget>(&d, "sourcelst");
        press(&d, "imagecountchk");
        QCOMPARE(list->count(), 7);

        QVERIFY(pick(list, s5));
        press(&d, "attachbut");
        QVERIFY(calls == 1 && date == QStringLiteral("2 APR 1871") && d.imagesattached());
        QCOMPARE(backups(s), 1);
        const QString record = QStringLiteral("0 @O3@ OBJE\r\n1 FORM png\r\n1 TITL ") + s5 + QStringLiteral("\r\n1 _FILE ")
                             + page + QStringLiteral("\r\n1 _DATE 2 APR 1871\r\n");
        const std::string text = readfile(x.file);
        QVERIFY(text.find(record.toStdString()) != std::string::npos);
        // Linked to the source chosen, in the order chosen (_ASID: the rewrite's golden files).
        const size_t source = text.find("1 TITL " + s5.toStdString() + "\r\n");
        QVERIFY(source != std::string::npos);
        QVERIFY(text.find("1 OBJE @O3@\r\n2 _ASID 1\r\n1 OBJE @O2@\r\n", source) < text.find("\r\n0 @", source));

        // The index: the new record, both links, the new stamp; the details
        // cleared and the source gone from the list.
        QVERIFY(linked(*x.index, 4) == (std::vector<int32_t>{3, 2}) && !filechanged(*x.index));
        QVERIFY(child<QLineEdit>(&d, "titletxt")->text().isEmpty() && !child(&d, "attachbut")->isEnabled());
        QVERIFY(list->count() == 6 && !pick(list, s5));

        // Again, on another source.
        QVERIFY(pick(list, QStringLiteral("Census 1841")));
        press(&d, "attachbut");
        QVERIFY(calls == 2 && answered(p) && backups(s) == 2);
        QVERIFY(readfile(x.file).find("0 @O4@ OBJE\r\n") != std::string::npos);
        QVERIFY(linked(*x.index, 0) == (std::vector<int32_t>{4, 2}));
    }

    // Changed by another program while the images are chosen: nothing is
    // written and the dialog closes. (A change before choosing: frommainwindow.)
    void outsidechange()
    {
        loaded x = sample();
        const settings s = testsettings();
        scriptedprompts p;
        int calls = 0;
        const Attachimagesfrm::imagechooser inner = fakechooser(*x.index, png("page.png"), &calls);
        const auto chooser = [&](const QString& title, const QString& date, QWidget* parent) {
            replaceinfile(x.file, "1 NAME Sample Family File", "1 NAME Another Family File");
            return inner(title, date, parent);
        };
        Attachimagesfrm d(*x.index, s, p, chooser);
        d.show();
        QVERIFY(pick(child<QListWidget>(&d, "sourcelst"), s5));
        p.expect(answer::ok, QDir::toNativeSeparators(x.file) + QStringLiteral(
                                 " has been modified by another application. Images will not be attached to this "
                                 "source and new images will not be added as a precaution to ensure there is no "
                                 "data loss. This form will now close and the file will be reloaded."));
        press(&d, "attachbut");
        QVERIFY(answered(p) && calls == 1);
        QVERIFY(!d.isVisible() && d.filechanged() && !d.imagesattached());
        QVERIFY(readfile(x.file).find("@O3@") == std::string::npos);
        QCOMPARE(backups(s), 0);
    }

    // Attaches that write nothing and leave the dialog open: only an image
    // already linked to the source was chosen (left out with a word to the
    // user), or a backup that cannot be made.
    void nothingwritten()
    {
        for (const bool nobackup : {false, true}) {
            loaded x = sample();
            settings s = testsettings();
            if (nobackup)
                s.backupfolder = files_.filepath(QStringLiteral("no such folder"));
            scriptedprompts p;
            int calls = 0;
            const auto onlyo2 = [&](const QString&, const QString&, QWidget*) {
                ++calls;
                std::vector<imagechoice> chosen;
                addexistingimage(chosen, x.index->objects[1]);
                return chosen;
            };
            Attachimagesfrm d(*x.index, s, p,
                              nobackup ? fakechooser(*x.index, png("page.png"), &calls) : Attachimagesfrm::imagechooser(onlyo2));
            d.show();
            QVERIFY(pick(child<QListWidget>(&d, "sourcelst"), nobackup ? s5 : QStringLiteral("Census 1881 Hebden Bridge")));
            const std::string before = readfile(x.file);
            p.expect(answer::ok, nobackup ? QString()
                                          : QStringLiteral("The image 'Census 1881 Hebden Bridge' (ID: 2) is already "
                                                           "attached to this source, so it is not attached again."));
            press(&d, "attachbut");
            QVERIFY(calls == 1 && answered(p));
            QVERIFY(d.isVisible() && !d.imagesattached());
            QCOMPARE(readfile(x.file), before);
            QVERIFY(x.index->sources[4].objectids.empty());
        }
    }

    // From the Tools menu through the real Census Images dialogs: a new image
    // and the 1881 page attached to the 1871 source, the file rewritten and
    // read again; then a change made by another program refuses the attach,
    // and a failed rewrite ends the program.
    void frommainwindow()
    {
        const QString file = files_.sample();
        const settings s = testsettings();
        auto run = files_.opened(file, &s);
        QVERIFY(run);
        mainfrm& w = *run->w;
        const QString page = png("page62.png");
        auto* menu = w.findChild<QAction*>(QStringLiteral("attachbut"));
        QVERIFY(!page.isEmpty() && menu && menu->isEnabled());

        dialoganswers dialogs;
        // Each opening of Attach Images runs `f` once the dialog is up.
        const auto attach = [&](std::function<void(QDialog*)> f) {
            dialogs.expect(QStringLiteral("Attachimagesfrm"), [f](QDialog* d) { QTimer::singleShot(0, d, [f, d] { f(d); }); });
        };
        const auto imagesfrm = [&](bool addnew) {
            dialogs.expect(QStringLiteral("imagesfrm"), [addnew](QDialog* d) {
                QTimer::singleShot(0, d, [d, addnew] {
                    press(d, "addcurrentimagebut");
                    if (addnew)
                        press(d, "Addnewbut");
                    press(d, "okbut");
                });
            });
            dialogs.expect(QStringLiteral("currentimagesfrm"), [](QDialog* d) {
                pick(child<QListWidget>(d, "imageslst"), QStringLiteral("Census 1881 Hebden Bridge"));
                press(d, "okbut");
            });
        };
        const auto closed = [&] {
            QTRY_COMPARE(dialogs.pending(), 0);
            QVERIFY(answered(dialogs) && answered(run->prompts));
        };

        QString datetxt;
        std::vector<int32_t> before;
        bool watched = true;
        attach([&](QDialog* d) {
            watched = w.watching();
            if (pick(child<QListWidget>(d, "sourcelst"), s5)) {
                datetxt = child<QLineEdit>(d, "Datetxt")->text();
                press(d, "attachbut"); // waits for the Census Images dialog
            }
            before = linked(*w.index(), 4);
            press(d, "okbut");
        });
        imagesfrm(true);
        dialogs.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            run->prompts.expectfile(page);
            press(d, "choosefilebut");
            press(d, "titleopt1");
            child<QCheckBox>(d, "renamechk")->setChecked(false);
            press(d, "addbut");
        });
        menu->trigger();
        closed();
        QVERIFY(!watched && w.watching());
        QCOMPARE(datetxt, QStringLiteral("2 APR 1871"));
        // The index was brought up to date before the dialog closed, and the
        // file read again afterwards (the records written: attachtwice).
        QVERIFY(before == (std::vector<int32_t>{2, 3}) && linked(*w.index(), 4) == before);
        QVERIFY(backups(s) == 1 && w.index()->maxobjectid == 3);

        // Another program changes the file while the dialog is open: nothing
        // is written, and the file is read again.
        attach([&](QDialog* d) {
            pick(child<QListWidget>(d, "sourcelst"), QStringLiteral("Census 1841"));
            replaceinfile(file, "1 NAME Sample Family File", "1 NAME Changed Elsewhere");
            run->prompts.expect(answer::ok, QStringLiteral("Images will not be attached to this source"));
            press(d, "attachbut");
        });
        menu->trigger();
        closed();
        QVERIFY(readfile(file).find("1 NAME Changed Elsewhere") != std::string::npos && backups(s) == 1);
        QVERIFY(!filechanged(*w.index()) && w.index()->sources[0].objectids.empty());

        // A rewrite that fails: its message, the file as it was, and the program ends.
        const std::string unchanged = readfile(file);
        attach([&](QDialog* d) {
            pick(child<QListWidget>(d, "sourcelst"), QStringLiteral("Census 1841"));
            run->prompts.expect(answer::ok, QStringLiteral("An error occurred"));
            setinputfaultfortests(true);
            press(d, "attachbut");
            setinputfaultfortests(false);
        });
        imagesfrm(false);
        menu->trigger();
        closed();
        QCOMPARE(run->prompts.history().back().m.kind, icon::critical);
        QVERIFY(!w.isVisible());
        QCOMPARE(readfile(file), unchanged);
    }
};

QTEST_MAIN(attachimagesfrm_test)
#include "attachimagesfrm_test.moc"

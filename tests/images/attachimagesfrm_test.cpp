// Attach Images to Existing Sources: the source list and its filters, the
// selected source's details, attaching (with the Census Images dialog stood in
// for) and its refusals, then the whole road from the main window's Tools menu
// through the real image dialogs.
#include "images/attachimagesfrm.h"

#include "images/imagechoices.h"
#include "model/filechanged.h"
#include "model/loadgedcom.h"
#include "platform/scriptedprompts.h"
#include "settings/settings.h"
#include "writer/saveroad.h"
#include "support/mainfrmfixture.h"
#include "support/testfiles.h"

#include <QAction>
#include <QCheckBox>
#include <QDir>
#include <QImage>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest>

using namespace qm;
using namespace qmtest;

namespace {

template <class T>
T* child(const QWidget& w, const char* name)
{
    T* c = w.findChild<T*>(QString::fromLatin1(name));
    if (!c)
        qWarning("no control %s", name);
    return c;
}

QStringList rows(const QListWidget* l)
{
    QStringList out;
    for (int i = 0; i < l->count(); ++i)
        out << l->item(i)->text();
    return out;
}

// Selects the row of the list whose text begins with `start`.
bool pick(QListWidget* l, const QString& start)
{
    for (int i = 0; i < l->count(); ++i) {
        if (l->item(i)->text().startsWith(start)) {
            l->setCurrentRow(i);
            return true;
        }
    }
    return false;
}

const QString s5 = QStringLiteral("Census 1871 Hebden Bridge RG10/4387/62 (John Ashworth)");

} // namespace

class attachimagesfrm_test : public QObject {
    Q_OBJECT

private:
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
    static QStringList backups(const settings& s) { return QDir(s.backupfolder).entryList({QStringLiteral("QM Backup*")}, QDir::Files); }

    // A small PNG beside the family files.
    QString png(const char* name)
    {
        const QString path = files_.filepath(QString::fromLatin1(name));
        QImage image(24, 16, QImage::Format_RGB32);
        image.fill(Qt::darkCyan);
        return image.save(path) ? QDir::toNativeSeparators(path) : QString();
    }

    // The sample, loaded.
    struct loaded {
        QString file;
        std::unique_ptr<gedcomindex> index;
    };
    loaded sample()
    {
        loaded r;
        r.file = files_.sample();
        r.index = loadgedcom(r.file, {}).index;
        return r;
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
        auto* list = child<QListWidget>(d, "sourcelst");
        auto* count = child<QLabel>(d, "countlab");
        auto* search = child<QLineEdit>(d, "searchtxt");
        auto* searchbut = child<QPushButton>(d, "searchbut");
        auto* noimages = child<QCheckBox>(d, "imagecountchk");

        // Census sources at first: 9 of the 11.
        QVERIFY(child<QRadioButton>(d, "sourceopt1")->isChecked());
        QCOMPARE(list->count(), 9);
        QCOMPARE(count->text(), QStringLiteral("9 sources"));
        QVERIFY(!searchbut->isEnabled());
        noimages->click();
        QCOMPARE(list->count(), 7);
        child<QRadioButton>(d, "sourceopt0")->click();
        QCOMPARE(list->count(), 9);
        noimages->click();
        QCOMPARE(list->count(), 11);

        // Typing chooses the text option; the list waits for Search.
        QTest::keyClicks(search, QStringLiteral("  HEBDEN bridge  "));
        QVERIFY(child<QRadioButton>(d, "sourceopt2")->isChecked());
        QVERIFY(searchbut->isEnabled());
        QCOMPARE(list->count(), 11);
        searchbut->click();
        QCOMPARE(list->count(), 6);
        // Return in the search box searches, and does not close the dialog.
        search->setText(QStringLiteral("certificate"));
        QTest::keyClick(search, Qt::Key_Return);
        QVERIFY(d.isVisible());
        QCOMPARE(rows(list), QStringList{QStringLiteral("Birth certificate, Frederick Ashworth, 1881")});
        QCOMPARE(count->text(), QStringLiteral("1 source"));

        // Another option empties the search text.
        child<QRadioButton>(d, "sourceopt1")->click();
        QCOMPARE(search->text(), QString());
        QVERIFY(!searchbut->isEnabled());
        QCOMPARE(list->count(), 9);

        // The selected source's details; Attach waits for a selection.
        QVERIFY(!child<QPushButton>(d, "attachbut")->isEnabled());
        QVERIFY(pick(list, QStringLiteral("Census 1881 Hebden Bridge")));
        QCOMPARE(child<QLineEdit>(d, "titletxt")->text(), QStringLiteral("Census 1881 Hebden Bridge RG11/4426/88 (John Ashworth)"));
        QCOMPARE(child<QLineEdit>(d, "indextxt")->text(), QStringLiteral("7"));
        QCOMPARE(child<QLineEdit>(d, "Datetxt")->text(), QStringLiteral("3 APR 1881"));
        QCOMPARE(rows(child<QListWidget>(d, "imagelst")), QStringList{QStringLiteral("Census 1881 Hebden Bridge")});
        QCOMPARE(rows(child<QListWidget>(d, "individualslst")).filter(QStringLiteral("Ashworth, John")).size(), 1);
        QVERIFY(child<QPushButton>(d, "attachbut")->isEnabled());

        QVERIFY(pick(list, s5));
        QCOMPARE(child<QListWidget>(d, "imagelst")->count(), 0);

        child<QPushButton>(d, "helpbut")->click();
        QCOMPARE(p.helpshown, QStringList{QStringLiteral("19")});
        QCOMPARE(p.unexpected(), 0);
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
        auto* list = child<QListWidget>(d, "sourcelst");
        child<QCheckBox>(d, "imagecountchk")->click();
        QCOMPARE(list->count(), 7);

        QVERIFY(pick(list, s5));
        child<QPushButton>(d, "attachbut")->click();
        QCOMPARE(calls, 1);
        QCOMPARE(date, QStringLiteral("2 APR 1871"));
        QVERIFY(d.imagesattached());
        QCOMPARE(p.unexpected(), 0);
        QCOMPARE(backups(s).size(), 1);
        const QStringList lines = QString::fromStdString(readfile(x.file)).split(QStringLiteral("\r\n"));
        const qsizetype at = lines.indexOf(QStringLiteral("1 TITL ") + s5);
        QVERIFY(at > 0);
        QCOMPARE(lines.mid(at).indexOf(QStringLiteral("1 OBJE @O3@")) + 2, lines.mid(at).indexOf(QStringLiteral("1 OBJE @O2@")));
        const qsizetype o3 = lines.indexOf(QStringLiteral("0 @O3@ OBJE"));
        QVERIFY(o3 > 0);
        QCOMPARE(lines.mid(o3 + 1, 4), (QStringList{QStringLiteral("1 FORM png"), QStringLiteral("1 TITL ") + s5,
                                                     QStringLiteral("1 _FILE ") + page, QStringLiteral("1 _DATE 2 APR 1871")}));

        // The index: the new record, both links, the new stamp.
        const sourcerec& source = x.index->sources[4];
        QVERIFY(source.objectids == (std::vector<int32_t>{3, 2}));
        QVERIFY(!filechanged(*x.index));

        // The details are cleared and the source has left the list.
        QCOMPARE(child<QLineEdit>(d, "titletxt")->text(), QString());
        QVERIFY(!child<QPushButton>(d, "attachbut")->isEnabled());
        QCOMPARE(list->count(), 6);
        QVERIFY(!pick(list, s5));

        // Again, on another source.
        QVERIFY(pick(list, QStringLiteral("Census 1841")));
        child<QPushButton>(d, "attachbut")->click();
        QCOMPARE(calls, 2);
        QCOMPARE(p.unexpected(), 0);
        const std::string now = readfile(x.file);
        QVERIFY(now.find("0 @O4@ OBJE\r\n") != std::string::npos);
        QVERIFY(now.find("1 OBJE @O4@\r\n2 _ASID 1\r\n1 OBJE @O2@\r\n") != std::string::npos);
        QCOMPARE(backups(s).size(), 2);
        QVERIFY(x.index->sources[0].objectids == (std::vector<int32_t>{4, 2}));
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
        const QString file = x.file;
        const auto chooser = [&](const QString& title, const QString& date, QWidget* parent) {
            replaceinfile(file, "1 NAME Sample Family File", "1 NAME Another Family File");
            return inner(title, date, parent);
        };
        Attachimagesfrm d(*x.index, s, p, chooser);
        d.show();
        QVERIFY(pick(child<QListWidget>(d, "sourcelst"), s5));
        p.expect(answer::ok, QDir::toNativeSeparators(file) + QStringLiteral(
                                 " has been modified by another application. Images will not be attached to this "
                                 "source and new images will not be added as a precaution to ensure there is no "
                                 "data loss. This form will now close and the file will be reloaded."));
        child<QPushButton>(d, "attachbut")->click();
        QCOMPARE(p.unexpected(), 0);
        QCOMPARE(calls, 1);
        QVERIFY(!d.isVisible());
        QVERIFY(d.filechanged());
        QVERIFY(!d.imagesattached());
        QVERIFY(readfile(file).find("@O3@") == std::string::npos);
        QVERIFY(backups(s).isEmpty());
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
            QVERIFY(pick(child<QListWidget>(d, "sourcelst"), nobackup ? s5 : QStringLiteral("Census 1881 Hebden Bridge")));
            const std::string before = readfile(x.file);
            p.expect(answer::ok, nobackup ? QString()
                                          : QStringLiteral("The image 'Census 1881 Hebden Bridge' (ID: 2) is already "
                                                           "attached to this source, so it is not attached again."));
            child<QPushButton>(d, "attachbut")->click();
            QCOMPARE(calls, 1);
            QCOMPARE(p.unexpected(), 0);
            QVERIFY(d.isVisible());
            QVERIFY(!d.imagesattached());
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
        QVERIFY(!page.isEmpty());
        auto* menu = w.findChild<QAction*>(QStringLiteral("attachbut"));
        QVERIFY(menu && menu->isEnabled());

        dialoganswers dialogs;
        QString datetxt;
        std::vector<int32_t> linked;
        size_t objects = 0;
        bool watched = true;
        dialogs.expect(QStringLiteral("Attachimagesfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [&, d] {
                watched = w.watching();
                if (pick(child<QListWidget>(*d, "sourcelst"), s5)) {
                    datetxt = child<QLineEdit>(*d, "Datetxt")->text();
                    child<QPushButton>(*d, "attachbut")->click(); // waits for the Census Images dialog
                }
                linked.assign(w.index()->sources[4].objectids.begin(), w.index()->sources[4].objectids.end());
                objects = w.index()->objects.size();
                child<QPushButton>(*d, "okbut")->click();
            });
        });
        dialogs.expect(QStringLiteral("imagesfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [d] {
                child<QPushButton>(*d, "addcurrentimagebut")->click();
                child<QPushButton>(*d, "Addnewbut")->click();
                child<QPushButton>(*d, "okbut")->click();
            });
        });
        const auto link1881page = [](QDialog* d) {
            pick(child<QListWidget>(*d, "imageslst"), QStringLiteral("Census 1881 Hebden Bridge"));
            child<QPushButton>(*d, "okbut")->click();
        };
        dialogs.expect(QStringLiteral("currentimagesfrm"), link1881page);
        dialogs.expect(QStringLiteral("newimagefrm"), [&](QDialog* d) {
            run->prompts.expectfile(page);
            child<QPushButton>(*d, "choosefilebut")->click();
            child<QRadioButton>(*d, "titleopt1")->click();
            child<QCheckBox>(*d, "renamechk")->setChecked(false);
            child<QPushButton>(*d, "addbut")->click();
        });
        menu->trigger();
        QTRY_COMPARE(dialogs.pending(), 0);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);
        QVERIFY(!watched);
        QVERIFY(w.watching());
        QCOMPARE(datetxt, QStringLiteral("2 APR 1871"));
        // The index was brought up to date before the dialog closed.
        QVERIFY(linked == (std::vector<int32_t>{2, 3}));
        QCOMPARE(objects, size_t(3));

        // The records written are attachtwice's; here: read again afterwards.
        QCOMPARE(backups(s).size(), 1);
        QVERIFY(w.index()->sources[4].objectids == (std::vector<int32_t>{2, 3}));
        QCOMPARE(w.index()->maxobjectid, 3);

        // Another program changes the file while the dialog is open: nothing
        // is written, and the file is read again.
        dialogs.expect(QStringLiteral("Attachimagesfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [&, d] {
                pick(child<QListWidget>(*d, "sourcelst"), QStringLiteral("Census 1841"));
                replaceinfile(file, "1 NAME Sample Family File", "1 NAME Changed Elsewhere");
                run->prompts.expect(answer::ok, QStringLiteral("Images will not be attached to this source"));
                child<QPushButton>(*d, "attachbut")->click();
            });
        });
        menu->trigger();
        QTRY_COMPARE(dialogs.pending(), 0);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);
        QVERIFY(readfile(file).find("1 NAME Changed Elsewhere") != std::string::npos);
        QCOMPARE(backups(s).size(), 1);
        QVERIFY(!filechanged(*w.index())); // read again
        QVERIFY(w.index()->sources[0].objectids.empty());

        // A rewrite that fails: its message, the file as it was, and the program ends.
        const std::string before = readfile(file);
        dialogs.expect(QStringLiteral("Attachimagesfrm"), [&](QDialog* d) {
            QTimer::singleShot(0, d, [&, d] {
                pick(child<QListWidget>(*d, "sourcelst"), QStringLiteral("Census 1841"));
                run->prompts.expect(answer::ok, QStringLiteral("An error occurred"));
                setinputfaultfortests(true);
                child<QPushButton>(*d, "attachbut")->click();
                setinputfaultfortests(false);
            });
        });
        dialogs.expect(QStringLiteral("imagesfrm"), [](QDialog* d) {
            QTimer::singleShot(0, d, [d] {
                child<QPushButton>(*d, "addcurrentimagebut")->click();
                child<QPushButton>(*d, "okbut")->click();
            });
        });
        dialogs.expect(QStringLiteral("currentimagesfrm"), link1881page);
        menu->trigger();
        QTRY_COMPARE(dialogs.pending(), 0);
        QCOMPARE(dialogs.unexpected, 0);
        QCOMPARE(run->prompts.unexpected(), 0);
        QCOMPARE(run->prompts.history().back().m.kind, icon::critical);
        QVERIFY(!w.isVisible());
        QCOMPARE(readfile(file), before);
    }
};

QTEST_MAIN(attachimagesfrm_test)
#include "attachimagesfrm_test.moc"

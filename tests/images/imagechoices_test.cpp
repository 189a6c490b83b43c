#include "images/imagechoices.h"

#include "log/censuslog.h"
#include "model/gedcomindex.h"
#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "platform/paths.h"
#include "platform/settingsstore.h"
#include "settings/settings.h"
#include "support/readonlyfolder.h"
#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

gedcomindex sampleindex()
{
    loadresult r = loadgedcom(qmtest::samplefile(), flagtable());
    EXPECT_TRUE(r.index);
    return std::move(*r.index);
}

TEST(ImageChoices, FileTypesAndTitlesFromTheFileName)
{
    // A "." of the folder is no type.
    for (const auto& [path, type] : {std::pair{"C:\\Scans\\page.JPG", "jpeg"}, {"/s/page.jpeg", "jpeg"},
                                     {"/s/page.TIFF", "tiff"}, {"/s/page.PNG", "png"}, {"/s/page", ""},
                                     {"/scans.2024/page", ""}})
        EXPECT_EQ(imagefiletype(QString::fromLatin1(path)), QString::fromLatin1(type)) << path;

    EXPECT_EQ(titlefromfilename(QStringLiteral("C:\\Scans\\RG11 4426.52.jpg")), QStringLiteral("RG11 4426.52"));
    EXPECT_EQ(titlefromfilename(QStringLiteral("/s/page")), QStringLiteral("page"));
    EXPECT_EQ(titlefromfilename(QStringLiteral("/s/.hidden")), QStringLiteral(".hidden"));
    EXPECT_EQ(folderof(QStringLiteral("C:\\Scans\\a.jpg")), QStringLiteral("C:\\Scans\\"));
    EXPECT_EQ(folderof(QStringLiteral("/home/ann/a.jpg")), QStringLiteral("/home/ann/"));

    EXPECT_EQ(cleanfilename(QStringLiteral("a:b\\c/d?e*f<g>h|i'j\"k")), QStringLiteral("a_b_c_d_e_f_g_h_i_j_k"));
    EXPECT_EQ(pathrow(QStringLiteral("C:\\a\\census\\1.jpg")), QStringLiteral("...C:\\a\\census\\1.jpg"));
    const QString longpath = QStringLiteral("/x/") + QString(100, u'p') + QStringLiteral(".jpg");
    EXPECT_EQ(pathrow(longpath), QStringLiteral("...") + longpath.right(80));
}

// Two new images for one source are numbered base and base 2; after
// unlinking the first, the next is numbered 3; object numbers never go back.
TEST(ImageChoices, NumberingAndObjectNumbers)
{
    const QString base = QStringLiteral("Census 1881 Leeds");
    std::vector<imagechoice> chosen;
    int32_t next = 2;
    EXPECT_EQ(nexttitlenumber(chosen, base), 1);
    addnewimage(chosen, next, QStringLiteral("/s/a.jpg"), base, nexttitlenumber(chosen, base), QStringLiteral("3 APR 1881"));
    addnewimage(chosen, next, QStringLiteral("/s/b.png"), base, nexttitlenumber(chosen, base), QStringLiteral("3 APR 1881"));
    EXPECT_EQ(fulltitle(chosen[0]), base);
    EXPECT_EQ(fulltitle(chosen[1]), base + QStringLiteral(" 2"));
    EXPECT_EQ(imagerow(2, chosen[1]), QStringLiteral("2: Census 1881 Leeds 2"));
    EXPECT_EQ(chosen[1].objectid, 4);
    EXPECT_EQ(chosen[1].form, QStringLiteral("png"));
    EXPECT_TRUE(chosen[1].isnew);

    chosen.erase(chosen.begin());
    EXPECT_EQ(nexttitlenumber(chosen, base), 3);
    const imagechoice& third = addnewimage(chosen, next, QStringLiteral("/s/c.jpg"), base, 3, QString());
    EXPECT_EQ(third.objectid, 5);
    // Only new images of exactly that title count.
    EXPECT_EQ(nexttitlenumber(chosen, base.toLower()), 1);
    imagechoice old;
    old.title = QStringLiteral("Other");
    old.titlenumber = 7;
    chosen.push_back(old);
    EXPECT_EQ(nexttitlenumber(chosen, QStringLiteral("Other")), 1);
    EXPECT_EQ(fulltitle(QStringLiteral("T"), 0), QStringLiteral("T"));
}

TEST(ImageChoices, RefusalsOfNewAndExistingImages)
{
    const gedcomindex ix = sampleindex();
    ASSERT_EQ(ix.objects.size(), 2u);
    std::vector<imagechoice> chosen;
    EXPECT_EQ(refusenewimage(QStringLiteral("C:\\Tools\\SETUP.EXE"), chosen, ix),
              QStringLiteral("You have selected an application program rather than an image file."));
    EXPECT_EQ(refusenewimage(QStringLiteral("/home/ann/family.Ged"), chosen, ix),
              QStringLiteral("You have selected a GEDCOM family history file rather than an image file."));
    EXPECT_EQ(refusenewimage(QStringLiteral("media\\CENSUS 1881 hebden bridge rg11-4426-88.JPG"), chosen, ix),
              QStringLiteral("This image is already loaded into Family Historian and has the title Census 1881 Hebden "
                             "Bridge. Go back to the previous screen and select the 'Link current image' button"));
    int32_t next = firstobjectbase(ix);
    EXPECT_EQ(next, 2);
    addnewimage(chosen, next, QStringLiteral("/s/Page.jpg"), QStringLiteral("t"), 1, QString());
    EXPECT_EQ(refusenewimage(QStringLiteral("/S/page.JPG"), chosen, ix),
              QStringLiteral("This image has already been selected to be part of this census entry"));
    EXPECT_EQ(refusenewimage(QStringLiteral("/s/other.jpg"), chosen, ix), QString());

    EXPECT_EQ(refuseexistingimage(1, chosen), QString());
    const imagechoice& linked = addexistingimage(chosen, ix.objects[0]);
    EXPECT_EQ(linked.objectid, 1);
    EXPECT_FALSE(linked.isnew);
    EXPECT_EQ(linked.form, QStringLiteral("jpg"));
    EXPECT_EQ(linked.date, QStringLiteral("5 APR 1891"));
    EXPECT_EQ(refuseexistingimage(1, chosen),
              QStringLiteral("This image has already been selected to be linked to the new census source being created "
                             "and therefore can not be selected again."));
    EXPECT_TRUE(mentionscensus(ix.objects[0]));
}

class ImageRename : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        setclockfortests(QDateTime(QDate(2026, 12, 4), QTime(9, 8, 7)));
        s = defaultsettings();
        s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
        QDir(dir.path()).mkdir(QStringLiteral("scans"));
        file = dir.filePath(QStringLiteral("scans/IMG_0001.jpg"));
        qmtest::writefile(file, "jpeg bytes");
    }
    void TearDown() override { setclockfortests(QDateTime()); }

    QTemporaryDir dir;
    settings s;
    QString file;
};

TEST_F(ImageRename, RenamedToTheCleanedTitleAndLogged)
{
    const QString to = dir.filePath(QStringLiteral("scans/Smith_ 1881_.jpg"));
    EXPECT_EQ(renamedpath(file, QStringLiteral("Smith: 1881?")), to);
    const renameresult r = renametotitle(file, QStringLiteral("Smith: 1881?"), s);
    ASSERT_TRUE(r.ok()) << r.message.toStdString();
    EXPECT_TRUE(r.renamed);
    EXPECT_EQ(r.path, to);
    EXPECT_FALSE(QFile::exists(file));
    EXPECT_EQ(qmtest::readfile(to), "jpeg bytes");
    const std::string log = qmtest::readfile(s.logpath);
    EXPECT_EQ(log, std::string(78, '=') + "\r\nImage renamed on: 2026-12-04 09:08:07\r\nFrom: "
                       + QDir::toNativeSeparators(file).toStdString() + "\r\nTo: "
                       + QDir::toNativeSeparators(to).toStdString() + "\r\n");

    // Without "Keep Log" nothing is logged; a name equal but for letter case is no rename.
    s.keeplog = false;
    const renameresult again = renametotitle(to, QStringLiteral("smith_ 1881_"), s);
    EXPECT_TRUE(again.ok());
    EXPECT_FALSE(again.renamed);
    EXPECT_EQ(again.path, to);
    const renameresult third = renametotitle(to, QStringLiteral("Smith 1881"), s);
    EXPECT_TRUE(third.renamed);
    EXPECT_EQ(qmtest::readfile(s.logpath), log);
}

TEST_F(ImageRename, RefusedWhenTheNameIsTakenOrTheRenameFails)
{
    const QString taken = dir.filePath(QStringLiteral("scans/Leeds.jpg"));
    qmtest::writefile(taken, "other");
    const renameresult r = renametotitle(file, QStringLiteral("Leeds"), s);
    EXPECT_FALSE(r.ok());
    EXPECT_EQ(r.message, QStringLiteral("A file with the name '") + taken
                             + QStringLiteral("' already exists and therefore this file can not be renamed to match the "
                                              "current title. Change the title or deselect the rename option and try again."));
    EXPECT_EQ(r.path, file);
    EXPECT_EQ(qmtest::readfile(taken), "other");
    EXPECT_FALSE(QFile::exists(s.logpath));
}

TEST_F(ImageRename, AFailedRenameLeavesTheFileAndTheLogAlone)
{
    const auto refusedwitherror = [](const renameresult& r) {
        return !r.ok() && r.message.startsWith(QLatin1String("An error ("))
            && r.message.endsWith(QLatin1String(") occurred when attempting to rename the file. Check that the file "
                                                "is not currently being edited in another application and that you "
                                                "have permission to rename the file or deselect the rename option "
                                                "and try again."));
    };
    // The file went away after it was chosen.
    const renameresult gone = renametotitle(dir.filePath(QStringLiteral("scans/gone.jpg")), QStringLiteral("Leeds"), s);
    EXPECT_TRUE(refusedwitherror(gone)) << gone.message.toStdString();
    EXPECT_FALSE(QFile::exists(s.logpath));

    renameresult failed;
    {
        const qmtest::readonlyfolder readonly(dir.filePath(QStringLiteral("scans")));
        if (!readonly.ineffective().isEmpty())
            GTEST_SKIP() << readonly.ineffective().toStdString();
        failed = renametotitle(file, QStringLiteral("Halifax"), s);
    }
    EXPECT_TRUE(refusedwitherror(failed)) << failed.message.toStdString();
    EXPECT_TRUE(QFile::exists(file));
    EXPECT_FALSE(QFile::exists(s.logpath));
}

TEST_F(ImageRename, DialogValuesReadBackFromTheStore)
{
    auto store = settingsstore::onfile(dir.filePath(QStringLiteral("s.ini")));
    imagedialogvalues v = readimagevalues(*store, s);
    EXPECT_EQ(v.option, 0);
    EXPECT_FALSE(v.rename);
    saveimagefolder(*store, file);
    saveimagechoice(*store, 3, true);
    v = readimagevalues(*store, s);
    EXPECT_EQ(v.folder, QDir::toNativeSeparators(dir.filePath(QStringLiteral("scans/"))));
    EXPECT_EQ(v.option, 3);
    EXPECT_TRUE(v.rename);
    store->write(QStringLiteral("Image Option"), QStringLiteral("7"));
    store->write(QStringLiteral("Image Folder"), dir.filePath(QStringLiteral("gone")));
    v = readimagevalues(*store, s);
    EXPECT_EQ(v.option, 0);
    EXPECT_EQ(v.folder, QString());
}

} // namespace

// quillmark-cli add-entry with images: new image files and existing
// multimedia records linked to the entry's new source, and the refusals.
#include "support/clirun.h"
#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QJsonDocument>

using qmtest::readfile;
using qmtest::writefile;

namespace {

class CliImages : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        QDir(dir.path()).mkdir(QStringLiteral("scans"));
        ASSERT_TRUE(QFile::copy(qmtest::samplefile(), file));
        QFile(file).setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner);
        before = readfile(file);
        // Each begins as a picture of its type, which is all the tool looks at.
        writefile(scan("a.png"), "\x89PNG\r\n\x1A\nnot really an image");
        writefile(scan("b.jpg"), "\xFF\xD8\xFF\xE0not really an image");
    }

    QString scan(const char* name) const { return dir.filePath(QStringLiteral("scans/") + QString::fromLatin1(name)); }
    static std::string quoted(const QString& path) { return QJsonDocument::fromVariant(QVariantList{path}).toJson(QJsonDocument::Compact).mid(1).chopped(1).toStdString(); }

    using result = qmtest::clitextrun;
    result addentry(const std::string& images)
    {
        const QString entry = dir.filePath(QStringLiteral("entry.json"));
        writefile(entry, R"({"year": 1881, "place": "Hebden Bridge", "reference": "RG11/4426/52",
                             "individuals": [{"id": 11, "age": "28"}], "images": )" + images + "}");
        return cli(QStringLiteral("add-entry"), {file, QStringLiteral("--entry"), entry});
    }

    void expectrefused(const std::string& images, const std::string& message)
    {
        const result r = addentry(images);
        EXPECT_EQ(r.status, 2) << images;
        EXPECT_EQ(r.err, "quillmark-cli: " + message + "\n") << images;
        EXPECT_EQ(readfile(file), before);
    }

    std::string before;
};

TEST_F(CliImages, NewImagesAreNumberedAndRecordedExistingOnesLinked)
{
    const result r = addentry(R"([{"file": )" + quoted(scan("a.png")) + R"(, "title": "Ashworth 1881"},
                                  {"object": 2},
                                  {"file": )" + quoted(scan("b.jpg")) + R"(, "title": " Ashworth 1881 "}])");
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.json().value(QStringLiteral("images")).toInt(), 3);
    const std::string text = readfile(file);
    // The new source links the three in order, the new ones with their _ASID.
    EXPECT_NE(text.find("1 OBJE @O3@\r\n2 _ASID 1\r\n1 OBJE @O2@\r\n1 OBJE @O4@\r\n2 _ASID 1\r\n"), std::string::npos);
    const std::string native = QDir::toNativeSeparators(scan("a.png")).toStdString();
    EXPECT_NE(text.find("0 @O3@ OBJE\r\n1 FORM png\r\n1 TITL Ashworth 1881\r\n1 _FILE " + native
                        + "\r\n1 _DATE 3 APR 1881\r\n"),
              std::string::npos);
    EXPECT_NE(text.find("0 @O4@ OBJE\r\n1 FORM jpeg\r\n1 TITL Ashworth 1881\r\n"), std::string::npos);
    // The existing record gets no second OBJE record.
    EXPECT_EQ(text.find("0 @O2@ OBJE"), text.rfind("0 @O2@ OBJE"));
    const std::string log = readfile(dir.filePath(QStringLiteral("censuslog.txt")));
    EXPECT_NE(log.find("Existing image record linked to the census source: Census 1881 Hebden Bridge"), std::string::npos);
}

TEST_F(CliImages, RefusedImagesWriteNothing)
{
    expectrefused(R"([{"object": 9}])", "there is no multimedia record @O9@ in the family file");
    expectrefused(R"([{"object": 1}, {"object": "1"}])",
                  "This image has already been selected to be linked to the new census source being created and "
                  "therefore can not be selected again.");
    expectrefused(R"([{"file": "Media\\Census 1891 Hebden Bridge RG12-3622-103.JPG"}])",
                  "This image is already loaded into Family Historian and has the title Census 1891 Hebden Bridge. Go "
                  "back to the previous screen and select the 'Link current image' button");
    expectrefused(R"([{"file": )" + quoted(scan("a.png")) + R"(}, {"file": )" + quoted(scan("a.png")) + "}]",
                  "This image has already been selected to be part of this census entry");
    expectrefused(R"([{"file": )" + quoted(scan("gone.png")) + "}]",
                  QDir::toNativeSeparators(scan("gone.png")).toStdString() + ": no such image file");
    expectrefused(R"([{"object": 1, "file": "x.png"}])", "image 1 of the list must have either \"object\" or \"file\"");
    // A file no preview can read, as the Add a new image... dialog refuses it.
    writefile(scan("words.png"), "just words");
    expectrefused(R"([{"file": )" + quoted(scan("words.png")) + "}]",
                  QDir::toNativeSeparators(scan("words.png")).toStdString()
                      + ": A problem occurred when trying to preview this file. (the file does not hold a picture of "
                        "its type)");
    expectrefused(R"({"object": 1})", "\"images\" must be a list");
}

} // namespace

// quillmark-cli attach-images, run as a process on copies of family files.
#include "support/clirun.h"
#include "support/testfiles.h"

#include <QFileInfo>
#include <QJsonArray>

using qmtest::readfile;
using qmtest::writefile;

namespace {

// S1 is cited by two census events of 3 APR 1881; S2 has one image already.
const std::string family = "0 HEAD\r\n1 CHAR ANSI\r\n"
                           "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n2 SOUR @S1@\r\n"
                           "0 @I2@ INDI\r\n1 NAME Mary /Smith/\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n2 SOUR @S1@\r\n"
                           "0 @S1@ SOUR\r\n1 TITL Census 1881 Leeds RG11/4500\r\n"
                           "0 @S2@ SOUR\r\n1 TITL Census 1891 Leeds\r\n1 OBJE @O5@\r\n"
                           "0 @O5@ OBJE\r\n1 FORM jpg\r\n1 TITL Leeds 1891 page\r\n1 _FILE pages/leeds.jpg\r\n"
                           "0 TRLR\r\n";

using run = qmtest::clitextrun;

class CliAttachImages : public qmtest::clitest {
protected:
    void SetUp() override
    {
        clitest::SetUp();
        writefile(file, family);
        qm::settings s = qmtest::clitestsettings(dir.path());
        s.asid = false;
        qmtest::writeclisettings(ini, s);
        page1 = image("page1.png");
        page2 = image("page2.jpg");
    }

    // A file that begins as a picture of its type (all the tool looks at).
    QString image(const char* name)
    {
        const QString path = dir.filePath(QString::fromLatin1(name));
        QDir().mkpath(QFileInfo(path).path());
        const bool png = path.endsWith(QLatin1String(".png"));
        writefile(path, std::string(png ? "\x89PNG\r\n\x1A\n" : "\xFF\xD8\xFF\xE0") + "not really a picture");
        return path;
    }

    run attach(const QStringList& args) const { return cli(QStringLiteral("attach-images"), QStringList{file} + args); }

    // Refused: status 2, the message on standard error, nothing written.
    void expectrefused(const QStringList& args, const std::string& message)
    {
        const run r = attach(args);
        EXPECT_EQ(r.status, 2) << args.join(u' ').toStdString();
        EXPECT_NE(r.err.find(message), std::string::npos) << r.err;
        EXPECT_EQ(r.out, "");
        EXPECT_EQ(readfile(file), family);
        EXPECT_TRUE(backupfolderempty());
    }

    std::string native(const QString& path) const { return QDir::toNativeSeparators(path).toStdString(); }

    QString page1, page2;
};

} // namespace

TEST_F(CliAttachImages, NewFilesAndAnExistingRecord)
{
    const run r = attach({QStringLiteral("--source"), QStringLiteral("S1"), QStringLiteral("--image"), page1,
                          QStringLiteral("--object"), QStringLiteral("@O5@"), QStringLiteral("--image"), page2});
    ASSERT_EQ(r.status, 0) << r.err;
    const QJsonObject j = r.json();
    EXPECT_EQ(j.value(QStringLiteral("new_objects")).toArray(), (QJsonArray{6, 7}));
    EXPECT_EQ(j.value(QStringLiteral("linked_objects")).toArray(), (QJsonArray{5}));
    EXPECT_TRUE(j.value(QStringLiteral("log")).toBool());
    EXPECT_EQ(readfile(j.value(QStringLiteral("backup")).toString()), family);

    const std::string now = readfile(file);
    // The links in the order given, the new records after the last one, titled
    // after the source and numbered, dated with the source's census date.
    EXPECT_NE(now.find("0 @S1@ SOUR\r\n1 TITL Census 1881 Leeds RG11/4500\r\n"
                       "1 OBJE @O6@\r\n1 OBJE @O5@\r\n1 OBJE @O7@\r\n1 CHAN\r\n"),
              std::string::npos)
        << now;
    EXPECT_NE(now.find("0 @O6@ OBJE\r\n1 FORM png\r\n1 TITL Census 1881 Leeds RG11/4500\r\n1 _FILE " + native(page1)
                       + "\r\n1 _DATE 3 APR 1881\r\n"),
              std::string::npos)
        << now;
    EXPECT_NE(now.find("0 @O7@ OBJE\r\n1 FORM jpeg\r\n"), std::string::npos) << now;
    EXPECT_NE(now.find("0 @O5@ OBJE\r\n1 FORM jpg\r\n1 TITL Leeds 1891 page\r\n1 _FILE pages/leeds.jpg\r\n0 @O6@ OBJE"),
              std::string::npos);
}

TEST_F(CliAttachImages, OwnTitle)
{
    const run r = attach({QStringLiteral("--source=1"), QStringLiteral("--image=") + page1 + QStringLiteral("=Leeds page 92")});
    ASSERT_EQ(r.status, 0) << r.err;
    EXPECT_NE(readfile(file).find("1 TITL Leeds page 92\r\n1 _FILE " + native(page1) + "\r\n"), std::string::npos);
}

TEST_F(CliAttachImages, RefusalsWriteNothing)
{
    const QString src = QStringLiteral("--source");
    const QString img = QStringLiteral("--image");
    expectrefused({src, QStringLiteral("9"), img, page1}, "there is no source @S9@");
    expectrefused({src, QStringLiteral("1"), QStringLiteral("--object"), QStringLiteral("8")},
                  "there is no multimedia record @O8@");
    expectrefused({src, QStringLiteral("1"), img, dir.filePath(QStringLiteral("missing.png"))}, "no such image file");
    // "5" and "O5" name one record.
    expectrefused({src, QStringLiteral("1"), QStringLiteral("--object"), QStringLiteral("5"), QStringLiteral("--object"),
                   QStringLiteral("O5")},
                  "This image has already been selected");
    expectrefused({src, QStringLiteral("1"), img, file},
                  "You have selected a GEDCOM family history file rather than an image file.");
    expectrefused({src, QStringLiteral("2"), QStringLiteral("--object"), QStringLiteral("5")},
                  "@O5@ is already attached to the source @S2@");
    expectrefused({src, QStringLiteral("1")}, "attach-images needs");
    expectrefused({src, QStringLiteral("X1"), img, page1}, "--source needs");
    expectrefused({src, QStringLiteral("1"), img}, "--image needs a value");
    // What the Add a new image... dialog refuses: a file no preview can read,
    // and, given by a relative path, the file of a multimedia record.
    const QString text = dir.filePath(QStringLiteral("text.jpg"));
    writefile(text, "just words");
    expectrefused({src, QStringLiteral("1"), img, text}, "A problem occurred when trying to preview this file.");
    const QString record = QDir::current().relativeFilePath(image("pages/leeds.jpg"));
    expectrefused({src, QStringLiteral("1"), img, record},
                  "This image is already loaded into Family Historian and has the title Leeds 1891 page.");
}

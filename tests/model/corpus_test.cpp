// Every family file of the shared corpus loads, with one individual for each
// line beginning "0 @I".
#include "model/loadgedcom.h"

#include "support/testfiles.h"

#include <QDirIterator>
#include <QStringDecoder>

#include <gtest/gtest.h>

namespace {

// Lines beginning "0 @I", counted apart from the loader: the file is decoded
// whole (UTF-16 by its byte-order mark or its "0" followed by a zero byte),
// split at every CR and LF, and a line counts when it begins "0 @I" after any
// spaces and tabs (indented files indent their deeper levels, but a level-0
// line indented the same way is still a record).
int64_t individuallines(const std::string& bytes)
{
    std::string text = bytes;
    const auto b = [&](size_t i) { return i < bytes.size() ? static_cast<unsigned char>(bytes[i]) : 0x100u; };
    std::optional<QStringConverter::Encoding> utf16;
    if ((b(0) == 0xFF && b(1) == 0xFE) || (b(0) == '0' && b(1) == 0))
        utf16 = QStringConverter::Utf16LE;
    else if ((b(0) == 0xFE && b(1) == 0xFF) || (b(0) == 0 && b(1) == '0'))
        utf16 = QStringConverter::Utf16BE;
    if (utf16) {
        QStringDecoder d(*utf16);
        const QString s = d.decode(QByteArrayView(bytes.data(), static_cast<qsizetype>(bytes.size())));
        text = s.toStdString();
    }
    int64_t count = 0;
    size_t start = 0;
    while (start <= text.size()) {
        size_t end = text.find_first_of("\r\n", start);
        if (end == std::string::npos)
            end = text.size();
        size_t i = start;
        while (i < end && (text[i] == ' ' || text[i] == '\t'))
            ++i;
        if (text.compare(i, 4, "0 @I") == 0 && i + 4 <= end)
            ++count;
        start = end + 1;
    }
    return count;
}

QStringList corpusfiles()
{
    QStringList files;
    QDirIterator it(qmtest::corpusdir(), {QStringLiteral("*.ged"), QStringLiteral("*.GED")}, QDir::Files,
                    QDirIterator::Subdirectories);
    while (it.hasNext())
        files << it.next();
    files.sort();
    return files;
}

} // namespace

TEST(CorpusLoad, EveryFileLoadsWithItsIndividuals)
{
    if (qmtest::corpusdir().isEmpty())
        GTEST_SKIP() << "the shared corpus folder is absent";
    const QStringList files = corpusfiles();
    ASSERT_GT(files.size(), 50);
    for (const QString& path : files) {
        SCOPED_TRACE(path.toStdString());
        const qm::loadresult r = qm::loadgedcom(path, {});
        ASSERT_TRUE(r.index) << r.error.toStdString();
        EXPECT_EQ(static_cast<int64_t>(r.index->people.size()), individuallines(qmtest::readfile(path)));
        EXPECT_TRUE(r.index->hashead);
        for (size_t i = 1; i < r.index->places.size(); ++i)
            EXPECT_LT(qm::placekey(r.index->places[i - 1].name), qm::placekey(r.index->places[i].name));
    }
}

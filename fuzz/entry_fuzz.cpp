// Feeds arbitrary bytes as the entry file of quillmark-cli add-entry: read as
// JSON, checked against the bundled sample family file with the entry form's
// checks and the save road's, and, when all pass, written by the rewrite into
// memory. Checks what any accepted entry must give: a run that succeeds, and
// new lines that hold no control character but tabs and no pointer made of
// typed text.
#include "app/clientry.h"
#include "model/loadgedcom.h"
#include "settings/settings.h"
#include "writer/rewritechecks.h"
#include "writer/rewritefile.h"

#include "fuzzcheck.h"

#include <QFile>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>

using qmfuzz::check;

namespace {

struct family {
    std::string bytes;
    std::unique_ptr<qm::gedcomindex> index;
};

const family& sample()
{
    static const family f = [] {
        family s;
        QFile file(QStringLiteral(QM_EXAMPLES_DIR "/sample.ged"));
        check(file.open(QIODevice::ReadOnly));
        s.bytes = file.readAll().toStdString();
        s.index = qm::loadgedcombytes(s.bytes, {});
        return s;
    }();
    return f;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const family& f = sample();
    qm::entryfile e;
    QString error;
    if (!qm::readentry(QByteArray(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size)), e, error)) {
        check(!error.isEmpty());
        return 0;
    }
    qm::settings s = qm::defaultsettings();
    s.fullentry = size % 2 == 0; // a new source, or a citation of an existing one
    s.sharednote = size % 3 == 0;
    s.sourceinnote = size % 5 == 0;
    qm::rewriterequest rq;
    rq.mode = qm::rewritemode::censusentry;
    if (!qm::makeentry(e, *f.index, s, rq.entry).isEmpty())
        return 0;
    if (!qm::checkencodable(rq, s, f.index->encoding).isEmpty() || !qm::checkidentifiers(*f.index, s, rq).isEmpty())
        return 0;

    std::string out;
    const qm::rewriteresult r = qm::rewritebytes(f.bytes, out, *f.index, s, rq);
    check(r.ok);
    check(r.censusblocks == static_cast<int32_t>(rq.entry.selection.size()));
    check(out.size() > f.bytes.size());
    for (size_t at = 0; at < out.size();) {
        size_t end = out.find("\r\n", at);
        check(end != std::string::npos);
        const std::string_view line(out.data() + at, end - at);
        // Tabs come from the source text and the note, which may hold them.
        for (const char c : line)
            check((static_cast<unsigned char>(c) >= 0x20 || c == '\t') && c != 0x7F);
        // A value is a pointer only when it is one: "@X@" after the tag.
        const size_t space = line.find(' ', line.find(' ') + 1);
        if (space != std::string_view::npos && line.size() > space + 1 && line[space + 1] == '@'
            && line.substr(space + 1, 2) != "@@") {
            const std::string_view value = line.substr(space + 1);
            check(value.size() >= 3 && value.back() == '@' && value.find('@', 1) == value.size() - 1);
        }
        at = end + 2;
    }
    return 0;
}

// quillmark-cli stats: loads a family file and prints what the index holds.
#include "app/cli.h"

#include "model/gedcomindex.h"


#include <cstdio>

namespace qm {

int clistats(QStringList args)
{
    QString inipath, error;
    QStringList operands;
    if (!beginargs(args, operands, inipath, error))
        return clifail(error);
    if (!endargs(args, operands, error))
        return clifail(error);
    const auto f = openfamily(
        args, QStringLiteral("stats needs one family file: quillmark-cli stats FILE [--settings S.ini]"), inipath);
    if (!f)
        return clifailure;
    const gedcomindex& ix = *f->file.index();

    jsonobject j;
    j.add("individuals", static_cast<int64_t>(ix.people.size()));
    j.add("sources", static_cast<int64_t>(ix.sources.size()));
    j.add("census_sources", static_cast<int64_t>(ix.censussources.size()));
    j.add("objects", static_cast<int64_t>(ix.objects.size()));
    j.add("places", static_cast<int64_t>(ix.places.size()));
    j.add("census_events", ix.censusevents);
    j.add("flags", static_cast<int64_t>(ix.flags.size()));
    j.add("next_source", static_cast<int64_t>(ix.nextsourceid));
    j.add("maxobjectid", static_cast<int64_t>(ix.maxobjectid));
    j.add("maxnoteid", static_cast<int64_t>(ix.maxnoteid));
    j.add("encoding", QString::fromLatin1(encodingname(ix.encoding)));
    j.add("load_ms", f->loadms);
    const std::string out = j.text() + "\n";
    std::fwrite(out.data(), 1, out.size(), stdout);
    std::fflush(stdout);
    // The process ends here: freeing a big index block by block would only
    // add to the time, the system takes the memory back at once.
    f->file.abandonindex();
    return 0;
}

} // namespace qm

// quillmark-cli: Quillmark's work without windows, for scripts and batches.
#include "app/cli.h"

#include <QCoreApplication>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#if defined(__linux__) && defined(__GLIBC__)
#include <unistd.h>
#endif

namespace qm {

// One line per command; the usage text and the dispatch both come from here.
const std::vector<clicommand>& clicommands()
{
    static const std::vector<clicommand> commands = {
        {"stats", "FILE [--settings S.ini]",
         "load FILE and print what it holds as one JSON object (individuals, sources, places, ...)", clistats},
        {"add-entry", "FILE --entry ENTRY.json [--settings S.ini]",
         "save the census entry described by ENTRY.json into FILE (backup, rewrite, census log); see docs/cli.md",
         cliaddentry},
    };
    return commands;
}

// A big family file fills hundreds of megabytes with small blocks, and
// fetching that memory a small page at a time is much of the load's time.
// glibc serves its heap from large pages only when told so as the process
// starts (GLIBC_TUNABLES), so the tool starts itself afresh once with that
// setting. When that cannot be done it simply carries on.
void uselargepages(char** argv)
{
#if defined(__linux__) && defined(__GLIBC__)
    const char* tunables = std::getenv("GLIBC_TUNABLES");
    if (tunables && std::strstr(tunables, "glibc.malloc.hugetlb"))
        return;
    std::string value = "glibc.malloc.hugetlb=1";
    if (tunables && *tunables)
        value = std::string(tunables) + ":" + value;
    if (setenv("GLIBC_TUNABLES", value.c_str(), 1) == 0)
        execv("/proc/self/exe", argv);
#else
    (void)argv;
#endif
}

} // namespace qm

int main(int argc, char** argv)
{
    qm::uselargepages(argv);
    QCoreApplication app(argc, argv);
    QCoreApplication::setApplicationName(QStringLiteral("quillmark-cli"));
    QStringList args = QCoreApplication::arguments();
    args.removeFirst();

    const auto print = [](const QString& text, FILE* to) { std::fputs(text.toStdString().c_str(), to); };
    if (args.isEmpty()) {
        print(qm::cliusage(), stderr);
        return qm::clifailure;
    }
    const QString name = args.takeFirst();
    if (name == QLatin1String("--help") || name == QLatin1String("-h") || name == QLatin1String("help")) {
        print(qm::cliusage(args.isEmpty() ? QString() : args.front()), stdout);
        return 0;
    }
    for (const qm::clicommand& c : qm::clicommands()) {
        if (name != QLatin1String(c.name))
            continue;
        if (args.contains(QLatin1String("--help")) || args.contains(QLatin1String("-h"))) {
            print(qm::cliusage(name), stdout);
            return 0;
        }
        return c.run(args);
    }
    return qm::clifail(QStringLiteral("unknown command %1 (see quillmark-cli --help)").arg(name));
}

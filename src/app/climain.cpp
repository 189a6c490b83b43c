// quillmark-cli: Quillmark's work without windows, for scripts and batches.
#include "app/cli.h"

#include <QCoreApplication>

#include <cstdio>

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
        {"flag-check", "FILE [--apply] [--country-for PLACE=COUNTRY]... [--settings S.ini]",
         "list the census flags to add and remove as the Flag Check dialog does; --apply makes the changes",
         cliflagcheck},
        {"attach-images", "FILE --source S_NUMBER [--image PATH[=TITLE]]... [--object O_NUMBER]... [--settings S.ini]",
         "link new image files and existing multimedia records to an existing source of FILE; see docs/cli.md",
         cliattachimages},
        {"date-check", "FILE [--country C] [--apply] [--settings S.ini]",
         "list the census event dates as the Census Date Check dialog does; --apply makes the suggested changes",
         clidatecheck},
    };
    return commands;
}

} // namespace qm

int main(int argc, char** argv)
{
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

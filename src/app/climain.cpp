// quillmark-cli: Quillmark's work without windows, for scripts and batches.
#include "app/cli.h"

#include <QCoreApplication>

#include <cstdio>
#include <cstdlib>

#ifdef Q_OS_WIN
#include <fcntl.h>
#include <io.h>
#include <windows.h>
#endif

namespace qm {

// One line per command; the usage text and the dispatch both come from here.
const std::vector<clicommand>& clicommands()
{
    static const std::vector<clicommand> commands = {
        {"stats", "FILE [--settings S.ini]",
         "load FILE and print what it holds as one JSON object (individuals, sources, places, ...)", clistats},
        {"add-entry", "FILE --entry ENTRY.json [--strict] [--dry-run] [--settings S.ini]",
         "save the census entry described by ENTRY.json into FILE (backup, rewrite, census log), after the household "
         "check's warnings; --strict refuses it on them, --dry-run prints the lines it would write; see docs/cli.md",
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
        {"coverage", "FILE [--country C] [--year Y] [--missing-only] [--format csv|json] [--settings S.ini]",
         "for every individual and census of the country: recorded, not alive, uncertain, elsewhere or missing",
         clicoverage},
        {"undo", "FILE [--settings S.ini]",
         "put FILE back as it was before the last change any Quillmark command or window made to it, when it has "
         "not changed since; see docs/cli.md",
         cliundo},
    };
    return commands;
}

} // namespace qm

namespace {

#ifdef Q_OS_WIN
UINT consolecodepage = 0;
#endif

// The output is UTF-8 with LF line ends on every system, so that scripts and
// JSON readers get the same bytes everywhere: on Windows standard output and
// error are switched from text mode (which writes CR LF) to binary, and a
// console is told to show UTF-8 until the program ends.
void rawoutput()
{
#ifdef Q_OS_WIN
    _setmode(_fileno(stdout), _O_BINARY);
    _setmode(_fileno(stderr), _O_BINARY);
    consolecodepage = GetConsoleOutputCP();
    if (consolecodepage != 0 && consolecodepage != CP_UTF8 && SetConsoleOutputCP(CP_UTF8))
        std::atexit([] { SetConsoleOutputCP(consolecodepage); });
#endif
}

} // namespace

int main(int argc, char** argv)
{
    rawoutput();
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

#pragma once
// The family file open in the program, as one object: the file's path, its
// index with the stamp noted when it was read, the settings in use and the
// store they come from, the watch for changes made by other programs, and the
// road every change to the file takes. The main window, the tool windows and
// the command-line tool all work on one openfile; none of them keeps an index,
// settings or a watch of its own.
//
// The contract:
// - readsettings() reads the settings from the store; usesettings() puts
//   others in use (the options dialog after Save). Whoever changes a setting
//   through currentsettings() writes it to the store too.
// - load(path) reads a family file, reload() the same one again. The flag
//   definitions are read from the store first (a faulty group is reported,
//   the good ones are used). A file that cannot be read leaves the index read
//   before, and its path, as they were; with none read before, the index is
//   empty and the path is the one asked for. After every read, whether it
//   succeeded or not, the listeners added with onread() run, in the order they
//   were added: the windows refill their lists from the index there.
// - The watch for outside changes is on unless paused: pause() gives a guard
//   that turns it off for its life; guards count, so that the watch comes
//   back only when the last one ends, on every path out of the code holding
//   it. A read pauses it while it runs. changed() and missing() look at the
//   file itself.
// - save() runs the save road (writer/saveroad.h) for one rewrite over the
//   index's file and, when the change was saved, notes the file's new stamp
//   in the index. The index itself is not read again: the caller reads it
//   (reload()) or brings it up to date, and reports the outcome.
// - With prompts given, a read shows the busy pointer while the file is read
//   and tells its messages (the flag definitions' fault first, then why the
//   file could not be read, as a warning) before the listeners run. Without
//   (the command-line tool), the messages are only in the outcome.
//
// Qt Core only: listeners are plain functions, not signals.

#include "model/gedcomindex.h"
#include "settings/settings.h"
#include "writer/saveroad.h"

#include <QString>

#include <functional>
#include <memory>
#include <vector>

namespace qm {

class prompts;
class settingsstore;

// How a tool window ended, for whoever opened it.
enum class toolend {
    unchanged, // nothing written; the index is still in step with the file
    reload,    // the file was rewritten, or changed outside the program: read it again
    fatal,     // a rewrite failed (message shown, file as it was): the program ends
};

// What one read of the family file gave.
struct readoutcome {
    bool ok = false;
    QString error;     // why the file could not be read, for the user
    QString flagerror; // the flag definitions could not all be read
    double ms = 0;     // time the read took
};

class openfile {
public:
    explicit openfile(settingsstore& store, prompts* p = nullptr);
    ~openfile();
    openfile(const openfile&) = delete;
    openfile& operator=(const openfile&) = delete;

    settingsstore& store() const { return store_; }
    const settings& currentsettings() const { return settings_; }
    settings& currentsettings() { return settings_; }
    settingsload readsettings();
    void usesettings(const settings& s) { settings_ = s; }

    // The family file: the one read, or asked for when none could be.
    const QString& path() const { return path_; }
    // Null until the first read; then never null.
    const gedcomindex* index() const { return index_.get(); }
    gedcomindex* index() { return index_.get(); }

    // `needhead`: a file without a "0 HEAD" line is refused as not GEDCOM.
    readoutcome load(const QString& path, bool needhead = false);
    readoutcome reload();
    void onread(std::function<void()> listener);

    // The file differs from what was read (time or size), or has gone.
    bool changed() const;
    // The file read is no longer there (deleted, renamed or moved).
    bool missing() const;

    class pausewatch {
    public:
        explicit pausewatch(openfile& f);
        ~pausewatch();
        pausewatch(pausewatch&& other) noexcept;
        pausewatch(const pausewatch&) = delete;
        pausewatch& operator=(const pausewatch&) = delete;
        pausewatch& operator=(pausewatch&&) = delete;

    private:
        openfile* file_;
    };
    [[nodiscard]] pausewatch pause() { return pausewatch(*this); }
    bool watching() const { return pauses_ == 0; }

    // `made`: a backup made while the file was read (see savechange()).
    saveoutcome save(const rewriterequest& request, const backupresult* made = nullptr);

    // Gives the index up without freeing it: a process about to end leaves
    // the memory to the system, which takes it back faster than the index
    // would free it block by block.
    void abandonindex() { (void)index_.release(); }

private:
    settingsstore& store_;
    prompts* prompts_;
    settings settings_;
    QString path_;
    std::unique_ptr<gedcomindex> index_;
    std::vector<std::function<void()>> listeners_;
    int pauses_ = 0;
};

using pausewatch = openfile::pausewatch;

} // namespace qm

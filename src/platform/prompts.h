#pragma once
// Questions, messages and file choosers: the logic and the windows ask them
// through this interface, never through widgets directly, so that tests can
// answer them (scriptedprompts) and the program shows real dialogs.

#include <QString>
#include <QStringList>

#include <optional>

namespace qm {

enum class buttons { ok, okcancel, yesno, yesnocancel };
enum class icon { none, information, question, exclamation, critical };
enum class answer { ok, cancel, yes, no };

struct message {
    QString text;
    QString title = QStringLiteral("Quillmark");
    buttons choice = buttons::ok;
    icon kind = icon::none;
    // The button the Enter key presses; the first button when not given.
    std::optional<answer> defaultanswer;
};

class prompts {
public:
    virtual ~prompts() = default;

    virtual answer ask(const message& m) = 0;

    // Open dialog: a chosen existing file, or nothing when cancelled.
    // filter is in Qt's form: "Family Historian Gedcom (*.ged);;All Files (*)".
    virtual std::optional<QString> openfile(const QString& caption, const QString& folder,
                                            const QString& filter) = 0;
    // Open dialog choosing several files.
    virtual std::optional<QStringList> openfiles(const QString& caption, const QString& folder,
                                                 const QString& filter) = 0;
    virtual std::optional<QString> savefile(const QString& caption, const QString& startpath,
                                            const QString& filter) = 0;
    virtual std::optional<QString> choosefolder(const QString& caption, const QString& startfolder) = 0;

    // Shows the busy pointer while long work runs (see busycursor).
    virtual void setbusy(bool) {}

    // Opens the help window at a topic number, or at its index ("Index") or
    // search page ("Search") when command says so.
    virtual void showhelp(int topic, const QString& command = QString()) = 0;
    // Opens a file or a web address in the program the system keeps for it.
    // Returns "" when it was handed over, otherwise why not, for the user.
    virtual QString openexternal(const QString& target) = 0;

    // Conveniences for the common forms.
    void tell(const QString& text, icon kind = icon::none, const QString& title = QStringLiteral("Quillmark"))
    {
        ask(message{text, title, buttons::ok, kind, std::nullopt});
    }
    bool yes(const QString& text, icon kind = icon::question, answer def = answer::yes,
             const QString& title = QStringLiteral("Quillmark"))
    {
        return ask(message{text, title, buttons::yesno, kind, def}) == answer::yes;
    }
};

// Shows the busy pointer for the life of the object.
class busycursor {
public:
    explicit busycursor(prompts& p) : p_(p) { p_.setbusy(true); }
    ~busycursor() { p_.setbusy(false); }
    busycursor(const busycursor&) = delete;
    busycursor& operator=(const busycursor&) = delete;

private:
    prompts& p_;
};

} // namespace qm

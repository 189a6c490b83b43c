#pragma once
// quillmark-cli: the commands and what they share (settings, messages, JSON).
//
// A command is one entry of clicommands(): its name, its arguments for the
// usage text, a one-line summary and the function that runs it with the
// arguments after its name. It returns the process's exit status: 0 when done,
// 2 when it could not be (after one line on standard error).

#include "platform/settingsstore.h"
#include "writer/openfile.h"
#include "writer/saveroad.h"

#include <QJsonObject>
#include <QString>
#include <QStringList>

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace qm {


struct clicommand {
    const char* name;
    const char* args;
    const char* summary;
    int (*run)(QStringList args);
};

const std::vector<clicommand>& clicommands();

// Commands.
int clistats(QStringList args);
int cliaddentry(QStringList args);
int clidatecheck(QStringList args);
int cliflagcheck(QStringList args);
int cliattachimages(QStringList args);
int clicoverage(QStringList args);
int cliundo(QStringList args);

// Exit status of a command that could not do its work.
constexpr int clifailure = 2;

// Writes "quillmark-cli: " + message as one line on standard error and returns clifailure.
int clifail(const QString& message);
// Writes "quillmark-cli: warning: " + message as one line on standard error.
void cliwarn(const QString& message);
// Writes "quillmark-cli: note: " + message as one line on standard error.
void clinote(const QString& message);
// Usage of one command (or of all when name is empty), for --help and mistakes.
QString cliusage(const QString& name = QString());

// Takes "--" and every argument after it out of args and returns those: they
// are file names even when they begin with "-". Commands call it first.
QStringList takeoperands(QStringList& args);

// Takes "--settings S.ini" or "--settings=S.ini" out of args. False (with a
// message) when the option has no value.
bool takesettingsoption(QStringList& args, QString* path, QString* error);

// The family file a command works on, over the user's settings store or the
// INI file named by --settings, which must exist and read as settings (a file
// holding none of the values is refused). Values the file lacks or holds in a
// form not accepted take their defaults, after a warning on standard error
// naming them. Nothing is read from the family file yet (loadfamily).
struct clifile {
    explicit clifile(std::unique_ptr<settingsstore> s) : store(std::move(s)), file(*store) {}
    std::unique_ptr<settingsstore> store;
    openfile file;
    double loadms = 0; // time the last read took
    const settings& values() const { return file.currentsettings(); }
};
std::unique_ptr<clifile> opensettings(const QString& inipath, QString* error);

// Takes the value of "--name VALUE" or "--name=VALUE" at args[i] out of args;
// false when args[i] is not that option. A missing value sets error.
bool takeoptionvalue(QStringList& args, qsizetype i, const QString& name, QString& value, QString& error);

// "unknown option A (see quillmark-cli --help)" for the first argument that
// looks like an option ("-" alone names standard input); "" when none does.
QString unknownoption(const QStringList& args);

// The opening every command shares: the operands after "--" set aside, then
// "--settings" taken. False (with the message) when --settings has no value.
bool beginargs(QStringList& args, QStringList& operands, QString& inipath, QString& error);
// The closing, once a command has taken its own options: false (with the
// message) when an argument left looks like an option; else the operands set
// aside are put back after the arguments left.
bool endargs(QStringList& args, const QStringList& operands, QString& error);

// Reads the arguments of a command that takes family files, the switch
// --apply and one option NAME VALUE or NAME=VALUE, in the order given. Each
// value goes to `take`, which returns "" or why it refuses it; `missing` is
// the message for NAME without a value. "" or the first message.
QString readapplyargs(const QStringList& args, const QString& name, const QString& missing,
                      const std::function<QString(const QString& value)>& take, bool* apply, QStringList* files);

// One of the census countries (flagcountries()) named by text, in any letter
// case and with spaces around it, in its own spelling; "" when none is.
QString censuscountry(const QString& text);

// Reads the value of --country into country: "" or the message refusing it.
QString takecountry(const QString& given, QString* country);

// "" when path names a file, else "PATH: no such file" or "PATH is a folder ...".
QString checkfamilypath(const QString& path);

// True when the change was saved (after a warning when the census log could
// not be written); false after the reason on standard error.
bool clisaved(const saveoutcome& out);

// Reads the family file with the census flags of the settings store (a
// warning when those cannot be read). Not ok, with the message in error, when
// the file cannot be read or has no "0 HEAD" line.
readoutcome loadfamily(clifile& f, const QString& path);

// The one family file of `files`, checked (checkfamilypath) and read
// (loadfamily) with the settings of `inipath` (opensettings). Null, after one
// line on standard error (`usage` when files are not one), when it cannot be.
std::unique_ptr<clifile> openfamily(const QStringList& files, const QString& usage, const QString& inipath);

// One line of text, or one JSON object on one line, on standard output.
void printline(const QString& text);
// Text as it stands (its own line ends), on standard output.
void printtext(const QString& text);
void printjson(const QJsonObject& object);

// Appends utf8 to out as a JSON string, in quotes, with quotes, backslashes
// and control characters escaped.
void appendjsontext(std::string& out, std::string_view utf8);

// A JSON object written field by field on one line.
class jsonobject {
public:
    void add(const char* key, int64_t value);
    void add(const char* key, double value);
    void add(const char* key, const QString& value);
    std::string text() const { return out_ + "}"; }

private:
    void key(const char* key);
    std::string out_ = "{";
};

} // namespace qm

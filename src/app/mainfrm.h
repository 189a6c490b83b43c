#pragma once
// The main window: the family file open, the menus, and the census entry form
// and household (src/census/) laid out and wired to them. The family file,
// its index, the settings and the watch for outside changes are the window's
// openfile (file_); the prompts and the settings store are handed in by
// main() (tests hand in scripted prompts and an INI store). The tools and
// dialogs of the menus are the features' own (flags/flagsmenu_ui.h,
// images/imagesmenu_ui.h, tools/toolsmenu_ui.h, settings/optionsmenu_ui.h,
// log/logfrm.h and log/clearlog.h): the window hands them the openfile, the
// prompts and itself as parent, and reads the file again or ends the program
// as they report.

#include "app/recentfiles.h"
#include "census/entryform_ui.h"
#include "census/household_ui.h"
#include "model/gedcomindex.h"
#include "settings/settings.h"
#include "writer/censusentry.h"
#include "writer/openfile.h"

#include <QMainWindow>
#include <QPointer>

#include <array>
#include <functional>
#include <memory>
#include <optional>

class QAction;
class QPushButton;

namespace qm {

class coveragefrm;
class filechoice;
class entrypanel;
class prompts;
class settingsstore;

class mainfrm : public QMainWindow {
    Q_OBJECT
public:
    mainfrm(prompts& p, settingsstore& store, QWidget* parent = nullptr);
    ~mainfrm() override;

    // Start-up: places the window, chooses the family file (command line,
    // default file, Open dialog) and loads it. False when the user cancelled
    // the choice: the program then ends without showing the window.
    bool start(const QStringList& arguments);
    // Shows the window as it was placed (maximised when it was closed so).
    void showplaced();

    const openfile& file() const { return file_; }
    const gedcomindex* index() const { return file_.index(); }
    const householdrows& household() const { return household_->rows(); }
    const settings& currentsettings() const { return file_.currentsettings(); }
    const recentfiles& recent() const;
    QString gedcomfile() const { return file_.path(); }
    bool firststart() const { return file_.currentsettings().firststart; }
    bool watching() const { return file_.watching(); }
    entrypanel* panel() const { return form_->panel(); } // the panel of the current source mode

public slots:
    void openfamilyfile(const QString& path);
    // The application has become active: reload when the file changed.
    void checkonactivate();
    void reload();
    // "Save Census Entry" (addbut, savemen): the entry form's.
    void saveentry() { form_->saveentry(); }

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    // construction (mainfrm.cpp)
    void buildmenus();
    void buildform();
    void placewindow();
    // The title names `path`: the file about to be read, or the one open.
    void settitleandpanel(const QString& path);
    // After every read (an openfile listener): a file without individuals is
    // reported, and is no longer the default file.
    void afterload();
    void clearall();

    // The menus' tools and dialogs are offered by their features' folders;
    // these wire them to the window. A tool that may rewrite the family file
    // runs with the watch for outside changes paused and says how it ended:
    // endtool() reads the file again or ends the program.
    void endtool(toolend end);
    void removebackups();
    void showoptions();
    // After each load when "Flag Check" is on.
    void silentflagcheck();
    // Census Coverage (app/coveragemenu_ui.cpp): the grid stays open and is
    // given every index read; a missing cell chosen in it starts its entry.
    void opencoverage();
    void transcribegap(int32_t k, int year);
    void donate();             // app/helpmenu_ui.cpp
    void about();              // app/helpmenu_ui.cpp
    void helpkeys();           // app/helpmenu_ui.cpp: F1
    // After each saved entry, once Count has been raised (app/helpmenu_ui.cpp).
    void milestone();
    // Handed to the household: the Find dialog starting at people[start] (the
    // individual chosen or -1, and whether the family is to be rebuilt around it).
    int32_t runfind(int32_t start, bool& refocus);

    // A failed rewrite: the message has been shown; the program ends.
    void endprogram();
    // Empties the entry form and the household.
    void clearentry();

    prompts& prompts_;
    openfile file_;
    // The watch is off until start() has opened the first file, and again
    // once the window is closing.
    std::optional<pausewatch> idle_;

    filechoice* files_ = nullptr; // the family file to open, and the recent files
    bool maximise_ = false;

    bool checking_ = false;
    QString gonetold_; // the family file the user was told is no longer there
    bool ending_ = false; // closing after a failed rewrite: no questions
    QPointer<coveragefrm> coverage_; // the Census Coverage window while open

    // controls
    censusform* form_ = nullptr;
    householdform* household_ = nullptr;
    QPushButton* reloadbut_ = nullptr;
    QAction* viewlogmen_ = nullptr;
    QAction* attachbut_ = nullptr;
};

} // namespace qm

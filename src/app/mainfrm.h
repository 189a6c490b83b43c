#pragma once
// The main window: the family file open, the census entry form, the household
// being put together and the menus. The family file, its index, the settings
// and the watch for outside changes are the window's openfile (file_); the
// prompts and the settings store are handed in by main() (tests hand in
// scripted prompts and an INI store). The tools and dialogs of the menus are
// the features' own (flags/flagsmenu_ui.h, images/imagesmenu_ui.h,
// tools/toolsmenu_ui.h, settings/optionsmenu_ui.h, log/logfrm.h and
// log/clearlog.h): the window hands them the openfile, the prompts and itself
// as parent, and reads the file again or ends the program as they report.

#include "app/recentfiles.h"
#include "census/selection.h"
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
class QLabel;
class QPushButton;
class QStackedWidget;

namespace qm {

class coveragefrm;
struct censusentry;
struct entryform;
class entrypanel;
class householdpanel;
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
    const householdrows& household() const { return rows_; }
    const settings& currentsettings() const { return file_.currentsettings(); }
    const recentfiles& recent() const { return recent_; }
    QString gedcomfile() const { return file_.path(); }
    bool firststart() const { return file_.currentsettings().firststart; }
    bool watching() const { return file_.watching(); }
    entrypanel* panel() const; // the panel of the current source mode

public slots:
    void openfamilyfile(const QString& path);
    // The application has become active: reload when the file changed.
    void checkonactivate();
    void reload();
    // "Save Census Entry" (addbut, savemen): checks the form, asks for birth
    // details, writes the entry and clears the form (entryform_ui.cpp).
    void saveentry();
    // "Preview...": the form's checks, then what the save would write (entryform_ui.cpp).
    void previewentry();

protected:
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // construction (mainfrm.cpp)
    void buildmenus();
    void buildform();
    void placewindow();
    void rememberfile(const QString& path, bool fromopen);
    void showrecentfiles();
    // The title names `path`: the file about to be read, or the one open.
    void settitleandpanel(const QString& path);
    // Refills the lists from the index after every read (an openfile listener).
    void afterload();
    void editmenuopening();
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
    // Save step 12: the Census Images dialog for the entry being saved. False
    // when the user chose "Cancel saving census".
    bool chooseentryimages(std::vector<imagechoice>& chosen);
    std::optional<QString> askforfile(bool startup);

    // the entry form and its save (entryform_ui.cpp)
    void connectform();
    void sourcechosen(int item);
    void autotextclicked();
    void edittext(int mode);
    void dividermoved(double share);
    // The save's checks of the form: false when they refused it (the message
    // shown, the field focused); otherwise the census date to write.
    bool checkform(entryform& form, QString& entrydate);
    // The form as the save's checks read it (rows already stored).
    entryform currentform() const;
    // The birth details dialog for each individual of the entry who has no
    // birth date, birth place or birth details yet.
    void askbirthdetails(const QString& entrydate);
    // The individuals of the entry, with the birth details given for them.
    std::vector<selectionrec> currentselection() const;
    censusentry gatherentry(const entryform& form, const QString& entrydate) const;
    void raisecount();
    // A failed rewrite: the message has been shown; the program ends.
    void endprogram();

    // census year and form (mainfrm.cpp)
    void fillyears();
    void yearchosen(int item);
    void refreshtitle();
    void datechanged();
    bool censusdateok(bool normalise);

    // the household (household_ui.cpp)
    void fillallpeople();
    void fillalivepeople();
    void fillfamily(int32_t k);
    void showallclicked();
    void peopleclicked(int row);
    void familyclicked(int row);
    void selectperson(int32_t k);
    bool checkages();
    void storerows();
    void showrows(int t);
    void scrollup();
    void scrolldown();
    void deleterow(int r);
    void inforow(int r);
    void showpersoninfo(int32_t k);
    void clearentry();
    void findclicked();
    // Shows the Find dialog starting at people[start]; the individual chosen,
    // or -1. Sets fromfind_ when the immediate family is to be rebuilt.
    int32_t runfind(int32_t start);
    void pullrows();
    void pushrows();

    prompts& prompts_;
    openfile file_;
    // The watch is off until start() has opened the first file, and again
    // once the window is closing.
    std::optional<pausewatch> idle_;

    QString defaultfile_;
    QString gedcomfolder_;
    recentfiles recent_;
    int sourcemode_ = 0; // 0 a new source per entry, 1 an existing source cited
    QString lastrefprefix_;
    double divider_ = 1;
    bool maximise_ = false;

    householdrows rows_;
    bool checking_ = false;
    bool reloading_ = false;
    QString gonetold_; // the family file the user was told is no longer there
    int32_t findresult_ = -1;
    bool fromfind_ = false;     // the Find dialog asked for the immediate family to be rebuilt
    bool ending_ = false; // closing after a failed rewrite: no questions
    bool saving_ = false; // a save is running (a second click waits its turn)
    QPointer<coveragefrm> coverage_; // the Census Coverage window while open

    // controls
    QStackedWidget* panels_ = nullptr;
    std::array<entrypanel*, 2> panel_{};
    householdpanel* household_ = nullptr;
    QLabel* infolab_ = nullptr;
    QPushButton* addbut_ = nullptr;
    QPushButton* previewbut_ = nullptr;
    QPushButton* Autosourcebut_ = nullptr;
    QPushButton* reloadbut_ = nullptr;
    QPushButton* findbut_ = nullptr;
    std::array<QAction*, recentfiles::slotcount> RecentFilesmen_{};
    QAction* recentseparator_ = nullptr;
    QAction* viewlogmen_ = nullptr;
    QAction* attachbut_ = nullptr;
    QAction* copymen_ = nullptr;
    QAction* cutmen_ = nullptr;
    QAction* pastemen_ = nullptr;
};

} // namespace qm

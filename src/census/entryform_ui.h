#pragma once
// The census entry form: its two panels in a stack (panel 0 makes a new
// census source with each entry, panel 1 cites an existing one), the census
// year and date, the source title kept up to date, Auto Text, the large text
// editor and the divider, the birth details asked for the household, the
// Census Images asked for the entry, and "Save Census Entry".
//
// Inputs: the open family file (the save goes through it; the form refills
// its list of census sources after every read of the file), the prompts, the
// parent widget its controls are made in (the window lays them out) and,
// once made, the household being typed. What needs the program is reported
// upward: saved() once an entry has been written and Count raised, fatal()
// when a rewrite failed and the program must end.

#include <QObject>

#include <array>
#include <functional>
#include <vector>

class QPushButton;
class QStackedWidget;
class QWidget;

namespace qm {

struct censusentry;
struct entryform;
struct entrysource;
struct imagechoice;
class entrypanel;
class householdform;
class openfile;
class prompts;

class censusform : public QObject {
    Q_OBJECT
public:
    censusform(openfile& file, prompts& p, QWidget* parent);

    void sethousehold(householdform* h) { household_ = h; }

    // Controls for the window's layout.
    QStackedWidget* stack() const { return stack_; }
    QPushButton* savebutton() const { return addbut_; }
    QPushButton* previewbutton() const { return previewbut_; }
    QPushButton* autotextbutton() const { return Autosourcebut_; }

    // The panel of the current source mode.
    entrypanel* panel() const { return panel_[static_cast<size_t>(sourcemode_)]; }
    // 0 a new source per entry, 1 an existing source cited.
    int sourcemode() const { return sourcemode_; }

    // The settings in use may have changed: the source mode and the years of
    // the country (the date is emptied).
    void usesettings();
    // Refills the list of census sources from the index (after every read).
    void refill();
    // A title typed from the form follows the settings' title pattern.
    void refreshtitle();
    // The source chosen is forgotten (the file was read again).
    void forgetsource();

    double divider() const;
    void setdivider(double share);

    QString censusdate() const;
    QString censusyear() const;
    // Whether the census date is a date; `normalise` writes it as it will be saved.
    bool censusdateok(bool normalise);
    void setautotext(bool enabled);
    void focusyear();
    void focustext();

    // Empties the form and the household.
    void clearentry();

    // "Save Census Entry": checks the form and the household, asks for birth
    // details and images, writes the entry and clears the form.
    void saveentry();
    // "Preview...": the form's checks, then what the save would write.
    void previewentry();
    // A save is running.
    bool saving() const { return saving_; }

    // The Census Images dialog for the entry being saved, given the source it
    // makes or cites: false when the user chose "Cancel saving census".
    // Unset: no images are asked for.
    std::function<bool(const entrysource& source, std::vector<imagechoice>& chosen)> chooseimages;

signals:
    void saved();
    void fatal();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void fillyears();
    entrysource imagesource() const;
    void yearchosen(entrypanel* p, int item);
    void datechanged();
    void sourcechosen(int item);
    void autotextclicked();
    void edittext(int mode);
    void dividermoved(entrypanel* from, double share);
    // The form as the save's checks read it (rows already stored).
    entryform currentform() const;
    // The birth details dialog for each individual of the entry who has no
    // birth date, birth place or birth details yet.
    void askbirthdetails(const QString& entrydate);
    // The save's checks of the form: false when they refused it (the message
    // shown, the field focused); otherwise the census date to write.
    bool checkform(entryform& form, QString& entrydate);
    censusentry gatherentry(const entryform& form, const QString& entrydate) const;
    void raisecount();

    openfile& file_;
    prompts& prompts_;
    QWidget* parent_;
    householdform* household_ = nullptr;
    int sourcemode_ = 0;
    QString lastrefprefix_;
    bool saving_ = false; // a save is running (a second click waits its turn)

    QStackedWidget* stack_ = nullptr;
    std::array<entrypanel*, 2> panel_{};
    QPushButton* addbut_ = nullptr;
    QPushButton* previewbut_ = nullptr;
    QPushButton* Autosourcebut_ = nullptr;
};

} // namespace qm

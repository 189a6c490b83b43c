#pragma once
// Flag Check: lists the census flags to give to individuals and to take from
// them, and on "Make required changes" has the family file rewritten with
// them (after a backup; never over a change made by another program).

#include "flags/flagcheck.h"
#include "writer/openfile.h"

#include <QDialog>

class QCheckBox;
class QListWidget;
class QPushButton;

namespace qm {

struct gedcomindex;
struct settings;
class prompts;
class settingsstore;

class flagcheckfrm : public QDialog {
    Q_OBJECT
public:
    flagcheckfrm(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent = nullptr);

    // Runs the Flag Check dialog modally. True when the family file must be read again (rewritten, or changed outside).
    // A failed rewrite also returns true (the file is as it was); callers able
    // to end the program use open().
    static bool run(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent);
    // The same, telling a failed rewrite apart.
    static toolend open(gedcomindex& index, settings& s, settingsstore& store, prompts& p, QWidget* parent);

    // The check was cancelled while the dialog loaded: it is not shown.
    bool cancelled() const { return check_.cancelled; }
    toolend outcome() const { return end_; }
    const flagcheckresult& check() const { return check_; }

private:
    void makechanges();
    void flagschanged(bool on);

    gedcomindex& index_;
    settings& settings_;
    settingsstore& store_;
    prompts& prompts_;
    flagcheckresult check_;
    toolend end_ = toolend::unchanged;
    bool loading_ = false;

    QListWidget* addlst_ = nullptr;
    QListWidget* removelst_ = nullptr;
    QCheckBox* flagschk_ = nullptr;
    QPushButton* Changebut_ = nullptr;
    QPushButton* closebut_ = nullptr;
    QPushButton* helpbut_ = nullptr;
};

} // namespace qm

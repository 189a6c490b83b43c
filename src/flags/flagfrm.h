#pragma once
// Census Flags: the flags allocated to censuses, with the two choosers that
// pick a census (flagdatefrm) and a flag name (flagnamefrm) for a new
// allocation, deletion of allocations, the "Flag Use" setting and the way to
// the flag check. The flag definitions are written to the settings store
// whenever the dialog closes.

#include <QDialog>
#include <QString>

#include <functional>
#include <optional>

class QCheckBox;
class QLineEdit;
class QListWidget;
class QPushButton;

namespace qm {

struct gedcomindex;
struct settings;
class prompts;
class settingsstore;

class flagfrm : public QDialog {
    Q_OBJECT
public:
    // `flagcheck` runs the Flag Check dialog and says whether the family file
    // must be read again (the dialog then closes itself).
    flagfrm(gedcomindex& index, settings& s, settingsstore& store, prompts& p, std::function<bool()> flagcheck,
            QWidget* parent = nullptr);

    // The flag check rewrote the file (or found it changed): read it again.
    bool reloadneeded() const { return reloadneeded_; }

    // The results of the choosers; each allocates a flag once both a census
    // and a name are chosen.
    void setcensus(const QString& country, const QString& date);
    void setflagname(const QString& name, std::optional<size_t> existing = std::nullopt);

    void done(int r) override;

private:
    void filllist();
    void addrow(size_t flag);
    void clearfields();
    void tryallocate();
    void deleteselected();
    void choosedate();
    void choosename();
    void flaguseclicked(bool on);
    void runflagcheck();
    void enableflagcheck();

    gedcomindex& index_;
    settings& settings_;
    settingsstore& store_;
    prompts& prompts_;
    std::function<bool()> flagcheck_;
    bool reloadneeded_ = false;
    std::optional<size_t> chosenflag_; // the existing flag picked by name, if any

    QLineEdit* datelab_;
    QLineEdit* flaglab_;
    QLineEdit* countrylab_;
    QListWidget* flagslst_;
    QPushButton* delbut_;
    QCheckBox* flagschk_;
    QPushButton* flagcheckbut_;
};

} // namespace qm

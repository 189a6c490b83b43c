#pragma once
// Quillmark Options: every setting of the census entry, the log and the
// backups on five tabs. The dialog edits its controls only; Save checks them
// (settings/options.h), writes the settings to the store and gives them back.
// While the settings are incomplete (first start) it cannot be cancelled.

#include "settings/options.h"

#include <QDialog>
#include <QHash>

#include <array>
#include <functional>

class QAbstractButton;
class QButtonGroup;
class QCheckBox;
class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QRadioButton;
class QTabWidget;

namespace qm {

class prompts;
class settingsstore;

class optionsfrm : public QDialog {
    Q_OBJECT
public:
    // `donate` is run by the Donate button.
    optionsfrm(prompts& p, settingsstore& store, const settings& current, std::function<void()> donate,
               QWidget* parent = nullptr);

    // After Save: the settings now in use, and whether the entry on the main
    // window must be cleared and the file read again.
    const settings& saved() const { return saved_; }
    bool reloadneeded() const { return reloadneeded_; }

    // The values on the controls, and putting values on them.
    settings form() const;
    void showform(const settings& s);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QWidget* generaltab();
    QWidget* methodstab();
    QWidget* method1tab();
    QWidget* method2tab();
    QWidget* misctab();
    // A frame whose rows are added by check() and option().
    QGroupBox* frame(const QString& caption, const char* name);
    QCheckBox* check(QGroupBox* f, const char* name, const QString& caption);
    QRadioButton* option(QGroupBox* f, const char* name, const QString& caption);
    // Adds the button as a row of the frame; a long caption wraps in a label
    // beside the button, which clicks the button and follows its enabling.
    void place(QGroupBox* f, QAbstractButton* b, const QString& caption);

    void applyenabling();
    void separatorclicked(bool on);
    void choosepath();
    void choosefolder();
    void insertplaceholder(int item);
    void save();

    prompts& prompts_;
    settingsstore& store_;
    const settings current_;
    const optionsopening opening_;
    std::function<void()> donate_;
    settings saved_;
    bool reloadneeded_ = false;
    QHash<QObject*, QLabel*> captionof_;         // button -> its wrapped caption
    QHash<QObject*, QAbstractButton*> buttonof_; // wrapped caption -> its button
    QButtonGroup* methodgroup_ = nullptr;
    QButtonGroup* assessmentgroup_ = nullptr;
    QButtonGroup* countrygroup_ = nullptr;

public:
    QTabWidget* SSTab1 = nullptr;
    // General
    QCheckBox* Sourcetextemptychk = nullptr;
    QCheckBox* fileopendefaultchk = nullptr;
    QLineEdit* folderpathtxt = nullptr;
    QPushButton* folderpathbut = nullptr;
    QCheckBox* keeplogchk = nullptr;
    QLineEdit* pathtxt = nullptr;
    QPushButton* pathbut = nullptr;
    QCheckBox* IDonlychk = nullptr;
    QRadioButton* ukopt = nullptr;
    QRadioButton* usaopt = nullptr;
    QRadioButton* IrelandOpt = nullptr;
    QRadioButton* CanadaOpt = nullptr;
    QCheckBox* autorefchk = nullptr;
    // Recording Methods
    QCheckBox* birthchk = nullptr;
    QCheckBox* householdcheckchk = nullptr;
    std::array<QRadioButton*, 2> methodopt{};
    QRadioButton* Norecordopt = nullptr;
    std::array<QRadioButton*, 4> assessmentopt{};
    QCheckBox* occscholarchk = nullptr;
    QCheckBox* occplacechk = nullptr;
    QCheckBox* occagechk = nullptr;
    QCheckBox* marriageconditionchk = nullptr;
    QCheckBox* separatorchk = nullptr;
    QLineEdit* separatortxt = nullptr;
    // Recording Method 1
    QCheckBox* opt1entrydatechk = nullptr;
    QCheckBox* opt1whereinsourcechk = nullptr;
    QCheckBox* imageschk = nullptr;
    QCheckBox* opt1publicationinfochk = nullptr;
    QLineEdit* sourcetypetxt = nullptr;
    QLineEdit* titletxt = nullptr;
    QComboBox* titlerefcom = nullptr;
    QPushButton* defaulttitlebut = nullptr;
    QLabel* titleoutputlab = nullptr;
    QCheckBox* ASIDchk = nullptr;
    // Recording Method 2
    QCheckBox* sharednotechk = nullptr;
    QCheckBox* images2chk = nullptr;
    // Miscellaneous
    QCheckBox* sourcenotechk = nullptr;
    QCheckBox* image2eventchk = nullptr;
    QCheckBox* entrydatetodaychk = nullptr;
    QCheckBox* usenotechk = nullptr;
    QCheckBox* residencechk = nullptr;
    // buttons
    QPushButton* savebut = nullptr;
    QPushButton* Cancelbut = nullptr;
    QPushButton* defaultbut = nullptr;
    QPushButton* Command1 = nullptr;
    QPushButton* donatebut = nullptr;
};

} // namespace qm

#pragma once
// Add a new image...: picks an image file, checks it, previews it, offers the
// titles it may take (from the file name, the source, the user's own, the
// reference), optionally renames the file to match, and adds it to the images
// chosen as a new multimedia record.

#include "images/imagesfrm.h"

#include <QDialog>

#include <array>
#include <vector>

class QCheckBox;
class QGroupBox;
class QLineEdit;
class QPushButton;
class QRadioButton;

namespace qm {

class newimagefrm : public QDialog {
    Q_OBJECT
public:
    // Shows the dialog modally; true when an image was appended to `chosen`
    // (its O number taken from ++nextobjectid).
    static bool add(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                    prompts& p, std::vector<imagechoice>& chosen, int32_t& nextobjectid, QWidget* parent);

    newimagefrm(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store, prompts& p,
                std::vector<imagechoice>& chosen, int32_t& nextobjectid, QWidget* parent = nullptr);

    static QString filefilter();

private:
    void build();
    void choosefile();
    void optionchosen(int option);
    void addclicked();
    void resetdetails();
    int selectedoption() const;

    imagerequest request_;
    const gedcomindex& index_;
    const settings& settings_;
    settingsstore& store_;
    prompts& prompts_;
    std::vector<imagechoice>& chosen_;
    int32_t& nextobjectid_;
    bool referenceavailable_ = false;
    int sourcenumber_ = 1;
    int referencenumber_ = 1;
    QString folder_;

    QLineEdit* filenametxt_ = nullptr;
    QPushButton* choosefilebut_ = nullptr;
    QGroupBox* imageframe_ = nullptr;
    QLineEdit* filetypetxt_ = nullptr;
    QLineEdit* Datetxt_ = nullptr;
    imagepreview* imagepic_ = nullptr;
    std::array<QRadioButton*, 4> titleopt_{};
    std::array<QLineEdit*, 4> titletxt_{};
    QCheckBox* renamechk_ = nullptr;
    QPushButton* addbut_ = nullptr;
    QPushButton* cancelbut_ = nullptr;
};

} // namespace qm

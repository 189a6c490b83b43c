#pragma once
// Census Images: the images to be linked to a census source, chosen from the
// family file's multimedia records or added as new image files.

#include "writer/censusentry.h"

#include <QDialog>

#include <vector>

class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;
class QGroupBox;

namespace qm {

struct gedcomindex;
struct settings;
class imagepreview;
class prompts;
class settingsstore;

// What the dialog is opened for.
struct imagerequest {
    int context = 1;       // 1 the census entry being saved, 2 an existing source
    QString sourcetitle;   // shown after "Current Source:"
    QString imagedate;     // the date new images get
    QString sourcebase;    // base of the title derived from the source
    QString referencebase; // base of the title derived from the reference; "" = the reference title is unavailable
    bool fullentry = true; // "Full Entry": a new census source per entry
};

class imagesfrm : public QDialog {
    Q_OBJECT
public:
    // Shows the Census Images dialog modally; `chosen` receives the images.
    // False when the user chose "Cancel saving census" (context 1 only).
    static bool choose(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store,
                       prompts& p, std::vector<imagechoice>& chosen, QWidget* parent);

    imagesfrm(const imagerequest& r, const gedcomindex& index, const settings& s, settingsstore& store, prompts& p,
              QWidget* parent = nullptr);
    ~imagesfrm() override;

    const std::vector<imagechoice>& chosen() const { return chosen_; }
    bool cancelsave() const { return cancelsave_; }

private:
    void build();
    void refill();
    void cleardetails();
    void rowchosen(int row);
    void unlink();
    void linkcurrent();
    void linknew();
    void refreshheading();

    imagerequest request_;
    const gedcomindex& index_;
    const settings& settings_;
    settingsstore& store_;
    prompts& prompts_;
    std::vector<imagechoice> chosen_;
    int32_t nextobjectid_ = 0;
    bool cancelsave_ = false;

    QLabel* sourcetitlelab_ = nullptr;
    QLabel* imagelab_ = nullptr;
    QListWidget* newimageslst_ = nullptr;
    QPushButton* addcurrentimagebut_ = nullptr;
    QPushButton* Addnewbut_ = nullptr;
    QGroupBox* Imagefrm_ = nullptr;
    QLineEdit* Imageinfotxt_[5] = {};
    imagepreview* imagepic_ = nullptr;
    QPushButton* unlinkbut_ = nullptr;
    QPushButton* okbut_ = nullptr;
    QPushButton* cancelbut_ = nullptr;
    QPushButton* Cancelcensusbut_ = nullptr;
};

} // namespace qm

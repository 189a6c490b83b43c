#pragma once
// Choose current image to link: the family file's multimedia records, one of
// which is added to the images chosen as an existing image.

#include "writer/censusentry.h"

#include <QDialog>

#include <array>
#include <vector>

class QCheckBox;
class QGroupBox;
class QLineEdit;
class QListWidget;
class QPushButton;
class QRadioButton;

namespace qm {

struct gedcomindex;
class imagepreview;
class prompts;

class currentimagesfrm : public QDialog {
    Q_OBJECT
public:
    // Shows the dialog modally; true when a record was appended to `chosen`.
    static bool pick(const gedcomindex& index, prompts& p, std::vector<imagechoice>& chosen, QWidget* parent);

    currentimagesfrm(const gedcomindex& index, prompts& p, std::vector<imagechoice>& chosen, QWidget* parent = nullptr);

private:
    void build();
    void fill();
    void rowchosen();
    void okclicked();
    int selectedobject() const;

    const gedcomindex& index_;
    prompts& prompts_;
    std::vector<imagechoice>& chosen_;

    QListWidget* imageslst_ = nullptr;
    QCheckBox* censuschk_ = nullptr;
    QRadioButton* showtitlesopt_ = nullptr;
    QRadioButton* showpathsopt_ = nullptr;
    QGroupBox* Imageframe_ = nullptr;
    std::array<QLineEdit*, 5> Imageinfotxt_{};
    imagepreview* imagepic_ = nullptr;
    QPushButton* okbut_ = nullptr;
    QPushButton* cancelbut_ = nullptr;
};

} // namespace qm

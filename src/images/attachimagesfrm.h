#pragma once
// Attach Images to Existing Sources: the user filters and picks a source of
// the family file, sees its title, ID, census date, linked images and citing
// individuals, and links images to it; the family file is rewritten at once
// and the index brought up to date, so that several sources can be done in
// one opening.

#include "model/gedcomindex.h"
#include "writer/censusentry.h"

#include <QDialog>

#include <array>
#include <functional>
#include <vector>

class QCheckBox;
class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;
class QRadioButton;

namespace qm {

class prompts;
struct settings;

class Attachimagesfrm : public QDialog {
    Q_OBJECT
public:
    // Asks for the images of a source (the Census Images dialog for an existing
    // source): its title and the date new images get; nothing when none were chosen.
    using imagechooser =
        std::function<std::vector<imagechoice>(const QString& sourcetitle, const QString& imagedate, QWidget* parent)>;

    // Works out the sources' census dates from the family file first.
    Attachimagesfrm(gedcomindex& index, const settings& s, prompts& p, imagechooser chooser,
                    QWidget* parent = nullptr);

    // Images were attached: the family file has been rewritten.
    bool imagesattached() const { return attached_; }
    // The dialog closed because the file was changed by another program.
    bool filechanged() const { return changed_; }
    // The rewrite failed (its message has been shown): the program ends.
    bool fatal() const { return fatal_; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void build();
    void fill();
    void optionchosen(int option);
    void searchedited(const QString& text);
    void sourcechosen();
    void cleardetails();
    void attach();
    // The file changed outside the program: say so and close.
    void closeonchange();

    gedcomindex& index_;
    const settings& settings_;
    prompts& prompts_;
    imagechooser chooser_;
    std::vector<int32_t> listed_; // positions in sources of the rows of sourcelst
    int32_t source_ = -1;          // position in sources of the source shown
    bool attached_ = false;
    bool changed_ = false;
    bool fatal_ = false;

    QListWidget* sourcelst_ = nullptr;
    std::array<QRadioButton*, 3> sourceopt_{};
    QLineEdit* searchtxt_ = nullptr;
    QPushButton* searchbut_ = nullptr;
    QCheckBox* imagecountchk_ = nullptr;
    QLabel* countlab_ = nullptr;
    QLineEdit* titletxt_ = nullptr;
    QLineEdit* Datetxt_ = nullptr;
    QLineEdit* indextxt_ = nullptr;
    QListWidget* imagelst_ = nullptr;
    QListWidget* individualslst_ = nullptr;
    QPushButton* attachbut_ = nullptr;
};

} // namespace qm

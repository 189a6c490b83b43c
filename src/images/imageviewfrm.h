#pragma once
// Image View: the picture of a preview, as large as the window allows.

#include <QDialog>
#include <QImage>

namespace qm {

class picturebox;

class imageviewfrm : public QDialog {
    Q_OBJECT
public:
    explicit imageviewfrm(const QImage& picture, QWidget* parent = nullptr);
    // Shows the picture modally.
    static void view(const QImage& picture, QWidget* parent);

    picturebox* mainpic() const { return mainpic_; }

private:
    picturebox* mainpic_ = nullptr;
};

} // namespace qm

#pragma once
// The image preview shared by the three image dialogs: a picture box drawing
// the picture scaled to fit at its top-left corner, and the message shown in
// its place while the picture loads or when it cannot be shown. Clicking the
// picture opens the full-size view; clicking the "can not be previewed"
// message opens the file in the system's default viewer.

#include <QImage>
#include <QWidget>

class QLabel;
class QStackedLayout;

namespace qm {

class prompts;

// A picture scaled to fit the box keeping its proportions, drawn at the
// top-left corner.
class picturebox : public QWidget {
    Q_OBJECT
public:
    explicit picturebox(QWidget* parent = nullptr);
    void setpicture(const QImage& picture);
    const QImage& picture() const { return picture_; }
    // Where the picture is drawn in a box of this size.
    static QRect fitted(QSize picture, QSize box);

signals:
    void clicked();

protected:
    void paintEvent(QPaintEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    QImage picture_;
};

class imagepreview : public QWidget {
    Q_OBJECT
public:
    enum class outcome { none, shown, unsupported, notfound, failed };

    imagepreview(prompts& p, QSize boxsize, QWidget* parent = nullptr);

    // The preview procedure: loads the picture of `path` and shows it, or the
    // message saying why it cannot be shown.
    outcome showfile(const QString& path);
    // Hides the picture and the message.
    void clear();

    outcome last() const { return last_; }
    QString message() const;
    const QImage& picture() const;
    picturebox* box() const { return imagepic_; }
    QLabel* messagelabel() const { return previewmessagelab_; }

    // The texts of the procedure.
    static QString openingtext();
    static QString unsupportedtext();
    static QString notfoundtext();
    static QString failedtext();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void setmessage(const QString& text, bool clickable);
    void openinviewer();
    void showfullsize();

    prompts& prompts_;
    QString path_;
    outcome last_ = outcome::none;
    QStackedLayout* stack_ = nullptr;
    picturebox* imagepic_ = nullptr;
    QLabel* previewmessagelab_ = nullptr;
};

} // namespace qm

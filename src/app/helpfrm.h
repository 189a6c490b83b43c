#pragma once
// The help window: Quillmark's help pages in a browser with Back, Forward,
// Home, Index and Search, and a search panel over all pages. Modeless; the
// program keeps one and shows every help request in it (helpfrm::open).

#include "app/helptopics.h"

#include <QPointer>
#include <QWidget>

#include <vector>

class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;
class QTextBrowser;

namespace qm {

class helpfrm : public QWidget {
    Q_OBJECT
public:
    // `home` is the window the help belongs to (the main window); nullptr for
    // a window of its own.
    explicit helpfrm(QWidget* home = nullptr);

    // Shows the page of a topic number, the index ("Index") or the search page
    // ("Search"), and brings the window to the front. Opened from a modal
    // dialog, the window moves under that dialog for as long as it is open, so
    // that it can be read and used while the dialog waits.
    void showtopic(int topic, const QString& command = QString());
    // The file name of the page shown, e.g. "census-flags.html".
    QString currentpage() const;
    // Searches all pages and lists the pages found, best first.
    void search(const QString& query);

    // The program's help window, made on first use and kept for later requests.
    static helpfrm* open(QWidget* home, int topic, const QString& command);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void openpage(const QString& page);
    void showsearch();
    void resultchosen();
    void pagechanged();
    void belongto(QWidget* owner);

    QPointer<QWidget> home_;
    QPointer<QWidget> owner_;
    QTextBrowser* helptxt_;
    QWidget* searchpanel_;
    QLineEdit* searchtxt_;
    QListWidget* resultlst_;
    QLabel* resultlab_;
    QPushButton* backbut_;
    QPushButton* forwardbut_;
    QStringList lastquery_;
    std::vector<helpdoc> docs_;
    bool docsread_ = false;
};

} // namespace qm

#pragma once
// Quillmark Log: shows the census log a page at a time, read-only.

#include "log/logpages.h"

#include <QDialog>

class QLabel;
class QPlainTextEdit;
class QPushButton;

namespace qm {

class prompts;

class logfrm : public QDialog {
    Q_OBJECT
public:
    logfrm(const QString& logpath, prompts& asker, QWidget* parent = nullptr);

    // Opens the log at page 1. False, after telling the user, when it cannot be read.
    bool openlog();

    // Shows the viewer modally on the log; nothing is shown when the log
    // cannot be read.
    static void view(const QString& logpath, prompts& asker, QWidget* parent);

private:
    void showpage();
    void startpage();

    QString logpath_;
    prompts& asker_;
    logpages pages_;
    QPlainTextEdit* logtxt_ = nullptr;
    QPushButton* startbut_ = nullptr;
    QPushButton* nextpagebut_ = nullptr;
    QLabel* pagelab_ = nullptr;
};

} // namespace qm

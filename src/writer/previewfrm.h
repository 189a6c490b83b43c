#pragma once
// "Preview": what saving the entry would write, record by record. The list
// holds each record the save changes or adds; beside it, the chosen record's
// lines, those the save adds marked "+", those it takes away "-", the rest as
// they stand. Nothing is written.

#include "writer/preview.h"

#include <QDialog>

class QListWidget;
class QPlainTextEdit;

namespace qm {

class prompts;

class previewfrm : public QDialog {
    Q_OBJECT
public:
    // `note`, when given, says what the preview cannot show (details the save
    // will still ask for).
    previewfrm(const savepreview& preview, const QString& note, QWidget* parent = nullptr);

    // Shows the record at this position of the list.
    void showrecord(int k);

private:
    const savepreview& preview_;
    QListWidget* recordslst_;
    QPlainTextEdit* linestxt_;
};

// "Preview..." of the main window: runs the save into memory and shows the
// result, or tells why it cannot be run. False when another program changed
// the family file since it was read (the message has been given; the caller
// reads the file again).
bool showentrypreview(const gedcomindex& index, const settings& s, const censusentry& entry, prompts& p,
                      QWidget* parent);

// The record's line as the list shows it: its level-0 line and its name or title.
QString recordcaption(const previewrecord& r);

} // namespace qm

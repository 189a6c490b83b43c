#pragma once
// One of the two panels of the census entry form: panel 0 makes a new census
// source with each entry, panel 1 cites an existing census source. The
// controls carry their program names; the main window reaches them through
// the members.

#include <QWidget>

class QComboBox;
class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QSplitter;

namespace qm {

class entrypanel : public QWidget {
    Q_OBJECT
public:
    entrypanel(int mode, QWidget* parent = nullptr);

    const int mode;
    QLabel* CensusYearLab = nullptr;
    QComboBox* yearcom = nullptr;
    QLineEdit* fixeddatetxt = nullptr;
    QLabel* sourceidlab = nullptr;
    QComboBox* sourcecom = nullptr; // panel 1
    QLineEdit* locationtxt = nullptr;
    QLineEdit* addresstxt = nullptr;
    QLineEdit* referencetxt = nullptr; // panel 0
    QLineEdit* othertxt = nullptr;     // panel 0
    QLineEdit* titletxt = nullptr;     // panel 0
    QLineEdit* wherewithinsourcetxt = nullptr; // panel 1
    QPlainTextEdit* texttxt = nullptr;
    QPlainTextEdit* notetxt = nullptr;
    QSplitter* dividerpic = nullptr; // between the source text and the source note

    // Source text height over source note height.
    double divider() const;
    void setdivider(double ratio);
    // Empties every field (the year and source lists lose their selection).
    void clearfields(bool keepsourceid);
};

} // namespace qm

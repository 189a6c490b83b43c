#pragma once
// One of the two panels of the census entry form: panel 0 makes a new census
// source with each entry, panel 1 cites an existing census source. The
// controls carry their program names; the entry form (entryform_ui.h)
// reaches them through the members.

#include <QWidget>

class QComboBox;
class QLabel;
class QLineEdit;
class QPlainTextEdit;
class QPushButton;
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
    QPushButton* fulltextbut = nullptr; // opens the source text in the large editor
    QPushButton* notetextbut = nullptr; // opens the source note in the large editor
    QSplitter* dividerpic = nullptr; // between the source text and the source note

    // The source text's share of the height the two boxes have: from 0.2 to
    // 1, where 1 closes the note box (the "Divider Percent" value).
    double divider() const;
    void setdivider(double share);
    // Empties every field (the year and source lists lose their selection).
    void clearfields(bool keepsourceid);

signals:
    // The user moved the divider; the share is settled (see divider()).
    void dividermoved(double share);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    // Keeps a dragged divider within its limits; on release a share above
    // 0.97 closes the note box.
    void settle(bool released);

    double share_ = 1;
};

} // namespace qm

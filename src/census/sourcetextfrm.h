#pragma once
// The large editor for the source text or the source note of the entry form:
// the same text in a fixed-width font, in a window nearly as large as the main
// window. OK gives the edited text back; Cancel gives nothing.

#include <QDialog>
#include <QString>

#include <optional>

class QPlainTextEdit;
class QPushButton;

namespace qm {

class sourcetextfrm : public QDialog {
    Q_OBJECT
public:
    enum mode { sourcetext = 1, sourcenote = 2 }; // any other value edits the note

    // Takes the icon of `parent` and 0.95 of its width and height.
    sourcetextfrm(int mode, const QString& text, QWidget* parent = nullptr);

    // The edited text, with the line ends of the text it was given (CR LF when
    // the text given had them, otherwise LF).
    QString text() const;

    // Shows the editor modally: the edited text after OK, nothing after Cancel.
    static std::optional<QString> edit(int mode, const QString& text, QWidget* parent);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    QPlainTextEdit* sourcetxt_;
    QPushButton* okbut_;
    QPushButton* cancelbut_;
    bool crlf_ = false;
};

} // namespace qm

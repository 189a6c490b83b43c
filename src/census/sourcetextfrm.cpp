#include "census/sourcetextfrm.h"

#include "census/backtab_ui.h"
#include "platform/formparts_ui.h"

#include <QFontMetricsF>
#include <QHBoxLayout>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace qm {

sourcetextfrm::sourcetextfrm(int mode, const QString& text, QWidget* parent) : QDialog(parent)
{
    setObjectName(QStringLiteral("sourcetextfrm"));
    const bool note = mode != sourcetext;
    setWindowTitle(note ? QStringLiteral("Source Note") : QStringLiteral("Source Text"));
    if (parent) {
        setWindowIcon(parent->windowIcon());
        resize(qRound(parent->width() * 0.95), qRound(parent->height() * 0.95));
    }

    sourcetxt_ = new QPlainTextEdit(this);
    sourcetxt_->setObjectName(QStringLiteral("sourcetxt"));
    sourcetxt_->setAccessibleName(windowTitle());
    sourcetxt_->setFont(fixedfont());
    sourcetxt_->setTabStopDistance(QFontMetricsF(sourcetxt_->font()).horizontalAdvance(QLatin1Char(' ')) * 8);
    // A transcription is a table: its lines are kept whole. A note is prose.
    sourcetxt_->setLineWrapMode(note ? QPlainTextEdit::WidgetWidth : QPlainTextEdit::NoWrap);
    crlf_ = text.contains(QLatin1String("\r\n"));
    QString shown = text;
    shown.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    sourcetxt_->setPlainText(shown);
    sourcetxt_->installEventFilter(this);

    auto* buttonpic = new QWidget(this);
    buttonpic->setObjectName(QStringLiteral("buttonpic"));
    okbut_ = new QPushButton(QStringLiteral("OK"), buttonpic);
    okbut_->setObjectName(QStringLiteral("okbut"));
    cancelbut_ = new QPushButton(QStringLiteral("Cancel"), buttonpic);
    cancelbut_->setObjectName(QStringLiteral("cancelbut"));
    auto* buttons = new QHBoxLayout(buttonpic);
    buttons->setContentsMargins(0, 0, 0, 0);
    buttons->addWidget(okbut_);
    buttons->addWidget(cancelbut_);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(sourcetxt_, 1);
    layout->addWidget(buttonpic, 0, Qt::AlignHCenter);

    connect(okbut_, &QPushButton::clicked, this, &QDialog::accept);
    connect(cancelbut_, &QPushButton::clicked, this, &QDialog::reject);
    sourcetxt_->setFocus();
}

QString sourcetextfrm::text() const
{
    QString t = sourcetxt_->toPlainText();
    if (crlf_)
        t.replace(QLatin1Char('\n'), QLatin1String("\r\n"));
    return t;
}

std::optional<QString> sourcetextfrm::edit(int mode, const QString& text, QWidget* parent)
{
    sourcetextfrm editor(mode, text, parent);
    if (editor.exec() != QDialog::Accepted)
        return std::nullopt;
    return editor.text();
}

bool sourcetextfrm::eventFilter(QObject* watched, QEvent* event)
{
    // Tab types a tab character (the plain text box does that itself);
    // Shift+Tab leaves the box as in any other field.
    if (watched == sourcetxt_ && isbacktab(event)) {
        focusNextPrevChild(false);
        return true;
    }
    return QDialog::eventFilter(watched, event);
}

} // namespace qm

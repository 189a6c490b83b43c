#include "platform/widgetprompts_ui.h"

#include "platform/opencheck.h"

#include <QApplication>
#include <QDesktopServices>
#include <QFileDialog>
#include <QGuiApplication>
#include <QMessageBox>
#include <QUrl>

namespace qm {

namespace {
QMessageBox::StandardButton buttonof(answer a)
{
    switch (a) {
    case answer::ok:
        return QMessageBox::Ok;
    case answer::cancel:
        return QMessageBox::Cancel;
    case answer::yes:
        return QMessageBox::Yes;
    case answer::no:
        return QMessageBox::No;
    }
    return QMessageBox::NoButton;
}

QMessageBox::Icon iconof(icon i)
{
    switch (i) {
    case icon::none:
        return QMessageBox::NoIcon;
    case icon::information:
        return QMessageBox::Information;
    case icon::question:
        return QMessageBox::Question;
    case icon::exclamation:
        return QMessageBox::Warning;
    case icon::critical:
        return QMessageBox::Critical;
    }
    return QMessageBox::NoIcon;
}
} // namespace

answer widgetprompts::ask(const message& m)
{
    QMessageBox::StandardButtons set;
    QMessageBox::StandardButton escape = QMessageBox::NoButton;
    switch (m.choice) {
    case buttons::ok:
        set = QMessageBox::Ok;
        escape = QMessageBox::Ok;
        break;
    case buttons::okcancel:
        set = QMessageBox::Ok | QMessageBox::Cancel;
        escape = QMessageBox::Cancel;
        break;
    case buttons::yesno:
        set = QMessageBox::Yes | QMessageBox::No;
        escape = QMessageBox::No;
        break;
    case buttons::yesnocancel:
        set = QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
        escape = QMessageBox::Cancel;
        break;
    }
    QMessageBox box(iconof(m.kind), m.title, m.text, set, parent_);
    box.setObjectName(QStringLiteral("messagebox"));
    box.setDefaultButton(m.defaultanswer ? buttonof(*m.defaultanswer)
                                         : (m.choice == buttons::yesno || m.choice == buttons::yesnocancel
                                                ? QMessageBox::Yes
                                                : QMessageBox::Ok));
    box.setEscapeButton(escape);
    // Long messages (paths) wrap instead of widening the box past the screen.
    box.setTextFormat(Qt::PlainText);
    // The busy pointer must not hide that an answer is awaited.
    const bool busy = busy_ > 0;
    if (busy)
        QApplication::setOverrideCursor(Qt::ArrowCursor);
    const int r = box.exec();
    if (busy)
        QApplication::restoreOverrideCursor();
    switch (r) {
    case QMessageBox::Yes:
        return answer::yes;
    case QMessageBox::No:
        return answer::no;
    case QMessageBox::Cancel:
        return answer::cancel;
    default:
        return answer::ok;
    }
}

std::optional<QString> widgetprompts::openfile(const QString& caption, const QString& folder, const QString& filter)
{
    const QString f = QFileDialog::getOpenFileName(parent_, caption, folder, filter);
    if (f.isEmpty())
        return std::nullopt;
    return f;
}

std::optional<QStringList> widgetprompts::openfiles(const QString& caption, const QString& folder,
                                                    const QString& filter)
{
    const QStringList f = QFileDialog::getOpenFileNames(parent_, caption, folder, filter);
    if (f.isEmpty())
        return std::nullopt;
    return f;
}

std::optional<QString> widgetprompts::savefile(const QString& caption, const QString& startpath, const QString& filter)
{
    const QString f = QFileDialog::getSaveFileName(parent_, caption, startpath, filter);
    if (f.isEmpty())
        return std::nullopt;
    return f;
}

std::optional<QString> widgetprompts::choosefolder(const QString& caption, const QString& startfolder)
{
    const QString f = QFileDialog::getExistingDirectory(parent_, caption, startfolder);
    if (f.isEmpty())
        return std::nullopt;
    return f;
}

void widgetprompts::setbusy(bool on)
{
    if (on) {
        if (busy_++ == 0)
            QApplication::setOverrideCursor(Qt::WaitCursor);
    } else if (busy_ > 0) {
        if (--busy_ == 0)
            QApplication::restoreOverrideCursor();
    }
}

activationnotice::activationnotice(QObject* parent) : QObject(parent)
{
    connect(qGuiApp, &QGuiApplication::applicationStateChanged, this, [this](Qt::ApplicationState s) {
        if (s == Qt::ApplicationActive)
            emit activated();
    });
}

void widgetprompts::showhelp(int topic, const QString& command)
{
    if (help_)
        help_(topic, command);
}

QString widgetprompts::openexternal(const QString& target)
{
    const QUrl url = target.startsWith(QLatin1String("https://")) || target.startsWith(QLatin1String("http://"))
                         ? QUrl(target)
                         : QUrl::fromLocalFile(target);
    // A local path may come from a family file: never let it start a program.
    if (url.isLocalFile())
        if (const QString refused = refuseopen(target); !refused.isEmpty())
            return refused;
    return QDesktopServices::openUrl(url) ? QString()
                                          : QStringLiteral("There is no application associated with the given "
                                                           "file name extension.");
}

} // namespace qm

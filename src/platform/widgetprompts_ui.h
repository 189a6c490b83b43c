#pragma once
// The program's own prompts: message boxes and file dialogs of Qt Widgets, the
// busy pointer, and the notice that the application has become active.

#include "platform/prompts.h"

#include <QObject>

#include <functional>

class QWidget;

namespace qm {

class widgetprompts : public prompts {
public:
    // Dialogs are centred on `parent` once it is set.
    void setparent(QWidget* parent) { parent_ = parent; }

    answer ask(const message& m) override;
    std::optional<QString> openfile(const QString& caption, const QString& folder, const QString& filter) override;
    std::optional<QStringList> openfiles(const QString& caption, const QString& folder,
                                         const QString& filter) override;
    std::optional<QString> savefile(const QString& caption, const QString& startpath, const QString& filter) override;
    std::optional<QString> choosefolder(const QString& caption, const QString& startfolder) override;
    // Nested calls keep the pointer busy until the outermost one ends.
    void setbusy(bool on) override;
    // Hands the request to the help window set with sethelp.
    void showhelp(int topic, const QString& command = QString()) override;
    void sethelp(std::function<void(int, const QString&)> help) { help_ = std::move(help); }
    QString openexternal(const QString& target) override;

private:
    QWidget* parent_ = nullptr;
    int busy_ = 0;
    std::function<void(int, const QString&)> help_;
};

// Emits `activated` each time the application becomes the active one (the
// user switches back to it from another program).
class activationnotice : public QObject {
    Q_OBJECT
public:
    explicit activationnotice(QObject* parent = nullptr);

signals:
    void activated();
};

} // namespace qm

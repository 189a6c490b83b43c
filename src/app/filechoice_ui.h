#pragma once
// Which family file the main window opens, and what it remembers of the files
// opened: the file named on the command line, the default file, the Open
// dialog (starting in the folder of the last file chosen) and the File menu's
// four recent files, all kept in the settings store under their old names.

#include "app/recentfiles.h"

#include <QObject>
#include <QStringList>

#include <array>
#include <optional>

class QAction;
class QMenu;

namespace qm {

class prompts;
class settingsstore;

class filechoice : public QObject {
    Q_OBJECT
public:
    // The recent files' items ("RecentFilesmen1".."4", after a separator) are
    // added to the end of `menu`.
    filechoice(settingsstore& store, prompts& p, QMenu* menu, QObject* parent);

    // Reads the recent files, the default file and the Open dialog's folder.
    void read();
    // At start: the file named on the command line, else the default file,
    // else one chosen in the Open dialog, until one exists. A missing file is
    // reported, except a missing default file, which is forgotten silently.
    // Nothing when the user cancelled the Open dialog.
    std::optional<QString> atstart(const QStringList& arguments);
    // From the File menu: a recent file's path, or "-1" for the Open dialog.
    // A recent file no longer there is offered for removal from the list.
    std::optional<QString> another(const QString& path);
    // `path` is about to be read: the user may make it the default file; its
    // folder starts the next Open dialog; it becomes the first recent file.
    void remember(const QString& path, bool fromopen, bool fileopendefault);
    // A file found to hold no individuals is no longer the default file.
    void dropdefault(const QString& path);

    const recentfiles& recent() const { return recent_; }

signals:
    // A recent file's item was chosen.
    void recentchosen(const QString& path);

private:
    std::optional<QString> askforfile();
    void forgetdefault();
    void showrecent();

    settingsstore& store_;
    prompts& prompts_;
    recentfiles recent_;
    QString defaultfile_;
    QString folder_;
    std::array<QAction*, recentfiles::slotcount> items_{};
    QAction* separator_ = nullptr;
};

} // namespace qm

#pragma once
// The per-user settings store: named text values in a root group and in
// subgroups such as "Flags/1".
//
// On Windows the native store is the registry key
// HKEY_CURRENT_USER\Software\Quillmark with string values; elsewhere it is the platform's per-user
// settings file. Tests and `quillmark-cli --settings` use an INI file.

#include <QString>
#include <QStringList>

#include <memory>
#include <optional>

class QSettings;

namespace qm {

class settingsstore {
public:
    // The user's own store.
    static std::unique_ptr<settingsstore> native();
    // A store kept in an INI file (created when first written).
    static std::unique_ptr<settingsstore> onfile(const QString& path);

    explicit settingsstore(std::unique_ptr<QSettings> settings);
    ~settingsstore();
    settingsstore(const settingsstore&) = delete;
    settingsstore& operator=(const settingsstore&) = delete;

    // The text of a value; nothing when it is absent or not text. group "" is
    // the root. The text stops at its first NUL character, as a registry
    // string read by the first Quillmark did.
    std::optional<QString> read(const QString& group, const QString& name) const;
    std::optional<QString> read(const QString& name) const { return read(QString(), name); }
    void write(const QString& group, const QString& name, const QString& value);
    void write(const QString& name, const QString& value) { write(QString(), name, value); }

    bool groupexists(const QString& group) const;
    // Deletes a group with its values; false when there was none.
    bool removegroup(const QString& group);

    // False when the store's file is not in the store's format (or cannot be read).
    bool readable() const;
    // Whether any of the named values is in the root group.
    bool holdsany(const QStringList& names) const;

    // Writes pending changes to permanent storage.
    void sync();
    QString location() const;

private:
    std::unique_ptr<QSettings> settings_;
};

} // namespace qm

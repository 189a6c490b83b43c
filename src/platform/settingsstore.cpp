#include "platform/settingsstore.h"

#include <QSettings>

namespace qm {

namespace {
QString keyof(const QString& group, const QString& name)
{
    return group.isEmpty() ? name : group + QLatin1Char('/') + name;
}
} // namespace

std::unique_ptr<settingsstore> settingsstore::native()
{
#ifdef Q_OS_WIN
    // The key itself: a store opened with the organisation name alone keeps its
    // values one level down, under Software\Quillmark\OrganizationDefaults.
    return std::make_unique<settingsstore>(std::make_unique<QSettings>(
        QStringLiteral("HKEY_CURRENT_USER\\Software\\Quillmark"), QSettings::NativeFormat));
#else
    return std::make_unique<settingsstore>(
        std::make_unique<QSettings>(QSettings::NativeFormat, QSettings::UserScope, QStringLiteral("Quillmark")));
#endif
}

std::unique_ptr<settingsstore> settingsstore::onfile(const QString& path)
{
    return std::make_unique<settingsstore>(std::make_unique<QSettings>(path, QSettings::IniFormat));
}

settingsstore::settingsstore(std::unique_ptr<QSettings> settings) : settings_(std::move(settings)) {}

settingsstore::~settingsstore()
{
    settings_->sync();
}

std::optional<QString> settingsstore::read(const QString& group, const QString& name) const
{
    const QVariant v = settings_->value(keyof(group, name));
    if (!v.isValid())
        return std::nullopt;
    // An INI value holding commas reads back as a list: join it as it was written.
    if (v.typeId() == QMetaType::QStringList)
        return v.toStringList().join(QStringLiteral(", "));
    if (!v.canConvert<QString>())
        return std::nullopt;
    QString s = v.toString();
    const qsizetype nul = s.indexOf(QChar(0));
    if (nul >= 0)
        s.truncate(nul);
    return s;
}

void settingsstore::write(const QString& group, const QString& name, const QString& value)
{
    settings_->setValue(keyof(group, name), value);
}

bool settingsstore::groupexists(const QString& group) const
{
    settings_->beginGroup(group);
    const bool has = !settings_->childKeys().isEmpty() || !settings_->childGroups().isEmpty();
    settings_->endGroup();
    return has;
}

bool settingsstore::removegroup(const QString& group)
{
    if (!groupexists(group))
        return false;
    settings_->remove(group);
    return true;
}

bool settingsstore::readable() const
{
    return settings_->status() == QSettings::NoError;
}

bool settingsstore::holdsany(const QStringList& names) const
{
    for (const QString& n : names)
        if (settings_->contains(n))
            return true;
    return false;
}

void settingsstore::sync()
{
    settings_->sync();
}

QString settingsstore::location() const
{
    return settings_->fileName();
}

} // namespace qm

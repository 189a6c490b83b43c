#include "app/startup.h"

#include "app/recentfiles.h"
#include "platform/settingsstore.h"

#include <QDir>
#include <QFileInfo>

#include <algorithm>
#include <cmath>

namespace qm {

std::optional<QString> commandlinefile(const QStringList& arguments)
{
    QString line = arguments.join(QLatin1Char(' ')).trimmed();
    if (line.size() <= 2)
        return std::nullopt;
    if (line.startsWith(QLatin1Char('"')) && line.endsWith(QLatin1Char('"')))
        line = line.mid(1, line.size() - 2).trimmed();
    if (line.isEmpty())
        return std::nullopt;
    // A name given from a terminal is relative to the folder the program was
    // started in; the file is remembered (default file, recent files) by its
    // whole path so that it is found from anywhere.
    if (QFileInfo(line).isRelative())
        line = QDir::cleanPath(QDir::current().absoluteFilePath(line));
    return line;
}

QString versiontitle()
{
    QString t = QStringLiteral("Quillmark v%1.%2").arg(QM_VERSION_MAJOR).arg(QM_VERSION_MINOR);
    if (QM_VERSION_PATCH != 0)
        t += QStringLiteral(".%1").arg(QM_VERSION_PATCH);
    return t;
}

QString windowtitle(const QString& gedcomfile)
{
    return versiontitle() + QStringLiteral(" - ") + filenameof(gedcomfile);
}

namespace {
// A stored number; nothing when missing, empty or not a number.
std::optional<int> number(const settingsstore& store, const char* name)
{
    const QString v = store.read(QString::fromLatin1(name)).value_or(QString()).trimmed();
    bool ok = false;
    const double d = v.toDouble(&ok);
    if (v.isEmpty() || !ok || !std::isfinite(d))
        return std::nullopt;
    return static_cast<int>(std::lround(d));
}
} // namespace

placement readplacement(const settingsstore& store)
{
    placement p;
    const char* names[] = {"Main Top", "Main Left", "Main Width", "Main Height"};
    std::optional<int>* fields[] = {&p.top, &p.left, &p.width, &p.height};
    for (int i = 0; i < 4; ++i) {
        *fields[i] = number(store, names[i]);
        if (!*fields[i])
            break;
    }
    if (p.complete()) {
        const QString m = store.read(QStringLiteral("Main Maximised")).value_or(QString());
        p.maximised = m == QLatin1String("1");
        p.centre = m.isEmpty();
    }
    const QString d = store.read(QStringLiteral("Divider Percent")).value_or(QString()).trimmed();
    bool ok = false;
    const double v = d.toDouble(&ok);
    if (ok && std::isfinite(v) && v > 0)
        p.divider = v;
    return p;
}

void writeplacement(settingsstore& store, bool maximised, int top, int left, int width, int height, double divider)
{
    store.write(QStringLiteral("Main Maximised"), maximised ? QStringLiteral("1") : QStringLiteral("0"));
    store.write(QStringLiteral("Main Top"), QString::number(top));
    store.write(QStringLiteral("Main Left"), QString::number(left));
    store.write(QStringLiteral("Main Width"), QString::number(width));
    store.write(QStringLiteral("Main Height"), QString::number(height));
    store.write(QStringLiteral("Divider Percent"), QString::number(divider, 'g', 4));
}

windowplace placewindow(const placement& p, QPoint at, QSize hint, QSize minimum, const QRect& avail, double dpi)
{
    // Room for the frame and title bar of the window manager.
    const QSize room(avail.width() - 16, avail.height() - 40);
    QSize s = QSize(twipstopixels(12000, dpi), twipstopixels(8950, dpi))
                  .expandedTo(hint)
                  .expandedTo(QSize(1280, 760))
                  .boundedTo(room);
    if (p.top)
        at.setY(twipstopixels(*p.top, dpi));
    if (p.left)
        at.setX(twipstopixels(*p.left, dpi));
    if (p.width)
        s.setWidth(twipstopixels(*p.width, dpi));
    if (p.height)
        s.setHeight(twipstopixels(*p.height, dpi));
    s = s.boundedTo(room).expandedTo(minimum);
    at.setX(std::clamp(at.x(), avail.left(), std::max(avail.left(), avail.right() - s.width())));
    at.setY(std::clamp(at.y(), avail.top(), std::max(avail.top(), avail.bottom() - s.height())));
    windowplace w{at, s, p.top || p.left};
    if (p.complete() && p.centre) {
        w.at = avail.center() - QPoint(s.width() / 2, s.height() / 2);
        w.move = true;
    }
    return w;
}

int twipstopixels(int twips, double dpi)
{
    return static_cast<int>(std::lround(twips * dpi / 1440.0));
}

int pixelstotwips(int pixels, double dpi)
{
    return static_cast<int>(std::lround(pixels * 1440.0 / dpi));
}

bool askdefaultfile(const QString& defaultfile, bool fromopen, bool fileopendefault)
{
    return defaultfile.isEmpty() || (fromopen && fileopendefault);
}

QString gedcomfilter()
{
    return QStringLiteral("Family Historian Gedcom (*.ged);;All Files (*)");
}

} // namespace qm

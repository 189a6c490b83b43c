#pragma once
// Whether a control's font lines up columns of text, whatever fonts the
// machine has: the font given for it is fixed-pitch, or no fixed-pitch family
// is installed at all (nothing could do better there).

#include <QFont>
#include <QFontDatabase>
#include <QFontInfo>
#include <QFontMetricsF>

namespace qmtest {

inline bool linesupcolumns(const QFont& font)
{
    const QFontMetricsF m(font);
    if (QFontInfo(font).fixedPitch() && m.horizontalAdvance(QLatin1Char('i')) == m.horizontalAdvance(QLatin1Char('M')))
        return true;
    for (const QString& family : QFontDatabase::families())
        if (QFontDatabase::isFixedPitch(family))
            return false;
    return true;
}

} // namespace qmtest

#include "census/birthdate.h"

#include "model/dates.h"

namespace qm {

QString calculatedbirthdate(const QDate& census, int age, QChar agetype)
{
    if (!census.isValid())
        return QString();
    switch (agetype.toUpper().unicode()) {
    case u'Y':
        return QString::number(census.year() - age);
    case u'M':
        // Whole months back; the day does not matter (31 MAR less one month is
        // in February, not rolled over into March).
        return formatgedcommonth(QDate(census.year(), census.month(), 1).addMonths(-age));
    case u'D':
        return formatgedcomdate(census.addDays(-age));
    default:
        return QString();
    }
}

QString calculatedbirthdate(const QString& entrydate, const QString& age, QChar agetype)
{
    bool ok = false;
    const int years = age.trimmed().toInt(&ok);
    const std::optional<QDate> census = recognisedate(entrydate);
    if (!ok || !census)
        return QString();
    return calculatedbirthdate(*census, years, agetype);
}

} // namespace qm

#pragma once
// The birth date a census age gives: what the birth details dialog shows and
// what a calculated ("CAL") birth event records.

#include <QChar>
#include <QDate>
#include <QString>

namespace qm {

// From the census day and the age in years ('Y': "1806"), months ('M': the
// month, "SEP 1850") or days ('D': the day, "13 FEB 1851"). Months and days are
// written in English whatever the locale. Empty for an unknown age type.
QString calculatedbirthdate(const QDate& census, int age, QChar agetype);

// The same from the entry's census date text and the age as typed; empty when
// the date is not a date or the age not a number.
QString calculatedbirthdate(const QString& entrydate, const QString& age, QChar agetype);

} // namespace qm

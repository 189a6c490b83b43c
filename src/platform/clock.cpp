#include "platform/clock.h"

namespace qm {

namespace {
QDateTime& fixedtime()
{
    static QDateTime t;
    return t;
}
} // namespace

QDateTime now()
{
    return fixedtime().isValid() ? fixedtime() : QDateTime::currentDateTime();
}

void setclockfortests(const QDateTime& fixed)
{
    fixedtime() = fixed;
}

} // namespace qm

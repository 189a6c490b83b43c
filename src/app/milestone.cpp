#include "app/milestone.h"

namespace qm {

bool ismilestone(int64_t count)
{
    return count == 10 || count == 20 || (count > 0 && count % 50 == 0);
}

QString milestonetext(int64_t count)
{
    return QStringLiteral("For your information you have now used Quillmark to create at least %1 census entries.")
        .arg(count);
}

} // namespace qm

#pragma once
// The donation reminder's milestones of saved census entries.

#include <QString>

#include <cstdint>

namespace qm {

// Whether the reminder is shown once the saved-entries count has reached
// `count`: at the 10th, the 20th and every 50th entry.
bool ismilestone(int64_t count);

// The reminder's text for a milestone: "For your information you have now
// used Quillmark to create at least " + count + " census entries."
QString milestonetext(int64_t count);

} // namespace qm

#pragma once
// "Clear Log File": deletes the census log, after asking, and starts an empty one.

#include <QString>

namespace qm {

class prompts;

// Every outcome is told to the user; true when the log was emptied.
bool clearlog(prompts& asker, const QString& logpath);

} // namespace qm

#include "flags/flagtable.h"

namespace qm {

size_t noteflag(flagtable& table, std::string_view code, std::string_view name)
{
    for (size_t i = 0; i < table.size(); ++i) {
        if (table[i].code == code) {
            ++table[i].count;
            return i;
        }
    }
    flagrec f;
    f.code = std::string(code);
    f.name = std::string(name);
    f.count = 1;
    table.push_back(std::move(f));
    return table.size() - 1;
}

} // namespace qm

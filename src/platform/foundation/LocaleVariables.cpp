#include "platform/foundation/LocaleVariables.h"

#include <algorithm>

namespace orvo {

std::string localeOfVariables(const VariableLookup& valueOf) {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        auto name = valueOf(variable).value_or("");
        if (name.empty())
            continue;
        name.resize(std::min(name.find_first_of(".@"), name.size())); // de_CH.UTF-8@euro
        if (name == "C" || name == "POSIX")
            return "en";
        std::ranges::replace(name, '_', '-');
        return name;
    }
    return "en";
}

} // namespace orvo

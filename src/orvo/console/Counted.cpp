#include "orvo/console/Counted.h"

namespace orvo::Counted {

std::string grouped(std::uint64_t number) {
    constexpr std::size_t Group = 3;
    std::string text = std::to_string(number);
    for (std::size_t at = text.size(); at > Group;)
        text.insert(at -= Group, 1, ',');
    return text;
}

std::string text(std::uint64_t number, std::string_view singular, std::string_view plural) {
    return grouped(number).append(" ").append(number == 1 ? singular : plural);
}

} // namespace orvo::Counted

#pragma once

#include <string>
#include <utility>

namespace orvo {

/// The name of a method that is kept in a variable, as `_contentSizeCategoryDidChange` or
/// `tableView:didSelectRow:`.
class Selector {
public:
    explicit Selector(std::string name)
        : _name(std::move(name)) {}

    [[nodiscard]] const std::string& name() const noexcept { return _name; }

    friend bool operator==(const Selector& a, const Selector& b) = default;

private:
    std::string _name;
};

[[nodiscard]] inline std::string NSStringFromSelector(const Selector& selector) {
    return selector.name();
}
[[nodiscard]] inline Selector NSSelectorFromString(std::string name) {
    return Selector(std::move(name));
}

} // namespace orvo

#pragma once

#include <stdexcept>

namespace orvo {

/// A programming error of the caller: a nil where none may be, an element of the wrong class. Never
/// thrown for bad input.
class NSInvalidArgumentException : public std::invalid_argument {
public:
    using std::invalid_argument::invalid_argument;
};

} // namespace orvo

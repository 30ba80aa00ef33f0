#pragma once

#include "platform/foundation/NSError.h"
#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo {

/// What an operation ended with: a value (any object) or an error, exactly one of the two.
/// Immutable; may be passed between threads. Value and error are reached only through the
/// functions that take blocks; every block runs inside the call, on the caller's thread.
class Result : public virtual NSObject {
public:
    using Value = std::shared_ptr<NSObject>;
    using Error = std::shared_ptr<NSError>;

    /// A new success.
    /// @throws NSInvalidArgumentException "Value cannot be nil"
    [[nodiscard]] static std::shared_ptr<Result> resultWithValue(const Value& value);
    /// A new failure.
    /// @throws NSInvalidArgumentException "Error cannot be nil"
    [[nodiscard]] static std::shared_ptr<Result> resultWithError(const Error& error);
    /// As `resultWithValue`.
    [[nodiscard]] static std::shared_ptr<Result> initWithSuccess(const Value& value);
    /// As `resultWithError`.
    [[nodiscard]] static std::shared_ptr<Result> initWithError(const Error& error);

    [[nodiscard]] bool isSuccess() const noexcept { return _isSuccess; }

    /// Calls the block for what the receiver holds. A missing block is logged as misuse; the other
    /// one is still called if its side is the one held.
    void withValue_orError(const std::function<void(const Value&)>& valueBlock,
                           const std::function<void(const Error&)>& errorBlock) const;
    /// A new success with the block's answer; a failure answers itself and calls nothing.
    /// @throws NSInvalidArgumentException when the block answers nil
    [[nodiscard]] std::shared_ptr<Result>
    map(const std::function<Value(const Value&)>& block) const;
    /// The block's answer as it is; a failure answers itself and calls nothing.
    [[nodiscard]] std::shared_ptr<Result>
    flatMap(const std::function<std::shared_ptr<Result>(const Value&)>& block) const;

    /// Both succeeded or both failed, with equal values or errors. Nil is never equal. Does not
    /// look at the classes of the results.
    [[nodiscard]] bool isEqualToResult(const Result* other) const;

    /// The misuse line for `withValue_orError`; each argument says whether that block is missing.
    [[nodiscard]] std::string _errorMessageForValue_error(bool value, bool error) const;

    /// Only a result of exactly the receiver's class can be equal, by `isEqualToResult`.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    /// The error's own hash; the value's, with `HashMultiplier` mixed in.
    [[nodiscard]] std::uint64_t hash() const override;
    /// The root description with the value's or error's before its closing bracket.
    [[nodiscard]] std::string description() const override;

protected:
    bool _initWithSuccess(const Value& value);
    bool _initWithError(const Error& error);

private:
    Value _value;
    Error _error;
    bool _isSuccess = false;
};

} // namespace orvo

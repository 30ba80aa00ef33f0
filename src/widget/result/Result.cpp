#include "widget/result/Result.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Hashing.h"
#include "platform/foundation/Log.h"

#include <typeinfo>

namespace orvo {

namespace {

std::shared_ptr<Log> resultLog() {
    return Log::findOrCreate("Result");
}

std::string replacingEach(char mark, const std::string& replacement, const std::string& text) {
    std::string replaced;
    for (const char character : text) {
        if (character == mark)
            replaced += replacement;
        else
            replaced += character;
    }
    return replaced;
}

} // namespace

std::shared_ptr<Result> Result::resultWithValue(const Value& value) {
    return initWithSuccess(value);
}

std::shared_ptr<Result> Result::resultWithError(const Error& error) {
    return initWithError(error);
}

std::shared_ptr<Result> Result::initWithSuccess(const Value& value) {
    auto result = std::make_shared<Result>();
    return result->_initWithSuccess(value) ? result : nullptr;
}

std::shared_ptr<Result> Result::initWithError(const Error& error) {
    auto result = std::make_shared<Result>();
    return result->_initWithError(error) ? result : nullptr;
}

bool Result::_initWithSuccess(const Value& value) {
    if (!value)
        throw NSInvalidArgumentException("Value cannot be nil");
    _value = value;
    _isSuccess = true;
    return true;
}

bool Result::_initWithError(const Error& error) {
    if (!error)
        throw NSInvalidArgumentException("Error cannot be nil");
    _error = error;
    _isSuccess = false;
    return true;
}

void Result::withValue_orError(const std::function<void(const Value&)>& valueBlock,
                               const std::function<void(const Error&)>& errorBlock) const {
    if (!valueBlock || !errorBlock)
        resultLog()->error("%@", _errorMessageForValue_error(!valueBlock, !errorBlock));

    if (valueBlock && _value) {
        valueBlock(_value);
    } else if (errorBlock && _error) {
        errorBlock(_error);
    } else {
        if (!valueBlock && _value)
            resultLog()->error("Had a value but no value block");
        if (!errorBlock && _error)
            resultLog()->error("Had an error but no error block");
    }
}

std::shared_ptr<Result> Result::map(const std::function<Value(const Value&)>& block) const {
    return flatMap([&](const Value& value) { return resultWithValue(block(value)); });
}

std::shared_ptr<Result>
Result::flatMap(const std::function<std::shared_ptr<Result>(const Value&)>& block) const {
    if (!_isSuccess)
        return std::const_pointer_cast<Result>(strong(this));
    return block(_value);
}

bool Result::isEqualToResult(const Result* other) const {
    if (!other || _isSuccess != other->_isSuccess)
        return false;
    bool areEqual = false;
    // The other's side is asked, so what it calls equal decides.
    other->withValue_orError([&](const Value& value) { areEqual = value->isEqual(_value.get()); },
                             [&](const Error& error) { areEqual = error->isEqual(_error.get()); });
    return areEqual;
}

// NOLINTNEXTLINE(readability-convert-member-functions-to-static): a result is asked for it
std::string Result::_errorMessageForValue_error(bool value, bool error) const {
    std::string message = "Neither block can be nil but ";
    if (value && error)
        message += "both are nil.";
    else if (value)
        message += "value block is nil.";
    else
        message += "error block is nil.";
    return message;
}

bool Result::isEqual(const NSObject* other) const {
    if (other == this)
        return true;
    if (!other || typeid(*other) != typeid(*this))
        return false;
    return isEqualToResult(dynamic_cast<const Result*>(other));
}

std::uint64_t Result::hash() const {
    const std::uint64_t content = _isSuccess ? hashOf(_value) : hashOf(_error);
    return content ^ (static_cast<std::uint64_t>(_isSuccess) * HashMultiplier);
}

std::string Result::description() const {
    std::string text = rootDescription();
    const auto insert = [&](const std::string& content) {
        text = replacingEach('>', " " + content + ">", text);
    };
    withValue_orError([&](const Value& value) { insert(value->description()); },
                      [&](const Error& error) { insert(error->description()); });
    return text;
}

} // namespace orvo

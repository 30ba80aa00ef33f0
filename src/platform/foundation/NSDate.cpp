#include "platform/foundation/NSDate.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/ISO8601.h"

#include <bit>

namespace orvo {

std::shared_ptr<NSDate> NSDate::date() {
    return dateWithTimeIntervalSinceNow(0);
}

std::shared_ptr<NSDate> NSDate::dateWithTimeIntervalSinceNow(NSTimeInterval seconds) {
    return dateWithTimeIntervalSinceReferenceDate(
        Environment::wallClock().get()->timeIntervalSinceReferenceDate() + seconds);
}

std::shared_ptr<NSDate> NSDate::dateWithTimeIntervalSince1970(NSTimeInterval seconds) {
    return dateWithTimeIntervalSinceReferenceDate(seconds - NSTimeIntervalSince1970);
}

std::shared_ptr<NSDate> NSDate::dateWithTimeIntervalSinceReferenceDate(NSTimeInterval seconds) {
    auto date = std::make_shared<NSDate>();
    date->_seconds = seconds;
    return date;
}

NSTimeInterval NSDate::timeIntervalSince1970() const noexcept {
    return _seconds + NSTimeIntervalSince1970;
}

NSTimeInterval NSDate::timeIntervalSinceDate(const NSDate& other) const noexcept {
    return _seconds - other._seconds;
}

NSTimeInterval NSDate::timeIntervalSinceNow() const {
    return _seconds - Environment::wallClock().get()->timeIntervalSinceReferenceDate();
}

bool NSDate::isEqual(const NSObject* other) const {
    const auto* date = dynamic_cast<const NSDate*>(other);
    return date && date->_seconds == _seconds;
}

std::uint64_t NSDate::hash() const {
    return std::bit_cast<std::uint64_t>(_seconds == 0 ? 0.0 : _seconds); // -0.0 equals 0.0
}

std::string NSDate::description() const {
    auto text = ISO8601::string(timeIntervalSince1970());
    if (!text.ends_with('Z')) // outside the calendar
        return text;
    text[10] = ' ';
    text.replace(19, std::string::npos, " +0000");
    return text;
}

std::shared_ptr<NSObject> NSDate::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo

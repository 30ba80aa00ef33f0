#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSCoding.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/foundation/NSKeyedUnarchiver.h"

#include <cstdlib>

namespace orvo {
namespace {

/// Holds what records hold: values, an object of its own class, a list of those, and anything that
/// property lists have.
class FuzzedRecord final : public virtual NSSecureCoding {
public:
    static std::shared_ptr<FuzzedRecord> initWithCoder(NSCoder& coder) {
        auto record = std::make_shared<FuzzedRecord>();
        record->_name = coder.decodeStringForKey("name");
        record->_flag = coder.decodeBoolForKey("flag");
        record->_count = coder.decodeIntegerForKey("count");
        record->_real = coder.decodeDoubleForKey("real");
        record->_list = coder.decodeObjectOfClasses_forKey({"NSArray", "Record"}, "list");
        record->_next = coder.decodeObjectOfClass_forKey("Record", "next");
        record->_value = coder.decodeObjectForKey("value");
        return record->_count == 1 ? nullptr : record;
    }
    void encodeWithCoder(NSCoder& coder) const override {
        coder.encodeString_forKey(_name, "name");
        coder.encodeBool_forKey(_flag, "flag");
        coder.encodeInteger_forKey(_count, "count");
        coder.encodeDouble_forKey(_real, "real");
        coder.encodeObject_forKey(_list, "list");
        coder.encodeObject_forKey(_next, "next");
        coder.encodeObject_forKey(_value, "value");
    }
    [[nodiscard]] std::vector<std::string> classesForCoder() const override {
        return {"Record", "NSObject"};
    }

private:
    std::optional<std::string> _name;
    bool _flag = false;
    std::int64_t _count = 0;
    double _real = 0;
    std::shared_ptr<NSObject> _list;
    std::shared_ptr<NSObject> _next;
    std::shared_ptr<NSObject> _value;
};

std::shared_ptr<NSData> archivedSecurely(const std::shared_ptr<NSObject>& object) {
    return NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(object, true);
}

/// What decodes can be archived again; from then on the bytes stay the same.
void decodeAndArchive(const std::shared_ptr<NSData>& data) {
    const std::vector<std::string> classes{"NSObject"};
    const auto object = NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(classes, data);
    if (!object)
        return;
    const auto once = archivedSecurely(object);
    if (!once)
        std::abort();
    const auto again = archivedSecurely(
        NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(classes, once));
    if (!once->isEqual(again.get()))
        std::abort();
}

/// A failure raises where that is the policy, and leaves the unarchiver whole.
void decodeRaising(const std::shared_ptr<NSData>& data) {
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(data);
    if (!unarchiver)
        return;
    unarchiver->setRequiresSecureCoding(false);
    unarchiver->setClass_forClassName("Record", "OldRecord");
    unarchiver->setDecodingFailurePolicy(NSDecodingFailurePolicy::RaiseException);
    try {
        (void)unarchiver->decodeObjectForKey(NSKeyedArchiveRootObjectKey);
    } catch (const NSInvalidUnarchiveOperationException&) {
        if (!unarchiver->error())
            std::abort();
    }
    unarchiver->finishDecoding();
}

} // namespace
} // namespace orvo

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace orvo;
    static const auto classes =
        CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
            CodingClassTable{CodingClass::of<FuzzedRecord>("Record")}));
    const auto bytes = NSData::dataWithBytes({data, size});
    decodeAndArchive(bytes);
    decodeRaising(bytes);
    return 0;
}

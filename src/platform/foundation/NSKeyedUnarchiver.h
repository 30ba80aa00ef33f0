#pragma once

#include "platform/foundation/CodingClass.h"
#include "platform/foundation/KeyedArchive.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSCoder.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSNumber.h"

#include <map>
#include <set>
#include <stdexcept>
#include <unordered_map>
#include <utility>
#include <vector>

namespace orvo {

/// An archive does not hold what was asked of it, and the policy is to raise.
class NSInvalidUnarchiveOperationException : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

enum class NSDecodingFailurePolicy : std::int64_t {
    RaiseException = 0,
    SetErrorAndReturn = 1,
};

/// Reads a keyed archive, from anybody: bytes, references, classes and counts are believed only as
/// far as they prove true, and time, memory and depth are bounded by the bytes given. What is wrong
/// is an error of `NSCocoaErrorDomain`, `NSCoderReadCorruptError` unless it says otherwise.
///
/// Classes are made as `CodingClassTable::current()` says at the beginning. A shared object is
/// decoded once, but a collection once for each set of classes that it is decoded with.
class NSKeyedUnarchiver final : public NSCoder {
public:
    /// Requires secure coding, and does not raise. Nil with an error when the bytes are no keyed
    /// archive, or `data` is nil.
    [[nodiscard]] static std::shared_ptr<NSKeyedUnarchiver>
    initForReadingFromData_error(const std::shared_ptr<NSData>& data,
                                 std::shared_ptr<NSError>* error = nullptr);
    /// The root of an archive, as a whole in one step.
    [[nodiscard]] static std::shared_ptr<NSObject>
    unarchivedObjectOfClasses_fromData_error(const std::vector<std::string>& classes,
                                             const std::shared_ptr<NSData>& data,
                                             std::shared_ptr<NSError>* error = nullptr);

    void setRequiresSecureCoding(bool required) { _requiresSecureCoding = required; }
    [[nodiscard]] NSDecodingFailurePolicy decodingFailurePolicy() const noexcept { return _policy; }
    void setDecodingFailurePolicy(NSDecodingFailurePolicy policy) { _policy = policy; }
    /// Objects archived under `archivedName` are made as `className`, and count as that.
    void setClass_forClassName(const std::string& className, const std::string& archivedName);

    /// Never raises: what went wrong, here or earlier, is handed out. An object whose class answers
    /// nil is nil without an error; nothing under the key is `NSCoderValueNotFoundError`.
    [[nodiscard]] std::shared_ptr<NSObject>
    decodeTopLevelObjectOfClasses_forKey_error(const std::vector<std::string>& classes,
                                               const std::string& key,
                                               std::shared_ptr<NSError>* error = nullptr);
    /// Lets go of the archive. Whoever decodes afterwards gets nothing.
    /// @throws NSInvalidArgumentException while an object is being decoded
    void finishDecoding();

    [[nodiscard]] bool requiresSecureCoding() const override { return _requiresSecureCoding; }
    [[nodiscard]] std::shared_ptr<NSError> error() const override { return _error; }
    /// @throws NSInvalidUnarchiveOperationException where that is the policy
    void failWithError(const std::shared_ptr<NSError>& error) override;
    [[nodiscard]] bool containsValueForKey(const std::string& key) const override;
    [[nodiscard]] std::shared_ptr<NSObject>
    decodeObjectOfClasses_forKey(const std::vector<std::string>& classes,
                                 const std::string& key) override;
    [[nodiscard]] std::shared_ptr<NSObject> decodeObjectForKey(const std::string& key) override;
    [[nodiscard]] bool decodeBoolForKey(const std::string& key) override;
    [[nodiscard]] std::int64_t decodeIntegerForKey(const std::string& key) override;
    [[nodiscard]] double decodeDoubleForKey(const std::string& key) override;

    /// What the objects of a list are for. To be found by content they are hashed, which costs time
    /// in proportion to all that they hold.
    enum class Use { Kept, FoundByContent };
    /// A list of references under one key, of the classes allowed for the object being decoded.
    /// Empty after a failure; an element that is nil is one.
    [[nodiscard]] std::vector<std::shared_ptr<NSObject>>
    _decodeArrayOfObjectsForKey(const std::string& key, Use use);
    /// The same of one reference.
    [[nodiscard]] std::shared_ptr<NSObject> _decodeElementForKey(const std::string& key, Use use);
    /// What stands under the key itself, without a reference. Nil when there is nothing.
    [[nodiscard]] std::shared_ptr<NSObject> _valueForKey(const std::string& key) const;
    /// Fails with `NSCoderReadCorruptError`.
    void _failCorrupt(const std::string& what);

private:
    using Allowed = std::size_t; ///< which of the sets of classes
    static constexpr Allowed AnyClass = 0;

    struct Frame {
        std::shared_ptr<NSDictionary> record;
        Allowed allowed = AnyClass;
        KeyedArchive::Extent extent;
    };
    struct Decoded {
        std::shared_ptr<NSObject> object; ///< nil where its class answered nil
        bool isOpen = false;              ///< being decoded: meeting it again is a circle
        bool isDone = false;
        KeyedArchive::Extent extent;
    };
    class FrameScope;

    bool open(const NSData& data, std::shared_ptr<NSError>* error);
    [[nodiscard]] std::shared_ptr<NSNumber> numberForKey(const std::string& key);
    [[nodiscard]] std::shared_ptr<NSObject> decodeUnderKey(const std::string& key, Allowed allowed);
    [[nodiscard]] std::shared_ptr<NSObject>
    decodeReference(const NSObject& reference, Allowed allowed, Use use);
    [[nodiscard]] Decoded* decoded(std::uint64_t number, Allowed allowed);
    void decodeContent(const std::shared_ptr<NSObject>& archived,
                       const CodingClass& itsClass,
                       Allowed allowed,
                       Decoded& entry);
    [[nodiscard]] Allowed allowedSet(const std::vector<std::string>& classes);
    [[nodiscard]] bool isAllowed(const CodingClass& itsClass, Allowed allowed) const;
    [[nodiscard]] const CodingClass* classOf(const NSObject& archived);
    [[nodiscard]] const CodingClass* classNumbered(std::uint64_t number);

    bool _requiresSecureCoding = true;
    NSDecodingFailurePolicy _policy = NSDecodingFailurePolicy::SetErrorAndReturn;
    std::shared_ptr<const CodingClassTable> _table;
    std::unordered_map<std::string, std::string> _classNames; ///< by archived name
    std::shared_ptr<NSArray> _objects;
    std::vector<std::set<std::string>> _allowedSets{{}}; ///< the first stands for any class
    std::unordered_map<std::uint64_t, const CodingClass*> _classes; ///< by number
    std::map<std::pair<std::uint64_t, Allowed>, Decoded> _decoded; ///< by number and set of classes
    std::vector<Frame> _frames;     ///< outermost first, the top itself below all
    std::size_t _hashableBytes = 0; ///< how much may yet be hashed
    std::shared_ptr<NSError> _error;
};

} // namespace orvo

#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/KeyedArchive.h"
#include "platform/foundation/NSCoder.h"
#include "platform/foundation/NSData.h"

#include <functional>
#include <unordered_map>
#include <utility>

namespace orvo {

/// Writes objects that refer to one another into a keyed archive: a binary property list in which
/// `$objects` holds each object once, `$top` says which stand at the top, and references are UIDs.
///
/// An object is archived once, however often it is met; texts, numbers and data are the same object
/// when they are equal. The same content, given in the same order, makes the same bytes. Objects
/// are kept alive, and must not change, until the archive is finished.
class NSKeyedArchiver final : public NSCoder {
public:
    using Archiving = std::function<std::shared_ptr<NSData>(const std::shared_ptr<NSObject>& root,
                                                            bool requiresSecureCoding,
                                                            std::shared_ptr<NSError>*)>;

    /// An archive with one object at the top, under `NSKeyedArchiveRootObjectKey`. Nil with an
    /// error
    /// (`NSCocoaErrorDomain`, `NSCoderInvalidValueError`) when an object in it cannot be archived:
    /// it is no `NSCoding`, supports no secure coding where that is required, contains itself, or
    /// is nested too deep. `root` may be nil.
    [[nodiscard]] static std::shared_ptr<NSData>
    archivedDataWithRootObject_requiringSecureCoding_error(
        const std::shared_ptr<NSObject>& root,
        bool requiresSecureCoding,
        std::shared_ptr<NSError>* error = nullptr);
    /// What that function does.
    static EnvironmentSlot<Archiving>& archiving();

    [[nodiscard]] static std::shared_ptr<NSKeyedArchiver>
    initRequiringSecureCoding(bool requiresSecureCoding);

    /// Ends the archive. Nil, with the first error, when something could not be archived.
    /// @throws NSInvalidArgumentException a second time
    [[nodiscard]] std::shared_ptr<NSData> encodedData(std::shared_ptr<NSError>* error = nullptr);

    [[nodiscard]] bool requiresSecureCoding() const override { return _requiresSecureCoding; }
    [[nodiscard]] std::shared_ptr<NSError> error() const override { return _error; }
    void failWithError(const std::shared_ptr<NSError>& error) override;
    void encodeObject_forKey(const std::shared_ptr<NSObject>& object,
                             const std::string& key) override;
    void encodeBool_forKey(bool value, const std::string& key) override;
    void encodeInteger_forKey(std::int64_t value, const std::string& key) override;
    void encodeDouble_forKey(double value, const std::string& key) override;

    /// A list of references under one key, as collections have them.
    void _encodeArrayOfObjects_forKey(const std::vector<std::shared_ptr<NSObject>>& objects,
                                      const std::string& key);

private:
    using Number = std::uint64_t; ///< of an object in the archive
    /// An object while its content comes in.
    struct Frame {
        std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> values;
        KeyedArchive::Extent extent;
    };
    struct Archived {
        Number number = 0;
        bool isOpen = false; ///< its content still comes in
        KeyedArchive::Extent extent;
    };

    void fail(const std::string& what);
    void setValue(const std::string& key, std::shared_ptr<NSObject> value);
    [[nodiscard]] std::shared_ptr<NSObject> reference(const std::shared_ptr<NSObject>& object);
    Number addObject(const std::shared_ptr<NSObject>& object);
    Number addScalar(const std::shared_ptr<NSObject>& object, std::string content);
    bool encodeContent(const NSObject& object, std::vector<std::string>& classes);
    Number addClass(const std::vector<std::string>& classes);
    void include(const KeyedArchive::Extent& part);

    bool _requiresSecureCoding = true;
    std::vector<std::shared_ptr<NSObject>> _objects; ///< as the list will hold them
    std::vector<Frame> _frames;                      ///< outermost first, the top itself below all
    std::unordered_map<const NSObject*, Archived> _archived;
    std::vector<std::shared_ptr<NSObject>> _kept; ///< an address stays its object's
    std::unordered_map<std::string, Number> _scalars;
    std::unordered_map<std::string, Number> _classes;
    std::shared_ptr<NSError> _error;
};

} // namespace orvo
